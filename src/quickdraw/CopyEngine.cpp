// The copy engine. Destination pixels are chosen first (the destination rectangle, cut to
// the destination's pixels, to the pixels that have a source (and a mask) pixel, to the
// port's clip and to the mask region); each one then takes the source pixel that nearest-pixel
// scaling maps onto it. Pixels are read and written as words in place: nothing is drawn
// through a painter unless the destination has no pixels of its own.
#include "quickdraw/CopyEngine.h"

#include <Velmar/Diagnostics.h>

#include "foundation/ApplicationPrivate.h"
#include "foundation/Conversions.h"
#include "quickdraw/GrafPortPrivate.h"
#include "quickdraw/PixelMaps.h"
#include "quickdraw/RegionHandles.h"
#include "quickdraw/TransferModes.h"

#include <QPainter>

#include <cstring>
#include <optional>
#include <vector>

namespace Velmar::Private {

namespace {

// Where each destination column (or row) of the destination rectangle reads: an image
// coordinate of the source, and the span of destination indexes whose reads lie inside it.
// Unscaled axes are a plain offset; scaled ones keep a table.
struct AxisMap {
    std::vector<int> table;
    int offset = 0;
    int first = 0;
    int last = -1;
    bool unscaled = false;

    int at(int i) const { return unscaled ? offset + i : table[std::size_t(i)]; }
    void shift(int by)
    {
        offset -= by;
        for (int& v : table)
            v -= by;
    }
};

AxisMap mapAxis(int dstLen, int srcStart, int srcLen, int imageStart, int imageLen)
{
    AxisMap m;
    m.unscaled = srcLen == dstLen;
    if (m.unscaled) {
        m.offset = srcStart - imageStart;
        m.first = qMax(0, -m.offset);
        m.last = qMin(dstLen, imageLen - m.offset) - 1;
        return m;
    }
    m.table.resize(std::size_t(dstLen));
    m.first = dstLen;
    for (int i = 0; i < dstLen; ++i) {
        const int s = srcStart + int((qint64(i) * srcLen) / dstLen) - imageStart;
        m.table[std::size_t(i)] = s;
        if (s >= 0 && s < imageLen) {
            m.first = qMin(m.first, i);
            m.last = i;
        }
    }
    return m;
}

// The map's pixels along both axes for a destination rectangle.
struct PlaneMap {
    AxisMap x, y;
    PlaneMap(const QRect& dst, const QRect& src, const PixelMap& map)
        : x(mapAxis(dst.width(), src.left(), src.width(), map.origin.x(), map.image->width())),
          y(mapAxis(dst.height(), src.top(), src.height(), map.origin.y(), map.image->height()))
    {}
    // Destination pixels (local coordinates) that have a pixel of this map.
    QRect covered(const QRect& dst) const
    {
        if (x.last < x.first || y.last < y.first)
            return QRect();
        return QRect(dst.left() + x.first, dst.top() + y.first, x.last - x.first + 1,
                     y.last - y.first + 1);
    }
};

// Replaces a map's pixels by a 32-bit copy of the part `area` reads, when they are the
// destination's own (so that overlapping copies act as if through a temporary) or not words.
void detachIfNeeded(PixelMap& map, PlaneMap& plane, const QRect& area, const QRect& dstRect,
                    const QImage* dstImage)
{
    if (map.image != dstImage && isWordFormat(map.image->format()))
        return;
    const int x0 = plane.x.at(area.left() - dstRect.left());
    const int x1 = plane.x.at(area.right() - dstRect.left());
    const int y0 = plane.y.at(area.top() - dstRect.top());
    const int y1 = plane.y.at(area.bottom() - dstRect.top());
    const QRect box(QPoint(x0, y0), QPoint(x1, y1));
    QImage copy = map.image->copy(box);
    if (!isWordFormat(copy.format()))
        copy = copy.convertToFormat(QImage::Format_ARGB32_Premultiplied);
    map.wrapped = std::move(copy);
    map.image = &map.wrapped;
    plane.x.shift(x0);
    plane.y.shift(y0);
}

// One row of a map's words for destination columns [left, left + count): straight from the
// image when unscaled, gathered otherwise.
const QRgb* sourceRow(const PixelMap& map, const PlaneMap& plane, int row, int column, int count,
                      std::vector<QRgb>& buffer)
{
    const auto* line = reinterpret_cast<const QRgb*>(map.image->constScanLine(row));
    if (plane.x.unscaled)
        return line + plane.x.at(column);
    buffer.resize(std::size_t(count));
    const int* reads = plane.x.table.data() + column;
    QRgb* gathered = buffer.data();
    for (int i = 0; i < count; ++i)
        gathered[i] = line[reads[i]];
    return gathered;
}

TransferInk currentInk()
{
    TransferInk ink;
    if (const QtGrafPort* port = currentGrafPort()) {
        ink.fore = port->foreColor().rgb();
        ink.back = port->backColor.rgb();
        ink.op = port->opColor.rgb();
    }
    return ink;
}

// The destination pixels to write, in local coordinates.
QRegion clipFor(const QRect& area, const PixelMap& dst, RgnHandle maskRgn, bool* simple)
{
    const bool portClip = dst.port && dst.port->painterState.clipEnabled;
    *simple = !portClip && !maskRgn;
    if (*simple)
        return QRegion();
    QRegion clip(area);
    if (portClip)
        clip &= dst.port->painterState.clip;
    if (maskRgn)
        clip &= *maskRgn;
    return clip;
}

// A destination with no word pixels (a one-bit map, or a direct-drawing window) is
// worked on in a 32-bit stand-in and given the result afterwards. The destination's own
// pixels (null for a window) and where they lie are kept to write back to.
struct StandIn {
    bool used = false;
    QImage pixels;
    QImage* target = nullptr;
    QPoint targetOrigin;
};

bool useStandIn(PixelMap& dst, const QRect& area, const TransferInk& ink, StandIn* standIn,
                const char* call)
{
    if (dst.image && isWordFormat(dst.image->format()))
        return true;
    if (dst.image && dst.image->format() != QImage::Format_Mono
        && dst.image->format() != QImage::Format_MonoLSB) {
        VelmarLog(kLogQuickDraw, "%s: cannot write pixels of format %d", call,
                  int(dst.image->format()));
        return false;
    }
    standIn->used = true;
    standIn->target = dst.image;
    standIn->targetOrigin = dst.origin;
    if (dst.image) {
        standIn->pixels = dst.image->copy(QRect(dst.toImage(area.topLeft()), area.size()))
                              .convertToFormat(QImage::Format_ARGB32_Premultiplied);
    } else {
        // What a direct-drawing window shows cannot be read back: the modes combine with
        // the back colour instead.
        standIn->pixels = QImage(area.size(), QImage::Format_ARGB32_Premultiplied);
        standIn->pixels.fill(ink.back);
    }
    dst.image = &standIn->pixels;
    dst.origin = area.topLeft();
    return true;
}

void finishStandIn(const StandIn& standIn, const PixelMap& work, const QRegion& written,
                   const char* call)
{
    if (QImage* target = standIn.target) {
        // One bit per pixel: dark pixels set the bit (index 1 is black).
        for (const QRect& r : written)
            for (int y = r.top(); y <= r.bottom(); ++y)
                for (int x = r.left(); x <= r.right(); ++x) {
                    const QRgb c = work.image->pixel(work.toImage(QPoint(x, y)));
                    target->setPixel(QPoint(x, y) - standIn.targetOrigin, qGray(c) < 128 ? 1u : 0u);
                }
        return;
    }
    MakeQPainter painter(work.port, call);
    if (!painter)
        return;
    painter->save();
    painter->setClipRegion(written, Qt::IntersectClip);
    painter->setCompositionMode(QPainter::CompositionMode_Source);
    painter->drawImage(work.origin, *work.image);
    painter->restore();
    painter |= written.boundingRect();
}

} // namespace

void runCopy(const CopyJob& job)
{
    const char* call = job.call;
    if (!job.srcRect || !job.dstRect || (job.hasMask && !job.maskRect)) {
        VelmarLog(kLogQuickDraw, "%s: a rectangle is missing", call);
        return;
    }
    if (job.maskRgn && !VELMAR_CHECK_REGION(job.maskRgn))
        return;
    const QRect srcRect = toQRect(job.srcRect), dstRect = toQRect(job.dstRect);
    if (!srcRect.isValid() || !dstRect.isValid())
        return; // empty or inverted: nothing to copy
    PixelMap src, dst, mask;
    if (!resolvePixelMap(job.src, &src, call) || !resolvePixelMap(job.dst, &dst, call))
        return;
    if (job.hasMask && !resolvePixelMap(job.mask, &mask, call))
        return;
    if (!src.image || (job.hasMask && !mask.image)) {
        VelmarLog(kLogQuickDraw, "%s: the source has no pixels to read", call);
        return;
    }

    // Destination pixels that exist and have a source (and mask) pixel.
    PlaneMap srcPlane(dstRect, srcRect, src);
    QRect area = dstRect & srcPlane.covered(dstRect);
    area &= dst.image ? dst.localRect() : (dst.port ? dst.port->bounds : QRect());
    std::optional<PlaneMap> maskPlane;
    if (job.hasMask) {
        maskPlane.emplace(dstRect, toQRect(job.maskRect), mask);
        area &= maskPlane->covered(dstRect);
    }
    if (area.isEmpty())
        return;
    bool simple = true;
    const QRegion clip = clipFor(area, dst, job.maskRgn, &simple);
    if (!simple && clip.isEmpty())
        return;

    const TransferInk ink = currentInk();
    const RowTransfer transfer = rowTransferFor(job.mode, call);
    StandIn standIn;
    const QImage* dstPixels = dst.image;
    if (!useStandIn(dst, area, ink, &standIn, call))
        return;
    detachIfNeeded(src, srcPlane, area, dstRect, dstPixels);
    if (job.hasMask)
        detachIfNeeded(mask, *maskPlane, area, dstRect, dstPixels);

    std::vector<QRgb> srcBuffer, maskBuffer, work;
    // Taken once: every row through scanLine() would ask the image to detach again.
    uchar* const dstBits = dst.image->bits();
    const qsizetype dstStride = dst.image->bytesPerLine();
    // Rows that read the same source row (a copy scaled up) come out the same when the
    // mode looks at the source alone: the first is computed, the others copied from it.
    const bool sameRowsSame = !job.hasMask && !transferReadsDestination(transfer);
    const auto copyRect = [&](const QRect& r) {
        const int column = r.left() - dstRect.left();
        const int count = r.width();
        const QRgb* lastOut = nullptr;
        int lastSourceRow = -1;
        for (int y = r.top(); y <= r.bottom(); ++y) {
            const int row = y - dstRect.top();
            if (job.field >= 0 && (row & 1) != job.field)
                continue;
            const QPoint at = dst.toImage(QPoint(r.left(), y));
            auto* out = reinterpret_cast<QRgb*>(dstBits + at.y() * dstStride) + at.x();
            const int sourceRowIndex = srcPlane.y.at(row);
            if (sameRowsSame && sourceRowIndex == lastSourceRow) {
                std::memcpy(out, lastOut, std::size_t(count) * sizeof(QRgb));
                continue;
            }
            const QRgb* in = sourceRow(src, srcPlane, sourceRowIndex, column, count, srcBuffer);
            if (!job.hasMask) {
                transfer(in, out, count, ink);
                lastOut = out;
                lastSourceRow = sourceRowIndex;
                continue;
            }
            work.assign(out, out + count);
            transfer(in, work.data(), count, ink);
            const QRgb* weights = sourceRow(mask, *maskPlane, maskPlane->y.at(row),
                                            column, count, maskBuffer);
            maskRow(work.data(), weights, out, count);
        }
    };
    const QRegion written = simple ? QRegion(area) : clip;
    for (const QRect& r : written)
        copyRect(r);

    if (standIn.used)
        finishStandIn(standIn, dst, written, call);
    else if (dst.port)
        dst.port->markDirty(area);
    if (dst.port && dst.port->window && (job.toScreen || inspectorCopyBitsToScreen()))
        QDFlushPortBuffer(dst.port, nullptr);
}

} // namespace Velmar::Private
