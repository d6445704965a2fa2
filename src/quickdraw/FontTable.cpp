// The font table: fixed rows for the classic IDs, then every family the font database
// reports. Built on first use once an application exists; until then only the fixed rows
// answer (with the generic families).
#include "quickdraw/FontTable.h"

#include <Velmar/Diagnostics.h>

#include <QFontDatabase>
#include <QGuiApplication>

#include <vector>

namespace Velmar::Private {

namespace {

struct FixedRow {
    SInt16 id;
    const char* toolboxName;
    const char* family; // null: the system (row 0) or the application (row 1) family
    int hint; // QFont::StyleHint; the decorative hints on the Arial rows are kept
};

constexpr FixedRow kFixedRows[] = {
    {0, "systemFont", nullptr, 4},
    {1, "applFont", nullptr, 3},
    {2, "newYork", "Times New Roman", 1},
    {3, "geneva", "Arial", 3},
    {4, "monaco", "Courier New", 2},
    {5, "venice", "Times New Roman", 1},
    {6, "london", "Times New Roman", 1},
    {7, "athens", "Times New Roman", 1},
    {8, "sanFran", "Times New Roman", 1},
    {9, "toronto", "Times New Roman", 1},
    {11, "cairo", "Wingdings", 3},
    {12, "losAngeles", "Times New Roman", 1},
    {20, "times", "Times New Roman", 1},
    {21, "helvetica", "Arial", 3},
    {22, "courier", "Courier", 2},
    {23, "symbol", "Symbol", 3},
    {24, "taliesin", "Wingdings", 3},
    {128, "MS Serif", "MS Serif", 1},
    {129, "Tms Rmn", "Times New Roman", 1},
    {130, "Times", "Times New Roman", 1},
    {131, "MS Sans Serif", "MS Sans Serif", 0},
    {132, "Helv", "MS Sans Serif", 0},
    {133, "Helvetica", "Helvetica", 0},
    {134, "Courier", "Courier", 2},
    {135, "Modern", "Modern", 3},
    {136, "Roman", "Roman", 1},
    {137, "Script", "Script", 1},
    {138, "Terminal", "Courier New", 3},
    {139, "Arial", "Arial", 1},
    {140, "Times New Roman", "Times New Roman", 1},
    {141, "Courier New", "Courier New", 3},
};

QString systemFamily()
{
    return QFontDatabase::systemFont(QFontDatabase::GeneralFont).family();
}

std::vector<FontRow> makeRows(bool withDatabase)
{
    std::vector<FontRow> rows;
    rows.reserve(std::size(kFixedRows) + 64);
    for (const FixedRow& f : kFixedRows) {
        QString family;
        if (f.family)
            family = QString::fromLatin1(f.family);
        else if (withDatabase)
            family = f.id == 0 ? systemFamily() : QGuiApplication::font().family();
        rows.push_back(
            {f.id, QString::fromLatin1(f.toolboxName), family, QFont::StyleHint(f.hint)});
    }
    if (withDatabase) {
        SInt16 next = kFirstAddedFontId;
        for (const QString& family : QFontDatabase::families()) {
            if (next == INT16_MAX)
                break;
            rows.push_back({next++, family, family, QFont::AnyStyle});
        }
    }
    return rows;
}

const std::vector<FontRow>& rows()
{
    static std::vector<FontRow> sComplete;
    static std::vector<FontRow> sFixedOnly;
    if (!sComplete.empty())
        return sComplete;
    if (qGuiApp) {
        sComplete = makeRows(true);
        return sComplete;
    }
    if (sFixedOnly.empty())
        sFixedOnly = makeRows(false);
    return sFixedOnly;
}

} // namespace

const FontRow* findFontRow(SInt16 id)
{
    for (const FontRow& row : rows()) {
        if (row.id == id)
            return &row;
    }
    return nullptr;
}

const FontRow* fontRowById(SInt16 id)
{
    const FontRow* row = findFontRow(id);
    if (!row)
        VelmarLog(kLogQuickDraw, "getFontName(): Unknown font ID - %d", id);
    return row;
}

SInt16 fontIdByToolboxName(const QString& name)
{
    const auto& all = rows();
    for (const FontRow& row : all) {
        if (row.toolboxName == name)
            return row.id;
    }
    for (const FontRow& row : all) {
        if (row.toolboxName.compare(name, Qt::CaseInsensitive) == 0)
            return row.id;
    }
    return -1;
}

SInt16 fontIdByFamily(const QString& family)
{
    for (const FontRow& row : rows()) {
        if (row.family.compare(family, Qt::CaseInsensitive) == 0)
            return row.id;
    }
    return -1;
}

int fontRowCount()
{
    return int(rows().size());
}

const FontRow& fontRowAt(int index)
{
    return rows().at(size_t(index));
}

} // namespace Velmar::Private
