// Classic posting and the null event it starts from.
#pragma once

namespace Velmar::Private {

class EventQueueItem;

// Clears the item and fills it as a null event: the current tick, the global mouse
// position and the current key modifiers. The waiters build their timeout events with it.
void FillNullEvent(EventQueueItem* item);

} // namespace Velmar::Private
