// PostEvent and PostEventToQueue.
#include "events/PostEvent.h"

#include "events/EventMask.h"
#include "events/EventQueue.h"

#include <Velmar/Diagnostics.h>
#include <Velmar/MacErrors.h>

#include <QCursor>
#include <QGuiApplication>

namespace Velmar {

namespace Private {

namespace {

Point globalMousePosition()
{
    // QCursor needs a GUI application; without one there is no mouse to ask.
    if (!qobject_cast<QGuiApplication*>(QCoreApplication::instance()))
        return Point{0, 0};
    const QPoint p = QCursor::pos();
    return Point{SInt16(p.y()), SInt16(p.x())};
}

// The mouse position and modifiers every posted event carries. Asking for them costs a
// round trip to the X server each (pointer position, caps lock), far more than the rest of
// a post, so they are read at most once per tick: events stamped in the same 1/60 s share
// their time stamp already, and now their position and modifiers too. Qt's own modifier
// and button state is part of the key (it is plain memory, updated as input is delivered),
// so a modifier or button change the application has seen is picked up at once; a pointer
// move or caps lock toggle within the tick is not, until ForgetInputSnapshot() is called.
struct InputSnapshot {
    bool valid = false;
    UInt32 tick = 0;
    Qt::KeyboardModifiers qtModifiers;
    Qt::MouseButtons qtButtons;
    Point where{0, 0};
    UInt32 modifiers = 0;
};

InputSnapshot gSnapshot;

const InputSnapshot& currentInput(UInt32 tick)
{
    const Qt::KeyboardModifiers qtModifiers = QGuiApplication::keyboardModifiers();
    const Qt::MouseButtons qtButtons = QGuiApplication::mouseButtons();
    if (!gSnapshot.valid || gSnapshot.tick != tick || gSnapshot.qtModifiers != qtModifiers
        || gSnapshot.qtButtons != qtButtons) {
        gSnapshot.where = globalMousePosition();
        gSnapshot.modifiers = GetCurrentKeyModifiers();
        gSnapshot.tick = tick;
        gSnapshot.qtModifiers = qtModifiers;
        gSnapshot.qtButtons = qtButtons;
        gSnapshot.valid = true;
    }
    return gSnapshot;
}

} // namespace

void ForgetInputSnapshot()
{
    gSnapshot.valid = false;
}

void FillNullEvent(EventQueueItem* item)
{
    if (!item)
        return;
    item->clear();
    item->when = TickCount();
    const InputSnapshot& input = currentInput(item->when);
    item->where = input.where;
    item->modifiers = input.modifiers;
}

} // namespace Private

OSErr PostEvent(UInt16 eventCode, UInt32 eventMsg)
{
    using namespace Private;
    EventQueueItemSmartPtr item = EventQueueItemSmartPtr::Create();
    FillNullEvent(item.get());

    // Codes 1 to 6 have a Carbon form; everything else travels as a 'vlme' event.
    EventTypeSpec type{kEventClassVelmarClassic, eventCode};
    ClassicEventType(eventCode, type);
    item->eventClass = type.eventClass;
    item->eventKind = type.eventKind;
    item->message = eventMsg;
    ScheduleEvent(item, EventQueueItem::NoMerge);
    return noErr;
}

OSStatus PostEventToQueue(EventQueueRef queue, EventRef event, EventPriority)
{
    if (!queue || !event)
        return eventInternalErr;
    // The event goes to the one queue even when the reference named another.
    VELMAR_CHECK_QUEUE(queue);
    if (!VELMAR_CHECK_EVENT(event))
        return eventInternalErr;
    Private::ScheduleEvent(Private::EventQueueItemSmartPtr(event), Private::EventQueueItem::NoMerge);
    return noErr;
}

} // namespace Velmar
