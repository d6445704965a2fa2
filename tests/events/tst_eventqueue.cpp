// The main queue: merge policies, synchronized dispatch, posting, flushing, the Carbon
// queue calls, the wake-up signal and window disposal. Each case records what every
// participant (handlers, waiters, windows, assertions) saw, in order, and compares the
// whole sequence with the queue's contents.
#include "events_support.h"

#include "events/AppActivation.h"
#include "events/DispatchStack.h"
#include "events/EventQueue.h"
#include "events/PostEvent.h"

#include <Velmar/CarbonEventHandlers.h>
#include <Velmar/CarbonEvents.h>
#include <Velmar/Events.h>
#include <Velmar/FeatureFlags.h>
#include <Velmar/HostCore.h>
#include <Velmar/MacErrors.h>

#include <QCursor>
#include <QWindow>

#include <memory>

using namespace Velmar;
using namespace EventTest;
using Private::EventQueueItem;
using Private::gMainEventQueue;

namespace {

// Installs a tick source fixed at 1234 for its lifetime.
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

// Counts the queue-changed wake-ups the application receives.
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

// A Carbon handler on the dispatcher target that logs what it sees and answers `result`.
struct RecordingHandler {
    explicit RecordingHandler(OSStatus answer) : result(answer)
    {
        InstallEventHandler(GetEventDispatcherTarget(), NewEventHandlerUPP(call), 0, nullptr, this, &ref);
    }
    ~RecordingHandler() { RemoveEventHandler(ref); }
    static OSStatus call(EventHandlerCallRef, EventRef event, void* data)
    {
        log() << QStringLiteral("handler: ") + describe(event);
        return static_cast<RecordingHandler*>(data)->result;
    }
    OSStatus result;
    EventHandlerRef ref = nullptr;
};

bool matchesWindow(EventRef event, void* data)
{
    log() << QStringLiteral("compare ") + describe(event);
    return event->window == data;
}

bool matchesNothing(EventRef, void*)
{
    return false;
}

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

    void mergePolicies_data()
    {
        QTest::addColumn<QStringList>("script");
        QTest::addColumn<QStringList>("expected"); // assertions, then the queue

        QTest::newRow("no merge appends") << QStringList{"w1 keyb/1 N msg=1", "w1 keyb/1 N msg=2"}
                                          << QStringList{"keyb/1@w1 msg=1", "keyb/1@w1 msg=2"};
        QTest::newRow("guess: update twice leaves one, at the later position")
            << QStringList{"w1 wind/1 G msg=1", "w1 mous/1 G msg=2", "w1 wind/1 G msg=3"}
            << QStringList{"mous/1@w1 msg=2", "wind/1@w1 msg=3"};
        QTest::newRow("guess: activate and deactivate are separate kinds")
            << QStringList{"w1 wind/5 G msg=1", "w1 wind/6 G msg=2", "w1 wind/5 G msg=3"}
            << QStringList{"wind/6@w1 msg=2", "wind/5@w1 msg=3"};
        QTest::newRow("guess: other events never merge")
            << QStringList{"w1 mous/1 G msg=1", "w1 mous/1 G msg=2", "w1 wind/24 G msg=3", "w1 wind/24 G msg=4"}
            << QStringList{"mous/1@w1 msg=1", "mous/1@w1 msg=2", "wind/24@w1 msg=3", "wind/24@w1 msg=4"};
        QTest::newRow("twins are per window")
            << QStringList{"w1 wind/1 G msg=1", "w2 wind/1 G msg=2", "w1 wind/1 G msg=3"}
            << QStringList{"wind/1@w2 msg=2", "wind/1@w1 msg=3"};
        QTest::newRow("merge into queued: the first twin keeps place and data, takes the skip mark")
            << QStringList{"w1 keyb/1 N msg=1", "w1 mous/1 N msg=2", "w1 keyb/1 N msg=3", "w1 keyb/1 M skip msg=4"}
            << QStringList{"keyb/1@w1 msg=1 skip", "mous/1@w1 msg=2", "keyb/1@w1 msg=3"};
        QTest::newRow("merge into queued: an unset skip mark does not clear a set one")
            << QStringList{"w1 keyb/1 N skip msg=1", "w1 keyb/1 M msg=2"} << QStringList{"keyb/1@w1 msg=1 skip"};
        QTest::newRow("merge into queued without a twin appends")
            << QStringList{"w1 keyb/1 N msg=1", "w2 keyb/1 M msg=2"}
            << QStringList{"keyb/1@w1 msg=1", "keyb/1@w2 msg=2"};
        QTest::newRow("replace queued: every twin goes, any skip mark comes along")
            << QStringList{"w1 wind/5 N skip msg=1", "w2 wind/5 N msg=2", "w1 wind/5 N msg=3", "w1 wind/5 R msg=4"}
            << QStringList{"wind/5@w2 msg=2", "wind/5@w1 msg=4 skip"};
        QTest::newRow("merging without a window asserts and goes on")
            << QStringList{"- keyb/1 N msg=1", "- keyb/1 R msg=2"}
            << QStringList{"assert: item->window != NULL", "keyb/1 msg=2"};
        QTest::newRow("unknown policy asserts and drops the event")
            << QStringList{"w1 keyb/1 N msg=1", "w1 keyb/1 7 msg=2"}
            << QStringList{"assert: Unknown mergePolicy", "keyb/1@w1 msg=1"};
    }

