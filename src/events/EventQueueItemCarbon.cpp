// The Carbon entry points on event objects. A freed or made-up EventRef is refused before
// it is read, and the host can only give back the references it holds.
#include "events/EventQueueItem.h"

#include <Velmar/MacErrors.h>

namespace Velmar {

void RetainEvent(EventRef event)
{
    if (!VELMAR_CHECK_EVENT(event))
        return;
    event->AddRef();
    ++event->hostRefCount;
}

// Releasing more often than the host retained would free an event the queue or a handler
// chain still holds: that is refused with an assertion instead.
void ReleaseEvent(EventRef event)
{
    if (!VELMAR_CHECK_EVENT(event))
        return;
    if (!VELMAR_ASSERT(event->hostRefCount > 0, "event->hostRefCount > 0"))
        return;
    --event->hostRefCount;
    event->Release();
}

UInt32 GetEventClass(EventRef event)
{
    return VELMAR_CHECK_EVENT(event) ? event->eventClass : 0;
}

UInt32 GetEventKind(EventRef event)
{
    return VELMAR_CHECK_EVENT(event) ? event->eventKind : 0;
}

EventTime GetEventTime(EventRef event)
{
    return VELMAR_CHECK_EVENT(event) ? event->when / 60.0 : 0.0;
}

// `when` is ignored and the item keeps time 0: events made here report time 0.
OSStatus MacCreateEvent(CFAllocatorRef, UInt32 eventClass, UInt32 kind, EventTime,
                        EventAttributes flags, EventRef* outEvent)
{
    if (!outEvent)
        return eventInternalErr;
    EventRef event = Private::EventQueueItem::Create();
    event->eventClass = eventClass;
    event->eventKind = kind;
    event->attributes = flags;
    event->hostRefCount = 1;
    *outEvent = event;
    return noErr;
}

} // namespace Velmar
