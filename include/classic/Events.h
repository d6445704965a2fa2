/* The Event Manager: event records, waiting for events, the mouse and the keyboard. */
#ifndef VELMAR_CLASSIC_EVENTS_H
#define VELMAR_CLASSIC_EVENTS_H
#include "Types.h"
#include "Quickdraw.h"
VELMAR_CLASSIC_BEGIN

enum {
    nullEvent = 0, mouseDown = 1, mouseUp = 2, keyDown = 3, keyUp = 4, autoKey = 5,
    updateEvt = 6, diskEvt = 7, activateEvt = 8, osEvt = 15, kHighLevelEvent = 23
};
enum {
    mDownMask = 0x0002, mUpMask = 0x0004, keyDownMask = 0x0008, keyUpMask = 0x0010,
    autoKeyMask = 0x0020, updateMask = 0x0040, diskMask = 0x0080, activMask = 0x0100,
    highLevelEventMask = 0x0400, osMask = -32768, everyEvent = -1
};
enum {
    activeFlag = 0x0001, btnState = 0x0080, cmdKey = 0x0100, shiftKey = 0x0200,
    alphaLock = 0x0400, optionKey = 0x0800, controlKey = 0x1000
};
enum {
    charCodeMask = 0x000000FF, keyCodeMask = 0x0000FF00, adbAddrMask = 0x00FF0000,
    suspendResumeMessage = 0x01,
    mouseMovedMessage = 0xFA, resumeFlag = 1, convertClipboardFlag = 2
};

#define osEvtMessageMask 0xFF000000UL

typedef unsigned short EventKind;
typedef unsigned short EventModifiers;
typedef short EventMask;

/* message is as wide as a pointer: update and activate events carry the window in it. */
typedef struct EventRecord {
    EventKind what;
    unsigned long message;
    unsigned long when;
    Point where;
    EventModifiers modifiers;
} EventRecord;

typedef unsigned char KeyMap[16];

VELMAR_CLASSIC_API Boolean WaitNextEvent(short eventMask, EventRecord* theEvent,
                                         unsigned long sleep, RgnHandle mouseRgn);
VELMAR_CLASSIC_API Boolean GetNextEvent(short eventMask, EventRecord* theEvent);
VELMAR_CLASSIC_API Boolean EventAvail(short eventMask, EventRecord* theEvent);
VELMAR_CLASSIC_API OSErr PostEvent(short eventNum, long eventMsg);
VELMAR_CLASSIC_API void FlushEvents(short whichMask, short stopMask);
VELMAR_CLASSIC_API void SetEventMask(short mask);
VELMAR_CLASSIC_API Boolean Button(void);
VELMAR_CLASSIC_API Boolean StillDown(void);
VELMAR_CLASSIC_API Boolean WaitMouseUp(void);
VELMAR_CLASSIC_API void GetMouse(Point* mouseLoc);
VELMAR_CLASSIC_API unsigned long TickCount(void);
VELMAR_CLASSIC_API void GetKeys(KeyMap theKeys);
VELMAR_CLASSIC_API unsigned long GetDblTime(void);
VELMAR_CLASSIC_API unsigned long GetCaretTime(void);
VELMAR_CLASSIC_API void SystemTask(void);

VELMAR_CLASSIC_END
#endif
