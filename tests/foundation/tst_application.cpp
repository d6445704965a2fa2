// The application object: the notify filter (exceptions, tablets, timers,
// Control key, activation), activation events, menu slots and the native message hook.
#include "TestSupport.h"

#include <Velmar/Application.h>
#include <Velmar/CarbonEventHandlers.h>
#include <Velmar/Diagnostics.h>
#include <Velmar/HostCore.h>
#include <Velmar/HostShell.h>

#include "events/EventQueue.h"
#include "events/TimerRegistry.h"
#include "foundation/ApplicationPrivate.h"

#include <QAbstractEventDispatcher>
#include <QMenu>
#include <QMenuBar>
#include <QMessageBox>
#include <QPushButton>
#include <QPointingDevice>
#include <QTabletEvent>

#include <algorithm>
#include <functional>
#include <stdexcept>

using namespace Velmar;
using Private::EventQueueItem;
using Private::MainEventQueue;

namespace {

int queuedCount(UInt32 eventClass, UInt32 eventKind)
{
    const auto& items = MainEventQueue()->items();
    return int(std::count_if(items.begin(), items.end(),
                             [&](const auto& item) { return item->isClass(eventClass, eventKind); }));
}

const EventQueueItem* lastQueued()
{
    return MainEventQueue()->isEmpty() ? nullptr : MainEventQueue()->items().back().get();
}

class Thrower : public QObject {
public:
    std::function<void()> throwIt;
    bool event(QEvent* e) override
    {
        if (e->type() == QEvent::User)
            throwIt();
        return QObject::event(e);
    }
};

const QList<QEvent::Type> kTabletTypes{QEvent::TabletMove, QEvent::TabletPress,
                                        QEvent::TabletRelease, QEvent::TabletEnterProximity,
                                        QEvent::TabletLeaveProximity};

class EventCounter : public QWidget {
public:
    QList<int> timerIds;
    int tabletEvents = 0;

protected:
    void timerEvent(QTimerEvent* e) override { timerIds.append(e->timerId()); }
    bool event(QEvent* e) override
    {
        tabletEvents += kTabletTypes.contains(e->type()) ? 1 : 0;
        return QWidget::event(e);
    }
};

int gInitCursorCalls = 0;
QList<QAction*> gRecordedChoices;
QList<QMenu*> gRefreshed;

int gHookCalls = 0;
void* gHookMessage = nullptr;
bool consumingHook(void* message, SInt32* result) { ++gHookCalls; gHookMessage = message; *result = 42; return true; }
bool passingHook(void*, SInt32*) { ++gHookCalls; return false; }

} // namespace

class TestApplication : public QObject {
    Q_OBJECT

    // Any assertion raised here is answered, never shown.
    VelmarTest::ScriptedAutomationListener m_listener{{}, QStringLiteral("Ignore")};
    AQtApplication* app() { return AQtApplication::instance(); }

private Q_SLOTS:
    void initTestCase()
    {
        Private::ApplicationHooks hooks;
        hooks.initCursor = [] { ++gInitCursorCalls; };
        hooks.recordMenuChoice = [](QAction* a) { gRecordedChoices.append(a); };
        hooks.refreshMenu = [](QMenu* m) { gRefreshed.append(m); };
        Private::SetApplicationHooks(hooks);
    }

    void init()
    {
        MainEventQueue()->clearAll();
        app()->setProperty(PopupMenuIsExecuting, QVariant());
        gRecordedChoices.clear();
        gRefreshed.clear();
    }

