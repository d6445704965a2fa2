#include "events/HandlerCall.h"
#include "foundation/Lifetime.h"

#include <Velmar/Diagnostics.h>
#include <Velmar/MacErrors.h>

namespace Velmar::Private {

EventHandlerCall::EventHandlerCall(const EventQueueItemSmartPtr& item, UInt32 targetType,
                                   HandlerList& list)
    : m_item(item), m_targetType(targetType), m_list(list), m_walk(list),
      m_position(list.frontPosition())
{
    LiveHandles<EventHandlerCall>::instance().add(this);
}

EventHandlerCall::~EventHandlerCall()
{
    LiveHandles<EventHandlerCall>::instance().remove(this);
}

void EventHandlerCall::restart(UInt32 targetType)
{
    m_targetType = targetType;
    m_position = m_list.frontPosition();
}

bool EventHandlerCall::applies(const EventHandler& handler) const
{
    if (handler.target.targetType != m_targetType)
        return false;
    if (m_targetType == EventTargetRef::TargetTypeWindow
        && handler.target.window != m_item->window)
        return false;
    return handler.handles(m_item->eventClass, m_item->eventKind);
}

OSStatus EventHandlerCall::invokeNextHandler()
{
    VELMAR_ASSERT(m_targetType == EventTargetRef::TargetTypeApplication
                      || m_targetType == EventTargetRef::TargetTypeEventDispatcher
                      || m_targetType == EventTargetRef::TargetTypeWindow,
                  "targetType_ == EventTargetRef::TargetTypeApplication || targetType_ == "
                  "EventTargetRef::TargetTypeEventDispatcher || targetType_ == "
                  "EventTargetRef::TargetTypeWindow");
    // The list may grow or get holes while handlers run: re-read it at every step.
    while (m_position >= 0) {
        EventHandler* handler = m_list.at(m_position--);
        if (!handler || !applies(*handler))
            continue;
        m_current = handler;
        OSStatus result;
        {
            HostCallScope hostCode;
            result = handler->handler(this, m_item.get(), handler->userData);
        }
        m_current = nullptr;
        if (result == noErr)
            return noErr;
        // Errors and eventNotHandledErr alike pass the event on.
    }
    return eventNotHandledErr;
}

} // namespace Velmar::Private
