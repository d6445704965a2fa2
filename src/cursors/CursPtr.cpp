// The cursor record: a counted, registered owner of one QCursor.
#include "cursors/CursorPrivate.h"

namespace Velmar {

using namespace Private;

CursPtr::CursPtr(const QCursor& cursor) : m_cursor(new QCursor(cursor))
{
    LiveHandles<CursPtr>::instance().add(this);
}

CursPtr::~CursPtr()
{
    LiveHandles<CursPtr>::instance().remove(this);
    delete m_cursor;
}

SInt32 CursPtr::AddRef()
{
    if (!VELMAR_CHECK_CURSOR(this))
        return 0;
    return ++m_refCount;
}

SInt32 CursPtr::Release()
{
    if (!VELMAR_CHECK_CURSOR(this))
        return 0;
    // The table hands its records out without counting, so a host may release one more
    // time than it added: the table's own reference stays.
    if (m_refCount == 1 && isTableCursor(this))
        return m_refCount;
    const SInt32 count = --m_refCount;
    if (count == 0)
        delete this;
    return count;
}

void CursPtr::setCursor(const QCursor& cursor)
{
    if (!VELMAR_CHECK_CURSOR(this))
        return;
    *m_cursor = cursor;
}

QCursor CursPtr::getCursor() const
{
    if (!VELMAR_CHECK_CURSOR(this))
        return QCursor();
    return *m_cursor;
}

} // namespace Velmar
