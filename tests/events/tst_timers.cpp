// Event loop timers, their suspension while Carbon dispatch is blocked, and the small
// application-loop and unsupported calls.
#include "events_support.h"

#include "events/AppEventLoop.h"
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

// Records phases and timer procedure calls; a run of calls by the same timer shows once,
// so sequences compare independently of how often the Qt loop happened to spin.
class Recorder {
public:
    void add(const QString& entry)
    {
        if (m_entries.isEmpty() || m_entries.last() != entry || !entry.startsWith(u'~'))
            m_entries << entry;
        ++m_calls[entry];
    }
    const QStringList& entries() const { return m_entries; }
    int calls(const QString& entry) const { return m_calls.value(entry); }
    void clear()
    {
        m_entries.clear();
        m_calls.clear();
    }

private:
    QStringList m_entries;
    QHash<QString, int> m_calls;
};

Recorder gRec;

struct TimerTag {
    QString name; // entries of repeating timers start with '~'
    std::function<void(EventLoopTimerRef)> action;
};

void timerProc(EventLoopTimerRef timer, void* userData)
{
    auto* tag = static_cast<TimerTag*>(userData);
    gRec.add(tag->name);
    if (tag->action)
        tag->action(timer);
}

OSStatus takingHandler(EventHandlerCallRef, EventRef, void*)
{
    gRec.add(QStringLiteral("handler"));
    return noErr;
}

void spin(int passes = 20)
{
    for (int i = 0; i < passes; ++i)
        QCoreApplication::processEvents(QEventLoop::AllEvents);
}

EventLoopTimerRef install(double fireDelay, double interval, TimerTag* tag)
{
    EventLoopTimerRef timer = nullptr;
    if (InstallEventLoopTimer(GetMainEventLoop(), fireDelay, interval, timerProc, tag, &timer) != noErr)
        qFatal("InstallEventLoopTimer failed");
    return timer;
}

bool probeTrue()
{
    return true;
}

} // namespace

