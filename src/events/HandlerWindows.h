// What window disposal needs from the handler list.
#pragma once

namespace Velmar {
class AQtWindow;
}

namespace Velmar::Private {

// Removes and frees every handler installed on the window; returns how many. Called when
// the window goes away, before its queued events are revoked.
int RemoveWindowEventHandlers(const AQtWindow* window);

} // namespace Velmar::Private
