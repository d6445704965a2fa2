// Apple events have no counterpart here; the calls report themselves and fail.
#include <Velmar/CarbonEventHandlers.h>

#include "foundation/NotImplemented.h"

namespace Velmar {

OSStatus AEProcessAppleEvent(const EventRecord* /*theEventRecord*/)
{
    return Private::notImplemented("AEProcessAppleEvent");
}

OSStatus AEInstallEventHandler(AEEventClass, AEEventID, AEEventHandlerUPP, void*, Boolean)
{
    return Private::notImplemented("AEInstallEventHandler");
}

OSStatus SendTextInputEvent(EventRef /*inEvent*/)
{
    return Private::notImplemented("SendTextInputEvent");
}

} // namespace Velmar
