// The seam between the queue and the Carbon handler chain.
//
// DispatchEventToCallbacks is implemented by the handler machinery (CarbonDispatch.cpp):
// it runs the dispatcher, window and application handlers for the item and returns true
// when one of them handled it. The queue calls it for synchronized events.
#pragma once

#include "events/EventQueueItem.h"

namespace Velmar::Private {

bool DispatchEventToCallbacks(const EventQueueItemSmartPtr& item);

} // namespace Velmar::Private
