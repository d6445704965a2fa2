// The Carbon queue calls: flush, find and remove by comparator, count; window disposal.
#include "events/DispatchStack.h"
#include "events/EventQueue.h"
#include "events/EventQueueHooks.h"
#include "events/HandlerWindows.h"
#include "foundation/Lifetime.h"

#include <Velmar/MacErrors.h>

namespace Velmar {

namespace Private {

void FlushEventReferences(AQtWindow* window)
{
    if (!window)
        return;
    // Handlers of the window go first, so none of them sees its revoked events.
    RemoveWindowEventHandlers(window);
    gMainEventQueue.removeIf([window](EventQueueItem* item) {
        if (item->window != window)
            return false;
        item->window = nullptr;
        item->revoked = 1;
        return true;
    });
    for (const EventQueueItemSmartPtr& running : DispatchStack()) {
        if (running->window == window)
            running->window = nullptr;
    }
    ClearPendingUpdateEvent(window);
}

} // namespace Private

OSStatus FlushSpecificEventsFromQueue(EventQueueRef queue, EventComparatorUPP comparator, void* data)
{
    if (!VELMAR_CHECK_QUEUE(queue) || !comparator)
        return eventInternalErr;
    const Private::HostCallScope hostCode; // the comparator
    queue->removeIf([comparator, data](Private::EventQueueItem* item) { return comparator(item, data); });
    if (Private::LegacyEventProcessing())
        Private::ClearPendingUpdateEvents(comparator, data);
    return noErr;
}

// The comparator may change the queue while it looks (see EventQueue::findIf).
EventRef FindSpecificEventInQueue(EventQueueRef queue, EventComparatorUPP comparator, void* data)
{
    if (!VELMAR_CHECK_QUEUE(queue) || !comparator)
        return nullptr;
    const Private::HostCallScope hostCode; // the comparator
    if (EventRef found = queue->findIf(
            [comparator, data](Private::EventQueueItem* item) { return comparator(item, data); }))
        return found;
    if (Private::LegacyEventProcessing())
        return Private::FindPendingUpdateEvent(comparator, data);
    return nullptr;
}

OSStatus RemoveEventFromQueue(EventQueueRef queue, EventRef event)
{
    if (!VELMAR_CHECK_QUEUE(queue))
        return eventInternalErr;
    if (!event)
        return noErr;
    if (!VELMAR_CHECK_EVENT(event))
        return eventNotInQueueErr;
    // Asked before removing: the queue's reference may be the last one.
    const bool update = event->isUpdateEvent();
    queue->remove(event);
    if (update && Private::LegacyEventProcessing()) {
        Private::ClearPendingUpdateEvents(
            [](Private::EventQueueItem* pending, void* target) { return pending == target; }, event);
    }
    return noErr;
}

UInt32 GetNumEventsInQueue(EventQueueRef queue)
{
    if (!VELMAR_CHECK_QUEUE(queue))
        return 0;
    UInt32 n = queue->count();
    if (Private::LegacyEventProcessing())
        n += Private::CountPendingUpdateEvents();
    return n;
}

} // namespace Velmar
