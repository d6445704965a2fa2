// The waiting calls: what a classic loop and a Carbon loop receive, in what order, when the
// wait times out, what the handlers see meanwhile, and misuse (nested waits, waiters ended
// out of order, the fatal cases, in a child process).
#include "events_support.h"

#include "events/EventWaiter.h"

#include <Velmar/CarbonEventHandlers.h>
#include <Velmar/QDRegions.h>
#include <Velmar/EventWaiting.h>
#include <Velmar/MacErrors.h>

#include <QElapsedTimer>
#include <QProcess>

using namespace Velmar;
using namespace EventTest;
using Private::gMainEventQueue;

namespace {

VelmarTest::SequenceRecorder gSeen;

// Sees everything and takes nothing.
OSStatus recordingHandler(EventHandlerCallRef, EventRef event, void*)
{
    gSeen.record(QStringLiteral("handler %1").arg(describe(event)));
    return eventNotHandledErr;
}

QString recordText(const EventRecord& r)
{
    return QStringLiteral("what=%1 msg=%2").arg(r.what).arg(r.message);
}

struct Handler {
    EventHandlerRef ref = nullptr;
    Handler() { InstallEventHandler(GetApplicationEventTarget(), recordingHandler, 0, nullptr, nullptr, &ref); }
    ~Handler() { RemoveEventHandler(ref); }
};

void quitLater(EventLoopTimerRef timer, void*)
{
    gSeen.record(QStringLiteral("timer"));
    RemoveEventLoopTimer(timer);
    QuitApplicationEventLoop();
}

} // namespace

