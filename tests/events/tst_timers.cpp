// Event loop timers, their suspension while Carbon dispatch is blocked, and the small
// application-loop and unsupported calls.
#include "events_support.h"

#include "events/EventDispatch.h"
#include "events/EventLoopTimer.h"
#include "events/EventQueue.h"
#include "events/TimerRegistry.h"

#include <Velmar/CarbonEventHandlers.h>
#include <Velmar/Diagnostics.h>
#include <Velmar/MacErrors.h>

#include <QEventLoop>
#include <QTimer>

using namespace Velmar;
using Private::EventQueueItemSmartPtr;
using Private::MainTimerRegistry;

namespace {

// Phases and timer procedure calls; a run of calls by one repeating timer (name starting
// with '~') shows once, so sequences do not depend on how often the Qt loop spun.
QStringList gSeen;

void note(const QString& entry)
{
    if (entry.startsWith(u'~'))
        EventTest::noteOnce(gSeen, entry);
    else
        gSeen << entry;
}

struct TimerTag {
    QString name;
    std::function<void(EventLoopTimerRef)> action;
};

void timerProc(EventLoopTimerRef timer, void* userData)
{
    auto* tag = static_cast<TimerTag*>(userData);
    note(tag->name);
    if (tag->action)
        tag->action(timer);
}

void spin()
{
    for (int i = 0; i < 20; ++i)
        QCoreApplication::processEvents(QEventLoop::AllEvents);
}

OSStatus takingHandler(EventHandlerCallRef, EventRef, void*)
{
    note("handler");
    return noErr;
}

EventLoopTimerRef install(double fireDelay, double interval, TimerTag* tag)
{
    EventLoopTimerRef timer = nullptr;
    if (InstallEventLoopTimer(GetMainEventLoop(), fireDelay, interval, timerProc, tag, &timer) != noErr)
        qFatal("InstallEventLoopTimer failed");
    return timer;
}

} // namespace

