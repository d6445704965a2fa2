// Where managers above windows look at a window's Qt events first: the inspector's debugging
// shortcuts, key handling for events that convert to nothing, input-method text for the
// TextEdit record whose editor the window stands in for, and drags. Unset, nothing is looked at.
#pragma once

#include <Velmar/AQtWindow.h>

class QInputMethodEvent;

namespace Velmar::Private {

struct WindowFilterHooks {
    // True when it handled the event (the window then does nothing more with it).
    bool (*specialEvent)(AQtWindow* window, QEvent* e) = nullptr;
    bool (*unconvertedEvent)(AQtWindow* window, QEvent* e) = nullptr;
    void (*forwardInputMethod)(CommonTextEditAPI* edit, QInputMethodEvent* e) = nullptr;
    // Drags entering, moving over, leaving and dropping on the window. Unset, the window
    // takes no drags.
    bool (*dragEvent)(AQtWindow* window, QEvent* e) = nullptr;
};

const WindowFilterHooks& windowFilterHooks();
// Returns the hooks it replaces.
WindowFilterHooks SetWindowFilterHooks(const WindowFilterHooks& hooks);

} // namespace Velmar::Private
