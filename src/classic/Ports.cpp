// Classic ports: the records programs read (portRect, portBits, visRgn, clipRgn, the pen and
// text fields), each linked to a library port and kept in step with it; the current port.
#include "classic/ClassicPrivate.h"

#include <cstddef>
#include <cstring>

// Both records keep their shared fields at the same places (either pointer reads either).
static_assert(offsetof(GrafPort, portRect) == offsetof(CGrafPort, portRect));
static_assert(offsetof(GrafPort, clipRgn) == offsetof(CGrafPort, clipRgn));
static_assert(offsetof(GrafPort, pnLoc) == offsetof(CGrafPort, pnLoc));
static_assert(offsetof(GrafPort, pnVis) == offsetof(CGrafPort, pnVis));
static_assert(offsetof(GrafPort, txSize) == offsetof(CGrafPort, txSize));
static_assert(offsetof(GrafPort, grafProcs) == offsetof(CGrafPort, grafProcs));
static_assert(sizeof(GrafPort) == sizeof(CGrafPort));
static_assert(sizeof(WindowRecord) == sizeof(CWindowRecord));

namespace VelmarClassic {

namespace {

std::unordered_map<::GrafPtr, PortLink*>& ports()
{
    static auto* map = new std::unordered_map<::GrafPtr, PortLink*>;
    return *map;
}
std::unordered_map<Velmar::AQtWindow*, PortLink*>& windows()
{
    static auto* map = new std::unordered_map<Velmar::AQtWindow*, PortLink*>;
    return *map;
}

bool samePoint(Point a, Point b)
{
    return a.h == b.h && a.v == b.v;
}

} // namespace

Velmar::GrafPtr PortLink::port() const
{
    // A window remakes its port when its drawing mode changes: ask each time.
    return window ? Velmar::GetWindowPort(window) : ownPort;
}

PortLink* linkOf(::GrafPtr port)
{
    const auto it = ports().find(port);
    return it == ports().end() ? nullptr : it->second;
}

PortLink* windowLink(Velmar::AQtWindow* window)
{
    const auto it = windows().find(window);
    return it == windows().end() ? nullptr : it->second;
}

PortLink* portOfBits(const void* bits)
{
    for (const auto& [record, link] : ports())
        if (bits == &record->portBits || (link->colour && bits == &link->pixMap))
            return link;
    return nullptr;
}

::GrafPtr classicWindow(Velmar::AQtWindow* window)
{
    PortLink* link = windowLink(window);
    return link ? link->record : nullptr;
}

PortLink* checkedPort(::GrafPtr port, const char*)
{
    if (!VELMAR_ASSERT(port, "port != NULL"))
        return nullptr;
    PortLink* link = linkOf(port);
    return VELMAR_ASSERT(link, "IsValidPort(port)") ? link : nullptr;
}

PortLink* checkedWindow(::WindowPtr window, const char*)
{
    if (!VELMAR_ASSERT(window, "window != NULL"))
        return nullptr;
    PortLink* link = linkOf(window);
    if (!VELMAR_ASSERT(link && link->window, "IsValidWindowPtr(window)"))
        return nullptr;
    return link;
}

PortLink* currentLink()
{
    ::GrafPtr current = globals()->thePort;
    PortLink* link = current ? linkOf(current) : nullptr;
    if (!link || !link->port())
        return nullptr;
    // The library's current port follows the classic one even where a program changed it
    // behind the layer's back (SetPortWindowPort, the library's own calls).
    Velmar::GrafPtr library = nullptr;
    Velmar::GetPort(&library);
    if (library != link->port())
        Velmar::SetPort(link->port());
    return link;
}

void registerPort(PortLink* link)
{
    ports()[link->record] = link;
    if (link->window)
        windows()[link->window] = link;
}

void forgetPort(PortLink* link)
{
    ports().erase(link->record);
    if (link->window)
        windows().erase(link->window);
    if (globals()->thePort == link->record) {
        globals()->thePort = nullptr;
        ::thePort = nullptr;
    }
}

void initPortRecord(PortLink& link, bool colour)
{
    GrafPort* r = link.record;
    std::memset(r, 0, sizeof(GrafPort));
    link.colour = colour;
    r->visRgn = newClassicRegion();
    r->clipRgn = newClassicRegion();
    r->pnSize = Point{1, 1};
    r->pnMode = patCopy;
    r->txMode = srcOr;
    r->fgColor = blackColor;
    r->bkColor = whiteColor;
    if (colour) {
        auto* c = reinterpret_cast<CGrafPort*>(r);
        link.pixMapMaster = &link.pixMap;
        c->portPixMap = &link.pixMapMaster;
        c->portVersion = short(0xC000);
        c->rgbFgColor = RGBColor{0, 0, 0};
        c->rgbBkColor = RGBColor{0xFFFF, 0xFFFF, 0xFFFF};
        link.pixMap.pixelSize = 32;
        link.pixMap.cmpCount = 3;
        link.pixMap.cmpSize = 8;
        link.pixMap.hRes = link.pixMap.vRes = 72L << 16;
    } else {
        std::memset(r->pnPat.pat, 0xFF, 8);
        std::memset(r->fillPat.pat, 0xFF, 8);
    }
    link.shadow = PortShadow{};
    link.shadow.pnPat = r->pnPat;
}

void releasePortRecord(PortLink& link)
{
    DisposeRgn(link.record->visRgn);
    DisposeRgn(link.record->clipRgn);
    link.record->visRgn = link.record->clipRgn = nullptr;
}

void pullPort(PortLink& link)
{
    loadProgramBits(link);
    GrafPort* r = link.record;
    PortShadow& s = link.shadow;
    if (!samePoint(r->pnLoc, s.pnLoc))
        Velmar::MoveTo(r->pnLoc.h, r->pnLoc.v);
    if (!samePoint(r->pnSize, s.pnSize))
        Velmar::PenSize(r->pnSize.h, r->pnSize.v);
    if (r->pnMode != s.pnMode)
        Velmar::PenMode(r->pnMode);
    if (!link.colour && std::memcmp(r->pnPat.pat, s.pnPat.pat, 8) != 0) {
        const Velmar::Pattern p = libraryPattern(&r->pnPat);
        Velmar::PenPat(&p);
    }
    if (r->txFont != s.txFont)
        Velmar::TextFont(r->txFont);
    if (r->txFace != s.txFace)
        Velmar::TextFace(r->txFace);
    if (r->txSize != s.txSize)
        Velmar::TextSize(r->txSize);
    if (r->txMode != s.txMode)
        Velmar::TextMode(r->txMode == srcBic ? short(srcOr) : r->txMode);
    s.pnLoc = r->pnLoc;
    s.pnSize = r->pnSize;
    s.pnMode = r->pnMode;
    s.pnPat = r->pnPat;
    s.txFont = r->txFont;
    s.txFace = r->txFace;
    s.txSize = r->txSize;
    s.txMode = r->txMode;
}

void pushPen(PortLink& link)
{
    Point p{};
    Velmar::GetPen(&p);
    link.record->pnLoc = link.shadow.pnLoc = p;
}

void pushGeometry(PortLink& link)
{
    Velmar::GrafPtr port = link.port();
    // A port on the program's bitmap keeps the portRect and portBits the program gave it.
    loadProgramBits(link);
    if (!port || boundToProgramBits(link))
        return;
    GrafPort* r = link.record;
    Velmar::GetPortBounds(port, &r->portRect);
    // portBits.bounds: the screen in the port's coordinates.
    Rect bounds = globals()->screenBits.bounds;
    Rect global = r->portRect;
    Velmar::QDLocalToGlobalRect(port, &global);
    Velmar::OffsetRect(
        &bounds, short(r->portRect.left - global.left), short(r->portRect.top - global.top));
    if (link.colour) {
        link.pixMap.bounds = bounds;
        link.pixMap.rowBytes = short(0x8000 | 0x3FFF);
    } else {
        r->portBits.bounds = bounds;
        r->portBits.rowBytes = globals()->screenBits.rowBytes;
    }
}

void pushRegions(PortLink& link)
{
    Velmar::GrafPtr port = link.port();
    if (!port)
        return;
    if (Velmar::RgnHandle vis = libraryRegion(link.record->visRgn, "visRgn")) {
        Velmar::GetPortVisibleRegion(port, vis);
        syncRegion(link.record->visRgn);
    }
    if (Velmar::RgnHandle clip = libraryRegion(link.record->clipRgn, "clipRgn")) {
        Velmar::GetPortClipRegion(port, clip);
        syncRegion(link.record->clipRgn);
    }
}

Velmar::Pattern libraryPattern(const Pattern* classic)
{
    // The library paints a pattern's set bits as paper; classic programs expect them inked.
    Velmar::Pattern p{};
    for (int i = 0; i < 8; ++i)
        p.pat[i] = Velmar::UInt8(~classic->pat[i]);
    return p;
}

} // namespace VelmarClassic

