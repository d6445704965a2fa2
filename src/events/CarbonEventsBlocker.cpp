#include "events/EventQueue.h"
#include "events/TimerRegistry.h"

#include <Velmar/CarbonEventHandlers.h>
#include <Velmar/Diagnostics.h>

namespace Velmar {

ScopedCarbonEventsBlocker::ScopedCarbonEventsBlocker(const char* name)
    : ScopedCarbonEventsBlocker(Private::MainEventQueue(), name)
{
}

ScopedCarbonEventsBlocker::ScopedCarbonEventsBlocker(EventQueueRef queue, const char* name)
    : m_queue(queue), m_name(name), m_blocked(false), m_wasDisabled(false)
{
    if (!m_queue) {
        VelmarLog(kLogEvents, "ScopedCarbonEventsBlocker(%s): no queue, nothing blocked",
                  name ? name : "");
        return;
    }
    if (!VELMAR_CHECK_QUEUE(m_queue)) {
        m_queue = nullptr;
        return;
    }
    block();
}

ScopedCarbonEventsBlocker::~ScopedCarbonEventsBlocker()
{
    if (m_blocked)
        Unblock();
}

void ScopedCarbonEventsBlocker::block()
{
    VELMAR_ASSERT(!m_blocked, "!m_blocked");
    m_blocked = true;
    m_wasDisabled = m_queue->CheckCarbonEventsDisabled();
    m_queue->SetCarbonEventsDisabled(true);
    // Timer events that still arrive are held back by the application object.
    m_queue->timerRegistry().suspend();
}

void ScopedCarbonEventsBlocker::Unblock()
{
    if (!VELMAR_ASSERT(m_blocked, "m_blocked"))
        return;
    m_blocked = false;
    const bool wasDisabled = m_queue->CheckCarbonEventsDisabled();
    // An inner blocker restores "disabled": only the outermost one re-enables dispatch.
    m_queue->SetCarbonEventsDisabled(m_wasDisabled);
    if (wasDisabled && !m_wasDisabled)
        m_queue->RaiseQueueChangedSignal(); // events queued meanwhile must be noticed
    // The timers resume at the next dispatch, wait or application loop pass.
}

} // namespace Velmar
