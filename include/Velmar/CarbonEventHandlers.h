// Carbon event handlers, targets, the dispatch blocker and event loop timers.
#pragma once

#include <Velmar/MacTypes.h>
#include <Velmar/CarbonEvents.h>
#include <Velmar/Events.h>
#include <Velmar/WindowRef.h>

#include <QEventLoop>

namespace Velmar {

namespace Private {
struct EventHandler;
class EventHandlerCall;
class VelmarEventLoopTimer;
} // namespace Private

// Where a handler is installed: the application, the event dispatcher, or one window.
struct VELMAR_EXPORT EventTargetRef {
    enum : UInt32 {
        TargetTypeApplication = 1,
        TargetTypeEventDispatcher = 2,
        TargetTypeWindow = 3,
    };

    UInt32 targetType = 0;
    AQtWindow* window = nullptr; // only for window targets

    bool operator==(const EventTargetRef& other) const
    {
        return targetType == other.targetType && window == other.window;
    }
    bool operator!=(const EventTargetRef& other) const { return !(*this == other); }
};

using EventHandlerRef = Private::EventHandler*;
using EventHandlerCallRef = Private::EventHandlerCall*;
using EventHandlerProcPtr = OSStatus (*)(EventHandlerCallRef inHandlerCallRef, EventRef inEvent,
                                         void* inUserData);
using EventHandlerUPP = EventHandlerProcPtr;

inline EventHandlerUPP NewEventHandlerUPP(EventHandlerProcPtr proc) { return proc; }
inline void DisposeEventHandlerUPP(EventHandlerUPP) {}
inline OSStatus InvokeEventHandlerUPP(EventHandlerCallRef callRef, EventRef event,
                                      void* userData, EventHandlerUPP upp)
{
    return upp(callRef, event, userData);
}

VELMAR_EXPORT EventTargetRef GetApplicationEventTarget();
VELMAR_EXPORT EventTargetRef GetEventDispatcherTarget();
VELMAR_EXPORT EventTargetRef GetWindowEventTarget(WindowRef inWindow);

// The newest handler is tried first. A null handler procedure, or a null list with a
// non-zero count, is refused with paramErr.
VELMAR_EXPORT OSStatus InstallEventHandler(EventTargetRef inTarget, EventHandlerUPP inHandler,
                                           UInt32 inNumTypes, const EventTypeSpec* inList,
                                           void* inUserData, EventHandlerRef* outRef);
VELMAR_EXPORT OSStatus RemoveEventHandler(EventHandlerRef inHandlerRef);
VELMAR_EXPORT OSStatus CallNextEventHandler(EventHandlerCallRef inCallRef, EventRef inEvent);
// Always starts at the dispatcher's handlers; 0 whether or not a handler took the event.
VELMAR_EXPORT OSStatus SendEventToEventTarget(EventRef inEvent, EventTargetRef inTarget);

// Keeps Carbon handlers and event loop timers from running while it is alive. Blockers
// nest: each restores the state it found, so only the outermost re-enables dispatch.
class VELMAR_EXPORT ScopedCarbonEventsBlocker {
public:
    explicit ScopedCarbonEventsBlocker(const char* name);
    ScopedCarbonEventsBlocker(EventQueueRef queue, const char* name);
    ~ScopedCarbonEventsBlocker();
    ScopedCarbonEventsBlocker(const ScopedCarbonEventsBlocker&) = delete;
    ScopedCarbonEventsBlocker& operator=(const ScopedCarbonEventsBlocker&) = delete;

    void Unblock();
    bool isBlocked() const { return m_blocked; }
    const char* name() const { return m_name; }

private:
    void block();

    EventQueueRef m_queue;
    const char* m_name;
    bool m_blocked;
    bool m_wasDisabled;
};

// Event loop timers. Times are in seconds.
using EventLoopTimerRef = Private::VelmarEventLoopTimer*;
using EventLoopTimerProcPtr = void (*)(EventLoopTimerRef inTimer, void* inUserData);
using EventLoopTimerUPP = EventLoopTimerProcPtr;

inline EventLoopTimerUPP NewEventLoopTimerUPP(EventLoopTimerProcPtr proc) { return proc; }
inline void DisposeEventLoopTimerUPP(EventLoopTimerUPP) {}

VELMAR_EXPORT OSStatus InstallEventLoopTimer(EventLoopRef inEventLoop, EventTimerInterval inFireDelay,
                                             EventTimerInterval inInterval,
                                             EventLoopTimerUPP inTimerProc, void* inTimerData,
                                             EventLoopTimerRef* outTimer);
VELMAR_EXPORT OSStatus RemoveEventLoopTimer(EventLoopTimerRef inTimer);
// Makes the timer's procedure run at the next event processing, due or not.
VELMAR_EXPORT OSStatus FireQtTimer(EventLoopTimerRef inTimer);

// Lets Qt run one pass (no waiting) while Carbon handlers and event loop timers are held.
VELMAR_EXPORT void ProcessNonCarbonEvents(QEventLoop::ProcessEventsFlags flags);

VELMAR_EXPORT void QuitApplicationEventLoop();
VELMAR_EXPORT bool InApplicationEventLoop();

// A blocking pause of `numTicks` sixtieths of a second; processes no events.
VELMAR_EXPORT void Delay(UInt32 numTicks, UInt32* finalTicks);

// Apple events are not supported: these report themselves and return unimpErr.
using AEEventClass = FourCharCode;
using AEEventID = FourCharCode;
using DescType = FourCharCode;
struct AEDesc {
    DescType descriptorType;
    void* dataHandle;
};
using AppleEvent = AEDesc;
using AEEventHandlerProcPtr = OSErr (*)(const AppleEvent* theAppleEvent, AppleEvent* reply,
                                        void* handlerRefcon);
using AEEventHandlerUPP = AEEventHandlerProcPtr;

VELMAR_EXPORT OSStatus AEProcessAppleEvent(const EventRecord* theEventRecord);
VELMAR_EXPORT OSStatus AEInstallEventHandler(AEEventClass theAEEventClass, AEEventID theAEEventID,
                                             AEEventHandlerUPP handler, void* handlerRefcon,
                                             Boolean isSysHandler);
VELMAR_EXPORT OSStatus SendTextInputEvent(EventRef inEvent);

} // namespace Velmar
