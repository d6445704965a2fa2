// The tick counter and the foreground query, each replaceable by the host.
#include <Velmar/HostCore.h>

#include "host/Replaceable.h"
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

Private::Replaceable<TickSource> gTickSource(steadyTicks);
Private::Replaceable<ForegroundSource> gForegroundSource(qtForeground);

} // namespace

UInt32 TxGetTicks()
{
    return gTickSource.get()();
}

TickSource SetTickSource(TickSource source)
{
    return gTickSource.set(source);
}

bool isRunningInForeground()
{
    return gForegroundSource.get()();
}

ForegroundSource SetForegroundSource(ForegroundSource source)
{
    return gForegroundSource.set(source);
}

} // namespace Velmar
