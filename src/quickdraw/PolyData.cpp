// Polygon data: freeing, moving and measuring. Recording lives in PolyRecording.cpp.
#include <Velmar/QDShapes.h>

#include "quickdraw/ShapeRecording.h"
#include "foundation/Conversions.h"
#include "quickdraw/ShapeLog.h"

#include <QPolygon>

namespace Velmar {

void KillPoly(PolyPtr* poly)
{
    if (!poly)
        return;
    // A polygon killed while still open must not stay behind as its port's recording target.
    Private::forgetOpenPoly(poly);
    delete poly->qPoly;
    delete poly;
}

void OffsetPoly(PolyPtr* poly, short dh, short dv)
{
    if (!poly || !poly->qPoly) {
        Private::shapeWarning("warning: OffsetPoly: null polygon");
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
    if (!poly || !poly->qPoly) {
        Private::shapeWarning("warning: GetPolyRect: null polygon");
        *out = QRect();
        return;
    }
    *out = poly->qPoly->isEmpty() ? QRect() : poly->qPoly->boundingRect();
}

} // namespace Velmar
