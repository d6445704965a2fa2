// Waiting for events: the classic calls a host's main loop is built on, the Carbon receive
// call, the application event loop, and the user-cancel poll.
#pragma once

#include <Velmar/CarbonEvents.h>
#include <Velmar/Events.h>
#include <Velmar/QDTypes.h>

namespace Velmar {

// Blocks for up to `sleep` ticks until an event of `eventMask` arrives. Other events go to
// the Carbon handlers. False with a null event (time, mouse position, modifiers) when none
// came. `mouseRgn` must be null and `theEvent` given: anything else is fatal.
VELMAR_EXPORT Boolean WaitNextEvent(EventMask eventMask, EventRecord* theEvent, UInt32 sleep,
                                    RgnHandle mouseRgn);
// WaitNextEvent without waiting: one pass of Qt's events, then what is queued.
VELMAR_EXPORT Boolean GetNextEvent(EventMask eventMask, EventRecord* theEvent);
// GetNextEvent; true only for a record that is not a null event.
VELMAR_EXPORT Boolean GetOSEvent(EventMask mask, EventRecord* theEvent);
// The first queued event of `eventMask`, left in the queue; a window's pending update event
// counts when the mask asks for updates.
VELMAR_EXPORT Boolean EventAvail(EventMask eventMask, EventRecord* theEvent);

// The Carbon wait. `timeout` in seconds: kEventDurationNoWait for no waiting,
// kEventDurationForever for none. A pulled event belongs to the caller (ReleaseEvent).
VELMAR_EXPORT OSStatus ReceiveNextEvent(UInt32 numTypes, const EventTypeSpec* list,
                                        EventTimeout timeout, Boolean pullEvent,
                                        EventRef* outEvent);

// Runs until QuitApplicationEventLoop; every event goes to the Carbon handlers.
VELMAR_EXPORT void RunApplicationEventLoop();

// Whether the user asked to cancel (Escape, Cancel, or command-period), in the queue or on
// the keyboard now. When so, queued keys and clicks are dropped so that they do not act.
VELMAR_EXPORT Boolean CheckEventQueueForUserCancel();
// Forgets an earlier press of Escape or Cancel.
VELMAR_EXPORT void ClearAbortRequested();

} // namespace Velmar
