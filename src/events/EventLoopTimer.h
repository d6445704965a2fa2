// One Carbon event loop timer: a QObject driven by a Qt timer.
#pragma once

#include <Velmar/MacTypes.h>

#include <QObject>

class QTimerEvent;

namespace Velmar::Private {

class VelmarEventLoopTimer : public QObject {
    Q_OBJECT
public:
    using Callback = void (*)(VelmarEventLoopTimer* timer, void* userData);

    // A plain timer: first firing after one interval, then every interval.
    VelmarEventLoopTimer(Callback callback, void* userData, int intervalMs);
    // A two-phase timer: the Qt timer runs at the first delay; callbacks are thinned to at
    // most one per interval (an approximation of a distinct first delay).
    VelmarEventLoopTimer(Callback callback, void* userData, int firstDelayMs, int intervalMs);
    ~VelmarEventLoopTimer() override;

    void start();
    void stop();
    bool isRunning() const { return m_timerId != 0; }
    int timerId() const { return m_timerId; }
    int interval() const { return m_interval; }
    int firstDelay() const { return m_firstDelay; }
    bool firstPhaseDone() const { return m_firstPhaseDone; }
    bool isFiring() const { return m_firing; }

    // Posts a timer event and makes the last firing one interval older, so that the
    // callback runs at the next event processing whether or not it is due.
    void fireSoon();

protected:
    void timerEvent(QTimerEvent* event) override;

private:
    bool isDue(qint64 now) const;

    Callback m_callback;
    void* m_userData;
    int m_timerId = 0;
    int m_interval;
    qint64 m_lastFire = 0; // monotonic milliseconds
    bool m_hasFired = false;
    bool m_firstPhaseDone;
    int m_firstDelay;
    bool m_firing = false;
};

// The windows layer sets this to repaint dirty ports after a timer procedure ran; until
// then timers draw nothing by themselves. Returns the hook it replaces.
using RepaintDirtyPortsHook = void (*)(int flags);
RepaintDirtyPortsHook SetRepaintDirtyPortsHook(RepaintDirtyPortsHook hook);
// Calls the installed hook (1: copy to the screen at once); nothing without windows.
void repaintDirtyPorts(int flags);

} // namespace Velmar::Private
