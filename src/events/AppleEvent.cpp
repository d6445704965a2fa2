// Apple events have no counterpart here; the calls report themselves and fail.
#include <Velmar/CarbonEventHandlers.h>
#include <Velmar/Diagnostics.h>
#include <Velmar/MacErrors.h>

namespace Velmar {

OSStatus AEProcessAppleEvent(const EventRecord* /*theEventRecord*/)
{
    VelmarLog(kLogNotImpl, "Velmar::AEProcessAppleEvent");
    return unimpErr;
}

OSStatus AEInstallEventHandler(AEEventClass, AEEventID, AEEventHandlerUPP, void*, Boolean)
{
    VelmarLog(kLogNotImpl, "Velmar::AEInstallEventHandler");
    return unimpErr;
}

OSStatus SendTextInputEvent(EventRef /*inEvent*/)
{
    VelmarLog(kLogNotImpl, "Velmar::SendTextInputEvent");
    return unimpErr;
}

} // namespace Velmar
