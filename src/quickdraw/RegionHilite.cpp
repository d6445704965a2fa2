#include "quickdraw/RegionHilite.h"

#include <QImage>

namespace Velmar::Private {

void hiliteRegion(QImage* image, const QRegion& area, QRgb back, QRgb hilite)
{
    if (!image || image->isNull())
        return;
    const QRegion inside = area & QRegion(image->rect());
    if (inside.isEmpty())
        return;
    if (image->depth() != 32)
        return; // ports keep 32-bit images; anything else is not ours to convert
    const QRgb mask = 0x00FFFFFF;
    const QRgb b = back & mask, h = hilite & mask;
    for (const QRect& r : inside) {
        for (int y = r.top(); y <= r.bottom(); ++y) {
            QRgb* line = reinterpret_cast<QRgb*>(image->scanLine(y));
            for (int x = r.left(); x <= r.right(); ++x) {
                const QRgb rgb = line[x] & mask;
                if (b == h)
                    line[x] = 0xFF000000u | (~rgb & mask);
                else if (rgb == b)
                    line[x] = 0xFF000000u | h;
                else if (rgb == h)
                    line[x] = 0xFF000000u | b;
            }
        }
    }
}

} // namespace Velmar::Private
