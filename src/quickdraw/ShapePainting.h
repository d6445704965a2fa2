// The common drawing path of the shape and region calls: which brush a verb fills with,
// and temporary pen, brush and composition changes on the port's painter.
#pragma once

#include <Velmar/QDTypes.h>
#include <Velmar/QtGrafPort.h>

#include "foundation/Conversions.h"

#include <QPainter>

namespace Velmar::Private {

// Swaps pen, brush and composition mode in for one drawing operation and puts the port's
// own back afterwards. Copies of QPen and QBrush share their data, so this allocates nothing.
class PainterTools {
public:
    PainterTools(QPainter* painter, const QPen& pen, const QBrush& brush,
                 QPainter::CompositionMode mode)
        : m_painter(painter), m_pen(painter->pen()), m_brush(painter->brush()),
          m_mode(painter->compositionMode())
    {
        painter->setPen(pen);
        painter->setBrush(brush);
        if (mode != m_mode)
            painter->setCompositionMode(mode);
    }
    ~PainterTools()
    {
        m_painter->setPen(m_pen);
        m_painter->setBrush(m_brush);
        if (m_painter->compositionMode() != m_mode)
            m_painter->setCompositionMode(m_mode);
    }
    PainterTools(const PainterTools&) = delete;
    PainterTools& operator=(const PainterTools&) = delete;

private:
    QPainter* m_painter;
    QPen m_pen;
    QBrush m_brush;
    QPainter::CompositionMode m_mode;
};

// What a paint, erase, fill or invert verb fills with: the brush and the composition mode.
// Paint and fill draw in the pen mode; erase always copies; invert flips the destination.
// False (nothing to draw) for an unknown verb or a fill with a null pattern.
// `caller` names the call in the log line about a null pattern.
bool verbInk(const char* caller, QtGrafPort* port, SInt16 verb, const PatPtr* pattern,
             QBrush* brush, QPainter::CompositionMode* mode);

// The current pen's width in whole pixels (a cosmetic zero-width pen counts as 1), or 0 when
// the pen draws nothing.
int penPixelWidth(const QPen& pen);

// Runs `draw(QPainter*)` on the current port's painter with no brush, so that it strokes
// with the current pen; marks `shape` grown by the pen width dirty.
template <typename Draw>
void strokeShape(const char* caller, const QRect& shape, Draw draw)
{
    MakeQPainter painter(caller);
    if (!painter)
        return;
    const int w = penPixelWidth(painter->pen());
    if (w == 0)
        return;
    const QBrush own = painter->brush();
    painter->setBrush(Qt::NoBrush);
    draw(static_cast<QPainter*>(painter));
    painter->setBrush(own);
    painter |= grownRect(shape, w);
}

// Runs `draw(QPainter*)` on the current port's painter with a verb's ink and no pen;
// marks `dirty`.
template <typename Draw>
void fillShape(const char* caller, SInt16 verb, const QRect& dirty, const PatPtr* pattern,
               Draw draw)
{
    MakeQPainter painter(caller);
    if (!painter)
        return;
    QBrush brush;
    QPainter::CompositionMode mode;
    if (!verbInk(caller, painter.port(), verb, pattern, &brush, &mode))
        return;
    PainterTools tools(painter, QPen(Qt::NoPen), brush, mode);
    draw(static_cast<QPainter*>(painter));
    painter |= dirty;
}

// Draws the shape `draw(QPainter*, const QRect&)` makes of the Toolbox rectangle `r` with a
// verb's ink, as the oval, arc and rounded-rectangle calls do; nothing for a null or empty
// rectangle. Marks the rectangle dirty.
template <typename Draw>
void fillShapeInRect(const char* caller, SInt16 verb, const Rect* r, const PatPtr* pattern,
                     Draw draw)
{
    const QRect q = toQRect(r);
    if (q.isEmpty())
        return;
    fillShape(caller, verb, q, pattern, [&](QPainter* p) { draw(p, q); });
}

// Fills a rectangle (inclusive corners) with a verb's ink; marks it dirty.
void fillShapeRect(const char* caller, SInt16 verb, const QRect& rect,
                   const PatPtr* pattern = nullptr);

// Fills a region with a verb's ink, rectangle by rectangle (the region's rectangles never
// overlap, so every pixel is drawn once, exactly as through a clip); marks its bounds dirty.
void fillShapeRegion(const char* caller, SInt16 verb, const QRegion& region,
                     const PatPtr* pattern = nullptr);

} // namespace Velmar::Private
