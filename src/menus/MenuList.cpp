// Menus and the menu list.
#include "menus/MenuPrivate.h"

#include <Velmar/Application.h>
#include <Velmar/MacErrors.h>
#include <Velmar/TextUtils.h>

#include <QMenuBar>

namespace Velmar {

using namespace Private;

namespace {

// The ID a menu carries, without the list check (for menus known to be alive).
SInt16 carriedId(const QMenu* menu)
{
    return shortProperty(menu, kMenuIdProperty);
}

MenuRef newMenu(SInt16 menuID, const QString& title)
{
    auto* menu = new QMenu(title);
    registerMenu(menu);
    VELMAR_ASSERT(AddRef(menu) == 1, "Private::RefCount(menu) == 1");
    SetMenuID(menu, menuID);
    return menu;
}

} // namespace

namespace Private {

QMenuBar* applicationMenuBar()
{
    AQtApplication* app = AQtApplication::instance();
    return app ? app->menuBar() : nullptr;
}

void InsertMenuToMenuBar(MenuRef menu, SInt16 beforeID)
{
    if (beforeID == -1)
        return;
    QMenuBar* bar = applicationMenuBar();
    if (!bar)
        return;
    if (beforeID == 0)
        beforeID = kMenuBarAnchorID;
    const auto& map = menuMap();
    const auto before = map.find(beforeID);
    if (before != map.end()) {
        bar->insertMenu(before->second->menuAction(), menu);
    } else {
        VELMAR_ASSERT(
            false, "false && \"Velmar::Private::InsertMenuToMenuBar: Should not be here\"");
        bar->addMenu(menu);
    }
    placeMenuBarOnce();
}

} // namespace Private

MenuRef NewMenu(SInt16 menuID, const unsigned char* title)
{
    return newMenu(menuID, PascalString2QString(title));
}

MenuRef AdoptMenu(QMenu* menu)
{
    if (menu && !isLive(menu)) {
        registerMenu(menu);
        if (RefCount(menu) == 0)
            AddRef(menu);
    }
    return menu;
}

void DisposeMenu(MenuRef menu)
{
    if (!menu || !VELMAR_CHECK_MENU(menu))
        return;
    if (Release(menu) == 0)
        destroyMenu(menu);
}

void InsertMenu(MenuRef menu, SInt16 beforeID)
{
    if (!VELMAR_ASSERT(menu, "menu") || !VELMAR_CHECK_MENU(menu))
        return;
    AddRef(menu);
    // A menu listed under the same ID before is replaced without being released.
    menuMap()[GetMenuID(menu)] = menu;
    InsertMenuToMenuBar(menu, beforeID);
}

void DeleteMenu(SInt16 menuID)
{
    auto& map = menuMap();
    const auto it = map.find(menuID);
    if (it == map.end())
        return;
    QMenu* menu = it->second;
    if (QMenuBar* bar = applicationMenuBar())
        bar->removeAction(menu->menuAction());
    map.erase(it);
    DisposeMenu(menu);
}

MenuRef GetMenuHandle(SInt16 menuID)
{
    const auto& map = menuMap();
    const auto it = map.find(menuID);
    return it == map.end() ? nullptr : it->second;
}

MenuRef GetMenu(SInt16 resourceID)
{
    MenuRef menu = GetMenuHandle(resourceID);
    return menu ? menu : CreateDumbResourceMenu(resourceID);
}

bool IsInMenuList(MenuRef menu)
{
    for (const auto& [id, listed] : menuMap()) {
        if (listed == menu.get())
            return true;
    }
    return false;
}

SInt16 GetMenuID(MenuRef menu)
{
    if (!menu || !VELMAR_CHECK_MENU(menu))
        return -1;
    const SInt16 id = carriedId(menu);
    const auto& map = menuMap();
    const auto it = map.find(id);
    VELMAR_ASSERT(it == map.end() || it->second == menu.get(),
        "iMenuMap.find(ret) == iMenuMap.end() || iMenuMap.find(ret)->second == menu");
    return id;
}

void SetMenuID(MenuRef menu, SInt16 menuID)
{
    if (VELMAR_CHECK_MENU(menu))
        menu->setProperty(kMenuIdProperty, menuID);
}

unsigned char* GetMenuTitle(MenuRef menu, unsigned char* title)
{
    if (!VELMAR_CHECK_MENU(menu))
        return nullptr;
    QString2PascalString(menu->title(), title);
    return title;
}

OSStatus DuplicateMenu(MenuRef source, MenuRef* copy)
{
    if (!source || !copy)
        return menuInvalidErr;
    if (!VELMAR_CHECK_MENU(source))
        return menuInvalidErr;
    MenuRef duplicate = newMenu(carriedId(source), source->title());
    duplicate->setParent(source->parentWidget(), duplicate->windowFlags());
    // The very same actions, on purpose: enabling an item in one menu enables it in both.
    duplicate->addActions(source->actions());
    *copy = duplicate;
    return noErr;
}

UInt16 CountMenuItems(MenuRef menu)
{
    return VELMAR_CHECK_MENU(menu) ? UInt16(menu->actions().size()) : UInt16(0);
}

SInt16 GetMenuHeight(MenuRef menu)
{
    return VELMAR_CHECK_MENU(menu) ? SInt16(menu->sizeHint().height()) : SInt16(0);
}

SInt16 GetMenuWidth(MenuRef menu)
{
    return VELMAR_CHECK_MENU(menu) ? SInt16(menu->sizeHint().width()) : SInt16(0);
}

// Qt sizes and highlights its menus itself.
void CalcMenuSize(MenuRef)
{}
void HiliteMenu(SInt16)
{}

const std::map<SInt16, QMenu*>* GetMenuMapPtr()
{
    return &menuMap();
}

} // namespace Velmar