    void mergePolicies()
    {
        QFETCH(QStringList, script);
        QFETCH(QStringList, expected);
        AssertRecorder asserts;
        FakeWindows windows; // legacy processing off: update events are queued
        for (const QString& line : script)
            schedule(line);
        QCOMPARE(log() + queueSnapshot(), expected);
    }

    void synchronizedDispatch_data()
    {
        QTest::addColumn<bool>("waiter");
        QTest::addColumn<bool>("disabled");
        QTest::addColumn<int>("answer");
        QTest::addColumn<QStringList>("expected");

        QTest::newRow("handled at once") << true << false << int(noErr)
                                         << QStringList{"handler: vlmr/size@w1", "handler: mous/6@w1"};
        QTest::newRow("not handled: queued as synchronized")
            << true << false << int(eventNotHandledErr)
            << QStringList{"handler: vlmr/size@w1", "handler: mous/6@w1", "vlmr/size@w1 sync",
                           "mous/6@w1 sync"};
        QTest::newRow("no waiter: queued, marked not synchronized")
            << false << false << int(noErr) << QStringList{"vlmr/size@w1 nosync", "mous/6@w1 nosync"};
        QTest::newRow("Carbon events disabled: queued, marked not synchronized")
            << true << true << int(noErr) << QStringList{"vlmr/size@w1 nosync", "mous/6@w1 nosync"};
    }

    void synchronizedDispatch()
    {
        QFETCH(bool, waiter);
        QFETCH(bool, disabled);
        QFETCH(int, answer);
        QFETCH(QStringList, expected);
        AssertRecorder asserts;
        FakeWindows windows;
        FakeWaiter fakeWaiter(waiter);
        RecordingHandler handler(answer);
        gMainEventQueue.SetCarbonEventsDisabled(disabled);
        schedule("w1 vlmr/1936292453 N"); // 'size'
        schedule("w1 mous/6 N");
        schedule("w1 vlmr/1668050803 N"); // 'clos': never synchronized
        gMainEventQueue.SetCarbonEventsDisabled(false);
        QStringList seen = log();
        for (const EventQueueItemSmartPtr& item : gMainEventQueue.items())
            seen << describe(item.get()) + (item->notSynchronized ? " nosync" : " sync");
        QCOMPARE(seen, expected + QStringList{"vlmr/clos@w1 sync"});
    }

    // A handler that disposes of the event's window: the event counts as consumed and the
    // window's queued events are revoked.
    void windowDisposedDuringSynchronousDispatch()
    {
        AssertRecorder asserts;
        FakeWindows windows;
        FakeWaiter fakeWaiter(true);
        schedule("w1 keyb/1 N msg=1");
        schedule("w2 keyb/1 N msg=2");
        EventHandlerRef ref = nullptr;
        InstallEventHandler(
            GetEventDispatcherTarget(),
            [](EventHandlerCallRef, EventRef event, void*) -> OSStatus {
                log() << QStringLiteral("handler: ") + describe(event);
                Private::FlushEventReferences(event->window);
                log() << QStringLiteral("after disposal: ") + describe(event);
                return eventNotHandledErr;
            },
            0, nullptr, nullptr, &ref);
        schedule("w1 vlmr/1836021349 N msg=3"); // 'move'
        RemoveEventHandler(ref);
        QCOMPARE(log() + queueSnapshot(),
                 (QStringList{"handler: vlmr/move@w1 msg=3", "clear pending w1", "after disposal: vlmr/move msg=3",
                              "keyb/1@w2 msg=2"}));
    }