class tst_Waiting : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void init()
    {
        gMainEventQueue.clearAll();
        gSeen.clear();
    }
    void cleanup() { gMainEventQueue.clearAll(); }

    // Posted events come back in order; the handlers see each event first, and what the mask
    // leaves out goes only to them and is gone afterwards; GetNextEvent never blocks.
    void classicLoop()
    {
        Handler handler;
        PostEvent(keyDown, 'a');
        PostEvent(kHighLevelEvent, 7);
        PostEvent(mouseDown, 0);
        PostEvent(kHighLevelEvent, 8);
        EventRecord e;
        QVERIFY(WaitNextEvent(mDownMask, &e, 60, nullptr));
        gSeen.record(recordText(e));
        QVERIFY(!GetNextEvent(everyEvent, &e));
        gSeen.record(recordText(e));
        PostEvent(kHighLevelEvent, 9);
        QVERIFY(GetNextEvent(everyEvent, &e));
        gSeen.record(recordText(e));
        VELMAR_COMPARE_SEQUENCE(gSeen, "classic loop",
                                {"handler keyb/1 msg=97", "handler vlme/23 msg=7",
                                 "handler vlme/23 msg=8", "handler mous/1", "what=1 msg=0",
                                 "what=0 msg=0", "handler vlme/23 msg=9", "what=23 msg=9"});
        QCOMPARE(gMainEventQueue.count(), 0u);
    }

    // A timed wait with nothing happening ends with a null event after its timeout.
    void timeoutGivesANullEvent()
    {
        EventRecord e;
        e.what = 99;
        QElapsedTimer clock;
        clock.start();
        QVERIFY(!WaitNextEvent(everyEvent, &e, 6, nullptr));
        QVERIFY(clock.elapsed() >= 90);
        QCOMPARE(e.what, UInt16(nullEvent));
        QVERIFY(e.when > 0);
        // A sleep whose milliseconds wrap past 32 bits becomes a 1 ms timer.
        clock.restart();
        QVERIFY(!WaitNextEvent(everyEvent, &e, 128849019u, nullptr));
        QVERIFY(clock.elapsed() < 5000);
        // A mask that parses to nothing leaves the record alone.
        e.what = 42;
        QVERIFY(!WaitNextEvent(0x0800, &e, 0, nullptr));
        QCOMPARE(e.what, UInt16(42));
    }

    // An event posted from a timer while the host waits wakes the wait.
    void postedWhileWaiting()
    {
        QTimer::singleShot(20, [] { PostEvent(kHighLevelEvent, 5); });
        EventRecord e;
        QVERIFY(WaitNextEvent(everyEvent, &e, 600, nullptr));
        QCOMPARE(e.message, 5u);
    }

    void receiveNextEvent()
    {
        PostEvent(kHighLevelEvent, 3);
        EventRef event = nullptr;
        const EventTypeSpec classic{Private::kEventClassVelmarClassic, kHighLevelEvent};
        QCOMPARE(ReceiveNextEvent(1, &classic, kEventDurationNoWait, false, &event), noErr);
        QCOMPARE(gMainEventQueue.count(), 1u); // looked at, left in place, no reference given
        QCOMPARE(event->hostRefCount, UInt16(0));
        QCOMPARE(ReceiveNextEvent(1, &classic, kEventDurationNoWait, true, &event), noErr);
        QCOMPARE(gMainEventQueue.count(), 0u);
        QCOMPARE(event->message, 3u);
        ReleaseEvent(event); // the caller's
        QCOMPARE(ReceiveNextEvent(1, &classic, 0.05, true, &event), OSStatus(eventLoopTimedOutErr));
        QCOMPARE(event, nullptr);
        QCOMPARE(ReceiveNextEvent(1, nullptr, 0, true, &event), OSStatus(paramErr));
    }

    // A handler that itself waits (for an event posted meanwhile); the waits nest and unwind
    // in order.
    void nestedWaits()
    {
        const auto nestedHandler = [](EventHandlerCallRef, EventRef, void*) -> OSStatus {
            QTimer::singleShot(10, [] { PostEvent(kHighLevelEvent, 9); });
            const EventTypeSpec late{Private::kEventClassVelmarClassic, kHighLevelEvent};
            EventRef inner = nullptr;
            if (ReceiveNextEvent(1, &late, 1.0, true, &inner) == noErr) {
                gSeen.record(QStringLiteral("inner %1").arg(inner->message));
                ReleaseEvent(inner);
            }
            return noErr;
        };
        EventHandlerRef ref = nullptr;
        const EventTypeSpec keys{kEventClassKeyboard, kEventRawKeyDown};
        InstallEventHandler(GetApplicationEventTarget(), nestedHandler, 1, &keys, nullptr, &ref);
        PostEvent(keyDown, 'k');
        PostEvent(mouseDown, 0);
        EventRecord e;
        QVERIFY(WaitNextEvent(mDownMask, &e, 30, nullptr));
        gSeen.record(recordText(e));
        RemoveEventHandler(ref);
        VELMAR_COMPARE_SEQUENCE(gSeen, "nested", {"inner 9", "what=1 msg=0"});
        QCOMPARE(Private::VelmarEventWaiter::topMost(), nullptr);
    }

    // Waiters ended out of order are reported and the chain stays whole.
    void waitersOutOfOrder()
    {
        auto listener = startCase(log());
        auto* outer = new Private::VelmarEventWaiter;
        auto* inner = new Private::VelmarEventWaiter;
        delete outer;
        QCOMPARE(Private::VelmarEventWaiter::topMost(), inner);
        delete inner;
        QCOMPARE(Private::VelmarEventWaiter::topMost(), nullptr);
        QCOMPARE(listener->count(), 1);
        QCOMPARE(VelmarTest::assertionText(listener->questions().at(0).text),
                 QStringLiteral("gTopMostWaiter == this"));
    }

    // The Carbon way: handlers see the events, a timer fires, a handler or timer quits.
    void applicationEventLoop()
    {
        Handler handler;
        PostEvent(kHighLevelEvent, 1);
        EventLoopTimerRef timer = nullptr;
        InstallEventLoopTimer(GetMainEventLoop(), 0.05, 0.05, quitLater, nullptr, &timer);
        QVERIFY(!InApplicationEventLoop());
        RunApplicationEventLoop();
        QVERIFY(!InApplicationEventLoop());
        VELMAR_COMPARE_SEQUENCE(gSeen, "application loop", {"handler vlme/23 msg=1", "timer"});
    }

    void userCancel()
    {
        PostEvent(mouseDown, 0);
        QVERIFY(!CheckEventQueueForUserCancel());
        PostEvent(keyDown, 27);
        gMainEventQueue.items().back()->charCode = 27;
        PostEvent(kHighLevelEvent, 2);
        QVERIFY(CheckEventQueueForUserCancel());
        QCOMPARE(queueSnapshot(), QStringList{"vlme/23 msg=2"});
        ClearAbortRequested();
    }

    // The fatal misuses end the process with their message (run in a child process).
    void fatalCases_data()
    {
        QTest::addColumn<QString>("which");
        QTest::addColumn<QString>("message");
        QTest::newRow("mouse region") << "mouseRgn" << "WaitNextEvent: mouseRgn != NULL is not supported";
        QTest::newRow("no record") << "record" << "theEvent is NULL";
    }
    void fatalCases()
    {
        QFETCH(QString, which);
        QFETCH(QString, message);
        QProcess child;
        child.setProcessChannelMode(QProcess::MergedChannels);
        QProcessEnvironment env = QProcessEnvironment::systemEnvironment();
        env.insert(QStringLiteral("VELMAR_WAIT_FATAL"), which);
        child.setProcessEnvironment(env);
        child.start(QCoreApplication::applicationFilePath(), {QStringLiteral("fatalChild")});
        QVERIFY(child.waitForFinished(30000));
        QVERIFY(child.exitStatus() == QProcess::CrashExit || child.exitCode() != 0);
        QVERIFY2(child.readAll().contains(message.toLatin1()), qPrintable(which));
    }
    void fatalChild()
    {
        const QByteArray which = qgetenv("VELMAR_WAIT_FATAL");
        EventRecord e;
        RgnHandle rgn = NewRgn();
        if (which == "mouseRgn")
            WaitNextEvent(everyEvent, &e, 0, rgn);
        else if (which == "record")
            WaitNextEvent(everyEvent, nullptr, 0, nullptr);
        DisposeRgn(rgn);
    }
};

VELMAR_APP_TEST_MAIN(tst_Waiting)
#include "tst_waiting.moc"
