// Polygon data: freeing, moving and measuring. Recording lives in PolyRecording.cpp.
#include <Velmar/QDShapes.h>

#include "foundation/Conversions.h"
#include "quickdraw/PolyHandles.h"
#include "quickdraw/ShapeLog.h"
#include "quickdraw/ShapeRecording.h"

#include <QPolygon>

namespace Velmar {

// A polygon killed twice, or never made by OpenPoly, is refused and not freed.
void KillPoly(PolyPtr* poly)
{
    if (!VELMAR_CHECK_POLY(poly))
        return;
    // A polygon killed while still open must not stay behind as its port's recording target.
    Private::forgetOpenPoly(poly);
    Private::freePoly(poly);
}

void OffsetPoly(PolyPtr* poly, short dh, short dv)
{
    if (!poly) {
        Private::shapeWarning("warning: OffsetPoly: null polygon");
        return;
    }
    if (!VELMAR_CHECK_POLY(poly))
        return;
    const QRect box = poly->qPoly->boundingRect();
    // Repeated offsets must not carry the points out of the range Qt computes in.
    if (!poly->qPoly->isEmpty()
        && (Private::isFar(qint64(box.left()) + dh) || Private::isFar(qint64(box.right()) + dh)
            || Private::isFar(qint64(box.top()) + dv) || Private::isFar(qint64(box.bottom()) + dv))) {
        Private::shapeWarning("warning: OffsetPoly: offset out of range, polygon left as it was");
        return;
    }
    poly->qPoly->translate(dh, dv);
}

Rect GetPolyBBox(PolyPtr* const& poly)
{
    QRect q;
    GetPolyRect(poly, &q);
    return q.isNull() ? Rect{0, 0, 0, 0} : Private::toRect(q);
}

void GetPolyRect(PolyPtr* poly, QRect* out)
{
    if (!out)
        return;
    *out = QRect();
    if (!poly) {
        Private::shapeWarning("warning: GetPolyRect: null polygon");
        return;
    }
    if (VELMAR_CHECK_POLY(poly) && !poly->qPoly->isEmpty())
        *out = poly->qPoly->boundingRect();
}

} // namespace Velmar
