#include "quickdraw/ShapePainting.h"

#include <Velmar/Diagnostics.h>
#include <Velmar/QuickDraw.h>

#include "quickdraw/PortPainter.h"
#include "quickdraw/ShapeLog.h"

#include <QPainterPath>

namespace Velmar::Private {

bool verbInk(const char* caller, QtGrafPort* port, SInt16 verb, const PatPtr* pattern,
             QBrush* brush, QPainter::CompositionMode* mode)
{
    *mode = port->currentCompositionMode();
    switch (verb) {
    case kQDGrafVerbPaint:
        *brush = resolvedFillBrush(port);
        return true;
    case kQDGrafVerbErase:
        *brush = resolvedBackgroundBrush(port);
        *mode = QPainter::CompositionMode_SourceOver;
        return true;
    case kQDGrafVerbFill:
        if (!pattern || !pattern->brush()) {
            VelmarLog(kLogQuickDraw, "warning: %s: null pattern", caller);
            return false;
        }
        *brush = resolvedPatternBrush(port, *pattern->brush());
        return true;
    case kQDGrafVerbInvert:
        *brush = QBrush(Qt::black);
        *mode = QPainter::RasterOp_NotDestination;
        return true;
    default:
        return false;
    }
}

void fillShapePath(const char* caller, SInt16 verb, const QPainterPath& path, const QRect& dirty,
                   const PatPtr* pattern)
{
    fillShape(caller, verb, dirty, pattern, [&path](QPainter* p) { p->drawPath(path); });
}

void fillShapeRect(const char* caller, SInt16 verb, const QRect& rect, const PatPtr* pattern)
{
    MakeQPainter painter(caller);
    if (!painter || rect.isEmpty())
        return;
    QBrush brush;
    QPainter::CompositionMode mode;
    if (!verbInk(caller, painter.port(), verb, pattern, &brush, &mode))
        return;
    const QPainter::CompositionMode own = painter->compositionMode();
    if (mode != own)
        painter->setCompositionMode(mode);
    painter->fillRect(rect, brush);
    if (mode != own)
        painter->setCompositionMode(own);
    painter |= rect;
}

void fillShapeRegion(const char* caller, SInt16 verb, const QRegion& region,
                     const PatPtr* pattern)
{
    MakeQPainter painter(caller);
    if (!painter || region.isEmpty())
        return;
    QBrush brush;
    QPainter::CompositionMode mode;
    if (!verbInk(caller, painter.port(), verb, pattern, &brush, &mode))
        return;
    const QPainter::CompositionMode own = painter->compositionMode();
    if (mode != own)
        painter->setCompositionMode(mode);
    for (const QRect& r : region)
        painter->fillRect(r, brush);
    if (mode != own)
        painter->setCompositionMode(own);
    painter |= region.boundingRect();
}

int penPixelWidth(const QPen& pen)
{
    if (pen.style() == Qt::NoPen)
        return 0;
    const int w = pen.width();
    return w < 1 ? 1 : w;
}

} // namespace Velmar::Private
