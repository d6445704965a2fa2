// The one process-wide list of Carbon event handlers, newest first.
#pragma once

#include <Velmar/CarbonEventHandlers.h>

#include <QList>

#include <vector>

namespace Velmar::Private {

// What an EventHandlerRef points to.
struct EventHandler {
    EventTargetRef target;
    EventHandlerUPP handler = nullptr;
    QList<EventTypeSpec> types; // empty: every event
    void* userData = nullptr;

    bool handles(UInt32 eventClass, UInt32 eventKind) const;
};

// Handlers may install or remove handlers while a chain runs. Walkers therefore hold a
// position (an index) rather than an iterator; the newest handler sits at the highest
// index, so installing never moves the entries a walker has still to visit, and a removal
// during a walk leaves a hole that is compacted once no walk is running.
class HandlerList {
public:
    static HandlerList& instance();

    void insertFront(EventHandler* handler);
    // Takes the handler out and frees it; false (nothing freed) when it is not listed.
    bool removeAndFree(EventHandler* handler);
    bool contains(const EventHandler* handler) const;
    // Removes and frees every handler installed on the window.
    int removeWindowHandlers(const AQtWindow* window);

    // Position of the newest entry; the walk goes down to 0. -1 when empty.
    int frontPosition() const { return int(m_slots.size()) - 1; }
    // Null for a hole left by a removal.
    EventHandler* at(int position) const { return m_slots[std::size_t(position)]; }
    int count() const;

    // Held by every running chain (see HandlerList::Walk).
    class Walk {
    public:
        explicit Walk(HandlerList& list) : m_list(list) { ++m_list.m_walkers; }
        ~Walk() { m_list.endWalk(); }
        Walk(const Walk&) = delete;
        Walk& operator=(const Walk&) = delete;

    private:
        HandlerList& m_list;
    };

private:
    HandlerList() = default;
    ~HandlerList();
    void takeOut(std::size_t index);
    void endWalk();

    std::vector<EventHandler*> m_slots; // oldest first
    std::vector<EventHandler*> m_retired; // removed mid-walk, freed after it
    int m_walkers = 0;
};

} // namespace Velmar::Private
