// Arcs and wedges. Toolbox angles run clockwise from 12 o'clock, Qt's counter-clockwise
// from 3 o'clock in sixteenths of a degree.
#include <Velmar/QDShapes.h>
#include <Velmar/QuickDraw.h>

#include "foundation/Conversions.h"
#include "quickdraw/ArcAngles.h"
#include "quickdraw/ShapePainting.h"

namespace Velmar {

using namespace Private;

namespace {

void fillArc(const char* caller, SInt16 verb, const Rect* r, short startAngle, short arcAngle,
             const PatPtr* pattern = nullptr)
{
    const QtArc arc = toQtArc(startAngle, arcAngle);
    fillShapeInRect(caller, verb, r, pattern,
                    [&](QPainter* p, const QRect& q) { p->drawPie(q, arc.start, arc.span); });
}

} // namespace

void FrameArc(const Rect* r, short startAngle, short arcAngle)
{
    const QRect q = toQRect(r);
    if (q.isEmpty())
        return;
    const QtArc arc = toQtArc(startAngle, arcAngle);
    strokeShape("FrameArc", q, [&](QPainter* p) { p->drawArc(q, arc.start, arc.span); });
}

void PaintArc(const Rect* r, short startAngle, short arcAngle)
{
    fillArc("PaintArc", kQDGrafVerbPaint, r, startAngle, arcAngle);
}

void EraseArc(const Rect* r, short startAngle, short arcAngle)
{
    fillArc("EraseArc", kQDGrafVerbErase, r, startAngle, arcAngle);
}

void FillArc(const Rect* r, short startAngle, short arcAngle, const PatPtr& pattern)
{
    fillArc("FillArc", kQDGrafVerbFill, r, startAngle, arcAngle, &pattern);
}

void InvertArc(const Rect* r, short startAngle, short arcAngle)
{
    fillArc("InvertArc", kQDGrafVerbInvert, r, startAngle, arcAngle);
}

} // namespace Velmar
