// The dirty area of the back buffer and how it reaches the screen; scrolling in direct mode;
// fitting the port to the widget; bringing pending paints up to date when modes change.
#include <Velmar/AQtWindow.h>
#include <Velmar/QtGrafPort.h>

#include "windows/WindowPrivate.h"

#include <QCoreApplication>
#include <QEvent>
#include <QPointer>
#include <QWindow>

namespace Velmar {

using namespace Private;

namespace {

// Counts the update requests delivered to a widget while it lives.
class UpdateRequestCounter : public QObject {
public:
    explicit UpdateRequestCounter(QWidget* watched) : m_watched(watched)
    {
        if (watched)
            watched->installEventFilter(this);
    }
    ~UpdateRequestCounter() override
    {
        if (m_watched)
            m_watched->removeEventFilter(this);
    }
    bool eventFilter(QObject*, QEvent* e) override
    {
        if (e->type() == QEvent::UpdateRequest)
            ++m_count;
        return false;
    }
    int count() const { return m_count; }

private:
    QPointer<QWidget> m_watched;
    int m_count = 0;
};

} // namespace

void AQtWindow::markGrafPortDirty(const QRect& rect)
{
    if (m_inPaintEvent || isHidden())
        return;
    m_dirtyPortRect |= rect;
}

bool AQtWindow::flushDirtyPort(bool immediately)
{
    m_dirtyPortRect &= rect();
    bool later = false;
    if (isVisible() && m_dirtyPortRect.isValid()) {
        if (m_enableDirectQtDrawing)
            return false; // the rectangle is kept for the next paint event
        // Not on the screen yet: a repaint would paint nothing, so the area stays dirty and
        // goes up with the paint that follows the exposure.
        if (const QWindow* handle = window()->windowHandle(); handle && !handle->isExposed()) {
            update(m_dirtyPortRect);
            return true;
        }
        if (immediately && !testAttribute(Qt::WA_WState_ConfigPending)) {
            const bool handling = m_enableEventHandling;
            const bool inFlush = m_inFlush;
            m_enableEventHandling = false;
            m_inFlush = true;
            repaint(m_dirtyPortRect);
            m_enableEventHandling = handling;
            m_inFlush = inFlush;
            VELMAR_ASSERT(!m_inPaintEvent, "!m_inPaintEvent");
            if (!m_updateRegion.isEmpty())
                update(m_updateRegion);
        } else {
            update(m_dirtyPortRect);
            later = true;
        }
    }
    m_dirtyPortRect = QRect();
    return later;
}

bool AQtWindow::RepaintDirtyPorts(bool immediately)
{
    bool later = false;
    for (const QPointer<AQtWindow>& window : dirtyPortSetSnapshot()) {
        if (window && !window->IsDeletePending())
            later = window->flushDirtyPort(immediately) || later;
    }
    return later;
}

void AQtWindow::scrollRect(SInt32 dx, SInt32 dy, const QRect& requested)
{
    if (!VELMAR_ASSERT(m_enableDirectQtDrawing, "m_enableDirectQtDrawing")
        || !VELMAR_ASSERT(!m_inPaintEvent, "!m_inPaintEvent"))
        return;
    // 16-bit offsets at most: anything further scrolls the whole area out anyway.
    dx = qBound(-32768, int(dx), 32767);
    dy = qBound(-32768, int(dy), 32767);
    const QRect area = requested.isValid() ? (requested & rect()) : rect();
    if (!m_updateRegion.isEmpty()) {
        // Invalid areas move with the content.
        const QRegion moved = (m_updateRegion & area).translated(dx, dy) & area;
        m_updateRegion -= area;
        m_updateRegion += moved;
    }
    if (dx > 0)
        m_updateRegion += QRect(area.left(), area.top(), dx, area.height()) & area;
    else if (dx < 0)
        m_updateRegion += QRect(area.right() + 1 + dx, area.top(), -dx, area.height()) & area;
    if (dy > 0)
        m_updateRegion += QRect(area.left(), area.top(), area.width(), dy) & area;
    else if (dy < 0)
        m_updateRegion += QRect(area.left(), area.bottom() + 1 + dy, area.width(), -dy) & area;
    scroll(dx, dy, area);
}

void AQtWindow::scaleGrafPortToWindow(const QSize& wanted)
{
    if (!m_port)
        return;
    const QSize size = wanted.expandedTo(QSize(1, 1));
    if (size == m_port->bounds.size())
        return;
    m_port->setBounds(QRect(QPoint(0, 0), size));
    invalidateWholeWidget();
}

void AQtWindow::invalidateWholeWidget()
{
    if (supportLegacyMacEventProcessing()) {
        m_updateRegion = QRegion();
        addUpdateRegion(rect());
    } else {
        m_updateRegion = QRegion(rect());
    }
}

void AQtWindow::syncUpdateEvent(int mode)
{
    if (m_inPaintEvent)
        return;
    const bool wasInSync = m_inSyncUpdate;
    m_inSyncUpdate = true;
    QCoreApplication::sendPostedEvents(this, QEvent::UpdateLater);
    switch (mode) {
    case 0:
    case 1: {
        if (mode == 1)
            MakeUpdateEventIfNecessary();
        if (m_updateRegionChanged) {
            m_updateRegionChanged = false;
            update(m_updateRegion);
        }
        if (mode == 0) {
            // Pending update requests are delivered now; without one, paint here.
            QWidget* top = window();
            UpdateRequestCounter delivered(top);
            QCoreApplication::sendPostedEvents(top, QEvent::UpdateRequest);
            if (delivered.count() == 0)
                repaint(m_updateRegion);
        }
        break;
    }
    case 2: {
        // Whatever update was requested is covered by repainting the whole top-level window.
        invalidateWholeWidget();
        QWidget* top = window();
        QCoreApplication::removePostedEvents(top, QEvent::UpdateRequest);
        top->repaint();
        break;
    }
    default:
        break;
    }
    m_inSyncUpdate = wasInSync;
}

} // namespace Velmar
