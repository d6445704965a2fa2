// Carbon handler chains: each case compares which handler saw which event, in order. Then
// the dispatch blocker: nesting, the queue's disabled flag and what it suppresses.
#include "events_support.h"

#include "events/EventDispatch.h"
#include "events/EventQueue.h"
#include "events/HandlerList.h"
#include "events/HandlerWindows.h"

#include <Velmar/CarbonEventHandlers.h>
#include <Velmar/MacErrors.h>

#include <functional>

using namespace Velmar;
using Private::EventQueueItemSmartPtr;
using Private::gMainEventQueue;

namespace {

AQtWindow* const kWindowA = EventTest::fakeWindow(1);
AQtWindow* const kWindowB = EventTest::fakeWindow(2);

QStringList gSeen;

// One installed test handler: logs "name" or "name:kind" and answers `result`, or what its
// optional action answers.
struct TestHandler {
    QString name;
    OSStatus result = eventNotHandledErr;
    std::function<OSStatus(EventHandlerCallRef, EventRef)> action;
    EventHandlerRef ref = nullptr;
    bool logKind = false;
};

OSStatus recordingHandler(EventHandlerCallRef call, EventRef event, void* userData)
{
    auto* h = static_cast<TestHandler*>(userData);
    gSeen << (h->logKind ? QStringLiteral("%1:%2").arg(h->name).arg(GetEventKind(event)) : h->name);
    return h->action ? h->action(call, event) : h->result;
}

// Target by name: A application, D dispatcher, WA/WB windows.
EventTargetRef target(const QString& name)
{
    if (name.startsWith(u'D'))
        return GetEventDispatcherTarget();
    if (name.startsWith(u'A'))
        return GetApplicationEventTarget();
    return GetWindowEventTarget(name.startsWith(QStringLiteral("WB")) ? kWindowB : kWindowA);
}

// Handlers installed by one test; those still installed go when it ends.
class Chain {
public:
    ~Chain()
    {
        for (auto& h : m_handlers)
            if (h->ref && Private::HandlerList::instance().contains(h->ref))
                RemoveEventHandler(h->ref);
    }
    TestHandler& install(const QString& name, OSStatus result = eventNotHandledErr, QList<EventTypeSpec> types = {})
    {
        TestHandler& h = *m_handlers.emplace_back(new TestHandler{name, result, {}, nullptr, false});
        if (InstallEventHandler(target(name), NewEventHandlerUPP(recordingHandler), UInt32(types.size()),
                                types.constData(), &h, &h.ref) != noErr)
            qFatal("install failed");
        return h;
    }

private:
    std::vector<std::unique_ptr<TestHandler>> m_handlers;
};

EventQueueItemSmartPtr makeEvent(AQtWindow* window, UInt32 cls = kEventClassMouse, UInt32 kind = kEventMouseDown)
{
    return EventTest::makeItem(cls, kind, window);
}

QString blockerState()
{
    return gMainEventQueue.CheckCarbonEventsDisabled() ? "disabled" : "enabled";
}

} // namespace

