// Item styles, marks, check marks, enabling and submenus.
#include "menus/MenuPrivate.h"

#include <Velmar/MacErrors.h>
#include <Velmar/QDText.h>

#include <QSet>

namespace Velmar {

using namespace Private;

namespace Private {

void CheckMenuItem(QAction* action, bool checked)
{
    // An unchecked item is also made uncheckable, so that Qt draws no empty box.
    action->setCheckable(checked);
    action->setChecked(checked);
}

void RelinkSubmenus(QMenu* menu)
{
    if (!menu)
        return;
    for (QAction* action : menu->actions()) {
        const SInt16 mark = itemMark(action);
        action->setMenu(itemCmd(action) == hMenuCmd && mark ? GetMenuHandle(mark).get() : nullptr);
    }
}

} // namespace Private

void GetItemStyle(MenuRef menu, UInt16 item, unsigned char* style)
{
    QAction* action = itemOf(menu, item);
    if (!action || !style)
        return;
    const QFont font = action->font();
    // ORed into what the caller has, on purpose.
    if (font.weight() > QFont::Normal)
        *style |= bold;
    if (font.italic())
        *style |= italic;
    if (font.underline())
        *style |= underline;
}

void SetItemStyle(MenuRef menu, UInt16 item, SInt16 style)
{
    QAction* action = itemOf(menu, item);
    if (!action)
        return;
    VELMAR_ASSERT(!(style & outline), "0 == (chStyle & outline)");
    VELMAR_ASSERT(!(style & shadow), "0 == (chStyle & shadow)");
    VELMAR_ASSERT(!(style & condense), "0 == (chStyle & condense)");
    VELMAR_ASSERT(!(style & extend), "0 == (chStyle & extend)");
    QFont font = action->font();
    font.setWeight(style & bold ? QFont::Bold : QFont::Normal);
    font.setItalic(style & italic);
    font.setUnderline(style & underline);
    action->setFont(font);
}

void GetItemMark(MenuRef menu, UInt16 item, SInt16* mark)
{
    if (!mark)
        return;
    *mark = 0;
    QAction* action = itemOf(menu, item);
    if (!action)
        return;
    *mark = itemMark(action);
    if (QMenu* submenu = action->menu(); submenu && isLive(submenu))
        GetMenuID(submenu); // for its list check only
}

void SetItemMark(MenuRef menu, UInt16 item, SInt16 mark)
{
    QAction* action = itemOf(menu, item);
    if (!action)
        return;
    action->setProperty(kItemMarkProperty, mark);
    if (itemCmd(action) == hMenuCmd)
        action->setMenu(GetMenuHandle(mark).get());
    else
        Private::CheckMenuItem(action, mark != 0);
}

void CheckMenuItem(MenuRef menu, SInt16 item, Boolean checked)
{
    if (QAction* action = itemOf(menu, item))
        Private::CheckMenuItem(action, checked != 0);
}

namespace {

void setItemEnabled(MenuRef menu, UInt16 item, bool enabled)
{
    if (!VELMAR_CHECK_MENU(menu))
        return;
    QAction* action = item == 0 ? menu->menuAction() : GetItemAction(menu, item);
    if (action)
        action->setEnabled(enabled);
}

bool managedInside(const QAction* action)
{
    const QVariant v = action->property(kMenuItemManagedInside);
    return v.isValid() && v.toBool();
}

} // namespace

void EnableMenuItem(MenuRef menu, UInt16 item)
{
    setItemEnabled(menu, item, true);
}

void DisableMenuItem(MenuRef menu, UInt16 item)
{
    setItemEnabled(menu, item, false);
}

Boolean IsMenuItemEnabled(MenuRef menu, UInt16 item)
{
    QAction* action = itemOf(menu, item);
    if (!action)
        throwOutOfRange("Velmar::IsMenuItemEnabled", "item", item);
    return !action->isSeparator() && action->isEnabled();
}

namespace {

// Submenus are entered once each, so that a menu that is its own submenu ends the walk.
void enableAll(QMenu* menu, QSet<QMenu*>& seen)
{
    seen.insert(menu);
    for (QAction* action : menu->actions()) {
        if (managedInside(action))
            action->setEnabled(true);
        QMenu* submenu = action->menu();
        if (submenu && isLive(submenu) && !seen.contains(submenu))
            enableAll(submenu, seen);
    }
}

} // namespace

void EnableAllMenuItems(MenuRef menu)
{
    if (!VELMAR_CHECK_MENU(menu))
        return;
    QSet<QMenu*> seen;
    enableAll(menu, seen);
}

// Items with submenus are left alone and not entered: the asymmetry with
// EnableAllMenuItems is deliberate.
void DisableAllMenuItems(MenuRef menu)
{
    if (!VELMAR_CHECK_MENU(menu))
        return;
    for (QAction* action : menu->actions()) {
        if (!action->menu() && managedInside(action))
            action->setEnabled(false);
    }
}

Boolean MenuHasEnabledItems(MenuRef menu)
{
    if (!menu || !VELMAR_CHECK_MENU(menu))
        return 0;
    for (const QAction* action : menu->actions()) {
        if (action->isEnabled())
            return 1;
    }
    return 0;
}

OSStatus GetMenuItemHierarchicalMenu(MenuRef menu, UInt16 item, MenuRef* submenu)
{
    QAction* action = itemOf(menu, item);
    if (!action)
        return menuItemNotFoundErr;
    if (!action->menu())
        return menuNotFoundErr;
    if (submenu)
        *submenu = action->menu();
    return noErr;
}

} // namespace Velmar
