// The update region: what is invalid, the one pending update event it makes, and the
// BeginUpdate/EndUpdate pair. Update events never enter the queue; the waiting calls find
// the windows that hold one.
#include <Velmar/AQtWindow.h>
#include <Velmar/FeatureFlags.h>
#include <Velmar/QtGrafPort.h>
#include <Velmar/Windows.h>

#include "events/EventQueue.h"
#include "foundation/Conversions.h"
#include "quickdraw/GrafPortPrivate.h"
#include "quickdraw/RegionHandles.h"
#include "windows/WindowPrivate.h"

namespace Velmar {

using namespace Private;

namespace {

int gPendingUpdateCount = 0;

// Port coordinates of the window to widget coordinates.
QPoint portOrigin(const AQtWindow* window)
{
    return window->GetPort() ? window->GetPort()->origin() : QPoint();
}

} // namespace

namespace Private {

UInt32 pendingUpdateCount()
{
    return UInt32(gPendingUpdateCount);
}

} // namespace Private

void AQtWindow::addUpdateRegion(const QRect& rect)
{
    addUpdateRegion(QRegion(rect));
}

void AQtWindow::addUpdateRegion(const QRegion& region)
{
    const bool legacy = supportLegacyMacEventProcessing();
    if (legacy && isHidden())
        return;
    if (m_inPaintEvent) {
        // Only a handler that started an update while painting may add to the region.
        if (m_updateStarted) {
            m_updateRegion += region;
            MakeUpdateEventIfNecessary();
        }
        return;
    }
    const QRegion old = m_updateRegion;
    m_updateRegion += region;
    MakeUpdateEventIfNecessary();
    if (m_updateRegion != old || m_updateRegionChanged) {
        m_updateRegionChanged = false;
        if (!legacy)
            update(m_updateRegion);
    }
}

void AQtWindow::removeUpdateRegion(const QRegion& region)
{
    m_updateRegion -= region;
    if (m_updateRegionChanged) {
        m_updateRegionChanged = false;
        if (!supportLegacyMacEventProcessing())
            update(m_updateRegion);
    }
    if (m_updateRegion.isEmpty())
        clearPendingUpdateEvent();
}

void AQtWindow::MakeUpdateEventIfNecessary()
{
    if (!supportLegacyMacEventProcessing()) {
        clearPendingUpdateEvent();
        return;
    }
    if (!m_updateRegion.isEmpty() && !m_pendingUpdateEvent && !m_deletePending) {
        EventQueueItem* item = EventQueueItem::Create();
        item->eventClass = kEventClassWindow;
        item->eventKind = kEventWindowUpdate;
        item->when = TickCount();
        item->window = this;
        m_pendingUpdateEvent = item; // the reference Create gave
        ++gPendingUpdateCount;
    }
    gMainEventQueue.RaiseQueueChangedSignal();
}

void AQtWindow::clearPendingUpdateEvent()
{
    if (!m_pendingUpdateEvent)
        return;
    EventQueueItem* item = m_pendingUpdateEvent;
    m_pendingUpdateEvent = nullptr;
    --gPendingUpdateCount;
    VELMAR_ASSERT(gPendingUpdateCount >= 0, "sPendingUpdateCount >= 0");
    item->Release();
}

void AQtWindow::clearAllPendingUpdateEvents()
{
    const std::vector<AQtWindow*> windows = liveWindows();
    for (AQtWindow* window : windows)
        window->clearPendingUpdateEvent();
}

int AQtWindow::pendingUpdateEventCount()
{
    return gPendingUpdateCount;
}

void AQtWindow::beginUpdate()
{
    m_updateStarted = true;
    if (m_port) {
        m_port->visibleRegion = m_updateRegion.translated(m_port->origin());
        m_port->updateEffectiveClip();
    }
    if (!m_inPaintEvent && supportLegacyMacEventProcessing())
        update(m_updateRegion); // so that what the host draws now reaches the screen
    m_updateRegion = QRegion();
    clearPendingUpdateEvent();
}

void AQtWindow::endUpdate()
{
    if (!m_updateStarted)
        return;
    if (!m_inPaintEvent)
        m_updateStarted = false;
    if (m_port) {
        m_port->visibleRegion = QRegion(m_port->bounds);
        m_port->updateEffectiveClip();
    }
    if (!m_inPaintEvent)
        QDFlushPortBuffer(m_port, nullptr);
}

// ---- The free calls --------------------------------------------------------------------------

namespace {

// The four calls share their checks: a hidden window ignores them; the rectangle or region
// is in port coordinates.
template <typename Shape>
OSStatus changeUpdateRegion(WindowRef window, const Shape* shape, bool add)
{
    if (!VELMAR_CHECK_WINDOW(window))
        return errInvalidWindowPtr;
    if (window->isHidden())
        return noErr;
    QRegion region;
    if constexpr (std::is_same_v<Shape, Rect>) {
        // InvalWindowRect alone takes a null rectangle as nothing to add.
        if (!shape)
            return add ? noErr : errNullWindowArgument;
        region = QRegion(toQRect(shape));
    } else {
        if (!shape || !VELMAR_CHECK_REGION(shape))
            return errNullWindowArgument;
        region = *shape;
    }
    region.translate(-portOrigin(window));
    if (add)
        window->addUpdateRegion(region);
    else
        window->removeUpdateRegion(region);
    return noErr;
}

} // namespace

OSStatus InvalWindowRect(WindowRef window, const Rect* bounds)
{
    return changeUpdateRegion(window, bounds, true);
}

OSStatus InvalWindowRgn(WindowRef window, RgnHandle region)
{
    return changeUpdateRegion(window, region, true);
}

OSStatus ValidWindowRect(WindowRef window, const Rect* bounds)
{
    return changeUpdateRegion(window, bounds, false);
}

OSStatus ValidWindowRgn(WindowRef window, RgnHandle region)
{
    return changeUpdateRegion(window, region, false);
}

void BeginUpdate(WindowRef window)
{
    if (VELMAR_CHECK_WINDOW(window))
        window->beginUpdate();
}

void EndUpdate(WindowRef window)
{
    if (VELMAR_CHECK_WINDOW(window))
        window->endUpdate();
}

Boolean IsWindowUpdatePending(WindowRef window)
{
    if (!VELMAR_CHECK_WINDOW(window))
        return false;
    const QRegion& update = window->updateRegion();
    if (window->supportLegacyMacEventProcessing() || update.isEmpty())
        return !update.isEmpty();
    if (LimitDrawingWithWindowVisibleRegion(kFeatureFlagQuery) && window->isVisible())
        return update.intersects(window->visibleRegion());
    return true;
}

} // namespace Velmar