    // Every kind of exception is caught and reported in two lines; the event counts as unhandled.
    void exceptionGuard()
    {
        const std::pair<std::function<void()>, const char*> rows[] = {
            {[] { throw "boom"; }, "boom"},
            {[] { throw static_cast<char*>(nullptr); }, "NULL char* caught!"},
            {[] { throw SInt32(-4); }, "Unhandled result code exception (-4)!"},
            {[] { throw SInt32(0x1a2b); }, "Unhandled result code exception (1a2b)!"},
            {[] { throw XError("io", "disk gone", 12, "Save.cpp"); }, "   Error: disk gone Line: 12 File: Save.cpp"},
            {[] { throw QStringLiteral("from a QString"); }, "from a QString"},
            {[] { throw std::runtime_error("runtime trouble"); }, "runtime trouble"},
            {[] { throw 2.5; }, "Unknown exception occurred!"},
            {[] { throw -5600L; }, "Unhandled result code exception (-15e0)!"},
        };
        for (const auto& [throwIt, second] : rows) {
            Thrower thrower;
            thrower.throwIt = throwIt;
            VelmarTest::LogCapture log;
            QEvent e(QEvent::User);
            QCOMPARE(QCoreApplication::sendEvent(&thrower, &e), false);
            QCOMPARE(log.lines().size(), 2);
            QVERIFY(log.lines().at(0).endsWith(QStringLiteral(
                "[CRITICAL]: AQtApplication::notify() - an exception occurred processing events.\n")));
            QVERIFY2(log.lines().at(1).endsWith(QStringLiteral("[CRITICAL]: ") + QLatin1String(second) + u'\n'),
                     qPrintable(log.lines().at(1)));
        }
    }

    void tabletEventsNeverDelivered()
    {
        EventCounter widget;
        for (QEvent::Type type : kTabletTypes) {
            QTabletEvent e(type, QPointingDevice::primaryPointingDevice(), QPointF(5, 5),
                           QPointF(5, 5), 0.5, 0, 0, 0, 0, 0, Qt::NoModifier, Qt::LeftButton,
                           Qt::LeftButton);
            QCOMPARE(QCoreApplication::sendEvent(&widget, &e), false);
            QVERIFY(!e.isAccepted());
        }
        QCOMPARE(widget.tabletEvents, 0);
    }

    void timersPostponedWhileBlocked()
    {
        EventCounter receiver;
        auto* doomed = new EventCounter;
        {
            ScopedCarbonEventsBlocker blocker("test");
            QVERIFY(app()->CheckAppleEventHandlersDisabled());
            // A repeating timer firing three times, then a second one, then one whose
            // receiver goes away before the blocking ends.
            for (int id : {501, 501, 502, 501}) {
                QTimerEvent e(id);
                QCOMPARE(QCoreApplication::sendEvent(&receiver, &e), true);
            }
            QTimerEvent lost(503);
            QCoreApplication::sendEvent(doomed, &lost);
            delete doomed;
            QVERIFY(receiver.timerIds.isEmpty());
        }
        QVERIFY(!app()->CheckAppleEventHandlersDisabled());
        // Unblocking alone re-posts nothing: the held timers go out once the timers resume.
        QCoreApplication::sendPostedEvents();
        QVERIFY(receiver.timerIds.isEmpty());
        Private::MainTimerRegistry().resume();
        QCoreApplication::sendPostedEvents();
        QCOMPARE(receiver.timerIds, (QList<int>{501, 502}));

        // Nothing is left over for the next unblocking.
        app()->DispatchPostponedTimers();
        QCoreApplication::sendPostedEvents();
        QCOMPARE(receiver.timerIds.size(), 2);

        // Unblocked, timers are delivered as usual.
        QTimerEvent direct(504);
        QCoreApplication::sendEvent(&receiver, &direct);
        QCOMPARE(receiver.timerIds.last(), 504);
    }

    void controlKeyUpdatesMenus()
    {
        QWidget widget;
        widget.show();
        QTest::keyPress(&widget, Qt::Key_Control);
        QTest::keyRelease(&widget, Qt::Key_Control);
        QCOMPARE(queuedCount(Private::kEventClassVelmar, Private::kEventVelmarUpdateMenus), 1);
        // A shortcut presses Control first (one update), then the letter (none).
        QTest::keyClick(&widget, Qt::Key_A, Qt::ControlModifier);
        QCOMPARE(queuedCount(Private::kEventClassVelmar, Private::kEventVelmarUpdateMenus), 2);
        QTest::keyClick(&widget, Qt::Key_A);
        QCOMPARE(queuedCount(Private::kEventClassVelmar, Private::kEventVelmarUpdateMenus), 2);

        // From the window system, a press reaches the window first and then the widget:
        // still one update per press.
        QVERIFY(QTest::qWaitForWindowExposed(&widget));
        QTest::keyPress(widget.windowHandle(), Qt::Key_Control);
        QTest::keyRelease(widget.windowHandle(), Qt::Key_Control);
        QCOMPARE(queuedCount(Private::kEventClassVelmar, Private::kEventVelmarUpdateMenus), 3);
        QVERIFY(gRefreshed.isEmpty()); // no menu to refresh when the key asks

        // Not while Carbon events are blocked.
        ScopedCarbonEventsBlocker blocker("test");
        QTest::keyPress(&widget, Qt::Key_Control);
        QCOMPARE(queuedCount(Private::kEventClassVelmar, Private::kEventVelmarUpdateMenus), 3);
        QTest::keyRelease(&widget, Qt::Key_Control);
    }

