// Region set algebra, translation, whole-pixel insetting and rectangle-to-rectangle mapping.
#include <Velmar/QDRegions.h>

#include "foundation/Conversions.h"
#include "quickdraw/RegionHandles.h"
#include "quickdraw/RegionOps.h"
#include "quickdraw/ShapeLog.h"

#include <QRegion>
#include <QTransform>

#include <algorithm>
#include <cmath>
#include <cstdlib>

namespace Velmar {

namespace {

template <typename Op>
void combine(RgnHandle a, RgnHandle b, RgnHandle dst, Op op)
{
    if (!dst || !a || !b)
        return;
    if (VELMAR_CHECK_REGION(a) && VELMAR_CHECK_REGION(b) && VELMAR_CHECK_REGION(dst))
        *dst = op(*a, *b);
}

} // namespace

void UnionRgn(RgnHandle a, RgnHandle b, RgnHandle dst)
{
    combine(a, b, dst, [](const QRegion& x, const QRegion& y) { return x.united(y); });
}

void SectRgn(RgnHandle a, RgnHandle b, RgnHandle dst)
{
    combine(a, b, dst, [](const QRegion& x, const QRegion& y) { return x.intersected(y); });
}

void DiffRgn(RgnHandle a, RgnHandle b, RgnHandle dst)
{
    combine(a, b, dst, [](const QRegion& x, const QRegion& y) { return x.subtracted(y); });
}

void XorRgn(RgnHandle a, RgnHandle b, RgnHandle dst)
{
    combine(a, b, dst, [](const QRegion& x, const QRegion& y) { return x.xored(y); });
}

namespace Private {

bool staysNear(const QRectF& box)
{
    return !box.isValid()
        || (!isFar(qint64(std::floor(box.left()))) && !isFar(qint64(std::ceil(box.right())))
            && !isFar(qint64(std::floor(box.top()))) && !isFar(qint64(std::ceil(box.bottom()))));
}

} // namespace Private

// Offsets pile up; a region is never carried out of the range Qt computes in.
void OffsetRgn(RgnHandle rgn, short dh, short dv)
{
    if (!VELMAR_CHECK_REGION(rgn))
        return;
    if (!Private::staysNear(QRectF(rgn->boundingRect()).translated(dh, dv))) {
        Private::shapeWarning("warning: OffsetRgn: offset out of range, region left as it was");
        return;
    }
    rgn->translate(dh, dv);
}

void InsetRgn(RgnHandle rgn, short dh, short dv)
{
    if (VELMAR_CHECK_REGION(rgn))
        *rgn = Private::insetRegion(*rgn, dh, dv);
}

void MapRgn(RgnHandle rgn, const Rect* src, const Rect* dst)
{
    if (!VELMAR_CHECK_REGION(rgn))
        return;
    if (!src || !dst) {
        Private::shapeWarning("warning: MapRgn: null rectangle");
        return;
    }
    const int srcWidth = Private::rectWidth(*src), srcHeight = Private::rectHeight(*src);
    if (srcWidth == 0 || srcHeight == 0) {
        // The map has no scale; the region is left as it was.
        Private::shapeWarning("warning: MapRgn: empty source rectangle");
        return;
    }
    const double sx = double(Private::rectWidth(*dst)) / srcWidth;
    const double sy = double(Private::rectHeight(*dst)) / srcHeight;
    const QTransform map(sx, 0, 0, sy, dst->left - src->left * sx, dst->top - src->top * sy);
    // A steep scale can throw far parts of the region out of the range Qt computes in: only
    // what lands inside it is mapped.
    QRegion source = *rgn;
    if (!Private::staysNear(map.mapRect(QRectF(source.boundingRect())))) {
        const qint64 far = Private::kFarCoordinate;
        const QRectF reach = map.inverted().mapRect(QRectF(-far, -far, 2.0 * far, 2.0 * far));
        source &= QRect(QPoint(Private::clampFar(qint64(std::ceil(reach.left()))),
                               Private::clampFar(qint64(std::ceil(reach.top())))),
                        QPoint(Private::clampFar(qint64(std::floor(reach.right())) - 1),
                               Private::clampFar(qint64(std::floor(reach.bottom())) - 1)));
    }
    *rgn = map.map(source);
}

} // namespace Velmar

namespace Velmar::Private {

// Insetting by d is, per axis, the erosion (d > 0) or dilation (d < 0) of the region by the
// segment [-|d|, |d|]: the same as |d| one-pixel steps, each intersecting (or uniting) the
// region with itself moved a pixel either way. Steps combine: after reaching radius c, one
// step that moves by s <= 2c + 1 reaches radius c + s, so the work grows with log |d| and
// absurd values stay cheap. Shrinking stops early once nothing is left.
QRegion insetRegion(const QRegion& region, int dh, int dv)
{
    if (region.rectCount() == 1) {
        // A rectangle loses or gains a pixel on each side per step: the same result at once.
        const QRect b = region.boundingRect().adjusted(dh, dv, -dh, -dv);
        return b.isEmpty() ? QRegion() : QRegion(b);
    }
    QRegion r = region;
    const auto axis = [&r](int d, int mx, int my) {
        const int n = std::abs(d);
        for (int c = 0; c < n && !r.isEmpty();) {
            const int step = std::min(2 * c + 1, n - c);
            const QRegion a = r.translated(-mx * step, -my * step);
            const QRegion b = r.translated(mx * step, my * step);
            r = d > 0 ? r.intersected(a).intersected(b) : r.united(a).united(b);
            c += step;
        }
    };
    axis(dh, 1, 0);
    axis(dv, 0, 1);
    return r;
}

} // namespace Velmar::Private
