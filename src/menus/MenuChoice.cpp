// Menu choices: the pending choice of the menu bar, command keys, and the choice value of
// a fired item.
#include "menus/MenuPrivate.h"

#include <Velmar/Events.h>

#include "foundation/ApplicationPrivate.h"

#include <QKeySequence>

namespace Velmar {

using namespace Private;

namespace {

SInt32 gPendingMenuChoice = 0;

SInt32 choiceValue(SInt16 menuID, int item)
{
    return SInt32((UInt32(UInt16(menuID)) << 16) | UInt16(item));
}

} // namespace

namespace Private {

void recordMenuChoice(QAction* action)
{
    gPendingMenuChoice = CalculateMenuSelectInfo(action);
}

SInt32 CalculateMenuSelectInfo(QAction* action)
{
    if (!VELMAR_ASSERT(action, "action"))
        return 0;
    auto* menu = qobject_cast<QMenu*>(action->parent());
    if (!VELMAR_ASSERT(menu, "menu"))
        return 0;
    // Read directly: the parent of a live action is alive, adopted or not.
    const SInt16 id = shortProperty(menu, kMenuIdProperty);
    if (menu->property(kMenuDefinitionProperty).isValid()) {
        const SInt16 item = shortProperty(menu, kMenuSelectedItemProperty);
        return item ? choiceValue(id, item) : 0;
    }
    const qsizetype index = menu->actions().indexOf(action);
    return index < 0 ? 0 : choiceValue(id, int(index) + 1);
}

SInt32 FindEnabledItemByShortcut(const QKeySequence& sequence)
{
    for (const auto& [id, menu] : menuMap()) {
        if (!menu->menuAction()->isEnabled())
            continue;
        for (QAction* action : menu->actions()) {
            if (action->isEnabled() && action->shortcut() == sequence)
                return CalculateMenuSelectInfo(action);
        }
    }
    return 0;
}

void installMenuHooks()
{
    static bool sInstalled = false;
    if (sInstalled)
        return;
    sInstalled = true;
    ApplicationHooks hooks = applicationHooks();
    hooks.recordMenuChoice = recordMenuChoice;
    hooks.refreshMenu = RelinkSubmenus;
    hooks.applyMenuFont = ApplyMenuFont;
    SetApplicationHooks(hooks);
}

} // namespace Private

SInt32 MenuSelect(Point)
{
    const SInt32 choice = gPendingMenuChoice;
    gPendingMenuChoice = 0;
    return choice;
}

SInt32 MenuKey(SInt16 ch)
{
    return FindEnabledItemByShortcut(commandShortcut(true, false, false, char(ch)));
}

UInt32 MenuEvent(const EventRecord* event)
{
    if (!event || event->what != keyDown)
        return 0;
    // The Mac's control key has no part in shortcuts.
    const UInt16 m = event->modifiers;
    return UInt32(FindEnabledItemByShortcut(
        commandShortcut(m & cmdKey, m & (optionKey | rightOptionKey), m & (shiftKey | rightShiftKey),
                        char(event->message & charCodeMask))));
}

} // namespace Velmar
