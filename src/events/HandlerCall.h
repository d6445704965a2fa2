// One run of the handler chain for one event (what an EventHandlerCallRef points to).
#pragma once

#include "events/EventQueueItem.h"
#include "events/HandlerList.h"

namespace Velmar::Private {

class EventHandlerCall {
public:
    EventHandlerCall(const EventQueueItemSmartPtr& item, UInt32 targetType,
                     HandlerList& list = HandlerList::instance());
    ~EventHandlerCall();
    EventHandlerCall(const EventHandlerCall&) = delete;
    EventHandlerCall& operator=(const EventHandlerCall&) = delete;

    const EventQueueItemSmartPtr& item() const { return m_item; }
    UInt32 targetType() const { return m_targetType; }
    EventHandler* currentHandler() const { return m_current; }

    // Starts over at the newest handler, now for handlers of another target type.
    void restart(UInt32 targetType);

    // Calls the remaining applicable handlers, newest first, until one returns noErr.
    // Any other result passes the event on; eventNotHandledErr when nobody took it.
    OSStatus invokeNextHandler();

private:
    bool applies(const EventHandler& handler) const;

    EventQueueItemSmartPtr m_item;
    UInt32 m_targetType;
    HandlerList& m_list;
    HandlerList::Walk m_walk;
    int m_position;
    EventHandler* m_current = nullptr;
};

} // namespace Velmar::Private
