// Ovals: the ellipse inscribed in the converted rectangle.
#include <Velmar/QDShapes.h>
#include <Velmar/QuickDraw.h>

#include "foundation/Conversions.h"
#include "quickdraw/ShapePainting.h"
#include "quickdraw/ShapeRecording.h"

namespace Velmar {

using namespace Private;

namespace {

void fillOval(const char* caller, SInt16 verb, const Rect* r, const PatPtr* pattern = nullptr)
{
    fillShapeInRect(caller, verb, r, pattern,
                    [](QPainter* p, const QRect& q) { p->drawEllipse(q); });
}

} // namespace

// Unlike FrameRect, the stroke is not inset for the pen width.
void FrameOval(const Rect* r)
{
    const QRect q = toQRect(r);
    if (!framingPort("FrameOval",
                     [&q] { return ellipseRegion(q); })
        || q.isEmpty())
        return;
    strokeShape("FrameOval", q, [&q](QPainter* p) { p->drawEllipse(q); });
}

void PaintOval(const Rect* r)
{
    fillOval("PaintOval", kQDGrafVerbPaint, r);
}

void EraseOval(const Rect* r)
{
    fillOval("EraseOval", kQDGrafVerbErase, r);
}

void FillOval(const Rect* r, const PatPtr& pattern)
{
    fillOval("FillOval", kQDGrafVerbFill, r, &pattern);
}

void InvertOval(const Rect* r)
{
    fillOval("InvertOval", kQDGrafVerbInvert, r);
}

} // namespace Velmar
