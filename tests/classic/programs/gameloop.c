/* A game loop: WaitNextEvent without sleeping, a frame whenever the tick count moves on. */
#include <stdio.h>

int main(void)
{
    EventRecord e;
    WindowPtr w;
    Rect bounds, ball;
    unsigned long last, start;
    long frames = 0;
    short x = 0;

    InitGraf(&qd.thePort);
    InitWindows();
    SetRect(&bounds, 80, 80, 380, 280);
    w = NewCWindow(0L, &bounds, "\pGame", true, noGrowDocProc, (WindowPtr)-1L, false, 0);
    SetPort(w);
    start = last = TickCount();
    printf("ready\n");
    fflush(stdout);
    for (;;) {
        if (WaitNextEvent(everyEvent, &e, 0, 0L)) {
            if (e.what == keyDown) {
                printf("key %c frames %ld ticks %lu\n", (char)(e.message & charCodeMask),
                    frames, TickCount() - start);
                fflush(stdout);
                return 0;
            }
            if (e.what == updateEvt) {
                BeginUpdate(w);
                EraseRect(&w->portRect);
                EndUpdate(w);
            }
        }
        if (TickCount() != last) {
            last = TickCount();
            ++frames;
            SetRect(&ball, x, 50, x + 20, 70);
            EraseRect(&ball);
            x = (x + 3) % 280;
            OffsetRect(&ball, 3, 0);
            PaintOval(&ball);
        }
    }
}
