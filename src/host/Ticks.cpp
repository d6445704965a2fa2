// The tick counter and the foreground query, each replaceable by the host.
#include <Velmar/HostCore.h>

#include "platform/Platform.h"

#include <chrono>

namespace Velmar {

namespace {

// Counted from the first call so that small values are easy to read in logs.
UInt32 steadyTicks()
{
    using Clock = std::chrono::steady_clock;
    static const Clock::time_point origin = Clock::now();
    const auto elapsed = std::chrono::duration_cast<std::chrono::milliseconds>(Clock::now() - origin);
    return UInt32(UInt64(elapsed.count()) * 60u / 1000u);
}

bool qtForeground()
{
    return Private::Platform::isApplicationInForeground();
}

TickSource gTickSource = steadyTicks;
ForegroundSource gForegroundSource = qtForeground;

} // namespace

UInt32 TxGetTicks()
{
    return gTickSource();
}

TickSource SetTickSource(TickSource source)
{
    const TickSource previous = gTickSource;
    gTickSource = source ? source : steadyTicks;
    return previous;
}

bool isRunningInForeground()
{
    return gForegroundSource();
}

ForegroundSource SetForegroundSource(ForegroundSource source)
{
    const ForegroundSource previous = gForegroundSource;
    gForegroundSource = source ? source : qtForeground;
    return previous;
}

} // namespace Velmar
