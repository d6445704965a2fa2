// Classic event masks as (class, kind) lists, and the matching rule.
#include "events/EventMask.h"

#include "events/EventQueueItem.h"

#include <QtDebug>

namespace Velmar::Private {

namespace {

struct MaskRow {
    UInt16 bit;
    UInt32 eventClass;
    UInt32 eventKind;
};

// In this order; activate and os bits each stand for two kinds.
const MaskRow kMaskRows[] = {
    {mDownMask, kEventClassMouse, kEventMouseDown},
    {mUpMask, kEventClassMouse, kEventMouseUp},
    {keyDownMask, kEventClassKeyboard, kEventRawKeyDown},
    {keyUpMask, kEventClassKeyboard, kEventRawKeyUp},
    {autoKeyMask, kEventClassKeyboard, kEventRawKeyRepeat},
    {updateMask, kEventClassWindow, kEventWindowUpdate},
    {activMask, kEventClassWindow, kEventWindowActivated},
    {activMask, kEventClassWindow, kEventWindowDeactivated},
    {osMask, kEventClassApplication, kEventAppActivated},
    {osMask, kEventClassApplication, kEventAppDeactivated},
};

static_assert(sizeof(kMaskRows) / sizeof(kMaskRows[0]) <= EventTypeList::kCapacity);

} // namespace

int ParseEventMask(UInt16 mask, EventTypeList& out)
{
    out.count = 0;
    if (mask == everyEvent)
        return 0;
    UInt16 unparsed = mask;
    for (const MaskRow& row : kMaskRows) {
        if (mask & row.bit) {
            out.specs[out.count++] = EventTypeSpec{row.eventClass, row.eventKind};
            unparsed &= UInt16(~row.bit);
        }
    }
    if (mask != 0 && unparsed == mask) {
        qDebug("Unable to parse eventMask at all.... Returning negative");
        return -1;
    }
    return int(out.count);
}

bool ClassicEventType(UInt16 eventCode, EventTypeSpec& out)
{
    if (eventCode < 1 || eventCode > 6)
        return false;
    for (const MaskRow& row : kMaskRows) {
        if (row.bit == (1u << eventCode)) {
            out = EventTypeSpec{row.eventClass, row.eventKind};
            return true;
        }
    }
    return false;
}

bool MatchesEventTypes(const EventTypeSpec* list, UInt32 count, UInt32 eventClass, UInt32 eventKind)
{
    if (count == 0 || !list)
        return true;
    for (UInt32 i = 0; i < count; ++i) {
        if (list[i].eventClass == eventClass && list[i].eventKind == eventKind)
            return true;
    }
    return false;
}

bool MatchesEventTypes(const EventTypeSpec* list, UInt32 count, const EventQueueItem* item)
{
    return item && MatchesEventTypes(list, count, item->eventClass, item->eventKind);
}

} // namespace Velmar::Private
