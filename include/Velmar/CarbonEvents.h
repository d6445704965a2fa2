// Carbon event objects, parameters and the event queue.
#pragma once

#include <Velmar/MacTypes.h>

class QEvent;
class QKeyEvent;
class QMouseEvent;
class QWidget;

namespace Velmar {

class AQtWindow;

namespace Private {
class EventQueueItem;
class EventQueue;
} // namespace Private

struct EventRecord;

// An event is one reference-counted library object; the Carbon handle is a bare pointer to it.
using EventRef = Private::EventQueueItem*;
using EventQueue = Private::EventQueue;
using EventQueueRef = Private::EventQueue*;
using EventLoopRef = Private::EventQueue*;

using EventClass = UInt32;
using EventKind = UInt32;
using EventAttributes = UInt32;
using EventParamName = OSType;
using EventParamType = OSType;
using EventPriority = SInt16;
using EventTime = double;            // seconds
using EventTimeout = EventTime;
using EventTimerInterval = EventTime;
using ByteCount = UInt32;
using CFAllocatorRef = const void*;  // accepted and ignored

struct EventTypeSpec {
    UInt32 eventClass;
    UInt32 eventKind;
};

constexpr EventTime kEventDurationSecond = 1.0;
constexpr EventTime kEventDurationMillisecond = kEventDurationSecond / 1000;
constexpr EventTime kEventDurationNoWait = 0.0;
constexpr EventTime kEventDurationForever = -1.0;

enum : EventAttributes {
    kEventAttributeNone = 0,
    kEventAttributeUserEvent = 1,
};

enum : EventPriority {
    kEventPriorityLow = 0,
    kEventPriorityStandard = 1,
    kEventPriorityHigh = 2,
};

// Event classes.
enum : EventClass {
    kEventClassMouse = FOUR_CHAR_CODE("mous"),
    kEventClassKeyboard = FOUR_CHAR_CODE("keyb"),
    kEventClassWindow = FOUR_CHAR_CODE("wind"),
    kEventClassApplication = FOUR_CHAR_CODE("appl"),
    // The library's own class: events with no event-record form, for Carbon handlers only.
    kEventClassVelmar = FOUR_CHAR_CODE("vlmr"),
};

// Kinds of the library's class.
enum : EventKind {
    kEventVelmarMenuTriggered = FOUR_CHAR_CODE("mntg"), // a menu item fired: call MenuSelect
    kEventVelmarUpdateMenus = FOUR_CHAR_CODE("upmn"),   // a menu is about to show
    kEventVelmarResized = FOUR_CHAR_CODE("size"),
    kEventVelmarZoomed = FOUR_CHAR_CODE("zoom"),
    kEventVelmarMoved = FOUR_CHAR_CODE("move"),
    kEventVelmarCloseRequested = FOUR_CHAR_CODE("clos"),
};

// Kinds of the mouse class.
enum : EventKind {
    kEventMouseDown = 1,
    kEventMouseUp = 2,
    kEventMouseMoved = 5,
    kEventMouseDragged = 6,
    kEventMouseWheelMoved = 10,
};

// Kinds of the keyboard class.
enum : EventKind {
    kEventRawKeyDown = 1,
    kEventRawKeyRepeat = 2,
    kEventRawKeyUp = 3,
};

// Kinds of the window class.
enum : EventKind {
    kEventWindowUpdate = 1,
    kEventWindowActivated = 5,
    kEventWindowDeactivated = 6,
    kEventWindowShown = 24,
    kEventWindowHidden = 25,
    kEventWindowBoundsChanged = 27,
};

// Kinds of the application class.
enum : EventKind {
    kEventAppActivated = 1,
    kEventAppDeactivated = 2,
};

// Parameter names.
enum : EventParamName {
    kEventParamMouseButton = FOUR_CHAR_CODE("mbtn"),
    kEventParamWindowRef = FOUR_CHAR_CODE("wind"),
    kEventParamWindowPartCode = FOUR_CHAR_CODE("wpar"),
    kEventParamMouseLocation = FOUR_CHAR_CODE("mloc"),
    kEventParamKeyModifiers = FOUR_CHAR_CODE("kmod"),
    kEventParamKeyCode = FOUR_CHAR_CODE("kcod"),
    kEventParamKeyMacCharCodes = FOUR_CHAR_CODE("kchr"),
    kEventParamMouseWheelAxis = FOUR_CHAR_CODE("mwax"),
    kEventParamMouseWheelDelta = FOUR_CHAR_CODE("mwdl"),
    kEventParamCurrentBounds = FOUR_CHAR_CODE("crct"),
    kEventParamDirectObject = FOUR_CHAR_CODE("----"),
};

// Parameter types.
enum : EventParamType {
    typeMouseButton = FOUR_CHAR_CODE("mbtn"),
    typeWindowRef = FOUR_CHAR_CODE("wind"),
    typeWindowPartCode = FOUR_CHAR_CODE("wpar"),
    typeQDPoint = FOUR_CHAR_CODE("QDpt"),
    typeUInt32 = FOUR_CHAR_CODE("magn"),
    typeChar = FOUR_CHAR_CODE("TEXT"),
    typeMouseWheelAxis = FOUR_CHAR_CODE("mwax"),
    typeSInt32 = FOUR_CHAR_CODE("long"),
    typeLongInteger = FOUR_CHAR_CODE("long"),
    typeQDRectangle = FOUR_CHAR_CODE("qdrt"),
    typeFSVolumeRefNum = FOUR_CHAR_CODE("voln"),
};

enum : UInt16 {
    kEventMouseButtonPrimary = 1,
    kEventMouseButtonSecondary = 2,
    kEventMouseButtonTertiary = 3,
};

enum : UInt16 {
    kEventMouseWheelAxisX = 0,
    kEventMouseWheelAxisY = 1,
};

// ---------------------------------------------------------------------------------------
// Event objects.
VELMAR_EXPORT void RetainEvent(EventRef event);
VELMAR_EXPORT void ReleaseEvent(EventRef event);
VELMAR_EXPORT UInt32 GetEventClass(EventRef event);
VELMAR_EXPORT UInt32 GetEventKind(EventRef event);
VELMAR_EXPORT EventTime GetEventTime(EventRef event);

// The `when` argument is not used: events made here report time 0.
VELMAR_EXPORT OSStatus MacCreateEvent(CFAllocatorRef allocator, UInt32 eventClass, UInt32 kind,
                                      EventTime when, EventAttributes flags, EventRef* outEvent);

// No coercion is ever made. A parameter whose value is all zero bytes counts as absent
// (eventParameterNotFoundErr), except the wheel axis and delta of wheel events.
VELMAR_EXPORT OSStatus GetEventParameter(EventRef event, EventParamName name,
                                         EventParamType desiredType,
                                         EventParamType* outActualType, ByteCount bufferSize,
                                         ByteCount* outActualSize, void* outData);
VELMAR_EXPORT OSStatus SetEventParameter(EventRef event, EventParamName name, EventParamType type,
                                         ByteCount size, const void* data);

VELMAR_EXPORT bool ConvertEventRefToEventRecord(EventRef event, EventRecord* outRecord);

// A Qt event as an event object, as windows (`window`) and the application (null) convert
// what they receive: Mac key and char codes, Mac modifiers, global points, wheel steps,
// window and application events. False when the Qt event makes no Toolbox event. Mouse
// positions are taken relative to `widget`.
VELMAR_EXPORT bool ConvertVelmarEvent(AQtWindow* window, QEvent* e, EventRef item);
VELMAR_EXPORT bool ConvertMouseEvent(QMouseEvent* e, EventRef item, const QWidget* widget);
VELMAR_EXPORT bool ConvertKeyEvent(QKeyEvent* e, EventRef item);

// ---------------------------------------------------------------------------------------
// The event queue. There is one; every accessor returns it.
using EventComparatorProcPtr = bool (*)(EventRef event, void* data);
using EventComparatorUPP = EventComparatorProcPtr;

VELMAR_EXPORT EventQueueRef GetMainEventQueue();
VELMAR_EXPORT EventQueueRef GetCurrentEventQueue();
VELMAR_EXPORT EventLoopRef GetMainEventLoop();

VELMAR_EXPORT EventComparatorUPP NewEventComparatorUPP(EventComparatorProcPtr proc);
VELMAR_EXPORT void DisposeEventComparatorUPP(EventComparatorUPP proc);

// The priority is accepted and ignored.
VELMAR_EXPORT OSStatus PostEventToQueue(EventQueueRef queue, EventRef event, EventPriority priority);
VELMAR_EXPORT OSStatus FlushSpecificEventsFromQueue(EventQueueRef queue,
                                                    EventComparatorUPP comparator, void* data);
// No reference is added to the event returned.
VELMAR_EXPORT EventRef FindSpecificEventInQueue(EventQueueRef queue, EventComparatorUPP comparator,
                                                void* data);
VELMAR_EXPORT OSStatus RemoveEventFromQueue(EventQueueRef queue, EventRef event);
VELMAR_EXPORT UInt32 GetNumEventsInQueue(EventQueueRef queue);

} // namespace Velmar