using namespace VelmarClassic;

void SetPort(GrafPtr port)
{
    PortLink* link = checkedPort(port, "SetPort");
    if (!link || !link->port())
        return;
    globals()->thePort = port;
    ::thePort = port;
    Velmar::SetPort(link->port());
    pullPort(*link);
    pushGeometry(*link);
    pushRegions(*link);
}

void GetPort(GrafPtr* port)
{
    if (VELMAR_ASSERT(port, "port != NULL"))
        *port = globals()->thePort;
}

void OpenPort(GrafPtr port)
{
    if (!VELMAR_ASSERT(port, "port != NULL") || linkOf(port))
        return;
    ensureStarted();
    auto* link = new PortLink;
    link->record = port;
    link->ownPort = Velmar::CreateNewPort();
    // A new port covers the screen until the program gives it a bitmap of its own.
    Velmar::SetPortBounds(link->ownPort, &globals()->screenBits.bounds);
    initPortRecord(*link, false);
    registerPort(link);
    SetPort(port);
}

void InitPort(GrafPtr port)
{
    if (PortLink* link = checkedPort(port, "InitPort")) {
        Velmar::GrafPtr saved = nullptr;
        Velmar::GetPort(&saved);
        Velmar::SetPort(link->port());
        Velmar::PenNormal();
        Velmar::SetPort(saved);
        const bool colour = link->colour;
        releasePortRecord(*link);
        initPortRecord(*link, colour);
        pushGeometry(*link);
        pushRegions(*link);
    }
}

