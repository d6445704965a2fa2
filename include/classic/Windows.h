/* The Window Manager: window records, making and disposing windows, the user's clicks on
   their frames, update regions. A window pointer is its port. */
#ifndef VELMAR_CLASSIC_WINDOWS_H
#define VELMAR_CLASSIC_WINDOWS_H
#include "Types.h"
#include "Quickdraw.h"
#include "Events.h"
#include "Controls.h"
VELMAR_CLASSIC_BEGIN

enum {
    documentProc = 0, dBoxProc = 1, plainDBox = 2, altDBoxProc = 3, noGrowDocProc = 4,
    movableDBoxProc = 5, zoomDocProc = 8, zoomNoGrow = 12, rDocProc = 16
};
enum { dialogKind = 2, userKind = 8 };
enum {
    inDesk = 0, inNoWindow = 0, inMenuBar = 1, inSysWindow = 2, inContent = 3, inDrag = 4,
    inGrow = 5, inGoAway = 6, inZoomIn = 7, inZoomOut = 8
};

typedef GrafPtr WindowPtr;
typedef WindowPtr WindowRef;
typedef CGrafPtr CWindowPtr;

typedef struct WindowRecord* WindowPeek;
typedef struct WindowRecord {
    GrafPort port;
    short windowKind;
    Boolean visible;
    Boolean hilited;
    Boolean goAwayFlag;
    Boolean spareFlag;
    RgnHandle strucRgn;
    RgnHandle contRgn;
    RgnHandle updateRgn;
    Handle windowDefProc;
    Handle dataHandle;
    StringHandle titleHandle;
    short titleWidth;
    ControlHandle controlList; /* always empty */
    WindowPeek nextWindow;
    PicHandle windowPic;
    long refCon;
} WindowRecord;

typedef struct CWindowRecord {
    CGrafPort port;
    short windowKind;
    Boolean visible;
    Boolean hilited;
    Boolean goAwayFlag;
    Boolean spareFlag;
    RgnHandle strucRgn;
    RgnHandle contRgn;
    RgnHandle updateRgn;
    Handle windowDefProc;
    Handle dataHandle;
    StringHandle titleHandle;
    short titleWidth;
    ControlHandle controlList;
    WindowPeek nextWindow;
    PicHandle windowPic;
    long refCon;
} CWindowRecord;
typedef CWindowRecord* CWindowPeek;

VELMAR_CLASSIC_API void InitWindows(void);
VELMAR_CLASSIC_API WindowPtr NewWindow(void* wStorage, const Rect* boundsRect,
                                       ConstStr255Param title, Boolean visible, short procID,
                                       WindowPtr behind, Boolean goAwayFlag, long refCon);
VELMAR_CLASSIC_API WindowPtr NewCWindow(void* wStorage, const Rect* boundsRect,
                                        ConstStr255Param title, Boolean visible, short procID,
                                        WindowPtr behind, Boolean goAwayFlag, long refCon);
VELMAR_CLASSIC_API WindowPtr GetNewWindow(short windowID, void* wStorage, WindowPtr behind);
VELMAR_CLASSIC_API WindowPtr GetNewCWindow(short windowID, void* wStorage, WindowPtr behind);
VELMAR_CLASSIC_API void CloseWindow(WindowPtr window);
VELMAR_CLASSIC_API void DisposeWindow(WindowPtr window);
VELMAR_CLASSIC_API void ShowWindow(WindowPtr window);
VELMAR_CLASSIC_API void HideWindow(WindowPtr window);
VELMAR_CLASSIC_API void ShowHide(WindowPtr window, Boolean showFlag);
VELMAR_CLASSIC_API void SelectWindow(WindowPtr window);
VELMAR_CLASSIC_API void BringToFront(WindowPtr window);
VELMAR_CLASSIC_API void SendBehind(WindowPtr window, WindowPtr behindWindow);
VELMAR_CLASSIC_API void HiliteWindow(WindowPtr window, Boolean fHilite);
VELMAR_CLASSIC_API WindowPtr FrontWindow(void);
VELMAR_CLASSIC_API short FindWindow(Point thePoint, WindowPtr* theWindow);
VELMAR_CLASSIC_API void DragWindow(WindowPtr window, Point startPt, const Rect* boundsRect);
VELMAR_CLASSIC_API Boolean TrackGoAway(WindowPtr window, Point thePt);
VELMAR_CLASSIC_API Boolean TrackBox(WindowPtr window, Point thePt, short partCode);
VELMAR_CLASSIC_API long GrowWindow(WindowPtr window, Point startPt, const Rect* sizeRect);
VELMAR_CLASSIC_API void ZoomWindow(WindowPtr window, short partCode, Boolean front);
VELMAR_CLASSIC_API void SizeWindow(WindowPtr window, short w, short h, Boolean fUpdate);
VELMAR_CLASSIC_API void MoveWindow(WindowPtr window, short hGlobal, short vGlobal,
                                   Boolean front);
VELMAR_CLASSIC_API void SetWTitle(WindowPtr window, ConstStr255Param title);
VELMAR_CLASSIC_API void GetWTitle(WindowPtr window, Str255 title);
VELMAR_CLASSIC_API void SetWRefCon(WindowPtr window, long data);
VELMAR_CLASSIC_API long GetWRefCon(WindowPtr window);
VELMAR_CLASSIC_API void BeginUpdate(WindowPtr window);
VELMAR_CLASSIC_API void EndUpdate(WindowPtr window);
VELMAR_CLASSIC_API void InvalRect(const Rect* badRect);
VELMAR_CLASSIC_API void InvalRgn(RgnHandle badRgn);
VELMAR_CLASSIC_API void ValidRect(const Rect* goodRect);
VELMAR_CLASSIC_API void ValidRgn(RgnHandle goodRgn);
VELMAR_CLASSIC_API void GetWMgrPort(GrafPtr* wPort);
VELMAR_CLASSIC_API void GetCWMgrPort(CGrafPtr* wMgrCPort);
VELMAR_CLASSIC_API void DrawGrowIcon(WindowPtr window);
VELMAR_CLASSIC_API void SystemClick(const EventRecord* theEvent, WindowPtr theWindow);
VELMAR_CLASSIC_API CGrafPtr GetWindowPort(WindowPtr window);
VELMAR_CLASSIC_API void SetPortWindowPort(WindowPtr window);
VELMAR_CLASSIC_API RgnHandle GetGrayRgn(void);

VELMAR_CLASSIC_END
#endif
