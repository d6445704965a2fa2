// Region operations shared by the region calls and the frame drawing.
#pragma once

#include <QRegion>

namespace Velmar::Private {

// The region inset by whole pixels: positive values shrink, negative grow (see InsetRgn).
QRegion insetRegion(const QRegion& region, int dh, int dv);

} // namespace Velmar::Private