class tst_Handlers : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void init()
    {
        m_listener = EventTest::startCase(gSeen);
    }
    void cleanup()
    {
        QCOMPARE(Private::HandlerList::instance().count(), 0);
        QCOMPARE(blockerState(), QStringLiteral("enabled"));
        gMainEventQueue.clearAll();
        QCoreApplication::sendPostedEvents();
        m_listener.reset();
    }

    // Handlers in installation order, "name=result" (eventNotHandledErr if none given);
    // the event belongs to window A.
    void chainOrder_data()
    {
        QTest::addColumn<QString>("installed");
        QTest::addColumn<QString>("expected");
        QTest::addColumn<bool>("handled");

        auto row = [](const char* name, const char* installed, const char* expected, bool handled) {
            QTest::newRow(name) << installed << expected << handled;
        };
        row("dispatcher, window, application; newest first", "A1 D1 WA1 D2 A2 WA2", "D2 D1 WA2 WA1 A2 A1", false);
        row("other window never sees the event", "WB1 WA1 WB2", "WA1", false);
        row("first noErr stops the chain", "D1 D2=0 A1", "D2", true);
        row("window handler takes it, application never runs", "A1 WA1=0 D1", "D1 WA1", true);
        row("errors are absorbed like eventNotHandledErr", "A1=0 WA1=-50 D1=-1 D2=-4", "D2 D1 WA1 A1", true);
        row("only errors: not handled", "A1=-50 D1=-108", "D1 A1", false);
        row("empty chain", "", "", false);
    }
    void chainOrder()
    {
        QFETCH(QString, installed);
        QFETCH(QString, expected);
        QFETCH(bool, handled);
        Chain chain;
        for (const QString& entry : installed.split(u' ', Qt::SkipEmptyParts))
            chain.install(entry.section(u'=', 0, 0),
                          entry.contains(u'=') ? entry.section(u'=', 1).toInt() : eventNotHandledErr);
        QCOMPARE(Private::DispatchEventToCallbacks(makeEvent(kWindowA)), handled);
        QCOMPARE(gSeen.join(u' '), expected);
        QCOMPARE(m_listener->count(), 0);
    }

    // A handler sees only the kinds in its list, a copy taken at installation.
    void typeListsFilterEvents()
    {
        Chain chain;
        chain.install("D-any").logKind = true;
        QList<EventTypeSpec> types{{kEventClassMouse, kEventMouseUp}, {kEventClassKeyboard, kEventRawKeyUp}};
        chain.install("D-up", eventNotHandledErr, types).logKind = true;
        types[0].eventKind = kEventMouseDown; // the caller's list changes afterwards
        for (UInt32 kind : {kEventMouseDown, kEventMouseUp, kEventMouseMoved})
            Private::DispatchEventToCallbacks(makeEvent(nullptr, kEventClassMouse, kind));
        Private::DispatchEventToCallbacks(makeEvent(nullptr, kEventClassKeyboard, kEventRawKeyUp));
        QCOMPARE(gSeen, (QStringList{"D-any:1", "D-up:2", "D-any:2", "D-any:5", "D-up:3", "D-any:3"}));
    }

    // What a handler does after calling CallNextEventHandler, and what the rest answers.
    void callNextContinuesChain_data()
    {
        QTest::addColumn<int>("innerResult"); // D1's answer
        QTest::addColumn<bool>("returnNext"); // D2 returns CallNext's result (else noErr)
        QTest::addColumn<QString>("expected");
        QTest::addColumn<bool>("handled");

        QTest::newRow("rest declines, caller passes it on") << -9874 << true << "D2 D1 D2<--9874 WA1 A1" << false;
        QTest::newRow("rest handles") << 0 << true << "D2 D1 D2<-0" << true;
        QTest::newRow("rest declines, caller handles") << -9874 << false << "D2 D1 D2<--9874" << true;
        QTest::newRow("rest fails with an error: absorbed") << -50 << true << "D2 D1 D2<--9874 WA1 A1" << false;
    }
    void callNextContinuesChain()
    {
        QFETCH(int, innerResult);
        QFETCH(bool, returnNext);
        QFETCH(QString, expected);
        QFETCH(bool, handled);
        QCOMPARE(int(eventNotHandledErr), -9874);

        Chain chain;
        chain.install("A1");
        chain.install("WA1");
        chain.install("D1", innerResult);
        chain.install("D2").action = [&](EventHandlerCallRef call, EventRef event) {
            const OSStatus next = CallNextEventHandler(call, event);
            gSeen << QStringLiteral("D2<-%1").arg(next);
            return returnNext ? next : OSStatus(noErr);
        };
        QCOMPARE(Private::DispatchEventToCallbacks(makeEvent(kWindowA)), handled);
        QCOMPARE(gSeen.join(u' '), expected);
    }

    void handlerRemovesItselfMidChain()
    {
        Chain chain;
        chain.install("D1");
        TestHandler& d2 = chain.install("D2");
        chain.install("D3");
        d2.action = [&](EventHandlerCallRef, EventRef) {
            RemoveEventHandler(d2.ref);
            return OSStatus(eventNotHandledErr);
        };
        Private::DispatchEventToCallbacks(makeEvent(nullptr));
        Private::DispatchEventToCallbacks(makeEvent(nullptr));
        QCOMPARE(gSeen, (QStringList{"D3", "D2", "D1", "D3", "D1"}));
        QCOMPARE(Private::HandlerList::instance().count(), 2);
        QCOMPARE(m_listener->count(), 0);
    }

    // Removing handlers not yet reached, next in line, or in a later pass; then installing
    // new ones: a new dispatcher handler waits for the next event, a new application
    // handler is already in line for this event's application pass.
    void handlersChangeMidChain()
    {
        Chain chain;
        TestHandler& d1 = chain.install("D1");
        TestHandler& a1 = chain.install("A1");
        TestHandler& d2 = chain.install("D2");
        TestHandler& d3 = chain.install("D3");
        d3.action = [&](EventHandlerCallRef, EventRef) {
            RemoveEventHandler(d1.ref);
            RemoveEventHandler(d2.ref);
            RemoveEventHandler(a1.ref);
            return OSStatus(eventNotHandledErr);
        };
        Private::DispatchEventToCallbacks(makeEvent(nullptr));
        QCOMPARE(gSeen, QStringList{"D3"});
        QCOMPARE(Private::HandlerList::instance().count(), 1);

        RemoveEventHandler(d3.ref);
        gSeen.clear();
        chain.install("A1");
        chain.install("D1");
        bool installed = false;
        chain.install("D2").action = [&](EventHandlerCallRef, EventRef) {
            if (!std::exchange(installed, true)) {
                chain.install("D-new");
                chain.install("A-new");
            }
            return OSStatus(eventNotHandledErr);
        };
        Private::DispatchEventToCallbacks(makeEvent(nullptr));
        gSeen << "--";
        Private::DispatchEventToCallbacks(makeEvent(nullptr));
        QCOMPARE(gSeen, (QStringList{"D2", "D1", "A-new", "A1", "--", "D-new", "D2", "D1", "A-new", "A1"}));
    }

    void sendEventToEventTarget()
    {
        Chain chain;
        TestHandler& a1 = chain.install("A1");
        chain.install("D1");
        EventQueueItemSmartPtr event = makeEvent(nullptr);
        // The target is not used: the chain always starts at the dispatcher.
        QCOMPARE(SendEventToEventTarget(event.get(), GetApplicationEventTarget()), OSStatus(noErr));
        a1.result = noErr;
        QCOMPARE(SendEventToEventTarget(event.get(), GetWindowEventTarget(kWindowB)), OSStatus(noErr));
        QCOMPARE(gSeen, (QStringList{"D1", "A1", "D1", "A1"}));
        QCOMPARE(SendEventToEventTarget(nullptr, GetApplicationEventTarget()), OSStatus(eventInternalErr));
    }

    void removeUnknownHandler()
    {
        Chain chain;
        EventHandlerRef stale = chain.install("D1").ref;
        QCOMPARE(RemoveEventHandler(stale), OSStatus(noErr));
        QCOMPARE(m_listener->count(), 0);
        // Removing it again is reported and otherwise harmless.
        QCOMPARE(RemoveEventHandler(stale), OSStatus(noErr));
        QCOMPARE(m_listener->count(), 1);
        QVERIFY(m_listener->questions()[0].text.contains("IsValidEventHandler(inHandlerRef)"));
        QCOMPARE(RemoveEventHandler(nullptr), OSStatus(paramErr));
        QCOMPARE(m_listener->count(), 1);
        Private::DispatchEventToCallbacks(makeEvent(nullptr));
        QVERIFY(gSeen.isEmpty());
    }

    // A null output pointer is allowed; the handler still gets installed.
    void nullOutputReference()
    {
        const EventTargetRef app = GetApplicationEventTarget();
        TestHandler h;
        h.name = "A-noref";
        QCOMPARE(InstallEventHandler(app, recordingHandler, 0, nullptr, &h, nullptr), OSStatus(noErr));
        Private::DispatchEventToCallbacks(makeEvent(nullptr));
        QCOMPARE(gSeen, QStringList{"A-noref"});
        QCOMPARE(Private::RemoveWindowEventHandlers(kWindowA), 0);
        // Remove it through the list: the test kept no reference.
        for (int p = Private::HandlerList::instance().frontPosition(); p >= 0; --p)
            if (Private::EventHandler* e = Private::HandlerList::instance().at(p))
                RemoveEventHandler(e);
    }

    void nestingOnlyOutermostReenables()
    {
        QStringList states{blockerState()};
        {
            ScopedCarbonEventsBlocker outer("outer");
            states << blockerState();
            {
                ScopedCarbonEventsBlocker inner("inner");
                states << blockerState();
                {
                    ScopedCarbonEventsBlocker innermost(Private::MainEventQueue(), "innermost");
                    states << blockerState();
                }
                states << blockerState();
            }
            states << blockerState();
        }
        states << blockerState();
        QCOMPARE(states, (QStringList{"enabled", "disabled", "disabled", "disabled", "disabled", "disabled",
                                      "enabled"}));
        QCOMPARE(m_listener->count(), 0);
        ScopedCarbonEventsBlocker none(nullptr, "none"); // no queue: blocks nothing
        QVERIFY(!none.isBlocked());
        QCOMPARE(blockerState(), QStringLiteral("enabled"));
    }

    void explicitUnblock()
    {
        QStringList states;
        {
            ScopedCarbonEventsBlocker outer("outer");
            {
                ScopedCarbonEventsBlocker inner("inner");
                inner.Unblock();
                QVERIFY(!inner.isBlocked());
                states << blockerState();
            } // the destructor of an unblocked blocker restores nothing
            states << blockerState();
            outer.Unblock();
            states << blockerState();
            QCOMPARE(m_listener->count(), 0);
            outer.Unblock(); // once too often: reported, no effect
            QCOMPARE(m_listener->count(), 1);
            QVERIFY(m_listener->questions()[0].text.contains("m_blocked"));
            states << blockerState();
        }
        states << blockerState();
        QCOMPARE(states, (QStringList{"disabled", "disabled", "enabled", "enabled", "enabled"}));
    }

    // Events queued while blocked produce no wake-up; the outermost end raises one. Sending
    // one to the handlers meanwhile is reported.
    void blockedQueueAndDispatch()
    {
        Chain chain;
        chain.install("D1", noErr);
        QStringList marks;
        {
            ScopedCarbonEventsBlocker outer("outer");
            {
                ScopedCarbonEventsBlocker inner("inner");
                Private::ScheduleEvent(makeEvent(nullptr), Private::EventQueueItem::NoMerge);
                marks << QString::number(gMainEventQueue.hasQueueChangeEvent());
            }
            marks << QString::number(gMainEventQueue.hasQueueChangeEvent());
            QCOMPARE(m_listener->count(), 0);
            SendEventToEventTarget(
                EventTest::makeItem(Private::kEventClassVelmar, Private::kEventVelmarResized).get(),
                GetApplicationEventTarget());
        }
        marks << QString::number(gMainEventQueue.hasQueueChangeEvent());
        QCOMPARE(marks, (QStringList{"0", "0", "1"}));
        QCOMPARE(gMainEventQueue.count(), UInt32(1));
        QCOMPARE(m_listener->count(), 1);
        QVERIFY(m_listener->questions()[0].text.contains("!gMainEventQueue.CheckCarbonEventsDisabled()"));
    }

private:
    std::unique_ptr<VelmarTest::ScriptedAutomationListener> m_listener;
};

VELMAR_TEST_MAIN(tst_Handlers)
#include "tst_handlers.moc"