    void windowsOnTheirWayOutAndLegacyUpdates()
    {
        AssertRecorder asserts;
        FakeWindows windows;
        WakeUpCounter wakeUps;
        windows.setDeletePending(fakeWindow(2));
        windows.setLegacy(true);
        schedule("w2 keyb/1 N msg=1"); // dropped silently
        schedule("w1 wind/1 G msg=2"); // stays with its window: not queued, no wake-up
        QCoreApplication::sendPostedEvents();
        log() << QStringLiteral("--");
        windows.addPendingUpdate(fakeWindow(1));
        schedule("w1 wind/1 G msg=3"); // a window now holds one: the waiters are woken
        QCoreApplication::sendPostedEvents();
        schedule("w1 keyb/1 N msg=4");
        QCoreApplication::sendPostedEvents();
        QCOMPARE(log() + queueSnapshot(),
                 (QStringList{"--", "wake-up (queue 0)", "wake-up (queue 1)", "keyb/1@w1 msg=4"}));
    }

    void postEvent_data()
    {
        QTest::addColumn<int>("code");
        QTest::addColumn<bool>("legacy");
        QTest::addColumn<QString>("queued");

        QTest::newRow("0: null code travels as vlme") << 0 << false << "vlme/0 msg=77";
        QTest::newRow("1 mouse down") << 1 << false << "mous/1 msg=77";
        QTest::newRow("2 mouse up") << 2 << false << "mous/2 msg=77";
        QTest::newRow("3 key down") << 3 << false << "keyb/1 msg=77";
        QTest::newRow("4 key up") << 4 << false << "keyb/3 msg=77";
        QTest::newRow("5 auto key") << 5 << false << "keyb/2 msg=77";
        QTest::newRow("6 update") << 6 << false << "wind/1 msg=77";
        QTest::newRow("6 update, legacy: kept out of the queue") << 6 << true << "";
        QTest::newRow("7 disk") << 7 << false << "vlme/7 msg=77";
        QTest::newRow("8 activate is a vlme event") << 8 << false << "vlme/8 msg=77";
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

    void fillNullEvent()
    {
        FixedTicks ticks;
        EventQueueItemSmartPtr item = makeItem(kEventClassMouse, kEventMouseDown, fakeWindow(1), 5);
        Private::FillNullEvent(item.get());
        QCOMPARE(describe(item.get()), QStringLiteral("null/0"));
        QCOMPARE(item->when, 1234u);
        Private::FillNullEvent(nullptr);
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
        QCOMPARE(log() + queueSnapshot(),
                 (QStringList{"count 5",
                              "compare mous/1@w1", "compare keyb/1@w2", "found keyb/1@w2",
                              "compare mous/1@w1", "compare keyb/1@w2", "compare keyb/3@w1",
                              "compare wind/1@w3", "found wind/1@w3",
                              "compare mous/1@w1", "compare keyb/1@w2", "compare keyb/3@w1",
                              "compare wind/1@w3", "compare wind/1@w2", "0",
                              "count 3",
                              "clear pending w2", "0", "count 2",
                              "keyb/1@w2"}));
    }

    void removeEventFromQueue()
    {
        FakeWindows windows;
        schedule("w1 mous/1 N");
        schedule("w1 mous/2 N");
        EventQueueItemSmartPtr second = gMainEventQueue.items().back();
        EventQueueItemSmartPtr notQueued = makeItem(kEventClassMouse, kEventMouseUp);
        log() << QString::number(RemoveEventFromQueue(GetMainEventQueue(), notQueued.get()));
        log() << QString::number(RemoveEventFromQueue(GetMainEventQueue(), second.get()));
        log() << QString::number(RemoveEventFromQueue(GetMainEventQueue(), second.get()));
        log() << QString::number(RemoveEventFromQueue(GetMainEventQueue(), nullptr));
        log() << QString::number(RemoveEventFromQueue(nullptr, second.get()));
        log() << QStringLiteral("refs %1").arg(second->refCount);
        QCOMPARE(log() + queueSnapshot(), (QStringList{"0", "0", "0", "0", "-9868", "refs 1", "mous/1@w1"}));
    }

    void badQueueArguments()
    {
        schedule("w1 mous/1 N");
        QCOMPARE(FlushSpecificEventsFromQueue(nullptr, matchesNothing, nullptr), OSStatus(eventInternalErr));
        QCOMPARE(FlushSpecificEventsFromQueue(GetMainEventQueue(), nullptr, nullptr), OSStatus(eventInternalErr));
        QCOMPARE(FindSpecificEventInQueue(nullptr, matchesNothing, nullptr), EventRef(nullptr));
        QCOMPARE(FindSpecificEventInQueue(GetMainEventQueue(), nullptr, nullptr), EventRef(nullptr));
        QCOMPARE(FindSpecificEventInQueue(GetMainEventQueue(), matchesNothing, nullptr), EventRef(nullptr));
        QCOMPARE(GetNumEventsInQueue(nullptr), 0u);
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
        QVERIFY(Private::EventQueueChangedEvent::eventType() >= QEvent::User);
        gMainEventQueue.RaiseQueueChangedSignal(); // empty queue: nothing to collect
        log() << QStringLiteral("in flight %1").arg(gMainEventQueue.hasQueueChangeEvent());
        for (int i = 0; i < 3; ++i)
            PostEvent(keyDown, UInt32(i));
        log() << QStringLiteral("in flight %1").arg(gMainEventQueue.hasQueueChangeEvent());
        QCoreApplication::sendPostedEvents();
        log() << QStringLiteral("in flight %1").arg(gMainEventQueue.hasQueueChangeEvent());
        gMainEventQueue.SetCarbonEventsDisabled(true);
        PostEvent(keyDown, 3); // blocked: the blocker raises the signal when it ends
        log() << QStringLiteral("in flight %1").arg(gMainEventQueue.hasQueueChangeEvent());
        gMainEventQueue.SetCarbonEventsDisabled(false);
        gMainEventQueue.RaiseQueueChangedSignal();
        QCoreApplication::sendPostedEvents();
        log() << QStringLiteral("in flight %1").arg(gMainEventQueue.hasQueueChangeEvent());
        QCOMPARE(log(), (QStringList{"in flight 0", "in flight 1", "wake-up (queue 3)", "in flight 0",
                                     "in flight 0", "wake-up (queue 4)", "in flight 0"}));
    }

    void alreadyCountedWakeUpLeavesTheMark()
    {
        FakeWindows windows;
        schedule("w1 mous/1 N");
        QVERIFY(gMainEventQueue.hasQueueChangeEvent());
        QCoreApplication::removePostedEvents(qApp, Private::EventQueueChangedEvent::eventType());
        QVERIFY(!gMainEventQueue.hasQueueChangeEvent()); // discarded: the mark went with it
        {
            Private::EventQueueChangedEvent counted;
            counted.alreadyCounted = true;
            gMainEventQueue.RaiseQueueChangedSignal();
        }
        QVERIFY(gMainEventQueue.hasQueueChangeEvent());
        QCoreApplication::sendPostedEvents();
        QVERIFY(!gMainEventQueue.hasQueueChangeEvent());

        // one that was never counted, going away with no mark set
        AssertRecorder asserts;
        gMainEventQueue.clearAll();
        delete new Private::EventQueueChangedEvent;
        QCOMPARE(log(), QStringList{"assert: m_hasQueueChangeEvent"});
    }

    void windowDisposal()
    {
        AssertRecorder asserts;
        FakeWindows windows;
        windows.addPendingUpdate(fakeWindow(1));
        schedule("w1 mous/1 N msg=1");
        schedule("w2 mous/1 N msg=2");
        schedule("w1 keyb/1 N msg=3");
        EventQueueItemSmartPtr revokedOne = gMainEventQueue.items().front();
        EventQueueItemSmartPtr running = makeItem(kEventClassWindow, kEventWindowActivated, fakeWindow(1));
        EventQueueItemSmartPtr runningOther = makeItem(kEventClassWindow, kEventWindowActivated, fakeWindow(2));
        {
            Private::ScopedDispatchStackEntry outer(runningOther);
            Private::ScopedDispatchStackEntry inner(running);
            Private::FlushEventReferences(fakeWindow(1));
            log() << describe(running.get()) << describe(runningOther.get());
            QCOMPARE(int(Private::DispatchStack().size()), 2);
        }
        QCOMPARE(int(Private::DispatchStack().size()), 0);
        log() << describe(revokedOne.get());
        QCOMPARE(log() + queueSnapshot(), (QStringList{"clear pending w1", "wind/5", "wind/5@w2",
                                                       "mous/1 msg=1 revoked", "mous/1@w2 msg=2"}));
        QVERIFY(!windows.hasPendingUpdate(fakeWindow(1)));
    }

    void dispatchStackOutOfOrder()
    {
        AssertRecorder asserts;
        EventQueueItemSmartPtr a = makeItem(kEventClassMouse, kEventMouseDown);
        EventQueueItemSmartPtr b = makeItem(kEventClassMouse, kEventMouseUp);
        Private::PushDispatchedItem(a);
        Private::PushDispatchedItem(b);
        Private::PopDispatchedItem(a.get());
        Private::PopDispatchedItem(a.get()); // not there any more: ignored
        Private::PopDispatchedItem(b.get());
        Private::PushDispatchedItem(EventQueueItemSmartPtr());
        QCOMPARE(int(Private::DispatchStack().size()), 0);
        QCOMPARE(log(), QStringList{"assert: dispatch stack popped out of order"});
    }

    void applicationActivation()
    {
        FixedTicks ticks;
        EventQueueItemSmartPtr item = makeItem(kEventClassMouse, kEventMouseDown, fakeWindow(1), 9);
        QEvent activate(QEvent::ApplicationActivate);
        QEvent deactivate(QEvent::ApplicationDeactivate);
        QEvent other(QEvent::WindowActivate);
        QVERIFY(!Private::ConvertApplicationActivation(&other, item.get()));
        log() << describe(item.get());
        QVERIFY(Private::ConvertApplicationActivation(&activate, item.get()));
        log() << describe(item.get()) + QStringLiteral(" t=%1").arg(item->when);
        QCOMPARE(item->toEventRecord().message, 0x01000001u);
        QVERIFY(Private::ConvertApplicationActivation(&deactivate, item.get()));
        log() << describe(item.get());
        QCOMPARE(item->toEventRecord().message, 0x01000000u);
        QVERIFY(!Private::ConvertApplicationActivation(nullptr, item.get()));
        QVERIFY(!Private::ConvertApplicationActivation(&activate, nullptr));
        QCOMPARE(log(), (QStringList{"mous/1@w1 msg=9", "appl/1 t=1234", "appl/2"}));
    }

    void keyModifiers_data()
    {
        QTest::addColumn<int>("qtModifiers");
        QTest::addColumn<UInt32>("mac");
        QTest::newRow("none") << int(Qt::NoModifier) << 0u;
        QTest::newRow("shift") << int(Qt::ShiftModifier) << UInt32(shiftKey);
        QTest::newRow("alt is option") << int(Qt::AltModifier) << UInt32(optionKey);
        QTest::newRow("control is command") << int(Qt::ControlModifier) << UInt32(cmdKey);
        QTest::newRow("meta is command too") << int(Qt::MetaModifier) << UInt32(cmdKey);
        QTest::newRow("all") << int(Qt::ShiftModifier | Qt::AltModifier | Qt::ControlModifier | Qt::MetaModifier)
                             << UInt32(shiftKey | optionKey | cmdKey);
    }

    void keyModifiers()
    {
        QFETCH(int, qtModifiers);
        QFETCH(UInt32, mac);
        QWindow window;
        window.resize(50, 50);
        window.show();
        QTest::keyPress(&window, Qt::Key_A, Qt::KeyboardModifiers(qtModifiers));
        const UInt32 got = GetCurrentKeyModifiers();
        QTest::keyRelease(&window, Qt::Key_A, Qt::NoModifier);
        QCOMPARE(got & ~UInt32(alphaLock), mac); // caps lock is whatever the machine has
        QVERIFY(!(got & controlKey));
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
