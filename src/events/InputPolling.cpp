// The classic polling calls: the mouse button, the mouse position, the keyboard, timing.
#include "events/EventLoopTimer.h"
#include "events/EventQueue.h"
#include "events/KeyCodeTables.h"

#include <Velmar/EventWaiting.h>
#include <Velmar/Events.h>
#include <Velmar/FeatureFlags.h>
#include <Velmar/HostShell.h>

#include "platform/Platform.h"
#include "platform/VirtualKeys.h"

#include <QApplication>
#include <QCursor>
#include <QKeyEvent>

#include <cstring>

namespace Velmar {

using namespace Private;

namespace {

namespace VK = VirtualKey;

constexpr UInt16 kMouseDownOrUp = mDownMask | mUpMask;

void setKeyBit(UInt8* bytes, int keyCode, bool down)
{
    if (keyCode < 0 || keyCode >= 128)
        return;
    if (down)
        bytes[keyCode / 8] |= UInt8(1u << (keyCode % 8));
    else
        bytes[keyCode / 8] &= UInt8(~(1u << (keyCode % 8)));
}

} // namespace

Boolean Button()
{
    return Brindle::isLeftButtonDown_sys();
}

Boolean StillDown()
{
    if (EnableLooperFiltering(kFeatureFlagQuery)
        && !QGuiApplication::mouseButtons().testFlag(Qt::LeftButton)) {
        repaintDirtyPorts(1);
        return false;
    }
    if (!Brindle::isLeftButtonDown_sys())
        return false;
    // What the host drew while tracking must be seen while it tracks.
    repaintDirtyPorts(1);
    // EventAvail also sees a click that has reached the application but not the queue yet.
    EventRecord click;
    return !EventAvail(kMouseDownOrUp, &click);
}

Boolean WaitMouseUp()
{
    const bool down = StillDown();
    if (!down) {
        const EventTypeSpec up{kEventClassMouse, kEventMouseUp};
        gMainEventQueue.takeFirstMatching(&up, 1);
    }
    return down;
}

void GetGlobalMouse(Point* where)
{
    if (!where)
        return;
    *where = Point{0, 0};
    if (qobject_cast<QGuiApplication*>(QCoreApplication::instance())) {
        const QPoint p = QCursor::pos();
        *where = Point{SInt16(p.y()), SInt16(p.x())};
    }
}

void GetKeys(KeyMap keys)
{
    if (!keys)
        return;
    UInt8 bytes[16] = {};
    UInt8 state[256] = {};
    Platform::getKeyboardState(state);
    for (int vk = 1; vk < 256; ++vk) {
        if (!(state[vk] & 0x80))
            continue;
        const MacKeyPair pair = macKeyForVirtualKey(vk);
        // Key code 0 is the A key only; elsewhere it means "no key".
        if (pair.keyCode != 0 || vk == VK::A)
            setKeyBit(bytes, pair.keyCode, true);
    }
    // These follow the live state, as hosts poll them for modifier and escape handling.
    const struct {
        int keyCode;
        bool down;
    } live[] = {
        {0x31, Platform::isAsyncKeyDown(VK::Space)},
        {0x37, Platform::isAsyncKeyDown(VK::Control)},
        {0x38, Platform::isAsyncKeyDown(VK::Shift)},
        {0x3A, Platform::isAsyncKeyDown(VK::Menu)},
        {0x35, Platform::isAsyncKeyDown(VK::Escape)},
        {0x39, Platform::isCapsLockToggled()},
        {0x78, Platform::isAsyncKeyDown(VK::F1 + 1)},
        // The host reads this bit for its Insert key.
        {0x56, Platform::isAsyncKeyDown(VK::Insert) || Platform::isAsyncKeyDown(VK::Numpad0)},
    };
    for (const auto& key : live)
        setKeyBit(bytes, key.keyCode, key.down);
    std::memcpy(keys, bytes, sizeof(bytes));
}

Boolean IsKeyPressed(SInt32 macKeyCode)
{
    const int vk = virtualKeyForMacKey(macKeyCode);
    return vk != 0 && Platform::isAsyncKeyDown(vk);
}

UInt32 GetDblTime()
{
    const int ms = qobject_cast<QApplication*>(QCoreApplication::instance())
        ? QApplication::doubleClickInterval()
        : 400;
    return UInt32(ms) * 60 / 1000;
}

UInt32 LMGetDoubleTime()
{
    return GetDblTime();
}

SInt16 LMGetKeyThresh()
{
    return 24;
}

UInt16 GetUTF16Char(QKeyEvent* event)
{
    if (!event || event->text().isEmpty())
        return 0;
    return event->text().at(0).unicode();
}

} // namespace Velmar
