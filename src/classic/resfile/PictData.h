// The data structures inside a picture that are more than a few fixed fields: regions,
// polygons, PackBits rows and the pixel images of the bitmap opcodes. Pure decoding, no
// drawing: each reader advances past the structure or fails the reader.
#pragma once

#include "classic/resfile/BigEndian.h"

#include <QImage>
#include <QPolygon>
#include <QRegion>

namespace Velmar::Classic::Pict {

// A region: size word, bounding box, then (unless the size is 10) scan lines of inversion
// points. The region in the picture's coordinates.
QRegion readRegion(BigEndianReader& in);

// A polygon: size word, bounding box, points.
QPolygon readPolygon(BigEndianReader& in);

// PackBits: a flag byte n, then n + 1 literal units (n >= 0) or one unit repeated 1 - n times
// (n < 0, -128 skipped). Units are `unit` bytes (1, or 2 for 16-bit pixels). Unpacks `packed`
// into exactly `expected` bytes; false when the data is short, long or overruns.
bool unpackBits(const QByteArray& packed, int unit, qsizetype expected, QByteArray& out);

// The operand of BitsRect, BitsRgn, PackBitsRect, PackBitsRgn (direct = false) and
// DirectBitsRect, DirectBitsRgn (direct = true): the map, its source and destination
// rectangles, the transfer mode, the mask region and the pixels as an opaque ARGB32 image
// covering `bounds`. `packed` is false for BitsRect/BitsRgn (rows stored as they are).
struct PixelOperand {
    Rect bounds{};
    Rect srcRect{};
    Rect dstRect{};
    SInt16 mode = 0;
    bool hasMask = false;
    QRegion mask;
    bool oneBit = false;     // a BitMap: black and white, drawn in the port's colours
    QImage image;
};
bool readPixelOperand(BigEndianReader& in, bool direct, bool packed, bool withMask, PixelOperand& out);

// A pixel pattern (PnPixPat, FillPixPat, BkPixPat): skipped past; the one-bit pattern that
// stands in for it on one-bit devices is returned.
bool readPixPat(BigEndianReader& in, UInt8 (&oldPattern)[8]);

// Images larger than this many pixels are refused (a hostile size must not allocate
// gigabytes).
constexpr qint64 kMaxPixels = 16 * 1024 * 1024;

} // namespace Velmar::Classic::Pict
