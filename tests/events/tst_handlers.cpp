// Carbon handler chains: every case records which handler saw which event, in order, and
// compares the whole sequence. Then the dispatch blocker: nesting, the queue's disabled
// flag and what it suppresses.
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

// One installed test handler: logs "name" or "name:kind" and answers `result`, after
// running its optional action.
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

class Chain {
public:
    ~Chain()
    {
        for (auto& h : m_handlers) {
            if (h->ref && Private::HandlerList::instance().contains(h->ref))
                RemoveEventHandler(h->ref);
        }
    }

    TestHandler& install(const QString& name, EventTargetRef target,
                         OSStatus result = eventNotHandledErr,
                         QList<EventTypeSpec> types = {})
    {
        m_handlers.push_back(std::make_unique<TestHandler>());
        TestHandler& h = *m_handlers.back();
        h.name = name;
        h.result = result;
        const OSStatus err = InstallEventHandler(target, NewEventHandlerUPP(recordingHandler),
                                                 UInt32(types.size()), types.constData(), &h, &h.ref);
        if (err != noErr)
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

EventTargetRef target(const QString& name)
{
    if (name.startsWith(u'D'))
        return GetEventDispatcherTarget();
    if (name.startsWith(u'A'))
        return GetApplicationEventTarget();
    return GetWindowEventTarget(name.startsWith(QStringLiteral("WB")) ? kWindowB : kWindowA);
}

QString blockerState()
{
    return gMainEventQueue.CheckCarbonEventsDisabled() ? QStringLiteral("disabled") : QStringLiteral("enabled");
}

} // namespace

class tst_Handlers : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void init()
    {
        gSeen.clear();
        m_listener = EventTest::ignoreAssertions();
    }
    void cleanup()
    {
        QCOMPARE(Private::HandlerList::instance().count(), 0);
        QCOMPARE(blockerState(), QStringLiteral("enabled"));
        gMainEventQueue.clearAll();
        QCoreApplication::sendPostedEvents();
        m_listener.reset();
    }

    // Installation order of handlers named by target (A application, D dispatcher, WA/WB
    // windows); each answers with its result. The event belongs to window A.
    void chainOrder_data()
    {
        QTest::addColumn<QStringList>("installed");
        QTest::addColumn<QList<int>>("results");
        QTest::addColumn<QStringList>("expected");
        QTest::addColumn<bool>("handled");

        const int no = eventNotHandledErr;
        QTest::newRow("dispatcher, window, application; newest first")
            << QStringList{"A1", "D1", "WA1", "D2", "A2", "WA2"} << QList<int>{no, no, no, no, no, no}
            << QStringList{"D2", "D1", "WA2", "WA1", "A2", "A1"} << false;
        QTest::newRow("other window never sees the event")
            << QStringList{"WB1", "WA1", "WB2"} << QList<int>{no, no, no}
            << QStringList{"WA1"} << false;
        QTest::newRow("first noErr stops the chain")
            << QStringList{"D1", "D2", "A1"} << QList<int>{no, noErr, no}
            << QStringList{"D2"} << true;
        QTest::newRow("window handler takes it, application never runs")
            << QStringList{"A1", "WA1", "D1"} << QList<int>{no, noErr, no}
            << QStringList{"D1", "WA1"} << true;
        QTest::newRow("errors are absorbed like eventNotHandledErr")
            << QStringList{"A1", "WA1", "D1", "D2"} << QList<int>{noErr, int(paramErr), -1, int(unimpErr)}
            << QStringList{"D2", "D1", "WA1", "A1"} << true;
        QTest::newRow("only errors: not handled")
            << QStringList{"A1", "D1"} << QList<int>{int(paramErr), int(memFullErr)}
            << QStringList{"D1", "A1"} << false;
        QTest::newRow("empty chain") << QStringList{} << QList<int>{} << QStringList{} << false;
    }
    void chainOrder()
    {
        QFETCH(QStringList, installed);
        QFETCH(QList<int>, results);
        QFETCH(QStringList, expected);
        QFETCH(bool, handled);

        Chain chain;
        for (int i = 0; i < installed.size(); ++i)
            chain.install(installed[i], target(installed[i]), results[i]);
        QCOMPARE(Private::DispatchEventToCallbacks(makeEvent(kWindowA)), handled);
        QCOMPARE(gSeen, expected);
        QCOMPARE(m_listener->count(), 0);
    }

