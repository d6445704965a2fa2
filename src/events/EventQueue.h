// The one process-wide event queue, the single entry for new events (ScheduleEvent) and
// the queue-changed wake-up signal.
#pragma once

#include "events/EventMask.h"
#include "events/EventQueueItem.h"

#include <QEvent>
#include <QEventLoop>

#include <deque>
#include <vector>

namespace Velmar::Private {

class TimerRegistry;

class EventQueue {
public:
    using ItemList = std::deque<EventQueueItemSmartPtr>;

    EventQueue();
    ~EventQueue();
    EventQueue(const EventQueue&) = delete;
    EventQueue& operator=(const EventQueue&) = delete;

    // The queued items, oldest first. Each entry holds one reference.
    const ItemList& items() const { return m_items; }
    UInt32 count() const { return UInt32(m_items.size()); }
    bool isEmpty() const { return m_items.empty(); }

    // Appends without merging and raises the queue-changed signal. ScheduleEvent is the
    // entry for new events; this is its last step.
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
    // True while `item` is queued.
    bool contains(const EventQueueItem* item) const;
    // Removes the entries holding these items in one pass; returns how many went.
    int removeAll(const std::vector<const EventQueueItem*>& items);

    // The first item whose (class, kind) is in the list (an empty list matches all),
    // looked at or taken out. Null when none matches.
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

private:
    ItemList m_items;
    UInt64 m_changes = 0; // bumped by every change of m_items
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
int EventQueue::removeIf(Pred pred)
{
    // Walk a snapshot that holds its own references: whatever the predicate does to the
    // queue, no item it is shown can be freed under it and no iterator can go stale. Only
    // once the queue has changed under the walk is each item checked to be still queued.
    const std::vector<EventQueueItemSmartPtr> snapshot(m_items.begin(), m_items.end());
    const UInt64 changesAtStart = m_changes;
    std::vector<const EventQueueItem*> doomed;
    for (const EventQueueItemSmartPtr& item : snapshot) {
        if (m_changes != changesAtStart && !contains(item.get()))
            continue;
        if (pred(item.get()))
            doomed.push_back(item.get());
    }
    return removeAll(doomed);
}

template <typename Pred>
EventQueueItem* EventQueue::findIf(Pred pred)
{
    const std::vector<EventQueueItemSmartPtr> snapshot(m_items.begin(), m_items.end());
    const UInt64 changesAtStart = m_changes;
    for (const EventQueueItemSmartPtr& item : snapshot) {
        if (m_changes != changesAtStart && !contains(item.get()))
            continue;
        // The item is handed back without a reference: only while the queue still holds one.
        if (pred(item.get()) && (m_changes == changesAtStart || contains(item.get())))
            return item.get();
    }
    return nullptr;
}

} // namespace Velmar::Private
