// The main event queue's list, its wake-up signal and the queue accessors.
#include "events/EventQueue.h"

#include "events/EventQueueHooks.h"

#include <Velmar/Diagnostics.h>

#include <QCoreApplication>

#include <algorithm>

namespace Velmar {

namespace Private {

namespace {

// Registered once, when the library is loaded.
const QEvent::Type kQueueChangedEventType = QEvent::Type(QEvent::registerEventType());

} // namespace

EventQueue gMainEventQueue;

EventQueue::EventQueue() = default;

EventQueue::~EventQueue()
{
    clearAll();
}

namespace {

UInt64 typeKey(UInt32 eventClass, UInt32 eventKind)
{
    return UInt64(eventClass) << 32 | eventKind;
}

// Gaps are dropped once they outnumber the items by this much: each rebuild is paid for by
// as many removals as it walks entries.
constexpr size_t kGapSlack = 64;

} // namespace

std::vector<EventQueueItemSmartPtr> EventQueue::items() const
{
    std::vector<EventQueueItemSmartPtr> items;
    items.reserve(m_live);
    for (const Entry& entry : m_entries) {
        if (entry.item)
            items.push_back(entry.item);
    }
    return items;
}

void EventQueue::append(const EventQueueItemSmartPtr& item)
{
    if (!item)
        return;
    const UInt64 sequence = m_nextSequence++;
    m_entries.push_back(Entry{sequence, item});
    item->queuePlace.entries += 1;
    item->queuePlace.sequence = sequence;
    ++m_live;
    m_byType[typeKey(item->eventClass, item->eventKind)].push_back(sequence);
    RaiseQueueChangedSignal();
}

EventQueue::EntryList::iterator EventQueue::entryAt(UInt64 sequence)
{
    return std::lower_bound(m_entries.begin(), m_entries.end(), sequence,
        [](const Entry& entry, UInt64 wanted) { return entry.sequence < wanted; });
}

EventQueue::EntryList::const_iterator EventQueue::entryAt(UInt64 sequence) const
{
    return std::lower_bound(m_entries.begin(), m_entries.end(), sequence,
        [](const Entry& entry, UInt64 wanted) { return entry.sequence < wanted; });
}

bool EventQueue::isQueued(UInt64 sequence) const
{
    const auto entry = entryAt(sequence);
    return entry != m_entries.end() && entry->sequence == sequence && entry->item;
}

EventQueueItemSmartPtr EventQueue::takeEntry(EntryList::iterator entry)
{
    EventQueueItemSmartPtr item = std::move(entry->item);
    entry->item = EventQueueItemSmartPtr();
    item->queuePlace.entries -= 1;
    --m_live;
    dropGaps();
    return item;
}

void EventQueue::dropGaps()
{
    while (!m_entries.empty() && !m_entries.front().item)
        m_entries.pop_front();
    while (!m_entries.empty() && !m_entries.back().item)
        m_entries.pop_back();
    if (m_entries.size() <= 2 * size_t(m_live) + kGapSlack)
        return;
    EntryList kept;
    for (Entry& entry : m_entries) {
        if (entry.item)
            kept.push_back(std::move(entry));
    }
    m_entries.swap(kept);
    rebuildIndex();
}

void EventQueue::rebuildIndex() const
{
    m_byType.clear();
    for (const Entry& entry : m_entries) {
        if (entry.item)
            m_byType[typeKey(entry.item->eventClass, entry.item->eventKind)].push_back(
                entry.sequence);
    }
}

bool EventQueue::remove(const EventQueueItem* item)
{
    if (!contains(item))
        return false;
    auto entry = m_entries.end();
    if (item->queuePlace.entries == 1) {
        entry = entryAt(item->queuePlace.sequence);
    } else {
        // Queued more than once: the oldest entry goes.
        entry = std::find_if(m_entries.begin(), m_entries.end(),
            [item](const Entry& queued) { return queued.item.get() == item; });
    }
    if (entry == m_entries.end() || entry->item.get() != item)
        return false;
    // Released after the entry is gone: its destruction must see a consistent queue.
    const EventQueueItemSmartPtr gone = takeEntry(entry);
    return true;
}

bool checkMainQueue(const EventQueue* queue, const char* file, int line, const char* function)
{
    if (queue == &gMainEventQueue)
        return true;
    if (queue)
        velmar_assert("inQueue == Velmar::GetMainEventQueue()", file, line, function, nullptr);
    return false;
}

const EventQueue::Entry* EventQueue::oldestOfType(UInt32 eventClass, UInt32 eventKind) const
{
    const auto found = m_byType.find(typeKey(eventClass, eventKind));
    if (found == m_byType.end())
        return nullptr;
    std::deque<UInt64>& sequences = found->second;
    while (!sequences.empty()) {
        const auto entry = entryAt(sequences.front());
        if (entry != m_entries.end() && entry->sequence == sequences.front() && entry->item)
            return &*entry;
        sequences.pop_front();
    }
    m_byType.erase(found);
    return nullptr;
}

const EventQueue::Entry* EventQueue::oldestMatching(const EventTypeSpec* list, UInt32 count) const
{
    if (count == 0 || !list) {
        for (const Entry& entry : m_entries) {
            if (entry.item)
                return &entry;
        }
        return nullptr;
    }
    const Entry* oldest = nullptr;
    for (UInt32 i = 0; i < count; ++i) {
        const Entry* entry = oldestOfType(list[i].eventClass, list[i].eventKind);
        if (entry && (!oldest || entry->sequence < oldest->sequence))
            oldest = entry;
    }
    return oldest;
}

EventQueueItem* EventQueue::findFirstMatching(const EventTypeSpec* list, UInt32 count) const
{
    const Entry* entry = oldestMatching(list, count);
    return entry ? entry->item.get() : nullptr;
}

EventQueueItemSmartPtr EventQueue::takeFirstMatching(const EventTypeSpec* list, UInt32 count)
{
    const Entry* oldest = oldestMatching(list, count);
    if (!oldest)
        return EventQueueItemSmartPtr();
    return takeEntry(entryAt(oldest->sequence));
}

void EventQueue::clearAll()
{
    EntryList gone;
    gone.swap(m_entries);
    m_byType.clear();
    m_live = 0;
    for (Entry& entry : gone) {
        if (entry.item)
            entry.item->queuePlace.entries = 0;
    }
}

int EventQueue::removeAll(const std::vector<const EventQueueItem*>& items)
{
    if (items.empty())
        return 0;
    std::vector<const EventQueueItem*> doomed = items;
    std::sort(doomed.begin(), doomed.end());
    // Released only once the queue is consistent again: a destructor may look at it.
    std::vector<EventQueueItemSmartPtr> gone;
    EntryList kept;
    for (Entry& entry : m_entries) {
        if (!entry.item)
            continue;
        if (std::binary_search(doomed.begin(), doomed.end(), entry.item.get())) {
            entry.item->queuePlace.entries -= 1;
            gone.push_back(std::move(entry.item));
        } else {
            kept.push_back(std::move(entry));
        }
    }
    m_entries.swap(kept);
    m_live -= UInt32(gone.size());
    rebuildIndex();
    return int(gone.size());
}

void EventQueue::RaiseQueueChangedSignal()
{
    if (m_carbonEventsDisabled || m_hasQueueChangeEvent)
        return;
    if (m_live == 0 && (!LegacyEventProcessing() || CountPendingUpdateEvents() == 0))
        return;
    QCoreApplication* app = QCoreApplication::instance();
    if (!app)
        return;
    m_hasQueueChangeEvent = true;
    QCoreApplication::postEvent(app, new EventQueueChangedEvent);
}

void EventQueue::CallbackQueueChangeEventRemoved()
{
    VELMAR_ASSERT(m_hasQueueChangeEvent, "m_hasQueueChangeEvent");
    m_hasQueueChangeEvent = false;
}

EventQueueChangedEvent::EventQueueChangedEvent() : QEvent(kQueueChangedEventType) {}

EventQueueChangedEvent::~EventQueueChangedEvent()
{
    if (!alreadyCounted)
        gMainEventQueue.CallbackQueueChangeEventRemoved();
}

QEvent::Type EventQueueChangedEvent::eventType()
{
    return kQueueChangedEventType;
}

} // namespace Private

EventQueueRef GetMainEventQueue()
{
    return &Private::gMainEventQueue;
}

EventQueueRef GetCurrentEventQueue()
{
    return &Private::gMainEventQueue;
}

EventLoopRef GetMainEventLoop()
{
    return &Private::gMainEventQueue;
}

EventComparatorUPP NewEventComparatorUPP(EventComparatorProcPtr proc)
{
    return proc;
}

void DisposeEventComparatorUPP(EventComparatorUPP) {}

void SetEventMask(UInt16 mask)
{
    Private::gMainEventQueue.setEventMask(mask);
}

UInt16 GetEventMask()
{
    return Private::gMainEventQueue.eventMask();
}

} // namespace Velmar
