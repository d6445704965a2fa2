/* TextEdit: edit records through their handles, with the fields programs read kept in step. */
#ifndef VELMAR_CLASSIC_TEXTEDIT_H
#define VELMAR_CLASSIC_TEXTEDIT_H
#include "Types.h"
#include "Quickdraw.h"
#include "Events.h"
VELMAR_CLASSIC_BEGIN

enum { teJustLeft = 0, teJustCenter = 1, teJustRight = -1, teForceLeft = -2 };
enum { teFlushDefault = 0, teCenter = 1, teFlushRight = -1, teFlushLeft = -2 };

/* lineStarts holds nLines + 1 entries (the record grows with its text). */
typedef struct TERec {
    Rect destRect;
    Rect viewRect;
    Rect selRect;
    short lineHeight;
    short fontAscent;
    Point selPoint;
    short selStart;
    short selEnd;
    short active;
    ProcPtr wordBreak;
    ProcPtr clikLoop;
    long clickTime;
    short clickLoc;
    long caretTime;
    short caretState;
    short just;
    short teLength;
    Handle hText;
    long hDispText;
    long clikStuff;
    short crOnly;
    short txFont;
    Style txFace;
    char filler;
    short txMode;
    short txSize;
    GrafPtr inPort;
    ProcPtr highHook;
    ProcPtr caretHook;
    short nLines;
    short lineStarts[1];
} TERec;
typedef TERec* TEPtr;
typedef TEPtr* TEHandle;

VELMAR_CLASSIC_API void TEInit(void);
VELMAR_CLASSIC_API TEHandle TENew(const Rect* destRect, const Rect* viewRect);
VELMAR_CLASSIC_API TEHandle TEStyleNew(const Rect* destRect, const Rect* viewRect);
VELMAR_CLASSIC_API void TEDispose(TEHandle hTE);
VELMAR_CLASSIC_API void TESetText(const void* text, long length, TEHandle hTE);
VELMAR_CLASSIC_API Handle TEGetText(TEHandle hTE);
VELMAR_CLASSIC_API void TEIdle(TEHandle hTE);
VELMAR_CLASSIC_API void TEClick(Point pt, Boolean fExtend, TEHandle h);
VELMAR_CLASSIC_API void TESetSelect(long selStart, long selEnd, TEHandle hTE);
VELMAR_CLASSIC_API void TEActivate(TEHandle hTE);
VELMAR_CLASSIC_API void TEDeactivate(TEHandle hTE);
VELMAR_CLASSIC_API void TEKey(CharParameter key, TEHandle hTE);
VELMAR_CLASSIC_API void TECut(TEHandle hTE);
VELMAR_CLASSIC_API void TECopy(TEHandle hTE);
VELMAR_CLASSIC_API void TEPaste(TEHandle hTE);
VELMAR_CLASSIC_API void TEDelete(TEHandle hTE);
VELMAR_CLASSIC_API void TEInsert(const void* text, long length, TEHandle hTE);
VELMAR_CLASSIC_API void TESetAlignment(short just, TEHandle hTE);
VELMAR_CLASSIC_API void TEUpdate(const Rect* rUpdate, TEHandle hTE);
VELMAR_CLASSIC_API void TETextBox(const void* text, long length, const Rect* box, short just);
VELMAR_CLASSIC_API void TEScroll(short dh, short dv, TEHandle hTE);
VELMAR_CLASSIC_API void TESelView(TEHandle hTE);
VELMAR_CLASSIC_API void TEAutoView(Boolean fAuto, TEHandle hTE);
VELMAR_CLASSIC_API void TECalText(TEHandle hTE);
VELMAR_CLASSIC_API short TEGetOffset(Point pt, TEHandle hTE);

/* Later names of the same calls. */
#if !defined(VELMAR_CLASSIC_IMPLEMENTATION)
#define TextBox TETextBox
#define TESetJust TESetAlignment
#endif

VELMAR_CLASSIC_END
#endif
