// The live inspector: a debugging window showing the host's windows with their ports and
// regions, its menus and items, the event queue and waiters, the log with its categories,
// and the library's debugging switches. See docs/inspector.md.
#pragma once

#include <Velmar/VelmarExport.h>

namespace Velmar {

// Opens the inspector (made on first use) or closes it. Ctrl+Alt+Shift+I on any of the
// library's windows does the same once the inspector's "enabled" setting is on.
VELMAR_EXPORT void ToggleVelmarInspector();
VELMAR_EXPORT bool IsVelmarInspectorVisible();

} // namespace Velmar
