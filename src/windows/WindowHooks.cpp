// What the layers below windows reach through their hooks: QuickDraw's ports (dirty areas,
// direct drawing, scrolling, the screen), the event queue (deletion, pending update events,
// titles) and the timers (repainting dirty ports). Installed once, by the first window.
#include <Velmar/FeatureFlags.h>
#include <Velmar/QtGrafPort.h>

#include "events/EventLoopTimer.h"
#include "events/EventQueueHooks.h"
#include "events/EventQueueItem.h"
#include "events/QtInputConversion.h"
#include "host/Replaceable.h"
#include "quickdraw/GrafPortPrivate.h"
#include "windows/WindowFilters.h"
#include "windows/WindowPaintOverlay.h"
#include "windows/WindowPorts.h"
#include "windows/WindowPrivate.h"

namespace Velmar::Private {

namespace {

// ---- QuickDraw ----------------------------------------------------------------------------

void markDirty(AQtWindow* window, const QRect& deviceRect)
{
    window->markGrafPortDirty(deviceRect);
}

bool isDirectDrawing(AQtWindow* window)
{
    return window->isDirectQtDrawing();
}

void scrollDirect(AQtWindow* window, const QRect& rect, int dh, int dv, QRegion* update)
{
    const QPoint origin = window->GetPort() ? window->GetPort()->origin() : QPoint();
    const QRegion before = window->updateRegion();
    window->scrollRect(dh, dv, rect.translated(-origin));
    if (update)
        *update = (window->updateRegion() - before.translated(dh, dv)).translated(origin);
}

QtGrafPort* frontVisiblePortExcept(AQtWindow* except)
{
    for (AQtWindow* window : windowList()) {
        if (window != except && !window->IsDeletePending() && window->isVisible()
            && window->GetPort())
            return window->GetPort();
    }
    return nullptr;
}

bool visibleRegion(AQtWindow* window, QRegion* out)
{
    if (!LimitDrawingWithWindowVisibleRegion(kFeatureFlagQuery) || !window->isVisible()
        || window->isDirectQtDrawing() || !window->GetPort())
        return false;
    *out = window->visibleRegion().translated(window->GetPort()->origin());
    return true;
}

QPoint mapToGlobal(AQtWindow* window, const QPoint& local)
{
    return windowToGlobal(window, local);
}

QPoint mapFromGlobal(AQtWindow* window, const QPoint& global)
{
    return globalToWindow(window, global);
}

void flush(AQtWindow* window)
{
    window->flushDirtyPort(true);
}

QImage* backBuffer(AQtWindow*, const QSize& size)
{
    return makeBackBuffer(size);
}

// ---- The event queue --------------------------------------------------------------------------

bool isDeletePending(AQtWindow* window)
{
    // A window that is gone is as good as deleted: its new events are dropped too.
    return !isLive(window) || window->IsDeletePending();
}

bool isUpdateRegionEmpty(AQtWindow* window)
{
    return !isLive(window) || window->updateRegion().isEmpty();
}

UInt32 countPending()
{
    return pendingUpdateCount();
}

// The pending update event of each window in `list` that the host's predicate accepts,
// handed to `act` until it returns true. A host comparator may dispose windows or flush while
// it looks: each pending event is held for the look and counts only while its window still
// holds it.
template <typename Windows, typename Act>
void forAcceptedPending(const Windows& list, PendingUpdatePredicate pred, void* data, Act act)
{
    const std::vector<QPointer<AQtWindow>> windows(list.begin(), list.end());
    for (const QPointer<AQtWindow>& window : windows) {
        if (!window)
            continue;
        const EventQueueItemSmartPtr pending = window->pendingUpdateEvent();
        if (pending && pred(pending.get(), data) && window
            && window->pendingUpdateEvent() == pending.get() && act(window.data(), pending.get()))
            return;
    }
}

EventQueueItem* findPending(PendingUpdatePredicate pred, void* data)
{
    EventQueueItem* found = nullptr;
    forAcceptedPending(windowList(), pred, data, [&found](AQtWindow*, EventQueueItem* pending) {
        found = pending;
        return true;
    });
    return found;
}

void clearPendingWhere(PendingUpdatePredicate pred, void* data)
{
    forAcceptedPending(liveWindows(), pred, data, [](AQtWindow* window, EventQueueItem*) {
        window->clearPendingUpdateEvent();
        return false;
    });
}

void clearPending(AQtWindow* window)
{
    if (isLive(window))
        window->clearPendingUpdateEvent();
}

QString windowTitle(AQtWindow* window)
{
    return isLive(window) ? window->windowTitle() : QString();
}

void repaintWindows(int flags)
{
    AQtWindow::RepaintDirtyPorts(flags != 0);
}

// ---- Input conversion ----------------------------------------------------------------------

QWidget* windowWidget(AQtWindow* window)
{
    return isLive(window) ? window : nullptr;
}

bool minimizeMaximizeChange(AQtWindow* window)
{
    return isLive(window) && window->IsMinimizeMaximizeEvent();
}

} // namespace

namespace {
Replaceable<WindowFilterHooks> gFilterHooks;
Replaceable<PaintOverlayHook> gPaintOverlay;
}

PaintOverlayHook paintOverlayHook()
{
    return gPaintOverlay.get();
}

PaintOverlayHook SetPaintOverlayHook(PaintOverlayHook hook)
{
    return gPaintOverlay.set(hook);
}

const WindowFilterHooks& windowFilterHooks()
{
    return gFilterHooks.get();
}

WindowFilterHooks SetWindowFilterHooks(const WindowFilterHooks& hooks)
{
    return gFilterHooks.set(hooks);
}

void ensureWindowHooks()
{
    static bool sInstalled = false;
    if (sInstalled)
        return;
    sInstalled = true;

    PortWindowHooks ports;
    ports.markDirty = markDirty;
    ports.isDirectDrawing = isDirectDrawing;
    ports.scrollRect = scrollDirect;
    ports.frontVisiblePortExcept = frontVisiblePortExcept;
    ports.visibleRegion = visibleRegion;
    ports.mapToGlobal = mapToGlobal;
    ports.mapFromGlobal = mapFromGlobal;
    ports.flush = flush;
    ports.makeBackBuffer = backBuffer;
    setPortWindowHooks(ports);

    WindowEventHooks queue = windowEventHooks();
    queue.isDeletePending = isDeletePending;
    queue.isUpdateRegionEmpty = isUpdateRegionEmpty;
    queue.countPendingUpdateEvents = countPending;
    queue.findPendingUpdateEvent = findPending;
    queue.clearPendingUpdateEvents = clearPendingWhere;
    queue.clearPendingUpdateEvent = clearPending;
    queue.windowTitle = windowTitle;
    SetWindowEventHooks(queue);

    SetRepaintDirtyPortsHook(repaintWindows);

    InputWindowHooks input;
    input.widget = windowWidget;
    input.isMinimizeMaximizeChange = minimizeMaximizeChange;
    SetInputWindowHooks(input);
}

} // namespace Velmar::Private
