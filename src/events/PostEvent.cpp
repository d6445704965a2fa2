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

} // namespace

void FillNullEvent(EventQueueItem* item)
{
    if (!item)
        return;
    item->clear();
    item->when = TickCount();
    item->where = globalMousePosition();
    item->modifiers = GetCurrentKeyModifiers();
}

} // namespace Private

OSErr PostEvent(UInt16 eventCode, UInt32 eventMsg)
{
    using namespace Private;
    EventQueueItemSmartPtr item = EventQueueItemSmartPtr::Create();
    FillNullEvent(item.get());

    // Codes 1 to 6 have a Carbon form; everything else travels as a 'vlme' event.
    if (eventCode < 7) {
        EventTypeList pairs;
        if (ParseEventMask(UInt16(1u << eventCode), pairs) == 1) {
            item->eventClass = pairs.specs[0].eventClass;
            item->eventKind = pairs.specs[0].eventKind;
        }
    }
    if (item->isNullEvent()) {
        item->eventClass = kEventClassVelmarClassic;
        item->eventKind = eventCode;
    }
    item->message = eventMsg;
    ScheduleEvent(item, EventQueueItem::NoMerge);
    return noErr;
}

OSStatus PostEventToQueue(EventQueueRef queue, EventRef event, EventPriority)
{
    if (!queue || !event)
        return eventInternalErr;
    if (queue != GetMainEventQueue())
        velmar_assert("inQueue == Velmar::GetMainEventQueue()", __FILE__, __LINE__, __func__,
                      "inQueue == Velmar::GetMainEventQueue()");
    Private::ScheduleEvent(Private::EventQueueItemSmartPtr(event), Private::EventQueueItem::NoMerge);
    return noErr;
}

} // namespace Velmar
