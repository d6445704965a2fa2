// Installing and removing Carbon event handlers, and continuing a chain.
#include "events/HandlerCall.h"
#include "events/HandlerList.h"
#include "events/HandlerWindows.h"

#include <Velmar/Diagnostics.h>
#include <Velmar/MacErrors.h>

namespace Velmar {

namespace {

bool isUsableTarget(const EventTargetRef& target)
{
    switch (target.targetType) {
    case EventTargetRef::TargetTypeApplication:
    case EventTargetRef::TargetTypeEventDispatcher:
        return true;
    case EventTargetRef::TargetTypeWindow:
        return target.window != nullptr;
    default:
        return false;
    }
}

} // namespace

OSStatus InstallEventHandler(EventTargetRef inTarget, EventHandlerUPP inHandler, UInt32 inNumTypes,
                             const EventTypeSpec* inList, void* inUserData, EventHandlerRef* outRef)
{
    if (outRef)
        *outRef = nullptr;
    // A handler that could never be called, or one that would match everything because its
    // list went missing, is refused rather than installed.
    if (!inHandler || !isUsableTarget(inTarget) || (inNumTypes > 0 && !inList)) {
        VelmarLog(kLogEvents, "InstallEventHandler: invalid handler, target or type list");
        return paramErr;
    }
    auto* handler = new Private::EventHandler;
    handler->target = inTarget;
    handler->handler = inHandler;
    handler->userData = inUserData;
    if (inNumTypes > 0)
        handler->types = QList<EventTypeSpec>(inList, inList + inNumTypes);
    Private::HandlerList::instance().insertFront(handler);
    if (outRef)
        *outRef = handler;
    return noErr;
}

OSStatus RemoveEventHandler(EventHandlerRef inHandlerRef)
{
    if (!inHandlerRef)
        return paramErr;
    // An unknown handler may already be freed: it is reported, never touched.
    VELMAR_ASSERT(Private::HandlerList::instance().removeAndFree(inHandlerRef),
                  "IsValidEventHandler(inHandlerRef)");
    return noErr;
}

OSStatus CallNextEventHandler(EventHandlerCallRef inCallRef, EventRef inEvent)
{
    // A call reference lives only while its handler runs; a kept one is refused.
    if (!inCallRef || !VELMAR_LIVE(inCallRef, "IsValidEventHandlerCall(inCallRef)"))
        return paramErr;
    VELMAR_ASSERT(inCallRef->item().get() == inEvent, "inCallRef->item().get() == inEvent");
    return inCallRef->invokeNextHandler();
}

namespace Private {

int RemoveWindowEventHandlers(const AQtWindow* window)
{
    if (!window)
        return 0;
    return HandlerList::instance().removeWindowHandlers(window);
}

} // namespace Private

} // namespace Velmar
