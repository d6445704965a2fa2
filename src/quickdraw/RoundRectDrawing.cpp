// Rounded rectangles: ovalWidth and ovalHeight are the full width and height of the corner
// ovals, so Qt's corner radii are half of them.
#include <Velmar/QDShapes.h>
#include <Velmar/QuickDraw.h>

#include "foundation/Conversions.h"
#include "quickdraw/CurrentPort.h"
#include "quickdraw/ShapeLog.h"
#include "quickdraw/ShapePainting.h"

namespace Velmar {

using namespace Private;

namespace {

void drawRounded(QPainter* p, const QRect& q, short ovalWidth, short ovalHeight)
{
    p->drawRoundedRect(q, qMax(0, int(ovalWidth)) / 2.0, qMax(0, int(ovalHeight)) / 2.0,
                       Qt::AbsoluteSize);
}

void fillRounded(const char* caller, SInt16 verb, const Rect* r, short ovalWidth,
                 short ovalHeight, const PatPtr* pattern = nullptr)
{
    fillShapeInRect(caller, verb, r, pattern, [&](QPainter* p, const QRect& q) {
        drawRounded(p, q, ovalWidth, ovalHeight);
    });
}

} // namespace

void FrameRoundRect(const Rect* r, short ovalWidth, short ovalHeight)
{
    const QRect q = toQRect(r);
    if (!CurrentPort("FrameRoundRect") || q.isEmpty())
        return;
    strokeShape("FrameRoundRect", q,
                [&](QPainter* p) { drawRounded(p, q, ovalWidth, ovalHeight); });
}

void PaintRoundRect(const Rect* r, short ovalWidth, short ovalHeight)
{
    fillRounded("PaintRoundRect", kQDGrafVerbPaint, r, ovalWidth, ovalHeight);
}

void EraseRoundRect(const Rect* r, short ovalWidth, short ovalHeight)
{
    fillRounded("EraseRoundRect", kQDGrafVerbErase, r, ovalWidth, ovalHeight);
}

void FillRoundRect(const Rect* r, short ovalWidth, short ovalHeight, const PatPtr& pattern)
{
    fillRounded("FillRoundRect", kQDGrafVerbFill, r, ovalWidth, ovalHeight, &pattern);
}

void InvertRoundRect(const Rect* r, short ovalWidth, short ovalHeight)
{
    fillRounded("InvertRoundRect", kQDGrafVerbInvert, r, ovalWidth, ovalHeight);
}

} // namespace Velmar