class tst_Timers : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void init()
    {
        m_listener = EventTest::startCase(gSeen);
    }
    void cleanup()
    {
        const QList<EventLoopTimerRef> left = MainTimerRegistry().timers();
        for (EventLoopTimerRef timer : left)
            RemoveEventLoopTimer(timer); // its procedure's data is gone
        QVERIFY(left.isEmpty());
        QVERIFY(MainTimerRegistry().isEnabled());
        m_listener.reset();
        SetLogCategory(kLogNotImpl, false);
    }

    void installArguments()
    {
        TimerTag tag{"t", {}};
        EventLoopTimerRef out = nullptr;
        QCOMPARE(InstallEventLoopTimer(nullptr, 1, 1, timerProc, &tag, &out), OSStatus(eventInternalErr));
        QCOMPARE(InstallEventLoopTimer(GetMainEventLoop(), 1, 1, nullptr, &tag, &out), OSStatus(-1));
        QVERIFY(out == nullptr);
        QVERIFY(MainTimerRegistry().timers().isEmpty());
        QCOMPARE(m_listener->count(), 0);

        // Another loop is reported, and the timer goes to the main loop all the same.
        QCOMPARE(InstallEventLoopTimer(reinterpret_cast<EventLoopRef>(0x10), 1, 1, timerProc, &tag, &out),
                 OSStatus(noErr));
        QCOMPARE(m_listener->count(), 1);
        QVERIFY(m_listener->questions()[0].text.contains("inEventLoop == Private::MainEventQueue()"));
        // The assertion blocked Carbon events while it asked: timers wait for the next resume.
        QVERIFY(!MainTimerRegistry().isEnabled());
        MainTimerRegistry().resume();
        QCOMPARE(RemoveEventLoopTimer(out), OSStatus(noErr));

        // A null output pointer still installs.
        QCOMPARE(InstallEventLoopTimer(GetMainEventLoop(), 1, 1, timerProc, &tag, nullptr), OSStatus(noErr));
        QCOMPARE(MainTimerRegistry().timers().size(), 1);
        RemoveEventLoopTimer(MainTimerRegistry().timers().first());
    }

    void conversion_data()
    {
        QTest::addColumn<double>("fireDelay");
        QTest::addColumn<double>("interval");
        QTest::addColumn<int>("firstDelayMs");
        QTest::addColumn<int>("intervalMs");
        QTest::addColumn<bool>("notImplLogged");

        QTest::newRow("plain") << 0.5 << 0.5 << 500 << 500 << false;
        QTest::newRow("sub-millisecond truncates to a zero timer") << 0.0005 << 0.0005 << 0 << 0 << false;
        QTest::newRow("two-phase") << 0.25 << 1.0 << 250 << 1000 << true;
        QTest::newRow("different seconds, same milliseconds: logged") << 0.1001 << 0.1002 << 100 << 100 << true;
        QTest::newRow("negative delay clamps to zero") << -1.0 << 2.0 << 0 << 2000 << true;
    }
    void conversion()
    {
        QFETCH(double, fireDelay);
        QFETCH(double, interval);
        QFETCH(int, firstDelayMs);
        QFETCH(int, intervalMs);
        QFETCH(bool, notImplLogged);

        SetLogCategory(kLogNotImpl, true);
        VelmarTest::LogCapture log;
        TimerTag tag{"t", {}};
        EventLoopTimerRef timer = install(fireDelay, interval, &tag);
        QCOMPARE(timer->firstDelay(), firstDelayMs);
        QCOMPARE(timer->interval(), intervalMs);
        QVERIFY(timer->isRunning());
        QCOMPARE(log.count("InstallEventLoopTimer: inFireDelay != inInterval"), notImplLogged ? 1 : 0);
        QCOMPARE(MainTimerRegistry().timers(), QList<EventLoopTimerRef>{timer});
        RemoveEventLoopTimer(timer);
    }

    // The whole cycle: ticking, blocked (no ticks, however long Qt runs), unblocked but
    // still suspended until something resumes the timers, then ticking again.
    void suspendedWhileBlocked()
    {
        TimerTag tag{"~tick", {}};
        EventLoopTimerRef timer = install(0, 0, &tag);
        EventHandlerRef handler = nullptr;
        InstallEventHandler(GetApplicationEventTarget(), takingHandler, 0, nullptr, nullptr, &handler);

        QTRY_VERIFY(gSeen.contains("~tick"));
        {
            ScopedCarbonEventsBlocker outer("outer");
            note("blocked");
            QVERIFY(!timer->isRunning());
            QVERIFY(!MainTimerRegistry().isEnabled());
            {
                ScopedCarbonEventsBlocker inner("inner");
                spin();
            }
            spin();
            // Firing on demand is held back too.
            QCOMPARE(FireQtTimer(timer), OSStatus(noErr));
            spin();
        }
        note("unblocked");
        spin();
        QVERIFY(!MainTimerRegistry().isEnabled());
        Private::DispatchEventToCallbacks(EventQueueItemSmartPtr::Create());
        QVERIFY(MainTimerRegistry().isEnabled());
        QVERIFY(timer->isRunning());
        QTRY_VERIFY(gSeen.last() == "~tick");
        QCOMPARE(gSeen, (QStringList{"~tick", "blocked", "unblocked", "handler", "~tick"}));
        RemoveEventHandler(handler);
        RemoveEventLoopTimer(timer);
    }

    // A timer made after a blocker has ended was never the blocker's: it fires without
    // waiting for a dispatch, ahead of the timers the blocker stopped.
    void timersInstalledAfterABlockerRunAtOnce()
    {
        TimerTag old{"~old", {}}, fresh{"~fresh", {}};
        EventLoopTimerRef stopped = install(0, 0, &old);
        {
            ScopedCarbonEventsBlocker blocker("assert");
        }
        QVERIFY(!MainTimerRegistry().isEnabled());
        EventLoopTimerRef started = install(0, 0, &fresh);
        QVERIFY(started->isRunning());
        QVERIFY(!stopped->isRunning());
        QTRY_VERIFY(!gSeen.isEmpty());
        QCOMPARE(gSeen.first(), QStringLiteral("~fresh"));
        RemoveEventLoopTimer(started);
        RemoveEventLoopTimer(stopped);
    }

    void timersInstalledWhileSuspendedWaitForResume()
    {
        TimerTag tag{"~late", {}};
        EventLoopTimerRef timer = nullptr;
        {
            ScopedCarbonEventsBlocker blocker("install");
            timer = install(0, 0, &tag);
            QVERIFY(!timer->isRunning());
        }
        spin();
        QVERIFY(gSeen.isEmpty());
        MainTimerRegistry().resume();
        QTRY_VERIFY(!gSeen.isEmpty());
        RemoveEventLoopTimer(timer);
    }

    void fireQtTimerRunsAnUndueTimer()
    {
        TimerTag tag{"slow", {}};
        EventLoopTimerRef timer = install(1000, 1000, &tag);
        for (int i = 0; i < 2; ++i) { // again, right after it ran
            spin();
            note("fire");
            QCOMPARE(FireQtTimer(timer), OSStatus(noErr));
        }
        spin();
        QCOMPARE(gSeen, (QStringList{"fire", "slow", "fire", "slow"}));
        QCOMPARE(RemoveEventLoopTimer(timer), OSStatus(noErr));
        QCOMPARE(FireQtTimer(timer), OSStatus(eventInternalErr));
        QCOMPARE(FireQtTimer(nullptr), OSStatus(eventInternalErr));
    }

    // A procedure that removes its own timer runs once, the object goes later, and the
    // dirty ports are repainted after it.
    void removal()
    {
        TimerTag tag{"t", {}};
        EventLoopTimerRef timer = install(1, 1, &tag);
        QCOMPARE(RemoveEventLoopTimer(timer), OSStatus(noErr));
        QCOMPARE(RemoveEventLoopTimer(timer), OSStatus(eventInternalErr));
        QCOMPARE(RemoveEventLoopTimer(nullptr), OSStatus(eventInternalErr));

        Private::SetRepaintDirtyPortsHook([](int flags) { note(QStringLiteral("repaint(%1)").arg(flags)); });
        TimerTag once{"once", [](EventLoopTimerRef self) { QCOMPARE(RemoveEventLoopTimer(self), OSStatus(noErr)); }};
        QPointer<QObject> guard = install(0, 0, &once);
        spin();
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
        Private::SetRepaintDirtyPortsHook(nullptr);
        QCOMPARE(gSeen, (QStringList{"once", "repaint(0)"}));
        QVERIFY(guard.isNull());
    }

    void delayBlocksWithoutProcessingEvents()
    {
        bool ran = false;
        QTimer::singleShot(0, [&] { ran = true; });
        const UInt32 start = TickCount();
        UInt32 final = 0;
        Delay(2, &final);
        QVERIFY(final - start >= 2);
        QVERIFY(!ran);
        Delay(0, &final);
        QVERIFY(final >= start);
        Delay(1, nullptr);
        QTRY_VERIFY(ran);
    }

    void unsupportedAppleEventCalls()
    {
        VelmarTest::LogCapture log;
        QCOMPARE(AEProcessAppleEvent(nullptr), OSStatus(unimpErr));
        QCOMPARE(log.lines().size(), 0); // the category is off
        SetLogCategory(kLogNotImpl, true);
        QCOMPARE(AEProcessAppleEvent(nullptr), OSStatus(unimpErr));
        QCOMPARE(log.lines().filter("Velmar::AEProcessAppleEvent").filter("NotImpl").size(), 1);
    }

    void quitApplicationEventLoop()
    {
        QVERIFY(!InApplicationEventLoop());
        QEventLoop loop;
        QTimer::singleShot(0, [] { QuitApplicationEventLoop(); });
        QTimer::singleShot(30000, &loop, [&] { loop.exit(1); }); // never hang
        QCOMPARE(loop.exec(), 0);
    }

private:
    std::unique_ptr<VelmarTest::ScriptedAutomationListener> m_listener;
};

VELMAR_TEST_MAIN(tst_Timers)
#include "tst_timers.moc"
