// Key and button state off Windows: the backend of the window system Qt runs on answers
// where it can (the X server), the events Qt delivered to this process everywhere else
// (Wayland, offscreen, no application).
#include "platform/Backends.h"
#include "platform/InputTracker.h"
#include "platform/KeyTables.h"
#include "platform/Platform.h"
#include "platform/VirtualKeys.h"
#include "platform/WindowSystem.h"

#include <QCursor>
#include <QLocale>

namespace Velmar::Private::Platform {

namespace {

bool gWindowSystemInput = true;

// True when the X server is to be asked. Never under Wayland, even with XWayland's DISPLAY
// set: that server sees none of this process's input.
bool askX11()
{
    return gWindowSystemInput && windowSystem() == WindowSystem::X11;
}

void currentState(UInt8 state[256])
{
    if (askX11() && X11::queryKeyboardState(state))
        return;
    InputTracker::instance().getState(state);
}

} // namespace

bool isAsyncKeyDown(int virtualKey)
{
    if (virtualKey <= 0 || virtualKey > 255)
        return false;
    UInt8 state[256];
    currentState(state);
    return (state[virtualKey] & 0x80) != 0;
}

bool isCapsLockToggled()
{
    // Asked on every modifier query: only the pointer query, not the whole keyboard.
    bool toggled = false;
    if (askX11() && X11::queryCapsLock(toggled))
        return toggled;
    return InputTracker::instance().isToggled(VirtualKey::Capital);
}

void getKeyboardState(UInt8 state[256])
{
    if (state)
        currentState(state);
}

bool isSystemLeftButtonDown()
{
    return isAsyncKeyDown(VirtualKey::LButton);
}

QPoint pointerPosition()
{
    // The server knows where the pointer is even over other programs' windows; a compositor
    // tells a client only while the pointer is over one of its surfaces.
    if (askX11())
        return QCursor::pos();
    return InputTracker::instance().pointerPosition();
}

int virtualKeyForCharacter(char character)
{
    const auto c = static_cast<unsigned char>(character);
    if (askX11()) {
        if (const int vk = X11::virtualKeyForCharacter(c))
            return vk;
    }
    // US layout: Qt's key codes for ASCII are the upper-case characters.
    if (c < 0x20 || c > 0x7e)
        return 0;
    const int key = (c >= 'a' && c <= 'z') ? c - 'a' + 'A' : c;
    return virtualKeyFromQtKey(key);
}

int keyboardLanguageId()
{
    switch (windowSystem()) {
    case WindowSystem::X11:
        return X11::keyboardLanguageId();
    case WindowSystem::Wayland:
        return Wayland::keyboardLanguageId();
    default:
        return languageIdForLocale(QLocale::system());
    }
}

void trackInputEvent(const QEvent* event)
{
    InputTracker::instance().track(event);
    if (windowSystem() == WindowSystem::Wayland)
        Wayland::watchWindows();
}

void setWindowSystemInputEnabled(bool enabled)
{
    gWindowSystemInput = enabled;
}

bool isNativeInputPending()
{
    return false; // Qt drains its connection itself; there is no queue to peek into
}

} // namespace Velmar::Private::Platform
