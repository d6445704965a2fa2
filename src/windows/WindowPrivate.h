// The window layer's process-wide state and the checks every window call starts with.
#pragma once

#include <Velmar/AQtWindow.h>
#include <Velmar/Diagnostics.h>
#include <Velmar/MacErrors.h>

#include "foundation/LiveHandles.h"
#include "foundation/Lifetime.h"

#include <QEvent>
#include <QPointer>

#include <vector>

namespace Velmar::Private {

// Reaches the window's private members from the free functions of this layer.
struct AQtWindowPrivate {
    static bool& inSelectWindow(AQtWindow* w) { return w->m_inSelectWindow; }
    static bool& inActivateWindow(AQtWindow* w) { return w->m_inActivateWindow; }
    static QRegion& updateRegion(AQtWindow* w) { return w->m_updateRegion; }
    static void invalidateWholeWidget(AQtWindow* w) { w->invalidateWholeWidget(); }
};

// Sets a flag for a scope and puts back what it was, also when an exception passes (the
// re-entry guards and the in-paint, in-flush and in-sync marks).
class ScopedFlag {
public:
    ScopedFlag(bool& flag, bool value) : m_flag(flag), m_saved(flag) { flag = value; }
    ~ScopedFlag() { m_flag = m_saved; }
    ScopedFlag(const ScopedFlag&) = delete;
    ScopedFlag& operator=(const ScopedFlag&) = delete;

private:
    bool& m_flag;
    bool m_saved;
};

// Calls the host's handler for `window` (what it throws is contained; it counts as host code on
// the stack). False when the window was disposed meanwhile: the caller then stops touching it,
// though the object itself stays until the caller's own KeepAlive (if any) ends.
template <typename Call>
bool callWindowHandler(AQtWindow* window, Call call)
{
    KeepAlive keep(window);
    callGuarded(call, "A serious error has occurred!\nIt is recommended that you restart the "
                      "application immediately.");
    return keep.alive() && !window->IsDeletePending();
}

// ---- Which windows exist ---------------------------------------------------------------
// Every live window object, creation order (deletion-pending ones included until deleted).
const std::vector<AQtWindow*>& liveWindows();
void registerWindow(AQtWindow* window);
void unregisterWindow(AQtWindow* window);

// A live window object, silently false for null; a freed or made-up pointer raises the
// assertion "IsValidWindow(window)".
bool isLiveWindow(const AQtWindow* window, const char* file, int line, const char* function);
// Usable: live and not pending deletion. Pending deletion is a normal state (DisposeWindow
// makes it at once) and is refused silently, as null is.
bool isUsableWindow(const AQtWindow* window, const char* file, int line, const char* function);
#define VELMAR_CHECK_WINDOW(window)                                                        \
    ::Velmar::Private::isUsableWindow((window), __FILE__, __LINE__, __func__)

// ---- The window list, front first --------------------------------------------------------
std::vector<AQtWindow*>& windowList();
void listInsertFront(AQtWindow* window);
void listRemove(AQtWindow* window);
void listMoveToFront(AQtWindow* window);
bool listContains(const AQtWindow* window);

// ---- Windows in back-buffer mode whose dirty area RepaintDirtyPorts flushes ----------------
void dirtyPortSetAdd(AQtWindow* window);
void dirtyPortSetRemove(AQtWindow* window);
std::vector<QPointer<AQtWindow>> dirtyPortSetSnapshot();

// ---- Activation and focus records (guarded: they forget a window when it goes) -------------
QPointer<AQtWindow>& activeWindowRecord();
QPointer<AQtWindow>& userFocusRecord();

// Window content sizes a back buffer can hold: each side from 1 to kMaxWindowSide. Anything
// else is clamped, with a log line naming `call`.
inline constexpr int kMaxWindowSide = 8192;
QSize clampedWindowSize(const QSize& size, const char* call);

// Installs, once, what the lower layers need from windows (port, queue, timer and input
// hooks). Every window constructor calls it.
void ensureWindowHooks();

// The lower layers' view of a window's pending update events.
UInt32 pendingUpdateCount();

// The library's focus request event: posted to a window's widget to give it focus later.
QEvent::Type focusRequestEventType();

} // namespace Velmar::Private
