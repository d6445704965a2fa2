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
            if (it != s.rbegin())
                velmar_assert("DispatchStack().back() == item", __FILE__, __LINE__, __func__,
                              "dispatch stack popped out of order");
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
