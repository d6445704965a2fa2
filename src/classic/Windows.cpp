// Classic windows: a WindowRecord (the program's storage or the layer's) that begins with its
// port, linked to a library window and kept in step with it.
#include "classic/ClassicPrivate.h"

#include <algorithm>
#include <cstdlib>
#include <cstring>

#include "classic/resfile/Decoders.h"

namespace VelmarClassic {

namespace {

void setRegionFromWindow(::RgnHandle rgn, Velmar::AQtWindow* window, Velmar::WindowRegionCode code)
{
    if (Velmar::RgnHandle r = libraryRegion(rgn, "window region")) {
        Velmar::GetWindowRegion(window, code, r);
        syncRegion(rgn);
    }
}

WindowPeek peek(PortLink& link)
{
    return reinterpret_cast<WindowPeek>(link.record);
}

WindowPtr makeWindow(void* storage, const Rect* bounds, ConstStr255Param title, Boolean visible,
    short procID, Boolean goAwayFlag, long refCon, bool colour)
{
    if (!VELMAR_ASSERT(bounds, "boundsRect != NULL"))
        return nullptr;
    ensureStarted();
    unsigned char empty[1] = {0};
    Velmar::WindowRef window;
    {
        OwnGeometryChange own;
        window = Velmar::NewCWindow(
            nullptr, bounds, title ? title : empty, false, procID, nullptr, goAwayFlag, nullptr);
    }
    if (!window)
        return nullptr;
    auto* link = new PortLink;
    link->ownsStorage = storage == nullptr;
    link->record = static_cast<GrafPtr>(storage ? storage : std::calloc(1, sizeof(WindowRecord)));
    link->window = window.get();
    initPortRecord(*link, colour);
    WindowPeek w = peek(*link);
    w->windowKind = userKind;
    w->goAwayFlag = goAwayFlag;
    w->refCon = refCon;
    w->strucRgn = newClassicRegion();
    w->contRgn = newClassicRegion();
    w->updateRgn = newClassicRegion();
    w->titleHandle = newStringHandle(title ? title : empty);
    w->controlList = nullptr;
    w->nextWindow = nullptr;
    registerPort(link);
    watchWindow(window.get());
    Velmar::SetWindowKind(window, userKind);
    // Drawing state starts as the classic port's: the text of the system font at 12 points.
    GrafPtr saved = globals()->thePort;
    SetPort(link->record);
    pushGeometry(*link);
    if (visible) {
        OwnGeometryChange own;
        Velmar::ShowWindow(window);
    }
    if (saved && linkOf(saved))
        SetPort(saved);
    pushWindowRecord(*link);
    relinkWindowList();
    return link->record;
}

} // namespace

void pushWindowRecord(PortLink& link)
{
    if (!link.window)
        return;
    WindowPeek w = peek(link);
    w->visible = Velmar::IsWindowVisible(link.window);
    w->hilited = Velmar::IsWindowHilited(link.window);
    setRegionFromWindow(w->strucRgn, link.window, Velmar::kWindowStructureRgn);
    setRegionFromWindow(w->contRgn, link.window, Velmar::kWindowContentRgn);
    setRegionFromWindow(w->updateRgn, link.window, Velmar::kWindowUpdateRgn);
    pushGeometry(link);
}

void relinkWindowList()
{
    WindowPeek previous = nullptr;
    for (Velmar::WindowRef w = Velmar::GetWindowList(); w; w = Velmar::GetNextWindow(w)) {
        PortLink* link = windowLink(w.get());
        if (!link)
            continue;
        WindowPeek current = peek(*link);
        current->nextWindow = nullptr;
        if (previous)
            previous->nextWindow = current;
        previous = current;
    }
}

} // namespace VelmarClassic

using namespace VelmarClassic;

namespace {

// The window's link and library window, or null after the assertion.
PortLink* win(WindowPtr window, const char* call)
{
    ensureStarted();
    return checkedWindow(window, call);
}

void dispose(WindowPtr window, bool freeStorage)
{
    PortLink* link = win(window, "DisposeWindow");
    if (!link)
        return;
    Velmar::AQtWindow* w = link->window;
    WindowPeek peekRecord = reinterpret_cast<WindowPeek>(link->record);
    forgetPort(link);
    releasePortRecord(*link);
    DisposeRgn(peekRecord->strucRgn);
    DisposeRgn(peekRecord->contRgn);
    DisposeRgn(peekRecord->updateRgn);
    if (peekRecord->titleHandle && isLiveHandle(reinterpret_cast<Handle>(peekRecord->titleHandle)))
        DisposeHandle(reinterpret_cast<Handle>(peekRecord->titleHandle));
    peekRecord->titleHandle = nullptr;
    Velmar::DisposeWindow(w);
    if (link->ownsStorage && freeStorage)
        std::free(link->record);
    delete link;
    relinkWindowList();
}

} // namespace

