// The main event queue's list, its wake-up signal and the queue accessors.
#include "events/EventQueue.h"

#include "events/EventQueueHooks.h"

#include <Velmar/Diagnostics.h>

#include <QCoreApplication>

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
            return true;
        }
    }
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
            return found;
        }
    }
    return EventQueueItemSmartPtr();
}

void EventQueue::clearAll()
{
    ItemList gone;
    gone.swap(m_items);
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
