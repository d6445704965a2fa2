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

void EventQueue::append(const EventQueueItemSmartPtr& item)
{
    if (!item)
        return;
    m_items.push_back(item);
    ++m_changes;
    RaiseQueueChangedSignal();
}

bool EventQueue::remove(const EventQueueItem* item)
{
    if (!item)
        return false;
    for (auto it = m_items.begin(); it != m_items.end(); ++it) {
        if (it->get() == item) {
            // Released after the entry is gone: its destruction must see a consistent queue.
            EventQueueItemSmartPtr gone = std::move(*it);
            m_items.erase(it);
            ++m_changes;
            return true;
        }
    }
    return false;
}

bool EventQueue::contains(const EventQueueItem* item) const
{
    for (const EventQueueItemSmartPtr& queued : m_items) {
        if (queued.get() == item)
            return true;
    }
    return false;
}

bool checkMainQueue(const EventQueue* queue, const char* file, int line, const char* function)
{
    if (queue == &gMainEventQueue)
        return true;
    if (queue)
        velmar_assert("inQueue == Velmar::GetMainEventQueue()", file, line, function, nullptr);
    return false;
}

EventQueueItem* EventQueue::findFirstMatching(const EventTypeSpec* list, UInt32 count) const
{
    for (const EventQueueItemSmartPtr& item : m_items) {
        if (MatchesEventTypes(list, count, item.get()))
            return item.get();
    }
    return nullptr;
}

EventQueueItemSmartPtr EventQueue::takeFirstMatching(const EventTypeSpec* list, UInt32 count)
{
    for (auto it = m_items.begin(); it != m_items.end(); ++it) {
        if (MatchesEventTypes(list, count, it->get())) {
            EventQueueItemSmartPtr found = std::move(*it);
            m_items.erase(it);
            ++m_changes;
            return found;
        }
    }
    return EventQueueItemSmartPtr();
}

void EventQueue::clearAll()
{
    ItemList gone;
    gone.swap(m_items);
    ++m_changes;
}

int EventQueue::removeAll(const std::vector<const EventQueueItem*>& items)
{
    if (items.empty())
        return 0;
    std::vector<const EventQueueItem*> doomed = items;
    std::sort(doomed.begin(), doomed.end());
    // Released only once the queue is consistent again: a destructor may look at it.
    std::vector<EventQueueItemSmartPtr> gone;
    ItemList kept;
    for (EventQueueItemSmartPtr& queued : m_items) {
        if (std::binary_search(doomed.begin(), doomed.end(), queued.get()))
            gone.push_back(std::move(queued));
        else
            kept.push_back(std::move(queued));
    }
    m_items.swap(kept);
    if (!gone.empty())
        ++m_changes;
    return int(gone.size());
}

void EventQueue::RaiseQueueChangedSignal()
{
    if (m_carbonEventsDisabled || m_hasQueueChangeEvent)
        return;
    if (m_items.empty() && (!LegacyEventProcessing() || CountPendingUpdateEvents() == 0))
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
