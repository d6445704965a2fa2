// The fallback key and button state, fed by trackInputEvent.
#include "platform/InputTracker.h"
#include "platform/KeyTables.h"
#include "platform/VirtualKeys.h"

#include <QKeyEvent>
#include <QMouseEvent>

#include <cstring>

namespace Velmar::Private::Platform {

namespace {

namespace VK = VirtualKey;

constexpr UInt8 kDown = 0x80;
constexpr UInt8 kToggled = 0x01;

bool isLockKey(int virtualKey)
{
    return virtualKey == VK::Capital || virtualKey == VK::NumLock || virtualKey == VK::ScrollLock;
}

struct ButtonKey {
    Qt::MouseButton button;
    int virtualKey;
};

const ButtonKey kButtons[] = {
    {Qt::LeftButton, VK::LButton}, {Qt::RightButton, VK::RButton},
    {Qt::MiddleButton, VK::MButton}, {Qt::XButton1, VK::XButton1}, {Qt::XButton2, VK::XButton2},
};

struct ModifierKey {
    Qt::KeyboardModifier modifier;
    int virtualKey;
};

const ModifierKey kModifiers[] = {
    {Qt::ShiftModifier, VK::Shift}, {Qt::ControlModifier, VK::Control},
    {Qt::AltModifier, VK::Menu},
};

} // namespace

InputTracker& InputTracker::instance()
{
    static InputTracker tracker;
    return tracker;
}

void InputTracker::track(const QEvent* event)
{
    if (!event)
        return;
    switch (event->type()) {
    case QEvent::KeyPress:
        trackKey(event, true);
        break;
    case QEvent::KeyRelease:
        trackKey(event, false);
        break;
    case QEvent::MouseButtonPress:
    case QEvent::MouseButtonRelease:
    case QEvent::MouseButtonDblClick:
    case QEvent::MouseMove:
        trackButtons(event);
        break;
    case QEvent::ApplicationDeactivate:
        releaseAll();
        break;
    default:
        break;
    }
}

void InputTracker::trackKey(const QEvent* event, bool press)
{
    const auto* key = static_cast<const QKeyEvent*>(event);
    m_seenKeyboard = true;
    int vk = virtualKeyFromQtKey(key->key(), key->modifiers().testFlag(Qt::KeypadModifier));
    if (vk == VK::QtEnter)
        vk = VK::Return; // Windows reports keypad Enter as Return

    const bool repeated = event == m_lastKeyEvent && int(event->type()) == m_lastKeyType
                       && key->timestamp() == m_lastKeyTimestamp;
    m_lastKeyEvent = event;
    m_lastKeyType = int(event->type());
    m_lastKeyTimestamp = key->timestamp();

    if (vk > 0 && vk < 256) {
        if (press && isLockKey(vk) && !key->isAutoRepeat() && !repeated)
            m_state[vk] ^= kToggled;
        // An auto-repeat release is followed by another press: the key stays down.
        if (press || !key->isAutoRepeat())
            setDown(vk, press);
    }
    // The modifiers the event carries are the truth for the side-less modifier keys; this
    // also clears a modifier whose release went elsewhere.
    for (const ModifierKey& m : kModifiers) {
        if (vk != m.virtualKey)
            setDown(m.virtualKey, key->modifiers().testFlag(m.modifier));
    }
}

void InputTracker::trackButtons(const QEvent* event)
{
    const auto* mouse = static_cast<const QMouseEvent*>(event);
    const Qt::MouseButtons buttons = mouse->buttons(); // the state after this event
    m_pointer = mouse->globalPosition().toPoint();
    for (const ButtonKey& b : kButtons)
        setDown(b.virtualKey, buttons.testFlag(b.button));
    for (const ModifierKey& m : kModifiers)
        setDown(m.virtualKey, mouse->modifiers().testFlag(m.modifier));
}

void InputTracker::setDown(int virtualKey, bool down)
{
    if (virtualKey <= 0 || virtualKey > 255)
        return;
    if (down)
        m_state[virtualKey] |= kDown;
    else
        m_state[virtualKey] &= UInt8(~kDown);
}

void InputTracker::releaseAll()
{
    for (UInt8& entry : m_state)
        entry &= UInt8(~kDown);
}

void InputTracker::reset()
{
    std::memset(m_state, 0, sizeof m_state);
    m_lastKeyEvent = nullptr;
    m_lastKeyType = 0;
    m_lastKeyTimestamp = 0;
    m_pointer = QPoint();
    m_seenKeyboard = false;
}

bool InputTracker::isDown(int virtualKey) const
{
    return virtualKey > 0 && virtualKey < 256 && (m_state[virtualKey] & kDown) != 0;
}

bool InputTracker::isToggled(int virtualKey) const
{
    return virtualKey > 0 && virtualKey < 256 && (m_state[virtualKey] & kToggled) != 0;
}

void InputTracker::getState(UInt8 state[256]) const
{
    if (state)
        std::memcpy(state, m_state, sizeof m_state);
}

} // namespace Velmar::Private::Platform
