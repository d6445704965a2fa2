// The live menus, the menu list, reference counts and item look-up.
#include "menus/MenuPrivate.h"
#include "foundation/Lifetime.h"

#include <Velmar/Application.h>

#include <QMenuBar>

#include <string>

namespace Velmar {

const char* const kMenuItemManagedInside = "MenuItemManagedInside";

namespace Private {

namespace {

// Items that are not connected to the application themselves (plain items, font lists)
// report through the menu that holds them; every other menu the choice passes through on
// its way up is not theirs.
void reportPlainItem(QMenu* menu, QAction* action)
{
    if (!action || action->isSeparator() || action->menu())
        return;
    if (action->property(kMenuItemManagedInside).toBool() || !menu->actions().contains(action))
        return;
    if (AQtApplication* app = AQtApplication::instance())
        app->onMenuBarTriggered(action);
}

} // namespace

std::map<SInt16, QMenu*>& menuMap()
{
    static std::map<SInt16, QMenu*> sMap;
    return sMap;
}

void registerMenu(QMenu* menu)
{
    if (!menu || isLive(menu))
        return;
    LiveHandles<QMenu>::instance().add(menu);
    QObject::connect(menu, &QObject::destroyed, [menu] {
        LiveHandles<QMenu>::instance().remove(menu);
        auto& map = menuMap();
        for (auto it = map.begin(); it != map.end();)
            it = it->second == menu ? map.erase(it) : std::next(it);
    });
    QObject::connect(
        menu, &QMenu::triggered, menu, [menu](QAction* action) { reportPlainItem(menu, action); });
    if (AQtApplication* app = AQtApplication::instance())
        QObject::connect(menu, &QMenu::aboutToShow, app, &AQtApplication::onMenuAboutToShow);
    installMenuHooks();
}

void destroyMenu(QMenu* menu)
{
    LiveHandles<QMenu>::instance().remove(menu);
    // A menu that is showing runs Qt's own loop, and a pop-up call holds its menu: it goes
    // when they are done with it.
    if (menu->isVisible() || isKeptAlive(menu)) {
        menu->hide();
        deleteWhenFree(menu);
    } else {
        delete menu;
    }
}

QAction* GetItemAction(MenuRef menu, int item)
{
    if (!menu || item < 1 || !isLive(menu.get()))
        return nullptr;
    const QList<QAction*> actions = menu->actions();
    return item <= actions.size() ? actions.at(item - 1) : nullptr;
}

int RefCount(MenuRef menu)
{
    const int count = menu->property(kMenuRefCountProperty).toInt();
    VELMAR_ASSERT(count >= 0, "refcnt >= 0");
    return count;
}

int AddRef(MenuRef menu)
{
    const int count = menu->property(kMenuRefCountProperty).toInt();
    VELMAR_ASSERT(count >= 0, "refcnt >= 0");
    menu->setProperty(kMenuRefCountProperty, count + 1);
    return count + 1;
}

int Release(MenuRef menu)
{
    const int count = menu->property(kMenuRefCountProperty).toInt();
    VELMAR_ASSERT(count > 0, "refcnt > 0");
    menu->setProperty(kMenuRefCountProperty, count - 1);
    return count - 1;
}

void throwOutOfRange(const char* function, const char* argument, int value)
{
    throw std::out_of_range(std::string("Out of range in ") + function + ": " + argument
        + "==" + std::to_string(value));
}

void connectManagedItem(QAction* action)
{
    action->setProperty(kMenuItemManagedInside, true);
    if (AQtApplication* app = AQtApplication::instance())
        QObject::connect(action, &QAction::triggered, app, &AQtApplication::onMenuItemTriggered);
}

} // namespace Private

} // namespace Velmar
