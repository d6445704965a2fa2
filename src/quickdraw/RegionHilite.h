// The hilite pixel operation behind InvertRgn.
#pragma once

#include <QRegion>
#include <QRgb>

class QImage;

namespace Velmar::Private {

// Within `area` (image coordinates), pixels of the back colour become the hilite colour and
// pixels of the hilite colour become the back colour; every other pixel keeps its colour, so
// applying it twice restores the image. When the two colours are the same the swap would
// show nothing, so the pixels are inverted instead. Colours compare on RGB, opaque.
void hiliteRegion(QImage* image, const QRegion& area, QRgb back, QRgb hilite);

} // namespace Velmar::Private
