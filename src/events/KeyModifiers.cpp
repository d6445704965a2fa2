// The keyboard's modifier state as Mac modifier bits.
#include <Velmar/Events.h>

#include "events/KeyModifiers.h"
#include "platform/Platform.h"

#include <QGuiApplication>

namespace Velmar {

namespace {

struct ModifierRow {
    Qt::KeyboardModifier qt;
    UInt32 mac;
};

// Control plays the command key; the Mac control bit is never produced.
const ModifierRow kModifierRows[] = {
    {Qt::ShiftModifier, shiftKey},
    {Qt::AltModifier, optionKey},
    {Qt::ControlModifier, cmdKey},
    {Qt::MetaModifier, cmdKey},
};

} // namespace

UInt32 Private::macModifiers(Qt::KeyboardModifiers qt)
{
    UInt32 mac = 0;
    for (const ModifierRow& row : kModifierRows) {
        if (qt.testFlag(row.qt))
            mac |= row.mac;
    }
    return mac;
}

UInt32 GetCurrentKeyModifiers()
{
    UInt32 mac = Private::macModifiers(QGuiApplication::keyboardModifiers());
    if (Private::Platform::isCapsLockToggled())
        mac |= alphaLock;
    return mac;
}

} // namespace Velmar
