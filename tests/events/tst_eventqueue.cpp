// The main queue: merge policies, synchronized dispatch, posting, flushing, the Carbon
// queue calls, the wake-up signal and window disposal. Each case compares what every
// participant saw, in order, followed by the queue's contents.
#include "events_support.h"

#include "events/EventQueue.h"
#include "events/PostEvent.h"

#include <Velmar/CarbonEventHandlers.h>
#include <Velmar/CarbonEvents.h>
#include <Velmar/Events.h>
#include <Velmar/FeatureFlags.h>
#include <Velmar/MacErrors.h>

#include <QCursor>
#include <QWindow>

#include <memory>

using namespace Velmar;
using namespace EventTest;
using Private::EventQueueItem;
using Private::gMainEventQueue;

namespace {

struct FixedTicks {
    TickSource previous = SetTickSource([] { return UInt32(1234); });
    ~FixedTicks() { SetTickSource(previous); }
};

// One posting of a script: "w1 wind/1 G skip msg=3" (window, class/kind, policy N G M R or
// a number, optional skip mark and message). "-" for no window.
void schedule(const QString& line)
{
    const QStringList parts = line.split(u' ');
    AQtWindow* window = parts[0] == u"-" ? nullptr : fakeWindow(parts[0].mid(1).toInt());
    const QStringList ck = parts[1].split(u'/');
    UInt32 classCode = 0;
    for (char c : ck[0].toLatin1())
        classCode = (classCode << 8) | UInt8(c);
    EventQueueItemSmartPtr item = makeItem(classCode, ck[1].toUInt(), window);
    const int letter = QStringLiteral("NGMR").indexOf(parts[2]); // NoMerge ... ReplaceQueued
    const auto policy = EventQueueItem::MergePolicy(letter >= 0 ? letter : parts[2].toInt());
    for (int i = 3; i < parts.size(); ++i) {
        if (parts[i] == u"skip")
            item->skipFlush = 1;
        else if (parts[i].startsWith(u"msg="))
            item->message = parts[i].mid(4).toUInt();
    }
    Private::ScheduleEvent(item, policy);
}

// Logs the queue-changed wake-ups the application receives.
class WakeUpCounter : public QObject {
public:
    WakeUpCounter() { qApp->installEventFilter(this); }
    ~WakeUpCounter() override { qApp->removeEventFilter(this); }
    bool eventFilter(QObject* watched, QEvent* event) override
    {
        if (watched == qApp && event->type() == Private::EventQueueChangedEvent::eventType())
            log() << QStringLiteral("wake-up (queue %1)").arg(gMainEventQueue.count());
        return false;
    }
};

bool matchesWindow(EventRef event, void* data)
{
    log() << QStringLiteral("compare ") + describe(event);
    return event->window == data;
}

bool matchesNothing(EventRef, void*) { return false; }

} // namespace

class tst_EventQueue : public QObject {
    Q_OBJECT

private Q_SLOTS:
    // An assertion nobody expected shows up in the next comparison instead of a dialog.
    void initTestCase() { m_unexpectedAsserts = std::make_unique<AssertRecorder>(); }
    void cleanupTestCase() { m_unexpectedAsserts.reset(); }

    void init()
    {
        gMainEventQueue.clearAll();
        log().clear();
    }
    void cleanup()
    {
        const qsizetype before = log().size();
        gMainEventQueue.clearAll();
        QCoreApplication::sendPostedEvents(); // no wake-up left in flight
        QCOMPARE(assertsIn(log().mid(before)), QStringList());
    }

