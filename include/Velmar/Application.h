// The application object.
#pragma once

#include <Velmar/MacTypes.h>

#include <QApplication>

class QAction;
class QMenu;
class QMenuBar;

namespace Velmar {

namespace Private {
struct AQtApplicationPrivate;
class NativeEventFilter;
} // namespace Private

// Name of the application's dynamic property that holds the running pop-up menu (a QMenu*
// as a QWidget* variant) while one runs; empty otherwise.
inline constexpr const char* PopupMenuIsExecuting = "PopupMenuIsExecuting";

// The one application object. The host creates it first, in place of a plain QApplication.
class VELMAR_EXPORT AQtApplication : public QApplication {
    Q_OBJECT

public:
    // The host's hook for raw window-system messages, seen before Qt handles them.
    // `message` is the platform's native message: an MSG* on Windows, an
    // xcb_generic_event_t* on X11. Returning true consumes it; on Windows *result is then
    // the message's answer to the window system.
    using WinEventHandler = bool (*)(void* message, SInt32* result);

    // decorationFlag: true lets the host shell decorate windows, false keeps native frames.
    AQtApplication(int& argc, char** argv, bool decorationFlag);
    ~AQtApplication() override;

    // Null while no AQtApplication exists (also under a plain QApplication).
    static AQtApplication* instance();
    // Asserts that the application exists, then runs Qt's event loop.
    static int exec();

    static QString trUtf8(const char* text, const char* disambiguation = nullptr, int n = -1)
    {
        return tr(text, disambiguation, n);
    }

    QMenuBar* menuBar() const;
    // Orderly end: the decorations go first, then the event loop is asked to quit.
    void ShutdownApp();

    void SetWinEventHandler(WinEventHandler handler);
    // Offers a native message to the host's hook; false (not consumed) without one.
    virtual bool winEventFilter(void* message, SInt32* result);

    bool event(QEvent* e) override;

    // Re-posts, once each, the Qt timers swallowed while Carbon events were blocked.
    // Called when the blocking ends.
    void DispatchPostponedTimers();

    bool LeftButtonStillDown() const;
    bool RightButtonStillDown() const;
    bool MiddleButtonStillDown() const;
    bool AnyButtonStillDown() const;
    bool hasReceivedApplicationActivate() const;
    bool CheckAppleEventHandlersDisabled() const;

public Q_SLOTS:
    void onMenuBarTriggered(QAction* action);
    void onMenuItemTriggered();
    void onMenuAboutToShow();

protected:
    bool notify(QObject* receiver, QEvent* e) override;

private:
    bool filterAndDeliver(QObject* receiver, QEvent* e);
    void postponeTimer(QObject* receiver, int timerId);
    void menuAboutToShow(QMenu* menu);

    Private::AQtApplicationPrivate* d;
    WinEventHandler m_winEventHandler = nullptr;
    Private::NativeEventFilter* m_nativeEventFilter = nullptr;
};

} // namespace Velmar
