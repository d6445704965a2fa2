// Application activation and deactivation as 'appl' events.
#include "events/AppActivation.h"

#include "events/EventQueueItem.h"

#include <QEvent>

namespace Velmar::Private {

bool ConvertApplicationActivation(const QEvent* event, EventQueueItem* item)
{
    if (!event || !item)
        return false;
    UInt32 kind;
    switch (event->type()) {
    case QEvent::ApplicationActivate: kind = kEventAppActivated; break;
    case QEvent::ApplicationDeactivate: kind = kEventAppDeactivated; break;
    default: return false;
    }
    item->clear();
    item->when = TickCount();
    item->eventClass = kEventClassApplication;
    item->eventKind = kind;
    return true;
}

} // namespace Velmar::Private
