// The items whose Carbon handlers are running, innermost last. Window disposal walks it
// to forget the window of an event that is being handled.
#pragma once

#include "events/EventQueueItem.h"

#include <vector>

namespace Velmar::Private {

void PushDispatchedItem(const EventQueueItemSmartPtr& item);
// Takes the innermost entry holding `item` off the stack.
void PopDispatchedItem(const EventQueueItem* item);
const std::vector<EventQueueItemSmartPtr>& DispatchStack();

// Keeps an item on the dispatch stack for one scope.
class ScopedDispatchStackEntry {
public:
    explicit ScopedDispatchStackEntry(const EventQueueItemSmartPtr& item) : m_item(item.get())
    {
        PushDispatchedItem(item);
    }
    ~ScopedDispatchStackEntry() { PopDispatchedItem(m_item); }
    ScopedDispatchStackEntry(const ScopedDispatchStackEntry&) = delete;
    ScopedDispatchStackEntry& operator=(const ScopedDispatchStackEntry&) = delete;

private:
    const EventQueueItem* m_item;
};

} // namespace Velmar::Private
