/* A document window with menus from an 'MBAR': reports what each click becomes. */
#include <stdio.h>

static WindowPtr gWindow;

static void Report(const char* what, long a, long b)
{
    printf("%s %ld %ld\n", what, a, b);
    fflush(stdout);
}

static void ReportGeometry(const char* what)
{
    Rect r = gWindow->portRect;
    Point tl, br;
    SetPt(&tl, r.left, r.top);
    SetPt(&br, r.right, r.bottom);
    LocalToGlobal(&tl);
    LocalToGlobal(&br);
    printf("%s %d %d %d %d\n", what, tl.h, tl.v, br.h, br.v);
    fflush(stdout);
}

main()
{
    EventRecord e;
    WindowPtr w;
    MenuHandle extra;
    short part, ready = 0;
    long choice;

    InitGraf(&qd.thePort);
    InitFonts();
    InitWindows();
    InitMenus();
    TEInit();
    InitDialogs(0L);
    InitCursor();
    SetMenuBar(GetNewMBar(128));
    AddResMenu(GetMHandle(128), 'DRVR');
    extra = NewMenu(131, "\pExtra");
    AppendMenu(extra, "\pPing/P;(Nothing");
    InsertMenu(extra, 0);
    DrawMenuBar();
    gWindow = GetNewWindow(128, 0L, (WindowPtr)-1L);
    SetPort(gWindow);
    for (;;) {
        if (!WaitNextEvent(everyEvent, &e, 10, 0L))
            continue;
        switch (e.what) {
        case updateEvt:
            w = (WindowPtr)e.message;
            BeginUpdate(w);
            SetPort(w);
            EraseRect(&w->portRect);
            MoveTo(10, 20);
            DrawString("\pDocument");
            EndUpdate(w);
            ReportGeometry(ready++ ? "geometry" : "ready");
            break;
        case mouseDown:
            part = FindWindow(e.where, &w);
            if (part == inMenuBar) {
                choice = MenuSelect(e.where);
                Report("menu", HiWord(choice), LoWord(choice));
                HiliteMenu(0);
            } else if (part == inGoAway && w == gWindow) {
                if (TrackGoAway(w, e.where)) {
                    Report("close", 0, 0);
                    DisposeWindow(w);
                    return 0;
                }
            } else if (part == inContent) {
                SetPort(w);
                GlobalToLocal(&e.where);
                Report("content", e.where.h, e.where.v);
            } else {
                Report("part", part, w == gWindow);
            }
            break;
        case keyDown:
            if (e.modifiers & cmdKey) {
                choice = MenuKey(e.message & charCodeMask);
                Report("menukey", HiWord(choice), LoWord(choice));
            }
            break;
        }
    }
}
