// The one event object of the library: queued, handed to Carbon handlers, read through
// GetEventParameter and flattened into an EventRecord. Reference counted.
#pragma once

#include <Velmar/CarbonEvents.h>
#include <Velmar/Events.h>

#include "foundation/LiveHandles.h"

#include <QString>

namespace Velmar::Private {

// The library's own event classes and kinds (the public ones are in CarbonEvents.h).
enum : UInt32 {
    kEventClassVelmarClassic = FOUR_CHAR_CODE("vlme"), // PostEvent: kind = the classic code
};
using ::Velmar::kEventClassVelmar;
using ::Velmar::kEventVelmarCloseRequested;
using ::Velmar::kEventVelmarMenuTriggered;
using ::Velmar::kEventVelmarMoved;
using ::Velmar::kEventVelmarResized;
using ::Velmar::kEventVelmarUpdateMenus;
using ::Velmar::kEventVelmarZoomed;

// A plain record: fields are public because the converters fill them directly.
// Copying (operator=) copies every field, the reference count included.
class EventQueueItem {
public:
    enum MergePolicy {
        NoMerge = 0,
        GuessMerge = 1,
        MergeIntoQueued = 2,
        ReplaceQueued = 3,
    };

    SInt16 refCount;
    UInt8 skipFlush;       // FlushEvents never removes it; Merge carries it over
    UInt8 revoked;         // its window was disposed while it was queued
    UInt8 notSynchronized; // had to be queued although it would be dispatched at once
    AQtWindow* window;     // 'wind'; opaque here
    UInt32 eventClass;
    UInt32 eventKind;
    UInt32 attributes;     // EventAttributes
    UInt32 when;           // ticks
    Point where;           // 'mloc', global
    UInt32 message;        // classic message of a PostEvent event
    UInt16 mouseButton;    // 'mbtn'
    UInt16 windowPart;     // 'wpar'
    UInt16 wheelAxis;      // 'mwax'; not cleared
    SInt32 wheelDelta;     // 'mwdl'; not cleared
    Rect currentBounds;    // 'crct'
    UInt8 directObject[6]; // '----'; not cleared
    UInt32 keyMessage;     // char code | key code << 8 | native scan code << 16
    UInt32 keyCode;        // 'kcod'
    UInt8 charCode;        // 'kchr'
    UInt16 textUnit;       // the UTF-16 unit of a key event
    UInt32 modifiers;      // 'kmod'
    UInt32 qtKey;
    UInt32 qtModifiers;
    // How many of refCount the host holds (MacCreateEvent, RetainEvent, an event handed out
    // by ReceiveNextEvent): ReleaseEvent may give back only these, never a reference the
    // queue or a handler chain holds.
    UInt16 hostRefCount;
    // Where the queue holds this item: how many entries, and the newest entry's sequence
    // number. Kept by the queue alone; copying an item leaves the target's as they were.
    struct QueuePlace {
        UInt32 entries = 0;
        UInt64 sequence = 0;
    } queuePlace;

    static EventQueueItem* Create();
    EventQueueItem* Duplicate() const;

    // Clears the same fields as construction does; keeps refCount.
    void clear();
    EventQueueItem& operator=(const EventQueueItem& other);

    void AddRef();
    void Release();

    EventRecord toEventRecord() const;
    EventRef toEventRef() { return this; }

    // Takes over other's skip mark; nothing else. Both must be the same class and kind.
    void Merge(const EventQueueItem* other);
    MergePolicy GuessMergePolicy() const;
    // True when the event goes to the Carbon handlers at once instead of waiting queued.
    bool IsSynchronized() const;

    bool isEventRecordCompatible() const;
    bool isNullEvent() const { return eventClass == 0 && eventKind == 0; }
    bool isUpdateEvent() const;
    bool isMoveResizeEvent() const;
    bool isActivateEvent() const;
    bool isMouseEvent() const;
    bool isMouseWheelEvent() const;
    bool isClass(UInt32 cls, UInt32 kind) const { return eventClass == cls && eventKind == kind; }

    static QString EventClassAndKindToString(UInt32 eventClass, UInt32 eventKind);
    QString toString() const;

    // The process-wide count of live items and the count at which the next warning fires.
    static int LiveCount();
    static int LiveLimit();

private:
    EventQueueItem();
    EventQueueItem(const EventQueueItem& other);
    ~EventQueueItem();
    void clearFields();
    static void noteCreated();
};

// A live event: true. Null: false, silently. A freed or made-up one: the assertion
// "IsValidEvent(event)", false.
#define VELMAR_CHECK_EVENT(event) VELMAR_LIVE((event), "IsValidEvent(event)")

// Holds one reference to an item. All internal code passes items through it.
class EventQueueItemSmartPtr {
public:
    EventQueueItemSmartPtr() = default;
    // Adds a reference to `item` (the caller keeps its own).
    EventQueueItemSmartPtr(EventQueueItem* item) : m_item(item) // NOLINT: like a raw pointer
    {
        if (m_item)
            m_item->AddRef();
    }
    EventQueueItemSmartPtr(const EventQueueItemSmartPtr& other) : EventQueueItemSmartPtr(other.m_item) {}
    EventQueueItemSmartPtr(EventQueueItemSmartPtr&& other) noexcept : m_item(other.m_item)
    {
        other.m_item = nullptr;
    }
    ~EventQueueItemSmartPtr() { reset(); }

    EventQueueItemSmartPtr& operator=(const EventQueueItemSmartPtr& other)
    {
        if (other.m_item)
            other.m_item->AddRef();
        EventQueueItem* old = m_item;
        m_item = other.m_item;
        if (old)
            old->Release();
        return *this;
    }
    EventQueueItemSmartPtr& operator=(EventQueueItemSmartPtr&& other) noexcept
    {
        if (this != &other) {
            EventQueueItem* old = m_item;
            m_item = other.m_item;
            other.m_item = nullptr;
            if (old)
                old->Release();
        }
        return *this;
    }

    // Takes over the reference the caller holds (as from Create), adding none.
    static EventQueueItemSmartPtr Adopt(EventQueueItem* item)
    {
        EventQueueItemSmartPtr p;
        p.m_item = item;
        return p;
    }
    // A new item, held only by the returned pointer.
    static EventQueueItemSmartPtr Create() { return Adopt(EventQueueItem::Create()); }

    void reset()
    {
        EventQueueItem* old = m_item;
        m_item = nullptr;
        if (old)
            old->Release();
    }

    EventQueueItem* get() const { return m_item; }
    EventQueueItem* operator->() const { return m_item; }
    EventQueueItem& operator*() const { return *m_item; }
    explicit operator bool() const { return m_item != nullptr; }
    bool operator==(const EventQueueItemSmartPtr& other) const { return m_item == other.m_item; }
    bool operator==(const EventQueueItem* other) const { return m_item == other; }

private:
    EventQueueItem* m_item = nullptr;
};

} // namespace Velmar::Private
