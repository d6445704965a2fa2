// Qt timers that fire while Carbon dispatch is blocked are held back by the application
// object and re-posted once when the event loop timers resume.
#include "events_support.h"

#include "events/EventDispatch.h"
#include "events/EventQueue.h"
#include "events/TimerRegistry.h"

#include <Velmar/Application.h>
#include <Velmar/CarbonEventHandlers.h>
#include <Velmar/MacErrors.h>

#include <QTimerEvent>

#include <memory>

using namespace Velmar;
using Private::EventQueueItemSmartPtr;
using Private::MainTimerRegistry;

namespace {

// What happened, in order; a run of the same entry shows once.
QStringList gSeen;

// Logs its timer events and counts them.
class Probe : public QObject {
public:
    explicit Probe(QString name) : m_name(std::move(name)) {}
    int received = 0;

protected:
    void timerEvent(QTimerEvent*) override
    {
        ++received;
        EventTest::noteOnce(gSeen, m_name);
    }

private:
    QString m_name;
};

OSStatus takingHandler(EventHandlerCallRef, EventRef, void*)
{
    gSeen << QStringLiteral("handler");
    return noErr;
}

void spin()
{
    for (int i = 0; i < 20; ++i)
        QCoreApplication::processEvents(QEventLoop::AllEvents);
}

} // namespace

class tst_TimerPostpone : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void initTestCase() { QVERIFY(AQtApplication::instance()); }

    void init()
    {
        gSeen.clear();
        InstallEventHandler(GetApplicationEventTarget(), takingHandler, 0, nullptr, nullptr, &m_handler);
    }
    void cleanup()
    {
        RemoveEventHandler(m_handler);
        QVERIFY(MainTimerRegistry().isEnabled());
        QVERIFY(!Private::gMainEventQueue.CheckCarbonEventsDisabled());
    }

    void repostedExactlyOnceAfterUnblocking()
    {
        Probe probe("probe");
        int id = probe.startTimer(0);
        QTRY_VERIFY(probe.received > 0);
        int beforeBlock = 0;
        {
            ScopedCarbonEventsBlocker blocker("postpone");
            gSeen << "blocked";
            beforeBlock = probe.received;
            spin(); // the timer fires many times: each is swallowed, recorded once
            {
                ScopedCarbonEventsBlocker inner("inner");
                spin();
            }
            spin();
            QCOMPARE(probe.received, beforeBlock);
            probe.killTimer(id); // from now on only a re-posted event can arrive
        }
        gSeen << "unblocked";
        spin(); // unblocking alone re-posts nothing: the timers resume at the next dispatch
        Private::DispatchEventToCallbacks(EventQueueItemSmartPtr::Create());
        spin();
        Private::DispatchEventToCallbacks(EventQueueItemSmartPtr::Create()); // a second resume
        spin();
        QCOMPARE(gSeen, (QStringList{"probe", "blocked", "unblocked", "handler", "probe", "handler"}));
        QCOMPARE(probe.received, beforeBlock + 1);
    }

    void receiverGoneWhileBlockedIsSkipped()
    {
        auto gone = std::make_unique<Probe>("gone");
        Probe kept("kept");
        gone->startTimer(0);
        const int keptId = kept.startTimer(0);
        QTRY_VERIFY(gone->received > 0 && kept.received > 0);
        {
            ScopedCarbonEventsBlocker blocker("postpone");
            spin();
            gone.reset();
            kept.killTimer(keptId);
            gSeen.clear();
        }
        MainTimerRegistry().resume();
        spin();
        QCOMPARE(gSeen, QStringList{"kept"});
    }

    // The library's own timers stop while blocked; the Qt loop keeps running meanwhile.
    void eventLoopTimersUnderTheApplication()
    {
        EventLoopTimerRef timer = nullptr;
        InstallEventLoopTimer(GetMainEventLoop(), 0, 0, [](EventLoopTimerRef, void*) { EventTest::noteOnce(gSeen, "carbon"); }, nullptr, &timer);
        QTRY_VERIFY(!gSeen.isEmpty());
        {
            ScopedCarbonEventsBlocker blocker("timers");
            gSeen << "blocked";
            spin();
        }
        gSeen << "unblocked";
        spin();
        Private::DispatchEventToCallbacks(EventQueueItemSmartPtr::Create());
        QTRY_VERIFY(gSeen.last() == QStringLiteral("carbon"));
        QCOMPARE(gSeen, (QStringList{"carbon", "blocked", "unblocked", "handler", "carbon"}));
        RemoveEventLoopTimer(timer);
    }

private:
    EventHandlerRef m_handler = nullptr;
};

VELMAR_APP_TEST_MAIN(tst_TimerPostpone)
#include "tst_timerpostpone.moc"
