// Command keys, their modifiers and the shortcuts made from them.
#include "menus/MenuPrivate.h"

#include <Velmar/MacErrors.h>

#include <QKeySequence>

namespace Velmar {

using namespace Private;

namespace {

// The modifier property and the call's result: -5623 for no menu, -5622 for no item.
OSErr itemForModifiers(MenuRef menu, UInt16 item, QAction** action)
{
    *action = nullptr;
    if (!VELMAR_ASSERT(menu, "inMenu") || !VELMAR_CHECK_MENU(menu))
        return menuInvalidErr;
    *action = GetItemAction(menu, item);
    return VELMAR_ASSERT(*action, "action") ? noErr : menuItemNotFoundErr;
}

} // namespace

namespace Private {

void UpdateShortcut(MenuRef menu, UInt16 item)
{
    if (!VELMAR_ASSERT(menu, "menu") || !VELMAR_ASSERT(item, "item"))
        return;
    QAction* action = GetItemAction(menu, item);
    if (!VELMAR_ASSERT(action, "action"))
        return;
    const SInt16 cmd = itemCmd(action);
    if (cmd == 0) {
        action->setShortcut(QKeySequence());
        return;
    }
    UInt8 modifiers = 0;
    const OSErr err = GetMenuItemModifiers(menu, item, &modifiers);
    VELMAR_ASSERT(err == noErr, "noErr == err");
    action->setShortcut(commandShortcut(!(modifiers & kMenuNoCommandModifier),
                                        modifiers & kMenuOptionModifier,
                                        modifiers & kMenuShiftModifier, char(cmd)));
}

QKeySequence commandShortcut(bool command, bool option, bool shift, char key)
{
    QString text;
    if (command)
        text += QStringLiteral("Ctrl+");
    if (option)
        text += QStringLiteral("Alt+");
    if (shift)
        text += QStringLiteral("Shift+");
    text += QChar::fromLatin1(key);
    return QKeySequence(text);
}

} // namespace Private

void GetItemCmd(MenuRef menu, UInt16 item, SInt16* cmd)
{
    QAction* action = itemOf(menu, item);
    if (action && cmd)
        *cmd = itemCmd(action);
}

void SetItemCmd(MenuRef menu, UInt16 item, SInt16 cmd)
{
    QAction* action = itemOf(menu, item);
    // Control characters, and 32 and 33 on purpose, are not command keys.
    if (!action || (cmd >= 1 && cmd <= 26) || cmd == 32 || cmd == 33)
        return;
    action->setProperty(kItemCmdProperty, cmd);
    switch (cmd) {
    case hMenuCmd:
        if (const SInt16 mark = itemMark(action))
            action->setMenu(GetMenuHandle(mark).get());
        break;
    case 28:
    case 29:
    case kMenuSmallIconCmd: break;
    default:
        UpdateShortcut(menu, item);
        if (action->menu())
            action->setMenu(static_cast<QMenu*>(nullptr));
        break;
    }
}

OSErr GetMenuItemModifiers(MenuRef menu, UInt16 item, UInt8* modifiers)
{
    QAction* action = nullptr;
    const OSErr err = itemForModifiers(menu, item, &action);
    if (err == noErr && modifiers)
        *modifiers = UInt8(action->property(kItemModifiersProperty).toUInt());
    return err;
}

OSErr SetMenuItemModifiers(MenuRef menu, UInt16 item, UInt8 modifiers)
{
    QAction* action = nullptr;
    const OSErr err = itemForModifiers(menu, item, &action);
    if (err != noErr)
        return err;
    action->setProperty(kItemModifiersProperty, modifiers);
    UpdateShortcut(menu, item);
    return noErr;
}

} // namespace Velmar
