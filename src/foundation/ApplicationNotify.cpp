// The application's event delivery filter: timer postponement, the Control-key menu update,
// the cursor on activation, tablet filtering, and the guard that keeps exceptions out of Qt.
#include <Velmar/Application.h>

#include <Velmar/HostCore.h>

#include "events/EventQueue.h"
#include "foundation/ApplicationPrivate.h"
#include "platform/Platform.h"

#include <QKeyEvent>
#include <QThread>
#include <QTimerEvent>

#include <exception>
#include <utility>

namespace Velmar {

namespace {

bool isTabletEvent(QEvent::Type type)
{
    switch (type) {
    case QEvent::TabletMove:
    case QEvent::TabletPress:
    case QEvent::TabletRelease:
    case QEvent::TabletEnterProximity:
    case QEvent::TabletLeaveProximity:
        return true;
    default:
        return false;
    }
}

bool carbonEventsBlocked()
{
    return Private::MainEventQueue()->CheckCarbonEventsDisabled();
}

// Qt hands a key press first to the widget's window, which forwards it to the widget; the
// menu update must happen once per press.
bool isWidgetWindowRelay(const QObject* receiver)
{
    return receiver->isWindowType() && receiver->inherits("QWidgetWindow");
}

void logResultCodeException(qlonglong code)
{
    qCritical("%s", qPrintable(QStringLiteral("Unhandled result code exception (%1)!")
                                   .arg(QString::number(code, 16))));
}

} // namespace

namespace Private {

void logCurrentNotifyException()
{
    qCritical("AQtApplication::notify() - an exception occurred processing events.");
    try {
        throw;
    } catch (const char* text) {
        qCritical("%s", text ? text : "NULL char* caught!");
    } catch (SInt32 code) {
        logResultCodeException(code);
    } catch (long code) { // a Toolbox result code thrown as a C long
        logResultCodeException(code);
    } catch (const XError& error) {
        qCritical("%s", qPrintable(QStringLiteral("   Error: %1 Line: %2 File: %3")
                                       .arg(QString::fromLocal8Bit(error.GetErrorMessage()),
                                            QString::number(error.GetLine()),
                                            QString::fromLocal8Bit(error.GetFile()))));
    } catch (const QString& text) {
        qCritical("%s", qPrintable(text));
    } catch (const std::exception& e) {
        qCritical("%s", e.what());
    } catch (...) {
        qCritical("Unknown exception occurred!");
    }
}

} // namespace Private

bool AQtApplication::notify(QObject* receiver, QEvent* e)
{
    try {
        return filterAndDeliver(receiver, e);
    } catch (...) {
        Private::logCurrentNotifyException();
    }
    return false;
}

bool AQtApplication::filterAndDeliver(QObject* receiver, QEvent* e)
{
    const bool inOwnThread = thread() == QThread::currentThread();
    // Where the window system cannot be asked for key and button state, the platform
    // layer answers from the input Qt delivers; every event passes here first.
    if (inOwnThread)
        Private::Platform::trackInputEvent(e);
    switch (e->type()) {
    case QEvent::Timer:
        if (inOwnThread && carbonEventsBlocked()) {
            postponeTimer(receiver, static_cast<QTimerEvent*>(e)->timerId());
            return true;
        }
        break;
    case QEvent::KeyPress:
        if (inOwnThread && !carbonEventsBlocked() && !isWidgetWindowRelay(receiver)
            && static_cast<QKeyEvent*>(e)->key() == Qt::Key_Control) {
            // Control stands for the command key: the host updates its menus before a
            // shortcut is matched.
            menuAboutToShow(nullptr);
        }
        break;
    case QEvent::WindowActivate:
    case QEvent::WindowDeactivate:
        if (inOwnThread) {
            if (auto initCursor = Private::applicationHooks().initCursor)
                initCursor();
        }
        break;
    default:
        if (isTabletEvent(e->type())) {
            // The pen reaches widgets only as the mouse events Qt synthesises.
            e->ignore();
            return false;
        }
        break;
    }
    return QApplication::notify(receiver, e);
}

void AQtApplication::postponeTimer(QObject* receiver, int timerId)
{
    // Few timers fire while events are blocked: a scan is cheaper than keeping an index.
    for (const Private::PostponedTimer& timer : std::as_const(d->postponedTimers)) {
        if (timer.timerId == timerId)
            return;
    }
    d->postponedTimers.append({QPointer<QObject>(receiver), timerId});
}

void AQtApplication::DispatchPostponedTimers()
{
    // Taken first: posting may run nothing now, but the list must be empty afterwards
    // even if a receiver is blocked again before the posted events arrive.
    const QList<Private::PostponedTimer> timers = std::exchange(d->postponedTimers, {});
    for (const Private::PostponedTimer& timer : timers) {
        if (timer.receiver)
            QCoreApplication::postEvent(timer.receiver, new QTimerEvent(timer.timerId));
    }
}

namespace Private {

bool NativeEventFilter::nativeEventFilter(const QByteArray&, void* message, qintptr* result)
{
    SInt32 answer = 0;
    if (!m_app->winEventFilter(message, &answer))
        return false;
    if (result)
        *result = answer;
    return true;
}

} // namespace Private

} // namespace Velmar
