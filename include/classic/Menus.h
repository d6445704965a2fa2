/* The Menu Manager: menus from 'MENU' and 'MBAR' resources, items, choosing. */
#ifndef VELMAR_CLASSIC_MENUS_H
#define VELMAR_CLASSIC_MENUS_H
#include "Types.h"
#include "Quickdraw.h"
VELMAR_CLASSIC_BEGIN

enum { noMark = 0, checkMark = 0x12, diamondMark = 0x13, appleMark = 0x14 };
enum { hierMenu = -1 };

/* The classic record; menuID and menuData (the title) are kept in step with the menu. */
typedef struct MenuInfo {
    short menuID;
    short menuWidth;
    short menuHeight;
    Handle menuProc;
    long enableFlags;
    Str255 menuData;
} MenuInfo;
typedef MenuInfo* MenuPtr;
typedef MenuPtr* MenuHandle;
typedef MenuHandle MenuRef;

VELMAR_CLASSIC_API void InitMenus(void);
VELMAR_CLASSIC_API MenuHandle NewMenu(short menuID, ConstStr255Param menuTitle);
VELMAR_CLASSIC_API MenuHandle GetMenu(short resourceID);
VELMAR_CLASSIC_API void DisposeMenu(MenuHandle theMenu);
VELMAR_CLASSIC_API void InsertMenu(MenuHandle theMenu, short beforeID);
VELMAR_CLASSIC_API void DeleteMenu(short menuID);
VELMAR_CLASSIC_API void ClearMenuBar(void);
VELMAR_CLASSIC_API void DrawMenuBar(void);
VELMAR_CLASSIC_API void InvalMenuBar(void);
VELMAR_CLASSIC_API Handle GetNewMBar(short menuBarID);
VELMAR_CLASSIC_API Handle GetMenuBar(void);
VELMAR_CLASSIC_API void SetMenuBar(Handle menuList);
VELMAR_CLASSIC_API MenuHandle GetMHandle(short menuID);
VELMAR_CLASSIC_API MenuHandle GetMenuHandle(short menuID);
VELMAR_CLASSIC_API void AppendMenu(MenuHandle menu, ConstStr255Param data);
VELMAR_CLASSIC_API void InsMenuItem(MenuHandle theMenu, ConstStr255Param itemString,
                                    short afterItem);
VELMAR_CLASSIC_API void DelMenuItem(MenuHandle theMenu, short item);
VELMAR_CLASSIC_API void AddResMenu(MenuHandle theMenu, ResType theType);
VELMAR_CLASSIC_API void AppendResMenu(MenuHandle theMenu, ResType theType);
VELMAR_CLASSIC_API void InsertResMenu(MenuHandle theMenu, ResType theType, short afterItem);
VELMAR_CLASSIC_API void GetItem(MenuHandle theMenu, short item, Str255 itemString);
VELMAR_CLASSIC_API void SetItem(MenuHandle theMenu, short item, ConstStr255Param itemString);
VELMAR_CLASSIC_API void EnableItem(MenuHandle theMenu, short item);
VELMAR_CLASSIC_API void DisableItem(MenuHandle theMenu, short item);
VELMAR_CLASSIC_API void CheckItem(MenuHandle theMenu, short item, Boolean checked);
VELMAR_CLASSIC_API void SetItemMark(MenuHandle theMenu, short item, CharParameter markChar);
VELMAR_CLASSIC_API void GetItemMark(MenuHandle theMenu, short item, CharParameter* markChar);
VELMAR_CLASSIC_API void SetItemCmd(MenuHandle theMenu, short item, CharParameter cmdChar);
VELMAR_CLASSIC_API void GetItemCmd(MenuHandle theMenu, short item, CharParameter* cmdChar);
VELMAR_CLASSIC_API void SetItemStyle(MenuHandle theMenu, short item, StyleParameter chStyle);
VELMAR_CLASSIC_API short CountMItems(MenuHandle theMenu);
VELMAR_CLASSIC_API long MenuSelect(Point startPt);
VELMAR_CLASSIC_API long MenuKey(CharParameter ch);
VELMAR_CLASSIC_API void HiliteMenu(short menuID);
VELMAR_CLASSIC_API void FlashMenuBar(short menuID);

/* Later names of the same calls. */
#if !defined(VELMAR_CLASSIC_IMPLEMENTATION)
#define GetMenuItemText GetItem
#define SetMenuItemText SetItem
#define EnableMenuItem EnableItem
#define DisableMenuItem DisableItem
#define CheckMenuItem CheckItem
#define CountMenuItems CountMItems
#define InsertMenuItem InsMenuItem
#define DeleteMenuItem DelMenuItem
#endif

VELMAR_CLASSIC_END
#endif
