// The one process-wide event queue, the single entry for new events (ScheduleEvent) and
// the queue-changed wake-up signal.
#pragma once

#include "events/EventMask.h"
#include "events/EventQueueItem.h"

#include <QEvent>
#include <QEventLoop>

#include <deque>
#include <unordered_map>
#include <vector>

namespace Velmar::Private {

class TimerRegistry;

class EventQueue {
public:
    EventQueue();
    ~EventQueue();
    EventQueue(const EventQueue&) = delete;
    EventQueue& operator=(const EventQueue&) = delete;

    UInt32 count() const { return m_live; }
    bool isEmpty() const { return m_live == 0; }
    // The queued items, oldest first, each with its own reference: a copy the caller may walk
    // while the queue changes.
    std::vector<EventQueueItemSmartPtr> items() const;
    // The first queued item for which pred(item) is true, oldest first, or null. For the
    // library's own tests of an item: `pred` must not change the queue.
    template <typename Pred>
    EventQueueItem* firstWhere(Pred pred) const;

    // Appends without merging and raises the queue-changed signal. ScheduleEvent is the
    // entry for new events; this is its last step. An item may be queued more than once.
    void append(const EventQueueItemSmartPtr& item);
    // Removes the first entry holding `item`. False when it is not queued.
    bool remove(const EventQueueItem* item);
    // Removes every entry for which pred(item) is true; returns how many went. `pred` may be
    // a host's comparator: it may post, remove or flush while it runs. It is shown each item
    // that was queued when the call began and is still queued when its turn comes.
    template <typename Pred>
    int removeIf(Pred pred);
    // The first item for which pred(item) is true and which is still queued once pred has
    // answered, or null. The same guarantees as removeIf.
    template <typename Pred>
    EventQueueItem* findIf(Pred pred);
    // True while `item` (a live item) is queued.
    bool contains(const EventQueueItem* item) const { return item && item->queuePlace.entries; }
    // Removes the entries holding these items in one pass; returns how many went.
    int removeAll(const std::vector<const EventQueueItem*>& items);

    // The first item whose (class, kind) is in the list (an empty list matches all),
    // looked at or taken out. Null when none matches. Logarithmic in the queue's length.
    EventQueueItem* findFirstMatching(const EventTypeSpec* list, UInt32 count) const;
    EventQueueItemSmartPtr takeFirstMatching(const EventTypeSpec* list, UInt32 count);

    // Carbon handler dispatch is off while a ScopedCarbonEventsBlocker lives. Setting the
    // flag only stores it: the blocker suspends the timers and raises the signal itself.
    bool CheckCarbonEventsDisabled() const { return m_carbonEventsDisabled; }
    void SetCarbonEventsDisabled(bool disabled) { m_carbonEventsDisabled = disabled; }

    // Posts one EventQueueChangedEvent to the application unless one is in flight, Carbon
    // events are disabled, or there is nothing to collect.
    void RaiseQueueChangedSignal();
    bool hasQueueChangeEvent() const { return m_hasQueueChangeEvent; }
    // Called when the in-flight wake-up event is destroyed.
    void CallbackQueueChangeEventRemoved();
    // For a waiter that consumed the wake-up event: clears the in-flight mark at once.
    void ClearQueueChangeEventMark() { m_hasQueueChangeEvent = false; }

    UInt16 eventMask() const { return m_eventMask; }
    void setEventMask(UInt16 mask) { m_eventMask = mask; }

    // The event loop timers. Defined with the timer machinery.
    TimerRegistry& timerRegistry();

    // Lets Qt run one pass with Carbon dispatch blocked.
    void ProcessNonCarbonEvents(QEventLoop::ProcessEventsFlags flags);
    // True while that pass runs (paint statistics count paints made inside it).
    bool inNonCarbonProcessing() const { return m_inNonCarbonProcessing; }

