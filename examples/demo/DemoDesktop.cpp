#include "DemoDesktop.h"

#include "DemoEditor.h"

using namespace Velmar;

namespace Demo {

namespace {

struct CursorBox {
    Rect box;
    const char* label;
    ThemeCursor cursor;
};
const CursorBox kBoxes[] = {
    {{230, 430, 254, 560}, "I-beam", kThemeIBeamCursor},
    {{262, 430, 286, 560}, "Plus", kThemePlusCursor},
    {{294, 430, 318, 560}, "Pointing hand", kThemePointingHandCursor},
    {{326, 430, 350, 560}, "Watch", kThemeWatchCursor},
};
const Rect kDragBox{368, 430, 400, 560};
const char kDragged[] = "Hello from the Velmar demo";

WindowRef gFonts, gNotes;
const CursorBox* gUnder = nullptr;
UInt32 gSince = 0;
bool gTipShown = false;

void label(const Rect& r, const char* text)
{
    Str255 pascal;
    QString2PascalString(QString::fromLatin1(text), pascal);
    MoveTo(SInt16(r.left + 8), SInt16(r.bottom - 7));
    DrawString(pascal);
}

// Text dropped on the Notes window goes in at its caret.
SInt16 receiveText(WindowRef window, void*, Drag* drag)
{
    SInt32 size = 0;
    if (window != gNotes || GetFlavorDataSize(drag, 1, kDragFlavorTypeText, &size) != noErr || size <= 0)
        return dragNotAcceptedErr;
    QByteArray bytes(size, '\0');
    GetFlavorData(drag, 1, kDragFlavorTypeText, bytes.data(), &size, 0);
    insertIntoEditor(bytes.constData(), size);
    return noErr;
}

} // namespace

void installDesktop(WindowRef fontsWindow, WindowRef notesWindow)
{
    gFonts = fontsWindow;
    gNotes = notesWindow;
    Drag* drag = nullptr;
    NewDrag(&drag); // kept: drops from other applications are read through it
    InstallReceiveHandler(receiveText, gNotes, nullptr);
    SetToolTipParent(gFonts);
}

void drawDesktopBoxes()
{
    const RGBColor black(0, 0, 0), paper(0xEEEE, 0xF4F4, 0xFFFF), drag(0xFFFF, 0xF0F0, 0xC0C0);
    TextFont(geneva, false);
    TextSize(11, false);
    TextFace(normal, false);
    for (const CursorBox& b : kBoxes) {
        RGBForeColor(&paper);
        PaintRect(&b.box);
        RGBForeColor(&black);
        FrameRect(&b.box);
        label(b.box, b.label);
    }
    RGBForeColor(&drag);
    PaintRect(&kDragBox);
    RGBForeColor(&black);
    FrameRect(&kDragBox);
    label(kDragBox, "Drag me out");
}

bool dragFromBox(WindowRef window, const EventRecord& e)
{
    SetPortWindowPort(window);
    Point local = e.where;
    GlobalToLocal(&local);
    if (!PtInRect(local, &kDragBox))
        return false;
    Drag* drag = DragInstance();
    drag->mimeData()->setText(QString::fromLatin1(kDragged));
    Rect outline = kDragBox;
    QDLocalToGlobalRect(GetWindowPort(window), &outline);
    RgnHandle region = NewRgn();
    RectRgn(region, &outline);
    TrackDrag(drag, &e, region);
    DisposeRgn(region);
    return true;
}

void trackMouse()
{
    if (!gFonts || !IsValidWindowPtr(gFonts) || FrontWindow() != gFonts)
        return;
    GrafPtr saved = nullptr;
    GetPort(&saved);
    SetPortWindowPort(gFonts);
    Point mouse;
    GetMouse(&mouse);
    SetPort(saved);
    const CursorBox* under = nullptr;
    for (const CursorBox& b : kBoxes)
        if (PtInRect(mouse, &b.box))
            under = &b;
    if (under != gUnder) {
        gUnder = under;
        gSince = TickCount();
        if (gTipShown)
            HideToolTip(false);
        gTipShown = false;
        SetThemeCursor(under ? under->cursor : kThemeArrowCursor);
    } else if (under && !gTipShown && TickCount() - gSince > 40) {
        Point global{SInt16(under->box.bottom + 4), under->box.left};
        SetPortWindowPort(gFonts);
        LocalToGlobal(&global);
        SetPort(saved);
        const QByteArray tip = QByteArray("SetThemeCursor shows the ") + under->label + " cursor here";
        ShowToolTip(global.h, global.v, tip.constData());
        gTipShown = true;
    }
}

} // namespace Demo
