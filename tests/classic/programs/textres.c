/* Styled text from the program's 'TEXT' and 'styl', resources written to a new file and read
   back, and the TextEdit hooks: a word-break procedure for double clicks and a click loop that
   disposes of its own record. Prints what it finds; the test drives the clicks. */
#include <ClassicToolbox.h>
#include <stdio.h>
#include <string.h>

static TEHandle gWords, gLoop;
static int gLoopCalls;

static void Show(const char* name, long value)
{
    printf("%s=%ld\n", name, value);
    fflush(stdout);
}

/* Only spaces break words: a double click selects "foo-bar" whole. */
static pascal Boolean SpacesOnly(Ptr text, short charPos)
{
    return text[charPos] == ' ';
}

/* The third call disposes of the record being clicked. */
static pascal Boolean DisposingLoop(void)
{
    if (++gLoopCalls == 3 && gLoop) {
        TEDispose(gLoop);
        gLoop = nil;
    }
    return true;
}

static void WriteAndReadBack(StScrpHandle scrap)
{
    short ref, home, id;
    Handle h, back;
    ResType type;
    Str255 name;

    CreateResFile("\pNotes");
    Show("created", ResError());
    CreateResFile("\pNotes");
    Show("createdAgain", ResError());
    home = CurResFile();
    ref = OpenResFile("\pNotes");
    Show("opened", ref > 0 && ResError() == noErr);
    UseResFile(ref);
    h = NewHandle(5);
    memcpy(*h, "hello", 5);
    AddResource(h, 'TEXT', 200, "\pgreeting");
    Show("added", ResError());
    AddResource(h, 'TEXT', 201, "\pagain");
    Show("addedTwice", ResError());
    AddResource((Handle)scrap, 'styl', 200, "\p");
    /* A change after adding reaches the file too, even with its handle released first. */
    (*h)[0] = 'j';
    ChangedResource(h);
    ReleaseResource(h);
    UpdateResFile(ref);
    Show("updated", ResError());
    h = Get1Resource('TEXT', 200);
    SetResInfo(h, 300, nil);
    CloseResFile(ref);
    Show("closed", ResError());
    UseResFile(home);

    ref = OpenRFPerm("\pNotes", 0, fsRdPerm);
    UseResFile(ref);
    back = Get1Resource('TEXT', 300);
    Show("readBack", back && GetHandleSize(back) == 5 && memcmp(*back, "jello", 5) == 0);
    GetResInfo(back, &id, &type, name);
    Show("readBackInfo", id == 300 && type == 'TEXT' && name[0] == 8);
    Show("oldIdGone", Get1Resource('TEXT', 200) == nil && ResError() == resNotFound);
    ChangedResource(back);
    Show("readOnlyChange", ResError());
    h = NewHandle(1);
    AddResource(h, 'TEXT', 7, "\p");
    Show("readOnlyAdd", ResError());
    RemoveResource(back);
    Show("readOnlyRemove", ResError());
    scrap = (StScrpHandle)Get1Resource('styl', 200);
    TESetSelect(0, 32767, gWords);
    TEDelete(gWords);
    TEStyleInsert("jello", 5, scrap, gWords);
    CloseResFile(ref);
    UseResFile(home);
}

int main(void)
{
    WindowPtr w;
    Rect bounds, view;
    Handle text;
    StScrpHandle styles, scrap;
    TextStyle style;
    short height, ascent;
    Point origin;
    EventRecord e;
    int clicks = 0;

    InitGraf(&qd.thePort);
    InitFonts();
    InitWindows();
    TEInit();
    SetRect(&bounds, 80, 80, 400, 260);
    w = NewWindow(nil, &bounds, "\pText", true, documentProc, (WindowPtr)-1L, false, 0);
    SetPort(w);

    SetRect(&view, 10, 10, 300, 40);
    gWords = TEStyleNew(&view, &view);
    text = GetResource('TEXT', 128);
    styles = (StScrpHandle)GetResource('styl', 128);
    HLock(text);
    TEStyleInsert(*text, GetHandleSize(text), styles, gWords);
    HUnlock(text);
    Show("teLength", (**gWords).teLength);
    TEGetStyle(0, &style, &height, &ascent, gWords);
    Show("face0", style.tsFace);
    Show("red0", style.tsColor.red);
    TEGetStyle(9, &style, &height, &ascent, gWords);
    Show("face9", style.tsFace);
    Show("red9", style.tsColor.red);
    TESetSelect(0, 32767, gWords);
    scrap = TEGetStyleScrapHandle(gWords);
    Show("scrapRuns",
        GetHandleSize((Handle)scrap) == 2 + 2 * 20 && (*(unsigned char**)scrap)[1] == 2);
    TESetSelect(0, 0, gWords);
    WriteAndReadBack(scrap);
    TEGetStyle(1, &style, &height, &ascent, gWords);
    Show("roundTripFace", style.tsFace);
    TESetSelect(0, 32767, gWords);
    TEDelete(gWords);
    TEStyleInsert(*text, GetHandleSize(text), styles, gWords);
    TESetWordBreak(SpacesOnly, gWords);

    SetRect(&view, 10, 60, 300, 160);
    gLoop = TENew(&view, &view);
    TESetText("drag here", 9, gLoop);
    SetClikLoop((ProcPtr)DisposingLoop, gLoop);

    origin.h = 0;
    origin.v = 0;
    LocalToGlobal(&origin);
    printf("ready %d %d\n", origin.h, origin.v);
    fflush(stdout);
    for (;;) {
        if (!WaitNextEvent(everyEvent, &e, 2, nil))
            continue;
        if (e.what == updateEvt) {
            BeginUpdate((WindowPtr)e.message);
            TEUpdate(&((WindowPtr)e.message)->portRect, gWords);
            EndUpdate((WindowPtr)e.message);
        } else if (e.what == mouseDown) {
            GlobalToLocal(&e.where);
            if (PtInRect(e.where, &(**gWords).viewRect)) {
                TEClick(e.where, false, gWords);
                if (++clicks == 2)
                    printf("selected %d %d\n", (**gWords).selStart, (**gWords).selEnd);
            } else if (gLoop && PtInRect(e.where, &(**gLoop).viewRect)) {
                TEClick(e.where, false, gLoop);
                printf("loop %d %d\n", gLoopCalls, gLoop == nil);
                return 0;
            }
            fflush(stdout);
        }
    }
}
