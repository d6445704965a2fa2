// Single pixels, screen coordinates, flushing and scrolling.
#include <Velmar/Diagnostics.h>
#include <Velmar/QtGrafPort.h>

#include "foundation/Conversions.h"
#include "quickdraw/CurrentPort.h"
#include "quickdraw/RegionHandles.h"
#include "quickdraw/PortPainter.h"

#include <QImage>

namespace Velmar {

using namespace Private;

namespace {

bool isDirectDrawing(const QtGrafPort* port)
{
    const PortWindowHooks& hooks = portWindowHooks();
    return port->window && hooks.isDirectDrawing && hooks.isDirectDrawing(port->window);
}

// The image pixel under a local point, or false when it lies outside the image.
bool devicePixel(const QtGrafPort* port, int h, int v, QPoint* out)
{
    const QImage* image = port->image();
    const QPoint p = QPoint(h, v) - port->origin();
    if (!image || !image->rect().contains(p))
        return false;
    *out = p;
    return true;
}

} // namespace

void SetCPixel(SInt16 h, SInt16 v, const RGBColor* color)
{
    CurrentPort port("SetCPixel");
    if (!port)
        return;
    if (!port->image()) {
        VelmarLog(kLogQuickDraw, "SetCPixel has not implemented for DirectQtDrawing");
        return;
    }
    QPoint p;
    if (!color || !devicePixel(port, h, v, &p))
        return;
    // Opaque 8-bit ARGB; the painter writes the same buffer, so no flush is needed.
    port->image()->setPixel(p, static_cast<unsigned int>(*color));
    port->markDirty(QRect(h, v, 1, 1));
}

void GetCPixel(SInt16 h, SInt16 v, RGBColor* color)
{
    if (!color)
        return;
    CurrentPort port("GetCPixel");
    if (!port)
        return;
    QPoint p;
    if (!devicePixel(port, h, v, &p)) {
        // No pixels there (no image, or outside it): black, as an empty port reads.
        *color = RGBColor();
        return;
    }
    color->set(qUnpremultiply(port->image()->pixel(p)));
}

void GlobalToLocal(Point* point)
{
    QDGlobalToLocalPoint(gCurrentGrafPort, point);
}

void LocalToGlobal(Point* point)
{
    QtGrafPort* port = currentGrafPort();
    const PortWindowHooks& hooks = portWindowHooks();
    if (!port || !point || !port->window || !hooks.mapToGlobal)
        return;
    const QPoint widget = toQPoint(*point) - port->origin();
    *point = toPoint(hooks.mapToGlobal(port->window, widget));
}

Rect* QDLocalToGlobalRect(GrafPtr port, Rect* rect)
{
    const PortWindowHooks& hooks = portWindowHooks();
    if (!VELMAR_CHECK_PORT(port, nullptr) || !rect || !port->window || !hooks.mapToGlobal)
        return rect;
    const QPoint topLeft =
        hooks.mapToGlobal(port->window, QPoint(rect->left, rect->top) - port->origin());
    const int dh = topLeft.x() - rect->left;
    const int dv = topLeft.y() - rect->top;
    *rect = makeRect(rect->left + dh, rect->top + dv, rect->right + dh, rect->bottom + dv);
    return rect;
}

Point* QDGlobalToLocalPoint(GrafPtr port, Point* point)
{
    const PortWindowHooks& hooks = portWindowHooks();
    if (!VELMAR_CHECK_PORT(port, nullptr) || !point || !port->window || !hooks.mapFromGlobal)
        return point;
    const QPoint widget = hooks.mapFromGlobal(port->window, toQPoint(*point));
    *point = toPoint(widget + port->origin());
    return point;
}

void QDFlushPortBuffer(GrafPtr port, RgnHandle /*region*/)
{
    const PortWindowHooks& hooks = portWindowHooks();
    if (!VELMAR_CHECK_PORT(port, nullptr) || !port->window || !hooks.flush
        || isDirectDrawing(port))
        return;
    hooks.flush(port->window);
}

void ScrollRect(const Rect* r, SInt16 dh, SInt16 dv, RgnHandle updateRgn)
{
    VELMAR_ASSERT(r, "NULL != r");
    VELMAR_ASSERT(updateRgn, "NULL != updateRgn");
    if (updateRgn && !VELMAR_CHECK_REGION(updateRgn))
        updateRgn = nullptr;
    QtGrafPort* port = currentGrafPort();
    if ((dh == 0 && dv == 0) || !port) {
        if (updateRgn)
            *updateRgn = QRegion();
        return;
    }
    if (!r)
        return;
    if (isDirectDrawing(port)) {
        const PortWindowHooks& hooks = portWindowHooks();
        if (hooks.scrollRect)
            hooks.scrollRect(port->window, toQRect(r), dh, dv, updateRgn);
        return;
    }
    QPainter* painter = portPainter(port, "ScrollRect");
    if (!painter || !port->image())
        return;

    // Only pixels the port has can move: the rectangle is cut to the port first, so the
    // temporary copy is never larger than the port's image.
    const QRect rect = toQRect(r) & port->bounds;
    // The part that stays visible, and where it goes.
    QRect source = rect;
    if (dh < 0)
        source.setLeft(source.left() - dh);
    else
        source.setRight(source.right() - dh);
    if (dv < 0)
        source.setTop(source.top() - dv);
    else
        source.setBottom(source.bottom() - dv);
    const QRect destination = source.isValid() ? source.translated(dh, dv) : QRect();

    const QImage moved =
        destination.isValid() ? port->image()->copy(source.translated(-port->origin())) : QImage();
    const QPainter::CompositionMode mode = painter->compositionMode();
    painter->setCompositionMode(QPainter::CompositionMode_SourceOver);
    painter->fillRect(rect, resolvedBackgroundBrush(port));
    if (!moved.isNull())
        painter->drawImage(destination.topLeft(), moved);
    painter->setCompositionMode(mode);
    if (rect.isValid())
        port->markDirty(rect);

    if (updateRgn)
        *updateRgn = QRegion(rect) - QRegion(destination);
}

} // namespace Velmar