void ClosePort(GrafPtr port)
{
    PortLink* link = checkedPort(port, "ClosePort");
    if (!link || link->window)
        return;
    forgetPort(link);
    releasePortRecord(*link);
    Velmar::DisposePort(link->ownPort);
    delete link;
}

void SetOrigin(short h, short v)
{
    if (PortLink* link = currentLink()) {
        loadProgramBits(*link);
        if (boundToProgramBits(*link)) {
            // The bitmap's coordinates move with the port's, as the classic call moved
            // portRect and portBits.bounds together.
            GrafPort* r = link->record;
            const short dh = short(h - r->portRect.left), dv = short(v - r->portRect.top);
            Velmar::OffsetRect(&r->portRect, dh, dv);
            Velmar::OffsetRect(&r->portBits.bounds, dh, dv);
            link->boundBits.bounds = r->portBits.bounds;
            Velmar::SetPortBounds(link->port(), &r->portBits.bounds);
            pushRegions(*link);
            pushPen(*link);
            return;
        }
        Velmar::SetOrigin(h, v);
        pushGeometry(*link);
        pushRegions(*link);
        pushPen(*link);
    }
}

void PortSize(short width, short height)
{
    if (PortLink* link = currentLink()) {
        loadProgramBits(*link);
        if (boundToProgramBits(*link)) {
            // The bitmap keeps its size; only the record's rectangle changes.
            link->record->portRect.right = short(link->record->portRect.left + width);
            link->record->portRect.bottom = short(link->record->portRect.top + height);
            return;
        }
        Velmar::PortSize(width, height);
        pushGeometry(*link);
    }
}

void SetClip(RgnHandle rgn)
{
    PortLink* link = currentLink();
    Velmar::RgnHandle r = libraryRegion(rgn, "SetClip");
    if (link && r) {
        Velmar::SetClip(r);
        pushRegions(*link);
    }
}

