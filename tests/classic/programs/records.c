/* Reads the records classic code reads directly, and prints what it finds. */
#include <stdio.h>
#include <string.h>

static void Show(const char* name, long value)
{
    printf("%s=%ld\n", name, value);
}

int main(void)
{
    WindowRecord storage;
    WindowPtr w, w2;
    WindowPeek peek;
    RgnHandle rgn;
    Handle h, again;
    TEHandle te;
    Rect bounds, view;
    Str255 s;
    long n, r1;
    unsigned long secs, back;
    DateTimeRec date;
    short id;
    ResType type;
    EventRecord e;

    InitGraf(&qd.thePort);
    InitFonts();
    InitWindows();
    TEInit();
    Show("black0", qd.black.pat[0]);
    Show("gray01", qd.gray.pat[0] * 256 + qd.gray.pat[1]);
    Show("screenPositive", qd.screenBits.bounds.right > 0 && qd.screenBits.bounds.bottom > 0);

    SetRect(&bounds, 50, 60, 350, 260);
    w = NewWindow(&storage, &bounds, "\pRecords", true, documentProc, (WindowPtr)-1L, true, 42);
    w2 = NewWindow(0L, &bounds, "\pSecond", true, documentProc, (WindowPtr)-1L, false, 7);
    peek = (WindowPeek)w;
    Show("storageUsed", w == (WindowPtr)&storage);
    SetPort(w);
    Show("thePort", qd.thePort == w && thePort == w);
    Show("portRect", w->portRect.right * 1000 + w->portRect.bottom);
    Show("portBitsOrigin", -w->portBits.bounds.left * 1000 - w->portBits.bounds.top >= 0);
    Show("visRgnRect", (**w->visRgn).rgnSize);
    Show("windowKind", peek->windowKind);
    Show("visible", peek->visible);
    Show("goAwayFlag", peek->goAwayFlag);
    Show("refCon", peek->refCon);
    Show("titleLength", (**peek->titleHandle));
    Show("secondBehindFirst", ((WindowPeek)w2)->nextWindow == peek || peek->nextWindow == (WindowPeek)w2);
    Show("contRgnWidth", (**peek->contRgn).rgnBBox.right - (**peek->contRgn).rgnBBox.left);
    peek->refCon = 99;
    Show("GetWRefCon", GetWRefCon(w));

    /* The pen location as written into the record is where the next line starts. */
    w->pnLoc.h = 30;
    w->pnLoc.v = 40;
    Move(5, 5);
    Show("pnLocAfterMove", w->pnLoc.h * 1000 + w->pnLoc.v);
    TextSize(18);
    Show("txSize", w->txSize);

    rgn = NewRgn();
    SetRectRgn(rgn, 10, 20, 110, 70);
    Show("rgnRect", (**rgn).rgnSize * 100000L + (**rgn).rgnBBox.right * 100 + (**rgn).rgnBBox.bottom);
    OpenRgn();
    FrameOval(&w->portRect);
    CloseRgn(rgn);
    Show("rgnOvalComplex", (**rgn).rgnSize > 10);
    {
        /* An L: the scan lines after the record, as classic code walks them. */
        static const short expected[] = {
            0, 0, 20, 0x7fff, 10, 10, 20, 0x7fff, 20, 0, 10, 0x7fff, 0x7fff};
        RgnHandle foot = NewRgn();
        const short* lines;
        SetRectRgn(rgn, 0, 0, 20, 10);
        SetRectRgn(foot, 0, 10, 10, 20);
        UnionRgn(rgn, foot, rgn);
        lines = (const short*)((const char*)*rgn + 10);
        Show("rgnScanLines",
            (**rgn).rgnSize == 10 + sizeof expected
                && memcmp(lines, expected, sizeof expected) == 0);
        DisposeRgn(foot);
    }
    DisposeRgn(rgn);
    {
        PolyHandle poly = OpenPoly();
        MoveTo(10, 10);
        LineTo(50, 10);
        LineTo(30, 40);
        LineTo(10, 10);
        ClosePoly();
        Show("polygon", (**poly).polySize * 10000L + (**poly).polyBBox.right * 100 + (**poly).polyBBox.bottom);
        Show("polyPoint2", (**poly).polyPoints[2].h * 100 + (**poly).polyPoints[2].v);
        KillPoly(poly);
    }

    qd.randSeed = 1;
    r1 = Random();
    Show("random1", r1);
    Show("seedAfter", qd.randSeed);
    randSeed = 1;
    Show("randomPlainGlobal", Random() == r1);

    secs = 0;
    GetDateTime(&secs);
    Secs2Date(secs, &date);
    Date2Secs(&date, &back);
    Show("dateRoundTrip", secs == back && date.year >= 2024);
    Secs2Date(0, &date);
    Show("epoch", date.year * 10000L + date.month * 100 + date.day);
    IUDateString(0, shortDate, s);
    Show("shortDateLength", s[0]);
    NumToString(-1234567, s);
    n = 0x7FFFFFFFL;
    StringToNum(s, &n);
    Show("stringToNum", n);
    Show("hiword", HiWord(0x12345678));
    Show("bitTst", BitTst("\x40", 1) * 10 + BitTst("\x40", 0));
    Show("bitShift", BitShift(1, 31) < 0);

    h = NewHandle(10);
    HLock(h);
    Show("locked", (HGetState(h) & 0x80) != 0);
    HUnlock(h);
    SetHandleSize(h, 100000);
    Show("grown", GetHandleSize(h) * 10 + MemError());
    DisposeHandle(h);

    h = GetResource('STR ', 128);
    again = GetResource('STR ', 128);
    Show("oneHandlePerResource", h != 0 && h == again);
    Show("strLength", h ? (*h)[0] : -1);
    GetResInfo(h, &id, &type, s);
    Show("resInfo", id * 10 + (type == 'STR '));
    Show("countMenus", CountResources('MENU'));
    GetIndString(s, 128, 2);
    Show("indString2", s[0]);
    Show("missing", GetResource('ZZZZ', 1) == 0 && ResError() == resNotFound);
    Show("homeFile", HomeResFile(h) == CurResFile());

    SetRect(&view, 10, 10, 200, 100);
    te = TENew(&view, &view);
    TESetText("one\rtwo\rthree", 13, te);
    Show("teLength", (**te).teLength);
    Show("teLines", (**te).nLines);
    Show("teTextSize", GetHandleSize((**te).hText));
    TESetSelect(4, 7, te);
    Show("teSel", (**te).selStart * 100 + (**te).selEnd);
    TEDispose(te);
    {
        PicHandle pic = GetPicture(128);
        CursHandle cursor = GetCursor(128);
        Rect frame = (**pic).picFrame;
        Show("pictFrame", frame.right * 100 + frame.bottom);
        EraseRect(&w->portRect);
        DrawPicture(pic, &frame);
        Show("pictDrawn", GetPixel(10, 10) * 10 + GetPixel(2, 2));
        Show("cursorHotSpot", (**cursor).hotSpot.v * 10 + (**cursor).hotSpot.h);
        SetCursor(*cursor);
        SetCursor(&qd.arrow);
    }

    InvalRect(&w->portRect);
    Show("updateEvent", WaitNextEvent(updateMask, &e, 60, 0L) && e.what == updateEvt
        && (e.message == (unsigned long)w || e.message == (unsigned long)w2));
    BeginUpdate((WindowPtr)e.message);
    EndUpdate((WindowPtr)e.message);
    Show("trapAvailable", NGetTrapAddress(_WaitNextEvent, ToolTrap) != NGetTrapAddress(_Unimplemented, ToolTrap));
    Show("gestalt", Gestalt(gestaltSystemVersion, &n) == noErr && n >= 0x0700);
    DisposeWindow(w2);
    CloseWindow(w);
    Show("done", 1);
    fflush(stdout);
    return 0;
}
