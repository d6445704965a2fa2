// The tables behind window creation: classic definition IDs, classes, attributes, variants.
#pragma once

#include <Velmar/Windows.h>

namespace Velmar::Private {

// GetWVariant of a window made by CreateNewWindow (0 when no definition matches exactly).
SInt16 classAttributesVariant(WindowClass windowClass, WindowAttributes attributes);
// The class and attributes NewCWindow makes for a classic definition ID (a document window
// without attributes when the ID is unknown), and the variant it stores.
void procIdClassAndAttributes(SInt16 procID, WindowClass* windowClass, WindowAttributes* attributes);
SInt16 procIdVariant(SInt16 procID);

} // namespace Velmar::Private
