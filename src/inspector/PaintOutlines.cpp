#include "inspector/PaintOutlines.h"

#include <Velmar/AQtWindow.h>
#include <Velmar/QtGrafPort.h>

#include "quickdraw/GrafPortPrivate.h"
#include "windows/WindowPaintOverlay.h"
#include "windows/WindowPrivate.h"

#include <QPainter>

namespace Velmar::Private::Inspector {

namespace {

unsigned gOutlines = 0;

// Port regions are in local coordinates; the overlay draws in the widget's.
QRegion portRegion(AQtWindow* window, const QRegion& local)
{
    QtGrafPort* port = window->GetPort();
    return port ? local.translated(-port->origin()) : QRegion();
}

struct OutlineRow {
    PaintOutline outline;
    QRgb color;
    QRegion (*region)(AQtWindow* window, const PaintOverlayInput& input);
};

// Drawn in this order: the long-lived regions first, what this paint was about on top.
const OutlineRow kOutlines[] = {
    {kOutlineVisible, qRgb(0, 170, 0),
     [](AQtWindow* w, const PaintOverlayInput&) {
         return w->GetPort() ? portRegion(w, w->GetPort()->visibleRegion) : QRegion();
     }},
    {kOutlineClip, qRgb(255, 0, 255),
     [](AQtWindow* w, const PaintOverlayInput&) {
         return w->GetPort() ? portRegion(w, w->GetPort()->clipRegion) : QRegion();
     }},
    {kOutlineUpdate, qRgb(255, 0, 0),
     [](AQtWindow*, const PaintOverlayInput& input) { return input.updateRegion; }},
    {kOutlineDirty, qRgb(0, 0, 255),
     [](AQtWindow*, const PaintOverlayInput& input) { return QRegion(input.dirtyRect); }},
};

void drawOutlines(AQtWindow* window, QPainter& painter, const PaintOverlayInput& input)
{
    // A region reaching past the widget is cut one pixel outside it, so that its edges
    // there fall off the widget instead of being drawn along its border.
    const QRect beyond = window->rect().adjusted(-1, -1, 1, 1);
    painter.setBrush(Qt::NoBrush);
    for (const OutlineRow& row : kOutlines) {
        if (!(gOutlines & row.outline))
            continue;
        painter.setPen(QPen(QColor(row.color), 0));
        for (const QRect& r : row.region(window, input) & beyond)
            painter.drawRect(r.adjusted(0, 0, -1, -1));
    }
}

void repaintWindows()
{
    for (AQtWindow* window : windowList()) {
        if (isLive(window) && !window->IsDeletePending())
            window->update();
    }
}

} // namespace

bool paintOutlineOn(PaintOutline outline)
{
    return (gOutlines & outline) != 0;
}

void setPaintOutline(PaintOutline outline, bool on)
{
    const unsigned before = gOutlines;
    gOutlines = on ? (gOutlines | outline) : (gOutlines & ~unsigned(outline));
    if (gOutlines == before)
        return;
    SetPaintOverlayHook(gOutlines ? drawOutlines : nullptr);
    repaintWindows();
}

QRgb paintOutlineColor(PaintOutline outline)
{
    for (const OutlineRow& row : kOutlines) {
        if (row.outline == outline)
            return row.color;
    }
    return 0;
}

} // namespace Velmar::Private::Inspector