    void typeListsFilterEvents()
    {
        Chain chain;
        chain.install("D-any", GetEventDispatcherTarget()).logKind = true;
        chain.install("D-up", GetEventDispatcherTarget(), eventNotHandledErr,
                      {{kEventClassMouse, kEventMouseUp}, {kEventClassKeyboard, kEventRawKeyUp}})
            .logKind = true;
        for (UInt32 kind : {kEventMouseDown, kEventMouseUp, kEventMouseMoved})
            Private::DispatchEventToCallbacks(makeEvent(nullptr, kEventClassMouse, kind));
        Private::DispatchEventToCallbacks(makeEvent(nullptr, kEventClassKeyboard, kEventRawKeyUp));
        QCOMPARE(gSeen, (QStringList{"D-any:1", "D-up:2", "D-any:2", "D-any:5", "D-up:3", "D-any:3"}));
    }

    // What a handler does after calling CallNextEventHandler, and what the rest answers.
    void callNextContinuesChain_data()
    {
        QTest::addColumn<int>("innerResult");  // D1's answer
        QTest::addColumn<bool>("returnNext");  // D2 returns CallNext's result (else noErr)
        QTest::addColumn<QStringList>("expected");
        QTest::addColumn<bool>("handled");

        QTest::newRow("rest declines, caller passes it on")
            << int(eventNotHandledErr) << true
            << QStringList{"D2", "D1", "D2<-" + QString::number(eventNotHandledErr), "WA1", "A1"} << false;
        QTest::newRow("rest handles")
            << int(noErr) << true << QStringList{"D2", "D1", "D2<-0"} << true;
        QTest::newRow("rest declines, caller handles")
            << int(eventNotHandledErr) << false
            << QStringList{"D2", "D1", "D2<-" + QString::number(eventNotHandledErr)} << true;
        QTest::newRow("rest fails with an error: absorbed")
            << int(paramErr) << true
            << QStringList{"D2", "D1", "D2<-" + QString::number(eventNotHandledErr), "WA1", "A1"} << false;
    }
    void callNextContinuesChain()
    {
        QFETCH(int, innerResult);
        QFETCH(bool, returnNext);
        QFETCH(QStringList, expected);
        QFETCH(bool, handled);

        Chain chain;
        chain.install("A1", GetApplicationEventTarget());
        chain.install("WA1", GetWindowEventTarget(kWindowA));
        chain.install("D1", GetEventDispatcherTarget(), innerResult);
        chain.install("D2", GetEventDispatcherTarget()).action = [&](EventHandlerCallRef call,
                                                                    EventRef event) {
            const OSStatus next = CallNextEventHandler(call, event);
            gSeen << QStringLiteral("D2<-%1").arg(next);
            return returnNext ? next : OSStatus(noErr);
        };
        QCOMPARE(Private::DispatchEventToCallbacks(makeEvent(kWindowA)), handled);
        QCOMPARE(gSeen, expected);
    }

    void callNextWithForeignEventAsserts()
    {
        Chain chain;
        EventQueueItemSmartPtr other = makeEvent(nullptr);
        chain.install("D1", GetEventDispatcherTarget());
        chain.install("D2", GetEventDispatcherTarget()).action = [&](EventHandlerCallRef call, EventRef) {
            return CallNextEventHandler(call, other.get());
        };
        Private::DispatchEventToCallbacks(makeEvent(nullptr));
        QCOMPARE(gSeen, (QStringList{"D2", "D1"}));
        QCOMPARE(m_listener->count(), 1);
        QVERIFY(m_listener->questions()[0].text.contains("inCallRef->item().get() == inEvent"));
    }

