// Ctrl+Alt+Shift+I on any of the library's windows opens and closes the inspector, once the
// "enabled" setting allows it.
#pragma once

namespace Velmar::Private::Inspector {

// Puts the shortcut into the windows' special-event filter (once; later calls do nothing).
void installInspectorShortcut();

} // namespace Velmar::Private::Inspector
