// The front-to-back window list beside Qt's own stacking: walking it, reordering it, the
// user focus window, activation, and hit testing.
#include <Velmar/AQtWindow.h>
#include <Velmar/Application.h>
#include <Velmar/HostCore.h>
#include <Velmar/QDRegions.h>
#include <Velmar/QtGrafPort.h>
#include <Velmar/Windows.h>

#include "events/EventQueue.h"
#include "events/QtInputConversion.h"
#include "foundation/Conversions.h"
#include "platform/Platform.h"
#include "quickdraw/RegionHandles.h"
#include "windows/WindowPrivate.h"

#include <QApplication>
#include <QCoreApplication>

#include <algorithm>

namespace Velmar {

using namespace Private;

namespace {

bool isModal(const AQtWindow* window)
{
    return window->windowModality() != Qt::NonModal;
}

// The classic grow box: a 15-pixel square in the bottom-right corner of a resizable window.
bool growBoxSize(AQtWindow* window, int* size)
{
    if (!window->IsResizeable() || window->isDynViewWindow())
        return false;
    *size = 15;
    return true;
}

QRect globalRect(AQtWindow* window, WindowRegionCode code)
{
    Rect r;
    GetWindowBounds(window, code, &r);
    return toQRect(&r);
}

void postActivation(AQtWindow* window, bool activate)
{
    QEvent e(activate ? QEvent::WindowActivate : QEvent::WindowDeactivate);
    EventQueueItemSmartPtr item = EventQueueItemSmartPtr::Create();
    if (ConvertVelmarEvent(window, &e, item.get()))
        ScheduleEvent(item, EventQueueItem::GuessMerge);
}

} // namespace

// ---- Walking the list --------------------------------------------------------------------------

WindowRef FrontWindow()
{
    return windowList().empty() ? nullptr : windowList().front();
}

WindowRef GetWindowList()
{
    return FrontWindow();
}

WindowRef GetNextWindow(WindowRef window)
{
    if (!VELMAR_CHECK_WINDOW(window))
        return nullptr;
    const auto& list = windowList();
    auto it = std::find(list.begin(), list.end(), window.get());
    if (it == list.end() || ++it == list.end())
        return nullptr;
    return *it;
}

// ---- Reordering ----------------------------------------------------------------------------------

void BringToFront(WindowRef window)
{
    if (!VELMAR_CHECK_WINDOW(window) || !isRunningInForeground())
        return;
    QWidget* top = window->GetTopWindow();
    if (!VELMAR_ASSERT(top, "pTopWindow != NULL"))
        return;
    top->raise();
    listMoveToFront(window);
}

void SendBehind(WindowRef window, WindowRef behindWindow)
{
    if (!VELMAR_CHECK_WINDOW(window))
        return;
    auto& list = windowList();
    if (!behindWindow) {
        if (!VELMAR_ASSERT(!list.empty(), "!isEmpty()"))
            return;
        behindWindow = list.back();
    } else if (!VELMAR_CHECK_WINDOW(behindWindow)) {
        return;
    }

    QWidget* top = window->GetTopWindow();
    QWidget* topBehind = behindWindow->GetTopWindow();
    if (!VELMAR_ASSERT(top, "pTopWindow != NULL") || !VELMAR_ASSERT(topBehind, "pTopBehind != NULL"))
        return;
    if (top != topBehind) {
        if (!top->isWindow() || !topBehind->isWindow()) {
            if (top->parentWidget() == topBehind->parentWidget())
                top->stackUnder(topBehind);
            else
                qWarning("SendBehind: both windows must either be top level windows or children "
                         "of the same parent window!");
        } else if (top->isVisible() && topBehind->isVisible()) {
            Platform::placeNativeWindowBehind(topBehind, topBehind);
            QEvent zorder(QEvent::ZOrderChange);
            QCoreApplication::sendEvent(window.get(), &zorder);
        } else if (!top->isVisible()) {
            top->lower();
        }
        // A visible window behind a hidden one keeps its place on screen: the list only.
    }

    auto it = std::find(list.begin(), list.end(), window.get());
    if (it == list.end())
        return;
    list.erase(it);
    auto anchor = std::find(list.begin(), list.end(), behindWindow.get());
    if (anchor == list.end())
        list.insert(list.begin(), window); // it was the last one: to the front, deliberately
    else
        list.insert(anchor + 1, window);
}

void SelectWindow(WindowRef window)
{
    if (!VELMAR_CHECK_WINDOW(window) || !isRunningInForeground())
        return;
    SetUserFocusWindow(window);
    if (userFocusRecord().data() != window.get())
        return; // a modal window kept the focus
    window->activateWindow();
    BringToFront(window);
    if (Brindle::Decorator* decorator = window->GetDecorator())
        decorator->SelectWindow();
    else
        window->SelectWindow();
}

void AQtWindow::SelectWindow()
{
    if (m_inSelectWindow)
        return;
    ScopedFlag guard(m_inSelectWindow, true);
    Velmar::BringToFront(this);
    if (!m_activated)
        ActivateWindow(true);
    QPointer<AQtWindow>& previous = activeWindowRecord();
    if (previous && previous.data() != this)
        previous->ActivateWindow(false);
}

void AQtWindow::ActivateWindow(bool activate)
{
    if (m_inActivateWindow || !IsCurrentlyVisible())
        return;
    ScopedFlag guard(m_inActivateWindow, true);
    QPointer<AQtWindow>& active = activeWindowRecord();
    if (activate) {
        QWidget* focus = QApplication::focusWidget();
        if (!m_dynView && !(focus && (focus == this || isAncestorOf(focus))))
            QCoreApplication::postEvent(this, new QEvent(focusRequestEventType()));
        if (m_activated) {
            listMoveToFront(this);
        } else {
            SetUserFocusWindow(this);
            if (userFocusRecord().data() != this)
                return;
            if (active && active.data() != this)
                active->SetWindowActivated(false);
            SetWindowActivated(true);
            active = this;
            listMoveToFront(this);
        }
    } else if (m_activated || active.data() == this) {
        SetWindowActivated(false);
        if (active.data() == this)
            active = nullptr;
    }
    postActivation(this, activate);
}

// ---- User focus ----------------------------------------------------------------------------------

OSStatus SetUserFocusWindow(WindowRef window)
{
    if (window && !VELMAR_CHECK_WINDOW(window))
        return errInvalidWindowPtr;
    QPointer<AQtWindow>& focus = userFocusRecord();
    if (focus.data() == window.get())
        return noErr;
    if (focus && focus->isHidden())
        focus = nullptr;
    if (focus && window && isModal(focus) && !isModal(window))
        return noErr; // a modal window keeps the focus, silently
    focus = window.get();
    return noErr;
}

WindowRef GetUserFocusWindow()
{
    QPointer<AQtWindow>& focus = userFocusRecord();
    if (focus && !focus->IsDeletePending() && focus->isVisible())
        return focus.data();
    if (auto* active = qobject_cast<AQtWindow*>(QApplication::activeWindow());
        active && !active->IsDeletePending()) {
        focus = active;
        return active;
    }
    for (AQtWindow* window : windowList()) {
        if (!window->IsDeletePending() && window->IsCurrentlyVisible()) {
            focus = window;
            return window;
        }
    }
    focus = nullptr;
    return nullptr;
}

// ---- Hit testing and painting ------------------------------------------------------------------

WindowPartCode FindWindow(Point point, WindowRef* window)
{
    const QPoint p(point.h, point.v);
    for (AQtWindow* candidate : windowList()) {
        if (candidate->IsDeletePending() || !candidate->isVisible()
            || candidate->window()->isMinimized())
            continue;
        if (!globalRect(candidate, kWindowStructureRgn).contains(p))
            continue;
        if (window)
            *window = candidate;
        const QRect content = globalRect(candidate, kWindowContentRgn);
        if (!content.contains(p))
            return inDesk; // the frame belongs to the shell, not to the Toolbox window
        int grow = 0;
        if (growBoxSize(candidate, &grow)
            && QRect(content.right() - grow + 1, content.bottom() - grow + 1, grow, grow).contains(p))
            return inGrow;
        return inContent;
    }
    return inDesk;
}

void PaintOne(WindowRef window, RgnHandle clobbered)
{
    if (!VELMAR_CHECK_WINDOW(window) || !clobbered || !VELMAR_CHECK_REGION(clobbered)
        || !window->isVisible())
        return;
    const QRect box = clobbered->boundingRect();
    if (!globalRect(window, kWindowContentRgn).intersects(box))
        return;
    const QPoint topLeft = window->mapFromGlobal(box.topLeft());
    window->addUpdateRegion(QRect(topLeft, box.size()));
}

void PaintBehind(WindowRef startWindow, RgnHandle clobbered)
{
    if (!VELMAR_CHECK_WINDOW(startWindow))
        return;
    const std::vector<AQtWindow*> list = windowList();
    auto it = std::find(list.begin(), list.end(), startWindow.get());
    for (; it != list.end(); ++it) {
        if (isLive(*it))
            PaintOne(*it, clobbered);
    }
}

void CalcVisBehind(WindowRef, RgnHandle) {}

void SyncUpdateEvent(WindowRef window, int mode)
{
    if (window && isLive(window.get()) && !window->IsDeletePending()) {
        if (window->isVisible())
            window->syncUpdateEvent(mode);
        return;
    }
    const std::vector<QPointer<AQtWindow>> all(windowList().begin(), windowList().end());
    for (const QPointer<AQtWindow>& w : all) {
        if (w && !w->IsDeletePending() && w->isVisible())
            w->syncUpdateEvent(mode);
    }
}

// ---- Windows, widgets and native handles --------------------------------------------------------

QWidget* GetWidgetPtr(WindowRef window)
{
    return VELMAR_CHECK_WINDOW(window) ? window.get() : nullptr;
}

Brindle::ManagedWindow* GetManagedWindowPtr(WindowRef window)
{
    return VELMAR_CHECK_WINDOW(window) ? static_cast<Brindle::ManagedWindow*>(window.get())
                                       : nullptr;
}

WindowRef GetWindowFromPort(GrafPtr port)
{
    if (!port || !IsValidPort(port))
        return nullptr;
    return port->window;
}

void* GetNativeWindowFromWidget(QWidget* widget)
{
    if (!widget)
        return nullptr;
    VELMAR_ASSERT(widget->testAttribute(Qt::WA_NativeWindow) || widget->isWindow(),
                  "pWidget->testAttribute(Qt::WA_NativeWindow)");
    VELMAR_ASSERT(widget->testAttribute(Qt::WA_WState_Created) && widget->internalWinId(),
                  "pWidget->testAttribute(Qt::WA_WState_Created) && pWidget->internalWinId()");
    return Platform::nativeWindowHandle(widget);
}

WindowRef GetWindowRefFromNative(void* handle)
{
    if (!handle)
        return nullptr;
    return qobject_cast<AQtWindow*>(QWidget::find(WId(reinterpret_cast<quintptr>(handle))));
}

WindowRef GetWindowRefFromWidget(QWidget* widget, bool* isDynView)
{
    auto* window = qobject_cast<AQtWindow*>(widget);
    if (window && isDynView && window->isDynViewWindow())
        *isDynView = true;
    return window;
}

} // namespace Velmar
