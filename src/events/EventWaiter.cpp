#include "events/EventWaiter.h"

#include "events/AppEventLoop.h"
#include "events/DispatchStack.h"
#include "events/EventDispatch.h"
#include "events/EventLoopTimer.h"
#include "events/EventQueue.h"
#include "events/EventQueueHooks.h"
#include "events/KeyCodeTables.h"
#include "events/TimerRegistry.h"
#include "foundation/Lifetime.h"

#include <Velmar/Application.h>
#include <Velmar/CarbonEventHandlers.h>
#include <Velmar/Diagnostics.h>
#include <Velmar/FeatureFlags.h>
#include <Velmar/MacErrors.h>

#include <QCoreApplication>
#include <QEventLoop>
#include <QPointer>
#include <QTimer>

#include <cmath>
#include <limits>

namespace Velmar::Private {

struct VelmarEventWaiter::Record {
    bool filterInstalled = false;
    UInt32 typeCount = 0;
    const EventTypeSpec* typeList = nullptr;
    bool pull = false;
    QEventLoop* pEventLoop = nullptr;
    EventQueueItemSmartPtr eventQueueItem;
    AQtWindow* foundWindow = nullptr; // the found item's window when it was found
    Mode mode = Plain;
    VelmarEventWaiter* previous = nullptr;
};

namespace {

VelmarEventWaiter* gTopMostWaiter = nullptr;
bool gNullEventTimerEnabled = true;

// Forwards every event the application delivers to the top-most waiter.
class TopMostFilter : public QObject {
public:
    using QObject::QObject;
    bool eventFilter(QObject* receiver, QEvent* event) override
    {
        return gTopMostWaiter && gTopMostWaiter->filterEvent(receiver, event);
    }
};

void installTopMostFilter()
{
    static QPointer<TopMostFilter> sFilter;
    QCoreApplication* app = QCoreApplication::instance();
    if (sFilter || !app)
        return;
    sFilter = new TopMostFilter(app);
    app->installEventFilter(sFilter);
}

bool listNamesInput(UInt32 count, const EventTypeSpec* list)
{
    for (UInt32 i = 0; i < count; ++i) {
        if (list[i].eventClass == kEventClassMouse || list[i].eventClass == kEventClassKeyboard)
            return true;
    }
    return false;
}

// Seconds to the null-event timer's milliseconds: truncated to 32 bits as the classic call
// did, so that sleeps too long for them wrap to a negative count and end at once; at least 1.
int timerMilliseconds(double seconds)
{
    const double ms = std::trunc(seconds * 1000.0);
    const qint64 wide = ms >= 9.2e18 ? std::numeric_limits<qint64>::max() : qint64(ms);
    const auto wrapped = static_cast<SInt32>(static_cast<UInt32>(wide));
    return wrapped < 1 ? 1 : int(wrapped);
}

void* beginFlushWaiter()
{
    return new VelmarEventWaiter(VelmarEventWaiter::Plain);
}

void endFlushWaiter(void* waiter)
{
    delete static_cast<VelmarEventWaiter*>(waiter);
}

bool waiterActive()
{
    return gTopMostWaiter != nullptr;
}

bool inApplicationLoop()
{
    return gTopMostWaiter && gTopMostWaiter->mode() == VelmarEventWaiter::Application;
}

} // namespace

void prepareWaiting()
{
    static bool sPrepared = false;
    if (sPrepared)
        return;
    sPrepared = true;
    buildKeyboardTables();
    WaiterHooks hooks;
    hooks.isWaiterActive = waiterActive;
    hooks.beginFlushWaiter = beginFlushWaiter;
    hooks.endFlushWaiter = endFlushWaiter;
    SetWaiterHooks(hooks);
    SetApplicationLoopProbe(inApplicationLoop);
}

VelmarEventWaiter::VelmarEventWaiter(Mode mode) : m_d(std::make_unique<Record>())
{
    prepareWaiting();
    m_d->mode = mode;
    m_d->previous = gTopMostWaiter;
    gTopMostWaiter = this;
}

VelmarEventWaiter::~VelmarEventWaiter()
{
    VELMAR_ASSERT(!m_d->filterInstalled, "!m_d->filterInstalled");
    VELMAR_ASSERT(m_d->pEventLoop == nullptr, "NULL == m_d->pEventLoop");
    // Out of order: reported, and the chain is mended rather than left dangling.
    if (VELMAR_ASSERT(gTopMostWaiter == this, "gTopMostWaiter == this")) {
        gTopMostWaiter = m_d->previous;
        return;
    }
    for (VelmarEventWaiter* w = gTopMostWaiter; w; w = w->m_d->previous) {
        if (w->m_d->previous == this) {
            w->m_d->previous = m_d->previous;
            break;
        }
    }
}

VelmarEventWaiter::Mode VelmarEventWaiter::mode() const
{
    return m_d->mode;
}

VelmarEventWaiter* VelmarEventWaiter::topMost()
{
    return gTopMostWaiter;
}

VelmarEventWaiter* VelmarEventWaiter::interrupted() const
{
    return m_d->previous;
}

UInt32 VelmarEventWaiter::typeCount() const
{
    return m_d->typeCount;
}

bool VelmarEventWaiter::isLoopRunning() const
{
    return m_d->pEventLoop != nullptr;
}

void VelmarEventWaiter::setNullEventTimerEnabled(bool on)
{
    gNullEventTimerEnabled = on;
}

bool VelmarEventWaiter::nullEventTimerEnabled()
{
    return gNullEventTimerEnabled;
}

bool VelmarEventWaiter::ProcessCarbonEvents(UInt32 count, const EventTypeSpec* list, bool pull)
{
    EventQueue& queue = gMainEventQueue;
    const auto matches = [count, list](const EventQueueItem* item) {
        return MatchesEventTypes(list, count, item);
    };
    const bool acceptsUpdates = MatchesEventTypes(list, count, kEventClassWindow, kEventWindowUpdate);
    const auto firstPendingUpdate = []() -> EventQueueItem* {
        if (!LegacyEventProcessing())
            return nullptr;
        return FindPendingUpdateEvent([](EventQueueItem*, void*) { return true; }, nullptr);
    };
    // Handlers may not run while a blocker is active: then nothing is handed to them.
    const auto dispatch = [](const EventQueueItemSmartPtr& item) {
        return !gMainEventQueue.CheckCarbonEventsDisabled() && DispatchEventToCallbacks(item);
    };

    m_d->eventQueueItem.reset();
    if (!pull) {
        EventQueueItem* found = queue.findFirstMatching(list, count);
        if (!found && acceptsUpdates)
            found = firstPendingUpdate();
        m_d->eventQueueItem = found;
    } else {
        for (;;) {
            if (m_d->mode == Classic) {
                // A classic loop sees only what it asked for; the Carbon handlers see the rest,
                // once each: the items leave the queue before any handler (which may wait
                // itself) runs.
                // One at a time, each leaving the queue just before its handlers run: what an
                // earlier handler revoked (its window disposed) or took is no longer queued
                // and is never delivered; what handlers post waits for the next look.
                const std::vector<EventQueueItemSmartPtr> queued = queue.items();
                for (const EventQueueItemSmartPtr& item : queued) {
                    if (matches(item.get()) && item->isEventRecordCompatible())
                        continue;
                    if (queue.remove(item.get()) && !item->IsSynchronized())
                        dispatch(item);
                }
            }
            EventQueueItemSmartPtr item = queue.takeFirstMatching(list, count);
            if (!item && acceptsUpdates) {
                item = firstPendingUpdate();
                if (item)
                    ClearPendingUpdateEvents(
                        [](EventQueueItem* pending, void* taken) { return pending == taken; },
                        item.get());
            }
            if (!item)
                return false;
            if (m_d->mode == Classic && !item->IsSynchronized() && dispatch(item))
                continue; // a handler took it: look again
            m_d->eventQueueItem = item;
            break;
        }
    }
    if (!m_d->eventQueueItem)
        return false;
    if (!VELMAR_ASSERT(!m_d->eventQueueItem->revoked, "!m_d->eventQueueItem->revoked")) {
        queue.remove(m_d->eventQueueItem.get());
        m_d->eventQueueItem.reset();
        return false;
    }
    return true;
}

OSStatus VelmarEventWaiter::receive(UInt32 count, const EventTypeSpec* list, double timeout,
                                    bool pull, EventQueueItemSmartPtr* out)
{
    VELMAR_ASSERT(!m_d->filterInstalled, "!m_d->filterInstalled");
    VELMAR_ASSERT(m_d->pEventLoop == nullptr, "!m_d->pEventLoop");
    if (out)
        out->reset();
    repaintDirtyPorts(1);

    QEventLoop::ProcessEventsFlags flags = QEventLoop::AllEvents;
    if (count > 0 && !listNamesInput(count, list))
        flags = QEventLoop::ExcludeUserInputEvents; // a wait for other events leaves input be
    const bool alwaysProcess = AlwaysProcessEventsInReceiveNextEvent(kFeatureFlagQuery) != 0;
    if (alwaysProcess)
        gMainEventQueue.ProcessNonCarbonEvents(flags);

    bool found = ProcessCarbonEvents(count, list, pull);
    if (timeout == kEventDurationNoWait) {
        if (!alwaysProcess) {
            const UInt32 before = gMainEventQueue.count();
            gMainEventQueue.ProcessNonCarbonEvents(flags);
            if (!found && gMainEventQueue.count() > before)
                found = ProcessCarbonEvents(count, list, pull);
        }
    } else {
        MainTimerRegistry().resume();
        if (!found) {
            const bool deferredDelete = DeferrredDeleteInProcessNonCarbonEvents(kFeatureFlagQuery) != 0;
            m_d->filterInstalled = true;
            installTopMostFilter();
            QEventLoop loop;
            m_d->pEventLoop = &loop;
            m_d->typeList = list;
            m_d->typeCount = count;
            m_d->pull = pull;
            for (;;) {
                m_d->eventQueueItem.reset();
                QTimer timer;
                if (timeout > 0 && gNullEventTimerEnabled) {
                    connect(&timer, &QTimer::timeout, this, &VelmarEventWaiter::sltNullTimerTimeout);
                    timer.setSingleShot(true);
                    timer.start(timerMilliseconds(timeout));
                }
                // Qt 6 has no flag for it: objects deleted later go now, as the old flag did
                // (not while host code, and so library code for them, is on the stack).
                if (deferredDelete)
                    flushDeferredDeletions();
                // Events queued while nobody waited must wake this loop too.
                gMainEventQueue.RaiseQueueChangedSignal();
                loop.exec(flags);
                timer.stop();
                if (!m_d->eventQueueItem)
                    break;
                const EventQueueItemSmartPtr item = m_d->eventQueueItem;
                PopDispatchedItem(item.get());
                // Its window's disposal, while the item was on its way, forgot the window:
                // the item never reaches the caller and the wait goes on.
                if (!item->revoked && item->window == m_d->foundWindow)
                    break;
                m_d->eventQueueItem.reset();
            }
            m_d->filterInstalled = false;
            m_d->pEventLoop = nullptr;
            m_d->typeList = nullptr;
            m_d->typeCount = 0;
            found = m_d->eventQueueItem != nullptr;
        }
    }
    if (!found || !m_d->eventQueueItem)
        return eventLoopTimedOutErr;
    if (out)
        *out = m_d->eventQueueItem;
    m_d->eventQueueItem.reset();
    return noErr;
}

void VelmarEventWaiter::sltNullTimerTimeout()
{
    if (m_d->filterInstalled && m_d->pEventLoop)
        m_d->pEventLoop->exit(0);
}

bool VelmarEventWaiter::filterEvent(QObject*, QEvent* event)
{
    const bool active = m_d->mode == Application || (m_d->filterInstalled && m_d->pEventLoop);
    if (!active)
        return false;
    EventQueue& queue = gMainEventQueue;
    if (event->type() != EventQueueChangedEvent::eventType()) {
        // Items queued without a signal are noticed at the next event of any kind.
        if (!queue.hasQueueChangeEvent() && (!queue.isEmpty() || CountPendingUpdateEvents()))
            queue.RaiseQueueChangedSignal();
        return false;
    }
    static_cast<EventQueueChangedEvent*>(event)->alreadyCounted = true;
    queue.ClearQueueChangeEventMark();
    if (queue.CheckCarbonEventsDisabled() || m_d->eventQueueItem)
        return true;

    if (m_d->mode == Application) {
        // Every event goes to the handlers; synchronized ones already went when scheduled.
        while (ProcessCarbonEvents(0, nullptr, true)) {
            const EventQueueItemSmartPtr item = m_d->eventQueueItem;
            m_d->eventQueueItem.reset();
            if (!item->IsSynchronized() && !queue.CheckCarbonEventsDisabled())
                DispatchEventToCallbacks(item);
        }
        repaintDirtyPorts(1);
        return true;
    }
    if (!ProcessCarbonEvents(m_d->typeCount, m_d->typeList, m_d->pull))
        return true;
    VELMAR_ASSERT(!!m_d->eventQueueItem, "!!m_d->eventQueueItem");
    // On the dispatch stack while it travels, so that its window's disposal reaches it.
    m_d->foundWindow = m_d->eventQueueItem->window;
    PushDispatchedItem(m_d->eventQueueItem);
    if (m_d->pEventLoop)
        m_d->pEventLoop->exit(0);
    return true;
}

void VelmarEventWaiter::runApplicationLoop()
{
    m_d->filterInstalled = true;
    m_d->pull = true;
    installTopMostFilter();
    MainTimerRegistry().resume();
    gMainEventQueue.RaiseQueueChangedSignal();
    if (AQtApplication::instance())
        AQtApplication::exec();
    else if (QCoreApplication::instance())
        QCoreApplication::exec();
    m_d->filterInstalled = false;
    m_d->eventQueueItem.reset();
}

} // namespace Velmar::Private
