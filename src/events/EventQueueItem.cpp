// Construction, reference counting, the live-object limit, predicates and merging.
#include "events/EventQueueItem.h"

#include "events/EventQueueHooks.h"

#include <Velmar/Diagnostics.h>

#include <cstring>

namespace Velmar::Private {

namespace {

// A runaway producer shows itself early: the warning fires at 5000 live items and at each
// doubling, up to a limit that stops growing once it passes 100000.
int sLiveCount = 0;
int sLiveLimit = 5000;
constexpr int kLiveLimitGrowthCeiling = 100000;

QString fourCharText(UInt32 code)
{
    QString text;
    for (int shift = 24; shift >= 0; shift -= 8) {
        const char c = char((code >> shift) & 0xFF);
        text += (c >= 0x20 && c < 0x7F) ? QChar::fromLatin1(c) : QChar(u'.');
    }
    return text;
}

} // namespace

EventQueueItem::EventQueueItem()
{
    refCount = 1;
    hostRefCount = 0;
    clearFields();
    LiveHandles<EventQueueItem>::instance().add(this);
    noteCreated();
}

EventQueueItem::EventQueueItem(const EventQueueItem& other) : queuePlace{}
{
    *this = other;
    refCount = 1;
    hostRefCount = 0;
    LiveHandles<EventQueueItem>::instance().add(this);
    noteCreated();
}

EventQueueItem::~EventQueueItem()
{
    VELMAR_ASSERT(refCount == 0, "refCount == 0");
    LiveHandles<EventQueueItem>::instance().remove(this);
    --sLiveCount;
}

void EventQueueItem::noteCreated()
{
    ++sLiveCount;
    if (sLiveCount >= sLiveLimit) {
        if (sLiveLimit < kLiveLimitGrowthCeiling)
            sLiveLimit *= 2;
        velmar_assert("sLiveCount < sLiveLimit", __FILE__, __LINE__, __func__,
                      "Too many events were created");
    }
}

int EventQueueItem::LiveCount()
{
    return sLiveCount;
}

int EventQueueItem::LiveLimit()
{
    return sLiveLimit;
}

EventQueueItem* EventQueueItem::Create()
{
    return new EventQueueItem;
}

EventQueueItem* EventQueueItem::Duplicate() const
{
    return new EventQueueItem(*this);
}

// Wheel axis, wheel delta and the direct object are left alone on purpose: only the
// converters of the kinds that carry them write them.
void EventQueueItem::clearFields()
{
    skipFlush = 0;
    revoked = 0;
    notSynchronized = 0;
    window = nullptr;
    eventClass = 0;
    eventKind = 0;
    attributes = 0;
    when = 0;
    where = Point{0, 0};
    message = 0;
    mouseButton = 0;
    windowPart = 0;
    currentBounds = Rect{0, 0, 0, 0};
    keyMessage = 0;
    keyCode = 0;
    charCode = 0;
    textUnit = 0;
    modifiers = 0;
    qtKey = 0;
    qtModifiers = 0;
}

void EventQueueItem::clear()
{
    clearFields();
}

EventQueueItem& EventQueueItem::operator=(const EventQueueItem& other)
{
    if (this != &other) {
        const QueuePlace place = queuePlace;
        std::memcpy(static_cast<void*>(this), static_cast<const void*>(&other), sizeof(EventQueueItem));
        queuePlace = place;
    }
    return *this;
}

void EventQueueItem::AddRef()
{
    ++refCount;
}

void EventQueueItem::Release()
{
    --refCount;
    if (!VELMAR_ASSERT(refCount >= 0, "refCount >= 0"))
        return;
    if (refCount == 0)
        delete this;
}

void EventQueueItem::Merge(const EventQueueItem* other)
{
    if (!other)
        return;
    VELMAR_ASSERT(eventClass == other->eventClass, "eventClass == other->eventClass");
    VELMAR_ASSERT(eventKind == other->eventKind, "eventKind == other->eventKind");
    if (other->skipFlush)
        skipFlush = 1;
}

EventQueueItem::MergePolicy EventQueueItem::GuessMergePolicy() const
{
    if (eventClass == kEventClassWindow
        && (eventKind == kEventWindowUpdate || eventKind == kEventWindowActivated
            || eventKind == kEventWindowDeactivated))
        return ReplaceQueued;
    return NoMerge;
}

bool EventQueueItem::IsSynchronized() const
{
    if (notSynchronized)
        return false;
    if (eventClass == kEventClassVelmar)
        return eventKind != kEventVelmarCloseRequested && eventKind != kEventVelmarMenuTriggered;
    if (eventClass == kEventClassWindow)
        return eventKind == kEventWindowBoundsChanged;
    if (eventClass == kEventClassMouse)
        return eventKind == kEventMouseDragged;
    return false;
}

bool EventQueueItem::isUpdateEvent() const
{
    return isClass(kEventClassWindow, kEventWindowUpdate);
}

bool EventQueueItem::isMoveResizeEvent() const
{
    return isClass(kEventClassVelmar, kEventVelmarResized) || isClass(kEventClassVelmar, kEventVelmarMoved)
        || isClass(kEventClassWindow, kEventWindowBoundsChanged);
}

bool EventQueueItem::isActivateEvent() const
{
    return isClass(kEventClassWindow, kEventWindowActivated)
        || isClass(kEventClassWindow, kEventWindowDeactivated);
}

// A plain move (kind 5) is deliberately not a mouse event here.
bool EventQueueItem::isMouseEvent() const
{
    return eventClass == kEventClassMouse
        && (eventKind == kEventMouseDown || eventKind == kEventMouseUp || eventKind == kEventMouseDragged);
}

// Mouse down counts so that a down event may carry wheel parameters.
bool EventQueueItem::isMouseWheelEvent() const
{
    return eventClass == kEventClassMouse
        && (eventKind == 0 || eventKind == kEventMouseDown || eventKind == kEventMouseWheelMoved);
}

QString EventQueueItem::EventClassAndKindToString(UInt32 eventClass, UInt32 eventKind)
{
    return QStringLiteral(", class=%1 [%2]").arg(fourCharText(eventClass)).arg(eventClass, 8)
         + QStringLiteral(", kind=%1 [%2]").arg(fourCharText(eventKind)).arg(eventKind, 8);
}

QString EventQueueItem::toString() const
{
    return QStringLiteral("[ptr=%1").arg(quintptr(this), 0, 16)
         + QStringLiteral(", win=%1 [%2]").arg(WindowTitle(window)).arg(quintptr(window), 0, 16)
         + EventClassAndKindToString(eventClass, eventKind) + QStringLiteral("]");
}

} // namespace Velmar::Private
