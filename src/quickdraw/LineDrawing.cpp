// Lines and the pen location. While a polygon or region is being defined, MoveTo and LineTo
// record points instead of drawing; the pen location follows them either way.
#include <Velmar/QDShapes.h>
#include <Velmar/QuickDraw.h>

#include "quickdraw/ShapeLog.h"
#include "quickdraw/ShapePainting.h"
#include "quickdraw/ShapeRecording.h"

#include <QPolygon>

namespace Velmar {

using namespace Private;

namespace {

// The pixels a pen `w` wide can touch around the segment.
QRect lineDirty(int x0, int y0, int x1, int y1, int w)
{
    return QRect(QPoint(qMin(x0, x1), qMin(y0, y1)), QPoint(qMax(x0, x1), qMax(y0, y1)))
        .adjusted(-w, -w, w, w);
}

void lineTo(QtGrafPort* port, int h, int v)
{
    if (!recordPenPoint(port, h, v)) {
        MakeQPainter painter(port, "LineTo");
        if (painter) {
            const int x0 = port->penX, y0 = port->penY;
            // No half-pixel shift and no pen-size displacement: the pen is centred on the line.
            if (x0 == h && y0 == v)
                painter->drawPoint(h, v);
            else
                painter->drawLine(x0, y0, h, v);
            painter |= lineDirty(x0, y0, h, v, penPixelWidth(painter->pen()));
        }
    }
    port->penX = h;
    port->penY = v;
}

void moveTo(QtGrafPort* port, int h, int v)
{
    recordPenPoint(port, h, v);
    port->penX = h;
    port->penY = v;
}

// Pen coordinates travel as 16-bit Toolbox values.
short wrap(int value)
{
    return short(value);
}

} // namespace

void MoveTo(short h, short v)
{
    if (QtGrafPort* port = shapePort("warning: MoveTo: cannot get current port"))
        moveTo(port, h, v);
}

void Move(short dh, short dv)
{
    if (QtGrafPort* port = shapePort("warning: Move: cannot get current port"))
        moveTo(port, wrap(port->penX + dh), wrap(port->penY + dv));
}

void LineTo(short h, short v)
{
    if (QtGrafPort* port = shapePort("warning: LineTo: cannot get current port"))
        lineTo(port, h, v);
}

void Line(short dh, short dv)
{
    if (QtGrafPort* port = shapePort("warning: Line: cannot get current port"))
        lineTo(port, wrap(port->penX + dh), wrap(port->penY + dv));
}

void DrawLinesFromPointPairs(const QList<QPoint>& points)
{
    if (!shapePort("warning: DrawLinesFromPointPairs: cannot get Qt port") || points.size() < 2)
        return;
    const QRect bounds = QPolygon(points).boundingRect();
    strokeShape("DrawLinesFromPointPairs", bounds, [&points](QPainter* p) {
        p->drawLines(points.constData(), int(points.size() / 2));
    });
}

void DrawPolylineFromPoints(const QList<QPoint>& points)
{
    if (!shapePort("warning: DrawPolylineFromPoints: cannot get Qt port") || points.isEmpty())
        return;
    const QRect bounds = QPolygon(points).boundingRect();
    strokeShape("DrawPolylineFromPoints", bounds, [&points](QPainter* p) {
        if (points.size() == 1)
            p->drawPoint(points.first());
        else
            p->drawPolyline(points.constData(), int(points.size()));
    });
}

} // namespace Velmar
