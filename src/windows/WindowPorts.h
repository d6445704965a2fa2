// A window's port and back buffer, and how port coordinates map to the screen.
#pragma once

#include <Velmar/AQtWindow.h>

#include <QImage>
#include <QPoint>

namespace Velmar::Private {

// A new port for the window in its current drawing mode: a widget-sized back buffer in
// back-buffer mode, none in direct drawing mode.
QtGrafPort* makeWindowPort(AQtWindow* window);
// The back buffer for a widget of `size` (a native image where the platform has one).
QImage* makeBackBuffer(const QSize& size);

// Widget coordinates of the window to global screen coordinates and back: through the
// shell's content geometry when the window is decorated, else through Qt.
QPoint windowToGlobal(AQtWindow* window, const QPoint& widgetPoint);
QPoint globalToWindow(AQtWindow* window, const QPoint& globalPoint);

} // namespace Velmar::Private
