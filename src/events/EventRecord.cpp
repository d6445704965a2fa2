// Flattening an event into a classic EventRecord.
#include "events/EventQueueItem.h"

#include <Velmar/Diagnostics.h>

namespace Velmar {

namespace Private {

namespace {

// What besides `what` a record of each row receives.
enum class RecordFill { None, Classic, Modifiers, Key, Active, Inactive, Resume, Suspend };

struct RecordRow {
    UInt32 eventClass;
    UInt32 eventKind;
    UInt16 what;
    RecordFill fill;
};

// The record-compatible events: these rows plus class 'vlme' with any kind.
const RecordRow kRecordRows[] = {
    {0, 0, nullEvent, RecordFill::None},
    {kEventClassMouse, kEventMouseDown, mouseDown, RecordFill::Modifiers},
    {kEventClassMouse, kEventMouseUp, mouseUp, RecordFill::Modifiers},
    {kEventClassKeyboard, kEventRawKeyDown, keyDown, RecordFill::Key},
    {kEventClassKeyboard, kEventRawKeyUp, keyUp, RecordFill::Key},
    {kEventClassKeyboard, kEventRawKeyRepeat, autoKey, RecordFill::Key},
    {kEventClassWindow, kEventWindowUpdate, updateEvt, RecordFill::None},
    {kEventClassWindow, kEventWindowActivated, activateEvt, RecordFill::Active},
    {kEventClassWindow, kEventWindowDeactivated, activateEvt, RecordFill::Inactive},
    {kEventClassApplication, kEventAppActivated, osEvt, RecordFill::Resume},
    {kEventClassApplication, kEventAppDeactivated, osEvt, RecordFill::Suspend},
};

constexpr UInt32 kSuspendResumeMessage = UInt32(suspendResumeMessage) << 24;

const RecordRow* findRow(UInt32 eventClass, UInt32 eventKind)
{
    for (const RecordRow& row : kRecordRows) {
        if (row.eventClass == eventClass && row.eventKind == eventKind)
            return &row;
    }
    return nullptr;
}

bool isRecordClass(UInt32 eventClass)
{
    for (const RecordRow& row : kRecordRows) {
        if (row.eventClass == eventClass)
            return true;
    }
    return false;
}

} // namespace

bool EventQueueItem::isEventRecordCompatible() const
{
    return eventClass == kEventClassVelmarClassic || findRow(eventClass, eventKind) != nullptr;
}

EventRecord EventQueueItem::toEventRecord() const
{
    EventRecord record{};
    record.when = when;
    record.where = where;
    record.window = window;

    RecordFill fill;
    if (eventClass == kEventClassVelmarClassic) {
        record.what = UInt16(eventKind & 0xFFFF);
        fill = RecordFill::Classic;
    } else if (const RecordRow* row = findRow(eventClass, eventKind)) {
        record.what = row->what;
        fill = row->fill;
    } else {
        // An unknown kind of a record class, or a class records never have.
        VELMAR_ASSERT(false, isRecordClass(eventClass) ? "false" : "FALSE");
        return record;
    }

    switch (fill) {
    case RecordFill::None:
        break;
    case RecordFill::Classic:
    case RecordFill::Key:
        record.message = fill == RecordFill::Classic ? message : keyMessage;
        record.modifiers = UInt16(modifiers);
        record.textUnit = textUnit;
        record.qtKey = qtKey;
        record.qtModifiers = qtModifiers;
        break;
    case RecordFill::Modifiers:
        record.modifiers = UInt16(modifiers);
        break;
    case RecordFill::Active:
        record.modifiers = activeFlag;
        break;
    case RecordFill::Inactive:
        record.modifiers = 0;
        break;
    case RecordFill::Resume:
        record.message = kSuspendResumeMessage | resumeFlag;
        break;
    case RecordFill::Suspend:
        record.message = kSuspendResumeMessage;
        break;
    }
    return record;
}

} // namespace Private

bool ConvertEventRefToEventRecord(EventRef event, EventRecord* outRecord)
{
    if (!event || !outRecord || !VELMAR_CHECK_EVENT(event) || !event->isEventRecordCompatible())
        return false;
    *outRecord = event->toEventRecord();
    return true;
}

} // namespace Velmar
