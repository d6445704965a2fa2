// Tool tips on QToolTip for one parent window, shown only where the user sees that window.
#include <Velmar/AQtWindow.h>
#include <Velmar/Cursors.h>
#include <Velmar/TextUtils.h>

#include "foundation/Conversions.h"
#include "windows/WindowPrivate.h"

#include <QApplication>
#include <QPointer>
#include <QToolTip>

namespace Velmar {

using namespace Private;

namespace {

// Guarded: it forgets the window when the window goes. Never destroyed.
QPointer<AQtWindow>& toolTipParent()
{
    static auto* sParent = new QPointer<AQtWindow>;
    return *sParent;
}

// Qt's visible region knows nothing of other top-level windows, so the window system is
// asked as well: the top-level window at the point must be the parent's own. A tool tip
// there (the last one shown, usually) does not count as covering the parent.
bool parentShowsAt(AQtWindow* parent, const QPoint& global)
{
    if (!parent->visibleRegion().contains(parent->mapFromGlobal(global)))
        return false;
    const QWidget* top = QApplication::topLevelAt(global);
    return top && (top == parent->window() || top->windowType() == Qt::ToolTip);
}

} // namespace

void ShowToolTip(int h, int v, const char* text)
{
    AQtWindow* parent = toolTipParent();
    if (!parent || parent->IsDeletePending() || !QApplication::activeWindow())
        return;
    const QPoint global(clampFar(h), clampFar(v));
    if (parentShowsAt(parent, global))
        QToolTip::showText(global, MakeQString(text, -1), parent);
}

void HideToolTip(bool destroy)
{
    if (!destroy) {
        QToolTip::hideText();
        return;
    }
    for (QWidget* widget : QApplication::topLevelWidgets()) {
        if (qstrcmp(widget->metaObject()->className(), "QTipLabel") == 0) {
            widget->close();
            deleteWhenFree(widget);
        }
    }
}

void SetToolTipParent(WindowRef window)
{
    // A disposed window is forgotten as null is (a freed one raises the assertion too).
    toolTipParent() = VELMAR_CHECK_WINDOW(window.get()) ? window.get() : nullptr;
}

} // namespace Velmar
