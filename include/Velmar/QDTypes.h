// QuickDraw handle and value types shared by the port, pen, shape and region headers.
// Kept tiny so that every QuickDraw header can include it without pulling in Qt.
#pragma once

#include <Velmar/MacTypes.h>

class QRegion;
class QPolygon;

namespace Velmar {

class QtGrafPort;
class AQtWindow;
class PixMapPtr;
class BitMapPtr;
class PatPtr;
class PenState;
struct PolyPtr;

// A port handle; offscreen worlds are handed out as ports too.
using GrafPtr = QtGrafPort*;
using CGrafPtr = GrafPtr;
using GWorldPtr = GrafPtr;

// A region handle is a pointer to a heap-allocated QRegion owned by whoever made it.
using RgnHandle = QRegion*;

// Eight rows of eight one-bit pixels, top row first.
struct Pattern {
    UInt8 pat[8];
};

using GWorldFlags = UInt32;

// Pen modes (transfer modes) as the host passes them to PenMode.
enum : SInt16 {
    srcCopy = 0,
    srcOr = 1,
    srcXor = 2,
    srcBic = 3,
    notSrcCopy = 4,
    notSrcOr = 5,
    notSrcXor = 6,
    notSrcBic = 7,
    patCopy = 8,
    patOr = 9,
    patXor = 10,
    patBic = 11,
    notPatCopy = 12,
    notPatOr = 13,
    notPatXor = 14,
    notPatBic = 15,
    subPin = 35,
};

// UpdateGWorld's answer when the world had to be reallocated.
enum : UInt32 {
    reallocPix = 0x00100000,
};

// Drawing verbs of the Std* dispatchers and the private drawing helpers.
enum GrafVerb : SInt16 {
    kQDGrafVerbFrame = 0,
    kQDGrafVerbPaint = 1,
    kQDGrafVerbErase = 2,
    kQDGrafVerbInvert = 3,
    kQDGrafVerbFill = 4,
};

} // namespace Velmar
