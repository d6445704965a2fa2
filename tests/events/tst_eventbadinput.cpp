// What a hostile host hands the event calls: comparators that change the queue while it is
// searched, queue references that are not the queue, and event and handler-call references
// that are freed or kept beyond their handler. Each must be refused or survived (run under
// the sanitizer build to see the difference).
#include "events_support.h"

#include <Velmar/CarbonEventHandlers.h>
#include <Velmar/CarbonEvents.h>
#include <Velmar/Events.h>
#include <Velmar/MacErrors.h>

#include <QKeyEvent>

#include <functional>

using namespace Velmar;
using namespace EventTest;
using Private::gMainEventQueue;

namespace {

// What the comparator under test does to the queue when it is shown an item.
std::function<bool(EventRef)> gComparatorAction;
int gShown = 0;

bool actingComparator(EventRef event, void*)
{
    ++gShown;
    return gComparatorAction(event);
}

EventRef gKeptCall = nullptr;
EventHandlerCallRef gKeptCallRef = nullptr;

OSStatus keepingHandler(EventHandlerCallRef call, EventRef event, void*)
{
    gKeptCallRef = call;
    gKeptCall = event;
    return eventNotHandledErr;
}

void postThree()
{
    for (UInt32 msg = 1; msg <= 3; ++msg)
        PostEvent(12, msg);
}

} // namespace

class tst_EventBadInput : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void init()
    {
        log().clear();
        gMainEventQueue.clearAll();
        gShown = 0;
    }
    void cleanup() { gMainEventQueue.clearAll(); }

    // Flushing and finding with comparators that post, remove what they are shown, or flush
    // everything: the walk sees each item that is still queued once, and nothing is freed
    // under it.
    void comparatorsThatChangeTheQueue_data()
    {
        QTest::addColumn<int>("action");
        QTest::addColumn<QStringList>("afterFlush");
        QTest::addColumn<QString>("found");
        QTest::newRow("posts") << 0 << QStringList{"vlme/12 msg=9", "vlme/12 msg=9", "vlme/12 msg=9"}
                               << "vlme/12 msg=1";
        QTest::newRow("removes what it is shown") << 1 << QStringList() << "<null>";
        QTest::newRow("flushes the queue") << 2 << QStringList() << "<null>";
    }
    void comparatorsThatChangeTheQueue()
    {
        QFETCH(int, action);
        QFETCH(QStringList, afterFlush);
        QFETCH(QString, found);
        gComparatorAction = [action](EventRef event) {
            switch (action) {
            case 0:
                PostEvent(12, 9);
                return GetEventKind(event) == 12 && event->message != 9;
            case 1:
                RemoveEventFromQueue(GetMainEventQueue(), event);
                return true;
            default:
                FlushEvents(everyEvent, 0);
                return true;
            }
        };
        postThree();
        QCOMPARE(FlushSpecificEventsFromQueue(GetMainEventQueue(), actingComparator, nullptr), noErr);
        QCOMPARE(queueSnapshot(), afterFlush);
        QCOMPARE(gShown, action == 2 ? 1 : 3);

        gMainEventQueue.clearAll();
        postThree();
        EventRef hit = FindSpecificEventInQueue(GetMainEventQueue(), actingComparator, nullptr);
        QCOMPARE(describe(hit), found);
    }

    // Only the main queue exists: any other reference is refused before it is read.
    void foreignQueueReferences()
    {
        auto listener = startCase(log());
        EventQueueRef foreign = reinterpret_cast<EventQueueRef>(&gShown);
        PostEvent(12, 1);
        QCOMPARE(GetNumEventsInQueue(foreign), 0u);
        QCOMPARE(FlushSpecificEventsFromQueue(foreign, actingComparator, nullptr), OSStatus(eventInternalErr));
        QCOMPARE(FindSpecificEventInQueue(foreign, actingComparator, nullptr), nullptr);
        QCOMPARE(RemoveEventFromQueue(foreign, gMainEventQueue.items().front().get()),
                 OSStatus(eventInternalErr));
        {
            ScopedCarbonEventsBlocker blocker(foreign, "foreign");
            QVERIFY(!blocker.isBlocked());
        }
        QCOMPARE(gShown, 0);
        QCOMPARE(listener->count(), 5);
        for (const auto& q : listener->questions())
            QCOMPARE(VelmarTest::assertionText(q.text), QStringLiteral("inQueue == Velmar::GetMainEventQueue()"));
        QCOMPARE(queueSnapshot(), QStringList{"vlme/12 msg=1"});
        QVERIFY(!gMainEventQueue.CheckCarbonEventsDisabled());
    }

    // Freed events and call references kept past their handler are refused, unread.
    void freedEventsAndKeptCallReferences()
    {
        auto listener = startCase(log());
        EventRef event = nullptr;
        MacCreateEvent(nullptr, kEventClassMouse, kEventMouseDown, 0, 0, &event);
        EventHandlerRef handler = nullptr;
        InstallEventHandler(GetApplicationEventTarget(), keepingHandler, 0, nullptr, nullptr, &handler);
        SendEventToEventTarget(event, GetApplicationEventTarget());
        QCOMPARE(gKeptCall, event);
        ReleaseEvent(event);
        UInt32 modifiers = 7;
        EventRecord record{};
        QCOMPARE(GetEventParameter(event, kEventParamKeyModifiers, typeUInt32, nullptr, 4, nullptr, &modifiers),
                 OSStatus(paramErr));
        QCOMPARE(SetEventParameter(event, kEventParamKeyModifiers, typeUInt32, 4, &modifiers),
                 OSStatus(eventInternalErr));
        QVERIFY(!ConvertEventRefToEventRecord(event, &record));
        QCOMPARE(PostEventToQueue(GetMainEventQueue(), event, kEventPriorityStandard), OSStatus(eventInternalErr));
        QCOMPARE(SendEventToEventTarget(event, GetApplicationEventTarget()), OSStatus(eventInternalErr));
        RetainEvent(event);
        QCOMPARE(CallNextEventHandler(gKeptCallRef, event), OSStatus(paramErr));
        QKeyEvent key(QEvent::KeyPress, Qt::Key_A, Qt::NoModifier, QStringLiteral("a"));
        QVERIFY(!ConvertVelmarEvent(nullptr, &key, event));
        QVERIFY(!ConvertKeyEvent(&key, event));
        QVERIFY(!ConvertKeyEvent(nullptr, nullptr)); // null: refused quietly
        QVERIFY(!ConvertMouseEvent(nullptr, nullptr, nullptr));
        RemoveEventHandler(handler);
        QCOMPARE(listener->count(), 9);
        QStringList texts;
        for (const auto& q : listener->questions())
            texts << VelmarTest::assertionText(q.text);
        texts.removeDuplicates();
        QCOMPARE(texts, (QStringList{"IsValidEvent(event)", "IsValidEventHandlerCall(inCallRef)"}));
        QCOMPARE(gMainEventQueue.count(), 0u);
    }
};

VELMAR_APP_TEST_MAIN(tst_EventBadInput)
#include "tst_eventbadinput.moc"
