// Classic event masks as lists of Carbon (class, kind) pairs, and the matching rule that
// queue searches, flushes and handler type lists share.
#pragma once

#include <Velmar/CarbonEvents.h>

namespace Velmar::Private {

class EventQueueItem;

// Enough room for every pair the mask table can give.
struct EventTypeList {
    static constexpr int kCapacity = 10;
    EventTypeSpec specs[kCapacity];
    UInt32 count = 0;
};

// Fills `out` with the pairs of the mask's bits, in table order. everyEvent gives none
// (which matches everything). Returns the number of pairs, or -1 (with one debug line)
// when not a single bit of a non-zero mask is known.
int ParseEventMask(UInt16 mask, EventTypeList& out);

// Classic event codes 1 to 6 (mouseDown to updateEvt) have one Carbon (class, kind) pair;
// false for every other code, which has no Carbon form.
bool ClassicEventType(UInt16 eventCode, EventTypeSpec& out);

// An empty list matches every event.
bool MatchesEventTypes(const EventTypeSpec* list, UInt32 count, UInt32 eventClass, UInt32 eventKind);
bool MatchesEventTypes(const EventTypeSpec* list, UInt32 count, const EventQueueItem* item);
inline bool MatchesEventTypes(const EventTypeList& list, const EventQueueItem* item)
{
    return MatchesEventTypes(list.specs, list.count, item);
}

} // namespace Velmar::Private
