// What the queue needs from layers above it (windows, waiters). Each is one function
// pointer that the owning layer installs; unset, it answers as if that layer had nothing
// to say (no window is being deleted, no update events are pending, no waiter runs).
#pragma once

#include <Velmar/CarbonEvents.h>

#include <QString>

namespace Velmar::Private {

class EventQueueItem;

using PendingUpdatePredicate = bool (*)(EventQueueItem* updateEvent, void* data);

struct WindowEventHooks {
    // Window deletion pending: its new events are dropped.
    bool (*isDeletePending)(AQtWindow* window) = nullptr;
    // Whether the window's update region is empty (unset: empty).
    bool (*isUpdateRegionEmpty)(AQtWindow* window) = nullptr;
    // Windows keep their own pending update event while legacy event processing is on.
    UInt32 (*countPendingUpdateEvents)() = nullptr;
    // The first window's pending update event for which pred is true (windows in list order).
    EventQueueItem* (*findPendingUpdateEvent)(PendingUpdatePredicate pred, void* data) = nullptr;
    // Clears every pending update event for which pred is true.
    void (*clearPendingUpdateEvents)(PendingUpdatePredicate pred, void* data) = nullptr;
    // Clears this window's pending update event.
    void (*clearPendingUpdateEvent)(AQtWindow* window) = nullptr;
    // The window's title, for debugging texts.
    QString (*windowTitle)(AQtWindow* window) = nullptr;
    // Overrides the SupportLegacyMacEventProcessing feature flag (tests, DirectQtDrawing).
    bool (*legacyEventProcessing)() = nullptr;
};

struct WaiterHooks {
    // A waiter (a nested wait loop) is running.
    bool (*isWaiterActive)() = nullptr;
    // Begins and ends a plain waiter around a flush.
    void* (*beginFlushWaiter)() = nullptr;
    void (*endFlushWaiter)(void* waiter) = nullptr;
};

// Install (or with a default-constructed struct, remove) the hooks. Returns the old ones.
WindowEventHooks SetWindowEventHooks(const WindowEventHooks& hooks);
WaiterHooks SetWaiterHooks(const WaiterHooks& hooks);
const WindowEventHooks& windowEventHooks();
const WaiterHooks& waiterHooks();

// Thin wrappers answering the defaults when a hook is unset.
bool WindowIsDeletePending(AQtWindow* window);
bool WindowUpdateRegionIsEmpty(AQtWindow* window);
UInt32 CountPendingUpdateEvents();
EventQueueItem* FindPendingUpdateEvent(PendingUpdatePredicate pred, void* data);
void ClearPendingUpdateEvents(PendingUpdatePredicate pred, void* data);
void ClearPendingUpdateEvent(AQtWindow* window);
QString WindowTitle(AQtWindow* window);
bool EventWaiterActive();

// Window update events stay with their windows instead of the queue.
bool LegacyEventProcessing();

} // namespace Velmar::Private
