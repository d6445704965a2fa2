// The public waiting calls, each one waiter on the stack.
#include "events/EventMask.h"
#include "events/EventQueue.h"
#include "events/EventQueueHooks.h"
#include "events/EventWaiter.h"
#include "events/PostEvent.h"

#include <Velmar/EventWaiting.h>
#include <Velmar/MacErrors.h>

#include <QtGlobal>

namespace Velmar {

using namespace Private;

OSStatus ReceiveNextEvent(UInt32 numTypes, const EventTypeSpec* list, EventTimeout timeout,
                          Boolean pullEvent, EventRef* outEvent)
{
    if (outEvent)
        *outEvent = nullptr;
    if (numTypes > 0 && !list)
        return paramErr;
    VelmarEventWaiter waiter(VelmarEventWaiter::Plain);
    EventQueueItemSmartPtr item;
    const OSStatus result = waiter.receive(numTypes, list, timeout, pullEvent != 0, &item);
    if (result == noErr && outEvent) {
        *outEvent = item.get();
        if (pullEvent) {
            // The caller owns it now and gives it back with ReleaseEvent.
            item->AddRef();
            ++item->hostRefCount;
        }
    }
    return result;
}

Boolean WaitNextEvent(EventMask eventMask, EventRecord* theEvent, UInt32 sleep, RgnHandle mouseRgn)
{
    VelmarEventWaiter waiter(VelmarEventWaiter::Classic);
    if (mouseRgn) {
        qFatal("WaitNextEvent: mouseRgn != NULL is not supported");
        return false;
    }
    if (!theEvent) {
        qFatal("theEvent is NULL");
        return false;
    }
    EventTypeList types;
    if (ParseEventMask(eventMask, types) < 0)
        return false;
    const double timeout = double(sleep) / 60.0;
    EventQueueItemSmartPtr item;
    const OSStatus result = waiter.receive(types.count, types.specs, timeout, true, &item);
    if (result == noErr) {
        *theEvent = item->toEventRecord();
        return true;
    }
    if (result == eventLoopTimedOutErr) {
        // One item serves every null event: it is filled and read here, never handed out.
        static const EventQueueItemSmartPtr sNull = EventQueueItemSmartPtr::Create();
        FillNullEvent(sNull.get());
        *theEvent = sNull->toEventRecord();
        return false;
    }
    *theEvent = EventRecord{};
    return false;
}

Boolean GetNextEvent(EventMask eventMask, EventRecord* theEvent)
{
    return WaitNextEvent(eventMask, theEvent, 0, nullptr);
}

Boolean GetOSEvent(EventMask mask, EventRecord* theEvent)
{
    GetNextEvent(mask, theEvent);
    return theEvent && theEvent->what != nullEvent;
}

// Never removes anything. Input that reached the process but not yet Qt could be looked at
// too (UseNativeEventAvail); off Windows Qt drains the window system itself, so there is none.
Boolean EventAvail(EventMask eventMask, EventRecord* theEvent)
{
    VelmarEventWaiter waiter(VelmarEventWaiter::Plain);
    EventTypeList types;
    if (ParseEventMask(eventMask, types) < 0)
        return false;
    EventQueueItem* found = gMainEventQueue.findFirstMatching(types.specs, types.count);
    if (!found && (eventMask & updateMask) && LegacyEventProcessing())
        found = FindPendingUpdateEvent([](EventQueueItem*, void*) { return true; }, nullptr);
    if (found) {
        if (theEvent)
            *theEvent = found->toEventRecord();
        return true;
    }
    if (theEvent) {
        EventQueueItemSmartPtr null = EventQueueItemSmartPtr::Create();
        FillNullEvent(null.get());
        *theEvent = null->toEventRecord();
    }
    return false;
}

void RunApplicationEventLoop()
{
    VelmarEventWaiter waiter(VelmarEventWaiter::Application);
    waiter.runApplicationLoop();
}

} // namespace Velmar
