// Classic posting and the null event it starts from.
#pragma once

namespace Velmar::Private {

class EventQueueItem;

// Clears the item and fills it as a null event: the current tick, the global mouse
// position and the current key modifiers. The waiters build their timeout events with it.
// Position and modifiers are read at most once per tick (see PostEvent.cpp).
void FillNullEvent(EventQueueItem* item);

// Makes the next FillNullEvent ask for the mouse position and modifiers again; for the
// input layer to call when mouse or key input arrives.
void ForgetInputSnapshot();

} // namespace Velmar::Private