void GetClip(RgnHandle rgn)
{
    PortLink* link = currentLink();
    Velmar::RgnHandle r = libraryRegion(rgn, "GetClip");
    if (link && r) {
        Velmar::GetClip(r);
        syncRegion(rgn);
    }
}

void ClipRect(const Rect* r)
{
    PortLink* link = currentLink();
    if (link && VELMAR_ASSERT(r, "r != NULL")) {
        Velmar::ClipRect(r);
        pushRegions(*link);
    }
}

void GlobalToLocal(Point* pt)
{
    if (currentLink() && VELMAR_ASSERT(pt, "pt != NULL"))
        Velmar::GlobalToLocal(pt);
}

void LocalToGlobal(Point* pt)
{
    if (currentLink() && VELMAR_ASSERT(pt, "pt != NULL"))
        Velmar::LocalToGlobal(pt);
}

void QDFlushPortBuffer(CGrafPtr port, RgnHandle)
{
    if (PortLink* link = checkedPort(reinterpret_cast<GrafPtr>(port), "QDFlushPortBuffer"))
        Velmar::QDFlushPortBuffer(link->port(), nullptr);
}

// ---- The pen ----------------------------------------------------------------------------

void HidePen()
{
    if (PortLink* link = currentLink()) {
        Velmar::HidePen();
        --link->record->pnVis;
    }
}

void ShowPen()
{
    if (PortLink* link = currentLink()) {
        Velmar::ShowPen();
        ++link->record->pnVis;
    }
}

void GetPen(Point* pt)
{
    PortLink* link = currentLink();
    if (link && VELMAR_ASSERT(pt, "pt != NULL")) {
        pullPort(*link);
        Velmar::GetPen(pt);
    }
}

void GetPenState(PenState* state)
{
    PortLink* link = currentLink();
    if (!link || !VELMAR_ASSERT(state, "pnState != NULL"))
        return;
    pullPort(*link);
    pushPen(*link);
    state->pnLoc = link->record->pnLoc;
    state->pnSize = link->record->pnSize;
    state->pnMode = link->record->pnMode;
    state->pnPat = link->shadow.pnPat;
}

void SetPenState(const PenState* state)
{
    PortLink* link = currentLink();
    if (!link || !VELMAR_ASSERT(state, "pnState != NULL"))
        return;
    GrafPort* r = link->record;
    r->pnLoc = state->pnLoc;
    r->pnSize = state->pnSize;
    r->pnMode = state->pnMode;
    if (!link->colour)
        r->pnPat = state->pnPat;
    else {
        const Velmar::Pattern p = libraryPattern(&state->pnPat);
        Velmar::PenPat(&p);
        link->shadow.pnPat = state->pnPat;
    }
    pullPort(*link);
}

void PenSize(short width, short height)
{
    if (PortLink* link = currentLink()) {
        link->record->pnSize = Point{height, width};
        pullPort(*link);
    }
}

void PenMode(short mode)
{
    if (PortLink* link = currentLink()) {
        link->record->pnMode = mode;
        pullPort(*link);
    }
}

void PenPat(const Pattern* pat)
{
    PortLink* link = currentLink();
    if (!link || !VELMAR_ASSERT(pat, "pat != NULL"))
        return;
    if (!link->colour) {
        link->record->pnPat = *pat;
        pullPort(*link);
        return;
    }
    const Velmar::Pattern p = libraryPattern(pat);
    Velmar::PenPat(&p);
    link->shadow.pnPat = *pat;
}

void PenNormal()
{
    PortLink* link = currentLink();
    if (!link)
        return;
    GrafPort* r = link->record;
    r->pnSize = Point{1, 1};
    r->pnMode = patCopy;
    Pattern black;
    std::memset(black.pat, 0xFF, 8);
    if (!link->colour)
        r->pnPat = black;
    else {
        const Velmar::Pattern p = libraryPattern(&black);
        Velmar::PenPat(&p);
        link->shadow.pnPat = black;
    }
    pullPort(*link);
}

