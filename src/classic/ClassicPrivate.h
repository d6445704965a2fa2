// What the classic layer's files share: the library's public interface, the classic headers
// (their Rect and Point are the library's), and the records the layer keeps for each library
// object a classic program holds.
//
// Names: at global scope an unqualified name is the classic one (GrafPtr, RgnHandle, NewRgn);
// the library's are always written Velmar::. The layer's own helpers live in VelmarClassic.
#pragma once

#include <Velmar/Velmar.h>

#include <QByteArray>
#include <QPointer>
#include <QRegion>
#include <QString>

#include <optional>
#include <unordered_map>
#include <vector>

#define VELMAR_CLASSIC_SHARES_RECT 1
#define VELMAR_CLASSIC_IMPLEMENTATION 1
#include "ClassicToolbox.h"

namespace VelmarClassic {

// ---- Start -----------------------------------------------------------------------------
// Makes the application (once) and opens the program's resource file. Every entry point that
// needs Qt calls it first.
void ensureStarted();

// ---- Memory ----------------------------------------------------------------------------
// A handle of the classic layer: master pointer and size. Resource handles are ones too.
bool isLiveHandle(Handle h);
Handle newHandleFrom(const QByteArray& bytes);
QByteArray handleBytes(Handle h);
void setMemError(OSErr err);
StringHandle newStringHandle(ConstStr255Param s);
// A resource handle given back to memory (disposed): the resource forgets it.
void forgetResourceHandle(Handle h);
void markResourceHandle(Handle h, bool resource);

// ---- Regions ---------------------------------------------------------------------------
// The library region behind a classic region handle; null (after the library's assertion)
// for a handle the layer did not make or has disposed.
Velmar::RgnHandle libraryRegion(::RgnHandle rgn, const char* call);
::RgnHandle newClassicRegion();
// rgnBBox and rgnSize after the library region changed.
void syncRegion(::RgnHandle rgn);
void setRegion(::RgnHandle rgn, const QRegion& region);

// ---- Ports and windows -----------------------------------------------------------------
struct PortShadow {
    Point pnLoc{};
    Point pnSize{1, 1};
    short pnMode = patCopy;
    Pattern pnPat{};
    short txFont = 0;
    Style txFace = 0;
    short txMode = srcOr;
    short txSize = 0;
};

struct PortLink {
    ::GrafPtr record = nullptr;
    Velmar::AQtWindow* window = nullptr; // a window's port: the window's current port
    Velmar::GrafPtr ownPort = nullptr; // any other port
    PixMap pixMap{}; // what a colour port's portPixMap shows
    PixMap* pixMapMaster = nullptr;
    bool ownsStorage = false;
    bool colour = false;
    PortShadow shadow;
    // A port that is no window draws into the program's own bitmap once its portBits name
    // the program's memory (SetPortBits, or the record written directly): the library port
    // is then the bitmap's size and the memory is kept in step with it (ProgramBits.cpp).
    BitMap boundBits{}; // baseAddr null: not bound
    QByteArray bitsSeen; // the bitmap's bytes as last read or written by the layer
    std::vector<Velmar::UInt32> worldSeen; // the library port's pixels as last written back
    Velmar::GrafPtr port() const;
};

PortLink* linkOf(::GrafPtr port);
PortLink* windowLink(Velmar::AQtWindow* window);
// The classic port's link, or null after the library's assertion.
PortLink* checkedPort(::GrafPtr port, const char* call);
PortLink* checkedWindow(::WindowPtr window, const char* call);
PortLink* currentLink();
::GrafPtr classicWindow(Velmar::AQtWindow* window);

void initPortRecord(PortLink& link, bool colour);
void releasePortRecord(PortLink& link);
void registerPort(PortLink* link);
void forgetPort(PortLink* link);
// Record fields the program may have written, handed to the library (before drawing).
void pullPort(PortLink& link);
// The library's state written back into the record (after a call changed it).
void pushPen(PortLink& link);
void pushGeometry(PortLink& link);
void pushRegions(PortLink& link);
void pushWindowRecord(PortLink& link);
// Every window record's nextWindow, in the window list's order.
void relinkWindowList();

// ---- A program's own bitmaps (ProgramBits.cpp) ---------------------------------------------
// Binds a port that is no window to the bitmap its portBits name (or unbinds it) and reads
// the program's memory into the library port when the program changed it. pullPort calls it.
void loadProgramBits(PortLink& link);
// Writes the library port's pixels back into the program's bitmap (after each drawing call).
void storeProgramBits(PortLink& link);
bool boundToProgramBits(const PortLink& link);
// CopyBits of a program's bitmap (its bounds whole) onto dstRect of the current port.
void copyIntoCurrentPort(const Velmar::BitMap& bits, const Rect& dstRect, short mode);
// The port whose record's portBits (or colour pixmap) is at `bits`; null for any other map.
PortLink* portOfBits(const void* bits);

// Runs a drawing call on the current port with the record's fields handed over first and the
// pen written back afterwards. Does nothing without a current port.
template <typename Call> void drawInPort(Call&& call)
{
    PortLink* link = currentLink();
    if (!link)
        return;
    pullPort(*link);
    call();
    pushPen(*link);
    storeProgramBits(*link);
}

// Patterns given through the classic calls paint their set bits in the pen colour.
Velmar::Pattern libraryPattern(const Pattern* classic);
QDGlobals* globals();

// ---- Events --------------------------------------------------------------------------------
// A click the window manager or Qt took (frame, menu bar), handed to the program as a
// mouse-down that FindWindow places in `part`.
struct FrameClick {
    short part = 0;
    QPointer<Velmar::AQtWindow> window;
    Point where{};
    bool delivered = false;
};
void watchWindow(Velmar::AQtWindow* window);
void watchMenuBar();
void queueFrameClick(short part, Velmar::AQtWindow* window);
bool takeFrameClick(EventRecord* event, short mask);
bool frameClickWaiting();
// The click FindWindow placed last, while the program answers it.
const FrameClick* answeringClick(Point where);
FrameClick* answeringClickFor(Velmar::AQtWindow* window, short part);
void finishClick();
// Changes the layer makes to a window's geometry itself are no user's clicks.
struct OwnGeometryChange {
    OwnGeometryChange();
    ~OwnGeometryChange();
};
void flushAllPorts();
// The library's record of the event last handed to the program (TEKey takes it).
Velmar::EventRecord* lastLibraryEvent();

// ---- Resources ----------------------------------------------------------------------------
// The resource's bytes from the open files, searched from the current one down; empty and
// ResError set when there is none.
std::optional<QByteArray> resourceBytes(ResType type, short id);
QByteArray toQByteArray(ConstStr255Param s);
void copyToStr255(const QByteArray& bytes, unsigned char* out);

// ---- Menus --------------------------------------------------------------------------------
Velmar::MenuRef libraryMenu(MenuHandle menu, const char* call);
MenuHandle classicMenu(Velmar::MenuRef menu);

} // namespace VelmarClassic
