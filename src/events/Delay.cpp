#include <Velmar/CarbonEventHandlers.h>
#include <Velmar/Events.h>

#include <QThread>

namespace Velmar {

// A deliberate blocking pause: no events are processed while it waits.
void Delay(UInt32 numTicks, UInt32* finalTicks)
{
    const UInt32 start = TickCount();
    UInt32 now = start;
    while (now - start < numTicks) {
        QThread::yieldCurrentThread();
        now = TickCount();
    }
    if (finalTicks)
        *finalTicks = now;
}

} // namespace Velmar
