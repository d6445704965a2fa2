// The single entry for new events: dispatch at once, merge with a queued twin, or append.
#include "events/EventDispatch.h"
#include "events/EventQueue.h"
#include "events/EventQueueHooks.h"

#include <Velmar/Diagnostics.h>

namespace Velmar::Private {

namespace {

bool isTwin(const EventQueueItem* a, const EventQueueItem* b)
{
    return a->window == b->window && a->eventClass == b->eventClass && a->eventKind == b->eventKind;
}

} // namespace

void ScheduleEvent(const EventQueueItemSmartPtr& scheduled, EventQueueItem::MergePolicy policy)
{
    if (!scheduled) {
        VelmarLog(kLogEvents, "ScheduleEvent: no event");
        return;
    }
    // Held for the whole call: handlers run below may drop every other reference.
    const EventQueueItemSmartPtr item = scheduled;
    EventQueue& queue = gMainEventQueue;

    if (item->window && WindowIsDeletePending(item->window))
        return;

    // Windows keep their own pending update event; the queue only wakes the waiters.
    if (item->isUpdateEvent() && LegacyEventProcessing()) {
        queue.RaiseQueueChangedSignal();
        return;
    }

    if (item->IsSynchronized()) {
        if (queue.CheckCarbonEventsDisabled() || !EventWaiterActive())
            item->notSynchronized = 1;
        else if (DispatchEventToCallbacks(item))
            return;
    }

    if (policy == EventQueueItem::GuessMerge)
        policy = item->GuessMergePolicy();

    if (policy != EventQueueItem::NoMerge) {
        VELMAR_ASSERT(item->window, "item->window != NULL");
        switch (policy) {
        case EventQueueItem::MergeIntoQueued:
            if (EventQueueItem* twin = queue.firstWhere(
                    [&item](const EventQueueItem* queued) { return isTwin(queued, item.get()); })) {
                twin->Merge(item.get());
                queue.RaiseQueueChangedSignal();
                return;
            }
            break;
        case EventQueueItem::ReplaceQueued:
            // The newest request wins its place at the back; twins hand over their skip mark.
            queue.removeIf([&item](EventQueueItem* queued) {
                if (!isTwin(queued, item.get()))
                    return false;
                item->Merge(queued);
                return true;
            });
            break;
        default:
            velmar_assert("false", __FILE__, __LINE__, __func__, "Unknown mergePolicy");
            return;
        }
    }

    queue.append(item);
}

} // namespace Velmar::Private
