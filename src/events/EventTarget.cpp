#include <Velmar/CarbonEventHandlers.h>

namespace Velmar {

EventTargetRef GetApplicationEventTarget()
{
    return EventTargetRef{EventTargetRef::TargetTypeApplication, nullptr};
}

EventTargetRef GetEventDispatcherTarget()
{
    return EventTargetRef{EventTargetRef::TargetTypeEventDispatcher, nullptr};
}

EventTargetRef GetWindowEventTarget(WindowRef inWindow)
{
    return EventTargetRef{EventTargetRef::TargetTypeWindow, inWindow};
}

} // namespace Velmar
