// DragGrayRgn: the outline of a region follows the mouse until the button goes up. The
// outline is drawn with rubber bands, one per rectangle of the region.
#include <Velmar/AQtWindow.h>
#include <Velmar/QDRegions.h>
#include <Velmar/QtGrafPort.h>
#include <Velmar/Windows.h>

#include "foundation/Conversions.h"
#include "quickdraw/CurrentPort.h"
#include "quickdraw/RegionHandles.h"
#include "windows/MouseTracker.h"
#include "windows/WindowPorts.h"
#include "windows/WindowPrivate.h"

#include <QRubberBand>

#include <memory>
#include <vector>

namespace Velmar {

using namespace Private;

namespace {

// The dragged outline: one rectangle band per rectangle of the region, in global coordinates.
class GreyRegion {
public:
    void Set(const QRegion& region, QWidget* parent)
    {
        ClearList();
        m_region = region;
        BuildList(parent);
    }
    void BuildList(QWidget* parent)
    {
        for (const QRect& r : m_region) {
            auto band = std::make_unique<QRubberBand>(QRubberBand::Rectangle, parent);
            band->setGeometry(r);
            m_bands.push_back(std::move(band));
        }
    }
    // Places the outline at the region moved by `offset` from where it started.
    void MoveTo(const QPoint& offset)
    {
        const QPoint by = offset - m_offset;
        for (auto& band : m_bands)
            band->move(band->pos() + by);
        m_offset = offset;
    }
    void Show()
    {
        for (auto& band : m_bands)
            band->show();
        m_shown = true;
    }
    void Hide()
    {
        for (auto& band : m_bands)
            band->hide();
        m_shown = false;
    }
    void ClearList() { m_bands.clear(); }
    bool isShown() const { return m_shown; }

private:
    QRegion m_region;
    std::vector<std::unique_ptr<QRubberBand>> m_bands;
    QPoint m_offset;
    bool m_shown = false;
};

} // namespace

SInt32 DragGrayRgn(RgnHandle region, Point start, const Rect* limitRect, const Rect* slopRect,
                   SInt16 axis, void (*actionProc)())
{
    VELMAR_ASSERT(axis == noConstraint || axis == hAxisOnly || axis == vAxisOnly,
                  "axis == noConstraint || axis == hAxisOnly || axis == vAxisOnly");
    CurrentPort port("DragGrayRgn");
    if (!port)
        return 0;
    AQtWindow* window = port->window;
    if (!VELMAR_ASSERT(window, "NULL != window") || !VELMAR_CHECK_WINDOW(window))
        return 0;
    if (region && !VELMAR_CHECK_REGION(region))
        return 0;
    const QRect limit = toQRect(limitRect);
    const QRect slop = toQRect(slopRect);
    VELMAR_ASSERT(slop.contains(limit), "qSlopRect.contains(qLimitRect)");

    // The outline lives on the screen: the region moves from port to global coordinates.
    GreyRegion outline;
    if (region) {
        const QPoint toGlobal = windowToGlobal(window, QPoint(0, 0)) - port->origin();
        outline.Set(region->translated(toGlobal), nullptr);
    }
    QPoint last(start.h, start.v);
    QPoint total(0, 0);
    bool disposed = false;
    {
        KeepAlive keep(window);
        MouseTracker tracker(window);
        tracker.run([&](const QPoint& global, bool leftHeld) {
            // The action procedure may dispose the window (and its port): the drag ends.
            if (actionProc && !callWindowHandler(window, actionProc)) {
                outline.Hide();
                disposed = true;
                return false;
            }
            // Limit and slop rectangles are in the port's local coordinates, as `start` is.
            // (The window's port: a procedure switching its drawing mode makes a new one.)
            const QPoint local = globalToWindow(window, global) + window->GetPort()->origin();
            QPoint step(0, 0);
            if (limit.contains(local)) {
                step = local - last;
                if (axis == hAxisOnly)
                    step.setY(0);
                else if (axis == vAxisOnly)
                    step.setX(0);
                total += step;
                last = local;
            }
            if (!leftHeld) {
                outline.Hide();
                if (!slop.contains(local))
                    total = QPoint(32768, 32768);
                return false;
            }
            if (!slop.contains(local)) {
                outline.Hide();
            } else if (!step.isNull() || !outline.isShown()) {
                outline.Hide();
                outline.MoveTo(total);
                outline.Show();
            }
            window->flushDirtyPort(true);
            return true;
        });
    }
    if (disposed)
        return 0;
    return SInt32((UInt32(UInt16(total.y())) << 16) | UInt32(UInt16(total.x())));
}

} // namespace Velmar
