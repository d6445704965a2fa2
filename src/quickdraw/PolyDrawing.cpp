// Polygons: framed as a path stroked with the pen, filled under the odd-even rule.
#include <Velmar/Diagnostics.h>
#include <Velmar/QDShapes.h>
#include <Velmar/QuickDraw.h>

#include "quickdraw/GrafPortPrivate.h"
#include "quickdraw/PolyHandles.h"
#include "quickdraw/CurrentPort.h"
#include "quickdraw/ShapeLog.h"
#include "quickdraw/ShapePainting.h"
#include "quickdraw/ShapeRecording.h"

#include <QPainterPath>
#include <QPolygon>

namespace Velmar {

using namespace Private;

namespace {

// A null polygon is a warning; a killed or made-up one an assertion.
bool usable(PolyPtr* poly, const char* warning)
{
    if (!poly) {
        shapeWarning(warning);
        return false;
    }
    return VELMAR_CHECK_POLY(poly);
}

// Fewer than three points enclose nothing, so the fill forms draw nothing for them.
void fillPoly(const char* caller, const char* warning, SInt16 verb, PolyPtr* poly,
              const PatPtr* pattern = nullptr)
{
    if (!usable(poly, warning) || poly->qPoly->size() < 3)
        return;
    const QPolygon& points = *poly->qPoly;
    fillShape(caller, verb, points.boundingRect(), pattern,
              [&points](QPainter* p) { p->drawPolygon(points, Qt::OddEvenFill); });
}

} // namespace

void FramePoly(PolyPtr* poly)
{
    CurrentPort port("FramePoly");
    if (!port)
        return;
    if (port->definingRgn) {
        if (VELMAR_ASSERT(poly, "poly && poly->qPoly") && VELMAR_CHECK_POLY(poly))
            recordFrameShape(port, polygonRegion(*poly->qPoly));
        return;
    }
    if (!usable(poly, "warning: FramePoly: null polygon") || poly->qPoly->isEmpty())
        return;
    QPainterPath path;
    path.addPolygon(QPolygonF(*poly->qPoly));
    strokeShape("FramePoly", poly->qPoly->boundingRect(),
                [&path](QPainter* p) { p->strokePath(path, p->pen()); });
}

void PaintPoly(PolyPtr* poly)
{
    fillPoly("PaintPoly", "warning: PaintPoly: null polygon", kQDGrafVerbPaint, poly);
}

void FillPoly(PolyPtr* poly, const PatPtr& pattern)
{
    fillPoly("FillPoly", "warning: FillPoly: null polygon", kQDGrafVerbFill, poly, &pattern);
}

void ErasePoly(PolyPtr* poly)
{
    fillPoly("ErasePoly", "warning: ErasePoly: null polygon", kQDGrafVerbErase, poly);
}

void InvertPoly(PolyPtr* poly)
{
    fillPoly("InvertPoly", "warning: InvertPoly: null polygon", kQDGrafVerbInvert, poly);
}

} // namespace Velmar
