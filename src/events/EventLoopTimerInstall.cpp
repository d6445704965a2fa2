// The Carbon calls for event loop timers.
#include "events/EventLoopTimer.h"
#include "events/EventQueue.h"
#include "events/TimerRegistry.h"

#include <Velmar/CarbonEventHandlers.h>
#include <Velmar/Diagnostics.h>
#include <Velmar/MacErrors.h>

#include <cmath>
#include <limits>

namespace Velmar {

namespace {

bool differ(double a, double b)
{
    return std::fabs(a - b) > 1e-12 * std::max(std::fabs(a), std::fabs(b));
}

// Seconds to milliseconds, truncated toward zero; out-of-range and NaN values are clamped.
int toMilliseconds(double seconds)
{
    const double ms = std::trunc(seconds * 1000.0);
    if (!(ms >= 0.0))
        return 0;
    if (ms > double(std::numeric_limits<SInt32>::max()))
        return std::numeric_limits<SInt32>::max();
    return int(ms);
}

} // namespace

OSStatus InstallEventLoopTimer(EventLoopRef inEventLoop, EventTimerInterval inFireDelay,
                               EventTimerInterval inInterval, EventLoopTimerUPP inTimerProc,
                               void* inTimerData, EventLoopTimerRef* outTimer)
{
    if (!inEventLoop)
        return eventInternalErr;
    // The timer runs on the one loop even when the reference named another.
    VELMAR_ASSERT(inEventLoop == Private::MainEventQueue(),
                  "inEventLoop == Private::MainEventQueue()");
    if (differ(inFireDelay, inInterval))
        VelmarLog(kLogNotImpl, "InstallEventLoopTimer: inFireDelay != inInterval");
    if (!inTimerProc)
        return -1;

    const int firstDelayMs = toMilliseconds(inFireDelay);
    const int intervalMs = toMilliseconds(inInterval);
    auto* timer = firstDelayMs != intervalMs
        ? new Private::VelmarEventLoopTimer(inTimerProc, inTimerData, firstDelayMs, intervalMs)
        : new Private::VelmarEventLoopTimer(inTimerProc, inTimerData, intervalMs);
    Private::MainTimerRegistry().add(timer);
    if (outTimer)
        *outTimer = timer;
    return noErr;
}

OSStatus RemoveEventLoopTimer(EventLoopTimerRef inTimer)
{
    return Private::MainTimerRegistry().remove(inTimer) ? noErr : OSStatus(eventInternalErr);
}

OSStatus FireQtTimer(EventLoopTimerRef inTimer)
{
    if (!Private::MainTimerRegistry().contains(inTimer))
        return eventInternalErr;
    inTimer->fireSoon();
    return noErr;
}

} // namespace Velmar
