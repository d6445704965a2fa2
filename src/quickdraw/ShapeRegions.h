// The regions of ellipses and polygons, as recording a region XORs them in. Qt builds them in
// time that grows with the square of the shape's height, seconds for a full 16-bit oval; past
// a size where that shows, the shapes are scan-converted here row by row instead.
#pragma once

#include <QPolygon>
#include <QRect>
#include <QRegion>

namespace Velmar::Private {

// Up to this height (and width) Qt's own region is used, exact to the pixel Qt draws.
inline constexpr int kQtShapeRegionLimit = 2048;

// The ellipse inscribed in `rect`.
QRegion ellipseRegion(const QRect& rect);
// A polygon's area under the odd-even rule.
QRegion polygonRegion(const QPolygon& polygon);

} // namespace Velmar::Private