WindowPtr NewWindow(void* wStorage, const Rect* boundsRect, ConstStr255Param title, Boolean visible,
    short procID, WindowPtr, Boolean goAwayFlag, long refCon)
{
    return makeWindow(wStorage, boundsRect, title, visible, procID, goAwayFlag, refCon, false);
}

WindowPtr NewCWindow(void* wStorage, const Rect* boundsRect, ConstStr255Param title,
    Boolean visible, short procID, WindowPtr, Boolean goAwayFlag, long refCon)
{
    return makeWindow(wStorage, boundsRect, title, visible, procID, goAwayFlag, refCon, true);
}

namespace {
WindowPtr fromTemplate(short windowID, void* wStorage, bool colour)
{
    ensureStarted();
    const std::optional<QByteArray> bytes = resourceBytes('WIND', windowID);
    const auto t = bytes ? Velmar::Classic::decodeWindow(*bytes) : std::nullopt;
    if (!t)
        return nullptr;
    Str255 title;
    copyToStr255(t->title, title);
    return makeWindow(
        wStorage, &t->bounds, title, t->visible, t->procID, t->goAwayFlag, long(t->refCon), colour);
}
} // namespace

WindowPtr GetNewWindow(short windowID, void* wStorage, WindowPtr)
{
    return fromTemplate(windowID, wStorage, false);
}

WindowPtr GetNewCWindow(short windowID, void* wStorage, WindowPtr)
{
    return fromTemplate(windowID, wStorage, true);
}

void CloseWindow(WindowPtr window)
{
    dispose(window, false);
}
void DisposeWindow(WindowPtr window)
{
    dispose(window, true);
}

void ShowWindow(WindowPtr window)
{
    if (PortLink* link = win(window, "ShowWindow")) {
        {
            OwnGeometryChange own;
            Velmar::ShowWindow(link->window);
        }
        pushWindowRecord(*link);
        relinkWindowList();
    }
}

void HideWindow(WindowPtr window)
{
    if (PortLink* link = win(window, "HideWindow")) {
        Velmar::HideWindow(link->window);
        pushWindowRecord(*link);
        relinkWindowList();
    }
}

void ShowHide(WindowPtr window, Boolean showFlag)
{
    if (showFlag)
        ShowWindow(window);
    else
        HideWindow(window);
}

void SelectWindow(WindowPtr window)
{
    if (PortLink* link = win(window, "SelectWindow")) {
        Velmar::SelectWindow(link->window);
        pushWindowRecord(*link);
        relinkWindowList();
    }
}

void BringToFront(WindowPtr window)
{
    if (PortLink* link = win(window, "BringToFront")) {
        Velmar::BringToFront(link->window);
        relinkWindowList();
    }
}

void SendBehind(WindowPtr window, WindowPtr behindWindow)
{
    PortLink* link = win(window, "SendBehind");
    PortLink* behind = behindWindow ? win(behindWindow, "SendBehind") : nullptr;
    if (link && (behind || !behindWindow)) {
        Velmar::SendBehind(link->window, behind ? behind->window : nullptr);
        relinkWindowList();
    }
}

void HiliteWindow(WindowPtr window, Boolean fHilite)
{
    if (PortLink* link = win(window, "HiliteWindow")) {
        Velmar::HiliteWindow(link->window, fHilite);
        pushWindowRecord(*link);
    }
}

WindowPtr FrontWindow()
{
    ensureStarted();
    // The front-most window the program made (the library's own windows are not its).
    for (Velmar::WindowRef w = Velmar::GetWindowList(); w; w = Velmar::GetNextWindow(w))
        if (Velmar::IsWindowVisible(w))
            if (GrafPtr record = classicWindow(w.get()))
                return record;
    return nullptr;
}

short FindWindow(Point thePoint, WindowPtr* theWindow)
{
    ensureStarted();
    if (!VELMAR_ASSERT(theWindow, "theWindow != NULL"))
        return inDesk;
    if (const FrameClick* click = answeringClick(thePoint)) {
        *theWindow = click->window ? classicWindow(click->window) : nullptr;
        return click->part;
    }
    Velmar::WindowRef w;
    const short part = Velmar::FindWindow(thePoint, &w);
    *theWindow = w ? classicWindow(w.get()) : nullptr;
    if (w && !*theWindow)
        return inDesk; // a window of the library's own
    return part;
}

