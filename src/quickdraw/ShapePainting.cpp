#include "quickdraw/ShapePainting.h"

#include <Velmar/Diagnostics.h>
#include <Velmar/QuickDraw.h>

#include "quickdraw/PortPainter.h"
#include "quickdraw/ShapeLog.h"

#include <span>

namespace Velmar::Private {

namespace {

// Fills non-overlapping rectangles with a verb's ink (no pen needed); marks `dirty`.
void fillRects(const char* caller, SInt16 verb, std::span<const QRect> rects, const QRect& dirty,
               const PatPtr* pattern)
{
    MakeQPainter painter(caller);
    if (!painter || rects.empty())
        return;
    QBrush brush;
    QPainter::CompositionMode mode;
    if (!verbInk(caller, painter.port(), verb, pattern, &brush, &mode))
        return;
    const QPainter::CompositionMode own = painter->compositionMode();
    if (mode != own)
        painter->setCompositionMode(mode);
    for (const QRect& r : rects)
        painter->fillRect(r, brush);
    if (mode != own)
        painter->setCompositionMode(own);
    painter |= dirty;
}

} // namespace

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

void fillShapeRect(const char* caller, SInt16 verb, const QRect& rect, const PatPtr* pattern)
{
    fillRects(caller, verb, std::span(&rect, rect.isEmpty() ? 0 : 1), rect, pattern);
}

void fillShapeRegion(const char* caller, SInt16 verb, const QRegion& region,
                     const PatPtr* pattern)
{
    fillRects(caller, verb, std::span(region.begin(), region.end()), region.boundingRect(),
              pattern);
}

int penPixelWidth(const QPen& pen)
{
    if (pen.style() == Qt::NoPen)
        return 0;
    const int w = pen.width();
    return w < 1 ? 1 : w;
}

} // namespace Velmar::Private
