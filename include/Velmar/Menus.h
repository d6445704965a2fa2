// The Menu Manager: menus identified by a 16-bit ID, items by a 1-based number, on QMenu
// and QAction; the application's one QMenuBar is the menu bar. A menu choice is one 32-bit
// value: the menu ID in the high 16 bits, the item in the low 16 bits, 0 for none.
#pragma once

#include <Velmar/Events.h>
#include <Velmar/MacErrors.h>
#include <Velmar/MacTypes.h>

#include <map>

class QAction;
class QMenu;
class QWidget;

namespace Velmar {

// A menu: one QMenu* (null for none), passed by value. Menus are counted: NewMenu gives 1,
// InsertMenu adds one, DeleteMenu and DisposeMenu take one away, and the QMenu goes at 0.
// Calls refuse (with an assertion) a menu that is gone or that the library never made; a
// QMenu the host made itself is accepted once it is adopted with AdoptMenu.
class MenuRef {
public:
    MenuRef(QMenu* menu = nullptr) : m_menu(menu) {} // NOLINT: converts like the Qt pointer
    operator QMenu*() const { return m_menu; } // NOLINT
    QMenu* operator->() const { return m_menu; }
    QMenu* get() const { return m_menu; }

private:
    QMenu* m_menu;
};
using MenuHandle = MenuRef;

// Name of the action property that marks items made from item strings (InsertMenuItem,
// AppendMenu): only those are touched by EnableAllMenuItems / DisableAllMenuItems.
VELMAR_EXPORT extern const char* const kMenuItemManagedInside;

// Item command values with a meaning of their own (SetItemCmd).
enum : SInt16 {
    hMenuCmd = 27, // hierarchical: the item's mark holds the submenu's ID
    kMenuSmallIconCmd = 30, // the item's icon is a small ('SICN') icon
};

// Menu-item modifier bits (SetMenuItemModifiers).
enum : UInt8 {
    kMenuShiftModifier = 1,
    kMenuOptionModifier = 2,
    kMenuControlModifier = 4,
    kMenuNoCommandModifier = 8,
};

// ---- Menus and the menu list ----------------------------------------------------------
VELMAR_EXPORT MenuRef NewMenu(SInt16 menuID, const unsigned char* title);
VELMAR_EXPORT void DisposeMenu(MenuRef menu);
// beforeID 0 appends, -1 keeps the menu out of the bar (hierarchical and pop-up menus).
VELMAR_EXPORT void InsertMenu(MenuRef menu, SInt16 beforeID);
VELMAR_EXPORT void DeleteMenu(SInt16 menuID);
VELMAR_EXPORT MenuRef GetMenuHandle(SInt16 menuID);
// The menu of the list, or a newly built menu for the IDs the library knows (not listed).
VELMAR_EXPORT MenuRef GetMenu(SInt16 resourceID);
VELMAR_EXPORT MenuRef CreateDumbResourceMenu(SInt16 menuID);
VELMAR_EXPORT bool IsInMenuList(MenuRef menu);
VELMAR_EXPORT SInt16 GetMenuID(MenuRef menu);
VELMAR_EXPORT void SetMenuID(MenuRef menu, SInt16 menuID);
VELMAR_EXPORT unsigned char* GetMenuTitle(MenuRef menu, unsigned char* title);
VELMAR_EXPORT OSStatus DuplicateMenu(MenuRef source, MenuRef* copy);
VELMAR_EXPORT UInt16 CountMenuItems(MenuRef menu);
VELMAR_EXPORT SInt16 GetMenuHeight(MenuRef menu);
VELMAR_EXPORT SInt16 GetMenuWidth(MenuRef menu);
VELMAR_EXPORT void CalcMenuSize(MenuRef menu);
VELMAR_EXPORT void HiliteMenu(SInt16 menuID);
VELMAR_EXPORT const std::map<SInt16, QMenu*>* GetMenuMapPtr();
// Lets the Toolbox calls accept a QMenu the host made itself (count 1, not listed).
VELMAR_EXPORT MenuRef AdoptMenu(QMenu* menu);

// ---- Items ------------------------------------------------------------------------------
// Item strings: items separated by ';', '(' disables, a leading '-' makes a separator. The
// characters ! < / ^ are dropped (marks, styles, keys and icons have calls of their own).
VELMAR_EXPORT void AppendMenu(MenuRef menu, const unsigned char* data);
VELMAR_EXPORT void InsertMenuItem(MenuRef menu, const unsigned char* data, SInt16 afterItem);
VELMAR_EXPORT void AppendMenuItemText(MenuRef menu, const unsigned char* text);
VELMAR_EXPORT void DeleteMenuItem(MenuRef menu, UInt16 item);
VELMAR_EXPORT void GetMenuItemText(MenuRef menu, UInt16 item, unsigned char* text);
// A leading NUL before a '-' escapes it: the item shows the dash and is no separator.
VELMAR_EXPORT void SetMenuItemText(MenuRef menu, UInt16 item, const unsigned char* text);
VELMAR_EXPORT void GetItemStyle(MenuRef menu, UInt16 item, unsigned char* style);
VELMAR_EXPORT void SetItemStyle(MenuRef menu, UInt16 item, SInt16 style);
VELMAR_EXPORT void GetItemMark(MenuRef menu, UInt16 item, SInt16* mark);
VELMAR_EXPORT void SetItemMark(MenuRef menu, UInt16 item, SInt16 mark);
VELMAR_EXPORT void CheckMenuItem(MenuRef menu, SInt16 item, Boolean checked);
VELMAR_EXPORT void GetItemCmd(MenuRef menu, UInt16 item, SInt16* cmd);
VELMAR_EXPORT void SetItemCmd(MenuRef menu, UInt16 item, SInt16 cmd);
VELMAR_EXPORT OSErr GetMenuItemModifiers(MenuRef menu, UInt16 item, UInt8* modifiers);
VELMAR_EXPORT OSErr SetMenuItemModifiers(MenuRef menu, UInt16 item, UInt8 modifiers);
VELMAR_EXPORT void GetItemIcon(MenuRef menu, UInt16 item, SInt16* icon);
// The icon is resource icon + 256: a small icon for items whose command is 30, else a
// colour icon or, failing that, a black-and-white one.
VELMAR_EXPORT void SetItemIcon(MenuRef menu, UInt16 item, SInt16 icon);
// Item 0 stands for the whole menu.
VELMAR_EXPORT void EnableMenuItem(MenuRef menu, UInt16 item);
VELMAR_EXPORT void DisableMenuItem(MenuRef menu, UInt16 item);
// Throws std::out_of_range for an item that does not exist.
VELMAR_EXPORT Boolean IsMenuItemEnabled(MenuRef menu, UInt16 item);
VELMAR_EXPORT void EnableAllMenuItems(MenuRef menu);
VELMAR_EXPORT void DisableAllMenuItems(MenuRef menu);
VELMAR_EXPORT Boolean MenuHasEnabledItems(MenuRef menu);
VELMAR_EXPORT OSStatus GetMenuItemHierarchicalMenu(MenuRef menu, UInt16 item, MenuRef* submenu);
// 'FONT' appends the font families; other types append a disabled explanation.
VELMAR_EXPORT void AppendResMenu(MenuRef menu, ResType type);

// ---- Fonts ----------------------------------------------------------------------------
VELMAR_EXPORT OSStatus SetMenuFont(MenuRef menu, SInt16 fontID, UInt16 size);
VELMAR_EXPORT void SetGlobalMenuFontSize(SInt16 size);
VELMAR_EXPORT SInt16 GetGlobalMenuFontSize();
VELMAR_EXPORT void SetGlobalMenuFontFamily(SInt16 fontID);
VELMAR_EXPORT SInt16 GetGlobalMenuFontFamily();

// ---- Choosing ---------------------------------------------------------------------------
// The choice made in the menu bar since the last call (once), or 0. The point is ignored:
// Qt tracks the menu bar itself, and the choice arrives as a kEventVelmarMenuTriggered event.
VELMAR_EXPORT SInt32 MenuSelect(Point startPt);
// The first enabled item whose command key is Control + ch (Control plays the command key).
VELMAR_EXPORT SInt32 MenuKey(SInt16 ch);
VELMAR_EXPORT UInt32 MenuEvent(const EventRecord* event);
// allowList lets a menu too long for the screen show as a scrolling list, sorted when
// sortList is set. Throws std::out_of_range when popUpItem does not exist.
VELMAR_EXPORT SInt32 PopUpMenuSelect(MenuRef menu, SInt16 top, SInt16 left, UInt16 popUpItem,
    Boolean sortList = 0, Boolean allowList = 0);

// ---- Where the menu bar lives -------------------------------------------------------------
// By default the menu bar is a strip across the top of the primary screen, shown once it
// holds a menu (GetMBarHeight gives its height). With a window, the bar moves into it (a
// QMainWindow's menu bar, or the top of the window's layout); null brings the strip back.
VELMAR_EXPORT void SetMenuBarWindow(QWidget* window);

} // namespace Velmar
