// Running the Carbon handler chain for one event.
#include "events/DispatchStack.h"
#include "events/EventDispatch.h"
#include "events/EventQueue.h"
#include "events/HandlerCall.h"
#include "events/TimerRegistry.h"

#include <Velmar/CarbonEventHandlers.h>
#include <Velmar/Diagnostics.h>
#include <Velmar/MacErrors.h>

namespace Velmar {

namespace Private {

bool DispatchEventToCallbacks(const EventQueueItemSmartPtr& item)
{
    VELMAR_ASSERT(!gMainEventQueue.CheckCarbonEventsDisabled(),
                  "!gMainEventQueue.CheckCarbonEventsDisabled()");
    if (!item)
        return false;

    // Dispatcher handlers first, then those of the event's own window, then the application's.
    static constexpr UInt32 kTargetOrder[] = {
        EventTargetRef::TargetTypeEventDispatcher,
        EventTargetRef::TargetTypeWindow,
        EventTargetRef::TargetTypeApplication,
    };

    EventHandlerCall call(item, kTargetOrder[0]);
    const AQtWindow* window = item->window;
    bool handled = false;
    {
        // While on the stack, disposal of the window nulls the item's window.
        ScopedDispatchStackEntry onStack(item);
        for (UInt32 targetType : kTargetOrder) {
            call.restart(targetType);
            if (call.invokeNextHandler() == noErr) {
                handled = true;
                break;
            }
        }
    }
    if (!handled)
        return item->window != window; // its window went away: consumed
    MainTimerRegistry().resume();
    return true;
}

} // namespace Private

OSStatus SendEventToEventTarget(EventRef inEvent, EventTargetRef /*inTarget*/)
{
    if (!inEvent || !VELMAR_CHECK_EVENT(inEvent))
        return eventInternalErr;
    Private::DispatchEventToCallbacks(Private::EventQueueItemSmartPtr(inEvent));
    return noErr;
}

} // namespace Velmar
