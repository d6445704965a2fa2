// Key and button state as seen in Qt's own events, for when the window system cannot be
// asked (offscreen, Wayland, or no X connection). Only this process's input is seen.
#pragma once

#include <Velmar/MacTypes.h>

class QEvent;

namespace Velmar::Private::Platform {

class InputTracker {
public:
    static InputTracker& instance();

    void track(const QEvent* event);
    // Forgets keys and buttons held down (their releases will go to another application),
    // keeps the lock toggles.
    void releaseAll();
    void reset(); // everything, toggles too

    bool isDown(int virtualKey) const;
    bool isToggled(int virtualKey) const;
    // 0x80 while down, 0x01 when toggled, as the Windows keyboard state.
    void getState(UInt8 state[256]) const;

private:
    void setDown(int virtualKey, bool down);
    void trackKey(const QEvent* event, bool press);
    void trackButtons(const QEvent* event);

    UInt8 m_state[256] = {};
    // An event offered to several receivers (propagation) must toggle a lock key once.
    const QEvent* m_lastKeyEvent = nullptr;
    int m_lastKeyType = 0;
    UInt64 m_lastKeyTimestamp = 0;
};

} // namespace Velmar::Private::Platform