void DragWindow(WindowPtr window, Point, const Rect*)
{
    // The window manager moved the window while the user dragged its title bar.
    if (PortLink* link = win(window, "DragWindow")) {
        finishClick();
        Velmar::SelectWindow(link->window);
        pushWindowRecord(*link);
        relinkWindowList();
    }
}

Boolean TrackGoAway(WindowPtr window, Point)
{
    PortLink* link = win(window, "TrackGoAway");
    if (!link || !answeringClickFor(link->window, inGoAway))
        return false;
    finishClick();
    return true;
}

Boolean TrackBox(WindowPtr window, Point, short partCode)
{
    PortLink* link = win(window, "TrackBox");
    return link && answeringClickFor(link->window, partCode) != nullptr;
}

long GrowWindow(WindowPtr window, Point startPt, const Rect* sizeRect)
{
    PortLink* link = win(window, "GrowWindow");
    if (!link)
        return 0;
    if (answeringClickFor(link->window, inGrow)) {
        // The window manager resized the window: its size now is the answer.
        finishClick();
        Rect content{};
        Velmar::GetWindowBounds(link->window, Velmar::kWindowContentRgn, &content);
        long width = content.right - content.left, height = content.bottom - content.top;
        if (sizeRect) {
            width =
                std::clamp<long>(width, sizeRect->left, std::max(sizeRect->left, sizeRect->right));
            height =
                std::clamp<long>(height, sizeRect->top, std::max(sizeRect->top, sizeRect->bottom));
        }
        return (height << 16) | (width & 0xFFFF);
    }
    const Velmar::SInt32 size = Velmar::GrowWindow(link->window, startPt, sizeRect);
    return long(size);
}

void ZoomWindow(WindowPtr window, short partCode, Boolean front)
{
    PortLink* link = win(window, "ZoomWindow");
    if (!link)
        return;
    if (answeringClickFor(link->window, partCode)) {
        // The window manager zoomed the window already.
        finishClick();
    } else {
        OwnGeometryChange own;
        Velmar::ZoomWindow(link->window, partCode, front);
    }
    pushWindowRecord(*link);
    pushRegions(*link);
}

void SizeWindow(WindowPtr window, short w, short h, Boolean fUpdate)
{
    if (PortLink* link = win(window, "SizeWindow")) {
        Rect content{};
        Velmar::GetWindowBounds(link->window, Velmar::kWindowContentRgn, &content);
        if (content.right - content.left != w || content.bottom - content.top != h) {
            OwnGeometryChange own;
            Velmar::SizeWindow(link->window, w, h, fUpdate);
        }
        pushWindowRecord(*link);
        pushRegions(*link);
    }
}

void MoveWindow(WindowPtr window, short hGlobal, short vGlobal, Boolean front)
{
    if (PortLink* link = win(window, "MoveWindow")) {
        {
            OwnGeometryChange own;
            Velmar::MoveWindow(link->window, hGlobal, vGlobal, front);
        }
        pushWindowRecord(*link);
        relinkWindowList();
    }
}

void SetWTitle(WindowPtr window, ConstStr255Param title)
{
    PortLink* link = win(window, "SetWTitle");
    if (!link || !VELMAR_ASSERT(title, "title != NULL"))
        return;
    Velmar::SetWTitle(link->window, title);
    WindowPeek w = reinterpret_cast<WindowPeek>(link->record);
    if (w->titleHandle && isLiveHandle(reinterpret_cast<Handle>(w->titleHandle)))
        DisposeHandle(reinterpret_cast<Handle>(w->titleHandle));
    w->titleHandle = newStringHandle(title);
}

void GetWTitle(WindowPtr window, Str255 title)
{
    PortLink* link = win(window, "GetWTitle");
    if (link && VELMAR_ASSERT(title, "title != NULL"))
        Velmar::GetWTitle(link->window, title);
}

// The record's refCon is the one a program reads and writes directly.
void SetWRefCon(WindowPtr window, long data)
{
    if (PortLink* link = win(window, "SetWRefCon"))
        reinterpret_cast<WindowPeek>(link->record)->refCon = data;
}

long GetWRefCon(WindowPtr window)
{
    PortLink* link = win(window, "GetWRefCon");
    return link ? reinterpret_cast<WindowPeek>(link->record)->refCon : 0;
}

void BeginUpdate(WindowPtr window)
{
    if (PortLink* link = win(window, "BeginUpdate")) {
        pushWindowRecord(*link); // the update region as it is before the update
        Velmar::BeginUpdate(link->window);
        pushRegions(*link);
    }
}

