// TEMPORARY: stands in for the input converter until it lands; a weak definition, so the
// real one replaces it. Handles the window and application events only.
#include <Velmar/AQtWindow.h>

#include "events/EventQueueItem.h"

#include <QEvent>

namespace Velmar::Private {

__attribute__((weak)) bool ConvertVelmarEvent(AQtWindow* window, QEvent* e, EventQueueItem* item)
{
    item->clear();
    item->when = TickCount();
    if (!e)
        return !window;
    item->window = window;
    struct Row { QEvent::Type type; UInt32 cls, kind; };
    static const Row kRows[] = {
        {QEvent::Paint, kEventClassWindow, kEventWindowUpdate},
        {QEvent::Move, kEventClassVelmar, kEventVelmarMoved},
        {QEvent::Resize, kEventClassVelmar, kEventVelmarResized},
        {QEvent::Show, kEventClassWindow, kEventWindowShown},
        {QEvent::Hide, kEventClassWindow, kEventWindowHidden},
        {QEvent::Close, kEventClassVelmar, kEventVelmarCloseRequested},
        {QEvent::WindowActivate, kEventClassWindow, kEventWindowActivated},
        {QEvent::WindowDeactivate, kEventClassWindow, kEventWindowDeactivated},
    };
    for (const Row& r : kRows) {
        if (r.type == e->type()) {
            item->eventClass = r.cls;
            item->eventKind = r.kind;
            return true;
        }
    }
    return false;
}

} // namespace Velmar::Private
