#include "events/TimerRegistry.h"

#include "events/EventQueue.h"
#include "events/EventLoopTimer.h"
#include "foundation/Lifetime.h"

#include <Velmar/Application.h>

#include <QCoreApplication>

namespace Velmar::Private {

namespace {

// Qt timer events that arrived while dispatch was blocked were held back by the
// application object; they go out again before the timers restart.
void dispatchPostponedTimers()
{
    if (AQtApplication* app = AQtApplication::instance())
        app->DispatchPostponedTimers();
}

} // namespace

// There is one queue, so one registry serves it.
TimerRegistry& EventQueue::timerRegistry()
{
    static TimerRegistry sRegistry;
    return sRegistry;
}

TimerRegistry& MainTimerRegistry()
{
    return gMainEventQueue.timerRegistry();
}

TimerRegistry::~TimerRegistry()
{
    // Timer objects can only be deleted while Qt's thread data is still around.
    if (QCoreApplication::instance())
        qDeleteAll(timers());
}

QList<VelmarEventLoopTimer*> TimerRegistry::timers() const
{
    QList<VelmarEventLoopTimer*> list;
    list.reserve(qsizetype(m_byOrder.size()));
    for (const auto& [order, timer] : m_byOrder)
        list.append(timer);
    return list;
}

bool TimerRegistry::contains(const VelmarEventLoopTimer* timer) const
{
    return timer && m_order.contains(timer);
}

// A new timer runs at once unless a blocker is active right now: timers stopped by a blocker
// that has ended since wait for the next dispatch to restart, but a timer made after it
// never belonged to it.
void TimerRegistry::add(VelmarEventLoopTimer* timer)
{
    const quint64 order = m_nextOrder++;
    m_byOrder.emplace(order, timer);
    m_order.insert(timer, order);
    if (gMainEventQueue.CheckCarbonEventsDisabled())
        timer->stop();
}

bool TimerRegistry::remove(VelmarEventLoopTimer* timer)
{
    const auto found = timer ? m_order.constFind(timer) : m_order.constEnd();
    if (found == m_order.constEnd())
        return false;
    m_byOrder.erase(found.value());
    m_order.erase(found);
    if (timer->isFiring()) {
        // Removed from inside its own procedure: delete once its timer event is done.
        timer->stop();
        deleteWhenFree(timer);
    } else {
        delete timer;
    }
    return true;
}

void TimerRegistry::suspend()
{
    if (!m_enabled)
        return;
    m_enabled = false;
    for (const auto& [order, timer] : m_byOrder)
        timer->stop();
}

void TimerRegistry::resume()
{
    if (m_enabled)
        return;
    dispatchPostponedTimers();
    m_enabled = true;
    // A procedure run from a re-posted timer event may install or remove timers: walk a copy.
    const QList<VelmarEventLoopTimer*> installed = timers();
    for (VelmarEventLoopTimer* timer : installed) {
        if (contains(timer))
            timer->start();
    }
}

} // namespace Velmar::Private
