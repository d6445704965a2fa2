// Application activation and deactivation as 'appl' events, for the application object.
#pragma once

class QEvent;

namespace Velmar::Private {

class EventQueueItem;

// Fills `item` from Qt's ApplicationActivate or ApplicationDeactivate event ('appl' kind 1
// or 2, stamped with the current tick). False (item untouched) for any other event.
bool ConvertApplicationActivation(const QEvent* event, EventQueueItem* item);

} // namespace Velmar::Private
