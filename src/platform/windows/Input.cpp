// Key and button state on Windows: the system's own keyboard state.
#include "platform/windows/Win32.h"

#include "platform/InputTracker.h"
#include "platform/Platform.h"

#include <QCursor>

#include <cstring>

namespace Velmar::Private::Platform {

namespace {
bool gWindowSystemInput = true;
}

bool isAsyncKeyDown(int virtualKey)
{
    if (virtualKey <= 0 || virtualKey > 255)
        return false;
    if (!gWindowSystemInput)
        return InputTracker::instance().isDown(virtualKey);
    return (GetAsyncKeyState(virtualKey) & 0x8000) != 0;
}

bool isCapsLockToggled()
{
    if (!gWindowSystemInput)
        return InputTracker::instance().isToggled(VK_CAPITAL);
    return (GetKeyState(VK_CAPITAL) & 1) != 0;
}

void getKeyboardState(UInt8 state[256])
{
    if (!state)
        return;
    if (!gWindowSystemInput) {
        InputTracker::instance().getState(state);
        return;
    }
    if (!GetKeyboardState(reinterpret_cast<PBYTE>(state)))
        std::memset(state, 0, 256);
}

bool isSystemLeftButtonDown()
{
    if (!gWindowSystemInput)
        return InputTracker::instance().isDown(VK_LBUTTON);
    // The asynchronous state is physical; the primary button may be the right one.
    return isAsyncKeyDown(GetSystemMetrics(SM_SWAPBUTTON) ? VK_RBUTTON : VK_LBUTTON);
}

QPoint pointerPosition()
{
    if (!gWindowSystemInput)
        return InputTracker::instance().pointerPosition();
    return QCursor::pos();
}

int virtualKeyForCharacter(char character)
{
    const SHORT result = VkKeyScanA(character);
    if (result == -1)
        return 0;
    return result & 0xFF;
}

int keyboardLanguageId()
{
    return int(LOWORD(reinterpret_cast<UINT_PTR>(GetKeyboardLayout(0))));
}

void trackInputEvent(const QEvent* event)
{
    InputTracker::instance().track(event);
}

void setWindowSystemInputEnabled(bool enabled)
{
    gWindowSystemInput = enabled;
}

bool isNativeInputPending()
{
    MSG message;
    const UINT flags = PM_NOREMOVE | PM_NOYIELD;
    return PeekMessageA(&message, nullptr, WM_KEYFIRST, WM_KEYLAST, flags)
        || PeekMessageA(&message, nullptr, WM_MOUSEFIRST, WM_MOUSELAST, flags);
}

} // namespace Velmar::Private::Platform
