#include "events/HandlerList.h"

#include "events/EventMask.h"

#include <algorithm>

namespace Velmar::Private {

bool EventHandler::handles(UInt32 eventClass, UInt32 eventKind) const
{
    return MatchesEventTypes(types.constData(), UInt32(types.size()), eventClass, eventKind);
}

HandlerList& HandlerList::instance()
{
    static HandlerList sList;
    return sList;
}

HandlerList::~HandlerList()
{
    for (EventHandler* handler : m_slots)
        delete handler;
    for (EventHandler* handler : m_retired)
        delete handler;
}

void HandlerList::insertFront(EventHandler* handler)
{
    m_slots.push_back(handler);
}

bool HandlerList::contains(const EventHandler* handler) const
{
    return handler && std::find(m_slots.cbegin(), m_slots.cend(), handler) != m_slots.cend();
}

int HandlerList::count() const
{
    return int(std::count_if(m_slots.cbegin(), m_slots.cend(),
                             [](const EventHandler* h) { return h != nullptr; }));
}

void HandlerList::takeOut(std::size_t index)
{
    EventHandler* handler = m_slots[index];
    if (m_walkers > 0) {
        // A running chain may be inside this handler or hold a position past it.
        m_slots[index] = nullptr;
        m_retired.push_back(handler);
    } else {
        m_slots.erase(m_slots.begin() + std::ptrdiff_t(index));
        delete handler;
    }
}

bool HandlerList::removeAndFree(EventHandler* handler)
{
    if (!handler)
        return false;
    auto it = std::find(m_slots.begin(), m_slots.end(), handler);
    if (it == m_slots.end())
        return false;
    takeOut(std::size_t(it - m_slots.begin()));
    return true;
}

int HandlerList::removeWindowHandlers(const AQtWindow* window)
{
    int removed = 0;
    for (std::size_t i = m_slots.size(); i-- > 0;) {
        const EventHandler* handler = m_slots[i];
        if (handler && handler->target.targetType == EventTargetRef::TargetTypeWindow
            && handler->target.window == window) {
            takeOut(i);
            ++removed;
        }
    }
    return removed;
}

void HandlerList::endWalk()
{
    if (--m_walkers > 0 || m_retired.empty())
        return;
    std::erase(m_slots, nullptr);
    for (EventHandler* handler : m_retired)
        delete handler;
    m_retired.clear();
}

} // namespace Velmar::Private