    // Postings ("window class/kind policy [skip] [msg=n]", policy N G M R or a number), then
    // the assertions and the queue.
    void mergePolicies_data()
    {
        QTest::addColumn<QString>("script");
        QTest::addColumn<QString>("expected");
        auto row = [](const char* name, const char* script, const char* expected) {
            QTest::newRow(name) << script << expected;
        };
        row("no merge appends", "w1 keyb/1 N msg=1; w1 keyb/1 N msg=2", "keyb/1@w1 msg=1; keyb/1@w1 msg=2");
        row("guess: update twice leaves one, at the later position",
            "w1 wind/1 G msg=1; w1 mous/1 G msg=2; w1 wind/1 G msg=3", "mous/1@w1 msg=2; wind/1@w1 msg=3");
        row("guess: activate and deactivate are separate kinds",
            "w1 wind/5 G msg=1; w1 wind/6 G msg=2; w1 wind/5 G msg=3", "wind/6@w1 msg=2; wind/5@w1 msg=3");
        row("guess: other events never merge", "w1 mous/1 G msg=1; w1 mous/1 G msg=2; w1 wind/24 G msg=3; w1 wind/24 G msg=4",
            "mous/1@w1 msg=1; mous/1@w1 msg=2; wind/24@w1 msg=3; wind/24@w1 msg=4");
        row("twins are per window", "w1 wind/1 G msg=1; w2 wind/1 G msg=2; w1 wind/1 G msg=3",
            "wind/1@w2 msg=2; wind/1@w1 msg=3");
        row("merge into queued: the first twin keeps place and data, takes the skip mark",
            "w1 keyb/1 N msg=1; w1 mous/1 N msg=2; w1 keyb/1 N msg=3; w1 keyb/1 M skip msg=4",
            "keyb/1@w1 msg=1 skip; mous/1@w1 msg=2; keyb/1@w1 msg=3");
        row("merge into queued: an unset skip mark does not clear a set one",
            "w1 keyb/1 N skip msg=1; w1 keyb/1 M msg=2", "keyb/1@w1 msg=1 skip");
        row("merge into queued without a twin appends", "w1 keyb/1 N msg=1; w2 keyb/1 M msg=2",
            "keyb/1@w1 msg=1; keyb/1@w2 msg=2");
        row("replace queued: every twin goes, any skip mark comes along",
            "w1 wind/5 N skip msg=1; w2 wind/5 N msg=2; w1 wind/5 N msg=3; w1 wind/5 R msg=4",
            "wind/5@w2 msg=2; wind/5@w1 msg=4 skip");
        row("merging without a window asserts and goes on", "- keyb/1 N msg=1; - keyb/1 R msg=2",
            "assert: item->window != NULL; keyb/1 msg=2");
        row("unknown policy asserts and drops the event", "w1 keyb/1 N msg=1; w1 keyb/1 7 msg=2",
            "assert: Unknown mergePolicy; keyb/1@w1 msg=1");
    }

    void mergePolicies()
    {
        QFETCH(QString, script);
        QFETCH(QString, expected);
        AssertRecorder asserts;
        FakeWindows windows; // legacy processing off: update events are queued
        for (const QString& line : script.split(QStringLiteral("; ")))
            schedule(line);
        QCOMPARE((log() + queueSnapshot()).join(QStringLiteral("; ")), expected);
    }

    // Two events that ask for synchronous handling, then one that never does ('clos').
    void synchronizedDispatch_data()
    {
        QTest::addColumn<bool>("waiter");
        QTest::addColumn<bool>("disabled");
        QTest::addColumn<int>("answer");
        QTest::addColumn<QString>("expected");

        QTest::newRow("handled at once") << true << false << int(noErr)
                                         << "handler: vlmr/size@w1; handler: mous/6@w1";
        QTest::newRow("not handled: queued as synchronized") << true << false << int(eventNotHandledErr)
            << "handler: vlmr/size@w1; handler: mous/6@w1; vlmr/size@w1 sync; mous/6@w1 sync";
        QTest::newRow("no waiter: queued, marked not synchronized") << false << false << int(noErr)
                                                                    << "vlmr/size@w1 nosync; mous/6@w1 nosync";
        QTest::newRow("Carbon events disabled: queued, marked not synchronized")
            << true << true << int(noErr) << "vlmr/size@w1 nosync; mous/6@w1 nosync";
    }

    void synchronizedDispatch()
    {
        QFETCH(bool, waiter);
        QFETCH(bool, disabled);
        QFETCH(int, answer);
        QFETCH(QString, expected);
        AssertRecorder asserts;
        FakeWindows windows;
        FakeWaiter fakeWaiter(waiter);
        static OSStatus sAnswer;
        sAnswer = answer;
        EventHandlerRef handler = nullptr;
        InstallEventHandler(
            GetEventDispatcherTarget(),
            [](EventHandlerCallRef, EventRef event, void*) {
                log() << QStringLiteral("handler: ") + describe(event);
                return sAnswer;
            },
            0, nullptr, nullptr, &handler);
        gMainEventQueue.SetCarbonEventsDisabled(disabled);
        schedule("w1 vlmr/1936292453 N"); // 'size'
        schedule("w1 mous/6 N");
        schedule("w1 vlmr/1668050803 N"); // 'clos'
        gMainEventQueue.SetCarbonEventsDisabled(false);
        RemoveEventHandler(handler);
        for (const EventQueueItemSmartPtr& item : gMainEventQueue.items())
            log() << describe(item.get()) + (item->notSynchronized ? " nosync" : " sync");
        QCOMPARE(log().join(QStringLiteral("; ")), expected + "; vlmr/clos@w1 sync");
    }

