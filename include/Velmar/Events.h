// Classic Event Manager: event records, posting, flushing, masks and ticks.
#pragma once

#include <Velmar/MacTypes.h>

class QKeyEvent;

namespace Velmar {

class AQtWindow;

using EventMask = UInt16;
using EventModifiers = UInt16;

// The classic record, followed by what the library adds for its own hosts: the target
// window, the UTF-16 unit typed, and the Qt key and modifiers of a key event.
struct EventRecord {
    UInt16 what;
    UInt32 message;
    UInt32 when;        // ticks
    Point where;        // global
    UInt16 modifiers;
    AQtWindow* window;
    UInt16 textUnit;
    UInt32 qtKey;
    UInt32 qtModifiers;
};

using EventRecordPtr = EventRecord*;

// Event codes (`what`).
enum : UInt16 {
    nullEvent = 0,
    mouseDown = 1,
    mouseUp = 2,
    keyDown = 3,
    keyUp = 4,
    autoKey = 5,
    updateEvt = 6,
    diskEvt = 7,
    activateEvt = 8,
    osEvt = 15,
    kHighLevelEvent = 23,
};

// Event masks.
enum : EventMask {
    mDownMask = 0x0002,
    mUpMask = 0x0004,
    keyDownMask = 0x0008,
    keyUpMask = 0x0010,
    autoKeyMask = 0x0020,
    updateMask = 0x0040,
    diskMask = 0x0080,
    activMask = 0x0100,
    highLevelEventMask = 0x0400,
    osMask = 0x8000,
    everyEvent = 0xFFFF,
};

// Modifier bits. Control plays the command key; controlKey is never produced.
enum : EventModifiers {
    activeFlag = 0x0001,
    btnState = 0x0080,
    cmdKey = 0x0100,
    shiftKey = 0x0200,
    alphaLock = 0x0400,
    optionKey = 0x0800,
    controlKey = 0x1000,
    rightShiftKey = 0x2000,
    rightOptionKey = 0x4000,
};

// osEvt messages: the message code sits in the high byte.
enum : UInt32 {
    osEvtMessageMask = 0xFF000000,
    suspendResumeMessage = 0x01,
    resumeFlag = 1,
};

enum : UInt32 {
    charCodeMask = 0x000000FF,
    keyCodeMask = 0x0000FF00,
};

// Queues a classic event of code `eventCode` with `eventMsg` as its message. Always 0.
VELMAR_EXPORT OSErr PostEvent(UInt16 eventCode, UInt32 eventMsg);
// Removes queued events of the types in whichMask but not in stopMask.
VELMAR_EXPORT void FlushEvents(UInt16 whichMask, UInt16 stopMask);
// Stored for the host to read back; the library does not consult it.
VELMAR_EXPORT void SetEventMask(UInt16 mask);
VELMAR_EXPORT UInt16 GetEventMask();

// Ticks of 1/60 s from the host core's tick counter.
VELMAR_EXPORT UInt32 TickCount();

// ---- Polling the mouse and the keyboard --------------------------------------------------
// Key and button state come from the window system as it is now, so that keys held while
// no events are processed are seen too.

// 128 bits, one per Mac key code: bit (code % 8) of byte (code / 8).
using KeyMap = UInt32[4];

// The system's left mouse button.
VELMAR_EXPORT Boolean Button();
// The button is still down and no mouse-down or mouse-up is waiting; drawing done while a
// host tracks the mouse reaches the screen meanwhile.
VELMAR_EXPORT Boolean StillDown();
// StillDown; once the button is up, the mouse-up waiting in the queue is taken out.
VELMAR_EXPORT Boolean WaitMouseUp();
VELMAR_EXPORT void GetGlobalMouse(Point* where);
VELMAR_EXPORT void GetKeys(KeyMap keys);
// Whether the key with this Mac key code is down now (key code 0 is never reported).
VELMAR_EXPORT Boolean IsKeyPressed(SInt32 macKeyCode);
// The double-click interval in ticks.
VELMAR_EXPORT UInt32 GetDblTime();
VELMAR_EXPORT UInt32 LMGetDoubleTime();
// The auto-key threshold in ticks: always 24.
VELMAR_EXPORT SInt16 LMGetKeyThresh();
// The first UTF-16 unit a key event typed; 0 for none.
VELMAR_EXPORT UInt16 GetUTF16Char(QKeyEvent* event);
// The Mac modifier bits of the keyboard state (cmdKey, shiftKey, alphaLock, optionKey).
VELMAR_EXPORT UInt32 GetCurrentKeyModifiers();

} // namespace Velmar
