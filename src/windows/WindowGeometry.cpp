// Showing, hiding, moving, sizing and zooming windows; their bounds and regions in global
// coordinates. Geometry goes through the managed window, which knows the shell's frame.
#include <Velmar/AQtWindow.h>
#include <Velmar/CarbonEventHandlers.h>
#include <Velmar/FeatureFlags.h>
#include <Velmar/QDRegions.h>
#include <Velmar/QtGrafPort.h>
#include <Velmar/Windows.h>

#include "foundation/Conversions.h"
#include "foundation/Lifetime.h"
#include "platform/WindowSystem.h"
#include "quickdraw/RegionHandles.h"
#include "windows/WindowPorts.h"
#include "windows/WindowPrivate.h"

#include <QDeadlineTimer>
#include <QTimer>
#include <QWindow>

#include <algorithm>

namespace Velmar {

using namespace Private;

namespace {

constexpr QEventLoop::ProcessEventsFlags kShowHideProcessing =
    QEventLoop::ExcludeUserInputEvents | QEventLoop::ExcludeSocketNotifiers;

// How long ShowWindow waits for the window system to put a new window on the screen.
constexpr int kExposeWaitMs = 2000;

// A show or hide of a window the host waits on takes effect at once under legacy processing.
void settleShowHide(AQtWindow* window)
{
    if (window->supportLegacyMacEventProcessing())
        ProcessNonCarbonEvents(kShowHideProcessing);
}

// A shown window is on the screen when ShowWindow returns: a host that draws next and never
// waits (it computes, or polls Button) must see its drawing, and the window's first paint
// (which erases what is invalid) must come before that drawing, not after it.
void waitUntilExposed(AQtWindow* window)
{
    const QPointer<AQtWindow> alive(window);
    QDeadlineTimer deadline(kExposeWaitMs);
    for (;;) {
        if (!alive || alive->IsDeletePending() || !alive->isVisible())
            return;
        const QWindow* handle = alive->window()->windowHandle();
        if (!handle || handle->isExposed() || deadline.hasExpired())
            return;
        // Wakes the wait below should the window system say nothing.
        QTimer::singleShot(std::min<qint64>(20, deadline.remainingTime()), [] {});
        ProcessNonCarbonEvents(kShowHideProcessing | QEventLoop::WaitForMoreEvents);
    }
}

QRect withOrigin(AQtWindow* window, const QRect& rect)
{
    return rect.translated(window->ReferenceOrigin());
}

// Qt 6.4's Wayland plugin frees a window's pending frame callback on two threads at once when
// the window hides just as the compositor answers it (a double free, then a crash). Qt hands
// the window an update request only once no frame callback is pending, so a window hidden
// right after one is safe; the request itself is swallowed, as it would only paint again.
class FrameCallbackSettler : public QObject {
public:
    explicit FrameCallbackSettler(QWindow* handle) : m_handle(handle)
    {
        m_handle->installEventFilter(this);
        m_handle->requestUpdate();
    }
    bool settled() const { return m_settled || !m_handle; }

protected:
    bool eventFilter(QObject* watched, QEvent* event) override
    {
        if (watched != m_handle || event->type() != QEvent::UpdateRequest)
            return false;
        m_settled = true;
        return true;
    }

private:
    QPointer<QWindow> m_handle;
    bool m_settled = false;
};

// At most a few frames: a compositor that stopped answering must not hold the hide up.
constexpr int kFrameSettleWaitMs = 200;

void settleFrameCallback(AQtWindow* window)
{
    if (Platform::windowSystem() != Platform::WindowSystem::Wayland)
        return;
    QWindow* handle = window->window()->windowHandle();
    if (!handle || !handle->isVisible())
        return;
    const FrameCallbackSettler settler(handle);
    const QDeadlineTimer deadline(kFrameSettleWaitMs);
    while (!settler.settled() && !deadline.hasExpired()) {
        QTimer::singleShot(std::min<qint64>(20, deadline.remainingTime()), [] {});
        ProcessNonCarbonEvents(kShowHideProcessing | QEventLoop::WaitForMoreEvents);
    }
}

} // namespace

void ShowWindow(WindowRef window)
{
    if (!VELMAR_CHECK_WINDOW(window))
        return;
    if (GrafPtr port = window->GetPort(); port && port->pixmap)
        port->pixmap->clear();
    const bool wasHidden = !window->isVisible();
    window->SetWindowVisible(true);
    if (wasHidden) {
        settleShowHide(window);
        waitUntilExposed(window);
    }
}

void HideWindow(WindowRef window)
{
    if (!VELMAR_CHECK_WINDOW(window))
        return;
    const bool wasVisible = window->isVisible();
    if (wasVisible) {
        // Waits run host code, which may dispose this window.
        const KeepAlive hold(window);
        settleFrameCallback(window);
        if (!hold.alive() || window->IsDeletePending())
            return;
    }
    window->SetWindowVisible(false);
    if (wasVisible)
        settleShowHide(window);
}

void ShowHide(WindowRef window, Boolean show)
{
    if (show)
        ShowWindow(window);
    else
        HideWindow(window);
}

Boolean IsWindowVisible(WindowRef window)
{
    return VELMAR_CHECK_WINDOW(window) && window->isVisible();
}

void SizeWindow(WindowRef window, SInt16 width, SInt16 height, Boolean /*fUpdate*/)
{
    if (VELMAR_CHECK_WINDOW(window))
        window->SetContentSize(clampedWindowSize(QSize(width, height), "SizeWindow"));
}

void MoveWindow(WindowRef window, SInt16 h, SInt16 v, Boolean front)
{
    if (!VELMAR_CHECK_WINDOW(window))
        return;
    QPoint target(h, v);
    if (window->GetDecorator()) {
        // The title bar must stay reachable: only the top is clamped, so that windows can
        // still be pushed partly off to the left, as users expect.
        const QPoint origin = window->ReferenceOrigin();
        const int frameDepth = window->ContentGeometry().top() - window->FrameGeometry().top();
        const int frameTop = qMax(0, v - origin.y() - frameDepth);
        target = QPoint(h - origin.x(), frameTop + frameDepth);
    }
    if (target != window->ContentGeometry().topLeft())
        window->ManagedWindow::MoveWindow(target);
    if (front)
        SelectWindow(window);
}

OSStatus SetWindowBounds(WindowRef window, WindowRegionCode regionCode, const Rect* globalBounds)
{
    if (!VELMAR_CHECK_WINDOW(window))
        return errInvalidWindowPtr;
    if (!globalBounds)
        return errNullWindowArgument;
    QRect rect = toQRect(globalBounds).translated(-window->ReferenceOrigin());
    rect.setSize(clampedWindowSize(rect.size(), "SetWindowBounds"));
    switch (regionCode) {
    case kWindowStructureRgn:
        window->SetFrameGeometry(rect);
        return noErr;
    case kWindowContentRgn:
        window->SetContentGeometry(rect);
        return noErr;
    default:
        VelmarLog(kLogQuickDraw, "SetWindowBounds: unknown regionCode: %d", int(regionCode));
        return unimpErr;
    }
}

OSStatus GetWindowBounds(WindowRef window, WindowRegionCode regionCode, Rect* globalBounds)
{
    if (globalBounds)
        *globalBounds = Rect{0, 0, 0, 0};
    if (!VELMAR_CHECK_WINDOW(window))
        return errInvalidWindowPtr;
    if (!globalBounds)
        return errNullWindowArgument;
    switch (regionCode) {
    case kWindowStructureRgn:
        *globalBounds = toRect(withOrigin(window, window->FrameGeometry()));
        return noErr;
    case kWindowContentRgn:
        *globalBounds = toRect(withOrigin(window, window->ContentGeometry()));
        return noErr;
    default: {
        RgnHandle region = NewRgn();
        const OSStatus result = GetWindowRegion(window, regionCode, region);
        GetRegionBounds(region, globalBounds);
        DisposeRgn(region);
        return result;
    }
    }
}

OSStatus GetWindowRegion(WindowRef window, WindowRegionCode regionCode, RgnHandle region)
{
    if (!VELMAR_CHECK_WINDOW(window))
        return errInvalidWindowPtr;
    if (!region || !VELMAR_CHECK_REGION(region))
        return errNullWindowArgument;
    switch (regionCode) {
    case kWindowStructureRgn:
    case kWindowContentRgn: {
        Rect bounds;
        GetWindowBounds(window, regionCode, &bounds);
        RectRgn(region, &bounds);
        return noErr;
    }
    case kWindowUpdateRgn:
        *region = window->updateRegion().translated(windowToGlobal(window, QPoint(0, 0)));
        return noErr;
    default:
        VelmarLog(kLogNotImpl, "GetWindowRegion, regionCode=%d", int(regionCode));
        qWarning("GetWindowRegion: regionCode=%d is not supported", int(regionCode));
        *region = QRegion();
        return errNullWindowArgument;
    }
}

void ZoomWindow(WindowRef window, WindowPartCode partCode, Boolean front)
{
    if (!VELMAR_CHECK_WINDOW(window))
        return;
    QRect target;
    if (partCode == inZoomIn)
        target = window->userRect();
    else if (partCode == inZoomOut)
        target = window->zoomRect();
    if (target.isValid()) {
        target.setSize(clampedWindowSize(target.size(), "ZoomWindow"));
        if (window->GetDecorator()) {
            window->ManagedWindow::MoveWindow(target.topLeft() - window->ReferenceOrigin());
            window->SetContentSize(target.size());
        } else {
            window->SetContentGeometry(target);
        }
    }
    if (front)
        SelectWindow(window);
}

void SetWindowStandardState(WindowRef window, const Rect* rect)
{
    if (VELMAR_CHECK_WINDOW(window) && rect)
        window->setZoomRect(toQRect(rect));
}

void SetWindowUserState(WindowRef window, const Rect* rect)
{
    if (VELMAR_CHECK_WINDOW(window) && rect)
        window->setUserRect(toQRect(rect));
}

Rect* GetWindowStandardState(WindowRef window, Rect* rect)
{
    if (VELMAR_CHECK_WINDOW(window) && rect)
        *rect = toRect(window->zoomRect());
    return rect;
}

Rect* GetWindowUserState(WindowRef window, Rect* rect)
{
    if (VELMAR_CHECK_WINDOW(window) && rect)
        *rect = toRect(window->userRect());
    return rect;
}

} // namespace Velmar
