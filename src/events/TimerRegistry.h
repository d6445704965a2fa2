// The event loop timers of the main queue, suspended while Carbon dispatch is blocked.
#pragma once

#include <QList>

namespace Velmar::Private {

class VelmarEventLoopTimer;

class TimerRegistry {
public:
    TimerRegistry() = default;
    ~TimerRegistry();
    TimerRegistry(const TimerRegistry&) = delete;
    TimerRegistry& operator=(const TimerRegistry&) = delete;

    bool isEnabled() const { return m_enabled; }
    const QList<VelmarEventLoopTimer*>& timers() const { return m_timers; }
    bool contains(const VelmarEventLoopTimer* timer) const;

    void add(VelmarEventLoopTimer* timer);
    // Unregisters and deletes the timer; false (and nothing deleted) for an unknown one.
    bool remove(VelmarEventLoopTimer* timer);

    // Stops every timer while Carbon events are disabled.
    void suspend();
    // Re-posts the Qt timer events the application postponed, then restarts every
    // stopped timer. Cheap when nothing is suspended.
    void resume();

private:
    bool m_enabled = true;
    QList<VelmarEventLoopTimer*> m_timers; // installation order
};

TimerRegistry& MainTimerRegistry();

} // namespace Velmar::Private
