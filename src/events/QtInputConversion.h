// Qt's input and window events as the library's event objects: mouse and key events with
// Mac codes and modifiers, wheel steps, and the window and application events.
#pragma once

#include "events/EventQueueItem.h"

class QEvent;
class QKeyEvent;
class QMouseEvent;
class QWheelEvent;
class QWidget;

namespace Velmar::Private {

// False when the event makes no Toolbox event (nothing to post).
bool ConvertVelmarEvent(AQtWindow* window, QEvent* e, EventQueueItem* item);
bool ConvertMouseEvent(QMouseEvent* e, EventQueueItem* item, const QWidget* widget);
bool ConvertKeyEvent(QKeyEvent* e, EventQueueItem* item);
bool ConvertWheelEvent(QWheelEvent* e, EventQueueItem* item);

// What conversion needs from the window layer. Unset: no widget, no state change.
struct InputWindowHooks {
    QWidget* (*widget)(AQtWindow* window) = nullptr;
    // True once for a resize that minimised, maximised or restored the window.
    bool (*isMinimizeMaximizeChange)(AQtWindow* window) = nullptr;
};
const InputWindowHooks& inputWindowHooks();
InputWindowHooks SetInputWindowHooks(const InputWindowHooks& hooks);

} // namespace Velmar::Private
