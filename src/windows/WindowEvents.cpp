// Qt's events on a window become Toolbox events: input and close requests are converted and
// queued (a close request never closes the widget: the host decides), show and hide keep
// the update region and the dirty-port set, activation goes through the window list.
#include <Velmar/AQtWindow.h>
#include <Velmar/HostCore.h>
#include <Velmar/QtGrafPort.h>

#include "events/EventQueue.h"
#include "foundation/Lifetime.h"
#include "events/KeyModifiers.h"
#include "events/QtInputConversion.h"
#include "windows/WindowFilters.h"
#include "windows/WindowPorts.h"
#include "windows/WindowPrivate.h"

#include <QApplication>
#include <QInputMethodEvent>
#include <QResizeEvent>

#include <exception>

namespace Velmar {

using namespace Private;

namespace {

void schedule(AQtWindow* window, UInt32 eventClass, UInt32 eventKind, const QRect* bounds = nullptr)
{
    EventQueueItemSmartPtr item = EventQueueItemSmartPtr::Create();
    item->eventClass = eventClass;
    item->eventKind = eventKind;
    item->when = TickCount();
    item->window = window;
    if (bounds) {
        // Global content bounds, right and bottom exclusive.
        item->currentBounds = Rect{SInt16(bounds->top()), SInt16(bounds->left()),
                                   SInt16(bounds->bottom() + 1), SInt16(bounds->right() + 1)};
    }
    ScheduleEvent(item, EventQueueItem::GuessMerge);
}

} // namespace

bool AQtWindow::event(QEvent* e)
{
    // Whatever the host does from the handlers this event reaches, this object outlives it.
    KeepAlive keep(this);
    if (m_deletePending)
        return e->type() == QEvent::DeferredDelete ? QWidget::event(e) : false;

    if (e->type() == focusRequestEventType()) {
        QWidget* focus = QApplication::focusWidget();
        const bool focusInside = focus && (focus == this || isAncestorOf(focus));
        if (!focusInside && IsCurrentlyVisible() && IsWindowActivated())
            setFocus(Qt::OtherFocusReason);
        return true;
    }
    if (const WindowFilterHooks& hooks = windowFilterHooks();
        hooks.specialEvent && hooks.specialEvent(this, e))
        return true;

    switch (e->type()) {
    case QEvent::FocusIn:
    case QEvent::FocusOut:
        return true;
    case QEvent::Paint:
    case QEvent::Move:
    case QEvent::Resize:
    case QEvent::DeferredDelete:
        return QWidget::event(e);
    case QEvent::Show:
    case QEvent::Hide:
        handleShowHide(e);
        return QWidget::event(e);
    case QEvent::WindowActivate:
    case QEvent::WindowDeactivate:
        ActivateWindow(e->type() == QEvent::WindowActivate);
        e->accept();
        return true;
    case QEvent::DragEnter:
    case QEvent::DragMove:
    case QEvent::DragLeave:
    case QEvent::Drop:
        if (const WindowFilterHooks& hooks = windowFilterHooks(); hooks.dragEvent)
            return hooks.dragEvent(this, e);
        e->ignore();
        return true;
    default:
        break;
    }
    if (postConverted(e))
        return true;
    if (const WindowFilterHooks& hooks = windowFilterHooks();
        hooks.unconvertedEvent && hooks.unconvertedEvent(this, e))
        return true;
    return QWidget::event(e);
}

bool AQtWindow::handleShowHide(QEvent* e)
{
    if (e->type() == QEvent::Hide) {
        if (!m_enableDirectQtDrawing)
            dirtyPortSetRemove(this);
        clearPendingUpdateEvent();
        return true;
    }
    if (!m_enableDirectQtDrawing)
        dirtyPortSetAdd(this);
    if (!supportLegacyMacEventProcessing()) {
        m_updateRegion = QRegion(rect());
        if (m_enableEventHandling && m_eventHandler
            && !callWindowHandler(this, [this] { m_eventHandler->ShowEventHandler(); }))
            return true;
    } else {
        m_updateRegion = QRegion();
        addUpdateRegion(rect());
    }
    // Tells the host where the window now is, without its handler taking part.
    const bool handling = m_enableEventHandling;
    m_enableEventHandling = false;
    SetInResizeState(false);
    m_enableEventHandling = handling;
    return true;
}

bool AQtWindow::postConverted(QEvent* e)
{
    EventQueueItemSmartPtr item = EventQueueItemSmartPtr::Create();
    if (!ConvertVelmarEvent(this, e, item.get()))
        return false;
    ScheduleEvent(item, EventQueueItem::GuessMerge);
    // A close request is the host's to grant: Qt must not close the window by itself.
    if (e->type() == QEvent::Close)
        e->ignore();
    else
        e->accept();
    return true;
}

void AQtWindow::resizeEvent(QResizeEvent* e)
{
    QWidget::resizeEvent(e);
    if (!m_port || e->size().height() <= 0)
        return;
    m_contentSize = e->size();
    scaleGrafPortToWindow(e->size());
    if (m_enableEventHandling && m_eventHandler)
        callWindowHandler(this, [this] { m_eventHandler->ResizeEventHandler(); });
}

void AQtWindow::inputMethodEvent(QInputMethodEvent* e)
{
    const WindowFilterHooks& hooks = windowFilterHooks();
    if (m_focusProxyTextEdit && hooks.forwardInputMethod) {
        hooks.forwardInputMethod(m_focusProxyTextEdit, e);
        return;
    }
    QWidget::inputMethodEvent(e);
}

void AQtWindow::SetInResizeState(bool inResize)
{
    if (m_enableEventHandling && m_eventHandler
        && !callWindowHandler(this, [&] { m_eventHandler->SetInResizeState(inResize); }))
        return;
    if (inResize) {
        m_inResizeState = true;
        return;
    }
    m_inResizeState = false;
    if (m_deletePending)
        return;
    const QRect global(windowToGlobal(this, QPoint(0, 0)), size());
    schedule(this, kEventClassWindow, kEventWindowBoundsChanged, &global);
}

bool AQtWindow::ZoomEvent()
{
    schedule(this, kEventClassVelmar, kEventVelmarZoomed);
    return true;
}

bool AQtWindow::AcceptDropOnWindowTab(Qt::KeyboardModifiers modifiers)
{
    if (!m_enableEventHandling || !m_eventHandler)
        return false;
    bool accepted = false;
    const SInt16 mods = SInt16(macModifiers(modifiers));
    return callWindowHandler(this, [&] { accepted = m_eventHandler->DropOnWindowTabHandler(mods); })
        && accepted;
}

void AQtWindow::SetContentSize(const QSize& size)
{
    if (m_inSetContentSize)
        return;
    ScopedFlag guard(m_inSetContentSize, true);
    m_contentSize = size;
    scaleGrafPortToWindow(size);
    if (Brindle::Decorator* decorator = GetDecorator()) {
        decorator->SetContentSize(size);
    } else {
        if (windowFlags().testFlag(Qt::MSWindowsFixedSizeDialogHint))
            setFixedSize(size);
        resize(size);
        updateGeometry();
    }
}

} // namespace Velmar
