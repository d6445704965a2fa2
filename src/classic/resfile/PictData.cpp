#include "classic/resfile/PictData.h"

#include <algorithm>
#include <vector>

namespace Velmar::Classic::Pict {

namespace {

constexpr qsizetype kMaxRegionRects = 200000;

// The fields of a PixMap after rowBytes, as a picture stores them (no base address).
struct PixMapHeader {
    qsizetype rowBytes = 0;
    bool isPixMap = false;
    Rect bounds{};
    UInt16 packType = 0;
    UInt16 pixelSize = 1;
    UInt16 cmpCount = 1;
};

void readPixMapHeader(BigEndianReader& in, PixMapHeader& h, bool forcePixMap)
{
    const UInt16 field = in.u16();
    h.isPixMap = forcePixMap || (field & 0x8000);
    h.rowBytes = h.isPixMap ? (field & 0x3FFF) : (field & 0x7FFF);
    h.bounds = in.rect();
    if (!h.isPixMap)
        return;
    in.skip(2); // pmVersion
    h.packType = in.u16();
    in.skip(4 + 4 + 4 + 2); // packSize, hRes, vRes, pixelType
    h.pixelSize = in.u16();
    h.cmpCount = in.u16();
    in.skip(2 + 4 + 4 + 4); // cmpSize, planeBytes, pmTable, pmReserved
}

// A colour table: seed, flags, count - 1, then (value, r, g, b) entries.
bool readColorTable(BigEndianReader& in, QRgb (&palette)[256])
{
    std::fill(std::begin(palette), std::end(palette), qRgb(0, 0, 0));
    in.skip(4);
    const UInt16 flags = in.u16();
    const qint64 count = qint64(in.u16()) + 1;
    if (!in.ok() || !in.has(count * 8)) {
        in.fail();
        return false;
    }
    for (qint64 i = 0; i < count; ++i) {
        const UInt16 value = in.u16();
        const int r = in.u16() >> 8, g = in.u16() >> 8, b = in.u16() >> 8;
        const qint64 index = (flags & 0x8000) ? i : value;
        if (index >= 0 && index < 256)
            palette[index] = qRgb(r, g, b);
    }
    return in.ok();
}

// Reads the rows of a map and turns them into an opaque image (or only skips them when
// `image` is null).
bool readPixels(BigEndianReader& in, const PixMapHeader& h, bool packed, bool direct,
                const QRgb (&palette)[256], QImage* image)
{
    const qint64 width = qint64(h.bounds.right) - h.bounds.left;
    const qint64 height = qint64(h.bounds.bottom) - h.bounds.top;
    if (width <= 0 || height <= 0)
        return true; // nothing stored
    if (width * height > kMaxPixels)
        return false;
    const int depth = h.isPixMap ? h.pixelSize : 1;
    if (depth != 1 && depth != 2 && depth != 4 && depth != 8 && depth != 16 && depth != 32)
        return false;
    const UInt16 packType = h.packType;
    const bool plain = !packed || h.rowBytes < 8 || (direct && packType == 1);
    const bool rgb24 = direct && depth == 32 && packType == 2;
    const bool planar = depth == 32 && !plain && !rgb24;
    const int components = h.cmpCount == 4 ? 4 : 3;
    qsizetype rowLength = h.rowBytes;
    if (rgb24)
        rowLength = width * 3;
    else if (planar)
        rowLength = width * components;
    if (!rgb24 && h.rowBytes < (width * depth + 7) / 8)
        return false;

    // The rows must be there before the image is made: a PackBits unit of two bytes yields
    // at most 128 units, so a short operand cannot claim a huge image.
    const qint64 leastStored = plain || rgb24 ? height * rowLength : height * std::max<qint64>(1, rowLength / 128);
    if (!in.has(leastStored))
        return false;
    if (image) {
        *image = QImage(int(width), int(height), QImage::Format_RGB32);
        if (image->isNull())
            return false;
    }
    QByteArray row;
    for (qint64 y = 0; y < height; ++y) {
        if (plain || rgb24) {
            row = in.bytes(rowLength);
        } else {
            const qsizetype count = h.rowBytes > 250 ? in.u16() : in.u8();
            const QByteArray data = in.bytes(count);
            if (!in.ok())
                return false;
            const int unit = (depth == 16 && (packType == 0 || packType == 3)) ? 2 : 1;
            if (!unpackBits(data, unit, rowLength, row))
                return false;
        }
        if (!in.ok())
            return false;
        if (!image)
            continue;
        auto* line = reinterpret_cast<QRgb*>(image->scanLine(int(y)));
        const auto byte = [&row](qsizetype i) { return UInt8(row[i]); };
        for (qint64 x = 0; x < width; ++x) {
            QRgb c;
            if (depth <= 8) {
                const qsizetype bit = x * depth;
                const int index = (byte(bit / 8) >> (8 - depth - bit % 8)) & ((1 << depth) - 1);
                c = !h.isPixMap ? (index ? qRgb(0, 0, 0) : qRgb(255, 255, 255)) : palette[index];
            } else if (depth == 16) {
                const int w = (byte(x * 2) << 8) | byte(x * 2 + 1);
                const auto five = [](int v) { return (v << 3) | (v >> 2); };
                c = qRgb(five((w >> 10) & 31), five((w >> 5) & 31), five(w & 31));
            } else if (rgb24) {
                c = qRgb(byte(x * 3), byte(x * 3 + 1), byte(x * 3 + 2));
            } else if (planar) {
                const qsizetype first = components == 4 ? width : 0;
                c = qRgb(byte(first + x), byte(first + width + x), byte(first + 2 * width + x));
            } else {
                c = qRgb(byte(x * 4 + 1), byte(x * 4 + 2), byte(x * 4 + 3));
            }
            line[x] = c;
        }
    }
    return true;
}

} // namespace

QRegion readRegion(BigEndianReader& in)
{
    const UInt16 size = in.u16();
    const Rect box = in.rect();
    if (!in.ok() || size < 10) {
        in.fail();
        return {};
    }
    const QByteArray body = in.bytes(size - 10);
    if (!in.ok())
        return {};
    if (size == 10) {
        if (box.right <= box.left || box.bottom <= box.top)
            return {};
        return QRegion(QRect(QPoint(box.left, box.top), QPoint(box.right - 1, box.bottom - 1)));
    }
    // Scan lines of inversion points: each point toggles everything right of and below it.
    BigEndianReader r(body);
    std::vector<int> current; // the toggles in force, sorted
    std::vector<int> points;
    QList<QRect> rects;
    int previous = 0;
    bool first = true;
    while (r.has(2)) {
        const int v = r.s16();
        if (v == 0x7FFF)
            break;
        if (!first && v < previous)
            return {}; // lines out of order: not a region
        if (!first && v > previous) {
            for (size_t i = 0; i + 1 < current.size(); i += 2) {
                if (current[i] < current[i + 1])
                    rects.append(QRect(QPoint(current[i], previous), QPoint(current[i + 1] - 1, v - 1)));
            }
            if (rects.size() > kMaxRegionRects)
                return {};
        }
        points.clear();
        while (r.has(2)) {
            const int h = r.s16();
            if (h == 0x7FFF)
                break;
            points.push_back(h);
        }
        // A point given twice on one line cancels itself: keep those given an odd number of times.
        std::sort(points.begin(), points.end());
        std::vector<int> odd;
        for (size_t i = 0; i < points.size();) {
            size_t j = i;
            while (j < points.size() && points[j] == points[i])
                ++j;
            if ((j - i) % 2)
                odd.push_back(points[i]);
            i = j;
        }
        std::vector<int> toggled;
        std::set_symmetric_difference(current.begin(), current.end(), odd.begin(), odd.end(),
                                      std::back_inserter(toggled));
        current.swap(toggled);
        previous = v;
        first = false;
    }
    QRegion region;
    if (!rects.isEmpty())
        region.setRects(rects.constData(), int(rects.size()));
    return region;
}

QPolygon readPolygon(BigEndianReader& in)
{
    const UInt16 size = in.u16();
    in.rect();
    if (!in.ok() || size < 10 || !in.has(size - 10)) {
        in.fail();
        return {};
    }
    QPolygon poly;
    const int count = (size - 10) / 4;
    poly.reserve(count);
    for (int i = 0; i < count; ++i) {
        const Point p = in.point();
        poly.append(QPoint(p.h, p.v));
    }
    in.skip((size - 10) % 4);
    return poly;
}

bool unpackBits(const QByteArray& packed, int unit, qsizetype expected, QByteArray& out)
{
    out.resize(0);
    out.reserve(expected);
    qsizetype i = 0;
    while (i < packed.size() && out.size() < expected) {
        const int flag = SInt8(packed[i++]);
        if (flag == -128)
            continue;
        if (flag >= 0) {
            const qsizetype n = qsizetype(flag + 1) * unit;
            if (i + n > packed.size() || out.size() + n > expected)
                return false;
            out.append(packed.constData() + i, n);
            i += n;
        } else {
            const qsizetype times = 1 - flag;
            if (i + unit > packed.size() || out.size() + times * unit > expected)
                return false;
            for (qsizetype t = 0; t < times; ++t)
                out.append(packed.constData() + i, unit);
            i += unit;
        }
    }
    return out.size() == expected;
}

bool readPixelOperand(BigEndianReader& in, bool direct, bool packed, bool withMask, PixelOperand& out)
{
    if (direct)
        in.skip(4); // base address placeholder
    PixMapHeader h;
    readPixMapHeader(in, h, direct);
    QRgb palette[256];
    std::fill(std::begin(palette), std::end(palette), qRgb(0, 0, 0));
    if (h.isPixMap && !direct && !readColorTable(in, palette))
        return false;
    out.bounds = h.bounds;
    out.srcRect = in.rect();
    out.dstRect = in.rect();
    out.mode = in.s16();
    out.hasMask = withMask;
    if (withMask)
        out.mask = readRegion(in);
    out.oneBit = !h.isPixMap;
    if (!in.ok())
        return false;
    return readPixels(in, h, packed, direct, palette, &out.image) && in.ok();
}

bool readPixPat(BigEndianReader& in, UInt8 (&oldPattern)[8])
{
    const UInt16 type = in.u16();
    for (UInt8& b : oldPattern)
        b = in.u8();
    if (type == 1) {
        PixMapHeader h;
        readPixMapHeader(in, h, true);
        QRgb palette[256];
        if (!readColorTable(in, palette))
            return false;
        return readPixels(in, h, true, false, palette, nullptr) && in.ok();
    }
    if (type == 2)
        in.skip(6); // an RGB colour the pattern is dithered from
    return in.ok();
}

} // namespace Velmar::Classic::Pict
