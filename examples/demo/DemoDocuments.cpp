#include "DemoDocuments.h"

#include <map>

using namespace Velmar;

namespace Demo {

namespace {

struct DocumentState {
    Rect shape{40, 40, 110, 150}; // the shape the user drags
    RGBColor paper;
    int frame = 0;
};

std::map<AQtWindow*, DocumentState> gDocuments;

Rect portBounds(WindowRef w)
{
    Rect r;
    GetWindowPortBounds(w, &r);
    return r;
}

} // namespace

WindowRef openDocument(
    SInt16 procID, SInt16 top, SInt16 left, const char* title, const RGBColor& paper)
{
    const Rect bounds{top, left, SInt16(top + 240), SInt16(left + 340)};
    Str255 name;
    QString2PascalString(QString::fromLatin1(title), name);
    WindowRef w = NewCWindow(nullptr, &bounds, name, true, procID, nullptr, true, nullptr);
    gDocuments[w.get()].paper = paper;
    const Rect big{40, 40, 600, 900};
    SetWindowStandardState(w, &big);
    SetWindowUserState(w, &bounds);
    return w;
}

void adoptAsDocument(WindowRef window, const RGBColor& paper, const Rect& shape)
{
    gDocuments[window.get()].paper = paper;
    gDocuments[window.get()].shape = shape;
}

bool isDocument(WindowRef window)
{
    return gDocuments.count(window.get()) != 0;
}

void forgetDocument(WindowRef window)
{
    gDocuments.erase(window.get());
}

// The whole content of a document window, as QuickDraw draws it.
void drawDocument(WindowRef w, bool active)
{
    DocumentState& doc = gDocuments[w.get()];
    const Rect all = portBounds(w);
    RGBBackColor(&doc.paper);
    EraseRect(&all);

    Pattern pat;
    Rect well = all;
    InsetRect(&well, 10, 10);
    PenSize(2, 2);
    FrameRect(&well);
    PenNormal();

    const RGBColor red(0xDDDD, 0x2222, 0x2222), blue(0x2222, 0x4444, 0xCCCC), black(0, 0, 0);
    RGBForeColor(active ? &red : &blue);
    PaintOval(&doc.shape);
    RGBForeColor(&black);
    FrameOval(&doc.shape);

    // A region of two rectangles in a pattern, and a fan of lines.
    RgnHandle a = NewRgn(), b = NewRgn(), both = NewRgn();
    SetRectRgn(a, 180, 40, 260, 110);
    SetRectRgn(b, 220, 80, 300, 150);
    UnionRgn(a, b, both);
    PenPat(GetQDGlobalsDarkGray(&pat));
    PaintRgn(both);
    PenNormal();
    FrameRgn(both);
    DisposeRgn(a);
    DisposeRgn(b);
    DisposeRgn(both);
    for (int i = 0; i <= 8; ++i) {
        MoveTo(60, short(all.bottom - 30));
        LineTo(short(40 + 25 * i), short(all.bottom - 90));
    }
    // The grow box, drawn the classic way in the bottom-right corner.
    const Rect grow{SInt16(all.bottom - 15), SInt16(all.right - 15), all.bottom, all.right};
    FrameRect(&grow);
}

// Idle time: a small bar that moves along the bottom of the front window.
void animate(WindowRef w)
{
    auto it = gDocuments.find(w.get());
    if (it == gDocuments.end())
        return;
    DocumentState& doc = it->second;
    const Rect all = portBounds(w);
    const Rect track{SInt16(all.bottom - 24), 20, SInt16(all.bottom - 18), SInt16(all.right - 30)};
    RGBBackColor(&doc.paper);
    EraseRect(&track);
    const int width = track.right - track.left - 30;
    Rect bar = track;
    bar.left = SInt16(track.left + (doc.frame * 3) % qMax(1, width));
    bar.right = SInt16(bar.left + 30);
    const RGBColor green(0x2222, 0xAAAA, 0x4444);
    RGBForeColor(&green);
    PaintRect(&bar);
    ++doc.frame;
}

void clickDocument(WindowRef w, const EventRecord& e, WindowPartCode part)
{
    SetPortWindowPort(w);
    if (part == inGrow) {
        const Rect limits{120, 200, 2000, 2000}; // top/left: smallest height/width
        const SInt32 size = GrowWindow(w, e.where, &limits);
        SizeWindow(w, SInt16(size & 0xFFFF), SInt16(size >> 16), true);
        return;
    }
    auto doc = gDocuments.find(w.get());
    if (doc == gDocuments.end())
        return;
    Point local = e.where;
    GlobalToLocal(&local);
    if (!PtInRect(local, &doc->second.shape))
        return;
    // Drag a grey outline of the shape; it moves there when released inside the window.
    RgnHandle outline = NewRgn();
    OpenRgn();
    FrameOval(&doc->second.shape);
    CloseRgn(outline);
    const Rect limit = portBounds(w);
    const SInt32 moved = DragGrayRgn(outline, local, &limit, &limit, noConstraint, nullptr);
    DisposeRgn(outline);
    if (moved != SInt32(0x80008000)) {
        OffsetRect(&doc->second.shape, SInt16(moved & 0xFFFF), SInt16(moved >> 16));
        InvalWindowRect(w, &limit);
    }
}

} // namespace Demo
