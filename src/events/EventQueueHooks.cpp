// The hooks through which the queue reaches windows and waiters.
#include "events/EventQueueHooks.h"

#include <Velmar/FeatureFlags.h>

#include "host/Replaceable.h"

namespace Velmar::Private {

namespace {

Replaceable<WindowEventHooks> gWindowHookSlot;
Replaceable<WaiterHooks> gWaiterHookSlot;
// Read on every queue operation: the two references spare a call.
const WindowEventHooks& gWindowHooks = gWindowHookSlot.get();
const WaiterHooks& gWaiterHooks = gWaiterHookSlot.get();

} // namespace

WindowEventHooks SetWindowEventHooks(const WindowEventHooks& hooks)
{
    return gWindowHookSlot.set(hooks);
}

WaiterHooks SetWaiterHooks(const WaiterHooks& hooks)
{
    return gWaiterHookSlot.set(hooks);
}

const WindowEventHooks& windowEventHooks()
{
    return gWindowHooks;
}

const WaiterHooks& waiterHooks()
{
    return gWaiterHooks;
}

bool WindowIsDeletePending(AQtWindow* window)
{
    return window && gWindowHooks.isDeletePending && gWindowHooks.isDeletePending(window);
}

bool WindowUpdateRegionIsEmpty(AQtWindow* window)
{
    return !window || !gWindowHooks.isUpdateRegionEmpty || gWindowHooks.isUpdateRegionEmpty(window);
}

UInt32 CountPendingUpdateEvents()
{
    return gWindowHooks.countPendingUpdateEvents ? gWindowHooks.countPendingUpdateEvents() : 0;
}

EventQueueItem* FindPendingUpdateEvent(PendingUpdatePredicate pred, void* data)
{
    return gWindowHooks.findPendingUpdateEvent ? gWindowHooks.findPendingUpdateEvent(pred, data) : nullptr;
}

void ClearPendingUpdateEvents(PendingUpdatePredicate pred, void* data)
{
    if (gWindowHooks.clearPendingUpdateEvents)
        gWindowHooks.clearPendingUpdateEvents(pred, data);
}

void ClearPendingUpdateEvent(AQtWindow* window)
{
    if (window && gWindowHooks.clearPendingUpdateEvent)
        gWindowHooks.clearPendingUpdateEvent(window);
}

QString WindowTitle(AQtWindow* window)
{
    return window && gWindowHooks.windowTitle ? gWindowHooks.windowTitle(window) : QString();
}

bool EventWaiterActive()
{
    return gWaiterHooks.isWaiterActive && gWaiterHooks.isWaiterActive();
}

bool LegacyEventProcessing()
{
    if (gWindowHooks.legacyEventProcessing)
        return gWindowHooks.legacyEventProcessing();
    return SupportLegacyMacEventProcessing(kFeatureFlagQuery) != 0;
}

} // namespace Velmar::Private
