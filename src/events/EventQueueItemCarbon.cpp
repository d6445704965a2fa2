// The Carbon entry points on event objects.
#include "events/EventQueueItem.h"

#include <Velmar/MacErrors.h>

namespace Velmar {

void RetainEvent(EventRef event)
{
    if (event)
        event->AddRef();
}

void ReleaseEvent(EventRef event)
{
    if (event)
        event->Release();
}

UInt32 GetEventClass(EventRef event)
{
    return event ? event->eventClass : 0;
}

UInt32 GetEventKind(EventRef event)
{
    return event ? event->eventKind : 0;
}

EventTime GetEventTime(EventRef event)
{
    return event ? event->when / 60.0 : 0.0;
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
    *outEvent = event;
    return noErr;
}

} // namespace Velmar
