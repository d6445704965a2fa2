// The classic event calls: the library's events as classic records (the window pointer in the
// message of update and activate events), frame and menu-bar clicks in between, and the
// polling calls that put pending drawing on the screen before they answer.
#include "classic/ClassicPrivate.h"

#include <algorithm>
#include <cstring>

namespace VelmarClassic {

namespace {

Velmar::EventRecord gLastEvent{};

void convert(const Velmar::EventRecord& in, EventRecord* out)
{
    out->what = in.what;
    out->when = in.when;
    out->where = in.where;
    out->modifiers = in.modifiers;
    if (in.what == updateEvt || in.what == activateEvt)
        out->message = reinterpret_cast<unsigned long>(classicWindow(in.window));
    else
        out->message = in.message;
    if (in.what == activateEvt)
        if (PortLink* link = windowLink(in.window))
            pushWindowRecord(*link);
}

// Sleeps a little at a time, so that a frame click arriving meanwhile ends the wait.
constexpr Velmar::UInt32 kSlice = 2;

} // namespace

Velmar::EventRecord* lastLibraryEvent()
{
    return &gLastEvent;
}

void flushAllPorts()
{
    Velmar::RepaintDirtyPorts(true);
}

} // namespace VelmarClassic

using namespace VelmarClassic;

Boolean WaitNextEvent(short eventMask, EventRecord* theEvent, unsigned long sleep, RgnHandle)
{
    if (!VELMAR_ASSERT(theEvent, "theEvent != NULL"))
        return false;
    ensureStarted();
    finishClick();
    const Velmar::UInt32 start = Velmar::TickCount();
    const Velmar::UInt32 limit = Velmar::UInt32(std::min<unsigned long>(sleep, 0x7FFFFFFFUL));
    for (;;) {
        if (takeFrameClick(theEvent, eventMask))
            return true;
        const Velmar::UInt32 elapsed = Velmar::TickCount() - start;
        const Velmar::UInt32 slice = elapsed < limit ? std::min(limit - elapsed, kSlice) : 0;
        Velmar::EventRecord e{};
        if (Velmar::WaitNextEvent(Velmar::UInt16(eventMask), &e, slice, nullptr)) {
            gLastEvent = e;
            convert(e, theEvent);
            return true;
        }
        if (takeFrameClick(theEvent, eventMask))
            return true;
        if (Velmar::TickCount() - start >= limit) {
            convert(e, theEvent);
            return false;
        }
    }
}

Boolean GetNextEvent(short eventMask, EventRecord* theEvent)
{
    return WaitNextEvent(eventMask, theEvent, 0, nullptr);
}

Boolean EventAvail(short eventMask, EventRecord* theEvent)
{
    if (!VELMAR_ASSERT(theEvent, "theEvent != NULL"))
        return false;
    ensureStarted();
    if ((eventMask & mDownMask) && frameClickWaiting()) {
        std::memset(theEvent, 0, sizeof *theEvent);
        theEvent->what = mouseDown;
        theEvent->when = Velmar::TickCount();
        return true;
    }
    Velmar::EventRecord e{};
    const Boolean found = Velmar::EventAvail(Velmar::UInt16(eventMask), &e);
    convert(e, theEvent);
    return found;
}

OSErr PostEvent(short eventNum, long eventMsg)
{
    ensureStarted();
    return Velmar::PostEvent(Velmar::UInt16(eventNum), Velmar::UInt32(eventMsg));
}

void FlushEvents(short whichMask, short stopMask)
{
    ensureStarted();
    Velmar::FlushEvents(Velmar::UInt16(whichMask), Velmar::UInt16(stopMask));
}

void SetEventMask(short mask)
{
    Velmar::SetEventMask(Velmar::UInt16(mask));
}

Boolean Button()
{
    ensureStarted();
    flushAllPorts();
    return Velmar::Button();
}

Boolean StillDown()
{
    ensureStarted();
    flushAllPorts();
    return Velmar::StillDown();
}

Boolean WaitMouseUp()
{
    ensureStarted();
    flushAllPorts();
    return Velmar::WaitMouseUp();
}

void GetMouse(Point* mouseLoc)
{
    if (!VELMAR_ASSERT(mouseLoc, "mouseLoc != NULL"))
        return;
    ensureStarted();
    flushAllPorts();
    currentLink(); // the library's current port is the classic one
    Velmar::GetMouse(mouseLoc);
}

unsigned long TickCount()
{
    return Velmar::TickCount();
}

void GetKeys(KeyMap theKeys)
{
    if (!VELMAR_ASSERT(theKeys, "theKeys != NULL"))
        return;
    ensureStarted();
    Velmar::KeyMap keys{};
    Velmar::GetKeys(keys);
    std::memcpy(theKeys, keys, sizeof(KeyMap));
}

unsigned long GetDblTime()
{
    return Velmar::GetDblTime();
}

unsigned long GetCaretTime()
{
    return 32;
}

void SystemTask()
{
    flushAllPorts();
}