    void postEvent_data()
    {
        QTest::addColumn<int>("code");
        QTest::addColumn<bool>("legacy");
        QTest::addColumn<QString>("queued");

        // 0 (null), disk, activate and unknown codes travel as library-class events
        const char* queued[] = {"vlme/0", "mous/1", "mous/2", "keyb/1", "keyb/3", "keyb/2", "wind/1", "vlme/7", "vlme/8"};
        for (int code = 0; code <= 8; ++code)
            QTest::addRow("%d", code) << code << false << QString::fromLatin1(queued[code]) + " msg=77";
        QTest::newRow("6 update, legacy: kept out of the queue") << 6 << true << "";
        QTest::newRow("65535") << 65535 << false << "vlme/65535 msg=77";
    }

    void postEvent()
    {
        QFETCH(int, code);
        QFETCH(bool, legacy);
        QFETCH(QString, queued);
        FakeWindows windows;
        windows.setLegacy(legacy);
        FixedTicks ticks;
        QCOMPARE(PostEvent(UInt16(code), 77), OSErr(noErr));
        QCOMPARE(queueSnapshot().join(u','), queued);
        if (!queued.isEmpty()) {
            EventQueueItem* item = gMainEventQueue.items().front().get();
            QCOMPARE(item->when, 1234u);
            QCOMPARE(item->attributes, 0u);
            QCOMPARE(item->modifiers & ~UInt32(alphaLock), 0u);
        }
    }

    // Without a window layer overriding it, the feature flag decides where updates go.
    void legacyProcessingFollowsTheFeatureFlag()
    {
        const UInt32 saved = SupportLegacyMacEventProcessing(kFeatureFlagQuery);
        SupportLegacyMacEventProcessing(0);
        PostEvent(updateEvt, 1);
        SupportLegacyMacEventProcessing(1);
        PostEvent(updateEvt, 2);
        SupportLegacyMacEventProcessing(saved);
        QCOMPARE(queueSnapshot(), QStringList{"wind/1 msg=1"});
    }

    void postEventToQueue()
    {
        AssertRecorder asserts;
        FakeWindows windows;
        EventRef event = nullptr;
        MacCreateEvent(nullptr, kEventClassKeyboard, kEventRawKeyDown, 0, 0, &event);
        log() << QString::number(PostEventToQueue(nullptr, event, kEventPriorityStandard));
        log() << QString::number(PostEventToQueue(GetMainEventQueue(), nullptr, kEventPriorityStandard));
        log() << QString::number(PostEventToQueue(GetCurrentEventQueue(), event, kEventPriorityHigh));
        log() << QStringLiteral("refs %1").arg(event->refCount); // the queue holds its own
        EventQueue other;
        log() << QString::number(PostEventToQueue(&other, event, kEventPriorityLow)); // lands in the main queue
        ReleaseEvent(event);
        QCOMPARE(log() + queueSnapshot(),
                 (QStringList{"-9868", "-9868", "0", "refs 2", "assert: inQueue == Velmar::GetMainEventQueue()", "0",
                              "keyb/1", "keyb/1"}));
        QCOMPARE(GetMainEventQueue(), GetMainEventLoop());
    }

    void flushEvents_data()
    {
        QTest::addColumn<int>("which");
        QTest::addColumn<int>("stop");
        QTest::addColumn<QStringList>("expected"); // log, then what is left

        // The queue before each flush (w2 has an update region to repaint):
        const QStringList dirtyUpdateAndSkip{"wind/1@w2", "mous/1@w1 skip", "keyb/3@w1 skip"};
        QTest::newRow("everyEvent keeps repaints and skip-marked events")
            << int(everyEvent) << 0 << QStringList{"waiter begin", "waiter end"} + dirtyUpdateAndSkip;
        QTest::newRow("which == stop parses 0: flushes as broadly")
            << int(mDownMask | keyUpMask) << int(mDownMask | keyUpMask)
            << QStringList{"waiter begin", "waiter end"} + dirtyUpdateAndSkip;
        QTest::newRow("stop mask only excludes types")
            << int(everyEvent) << int(mDownMask)
            << QStringList{"waiter begin", "waiter end", "mous/1@w1", "wind/1@w2", "mous/1@w1 skip", "mous/1@w2",
                           "keyb/3@w1 skip", "vlme/12"};
        QTest::newRow("mouse downs only")
            << int(mDownMask) << 0
            << QStringList{"waiter begin", "waiter end", "keyb/1@w1", "wind/1@w1", "wind/1@w2", "mous/1@w1 skip",
                           "appl/1", "keyb/3@w1 skip", "vlme/12"};
        QTest::newRow("null-event bit: unparsed, nothing flushed")
            << 1 << 0
            << QStringList{"mous/1@w1", "keyb/1@w1", "wind/1@w1", "wind/1@w2", "mous/1@w1 skip", "mous/1@w2",
                           "appl/1", "keyb/3@w1 skip", "vlme/12"};
    }