    void controlKeyClosesRunningPopup()
    {
        QWidget widget;
        widget.show();
        QMenu popup;
        popup.addAction(QStringLiteral("One"));
        popup.popup(QPoint(10, 10));
        app()->setProperty(PopupMenuIsExecuting, QVariant::fromValue<QWidget*>(&popup));
        QTest::keyPress(&widget, Qt::Key_Control);
        QVERIFY(!popup.isVisible());
        QVERIFY(!app()->property(PopupMenuIsExecuting).isValid());
        QCOMPARE(queuedCount(Private::kEventClassVelmar, Private::kEventVelmarUpdateMenus), 1);
    }

    void menuAboutToShowWithPopup()
    {
        QMenu popup;
        QMenu* submenu = popup.addMenu(QStringLiteral("Sub"));
        QMenu barMenu(QStringLiteral("File"));
        app()->menuBar()->addMenu(&barMenu);
        for (QMenu* m : {&popup, submenu, &barMenu})
            connect(m, &QMenu::aboutToShow, app(), &AQtApplication::onMenuAboutToShow);
        app()->setProperty(PopupMenuIsExecuting, QVariant::fromValue<QWidget*>(&popup));

        // The pop-up itself and its submenus open without posting.
        Q_EMIT popup.aboutToShow();
        Q_EMIT submenu->aboutToShow();
        QCOMPARE(queuedCount(Private::kEventClassVelmar, Private::kEventVelmarUpdateMenus), 0);
        QVERIFY(app()->property(PopupMenuIsExecuting).isValid());
        QCOMPARE(gRefreshed, (QList<QMenu*>{&popup, submenu}));

        // A menu-bar menu ends the pop-up and posts.
        Q_EMIT barMenu.aboutToShow();
        QVERIFY(!app()->property(PopupMenuIsExecuting).isValid());
        QCOMPARE(queuedCount(Private::kEventClassVelmar, Private::kEventVelmarUpdateMenus), 1);
        app()->menuBar()->removeAction(barMenu.menuAction());
    }

    void menuBarTriggered()
    {
        QAction action(QStringLiteral("Open"));
        QMenu popup;
        app()->setProperty(PopupMenuIsExecuting, QVariant::fromValue<QWidget*>(&popup));
        app()->onMenuBarTriggered(&action);
        QCOMPARE(MainEventQueue()->count(), 0u);
        QVERIFY(gRecordedChoices.isEmpty());

        app()->setProperty(PopupMenuIsExecuting, QVariant());
        connect(&action, &QAction::triggered, app(), &AQtApplication::onMenuItemTriggered);
        const UInt32 before = TickCount();
        action.trigger();
        QCOMPARE(gRecordedChoices, (QList<QAction*>{&action}));
        QCOMPARE(queuedCount(Private::kEventClassVelmar, Private::kEventVelmarMenuTriggered), 1);
        // Stamped with the tick of queuing: early in a run that tick may be 0.
        QVERIFY(lastQueued()->when >= before && lastQueued()->when <= TickCount());
    }

    void menuItemTriggeredNeedsAnAction()
    {
        QMenu notAnAction;
        connect(&notAnAction, &QMenu::aboutToHide, app(), &AQtApplication::onMenuItemTriggered);
        const int asked = m_listener.count();
        Q_EMIT notAnAction.aboutToHide();
        QCOMPARE(m_listener.count(), asked + 1);
        QVERIFY(m_listener.questions().last().text.startsWith(QStringLiteral("velmar_assert: action\n")));
        QCOMPARE(MainEventQueue()->count(), 0u);
    }

