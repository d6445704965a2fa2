// Every blocking call (WaitNextEvent, ReceiveNextEvent, EventAvail, RunApplicationEventLoop)
// waits through one of these: a nested Qt event loop that runs until a matching event is
// queued or the timeout passes. Waiters nest strictly; only the top-most one's filter acts.
#pragma once

#include "events/EventQueueItem.h"

#include <QObject>

#include <memory>

class QEventLoop;

namespace Velmar::Private {

class VelmarEventWaiter : public QObject {
    Q_OBJECT

public:
    enum Mode {
        Plain = 0,       // ReceiveNextEvent, EventAvail, FlushEvents
        Classic = 1,     // the WaitNextEvent family: other events go to the Carbon handlers
        Application = 2, // RunApplicationEventLoop: every event goes to the Carbon handlers
    };

    explicit VelmarEventWaiter(Mode mode = Plain);
    ~VelmarEventWaiter() override;
    VelmarEventWaiter(const VelmarEventWaiter&) = delete;
    VelmarEventWaiter& operator=(const VelmarEventWaiter&) = delete;

    Mode mode() const;
    static VelmarEventWaiter* topMost();
    // Read-only views for the inspector: the waiter this one interrupted (the stack runs from
    // topMost() through these), how many event types it waits for (0: any), and whether its
    // nested loop is running.
    VelmarEventWaiter* interrupted() const;
    UInt32 typeCount() const;
    bool isLoopRunning() const;

    // The wait itself. On success `out` holds the event (taken out of the queue when `pull`).
    // eventLoopTimedOutErr when nothing matching came within `timeout` seconds (negative:
    // wait for ever; 0: one pass, no waiting).
    OSStatus receive(UInt32 count, const EventTypeSpec* list, double timeout, bool pull,
                     EventQueueItemSmartPtr* out);
    // The queue search: in classic mode everything the caller did not ask for is handed to
    // the Carbon handlers and dropped. True when an item was found (kept in the waiter).
    bool ProcessCarbonEvents(UInt32 count, const EventTypeSpec* list, bool pull);
    // Runs Qt's application loop with every queued event dispatched to the Carbon handlers.
    void runApplicationLoop();

    // What the application-wide filter forwards to the top-most waiter.
    bool filterEvent(QObject* receiver, QEvent* event);

    // The null-event timer ends timed waits; the inspector can switch it off.
    static void setNullEventTimerEnabled(bool on);
    static bool nullEventTimerEnabled();

private Q_SLOTS:
    void sltNullTimerTimeout();

private:
    struct Record;
    std::unique_ptr<Record> m_d;
};

// Builds the keyboard tables and anything else a wait needs first; hooks the waiters into
// the queue (flushes, synchronized dispatch) and the application-loop probe. Idempotent.
void prepareWaiting();

} // namespace Velmar::Private