    void flushEvents()
    {
        QFETCH(int, which);
        QFETCH(int, stop);
        QFETCH(QStringList, expected);
        FakeWindows windows;
        FakeWaiter waiter(false);
        windows.setDirty(fakeWindow(2));
        for (const char* line : {"w1 mous/1 N", "w1 keyb/1 N", "w1 wind/1 N", "w2 wind/1 N", "w1 mous/1 N skip",
                                 "w2 mous/1 N", "- appl/1 N", "w1 keyb/3 N skip", "- vlme/12 N"})
            schedule(QString::fromLatin1(line));
        FlushEvents(UInt16(which), UInt16(stop));
        QCOMPARE(log() + queueSnapshot(), expected);
    }

    void comparatorCalls()
    {
        AssertRecorder asserts;
        FakeWindows windows;
        windows.setLegacy(true);
        schedule("w1 mous/1 N");
        schedule("w2 keyb/1 N");
        schedule("w1 keyb/3 N");
        windows.addPendingUpdate(fakeWindow(3));
        EventQueueItem* pendingW2 = windows.addPendingUpdate(fakeWindow(2));

        log() << QStringLiteral("count %1").arg(GetNumEventsInQueue(GetMainEventQueue()));
        EventRef found = FindSpecificEventInQueue(GetMainEventQueue(), matchesWindow, fakeWindow(2));
        log() << QStringLiteral("found ") + describe(found);
        // not in the queue: the windows' pending update events are searched next
        found = FindSpecificEventInQueue(GetMainEventQueue(), matchesWindow, fakeWindow(3));
        log() << QStringLiteral("found ") + describe(found);
        log() << QString::number(FlushSpecificEventsFromQueue(GetMainEventQueue(), matchesWindow, fakeWindow(1)));
        log() << QStringLiteral("count %1").arg(GetNumEventsInQueue(GetMainEventQueue()));
        log() << QString::number(RemoveEventFromQueue(GetMainEventQueue(), pendingW2));
        log() << QStringLiteral("count %1").arg(GetNumEventsInQueue(GetMainEventQueue()));
        QCOMPARE((log() + queueSnapshot()).join(QStringLiteral("; ")),
                 "count 5; compare mous/1@w1; compare keyb/1@w2; found keyb/1@w2; "
                 "compare mous/1@w1; compare keyb/1@w2; compare keyb/3@w1; compare wind/1@w3; found wind/1@w3; "
                 "compare mous/1@w1; compare keyb/1@w2; compare keyb/3@w1; compare wind/1@w3; compare wind/1@w2; 0; "
                 "count 3; clear pending w2; 0; count 2; keyb/1@w2");
    }

    void badQueueArguments()
    {
        FakeWindows windows;
        schedule("w1 mous/1 N");
        schedule("w1 mous/2 N");
        EventQueueItemSmartPtr second = gMainEventQueue.items().back();
        EventQueueItemSmartPtr notQueued = makeItem(kEventClassMouse, kEventMouseUp);
        for (EventRef event : {notQueued.get(), second.get(), second.get(), EventRef(nullptr)})
            log() << QString::number(RemoveEventFromQueue(GetMainEventQueue(), event));
        log() << QString::number(RemoveEventFromQueue(nullptr, second.get()));
        log() << QStringLiteral("refs %1").arg(second->refCount);
        QCOMPARE(log(), (QStringList{"0", "0", "0", "0", "-9868", "refs 1"}));
        QCOMPARE(FindSpecificEventInQueue(GetMainEventQueue(), matchesNothing, nullptr), EventRef(nullptr));
        QVERIFY(NewEventComparatorUPP(matchesNothing) == &matchesNothing);
        Private::ScheduleEvent(EventQueueItemSmartPtr(), EventQueueItem::NoMerge);
        Private::FlushEventReferences(nullptr);
        QCOMPARE(queueSnapshot(), QStringList{"mous/1@w1"});
    }

