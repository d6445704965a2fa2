// What the menu calls share: property names, the menu list, item look-up, reference counts,
// the live-menu check and the pieces the application object reaches through its hooks.
#pragma once

#include <Velmar/Menus.h>

#include "foundation/LiveHandles.h"

#include <QAction>
#include <QMenu>
#include <QMenuBar>

#include <map>
#include <stdexcept>

namespace Velmar::Private {

// Dynamic properties kept on menus and items, under their fixed names.
inline constexpr const char* kMenuIdProperty = "MenuID";
inline constexpr const char* kMenuRefCountProperty = "MenuRefCount";
inline constexpr const char* kMenuCustomFontProperty = "MenuCustomFont";
inline constexpr const char* kMenuDefinitionProperty = "MDEF";
inline constexpr const char* kMenuSelectedItemProperty = "selecteditem";
inline constexpr const char* kItemCmdProperty = "MenuItemCmd";
inline constexpr const char* kItemMarkProperty = "MenuItemMark";
inline constexpr const char* kItemModifiersProperty = "MenuItemModifiers";
inline constexpr const char* kItemIconProperty = "iconIndex";

// The menu list: menu ID to menu, ascending, holding exactly the inserted menus.
std::map<SInt16, QMenu*>& menuMap();

// A menu the calls may touch: live (made or adopted by the library). Null gives false
// quietly (each call decides what null means); a dead or foreign menu raises the assertion
// "IsValidMenu(menu)" and gives false.
#define VELMAR_CHECK_MENU(menu) VELMAR_LIVE((menu).get(), "IsValidMenu(menu)")

// Registers a menu the library made or adopted; it leaves the registry, the menu list and
// the menu bar when it is destroyed.
void registerMenu(QMenu* menu);
// Deletes a menu now, or once it has closed when it is showing.
void destroyMenu(QMenu* menu);

// The action of a 1-based item, or null for item 0, items past the end and dead menus.
QAction* GetItemAction(MenuRef menu, int item);
// Like GetItemAction, for calls that say nothing about a missing item.
inline QAction* itemOf(MenuRef menu, int item)
{
    return VELMAR_CHECK_MENU(menu) ? GetItemAction(menu, item) : nullptr;
}

int RefCount(MenuRef menu);
int AddRef(MenuRef menu);
int Release(MenuRef menu);

// Integer properties, 0 when absent.
inline SInt16 shortProperty(const QObject* object, const char* name)
{
    return SInt16(object->property(name).toInt());
}
inline SInt16 itemCmd(const QAction* action)
{
    return shortProperty(action, kItemCmdProperty);
}
inline SInt16 itemMark(const QAction* action)
{
    return shortProperty(action, kItemMarkProperty);
}

void InsertMenuToMenuBar(MenuRef menu, SInt16 beforeID);
void CheckMenuItem(QAction* action, bool checked);
void UpdateShortcut(MenuRef menu, UInt16 item);
SInt32 CalculateMenuSelectInfo(QAction* action);
SInt32 FindEnabledItemByShortcut(const QKeySequence& sequence);
// A command key as a shortcut: the Mac's command key is the Control key here, option is Alt.
QKeySequence commandShortcut(bool command, bool option, bool shift, char key);
// The application's menu bar; null without an application.
QMenuBar* applicationMenuBar();
bool NeedsListPopup(const QPoint& point, QMenu* menu);
void ApplyMenuFont(QMenu* menu);
void RelinkSubmenus(QMenu* menu);
MenuRef CreateUnknownMenu(SInt16 menuID);

// The pending menu choice, recorded when a menu-bar item fires.
void recordMenuChoice(QAction* action);

// Connects an item to the application as items from item strings are.
void connectManagedItem(QAction* action);

// "Out of range in <function>: <argument>==<value>".
[[noreturn]] void throwOutOfRange(const char* function, const char* argument, int value);

// Installs the application hooks (choice, refresh, font) once.
void installMenuHooks();

// Shows the menu bar where it lives, once it has a menu.
void placeMenuBarOnce();

} // namespace Velmar::Private