void BackPat(const Pattern* pat)
{
    PortLink* link = currentLink();
    if (!link || !VELMAR_ASSERT(pat, "pat != NULL"))
        return;
    const Velmar::Pattern p = libraryPattern(pat);
    Velmar::BackPat(&p);
    if (!link->colour)
        link->record->bkPat = *pat;
}

// ---- Colours ------------------------------------------------------------------------------

namespace {

Velmar::RGBColor classicColour(long color)
{
    switch (color) {
    case whiteColor: return {0xFFFF, 0xFFFF, 0xFFFF};
    case redColor: return {0xFFFF, 0, 0};
    case greenColor: return {0, 0xFFFF, 0};
    case blueColor: return {0, 0, 0xFFFF};
    case cyanColor: return {0, 0xFFFF, 0xFFFF};
    case magentaColor: return {0xFFFF, 0, 0xFFFF};
    case yellowColor: return {0xFFFF, 0xFFFF, 0};
    default: return {0, 0, 0}; // blackColor and anything unknown
    }
}

void recordColours(PortLink& link)
{
    if (!link.colour)
        return;
    auto* c = reinterpret_cast<CGrafPort*>(link.record);
    Velmar::RGBColor fore, back;
    Velmar::GetForeColor(&fore);
    Velmar::GetBackColor(&back);
    c->rgbFgColor = RGBColor{fore.red, fore.green, fore.blue};
    c->rgbBkColor = RGBColor{back.red, back.green, back.blue};
}

} // namespace

void ForeColor(long color)
{
    if (PortLink* link = currentLink()) {
        const Velmar::RGBColor c = classicColour(color);
        Velmar::RGBForeColor(&c);
        link->record->fgColor = color;
        recordColours(*link);
    }
}

void BackColor(long color)
{
    if (PortLink* link = currentLink()) {
        const Velmar::RGBColor c = classicColour(color);
        Velmar::RGBBackColor(&c);
        link->record->bkColor = color;
        recordColours(*link);
    }
}

void RGBForeColor(const RGBColor* color)
{
    PortLink* link = currentLink();
    if (link && VELMAR_ASSERT(color, "color != NULL")) {
        const Velmar::RGBColor c(color->red, color->green, color->blue);
        Velmar::RGBForeColor(&c);
        recordColours(*link);
    }
}

void RGBBackColor(const RGBColor* color)
{
    PortLink* link = currentLink();
    if (link && VELMAR_ASSERT(color, "color != NULL")) {
        const Velmar::RGBColor c(color->red, color->green, color->blue);
        Velmar::RGBBackColor(&c);
        recordColours(*link);
    }
}

void GetForeColor(RGBColor* color)
{
    if (currentLink() && VELMAR_ASSERT(color, "color != NULL")) {
        Velmar::RGBColor c;
        Velmar::GetForeColor(&c);
        *color = RGBColor{c.red, c.green, c.blue};
    }
}

void GetBackColor(RGBColor* color)
{
    if (currentLink() && VELMAR_ASSERT(color, "color != NULL")) {
        Velmar::RGBColor c;
        Velmar::GetBackColor(&c);
        *color = RGBColor{c.red, c.green, c.blue};
    }
}

// QuickDraw's generator: seed = seed * 16807 mod (2^31 - 1), answered as a signed word.
long Random()
{
    QDGlobals* g = globals();
    // The plain global of older compilers wins when the program set it.
    static long lastSeen = 1;
    long seed = (::randSeed != lastSeen) ? ::randSeed : g->randSeed;
    long long s = (long long)(seed & 0x7FFFFFFF);
    if (s == 0)
        s = 1;
    s = (s * 16807) % 0x7FFFFFFF;
    g->randSeed = ::randSeed = lastSeen = long(s);
    short value = short(s & 0xFFFF);
    if (value == -32768)
        value = 0;
    return value;
}

Boolean GetPixel(short h, short v)
{
    PortLink* link = currentLink();
    if (!link)
        return false;
    Velmar::RGBColor c;
    Velmar::GetCPixel(h, v, &c);
    return (int(c.red) + c.green + c.blue) / 3 < 0x8000;
}
