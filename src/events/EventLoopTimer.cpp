#include "events/EventLoopTimer.h"

#include "events/EventQueue.h"
#include "events/TimerRegistry.h"
#include "foundation/Lifetime.h"
#include "host/Replaceable.h"

#include <QCoreApplication>
#include <QDeadlineTimer>
#include <QTimerEvent>

namespace Velmar::Private {

namespace {

Replaceable<RepaintDirtyPortsHook> gRepaintDirtyPorts(nullptr);

qint64 monotonicMs()
{
    return QDeadlineTimer::current().deadline();
}

QString callbackText(VelmarEventLoopTimer::Callback callback)
{
    return QStringLiteral("0x%1").arg(quintptr(reinterpret_cast<void*>(callback)), 0, 16);
}

} // namespace

RepaintDirtyPortsHook SetRepaintDirtyPortsHook(RepaintDirtyPortsHook hook)
{
    return gRepaintDirtyPorts.set(hook);
}

void repaintDirtyPorts(int flags)
{
    if (RepaintDirtyPortsHook repaint = gRepaintDirtyPorts.get())
        repaint(flags);
}

VelmarEventLoopTimer::VelmarEventLoopTimer(Callback callback, void* userData, int intervalMs)
    : m_callback(callback), m_userData(userData), m_interval(intervalMs),
      m_firstPhaseDone(true), m_firstDelay(intervalMs)
{
    setObjectName(QStringLiteral("VelmarEventLoopTimer(msec=%1, callback=%2)")
                      .arg(intervalMs)
                      .arg(callbackText(callback)));
    start();
}

VelmarEventLoopTimer::VelmarEventLoopTimer(Callback callback, void* userData, int firstDelayMs,
                                           int intervalMs)
    : m_callback(callback), m_userData(userData), m_interval(intervalMs),
      m_firstPhaseDone(false), m_firstDelay(firstDelayMs)
{
    setObjectName(QStringLiteral("VelmarEventLoopTimer(fireDelay=%1, intervalDelay=%2, callback=%3)")
                      .arg(firstDelayMs)
                      .arg(intervalMs)
                      .arg(callbackText(callback)));
    start();
}

VelmarEventLoopTimer::~VelmarEventLoopTimer()
{
    stop();
}

void VelmarEventLoopTimer::start()
{
    if (m_timerId != 0)
        return;
    if (!m_firstPhaseDone) {
        m_timerId = startTimer(qMax(0, m_firstDelay));
        m_firstPhaseDone = true;
    } else {
        m_timerId = startTimer(qMax(0, m_interval));
    }
}

void VelmarEventLoopTimer::stop()
{
    if (m_timerId == 0)
        return;
    killTimer(m_timerId);
    m_timerId = 0;
}

void VelmarEventLoopTimer::fireSoon()
{
    QCoreApplication::postEvent(this, new QTimerEvent(m_timerId));
    m_lastFire -= m_interval;
}

bool VelmarEventLoopTimer::isDue(qint64 now) const
{
    if (!m_hasFired || now < m_lastFire)
        return true;
    // Qt schedules each timeout from the previous one, not from when the callback ran, so
    // a timeout can arrive a little less than one interval after the recorded firing.
    const qint64 slack = m_interval / 10;
    return now - m_lastFire + slack >= m_interval;
}

void VelmarEventLoopTimer::timerEvent(QTimerEvent* event)
{
    if (event->timerId() != m_timerId || gMainEventQueue.CheckCarbonEventsDisabled())
        return;
    const qint64 now = monotonicMs();
    if (!isDue(now))
        return;
    m_lastFire = now;
    m_hasFired = true;

    // The procedure may remove this very timer; the registry then defers the deletion until
    // this call is done.
    KeepAlive keep(this);
    m_firing = true;
    {
        HostCallScope hostCode;
        m_callback(this, m_userData);
    }
    m_firing = false;

    repaintDirtyPorts(0);
    MainTimerRegistry().resume();
}

} // namespace Velmar::Private
