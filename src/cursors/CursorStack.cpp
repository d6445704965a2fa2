// Setting, hiding and obscuring the cursor: every call is a push or a pop on Qt's
// application override-cursor stack, the table keeping only whether the cursor is hidden or
// obscured.
#include "cursors/CursorPrivate.h"

#include <QGuiApplication>

namespace Velmar {

using namespace Private;

namespace {

bool sameShape(const QCursor& a, const QCursor& b)
{
    return a.shape() != Qt::BitmapCursor && a.shape() == b.shape();
}

void popOverrideCursor()
{
    QGuiApplication::restoreOverrideCursor(); // nothing when the stack is empty
    cursorTable().setCursorOnTop = false;
}

void pushOverrideCursor(const QCursor& cursor)
{
    QGuiApplication::setOverrideCursor(cursor);
    cursorTable().setCursorOnTop = false;
}

} // namespace

void SetCCursor(CursPtr* cursor)
{
    if (!VELMAR_CHECK_CURSOR(cursor))
        return;
    cursorTable(); // a host's first cursor call installs the activation hook
    const QCursor wanted = cursor->getCursor();
    // Hosts set the cursor on every mouse move: the same shape again must not grow the stack.
    const QCursor* showing = QGuiApplication::overrideCursor();
    if (showing && sameShape(*showing, wanted))
        return;
    CursorTable& table = cursorTable();
    if (showing && table.setCursorOnTop) {
        QGuiApplication::changeOverrideCursor(wanted);
        return;
    }
    pushOverrideCursor(wanted);
    table.setCursorOnTop = true;
}

void HideCursor()
{
    CursorTable& table = cursorTable();
    if (table.hidden)
        return;
    pushOverrideCursor(QCursor(Qt::BlankCursor));
    table.hidden = true;
}

void ObscureCursor()
{
    pushOverrideCursor(QCursor(Qt::BlankCursor));
    cursorTable().obscured = true;
}

void ShowCursor()
{
    CursorTable& table = cursorTable();
    if (!table.hidden && !table.obscured)
        return;
    popOverrideCursor();
    table.hidden = false;
    table.obscured = false;
}

void RestoreObscuredCursor()
{
    if (cursorTable().obscured)
        ShowCursor();
}

Boolean CursorObscured()
{
    return cursorTable().obscured;
}

void InitCursor()
{
    RemoveOverrideCursor();
    ShowCursor();
}

void RemoveOverrideCursor()
{
    cursorTable(); // the first cursor call of a host installs the activation hook
    while (QGuiApplication::overrideCursor())
        popOverrideCursor();
}

AutoRestoreCursor::AutoRestoreCursor()
{
    cursorTable().setCursorOnTop = false;
}

AutoRestoreCursor::~AutoRestoreCursor()
{
    popOverrideCursor();
}

} // namespace Velmar
