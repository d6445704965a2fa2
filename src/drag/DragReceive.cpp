// The receiving side: drags over the library's windows become tracking and receive handler
// calls, window handlers first, then the application's.
#include <Velmar/Drag.h>
#include <Velmar/HostCore.h>
#include <Velmar/QtGrafPort.h>
#include <Velmar/Windows.h>

#include "drag/DragPrivate.h"
#include "foundation/GuardedCall.h"
#include "windows/WindowFilters.h"

#include <QDropEvent>


namespace Velmar {

using namespace Private;

namespace {

const QString kItemData = QStringLiteral("application/x-dnditemdata");
const QString kNxnDropData = QStringLiteral("NXNDropData");

bool acceptable(const QMimeData* data)
{
    return data
        && (data->hasFormat(kItemData) || data->hasText() || data->hasUrls()
            || data->hasFormat(kNxnDropData));
}

// A drag from the same window is a move; any other takes the action it proposes.
void accept(AQtWindow* window, QDropEvent* e)
{
    if (e->source() == window) {
        e->setDropAction(Qt::MoveAction);
        e->accept();
    } else {
        e->acceptProposedAction();
    }
}

void flush(AQtWindow* window)
{
    QDFlushPortBuffer(window->GetPort(), nullptr);
}

void forgetTarget()
{
    if (Drag* drag = DragInstance())
        drag->clearTarget();
}

// A handler that throws ends the dispatch and the drag's target with it.
template <typename Call> bool guarded(Call call)
{
    if (callGuarded(call, "A drag handler threw"))
        return true;
    forgetTarget();
    return false;
}

bool onDragEvent(AQtWindow* window, QEvent* e)
{
    Drag* drag = DragInstance();
    switch (e->type()) {
    case QEvent::DragEnter: {
        auto* enter = static_cast<QDragEnterEvent*>(e);
        if (!acceptable(enter->mimeData())) {
            enter->ignore();
            return true;
        }
        accept(window, enter);
        if (drag)
            drag->setDropData(enter->mimeData());
        const bool entered = callTrackingHandlers(window, kDragTrackingEnterHandler);
        // A handler that threw has ended the tracking of this window.
        if (callTrackingHandlers(window, kDragTrackingEnterWindow) && entered
            && (drag = DragInstance()))
            drag->setTarget(window);
        flush(window);
        return true;
    }
    case QEvent::DragMove: {
        auto* move = static_cast<QDragMoveEvent*>(e);
        if (!acceptable(move->mimeData())) {
            move->ignore();
            return true;
        }
        accept(window, move);
        if (drag)
            drag->setDropData(move->mimeData());
        const bool tracked = callTrackingHandlers(window, kDragTrackingInWindow);
        flush(window);
        if (tracked && (drag = DragInstance()))
            drag->setTarget(window); // the repeat starts again from this move
        return true;
    }
    case QEvent::DragLeave:
        callTrackingHandlers(window, kDragTrackingLeaveWindow);
        callTrackingHandlers(window, kDragTrackingLeaveHandler);
        forgetTarget();
        flush(window);
        return true;
    case QEvent::Drop: {
        auto* drop = static_cast<QDropEvent*>(e);
        if (!acceptable(drop->mimeData())) {
            drop->ignore();
            return true;
        }
        forgetTarget();
        if (drag) {
            drag->setDropData(drop->mimeData());
            drag->setDropModifiers(drop->modifiers());
        }
        accept(window, drop);
        localDropStarted();
        callReceiveHandlers(window);
        callTrackingHandlers(window, kDragTrackingLeaveWindow);
        callTrackingHandlers(window, kDragTrackingLeaveHandler);
        localDropEnded();
        flush(window);
        return true;
    }
    default: return false;
    }
}

// The window may go while its handlers run; lists are copied so that handlers may install
// and remove handlers.
template <typename List, typename Call>
bool dispatch(AQtWindow* window, const List& own, const List& global, Call call)
{
    const List windowHandlers = own;
    const List globalHandlers = global;
    const QPointer<AQtWindow> alive(window);
    for (const List* list : {&windowHandlers, &globalHandlers}) {
        for (const auto& [handler, refCon] : *list) {
            if (!alive || window->IsDeletePending())
                return false;
            // Copied into the lambda: clang before 16 cannot capture a structured binding.
            if (!guarded([&, handler = handler] { call(handler); }))
                return false;
        }
    }
    return true;
}

} // namespace

namespace Private {

bool callTrackingHandlers(AQtWindow* window, DragTrackingMessage message)
{
    return dispatch(window, window->trackingHandlers(), AQtWindow::globalTrackingHandlers(),
        [&](DragTrackingHandlerUPP handler) { handler(message, window, nullptr, DragInstance()); });
}

bool callReceiveHandlers(AQtWindow* window)
{
    return dispatch(window, window->receiveHandlers(), AQtWindow::globalReceiveHandlers(),
        [&](DragReceiveHandlerUPP handler) { handler(window, nullptr, DragInstance()); });
}

void installDragReceiving()
{
    static bool sInstalled = false;
    if (sInstalled)
        return;
    sInstalled = true;
    WindowFilterHooks hooks = windowFilterHooks();
    hooks.dragEvent = onDragEvent;
    SetWindowFilterHooks(hooks);
}

} // namespace Private

// ---- Installing handlers ------------------------------------------------------------------------

namespace {

// A window given must be alive; no window means the application's lists.
bool usable(WindowRef window)
{
    return !window || IsValidWindowPtr(window);
}

} // namespace

OSErr InstallTrackingHandler(DragTrackingHandlerUPP handler, WindowRef window, void* refCon)
{
    installDragReceiving();
    if (!handler || !usable(window))
        return paramErr;
    const bool added = window ? window->setTrackingHandler(handler, refCon)
                              : AQtWindow::setGlobalTrackingHandler(handler, refCon);
    return added ? OSErr(noErr) : OSErr(paramErr);
}

OSErr RemoveTrackingHandler(DragTrackingHandlerUPP handler, WindowRef window)
{
    if (!handler || !usable(window))
        return paramErr;
    const bool removed = window ? window->removeTrackingHandler(handler)
                                : AQtWindow::removeGlobalTrackingHandler(handler);
    return removed ? OSErr(noErr) : OSErr(handlerNotFoundErr);
}

OSErr InstallReceiveHandler(DragReceiveHandlerUPP handler, WindowRef window, void* refCon)
{
    installDragReceiving();
    if (!handler || !usable(window))
        return paramErr;
    const bool added = window ? window->setReceiveHandler(handler, refCon)
                              : AQtWindow::setGlobalReceiveHandler(handler, refCon);
    return added ? OSErr(noErr) : OSErr(paramErr);
}

OSErr RemoveReceiveHandler(DragReceiveHandlerUPP handler, WindowRef window)
{
    if (!handler || !usable(window))
        return paramErr;
    const bool removed = window ? window->removeReceiveHandler(handler)
                                : AQtWindow::removeGlobalReceiveHandler(handler);
    return removed ? OSErr(noErr) : OSErr(handlerNotFoundErr);
}

} // namespace Velmar
