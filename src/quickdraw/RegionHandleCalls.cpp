// Region handles: lifetime, content and the region tests.
#include <Velmar/QDRegions.h>

#include "foundation/Conversions.h"
#include "quickdraw/RegionHandles.h"
#include "quickdraw/ShapeLog.h"

#include <QRegion>

namespace Velmar {

using Private::shapeWarning;
using Private::toQRect;

RgnHandle NewRgn()
{
    auto* region = new QRegion;
    Private::registerRegion(region);
    return region;
}

// A handle disposed twice, or never made by NewRgn, is refused and not freed.
void DisposeRgn(RgnHandle rgn)
{
    if (!VELMAR_CHECK_REGION(rgn))
        return;
    Private::unregisterRegion(rgn);
    delete rgn;
}

void CopyRgn(RgnHandle src, RgnHandle dst)
{
    if (!src || !dst) {
        shapeWarning("warning: CopyRgn: null region");
        return;
    }
    if (VELMAR_CHECK_REGION(src) && VELMAR_CHECK_REGION(dst) && src != dst)
        *dst = *src;
}

void SetEmptyRgn(RgnHandle rgn)
{
    if (!rgn) {
        shapeWarning("warning: SetEmptyRgn: null region");
        return;
    }
    if (VELMAR_CHECK_REGION(rgn))
        *rgn = QRegion();
}

void RectRgn(RgnHandle rgn, const Rect* r)
{
    // An empty rectangle (left >= right or top >= bottom) gives the empty region.
    if (VELMAR_CHECK_REGION(rgn))
        *rgn = QRegion(toQRect(r));
}

void SetRectRgn(RgnHandle rgn, short left, short top, short right, short bottom)
{
    const Rect r = Private::makeRect(left, top, right, bottom);
    RectRgn(rgn, &r);
}

unsigned char PtInRgn(Point pt, RgnHandle rgn)
{
    if (!VELMAR_CHECK_REGION(rgn))
        return 0;
    return rgn->contains(Private::toQPoint(pt)) ? 1 : 0;
}

unsigned char RectInRgn(const Rect* r, RgnHandle rgn)
{
    if (!VELMAR_CHECK_REGION(rgn) || !r)
        return 0;
    const QRect q = toQRect(r);
    if (!q.isValid())
        return 0;
    return rgn->intersects(q) ? 1 : 0;
}

// Two null handles are equal, as EqualRect treats two null rectangles.
unsigned char EqualRgn(RgnHandle a, RgnHandle b)
{
    if (!a || !b) {
        shapeWarning("warning: EqualRgn: null region");
        return (!a && !b) ? 1 : 0;
    }
    if (!VELMAR_CHECK_REGION(a) || !VELMAR_CHECK_REGION(b))
        return 0;
    // QRegion compares rectangle lists, and equal areas can be banded differently.
    return (*a == *b || (*a ^ *b).isEmpty()) ? 1 : 0;
}

// A null handle counts as empty, as a null rectangle does; so does a stale one.
unsigned char EmptyRgn(RgnHandle rgn)
{
    if (!rgn) {
        shapeWarning("warning: EmptyRgn: null region");
        return 1;
    }
    if (!VELMAR_CHECK_REGION(rgn))
        return 1;
    return rgn->isEmpty() ? 1 : 0;
}

Rect* GetRegionBounds(RgnHandle rgn, Rect* bounds)
{
    if (!bounds)
        return nullptr;
    if (!rgn)
        shapeWarning("warning: GetRegionBounds: null region");
    if (!VELMAR_CHECK_REGION(rgn)) {
        *bounds = Rect{0, 0, 0, 0};
        return bounds;
    }
    const QRect q = rgn->boundingRect();
    *bounds = q.isEmpty() ? Rect{0, 0, 0, 0} : Private::toRect(q);
    return bounds;
}

} // namespace Velmar