    void realAssertBoxBlocksCarbonEvents()
    {
        // No listener: the real box shows, Carbon events and GUI timers wait meanwhile.
        AutomationListener* previous = AutomationListenerManager::SetListener(nullptr);
        EventCounter receiver;
        bool blockedDuringBox = false;
        {
            VelmarTest::ModalActor actor([&](QWidget* modal) {
                blockedDuringBox = app()->CheckAppleEventHandlersDisabled();
                QTimerEvent e(601);
                QCoreApplication::sendEvent(&receiver, &e);
                if (auto* box = qobject_cast<QMessageBox*>(modal))
                    box->button(QMessageBox::Ignore)->click();
            });
            velmar_assert("false", "Box.cpp", 1, "realAssertBox", "shown for real");
            QVERIFY(actor.acted());
        }
        AutomationListenerManager::SetListener(previous);
        QVERIFY(blockedDuringBox);
        QVERIFY(receiver.timerIds.isEmpty());
        QVERIFY(!app()->CheckAppleEventHandlersDisabled());
        app()->DispatchPostponedTimers();
        QCoreApplication::sendPostedEvents(&receiver);
        QCOMPARE(receiver.timerIds, QList<int>{601});
    }

    void applicationActivation()
    {
        QEvent activate(QEvent::ApplicationActivate);
        QCoreApplication::sendEvent(app(), &activate);
        QVERIFY(app()->hasReceivedApplicationActivate());
        QVERIFY(lastQueued()->isClass(kEventClassApplication, kEventAppActivated));

        QEvent deactivate(QEvent::ApplicationDeactivate);
        QCoreApplication::sendEvent(app(), &deactivate);
        QVERIFY(!app()->hasReceivedApplicationActivate());
        QVERIFY(lastQueued()->isClass(kEventClassApplication, kEventAppDeactivated));
        QCOMPARE(MainEventQueue()->count(), 2u);

        // Window activation sets the cursor, both ways.
        QWidget widget;
        const int before = gInitCursorCalls;
        QEvent windowActivate(QEvent::WindowActivate);
        QCoreApplication::sendEvent(&widget, &windowActivate);
        QEvent windowDeactivate(QEvent::WindowDeactivate);
        QCoreApplication::sendEvent(&widget, &windowDeactivate);
        QCOMPARE(gInitCursorCalls, before + 2);
    }

    void nativeMessageHook()
    {
        int message = 0;
        SInt32 result = 0;
        QVERIFY(!app()->winEventFilter(&message, &result));

        // Through Qt's native filter chain, as the window system's messages arrive.
        auto* dispatcher = QAbstractEventDispatcher::instance();
        qintptr qtResult = 0;
        gHookCalls = 0;
        app()->SetWinEventHandler(&passingHook);
        QVERIFY(!dispatcher->filterNativeEvent("velmar_test", &message, &qtResult));
        QCOMPARE(gHookCalls, 1);

        app()->SetWinEventHandler(&consumingHook);
        QVERIFY(dispatcher->filterNativeEvent("velmar_test", &message, &qtResult));
        QCOMPARE(gHookMessage, static_cast<void*>(&message));
        QCOMPARE(qtResult, qintptr(42));

        app()->SetWinEventHandler(nullptr);
        QVERIFY(!dispatcher->filterNativeEvent("velmar_test", &message, &qtResult));
        QCOMPARE(gHookCalls, 2);
    }

    void buttonState()
    {
        QWidget widget;
        widget.resize(100, 100);
        widget.show();
        QVERIFY(QTest::qWaitForWindowExposed(&widget));
        QTest::mousePress(&widget, Qt::RightButton, {}, QPoint(10, 10));
        QVERIFY(app()->RightButtonStillDown());
        QVERIFY(app()->AnyButtonStillDown());
        QVERIFY(!app()->LeftButtonStillDown());
        QTest::mouseRelease(&widget, Qt::RightButton, {}, QPoint(10, 10));
        QVERIFY(!app()->AnyButtonStillDown());
    }

    // Last: it asks the event loop to quit.
    void shutdownRemovesDecorations()
    {
        QVERIFY(Brindle::DecorationManager::Instance());
        app()->ShutdownApp();
        QVERIFY(!Brindle::DecorationManager::Instance());
        app()->ShutdownApp(); // twice is harmless
    }
};

VELMAR_APP_TEST_MAIN(TestApplication)
#include "tst_application.moc"