void EndUpdate(WindowPtr window)
{
    if (PortLink* link = win(window, "EndUpdate")) {
        Velmar::EndUpdate(link->window);
        pushRegions(*link);
        pushWindowRecord(*link);
    }
}

namespace {
PortLink* currentWindowLink(const char* call)
{
    ensureStarted();
    PortLink* link = currentLink();
    if (!link || !link->window) {
        Velmar::VelmarLog(
            Velmar::kLogWindowManagement, "warning: %s: the current port is no window", call);
        return nullptr;
    }
    return link;
}
} // namespace

void InvalRect(const Rect* badRect)
{
    PortLink* link = currentWindowLink("InvalRect");
    if (link && VELMAR_ASSERT(badRect, "badRect != NULL")) {
        Velmar::InvalWindowRect(link->window, badRect);
        setRegionFromWindow(reinterpret_cast<WindowPeek>(link->record)->updateRgn, link->window,
            Velmar::kWindowUpdateRgn);
    }
}

void InvalRgn(RgnHandle badRgn)
{
    PortLink* link = currentWindowLink("InvalRgn");
    Velmar::RgnHandle r = link ? libraryRegion(badRgn, "InvalRgn") : nullptr;
    if (r) {
        Velmar::InvalWindowRgn(link->window, r);
        setRegionFromWindow(reinterpret_cast<WindowPeek>(link->record)->updateRgn, link->window,
            Velmar::kWindowUpdateRgn);
    }
}

void ValidRect(const Rect* goodRect)
{
    PortLink* link = currentWindowLink("ValidRect");
    if (link && VELMAR_ASSERT(goodRect, "goodRect != NULL")) {
        Velmar::ValidWindowRect(link->window, goodRect);
        setRegionFromWindow(reinterpret_cast<WindowPeek>(link->record)->updateRgn, link->window,
            Velmar::kWindowUpdateRgn);
    }
}

void ValidRgn(RgnHandle goodRgn)
{
    PortLink* link = currentWindowLink("ValidRgn");
    Velmar::RgnHandle r = link ? libraryRegion(goodRgn, "ValidRgn") : nullptr;
    if (r) {
        Velmar::ValidWindowRgn(link->window, r);
        setRegionFromWindow(reinterpret_cast<WindowPeek>(link->record)->updateRgn, link->window,
            Velmar::kWindowUpdateRgn);
    }
}

namespace {
CGrafPort gWMgrPort;
} // namespace

void GetCWMgrPort(CGrafPtr* wMgrCPort)
{
    if (!VELMAR_ASSERT(wMgrCPort, "wMgrCPort != NULL"))
        return;
    ensureStarted();
    auto* record = reinterpret_cast<GrafPtr>(&gWMgrPort);
    if (!linkOf(record)) {
        // The whole screen as a port of its own.
        auto* link = new PortLink;
        link->record = record;
        link->ownPort = Velmar::CreateNewPort();
        initPortRecord(*link, true);
        registerPort(link);
        const Rect& screen = globals()->screenBits.bounds;
        Velmar::GrafPtr saved = nullptr;
        Velmar::GetPort(&saved);
        Velmar::SetPort(link->ownPort);
        Velmar::PortSize(short(screen.right - screen.left), short(screen.bottom - screen.top));
        Velmar::SetPort(saved);
        pushGeometry(*link);
        pushRegions(*link);
    }
    *wMgrCPort = &gWMgrPort;
}

void GetWMgrPort(GrafPtr* wPort)
{
    if (!VELMAR_ASSERT(wPort, "wPort != NULL"))
        return;
    CGrafPtr port = nullptr;
    GetCWMgrPort(&port);
    *wPort = reinterpret_cast<GrafPtr>(port);
}

void DrawGrowIcon(WindowPtr window)
{
    // The window system draws the frame, grow box included.
    win(window, "DrawGrowIcon");
}

void SystemClick(const EventRecord*, WindowPtr)
{}

CGrafPtr GetWindowPort(WindowPtr window)
{
    return win(window, "GetWindowPort") ? reinterpret_cast<CGrafPtr>(window) : nullptr;
}

void SetPortWindowPort(WindowPtr window)
{
    if (win(window, "SetPortWindowPort"))
        SetPort(window);
}

RgnHandle GetGrayRgn()
{
    ensureStarted();
    static RgnHandle gray = nullptr;
    if (!gray)
        gray = newClassicRegion();
    setRegion(gray, *Velmar::GetGrayRgn());
    return gray;
}
