// The Carbon dispatch blocker: nesting, the queue's disabled flag and what it suppresses.
#include "TestSupport.h"

#include "events/EventDispatch.h"
#include "events/EventQueue.h"
#include "events/EventQueueHooks.h"
#include "events/HandlerList.h"

#include <Velmar/CarbonEventHandlers.h>
#include <Velmar/MacErrors.h>

#include <memory>

using namespace Velmar;
using Private::EventQueueItem;
using Private::EventQueueItemSmartPtr;
using Private::gMainEventQueue;

namespace {

QStringList gSeen;

QString state()
{
    return gMainEventQueue.CheckCarbonEventsDisabled() ? QStringLiteral("disabled")
                                                       : QStringLiteral("enabled");
}

OSStatus takingHandler(EventHandlerCallRef, EventRef event, void*)
{
    gSeen << QStringLiteral("handler:%1").arg(GetEventKind(event));
    return noErr;
}

EventQueueItemSmartPtr resizedEvent()
{
    // Resize events are synchronized: dispatched at once while a waiter runs.
    EventQueueItemSmartPtr item = EventQueueItemSmartPtr::Create();
    item->eventClass = Private::kEventClassVelmar;
    item->eventKind = Private::kEventVelmarResized;
    return item;
}

bool waiterActive()
{
    return true;
}

} // namespace

class tst_Blocker : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void init()
    {
        gSeen.clear();
        m_listener = std::make_unique<VelmarTest::ScriptedAutomationListener>(QStringList{},
                                                                              QStringLiteral("Ignore"));
    }
    void cleanup()
    {
        QCOMPARE(state(), QStringLiteral("enabled"));
        gMainEventQueue.clearAll();
        QCoreApplication::sendPostedEvents();
        m_listener.reset();
    }

    void nestingOnlyOutermostReenables()
    {
        QStringList states{state()};
        {
            ScopedCarbonEventsBlocker outer("outer");
            states << state();
            {
                ScopedCarbonEventsBlocker inner("inner");
                states << state();
                {
                    ScopedCarbonEventsBlocker innermost(Private::MainEventQueue(), "innermost");
                    states << state();
                }
                states << state();
            }
            states << state();
        }
        states << state();
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
                states << state();
            } // the destructor of an unblocked blocker restores nothing
            states << state();
            outer.Unblock();
            states << state();
            QCOMPARE(m_listener->count(), 0);
            outer.Unblock(); // once too often: reported, no effect
            QCOMPARE(m_listener->count(), 1);
            QVERIFY(m_listener->questions()[0].text.contains("m_blocked"));
            states << state();
            QCOMPARE(QString::fromLatin1(outer.name()), QStringLiteral("outer"));
        }
        states << state();
        QCOMPARE(states, (QStringList{"disabled", "disabled", "enabled", "enabled", "enabled"}));
    }

    void nullQueueBlocksNothing()
    {
        ScopedCarbonEventsBlocker blocker(nullptr, "none");
        QVERIFY(!blocker.isBlocked());
        QCOMPARE(state(), QStringLiteral("enabled"));
    }

    // Events queued while blocked produce no wake-up; the outermost end raises one.
    void wakeUpOnlyWhenReenabled()
    {
        QStringList marks;
        {
            ScopedCarbonEventsBlocker outer("outer");
            {
                ScopedCarbonEventsBlocker inner("inner");
                EventQueueItemSmartPtr item = EventQueueItemSmartPtr::Create();
                item->eventClass = kEventClassMouse;
                item->eventKind = kEventMouseDown;
                Private::ScheduleEvent(item, EventQueueItem::NoMerge);
                marks << QString::number(gMainEventQueue.hasQueueChangeEvent());
            }
            marks << QString::number(gMainEventQueue.hasQueueChangeEvent());
        }
        marks << QString::number(gMainEventQueue.hasQueueChangeEvent());
        QCOMPARE(marks, (QStringList{"0", "0", "1"}));
        QCOMPARE(gMainEventQueue.count(), UInt32(1));
    }

    // With a waiter running, synchronized events go straight to the handlers, except
    // while blocked, when they are queued instead and marked as such.
    void synchronizedDispatchSuppressedWhileBlocked()
    {
        const Private::WaiterHooks old = Private::SetWaiterHooks({&waiterActive, nullptr, nullptr});
        EventHandlerRef ref = nullptr;
        QCOMPARE(InstallEventHandler(GetEventDispatcherTarget(), takingHandler, 0, nullptr, nullptr, &ref),
                 OSStatus(noErr));

        EventQueueItemSmartPtr blockedItem = resizedEvent();
        {
            ScopedCarbonEventsBlocker blocker("resize");
            Private::ScheduleEvent(blockedItem, EventQueueItem::NoMerge);
            gSeen << QStringLiteral("queued:%1").arg(gMainEventQueue.count());
        }
        gSeen << "unblocked";
        Private::ScheduleEvent(resizedEvent(), EventQueueItem::NoMerge);
        gSeen << QStringLiteral("queued:%1").arg(gMainEventQueue.count());

        QCOMPARE(gSeen, (QStringList{"queued:1", "unblocked",
                                     QStringLiteral("handler:%1").arg(Private::kEventVelmarResized),
                                     "queued:1"}));
        QVERIFY(blockedItem->notSynchronized);
        QVERIFY(!blockedItem->IsSynchronized());

        RemoveEventHandler(ref);
        Private::SetWaiterHooks(old);
        QCOMPARE(m_listener->count(), 0);
    }

    void dispatchWhileBlockedIsReported()
    {
        EventHandlerRef ref = nullptr;
        InstallEventHandler(GetEventDispatcherTarget(), takingHandler, 0, nullptr, nullptr, &ref);
        {
            ScopedCarbonEventsBlocker blocker("send");
            SendEventToEventTarget(resizedEvent().get(), GetApplicationEventTarget());
        }
        QCOMPARE(m_listener->count(), 1);
        QVERIFY(m_listener->questions()[0].text.contains("!gMainEventQueue.CheckCarbonEventsDisabled()"));
        RemoveEventHandler(ref);
    }

private:
    std::unique_ptr<VelmarTest::ScriptedAutomationListener> m_listener;
};

VELMAR_TEST_MAIN(tst_Blocker)
#include "tst_blocker.moc"
