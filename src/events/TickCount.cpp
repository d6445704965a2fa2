// Ticks of 1/60 s, from the host core's counter.
#include <Velmar/Events.h>
#include <Velmar/HostCore.h>

namespace Velmar {

UInt32 TickCount()
{
    return TxGetTicks();
}

} // namespace Velmar
