// The paint event: the host's handler paints or the update region is left for update
// events, then the drawn back buffer goes to the screen, with the highlight frame on top.
#include <Velmar/AQtWindow.h>
#include <Velmar/FeatureFlags.h>
#include <Velmar/QtGrafPort.h>

#include "events/EventQueue.h"
#include "quickdraw/GrafPortPrivate.h"
#include "quickdraw/PortPainter.h"
#include "windows/WindowPaintOverlay.h"
#include "windows/WindowPrivate.h"

#include <QElapsedTimer>
#include <QPaintEvent>
#include <QPainter>

#include <cmath>

namespace Velmar {

using namespace Private;

namespace {

// How often windows paint, reported every N paints when ReportPaintEventFrequency asks.
struct PaintStatistics {
    QElapsedTimer clock;
    UInt32 paints = 0;
    UInt32 nonCarbonPaints = 0;
};

void notePaint()
{
    static PaintStatistics stats;
    const UInt32 every = ReportPaintEventFrequency(kFeatureFlagQuery);
    if (every <= 1)
        return;
    if (stats.paints == 0)
        stats.clock.start();
    if (stats.paints >= every) {
        const qint64 elapsed = qMax<qint64>(1, stats.clock.elapsed());
        const auto perSecond = [elapsed](UInt32 count) {
            return int(std::floor(count * 1000.0 / double(elapsed) + 0.5));
        };
        qDebug("[Paint Frequency] AQtWindow::PaintEvent: report frequencey: %d duration: "
               "elapsed (ms): %d, paints/sec: %d, NCE paints/sec: %d",
               int(every), int(elapsed), perSecond(every), perSecond(stats.nonCarbonPaints));
        stats.paints = 0;
        stats.nonCarbonPaints = 0;
        stats.clock.start();
    }
    ++stats.paints;
    if (gMainEventQueue.inNonCarbonProcessing())
        ++stats.nonCarbonPaints;
}

// The highlight frame's pen from the palette, when it names all three values.
bool highlightPen(QPen* pen, int* width)
{
    const Palette::PaletteManager* palette = Palette::PaletteManager::Instance();
    RGBColor color;
    UInt16 w = 0, opacity = 0;
    if (!palette || !palette->GetTxRGBColorBasedOnHighlightIndex("WindowHighlightFrameColor", color)
        || !palette->GetUint16("WindowHighlightFrameWidth", w)
        || !palette->GetUint16("WindowHighlightFrameOpacity", opacity))
        return false;
    QColor c = QColor::fromRgbF(float(color.red / 65535.0), float(color.green / 65535.0),
                                float(color.blue / 65535.0));
    c.setAlpha(int(opacity) * 255 / 100);
    *pen = QPen(QBrush(c), w, Qt::SolidLine, Qt::SquareCap, Qt::BevelJoin);
    *width = w;
    return true;
}

} // namespace

void AQtWindow::paintEvent(QPaintEvent* e)
{
    ++m_paintEventCalls;
    if (m_deletePending || m_inPaintEvent || m_dynView || !m_port)
        return;
    ScopedFlag inPaint(m_inPaintEvent, true);

    // The overlay shows what this paint was asked to do, so it needs the state from before.
    const PaintOverlayHook overlay = paintOverlayHook();
    PaintOverlayInput overlayInput;
    if (overlay)
        overlayInput = {m_updateRegion, m_dirtyPortRect};

    const QRegion eventRegion = e->region();
    QtGrafPort* const port = m_port;
    QPainter local;
    QPainter* painter = &local;
    if (m_enableDirectQtDrawing) {
        painter = m_port->painter;
        if (!VELMAR_ASSERT(!painter->isActive(), "!painter.isActive()"))
            return;
        m_port->paintDevice = this;
        m_port->BeginPaint();
        if (m_paintEventPropagation)
            m_updateRegion += eventRegion;
    }

    const bool fill = !m_inSyncUpdate && supportLegacyMacEventProcessing() && !m_inResizeState;
    if (m_enableEventHandling && !m_updateStarted && !m_updateRegion.isEmpty()
        && !SuspendUpdateEvents::checkFor(this))
        consumeUpdateRegion(painter, eventRegion, fill);
    // The handler disposed the window, or switched its drawing mode and so made a new port:
    // the painter taken above went with the old port. A new paint shows the new state.
    if (m_deletePending || m_port != port) {
        if (!m_deletePending)
            update();
        return;
    }

    if (!m_enableDirectQtDrawing) {
        m_port->EndPaint();
        local.begin(this);
        paintBackBuffer(local, eventRegion);
        if (m_eventHandler && SupportVelmarWindowOverlays(kFeatureFlagQuery)
            && !callWindowHandler(this, [&] { m_eventHandler->DrawOverlays(local, eventRegion); }))
            return;
        if (!m_dirtyPortRect.isNull() && eventRegion.united(m_dirtyPortRect) == eventRegion)
            m_dirtyPortRect = QRect();
    }
    if (m_inHighlightState)
        paintHighlightFrame(*painter);
    if (overlay && painter->isActive()) {
        painter->save();
        painter->resetTransform();
        painter->setClipping(false);
        painter->setCompositionMode(QPainter::CompositionMode_SourceOver);
        overlay(this, *painter, overlayInput);
        painter->restore();
    }
    notePaint();

    if (m_enableDirectQtDrawing) {
        m_port->EndPaint();
        m_port->paintDevice = nullptr;
    }
}

// Fills a widget-coordinate rectangle with the port's background: on the screen in direct
// mode, in the back buffer otherwise (the copy to the screen follows).
static void fillBackground(QtGrafPort* port, QPainter* directPainter, const QRect& rect)
{
    const QBrush& brush = resolvedBackgroundBrush(port);
    if (directPainter && directPainter->isActive()) {
        directPainter->save();
        directPainter->resetTransform();
        directPainter->setClipping(false);
        directPainter->setCompositionMode(QPainter::CompositionMode_SourceOver);
        directPainter->fillRect(rect, brush);
        directPainter->restore();
    } else if (QImage* image = port->image()) {
        port->EndPaint();
        QPainter(image).fillRect(rect, brush);
    }
}

// With a handler: it paints what is invalid and visible in this event. Only a handler that
// calls BeginUpdate validates what it painted; everything else stays invalid.
void AQtWindow::consumeUpdateRegion(QPainter* painter, const QRegion& eventRegion,
                                    bool fill)
{
    QRegion visiblePart = m_updateRegion & rect();
    if (!visiblePart.isEmpty()) {
        m_updateRegion = visiblePart & eventRegion;
        if (!m_updateRegion.isEmpty()) {
            if (fill)
                fillBackground(m_port, m_enableDirectQtDrawing ? painter : nullptr,
                               m_updateRegion.boundingRect());
            else if (m_eventHandler
                     && !callWindowHandler(this, [&] {
                            m_eventHandler->PaintEventHandler(painter, m_updateRegion);
                        }))
                return;
            if (m_updateStarted) {
                m_updateStarted = false;
                visiblePart -= eventRegion;
                if (!m_updateRegion.isEmpty()) {
                    visiblePart += m_updateRegion;
                    update(m_updateRegion);
                }
            }
        }
    }
    m_updateRegion = visiblePart;
    if (supportLegacyMacEventProcessing()) {
        if (!m_updateRegion.isEmpty())
            MakeUpdateEventIfNecessary();
        else
            clearPendingUpdateEvent();
    }
    m_updateRegionChanged = !m_updateRegion.isEmpty();
}

// One image draw for a simple region, one per rectangle otherwise.
void AQtWindow::paintBackBuffer(QPainter& painter, const QRegion& region)
{
    const QImage* image = m_port->image();
    if (!image)
        return;
    painter.setCompositionMode(QPainter::CompositionMode_Source);
    if (!supportLegacyMacEventProcessing() || region.rectCount() < 2) {
        const QRect r = region.boundingRect();
        painter.drawImage(r, *image, r);
        return;
    }
    for (const QRect& r : region)
        painter.drawImage(r, *image, r);
}

void AQtWindow::paintHighlightFrame(QPainter& painter)
{
    QPen pen;
    int w = 0;
    if (!painter.isActive() || !highlightPen(&pen, &w))
        return;
    painter.save();
    painter.setCompositionMode(QPainter::CompositionMode_SourceOver);
    painter.setPen(pen);
    painter.setBrush(Qt::NoBrush);
    painter.drawRect(rect().adjusted(w / 2, w / 2, -(w % 2) - w / 2, -(w % 2) - w / 2));
    painter.restore();
}

} // namespace Velmar
