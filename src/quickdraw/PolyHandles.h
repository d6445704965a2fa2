// Which PolyPtrs are live: those OpenPoly (or region recording) made and KillPoly has not
// freed. Every call that takes a polygon checks it here first.
#pragma once

#include <Velmar/QDShapes.h>

#include "foundation/LiveHandles.h"

namespace Velmar::Private {

// A new polygon with no points, registered.
PolyPtr* newPoly();
// Unregisters and frees a polygon and its points (no check: the caller made sure).
void freePoly(PolyPtr* poly);

} // namespace Velmar::Private

// A live polygon: true. Null: false, silently. A killed or made-up one: the assertion
// "IsValidPoly(poly)", false.
#define VELMAR_CHECK_POLY(poly) VELMAR_LIVE((poly), "IsValidPoly(poly)")
