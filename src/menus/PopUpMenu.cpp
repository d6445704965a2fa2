// Pop-up menus: QMenu::exec, or the scrolling list for menus too long for the screen.
#include "menus/MenuPrivate.h"
#include "menus/QMenuListPopup.h"
#include "foundation/Lifetime.h"

#include <Velmar/Application.h>
#include <Velmar/HostCore.h>

#include <QFontMetrics>

#include <memory>

namespace Velmar {

using namespace Private;

namespace {

// "PopupMenuIsExecuting" holds the menu for exactly as long as the pop-up runs, so that its
// choice is not also taken for a menu-bar choice.
class PopupMenuScope {
public:
    explicit PopupMenuScope(QMenu* menu) : m_app(AQtApplication::instance())
    {
        if (m_app)
            m_app->setProperty(
                PopupMenuIsExecuting, QVariant::fromValue(static_cast<QWidget*>(menu)));
    }
    ~PopupMenuScope()
    {
        if (m_app)
            m_app->setProperty(PopupMenuIsExecuting, QVariant());
    }
    PopupMenuScope(const PopupMenuScope&) = delete;
    PopupMenuScope& operator=(const PopupMenuScope&) = delete;

private:
    AQtApplication* m_app;
};

} // namespace

namespace Private {

bool NeedsListPopup(const QPoint& point, QMenu* menu)
{
    ApplyMenuFont(menu);
    const QList<QAction*> actions = menu->actions();
    const AScreenManOS* screens = AScreenManOS::Get();
    const int height = screens->GetUsableRect(screens->GetScreenForPoint(point)).height();
    const int lineHeight = std::max(1, QFontMetrics(menu->font()).lineSpacing());
    if (actions.size() <= height / lineHeight)
        return false;
    // Menus with separators or submenus stay menus however long they are.
    for (const QAction* action : actions) {
        if (action->isSeparator() || action->menu())
            return false;
    }
    return true;
}

} // namespace Private

SInt32 PopUpMenuSelect(
    MenuRef menu, SInt16 top, SInt16 left, UInt16 popUpItem, Boolean sortList, Boolean allowList)
{
    if (!menu || !VELMAR_CHECK_MENU(menu))
        return 0;
    if (menu->actions().isEmpty() && popUpItem == 0)
        return 0;
    QAction* placed = GetItemAction(menu, popUpItem == 0 ? 1 : popUpItem);
    if (!placed)
        throwOutOfRange("Velmar::PopUpMenuSelect", "popUpItem", popUpItem);

    const QPoint at(left, top);
    // Host code may run while the pop-up shows (timers, handlers) and dispose of the menu or
    // its items: the menu stays until this call is done, a deleted item is no choice.
    KeepAlive keep(menu.get());
    QPointer<QMenu> guard(menu.get());
    QPointer<QAction> chosen;
    {
        PopupMenuScope scope(menu);
        if (allowList && NeedsListPopup(at, menu)) {
            auto popup = std::make_unique<QMenuListPopup>(menu, sortList != 0);
            chosen = popup->run(at);
        } else {
            chosen = menu->exec(at, placed);
        }
    }
    // The host may have disposed of the menu from inside the pop-up's loop.
    if (!guard || !chosen || !isLive(guard.data()))
        return 0;
    return CalculateMenuSelectInfo(chosen);
}

} // namespace Velmar
