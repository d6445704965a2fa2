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

/* TESetStyle modes. */
enum { doFont = 1, doFace = 2, doSize = 4, doColor = 8, doAll = 15, addSize = 16, doToggle = 32 };

typedef struct TextStyle {
    short tsFont;
    Style tsFace;
    char filler;
    short tsSize;
    RGBColor tsColor;
} TextStyle;
typedef TextStyle* TextStylePtr;
typedef TextStylePtr* TextStyleHandle;

/* A style scrap as a 'styl' resource holds it: a count, then 20-byte runs, in the resource's
   (big-endian) byte order, with two-byte alignment. The handles the calls take and make are
   in this form, so a 'styl' resource and a scrap from TEGetStyleScrapHandle are one thing. */
#pragma pack(push, 2)
typedef struct ScrpSTElement {
    int scrpStartChar; /* 32 bits, as the resource has it */
    short scrpHeight;
    short scrpAscent;
    short scrpFont;
    Style scrpFace;
    char filler;
    short scrpSize;
    RGBColor scrpColor;
} ScrpSTElement;
typedef struct StScrpRec {
    short scrpNStyles;
    ScrpSTElement scrpStyleTab[1];
} StScrpRec;
#pragma pack(pop)
typedef StScrpRec* StScrpPtr;
typedef StScrpPtr* StScrpHandle;

/* Hooks a program installs. The click loop runs again and again while TEClick tracks the
   mouse (false stops the tracking); it is given the record (programs that declare it without
   arguments ignore it). The word-break procedure answers whether the character at charPos
   breaks words; a double click selects the run around the click that it classes alike. */
typedef pascal Boolean (*TEClickLoopProcPtr)(TEPtr pTE);
typedef TEClickLoopProcPtr TEClickLoopUPP;
typedef pascal Boolean (*WordBreakProcPtr)(Ptr text, short charPos);
typedef WordBreakProcPtr WordBreakUPP;

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
VELMAR_CLASSIC_API Point TEGetPoint(short offset, TEHandle hTE);
VELMAR_CLASSIC_API long TEGetHeight(long endLine, long startLine, TEHandle hTE);
VELMAR_CLASSIC_API void TEPinScroll(short dh, short dv, TEHandle hTE);

/* Styles: in styled records only (plain records keep one style). */
VELMAR_CLASSIC_API void TEStyleInsert(
    const void* text, long length, StScrpHandle hST, TEHandle hTE);
VELMAR_CLASSIC_API void TEStylePaste(TEHandle hTE);
VELMAR_CLASSIC_API void TESetStyle(
    short mode, const TextStyle* newStyle, Boolean fRedraw, TEHandle hTE);
VELMAR_CLASSIC_API void TEGetStyle(
    short offset, TextStyle* theStyle, short* lineHeight, short* fontAscent, TEHandle hTE);
/* The selection's styles as a new handle the program disposes; null for a plain record. */
VELMAR_CLASSIC_API StScrpHandle TEGetStyleScrapHandle(TEHandle hTE);

VELMAR_CLASSIC_API void TESetClickLoop(TEClickLoopUPP clikProc, TEHandle hTE);
VELMAR_CLASSIC_API void SetClikLoop(ProcPtr clikProc, TEHandle hTE);
VELMAR_CLASSIC_API void TESetWordBreak(WordBreakUPP wBrkProc, TEHandle hTE);
VELMAR_CLASSIC_API void SetWordBreak(ProcPtr wBrkProc, TEHandle hTE);

#define NewTEClickLoopUPP(proc) ((TEClickLoopUPP)(proc))
#define DisposeTEClickLoopUPP(upp) ((void)(upp))
#define NewWordBreakUPP(proc) ((WordBreakUPP)(proc))
#define DisposeWordBreakUPP(upp) ((void)(upp))

/* Later names of the same calls. */
#if !defined(VELMAR_CLASSIC_IMPLEMENTATION)
#define TextBox TETextBox
#define TESetJust TESetAlignment
#define TEStylNew TEStyleNew
#define TEStylInsert TEStyleInsert
#define TEStylPaste TEStylePaste
#define GetStylScrap TEGetStyleScrapHandle
#endif

VELMAR_CLASSIC_END
#endif