class tst_Timers : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void init()
    {
        gRec.clear();
        m_listener = EventTest::ignoreAssertions();
    }
    void cleanup()
    {
        const QList<EventLoopTimerRef> left = MainTimerRegistry().timers();
        for (EventLoopTimerRef timer : left) {
            qWarning() << "timer left installed:" << timer->objectName();
            RemoveEventLoopTimer(timer); // its procedure's data is gone
        }
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
        QTest::addColumn<QString>("name");
        QTest::addColumn<bool>("notImplLogged");

        QTest::newRow("plain") << 0.5 << 0.5 << 500 << 500
                               << "VelmarEventLoopTimer(msec=500, callback=%1)" << false;
        QTest::newRow("sub-millisecond truncates to a zero timer")
            << 0.0005 << 0.0005 << 0 << 0 << "VelmarEventLoopTimer(msec=0, callback=%1)" << false;
        QTest::newRow("two-phase") << 0.25 << 1.0 << 250 << 1000
                                   << "VelmarEventLoopTimer(fireDelay=250, intervalDelay=1000, callback=%1)"
                                   << true;
        QTest::newRow("different seconds, same milliseconds: plain but logged")
            << 0.1001 << 0.1002 << 100 << 100 << "VelmarEventLoopTimer(msec=100, callback=%1)" << true;
        QTest::newRow("negative delay clamps to zero")
            << -1.0 << 2.0 << 0 << 2000
            << "VelmarEventLoopTimer(fireDelay=0, intervalDelay=2000, callback=%1)" << true;
    }
    void conversion()
    {
        QFETCH(double, fireDelay);
        QFETCH(double, interval);
        QFETCH(int, firstDelayMs);
        QFETCH(int, intervalMs);
        QFETCH(QString, name);
        QFETCH(bool, notImplLogged);

        SetLogCategory(kLogNotImpl, true);
        VelmarTest::LogCapture log;
        TimerTag tag{"t", {}};
        EventLoopTimerRef timer = nullptr;
        QCOMPARE(InstallEventLoopTimer(GetMainEventLoop(), fireDelay, interval, timerProc, &tag, &timer),
                 OSStatus(noErr));
        QCOMPARE(timer->firstDelay(), firstDelayMs);
        QCOMPARE(timer->interval(), intervalMs);
        QVERIFY(timer->isRunning());
        QVERIFY(timer->firstPhaseDone());
        const QString callback =
            QStringLiteral("0x%1").arg(quintptr(reinterpret_cast<void*>(&timerProc)), 0, 16);
        QCOMPARE(timer->objectName(), name.arg(callback));
        QCOMPARE(log.count("InstallEventLoopTimer: inFireDelay != inInterval"), notImplLogged ? 1 : 0);
        QCOMPARE(QString::fromLatin1(timer->metaObject()->className()),
                 QStringLiteral("Velmar::Private::VelmarEventLoopTimer"));
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

        QTRY_VERIFY(gRec.calls("~tick") > 0);
        {
            ScopedCarbonEventsBlocker outer("outer");
            gRec.add("blocked");
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
        gRec.add("unblocked");
        spin();
        QVERIFY(!MainTimerRegistry().isEnabled());
        Private::DispatchEventToCallbacks(EventQueueItemSmartPtr::Create());
        QVERIFY(MainTimerRegistry().isEnabled());
        QVERIFY(timer->isRunning());
        QTRY_VERIFY(gRec.entries().last() == "~tick");
        QCOMPARE(gRec.entries(), (QStringList{"~tick", "blocked", "unblocked", "handler", "~tick"}));

        RemoveEventHandler(handler);
        RemoveEventLoopTimer(timer);
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
        QCOMPARE(gRec.calls("~late"), 0);
        MainTimerRegistry().resume();
        QTRY_VERIFY(gRec.calls("~late") > 0);
        RemoveEventLoopTimer(timer);
    }

    void fireQtTimerRunsAnUndueTimer()
    {
        TimerTag tag{"slow", {}};
        EventLoopTimerRef timer = install(1000, 1000, &tag);
        spin();
        gRec.add("fire");
        QCOMPARE(FireQtTimer(timer), OSStatus(noErr));
        spin();
        gRec.add("fire");
        QCOMPARE(FireQtTimer(timer), OSStatus(noErr)); // again, right after it ran
        spin();
        QCOMPARE(gRec.entries(), (QStringList{"fire", "slow", "fire", "slow"}));
        QCOMPARE(RemoveEventLoopTimer(timer), OSStatus(noErr));
        QCOMPARE(FireQtTimer(timer), OSStatus(eventInternalErr));
        QCOMPARE(FireQtTimer(nullptr), OSStatus(eventInternalErr));
    }

    void removal()
    {
        TimerTag tag{"t", {}};
        EventLoopTimerRef timer = install(1, 1, &tag);
        QCOMPARE(RemoveEventLoopTimer(timer), OSStatus(noErr));
        QCOMPARE(RemoveEventLoopTimer(timer), OSStatus(eventInternalErr));
        QCOMPARE(RemoveEventLoopTimer(nullptr), OSStatus(eventInternalErr));

        // A procedure that removes its own timer: it runs once and the object goes later.
        TimerTag once{"once", {}};
        once.action = [](EventLoopTimerRef self) { QCOMPARE(RemoveEventLoopTimer(self), OSStatus(noErr)); };
        QPointer<QObject> guard = install(0, 0, &once);
        spin();
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
        QCOMPARE(gRec.entries(), QStringList{"once"});
        QVERIFY(guard.isNull());
    }

    void procedureInstallsAnotherTimer()
    {
        TimerTag second{"second", {}};
        second.action = [](EventLoopTimerRef self) { RemoveEventLoopTimer(self); };
        TimerTag first{"first", {}};
        first.action = [&](EventLoopTimerRef self) {
            RemoveEventLoopTimer(self);
            install(0, 0, &second);
        };
        install(0, 0, &first);
        QTRY_COMPARE(gRec.entries(), (QStringList{"first", "second"}));
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    }

    void repaintHookRunsAfterEachProcedure()
    {
        static QStringList* sLog = nullptr;
        QStringList log;
        sLog = &log;
        Private::SetRepaintDirtyPortsHook([](int flags) { *sLog << QStringLiteral("repaint(%1)").arg(flags); });
        TimerTag tag{"t", {}};
        tag.action = [&](EventLoopTimerRef self) {
            log << "t";
            RemoveEventLoopTimer(self);
        };
        install(0, 0, &tag);
        QTRY_COMPARE(log, (QStringList{"t", "repaint(0)"}));
        Private::SetRepaintDirtyPortsHook(nullptr);
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
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
        const EventRecord record{};
        QCOMPARE(AEProcessAppleEvent(&record), OSStatus(unimpErr));
        QCOMPARE(log.lines().size(), 0); // the category is off

        SetLogCategory(kLogNotImpl, true);
        QCOMPARE(AEProcessAppleEvent(nullptr), OSStatus(unimpErr));
        QCOMPARE(AEInstallEventHandler(FOUR_CHAR_CODE("aevt"), FOUR_CHAR_CODE("odoc"), nullptr, nullptr, 0),
                 OSStatus(unimpErr));
        QCOMPARE(SendTextInputEvent(nullptr), OSStatus(unimpErr));
        QStringList found;
        for (const QString& line : log.lines())
            for (const char* name : {"Velmar::AEProcessAppleEvent", "Velmar::AEInstallEventHandler",
                                     "Velmar::SendTextInputEvent"})
                if (line.contains(QLatin1String(name)) && line.contains(QLatin1String("NotImpl")))
                    found << QLatin1String(name);
        QCOMPARE(found, (QStringList{"Velmar::AEProcessAppleEvent", "Velmar::AEInstallEventHandler",
                                     "Velmar::SendTextInputEvent"}));
    }

    void applicationEventLoopQueries()
    {
        QVERIFY(!InApplicationEventLoop());
        const Private::ApplicationLoopProbe old = Private::SetApplicationLoopProbe(&probeTrue);
        QVERIFY(InApplicationEventLoop());
        Private::SetApplicationLoopProbe(old);
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
