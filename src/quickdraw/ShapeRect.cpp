// Rectangles: frame, paint, erase, fill, invert and the StdRect dispatcher.
#include <Velmar/QDRegions.h>
#include <Velmar/QDShapes.h>
#include <Velmar/QuickDraw.h>

#include "foundation/Conversions.h"
#include "quickdraw/RegionOps.h"
#include "quickdraw/CurrentPort.h"
#include "quickdraw/ShapeLog.h"
#include "quickdraw/ShapePainting.h"
#include "quickdraw/ShapeRecording.h"

namespace Velmar {

using namespace Private;

namespace {

bool isNormalPenPattern(const QBrush& brush)
{
    return brush.style() == Qt::SolidPattern && brush.color() == QColor(Qt::black);
}

} // namespace

// A frame stays inside its rectangle: the stroke of a pen w wide is centred on a rectangle
// inset by floor(w/2) at the top-left and ceil(w/2) at the bottom-right, which for w = 1 is
// exactly the Toolbox frame (Qt's stroke of an inclusive rectangle reaches one pixel further
// right and down).
void FrameRect(const Rect* r)
{
    const QRect q = toQRect(r);
    // The region is built only while recording, so that drawing a frame allocates nothing.
    QtGrafPort* port =
        framingPort("FrameRect", [&q] { return QRegion(q); });
    if (!port)
        return;
    MakeQPainter painter(port, "FrameRect");
    if (!painter || q.isEmpty())
        return;
    if (!isNormalPenPattern(painter->brush())) {
        const int w = penPixelWidth(painter->pen());
        if (w > 0)
            fillShapeRegion("FrameRect", kQDGrafVerbPaint,
                            QRegion(q).subtracted(insetRegion(QRegion(q), w, w)));
        painter |= q;
        return;
    }
    const QPen& pen = painter->pen();
    const int w = penPixelWidth(pen);
    if (w == 0)
        return;
    const int a = w / 2, b = (w + 1) / 2;
    const QRect stroke(QPoint(q.left() + a, q.top() + a), QPoint(q.right() - b, q.bottom() - b));
    if (stroke.right() < stroke.left() || stroke.bottom() < stroke.top()) {
        // The pen is wider than half the rectangle: the frame covers all of it.
        painter->fillRect(q, pen.color());
    } else {
        const QBrush own = painter->brush();
        painter->setBrush(Qt::NoBrush);
        if (w > 1 && pen.joinStyle() != Qt::MiterJoin) {
            // Square outer corners, so that a wide frame is the full band a Toolbox frame is
            // (the normal pen's bevel join would cut the corner pixels off).
            const QPen ownPen = pen;
            QPen square = pen;
            square.setJoinStyle(Qt::MiterJoin);
            painter->setPen(square);
            painter->drawRect(stroke);
            painter->setPen(ownPen);
        } else {
            painter->drawRect(stroke);
        }
        painter->setBrush(own);
    }
    painter |= q;
}

void PaintRect(const Rect* r)
{
    fillShapeRect("PaintRect", kQDGrafVerbPaint, toQRect(r));
}

void EraseRect(const Rect* r)
{
    fillShapeRect("EraseRect", kQDGrafVerbErase, toQRect(r));
}

void FillRect(const Rect* r, const PatPtr& pattern)
{
    fillShapeRect("FillRect", kQDGrafVerbFill, toQRect(r), &pattern);
}

void InvertRect(const Rect* r)
{
    fillShapeRect("InvertRect", kQDGrafVerbInvert, toQRect(r));
}

// The fill verb has no pattern of its own here: it fills with the pen pattern, as paint does.
void StdRect(SInt16 verb, const Rect* r)
{
    using Draw = void (*)(const Rect*);
    static constexpr Draw kByVerb[] = {FrameRect, PaintRect, EraseRect, InvertRect, PaintRect};
    if (!CurrentPort("StdRect"))
        return;
    if (verb < 0 || verb >= SInt16(std::size(kByVerb))) {
        shapeWarning("warning: StdRect: unknown verb");
        return;
    }
    kByVerb[verb](r);
}

} // namespace Velmar
