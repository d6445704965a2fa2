// Key and button state as seen in Qt's own events, for when the window system cannot be
// asked (offscreen, Wayland, or no X connection). Only this process's input is seen.
#pragma once

#include <Velmar/MacTypes.h>

#include <QPoint>

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
    // Where the last mouse event put the pointer, in global coordinates.
    QPoint pointerPosition() const { return m_pointer; }
    // True once a key event arrived: the window system has a keyboard for this process.
    bool hasSeenKeyboard() const { return m_seenKeyboard; }

private:
    void setDown(int virtualKey, bool down);
    void trackKey(const QEvent* event, bool press);
    void trackButtons(const QEvent* event);

    UInt8 m_state[256] = {};
    // An event offered to several receivers (propagation) must toggle a lock key once.
    const QEvent* m_lastKeyEvent = nullptr;
    int m_lastKeyType = 0;
    UInt64 m_lastKeyTimestamp = 0;
    QPoint m_pointer;
    bool m_seenKeyboard = false;
};

} // namespace Velmar::Private::Platform
