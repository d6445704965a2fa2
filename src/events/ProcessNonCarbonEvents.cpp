// Letting Qt run one pass while no Carbon handler or event loop timer may run: window shows
// and hides take effect, paint events happen, and nothing of the host is re-entered.
#include "events/EventQueue.h"
#include "events/EventQueueHooks.h"
#include "events/TimerRegistry.h"
#include "foundation/Lifetime.h"

#include <Velmar/CarbonEventHandlers.h>
#include <Velmar/FeatureFlags.h>

#include <QCoreApplication>

namespace Velmar {

namespace Private {

void EventQueue::ProcessNonCarbonEvents(QEventLoop::ProcessEventsFlags flags)
{
    {
        ScopedCarbonEventsBlocker blocker(this, "ProcessNonCarbonEvents");
        const bool wasInside = m_inNonCarbonProcessing;
        m_inNonCarbonProcessing = true;
        if (DeferrredDeleteInProcessNonCarbonEvents(kFeatureFlagQuery))
            flushDeferredDeletions();
        QCoreApplication::processEvents(flags);
        m_inNonCarbonProcessing = wasInside;
    }
    if (LegacyEventProcessing())
        timerRegistry().resume();
}

} // namespace Private

void ProcessNonCarbonEvents(QEventLoop::ProcessEventsFlags flags)
{
    Private::gMainEventQueue.ProcessNonCarbonEvents(flags);
}

} // namespace Velmar
