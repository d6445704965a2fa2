/* Doodle: a classic Toolbox program. Its window and menus come from its resource file; drag in
   the window to draw, choose a pen from the Pen menu, close the window or choose Quit to end. */
#include <Quickdraw.h>
#include <Fonts.h>
#include <Events.h>
#include <Windows.h>
#include <Menus.h>
#include <Resources.h>
#include <ToolUtils.h>
#include <Devices.h>

#define kMenuBar 128
#define kAppleMenu 128
#define kFileMenu 129
#define kPenMenu 130
#define kWindow 128

static WindowPtr gWindow;
static Boolean gDone;
static short gPenWidth = 1;
static short gPenKind = 1; /* 4 gray, 5 invert */

static void DrawFrame(void)
{
    Rect r;
    Str255 hint;

    r = gWindow->portRect;
    EraseRect(&r);
    InsetRect(&r, 4, 4);
    PenSize(2, 2);
    FrameRect(&r);
    PenNormal();
    GetIndString(hint, 128, 1);
    MoveTo(12, r.bottom - 8);
    TextFont(applFont);
    TextSize(10);
    DrawString(hint);
}

static void UsePen(void)
{
    PenNormal();
    PenSize(gPenWidth, gPenWidth);
    if (gPenKind == 4)
        PenPat(&qd.gray);
    else if (gPenKind == 5)
        PenMode(patXor);
}

static void Scribble(Point start)
{
    Point now, last;

    SetPort(gWindow);
    GlobalToLocal(&start);
    UsePen();
    MoveTo(start.h, start.v);
    last = start;
    while (StillDown()) {
        GetMouse(&now);
        if (now.h != last.h || now.v != last.v) {
            LineTo(now.h, now.v);
            last = now;
        }
    }
    PenNormal();
}

static void Choose(long choice)
{
    short menu = HiWord(choice), item = LoWord(choice), i;
    MenuHandle pen = GetMHandle(kPenMenu);

    switch (menu) {
    case kAppleMenu:
        SysBeep(1);
        break;
    case kFileMenu:
        if (item == 1) {
            SetPort(gWindow);
            InvalRect(&gWindow->portRect);
        } else if (item == 3)
            gDone = true;
        break;
    case kPenMenu:
        if (item <= 2)
            gPenWidth = item == 1 ? 1 : 4;
        else
            gPenKind = gPenKind == item ? 1 : item;
        for (i = 1; i <= CountMItems(pen); i++)
            CheckItem(pen, i, i == (gPenWidth == 1 ? 1 : 2) || i == gPenKind);
        break;
    }
    HiliteMenu(0);
}

static void MouseDown(EventRecord* event)
{
    WindowPtr window;
    short part = FindWindow(event->where, &window);

    switch (part) {
    case inMenuBar:
        Choose(MenuSelect(event->where));
        break;
    case inGoAway:
        if (TrackGoAway(window, event->where))
            gDone = true;
        break;
    case inDrag:
        DragWindow(window, event->where, &qd.screenBits.bounds);
        break;
    case inContent:
        if (window != FrontWindow())
            SelectWindow(window);
        else
            Scribble(event->where);
        break;
    }
}

int main(void)
{
    EventRecord event;

    InitGraf(&qd.thePort);
    InitFonts();
    InitWindows();
    InitMenus();
    TEInit();
    InitCursor();

    SetMenuBar(GetNewMBar(kMenuBar));
    AppendResMenu(GetMHandle(kAppleMenu), 'DRVR');
    DrawMenuBar();
    gWindow = GetNewWindow(kWindow, NULL, (WindowPtr)-1L);
    if (gWindow == NULL)
        return 1;
    SetPort(gWindow);

    while (!gDone) {
        if (!WaitNextEvent(everyEvent, &event, 30, NULL))
            continue;
        switch (event.what) {
        case mouseDown:
            MouseDown(&event);
            break;
        case keyDown:
            if (event.modifiers & cmdKey)
                Choose(MenuKey((char)(event.message & charCodeMask)));
            break;
        case updateEvt:
            BeginUpdate((WindowPtr)event.message);
            SetPort((WindowPtr)event.message);
            DrawFrame();
            EndUpdate((WindowPtr)event.message);
            break;
        }
    }
    DisposeWindow(gWindow);
    return 0;
}
