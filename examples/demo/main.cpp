// The demo host: a classic WaitNextEvent application. It opens document, floating and movable
// modal windows with NewCWindow and CreateNewWindow and draws them through QuickDraw on update
// events; clicks select windows (FindWindow), drag a grey outline of a shape (DragGrayRgn) or
// grow a window (GrowWindow); keys zoom (z), open a window (n) and quit (q); idle time (null
// events) animates the front window. With --screenshot PATH it saves the screen after a few
// seconds and quits, for machines without a display.
#include <Velmar/Velmar.h>

#include <QElapsedTimer>
#include <QGuiApplication>
#include <QScreen>

#include <map>
#include <vector>

using namespace Velmar;

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

WindowRef openDocument(SInt16 procID, SInt16 top, SInt16 left, const char* title, const RGBColor& paper)
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

void handleMouseDown(const EventRecord& e)
{
    WindowRef w = nullptr;
    const WindowPartCode part = FindWindow(e.where, &w);
    if (!w)
        return;
    if (w != FrontWindow()) {
        SelectWindow(w);
        return;
    }
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

} // namespace

int main(int argc, char** argv)
{
    // Decorated: the library's shell draws the frames and title bars, with or without a
    // window manager.
    AQtApplication app(argc, argv, true);
    QString screenshot;
    const QStringList args = QCoreApplication::arguments();
    const qsizetype at = args.indexOf(QStringLiteral("--screenshot"));
    if (at >= 0 && at + 1 < args.size())
        screenshot = args.at(at + 1);

    std::vector<WindowRef> windows;
    windows.push_back(openDocument(8, 60, 40, "Document (zoom box)", RGBColor(0xFFFF, 0xFFFF, 0xF0F0)));
    windows.push_back(openDocument(0, 120, 420, "Document", RGBColor(0xF0F0, 0xF8F8, 0xFFFF)));

    // A floating palette and a movable modal dialog from Carbon classes.
    WindowRef palette = nullptr;
    const Rect paletteBounds{80, 820, 300, 960};
    CreateNewWindow(kFloatingWindowClass, kWindowStandardFloatingAttributes, &paletteBounds, &palette);
    SetWTitle(palette, reinterpret_cast<const unsigned char*>("\x07Palette"));
    gDocuments[palette.get()].paper = RGBColor(0xE0E0, 0xE0E0, 0xE0E0);
    gDocuments[palette.get()].shape = Rect{20, 20, 70, 110};
    ShowWindow(palette);

    WindowRef dialog = nullptr;
    const Rect dialogBounds{420, 300, 520, 620};
    CreateNewWindow(kMovableModalWindowClass, 0, &dialogBounds, &dialog);
    SetWTitle(dialog, reinterpret_cast<const unsigned char*>("\x17" "Click or press a key..."));
    gDocuments[dialog.get()].paper = RGBColor(0xFFFF, 0xF0F0, 0xD0D0);
    gDocuments[dialog.get()].shape = Rect{20, 20, 60, 60};
    ShowWindow(dialog);
    SelectWindow(dialog);

    QElapsedTimer clock;
    clock.start();
    bool quit = false;
    while (!quit) {
        EventRecord e;
        if (!WaitNextEvent(everyEvent, &e, 2, nullptr)) {
            if (WindowRef front = FrontWindow()) {
                SetPortWindowPort(front);
                animate(front);
            }
        } else {
            switch (e.what) {
            case updateEvt:
                SetPortWindowPort(e.window);
                BeginUpdate(e.window);
                drawDocument(e.window, e.window == FrontWindow());
                EndUpdate(e.window);
                break;
            case activateEvt: {
                const Rect all = portBounds(e.window);
                InvalWindowRect(e.window, &all); // the shape's colour follows activation
                break;
            }
            case mouseDown:
                if (dialog) {
                    DisposeWindow(dialog); // the modal dialog goes away first
                    dialog = nullptr;
                    break;
                }
                handleMouseDown(e);
                break;
            case keyDown: {
                const char c = char(e.message & charCodeMask);
                if (dialog) {
                    DisposeWindow(dialog);
                    dialog = nullptr;
                } else if (c == 'q') {
                    quit = true;
                } else if (c == 'z' && FrontWindow()) {
                    static bool out = false;
                    out = !out;
                    ZoomWindow(FrontWindow(), out ? inZoomOut : inZoomIn, true);
                } else if (c == 'n') {
                    windows.push_back(openDocument(8, SInt16(80 + 20 * windows.size()),
                                                   SInt16(80 + 20 * windows.size()), "New",
                                                   RGBColor(0xFFFF, 0xFFFF, 0xFFFF)));
                }
                break;
            }
            default:
                break;
            }
        }
        if (!screenshot.isEmpty() && clock.elapsed() > 2500) {
            QScreen* screen = QGuiApplication::primaryScreen();
            if (!screen || !screen->grabWindow(0).save(screenshot))
                qWarning("velmar-demo: could not save %s", qPrintable(screenshot));
            quit = true;
        }
    }
    return 0;
}
