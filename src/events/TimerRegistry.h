// The event loop timers of the main queue, suspended while Carbon dispatch is blocked.
#pragma once

#include <QHash>
#include <QList>

#include <map>

namespace Velmar::Private {

class VelmarEventLoopTimer;

class TimerRegistry {
public:
    TimerRegistry() = default;
    ~TimerRegistry();
    TimerRegistry(const TimerRegistry&) = delete;
    TimerRegistry& operator=(const TimerRegistry&) = delete;

    bool isEnabled() const { return m_enabled; }
    // In installation order.
    QList<VelmarEventLoopTimer*> timers() const;
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
    // Installation order by number, and each timer's number: adding, finding and removing
    // stay cheap with thousands installed.
    std::map<quint64, VelmarEventLoopTimer*> m_byOrder;
    QHash<const VelmarEventLoopTimer*, quint64> m_order;
    quint64 m_nextOrder = 0;
};

TimerRegistry& MainTimerRegistry();

} // namespace Velmar::Private