    // At most one wake-up is in flight, whatever the posting rate.
    void queueChangedSignal()
    {
        AssertRecorder asserts;
        FakeWindows windows;
        WakeUpCounter wakeUps;
        auto inFlight = [] { log() << QStringLiteral("in flight %1").arg(gMainEventQueue.hasQueueChangeEvent()); };
        QVERIFY(Private::EventQueueChangedEvent::eventType() >= QEvent::User);
        gMainEventQueue.RaiseQueueChangedSignal(); // empty queue: nothing to collect
        inFlight();
        for (int i = 0; i < 3; ++i)
            PostEvent(keyDown, UInt32(i));
        inFlight();
        QCoreApplication::sendPostedEvents();
        inFlight();
        gMainEventQueue.SetCarbonEventsDisabled(true);
        PostEvent(keyDown, 3); // blocked: the blocker raises the signal when it ends
        inFlight();
        gMainEventQueue.SetCarbonEventsDisabled(false);
        gMainEventQueue.RaiseQueueChangedSignal();
        QCoreApplication::sendPostedEvents();
        inFlight();
        QCOMPARE(log(), (QStringList{"in flight 0", "in flight 1", "wake-up (queue 3)", "in flight 0",
                                     "in flight 0", "wake-up (queue 4)", "in flight 0"}));
    }

    // A disposed window's queued events are revoked where they stand and never handed out;
    // its pending update event goes too.
    void windowDisposal()
    {
        AssertRecorder asserts;
        FakeWindows windows;
        windows.addPendingUpdate(fakeWindow(1));
        schedule("w1 mous/1 N msg=1");
        schedule("w2 mous/1 N msg=2");
        EventQueueItemSmartPtr revokedOne = gMainEventQueue.items().front();
        Private::FlushEventReferences(fakeWindow(1));
        log() << describe(revokedOne.get());
        QCOMPARE(log() + queueSnapshot(), (QStringList{"clear pending w1", "mous/1 msg=1 revoked", "mous/1@w2 msg=2"}));
        QVERIFY(!windows.hasPendingUpdate(fakeWindow(1)));
    }

    // Control and Meta both become command; Alt is option.
    void keyModifiers()
    {
        QWindow window;
        window.resize(50, 50);
        window.show();
        QTest::keyPress(&window, Qt::Key_A, Qt::ShiftModifier | Qt::AltModifier | Qt::ControlModifier | Qt::MetaModifier);
        const UInt32 got = GetCurrentKeyModifiers();
        QTest::keyRelease(&window, Qt::Key_A, Qt::NoModifier);
        QCOMPARE(got & ~UInt32(alphaLock), UInt32(shiftKey | optionKey | cmdKey)); // caps lock is the machine's
    }

    // Posted events share one reading of the mouse and modifiers per tick; a modifier change
    // Qt has delivered, or ForgetInputSnapshot, takes a new one within the tick.
    void inputReadOncePerTick()
    {
        FakeWindows windows;
        FixedTicks ticks;
        QWindow window;
        window.resize(50, 50);
        window.show();
        QCursor::setPos(10, 20);
        Private::ForgetInputSnapshot();
        PostEvent(keyDown, 1);
        QCursor::setPos(30, 40); // same tick: not asked again
        PostEvent(keyDown, 2);
        QTest::keyPress(&window, Qt::Key_A, Qt::ShiftModifier);
        PostEvent(keyDown, 3);
        QTest::keyRelease(&window, Qt::Key_A, Qt::NoModifier);
        Private::ForgetInputSnapshot();
        PostEvent(keyDown, 4);
        for (const EventQueueItemSmartPtr& item : gMainEventQueue.items()) {
            const UInt32 mods = item->modifiers & ~UInt32(alphaLock);
            log() << QStringLiteral("%1,%2 %3").arg(item->where.h).arg(item->where.v).arg(mods);
        }
        if (QCursor::pos() != QPoint(30, 40))
            QSKIP("the platform cannot move the mouse");
        QCOMPARE(log(), (QStringList{"10,20 0", "10,20 0", "30,40 512", "30,40 0"}));
    }

private:
    std::unique_ptr<AssertRecorder> m_unexpectedAsserts;
};

VELMAR_TEST_MAIN(tst_EventQueue)
#include "tst_eventqueue.moc"
