// The process cursor table: the built-in shapes, the pictures loaded on first request, and
// the calls that hand its records out.
#include "cursors/CursorPrivate.h"

#include "foundation/ApplicationPrivate.h"

#include <QGuiApplication>

// rcc's registration function is declared where Q_INIT_RESOURCE stands, so outside any
// namespace. Called explicitly because the tests' static library would otherwise leave the
// pictures' object file, which nothing else references, out of the link.
static void registerCursorPictures()
{
    Q_INIT_RESOURCE(velmar_cursors);
}

namespace Velmar {

using namespace Private;

namespace {

struct BuiltIn {
    SInt16 id;
    Qt::CursorShape shape;
};

constexpr BuiltIn kBuiltIns[] = {
    {0, Qt::ArrowCursor},
    {1, Qt::IBeamCursor},
    {2, Qt::CrossCursor},
    {3, Qt::CrossCursor},
    {4, Qt::WaitCursor},
    {2010, Qt::SizeFDiagCursor},
    {8, Qt::ClosedHandCursor},
    {9, Qt::OpenHandCursor},
    {10, Qt::PointingHandCursor},
    {17, Qt::SizeHorCursor},
    {18, Qt::ForbiddenCursor},
    {21, Qt::SizeVerCursor},
};

// Never destroyed, like the table.
PointerSet& tableRecords()
{
    static auto* sRecords = new PointerSet;
    return *sRecords;
}

CursPtr* addRecord(std::map<SInt16, CursPtr*>& map, SInt16 id, const QCursor& cursor)
{
    auto* record = new CursPtr(cursor);
    tableRecords().insert(record);
    map[id] = record;
    return record;
}

// Window activation resets the cursor from now on.
void installCursorHooks()
{
    ApplicationHooks hooks = applicationHooks();
    hooks.initCursor = InitCursor;
    SetApplicationHooks(hooks);
}

CursPtr* lookUp(std::map<SInt16, CursPtr*>& map, QLatin1String prefix, SInt16 id)
{
    if (auto it = map.find(id); it != map.end())
        return it->second;
    const qreal ratio = qGuiApp ? qGuiApp->devicePixelRatio() : 1.0;
    return addRecord(map, id, loadCursorPicture(prefix, id, ratio));
}

} // namespace

namespace Private {

CursorTable& cursorTable()
{
    static CursorTable* sTable = [] {
        registerCursorPictures();
        auto* table = new CursorTable;
        for (const BuiltIn& entry : kBuiltIns) {
            addRecord(table->blackAndWhite, entry.id, QCursor(entry.shape));
            addRecord(table->colour, entry.id, QCursor(entry.shape));
        }
        installCursorHooks();
        return table;
    }();
    return *sTable;
}

bool isTableCursor(const CursPtr* cursor)
{
    return tableRecords().contains(cursor);
}

} // namespace Private

CursPtr* GetCursor(SInt16 id)
{
    return lookUp(cursorTable().blackAndWhite, kBlackAndWhiteCursorPrefix, id);
}

CursPtr* GetCCursor(SInt16 id)
{
    return lookUp(cursorTable().colour, kColourCursorPrefix, id);
}

void DisposeCCursor(CursPtr* cursor)
{
    if (VELMAR_CHECK_CURSOR(cursor))
        cursor->Release();
}

} // namespace Velmar
