/* A tracking-loop drawing program: draws with the classic patterns and modes, then follows the
   mouse with LineTo while the button is down, never waiting for events meanwhile. */
#include <Quickdraw.h>
#include <Events.h>
#include <Windows.h>
#include <Fonts.h>
#include <stdio.h>

static void Draw(WindowPtr w)
{
    Rect r;
    SetPort(w);
    EraseRect(&w->portRect);
    SetRect(&r, 10, 10, 110, 60);   /* light gray: mostly paper */
    FillRect(&r, &qd.ltGray);
    SetRect(&r, 120, 10, 220, 60);  /* dark gray: mostly ink */
    FillRect(&r, &qd.dkGray);
    SetRect(&r, 10, 70, 110, 120);  /* black, with text cleared out of it */
    PaintRect(&r);
    TextFont(systemFont);
    TextSize(24);
    TextMode(srcBic);
    MoveTo(14, 105);
    DrawString((ConstStr255Param)"\004WWWW");
    TextMode(srcOr);
    SetRect(&r, 120, 70, 220, 120); /* black, inverted half by patXor */
    PaintRect(&r);
    PenMode(patXor);
    SetRect(&r, 120, 70, 170, 120);
    PaintRect(&r);
    PenNormal();
}

int main(void)
{
    EventRecord e;
    WindowPtr w, hit;
    Rect bounds;
    Point p, tl;
    int drawn = 0;

    InitGraf(&qd.thePort);
    InitWindows();
    SetRect(&bounds, 100, 100, 500, 400);
    w = NewWindow(0L, &bounds, (ConstStr255Param)"\007Tracker", true, documentProc,
        (WindowPtr)-1L, true, 0);
    for (;;) {
        if (!WaitNextEvent(everyEvent, &e, 10, 0L))
            continue;
        if (e.what == updateEvt) {
            BeginUpdate(w);
            Draw(w);
            EndUpdate(w);
            if (!drawn++) {
                SetPt(&tl, 0, 0);
                LocalToGlobal(&tl);
                printf("ready %d %d\n", tl.h, tl.v);
                fflush(stdout);
            }
        } else if (e.what == mouseDown && FindWindow(e.where, &hit) == inContent) {
            SetPort(w);
            PenSize(3, 3);
            p = e.where;
            GlobalToLocal(&p);
            MoveTo(p.h, p.v);
            while (StillDown()) {
                GetMouse(&p);
                LineTo(p.h, p.v);
            }
            PenNormal();
            printf("tracked %d %d\n", p.h, p.v);
            fflush(stdout);
        } else if (e.what == keyDown) {
            return 0;
        }
    }
}
