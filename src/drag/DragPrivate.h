// What the drag calls share: the drop-completion notice, the receiving side's installer, and
// the handler dispatch.
#pragma once

#include <Velmar/Drag.h>

namespace Velmar::Private {

// The notice that a drop happened outside the application. Stock Qt tells a drag source
// nothing about it, so the library watches for itself: a request for the file list that
// comes while the drag runs but once the mouse button is up, and not from one of the
// library's own windows, is a real drop onto another application; so is one that comes
// after a drag that ended accepted by no window of the application (the target asks for the
// data once the source's drag loop is over).
// The library's own window is taking the drop now.
void localDropStarted();
void localDropEnded();
bool droppedOutside(MimeData::Phase phase);

// The windows take drags once a host is interested in them (a drag, a handler).
void installDragReceiving();

// Calls the tracking handlers of `window`, then the application's, with `message`; the
// receive handlers likewise. A handler that throws ends the dispatch (the drag's target is
// cleared) and never unwinds into Qt; false then, and when the window went meanwhile.
bool callTrackingHandlers(AQtWindow* window, DragTrackingMessage message);
bool callReceiveHandlers(AQtWindow* window);

// The 'TEXT' flavour of drop data: the text in the host's encoding, ending with its zero.
QByteArray dropText(const QMimeData* data);

// The cursor for the move action of the drag that runs now (SetDragCursor), if any.
QPixmap& dragCursorPixmap();

} // namespace Velmar::Private
