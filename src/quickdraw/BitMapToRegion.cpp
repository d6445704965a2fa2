// Regions from pixels. Each row becomes its runs of marked pixels; rows whose runs repeat
// the row above extend its band, so the rectangles come out in the banded form QRegion keeps
// and are handed over in one piece instead of by thousands of unions.
#include <Velmar/Diagnostics.h>
#include <Velmar/MacErrors.h>
#include <Velmar/QDBitmaps.h>

#include "quickdraw/GrafPortPrivate.h"
#include "quickdraw/PixelMaps.h"
#include "quickdraw/RegionHandles.h"

#include <QRegion>

#include <vector>

namespace Velmar {

using namespace Private;

namespace {

// Runs of one row as [begin, end) column pairs, appended to `runs`.
void markedRuns(const QImage& image, int y, QRgb background, std::vector<int>& runs)
{
    const int width = image.width();
    const bool mono = image.depth() == 1;
    const uchar* bits = image.constScanLine(y);
    const auto* words = reinterpret_cast<const QRgb*>(bits);
    const QRgb paper = background & 0xFFFFFF;
    const auto marked = [&](int x) {
        if (mono)
            return ((bits[x >> 3] >> (7 - (x & 7))) & 1) != 0;
        return (words[x] & 0xFFFFFF) != paper;
    };
    for (int x = 0; x < width;) {
        if (!marked(x)) {
            ++x;
            continue;
        }
        const int begin = x;
        while (x < width && marked(x))
            ++x;
        runs.push_back(begin);
        runs.push_back(x);
    }
}

} // namespace

OSErr BitMapToRegion(RgnHandle region, BitMapView map)
{
    if (!region || !VELMAR_CHECK_REGION(region))
        return paramErr;
    PixelMap pixels;
    if (!resolvePixelMap(map, &pixels, "BitMapToRegion") || !pixels.image)
        return paramErr;
    QImage image = *pixels.image;
    if (image.format() == QImage::Format_MonoLSB)
        image = image.convertToFormat(QImage::Format_Mono);
    else if (image.depth() != 1 && !isWordFormat(image.format()))
        image = image.convertToFormat(QImage::Format_ARGB32_Premultiplied);
    const QRgb background = pixels.port ? pixels.port->backColor.rgb() : 0xFFFFFFFFu;

    std::vector<QRect> rects;
    std::vector<int> band, row;
    int bandTop = 0;
    const auto closeBand = [&](int bottom) {
        for (std::size_t i = 0; i < band.size(); i += 2)
            rects.emplace_back(QPoint(band[i], bandTop) + pixels.origin,
                               QPoint(band[i + 1] - 1, bottom) + pixels.origin);
    };
    for (int y = 0; y < image.height(); ++y) {
        row.clear();
        markedRuns(image, y, background, row);
        if (row == band)
            continue;
        closeBand(y - 1);
        band.swap(row);
        bandTop = y;
    }
    closeBand(image.height() - 1);
    region->setRects(rects.data(), int(rects.size()));
    return noErr;
}

} // namespace Velmar
