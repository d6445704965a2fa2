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
    long n = 0, i;
    for (i = 0; i < 8L * b->rowBytes * (b->bounds.bottom - b->bounds.top); ++i)
        n += (((unsigned char*)b->baseAddr)[i / 8] >> (i % 8)) & 1;
    return n;
}

static void NewBits(BitMap* b)
{
    b->baseAddr = NewPtrClear(8 * 64);
    b->rowBytes = 8;
    SetRect(&b->bounds, 0, 0, 64, 64);
}

static void DrawOffscreen(void)
{
    unsigned char* m;
    Rect half, r;
    long before;
    NewBits(&offBits);
    m = (unsigned char*)offBits.baseAddr;
    OpenPort(&offPort);
    offPort.portBits = offBits; /* as SetPortBits(&offBits) */
    EraseRect(&offBits.bounds);
    SetRect(&half, 0, 0, 32, 64); /* the left half black */
    PaintRect(&half);
    printf("row10 %02x%02x %02x%02x %d\n", m[80], m[83], m[84], m[87], SetBits(&offBits) == 2048);
    /* Bytes the program writes itself survive the next drawing call. */
    memset(m + 8 * 60, 0xFF, 8);
    SetRect(&r, 40, 0, 48, 4);
    PaintRect(&r);
    printf("direct %d", m[8 * 60 + 7] == 0xFF && m[8 * 60 + 4] == 0xFF);
    before = SetBits(&offBits);
    MoveTo(36, 40);
    DrawString((ConstStr255Param)"\001W");
    printf(" text %d\n", SetBits(&offBits) > before);
    EraseRect(&offBits.bounds);
    PaintRect(&half);
}

static void Draw(WindowPtr w)
{
    static const short modes[] = {srcCopy, srcCopy, srcXor, srcBic, notSrcCopy};
    static const Rect dst[] = {{10, 10, 74, 74}, {10, 90, 138, 218}, {10, 230, 74, 294},
        {10, 310, 74, 374}, {150, 10, 214, 74}};
    Rect r;
    int i;
    SetPort(w);
    EraseRect(&w->portRect);
    for (i = 0; i < 5; ++i) { /* xor and bic over black; the second copy is scaled twice */
        if (modes[i] == srcXor || modes[i] == srcBic)
            PaintRect(&dst[i]);
        CopyBits(i == 1 ? &offPort.portBits : &offBits, &w->portBits, &offBits.bounds, &dst[i],
            modes[i], 0L);
    }
    SetRect(&r, 90, 150, 122, 182); /* black under the icon: its mask's left half shows it */
    PaintRect(&r);
    PlotIconID(&r, atNone, ttNone, 128);
    TextSize(24);
    TextMode(srcXor);
    for (i = 0; i < 3; ++i) { /* twice at 150: gone; once at 250: there */
        MoveTo(i < 2 ? 150 : 250, 240);
        DrawString((ConstStr255Param)"\003WWW");
    }
    TextMode(srcOr);
    NewBits(&backBits); /* window to bitmap: the first copy comes back */
    CopyBits(&w->portBits, &backBits, &dst[0], &backBits.bounds, srcCopy, 0L);
    printf("back %ld\n", SetBits(&backBits));
}

int main(void)
{
    EventRecord e;
    WindowPtr w;
    Rect bounds;
    Point tl = {0, 0};

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
            LocalToGlobal(&tl);
            printf("ready %d %d\n", tl.h, tl.v);
            fflush(stdout);
            SetPt(&tl, 0, 0);
        } else if (e.what == keyDown || e.what == mouseDown) {
            ClosePort(&offPort);
            return 0;
        }
    }
}