    void handlerRemovesItselfMidChain()
    {
        Chain chain;
        chain.install("D1", GetEventDispatcherTarget());
        TestHandler& d2 = chain.install("D2", GetEventDispatcherTarget());
        chain.install("D3", GetEventDispatcherTarget());
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

    void handlerRemovesOthersMidChain()
    {
        Chain chain;
        TestHandler& d1 = chain.install("D1", GetEventDispatcherTarget());
        TestHandler& a1 = chain.install("A1", GetApplicationEventTarget());
        TestHandler& d2 = chain.install("D2", GetEventDispatcherTarget());
        chain.install("D3", GetEventDispatcherTarget()).action = [&](EventHandlerCallRef, EventRef) {
            RemoveEventHandler(d1.ref); // not reached yet in this pass
            RemoveEventHandler(d2.ref); // next in line
            RemoveEventHandler(a1.ref); // a later pass
            return OSStatus(eventNotHandledErr);
        };
        Private::DispatchEventToCallbacks(makeEvent(nullptr));
        QCOMPARE(gSeen, QStringList{"D3"});
        QCOMPARE(Private::HandlerList::instance().count(), 1);
    }

    void handlerInstallsMidChain()
    {
        Chain chain;
        chain.install("A1", GetApplicationEventTarget());
        chain.install("D1", GetEventDispatcherTarget());
        bool installed = false;
        chain.install("D2", GetEventDispatcherTarget()).action = [&](EventHandlerCallRef, EventRef) {
            if (!installed) {
                installed = true;
                // A new dispatcher handler waits for the next event; a new application
                // handler is already in line for this event's application pass.
                chain.install("D-new", GetEventDispatcherTarget());
                chain.install("A-new", GetApplicationEventTarget());
            }
            return OSStatus(eventNotHandledErr);
        };
        Private::DispatchEventToCallbacks(makeEvent(nullptr));
        gSeen << "--";
        Private::DispatchEventToCallbacks(makeEvent(nullptr));
        QCOMPARE(gSeen, (QStringList{"D2", "D1", "A-new", "A1", "--", "D-new", "D2", "D1", "A-new", "A1"}));
    }

    void nestedDispatchFromHandler()
    {
        Chain chain;
        chain.install("A1", GetApplicationEventTarget()).logKind = true;
        TestHandler& d1 = chain.install("D1", GetEventDispatcherTarget());
        d1.logKind = true;
        d1.action = [&](EventHandlerCallRef, EventRef event) {
            if (GetEventKind(event) == kEventMouseDown) {
                Velmar::SendEventToEventTarget(makeEvent(nullptr, kEventClassMouse, kEventMouseUp).get(),
                                               GetApplicationEventTarget());
            }
            return OSStatus(eventNotHandledErr);
        };
        Private::DispatchEventToCallbacks(makeEvent(nullptr, kEventClassMouse, kEventMouseDown));
        QCOMPARE(gSeen, (QStringList{"D1:1", "D1:2", "A1:2", "A1:1"}));
    }

    void sendEventToEventTarget()
    {
        Chain chain;
        TestHandler& a1 = chain.install("A1", GetApplicationEventTarget());
        chain.install("D1", GetEventDispatcherTarget());
        EventQueueItemSmartPtr event = makeEvent(nullptr);
        // The target is not used: the chain always starts at the dispatcher.
        QCOMPARE(SendEventToEventTarget(event.get(), GetApplicationEventTarget()), OSStatus(noErr));
        a1.result = noErr;
        QCOMPARE(SendEventToEventTarget(event.get(), GetWindowEventTarget(kWindowB)), OSStatus(noErr));
        QCOMPARE(gSeen, (QStringList{"D1", "A1", "D1", "A1"}));
        QCOMPARE(SendEventToEventTarget(nullptr, GetApplicationEventTarget()), OSStatus(eventInternalErr));
    }

    void windowDisposedDuringDispatchCountsAsHandled()
    {
        Chain chain;
        chain.install("A1", GetApplicationEventTarget());
        chain.install("WA1", GetWindowEventTarget(kWindowA)).action = [&](EventHandlerCallRef, EventRef) {
            Private::FlushEventReferences(kWindowA);
            return OSStatus(eventNotHandledErr);
        };
        EventQueueItemSmartPtr event = makeEvent(kWindowA);
        QVERIFY(Private::DispatchEventToCallbacks(event));
        QCOMPARE(gSeen, (QStringList{"WA1", "A1"}));
        QVERIFY(event->window == nullptr);
        QCOMPARE(Private::HandlerList::instance().count(), 1); // the window's handlers went with it
    }

    void removeWindowHandlers()
    {
        Chain chain;
        chain.install("WA1", GetWindowEventTarget(kWindowA));
        chain.install("WB1", GetWindowEventTarget(kWindowB));
        chain.install("WA2", GetWindowEventTarget(kWindowA));
        chain.install("A1", GetApplicationEventTarget());
        QCOMPARE(Private::RemoveWindowEventHandlers(kWindowA), 2);
        QCOMPARE(Private::RemoveWindowEventHandlers(nullptr), 0);
        Private::DispatchEventToCallbacks(makeEvent(kWindowA));
        Private::DispatchEventToCallbacks(makeEvent(kWindowB));
        QCOMPARE(gSeen, (QStringList{"A1", "WB1", "A1"}));
    }

    void removeUnknownHandler()
    {
        Chain chain;
        TestHandler& d1 = chain.install("D1", GetEventDispatcherTarget());
        EventHandlerRef stale = d1.ref;
        QCOMPARE(RemoveEventHandler(stale), OSStatus(noErr));
        QCOMPARE(m_listener->count(), 0);
        // Removing it again is reported and otherwise harmless.
        QCOMPARE(RemoveEventHandler(stale), OSStatus(noErr));
        QCOMPARE(m_listener->count(), 1);
        QVERIFY(m_listener->questions()[0].text.contains("count > 0"));
        QCOMPARE(RemoveEventHandler(nullptr), OSStatus(paramErr));
        QCOMPARE(m_listener->count(), 1);
        Private::DispatchEventToCallbacks(makeEvent(nullptr));
        QVERIFY(gSeen.isEmpty());
    }

    void invalidArguments()
    {
        EventHandlerRef ref = reinterpret_cast<EventHandlerRef>(0x1);
        const EventTypeSpec spec{kEventClassMouse, kEventMouseDown};
        QCOMPARE(InstallEventHandler(GetApplicationEventTarget(), nullptr, 0, nullptr, nullptr, &ref),
                 OSStatus(paramErr));
        QVERIFY(ref == nullptr);
        QCOMPARE(InstallEventHandler(GetWindowEventTarget(nullptr), recordingHandler, 1, &spec, nullptr,
                                     nullptr),
                 OSStatus(paramErr));
        QCOMPARE(InstallEventHandler(EventTargetRef{}, recordingHandler, 0, nullptr, nullptr, nullptr),
                 OSStatus(paramErr));
        QCOMPARE(InstallEventHandler(GetApplicationEventTarget(), recordingHandler, 2, nullptr, nullptr,
                                     nullptr),
                 OSStatus(paramErr));
        QCOMPARE(CallNextEventHandler(nullptr, nullptr), OSStatus(paramErr));
        QVERIFY(!Private::DispatchEventToCallbacks(EventQueueItemSmartPtr()));

        // A null output pointer is allowed; the handler still gets installed.
        TestHandler h;
        h.name = "A-noref";
        QCOMPARE(InstallEventHandler(GetApplicationEventTarget(), recordingHandler, 0, nullptr, &h,
                                     nullptr),
                 OSStatus(noErr));
        Private::DispatchEventToCallbacks(makeEvent(nullptr));
        QCOMPARE(gSeen, QStringList{"A-noref"});
        QCOMPARE(Private::RemoveWindowEventHandlers(kWindowA), 0);
        // Remove it through the list: the test kept no reference.
        for (int p = Private::HandlerList::instance().frontPosition(); p >= 0; --p)
            if (Private::EventHandler* e = Private::HandlerList::instance().at(p))
                RemoveEventHandler(e);
    }

    void typeListIsCopied()
    {
        QList<EventTypeSpec> types{{kEventClassMouse, kEventMouseUp}};
        TestHandler h;
        h.name = "D";
        EventHandlerRef ref = nullptr;
        QCOMPARE(InstallEventHandler(GetEventDispatcherTarget(), recordingHandler, 1, types.constData(),
                                     &h, &ref),
                 OSStatus(noErr));
        types[0].eventKind = kEventMouseDown; // the caller's list changes afterwards
        Private::DispatchEventToCallbacks(makeEvent(nullptr, kEventClassMouse, kEventMouseDown));
        Private::DispatchEventToCallbacks(makeEvent(nullptr, kEventClassMouse, kEventMouseUp));
        QCOMPARE(gSeen, QStringList{"D"});
        RemoveEventHandler(ref);
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
        QCOMPARE(states, (QStringList{"enabled", "disabled", "disabled", "disabled", "disabled",
                                      "disabled", "enabled"}));
        QCOMPARE(m_listener->count(), 0);
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
            QCOMPARE(QString::fromLatin1(outer.name()), QStringLiteral("outer"));
        }
        states << blockerState();
        QCOMPARE(states, (QStringList{"disabled", "disabled", "enabled", "enabled", "enabled"}));
    }

