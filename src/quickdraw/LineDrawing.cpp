// Lines and the pen location. While a polygon or region is being defined, MoveTo and LineTo
// record points instead of drawing; the pen location follows them either way.
#include <Velmar/QDShapes.h>
#include <Velmar/QuickDraw.h>

#include "quickdraw/CurrentPort.h"
#include "quickdraw/ShapeLog.h"
#include "quickdraw/ShapePainting.h"
#include "quickdraw/ShapeRecording.h"

#include <QPolygon>

namespace Velmar {

using namespace Private;

namespace {

// The pixels a pen `w` wide can touch around the segment. The pen location may be any
// 32-bit value (SetPenState), so the sum is taken in 64 bits.
QRect lineDirty(int x0, int y0, int x1, int y1, int w)
{
    return farRect(qint64(qMin(x0, x1)) - w, qint64(qMin(y0, y1)) - w, qint64(qMax(x0, x1)) + w,
                   qint64(qMax(y0, y1)) + w);
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

// Pen coordinates travel as 16-bit Toolbox values; a relative move wraps as it did on a
// Toolbox host, whatever 32-bit location SetPenState left.
short wrap(qint64 value)
{
    return short(value & 0xFFFF);
}

} // namespace

void MoveTo(short h, short v)
{
    if (CurrentPort port("MoveTo"); port)
        moveTo(port, h, v);
}

void Move(short dh, short dv)
{
    if (CurrentPort port("Move"); port)
        moveTo(port, wrap(qint64(port->penX) + dh), wrap(qint64(port->penY) + dv));
}

void LineTo(short h, short v)
{
    if (CurrentPort port("LineTo"); port)
        lineTo(port, h, v);
}

void Line(short dh, short dv)
{
    if (CurrentPort port("Line"); port)
        lineTo(port, wrap(qint64(port->penX) + dh), wrap(qint64(port->penY) + dv));
}

void DrawLinesFromPointPairs(const QList<QPoint>& points)
{
    if (!CurrentPort("DrawLinesFromPointPairs") || points.size() < 2)
        return;
    const QRect bounds = QPolygon(points).boundingRect();
    strokeShape("DrawLinesFromPointPairs", bounds, [&points](QPainter* p) {
        p->drawLines(points.constData(), int(points.size() / 2));
    });
}

void DrawPolylineFromPoints(const QList<QPoint>& points)
{
    // Both point-list calls warn under one name, deliberately.
    if (!CurrentPort("DrawLinesFromPointPairs") || points.isEmpty())
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
