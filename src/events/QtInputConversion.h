// Qt's input and window events as the library's event objects: mouse and key events with
// Mac codes and modifiers, wheel steps, and the window and application events.
#pragma once

#include "events/EventQueueItem.h"

#include <Velmar/CarbonEvents.h>

class QEvent;
class QKeyEvent;
class QMouseEvent;
class QWheelEvent;
class QWidget;

namespace Velmar::Private {

// The public converters (CarbonEvents.h), under the names the library's own code uses.
using Velmar::ConvertKeyEvent;
using Velmar::ConvertMouseEvent;
using Velmar::ConvertVelmarEvent;
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