    void nullQueueBlocksNothing()
    {
        ScopedCarbonEventsBlocker blocker(nullptr, "none");
        QVERIFY(!blocker.isBlocked());
        QCOMPARE(blockerState(), QStringLiteral("enabled"));
    }

    // Events queued while blocked produce no wake-up; the outermost end raises one.
    void wakeUpOnlyWhenReenabled()
    {
        QStringList marks;
        {
            ScopedCarbonEventsBlocker outer("outer");
            {
                ScopedCarbonEventsBlocker inner("inner");
                Private::ScheduleEvent(EventTest::makeItem(kEventClassMouse, kEventMouseDown),
                                       Private::EventQueueItem::NoMerge);
                marks << QString::number(gMainEventQueue.hasQueueChangeEvent());
            }
            marks << QString::number(gMainEventQueue.hasQueueChangeEvent());
        }
        marks << QString::number(gMainEventQueue.hasQueueChangeEvent());
        QCOMPARE(marks, (QStringList{"0", "0", "1"}));
        QCOMPARE(gMainEventQueue.count(), UInt32(1));
    }

    void dispatchWhileBlockedIsReported()
    {
        Chain chain;
        chain.install("D1", GetEventDispatcherTarget(), noErr);
        {
            ScopedCarbonEventsBlocker blocker("send");
            SendEventToEventTarget(
                EventTest::makeItem(Private::kEventClassVelmar, Private::kEventVelmarResized).get(),
                GetApplicationEventTarget());
        }
        QCOMPARE(m_listener->count(), 1);
        QVERIFY(m_listener->questions()[0].text.contains("!gMainEventQueue.CheckCarbonEventsDisabled()"));
    }

private:
    std::unique_ptr<VelmarTest::ScriptedAutomationListener> m_listener;
};

VELMAR_TEST_MAIN(tst_Handlers)
#include "tst_handlers.moc"
