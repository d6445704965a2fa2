/* Draws into a bitmap of its own through an offscreen port, copies it onto its window in
   several transfer modes and back, plots an 'ICN#' with its mask and writes srcXor text. It
   prints what it finds in its own memory; the test looks at the window. */
#include <Quickdraw.h>
#include <Events.h>
#include <Windows.h>
#include <Fonts.h>
#include <Icons.h>
#include <Memory.h>
#include <stdio.h>
#include <string.h>

static GrafPort offPort;
static BitMap offBits, backBits;

static long SetBits(const BitMap* b)
{
    long n = 0;
    int i, bit;
    for (i = 0; i < b->rowBytes * (b->bounds.bottom - b->bounds.top); ++i)
        for (bit = 0; bit < 8; ++bit)
            n += (((unsigned char*)b->baseAddr)[i] >> bit) & 1;
    return n;
}

static void DrawOffscreen(void)
{
    Rect r;
    long before;
    int directKept, i;
    offBits.baseAddr = NewPtrClear(8 * 64);
    offBits.rowBytes = 8;
    SetRect(&offBits.bounds, 0, 0, 64, 64);
    OpenPort(&offPort);
    SetPortBits(&offBits);
    ClipRect(&offBits.bounds);
    EraseRect(&offBits.bounds);
    SetRect(&r, 0, 0, 32, 64); /* the left half black */
    PaintRect(&r);
    printf("row10 %02x%02x%02x%02x%02x\n", ((unsigned char*)offBits.baseAddr)[80],
        ((unsigned char*)offBits.baseAddr)[83], ((unsigned char*)offBits.baseAddr)[84],
        ((unsigned char*)offBits.baseAddr)[87], (unsigned)SetBits(&offBits) == 2048);
    /* Bytes the program writes itself survive the next drawing call. */
    memset(offBits.baseAddr + 8 * 60, 0xFF, 8);
    SetRect(&r, 40, 0, 48, 4);
    PaintRect(&r);
    directKept = 1;
    for (i = 0; i < 8; ++i)
        directKept &= ((unsigned char*)offBits.baseAddr)[8 * 60 + i] == 0xFF;
    /* Undo both: the bitmap is the left half again. */
    memset(offBits.baseAddr + 8 * 60 + 4, 0, 4);
    EraseRect(&r);
    before = SetBits(&offBits);
    MoveTo(36, 40);
    TextFont(systemFont);
    TextSize(12);
    DrawString((ConstStr255Param)"\001W");
    printf("direct %d text %d\n", directKept, SetBits(&offBits) > before);
    EraseRect(&offBits.bounds);
    SetRect(&r, 0, 0, 32, 64);
    PaintRect(&r);
}

static void Draw(WindowPtr w)
{
    Rect src, r;
    SetPort(w);
    EraseRect(&w->portRect);
    src = offBits.bounds;
    SetRect(&r, 10, 10, 74, 74);
    CopyBits(&offBits, &w->portBits, &src, &r, srcCopy, 0L);
    SetRect(&r, 90, 10, 218, 138); /* scaled twice */
    CopyBits(&offPort.portBits, &w->portBits, &src, &r, srcCopy, 0L);
    SetRect(&r, 230, 10, 294, 74);
    PaintRect(&r);
    CopyBits(&offBits, &w->portBits, &src, &r, srcXor, 0L);
    SetRect(&r, 310, 10, 374, 74);
    PaintRect(&r);
    CopyBits(&offBits, &w->portBits, &src, &r, srcBic, 0L);
    SetRect(&r, 10, 150, 74, 214);
    CopyBits(&offBits, &w->portBits, &src, &r, notSrcCopy, 0L);
    SetRect(&r, 90, 150, 122, 182); /* black under the icon: its mask's left half shows it */
    PaintRect(&r);
    PlotIconID(&r, atNone, ttNone, 128);
    TextFont(systemFont);
    TextSize(24);
    TextMode(srcXor);
    MoveTo(150, 240); /* twice: gone */
    DrawString((ConstStr255Param)"\003WWW");
    MoveTo(150, 240);
    DrawString((ConstStr255Param)"\003WWW");
    MoveTo(250, 240); /* once: there */
    DrawString((ConstStr255Param)"\003WWW");
    TextMode(srcOr);
    /* Window to bitmap: the first copy comes back. */
    backBits.baseAddr = NewPtrClear(8 * 64);
    backBits.rowBytes = 8;
    SetRect(&backBits.bounds, 0, 0, 64, 64);
    SetRect(&r, 10, 10, 74, 74);
    CopyBits(&w->portBits, &backBits, &r, &backBits.bounds, srcCopy, 0L);
    printf("back %ld\n", SetBits(&backBits));
}

int main(void)
{
    EventRecord e;
    WindowPtr w;
    Rect bounds;
    Point tl;
    int drawn = 0;

    InitGraf(&qd.thePort);
    InitFonts();
    InitWindows();
    DrawOffscreen();
    SetRect(&bounds, 100, 100, 500, 400);
    w = NewWindow(0L, &bounds, (ConstStr255Param)"\011Offscreen", true, documentProc,
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
        } else if (e.what == keyDown || e.what == mouseDown) {
            ClosePort(&offPort);
            return 0;
        }
    }
}
