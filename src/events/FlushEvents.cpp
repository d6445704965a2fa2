// FlushEvents: removing queued events by classic mask.
#include "events/EventMask.h"
#include "events/EventQueue.h"
#include "events/EventQueueHooks.h"

namespace Velmar {

namespace {

// The flush runs as a plain wait so that events scheduled meanwhile see a waiter.
class ScopedFlushWaiter {
public:
    ScopedFlushWaiter()
    {
        const Private::WaiterHooks& hooks = Private::waiterHooks();
        if (hooks.beginFlushWaiter && hooks.endFlushWaiter)
            m_waiter = hooks.beginFlushWaiter();
    }
    ~ScopedFlushWaiter()
    {
        const Private::WaiterHooks& hooks = Private::waiterHooks();
        if (m_waiter && hooks.endFlushWaiter)
            hooks.endFlushWaiter(m_waiter);
    }
    ScopedFlushWaiter(const ScopedFlushWaiter&) = delete;
    ScopedFlushWaiter& operator=(const ScopedFlushWaiter&) = delete;

private:
    void* m_waiter = nullptr;
};

} // namespace

// The stop mask only excludes types. Skip-marked items and update events whose window
// still has something to repaint are never flushed.
void FlushEvents(UInt16 whichMask, UInt16 stopMask)
{
    using namespace Private;
    EventTypeList pairs;
    if (ParseEventMask(UInt16(whichMask & ~stopMask), pairs) < 0)
        return;
    ScopedFlushWaiter waiter;
    gMainEventQueue.removeIf([&pairs](EventQueueItem* item) {
        if (!MatchesEventTypes(pairs, item) || item->skipFlush)
            return false;
        if (item->isUpdateEvent() && !WindowUpdateRegionIsEmpty(item->window))
            return false;
        return true;
    });
}

} // namespace Velmar
