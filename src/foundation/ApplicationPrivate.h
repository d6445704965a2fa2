// The application object's private record and the hooks other managers fill in.
#pragma once

#include <Velmar/Application.h>

#include <QAbstractNativeEventFilter>
#include <QList>
#include <QMenuBar>
#include <QPointer>

namespace Velmar {

namespace Brindle {
class DecorationManager;
}

namespace Private {

// A Qt timer event swallowed while Carbon events were blocked.
struct PostponedTimer {
    QPointer<QObject> receiver; // null once the receiver is gone
    int timerId = 0;
};

struct AQtApplicationPrivate {
    bool decorationFlag = false;
    // Owned; guarded because a host window the bar was placed in could still take it along.
    QPointer<QMenuBar> menuBar;
    Brindle::DecorationManager* decorationManager = nullptr; // owned until ShutdownApp
    QList<PostponedTimer> postponedTimers; // arrival order, one entry per timer id
    bool applicationActive = false;
};

// Hands native messages to AQtApplication::winEventFilter.
class NativeEventFilter : public QAbstractNativeEventFilter {
public:
    explicit NativeEventFilter(AQtApplication* app) : m_app(app) {}
    bool nativeEventFilter(const QByteArray& eventType, void* message, qintptr* result) override;

private:
    AQtApplication* m_app;
};

// What the application object needs from managers built on top of it. Unset entries do
// nothing. To set one, read the current set, change the entry and install it again.
struct ApplicationHooks {
    // Cursors: the arrow cursor, set when a window is activated or deactivated.
    void (*initCursor)() = nullptr;
    // Menus: records the chosen action as the pending menu choice.
    void (*recordMenuChoice)(QAction* action) = nullptr;
    // Menus: brings a menu's items up to date, then applies the menu font, before it shows.
    void (*refreshMenu)(QMenu* menu) = nullptr;
    void (*applyMenuFont)(QMenu* menu) = nullptr;
};

const ApplicationHooks& applicationHooks();
ApplicationHooks SetApplicationHooks(const ApplicationHooks& hooks); // returns the old set

// The debug inspector's two settings, read when the application is constructed. The
// setters change the running process only; the inspector stores them in the settings.
bool inspectorEnabled();
bool inspectorCopyBitsToScreen();
void setInspectorEnabled(bool on);
void setInspectorCopyBitsToScreen(bool on);

// The two lines notify logs for an exception escaping an event handler. Rethrows the
// current exception internally; call only from inside a catch block.
void logCurrentNotifyException();

} // namespace Private

} // namespace Velmar
