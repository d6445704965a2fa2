// The stack of items whose Carbon handlers are running.
#include "events/DispatchStack.h"

#include <Velmar/Diagnostics.h>

namespace Velmar::Private {

namespace {

std::vector<EventQueueItemSmartPtr>& stack()
{
    static std::vector<EventQueueItemSmartPtr> sStack;
    return sStack;
}

} // namespace

void PushDispatchedItem(const EventQueueItemSmartPtr& item)
{
    if (item)
        stack().push_back(item);
}

void PopDispatchedItem(const EventQueueItem* item)
{
    auto& s = stack();
    for (auto it = s.rbegin(); it != s.rend(); ++it) {
        if (it->get() == item) {
            VELMAR_ASSERT(it == s.rbegin(), "DispatchStack().back() == item");
            EventQueueItemSmartPtr keep = std::move(*it);
            s.erase(std::next(it).base());
            return;
        }
    }
}

const std::vector<EventQueueItemSmartPtr>& DispatchStack()
{
    return stack();
}

} // namespace Velmar::Private