    // Drops every queued item (tests, shutdown).
    void clearAll();
    // Files the queued items by type again, after a queued item's class or kind changed.
    void reindex() const { rebuildIndex(); }

private:
    // Entries in queue order with rising sequence numbers. An entry taken out of the middle
    // stays as a gap (null item) until the gaps outnumber the items, so that every entry
    // keeps its place and is found again by binary search on its number.
    struct Entry {
        UInt64 sequence;
        EventQueueItemSmartPtr item;
    };
    using EntryList = std::deque<Entry>;

    EntryList::iterator entryAt(UInt64 sequence);
    EntryList::const_iterator entryAt(UInt64 sequence) const;
    bool isQueued(UInt64 sequence) const;
    // The oldest queued entry of one (class, kind), or null; drops stale index numbers.
    const Entry* oldestOfType(UInt32 eventClass, UInt32 eventKind) const;
    const Entry* oldestMatching(const EventTypeSpec* list, UInt32 count) const;
    // Takes the entry's item out of the queue (the entry becomes a gap) and returns it.
    EventQueueItemSmartPtr takeEntry(EntryList::iterator entry);
    void dropGaps();
    void rebuildIndex() const;

    EntryList m_entries;
    UInt32 m_live = 0;
    UInt64 m_nextSequence = 1;
    // Sequence numbers of each (class, kind), oldest first. Numbers of entries taken out
    // stay until they reach the front or the list is rebuilt.
    mutable std::unordered_map<UInt64, std::deque<UInt64>> m_byType;
    bool m_inNonCarbonProcessing = false;
    bool m_hasQueueChangeEvent = false;
    bool m_carbonEventsDisabled = false;
    UInt16 m_eventMask = 7;
};

extern EventQueue gMainEventQueue;
inline EventQueue* MainEventQueue() { return &gMainEventQueue; }

// There is one queue. Another non-null queue reference raises the assertion
// "inQueue == Velmar::GetMainEventQueue()" and gives false; null gives false silently.
bool checkMainQueue(const EventQueue* queue, const char* file, int line, const char* function);
#define VELMAR_CHECK_QUEUE(queue)                                                          \
    ::Velmar::Private::checkMainQueue((queue), __FILE__, __LINE__, __func__)

// The wake-up posted to the application when the queue changed. Its type is registered
// with Qt once, at start.
class EventQueueChangedEvent : public QEvent {
public:
    EventQueueChangedEvent();
    ~EventQueueChangedEvent() override;
    static QEvent::Type eventType();

    // Set by the waiter that handled it: the in-flight mark was already cleared.
    bool alreadyCounted = false;
};

// The single entry for new events: dispatch at once, merge with a queued twin, or append.
void ScheduleEvent(const EventQueueItemSmartPtr& item, EventQueueItem::MergePolicy policy);

// Window disposal: revokes and removes its queued events, forgets it on the dispatch stack
// and clears its pending update event.
void FlushEventReferences(AQtWindow* window);

template <typename Pred>
EventQueueItem* EventQueue::firstWhere(Pred pred) const
{
    for (const Entry& entry : m_entries) {
        if (entry.item && pred(entry.item.get()))
            return entry.item.get();
    }
    return nullptr;
}

template <typename Pred>
int EventQueue::removeIf(Pred pred)
{
    // Walk a snapshot that holds its own references: whatever the predicate does to the
    // queue, no item it is shown can be freed under it and no iterator can go stale.
    const std::vector<EventQueueItemSmartPtr> queued = items();
    std::vector<const EventQueueItem*> doomed;
    for (const EventQueueItemSmartPtr& item : queued) {
        if (contains(item.get()) && pred(item.get()))
            doomed.push_back(item.get());
    }
    return removeAll(doomed);
}

template <typename Pred>
EventQueueItem* EventQueue::findIf(Pred pred)
{
    const std::vector<EventQueueItemSmartPtr> queued = items();
    for (const EventQueueItemSmartPtr& item : queued) {
        // The item is handed back without a reference: only while the queue still holds one.
        if (contains(item.get()) && pred(item.get()) && contains(item.get()))
            return item.get();
    }
    return nullptr;
}

} // namespace Velmar::Private
