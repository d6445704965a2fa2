// CopyBits and its family against expectations worked out here pixel by pixel (in floating
// point, from the rules the header states), pixmaps a host writes itself, one-bit maps in
// the host's memory, and regions made from pixels against regions built a pixel at a time.
#include "QuickDrawTestSupport.h"

#include <Velmar/MacErrors.h>
#include <Velmar/QDBitmaps.h>
#include <Velmar/Resources.h>

#include <QRandomGenerator>

#include <algorithm>
#include <cmath>
#include <functional>

using namespace Velmar;
using namespace QDTest;
using Velmar::Private::makeRect;

namespace {

struct Ink {
    QRgb fore, back, op;
};
const Ink kPlain{0xFF000000u, 0xFFFFFFFFu, 0xFF808080u};
const Ink kTinted{0xFFC02000u, 0xFFFFF080u, 0xFF40A0FFu};

const QRgb kSourceRow[] = {0xFF000000, 0xFFFFFFFF, 0xFF808080, 0xFF204060, 0xFFF0C010,
                           0xFFFFF080, 0xFF00FF00, 0xFF123456};
const QRgb kDestRow[] = {0xFFFFFFFF, 0xFF000000, 0xFF3070B0, 0xFFE0E0E0, 0xFF102030,
                         0xFF7F7F7F, 0xFFFF00FF, 0xFF654321};
constexpr int kRow = 8;

void setInk(const Ink& ink)
{
    const RGBColor fore(ink.fore), back(ink.back), op(ink.op);
    RGBForeColor(&fore);
    RGBBackColor(&back);
    OpColor(&op);
}

// One component as the mode should leave it; -1 when the whole pixel is left alone.
double expectedComponent(SInt16 mode, int s, int d, int f, int b, int o)
{
    const double light = s / 255.0, dark = 1.0 - light;
    switch (mode & ~ditherCopy) {
    case srcCopy: return f * dark + b * light;
    case notSrcCopy: return f * light + b * dark;
    case srcOr: return f * dark + d * light;
    case notSrcOr: return f * light + d * dark;
    case srcBic: return b * dark + d * light;
    case notSrcBic: return b * light + d * dark;
    case srcXor: return d ^ (255 - s);
    case notSrcXor: return d ^ s;
    case blend: return s * (o / 255.0) + d * (1.0 - o / 255.0);
    case addPin: return std::min(s + d, o);
    case addOver: return (s + d) % 256;
    case subPin: return std::max(d - s, o);
    case subOver: return (d - s + 256) % 256;
    case adMax: return std::max(s, d);
    case adMin: return std::min(s, d);
    default: return -1;
    }
}

QRgb expectedPixel(SInt16 mode, QRgb s, QRgb d, const Ink& ink)
{
    if (mode == transparent)
        return (s & 0xFFFFFF) == (ink.back & 0xFFFFFF) ? d : s;
    int c[3];
    for (int i = 0; i < 3; ++i) {
        const int shift = 16 - 8 * i;
        const auto at = [shift](QRgb w) { return int((w >> shift) & 0xFF); };
        c[i] = int(std::lround(expectedComponent(mode, at(s), at(d), at(ink.fore), at(ink.back),
                                                 at(ink.op))));
    }
    return qRgb(c[0], c[1], c[2]);
}

// A world filled with pseudo-random opaque pixels.
void scramble(World& world, quint32 seed)
{
    QRandomGenerator random(seed);
    QImage& image = world.image();
    for (int y = 0; y < image.height(); ++y)
        for (int x = 0; x < image.width(); ++x)
            image.setPixel(x, y, 0xFF000000u | random.generate());
}

// Which source pixel a destination index reads when `srcLen` pixels cover `dstLen`.
int nearestSource(int i, int srcLen, int dstLen)
{
    return int(std::floor(i * double(srcLen) / dstLen));
}

QRegion regionPixelByPixel(const QImage& image, const std::function<bool(int, int)>& marked,
                           QPoint origin = QPoint())
{
    QRegion region;
    for (int y = 0; y < image.height(); ++y)
        for (int x = 0; x < image.width(); ++x)
            if (marked(x, y))
                region += QRect(origin + QPoint(x, y), QSize(1, 1));
    return region;
}

} // namespace

class TestCopyBits : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void modes_data()
    {
        QTest::addColumn<int>("mode");
        QTest::addColumn<bool>("tinted");
        const std::pair<const char*, SInt16> modes[] = {
            {"srcCopy", srcCopy}, {"srcOr", srcOr}, {"srcXor", srcXor}, {"srcBic", srcBic},
            {"notSrcCopy", notSrcCopy}, {"notSrcOr", notSrcOr}, {"notSrcXor", notSrcXor},
            {"notSrcBic", notSrcBic}, {"transparent", transparent}, {"blend", blend},
            {"addPin", addPin}, {"addOver", addOver}, {"subPin", subPin}, {"subOver", subOver},
            {"adMax", adMax}, {"adMin", adMin}, {"ditherCopy", SInt16(int(srcCopy) + int(ditherCopy))}};
        for (const auto& [name, mode] : modes) {
            QTest::addRow("%s", name) << int(mode) << false;
            QTest::addRow("%s tinted", name) << int(mode) << true;
        }
    }
    // Every mode, every pixel, with plain and with tinting colours.
    void modes()
    {
        QFETCH(int, mode);
        QFETCH(bool, tinted);
        const Ink ink = tinted ? kTinted : kPlain;
        World src(kRow, 1), dst(kRow, 1);
        for (int x = 0; x < kRow; ++x) {
            src.image().setPixel(x, 0, kSourceRow[x]);
            dst.image().setPixel(x, 0, kDestRow[x]);
        }
        setInk(ink);
        const Rect r = R(0, 0, 1, kRow);
        CopyBits(GetPortBitMapForCopyBits(src), GetPortBitMapForCopyBits(dst), &r, &r,
                 SInt16(mode), nullptr);
        for (int x = 0; x < kRow; ++x) {
            const QRgb want = expectedPixel(SInt16(mode), kSourceRow[x], kDestRow[x], ink);
            QVERIFY2(near(dst.pixel(x, 0), want),
                     qPrintable(QStringLiteral("pixel %1: %2, expected %3").arg(x)
                                    .arg(dst.pixel(x, 0), 8, 16).arg(want, 8, 16)));
        }
    }

    void unknownModeCopiesAsSrcCopyAndSaysSo()
    {
        VelmarTest::LogCapture log;
        SetLogCategory(kLogNotImpl, true);
        World src(4), dst(4);
        scramble(src, 7);
        const Rect r = R(0, 0, 4, 4);
        CopyBits(GetPortBitMapForCopyBits(src), GetPortBitMapForCopyBits(dst), &r, &r, 17, nullptr);
        QCOMPARE(dst.image(), src.image());
        QVERIFY(log.contains(QStringLiteral("Velmar::CopyBits: transfer mode 17")));
    }

    void scaling_data()
    {
        QTest::addColumn<QSize>("source");
        QTest::addColumn<QSize>("destination");
        QTest::newRow("double") << QSize(5, 3) << QSize(10, 6);
        QTest::newRow("shrink") << QSize(9, 7) << QSize(3, 2);
        QTest::newRow("uneven") << QSize(4, 5) << QSize(7, 3);
    }
    // Each destination pixel takes the source pixel its position maps onto.
    void scaling()
    {
        QFETCH(QSize, source);
        QFETCH(QSize, destination);
        World src(source.width(), source.height()), dst(12, 8);
        scramble(src, 11);
        const QImage before = dst.image().copy();
        const Rect sr = R(0, 0, source.height(), source.width());
        const Rect dr = R(1, 2, 1 + destination.height(), 2 + destination.width());
        CopyBits(GetGWorldPixMap(src), GetGWorldPixMap(dst), &sr, &dr, srcCopy, nullptr);
        for (int y = 0; y < 8; ++y)
            for (int x = 0; x < 12; ++x) {
                const QRect inside(2, 1, destination.width(), destination.height());
                const QRgb want = inside.contains(x, y)
                    ? src.pixel(nearestSource(x - 2, source.width(), destination.width()),
                                nearestSource(y - 1, source.height(), destination.height()))
                    : before.pixel(x, y);
                QCOMPARE(dst.pixel(x, y), want);
            }
    }

    // Only pixels inside the destination rectangle, the port's clip, the mask region and
    // both images change.
    void clipping()
    {
        World src(20), dst(20);
        scramble(src, 3);
        SetPort(dst);
        const Rect clip = R(2, 2, 18, 15);
        ClipRect(&clip);
        const Rgn mask = rgnOf(QRegion(QRect(0, 0, 14, 14), QRegion::Ellipse));
        const Rect sr = R(-5, 8, 15, 30); // hangs off the source's top and right
        const Rect dr = R(0, -3, 20, 19);
        const QImage before = dst.image().copy();
        CopyBits(GetPortBitMapForCopyBits(src), GetPortBitMapForCopyBits(dst), &sr, &dr, srcCopy,
                 mask.get());
        for (int y = 0; y < 20; ++y)
            for (int x = 0; x < 20; ++x) {
                const QPoint s(x + 11, y - 5); // the unscaled source pixel
                const bool changes = QRect(2, 2, 13, 16).contains(x, y) && mask->contains(QPoint(x, y))
                    && QRect(0, 0, 20, 20).contains(s);
                QCOMPARE(dst.pixel(x, y), changes ? src.pixel(s.x(), s.y()) : before.pixel(x, y));
            }
    }

    void overlap_data()
    {
        QTest::addColumn<QPoint>("shift");
        QTest::newRow("down right") << QPoint(3, 2);
        QTest::newRow("up left") << QPoint(-4, -1);
        QTest::newRow("scaled into itself") << QPoint(0, 0);
    }
    // Copies within one port read the pixels as they were before the copy.
    void overlap()
    {
        QFETCH(QPoint, shift);
        World world(24);
        scramble(world, 5);
        const QImage before = world.image().copy();
        const Rect sr = R(4, 4, 16, 16);
        const bool scaled = shift.isNull();
        const Rect dr = scaled ? R(2, 2, 22, 22)
                               : R(4 + shift.y(), 4 + shift.x(), 16 + shift.y(), 16 + shift.x());
        CopyBits(GetPortBitMapForCopyBits(world), GetPortBitMapForCopyBits(world), &sr, &dr,
                 srcCopy, nullptr);
        const int size = scaled ? 20 : 12;
        for (int y = 0; y < size; ++y)
            for (int x = 0; x < size; ++x)
                QCOMPARE(world.pixel(dr.left + x, dr.top + y),
                         before.pixel(4 + nearestSource(x, 12, size), 4 + nearestSource(y, 12, size)));
    }

    // Words the host writes through the base address arrive, alpha or not; pixmap accessors
    // describe the pixels truthfully.
    void hostWrittenPixels()
    {
        World world(6, 4), dst(6, 4);
        PixMapHandle pm = GetGWorldPixMap(world);
        QVERIFY(LockPixels(pm));
        QCOMPARE(GetPixDepth(pm), SInt16(32));
        Rect bounds;
        QCOMPARE(GetPixBounds(pm, &bounds)->right, SInt16(6));
        auto* base = reinterpret_cast<UInt32*>(GetPixBaseAddr(pm));
        const SInt32 rowBytes = GetPixRowBytes(pm);
        QVERIFY(base && rowBytes >= 24);
        for (int y = 0; y < 4; ++y)
            for (int x = 0; x < 6; ++x)
                base[y * rowBytes / 4 + x] = UInt32(0x00102030 + x * 0x10 + y * 0x1000); // no alpha
        UnlockPixels(pm);
        const Rect r = R(0, 0, 4, 6);
        CopyBits(GetPortBitMapForCopyBits(world), GetPortBitMapForCopyBits(dst), &r, &r, srcCopy,
                 nullptr);
        QCOMPARE(dst.pixel(5, 3), QRgb(0xFF102030 + 5 * 0x10 + 3 * 0x1000));

        // A host's own pixmap, placed away from the origin, and a copy of it.
        PixMapHandle own = NewPixMap();
        const Rect ownBounds = R(10, 20, 12, 23);
        QCOMPARE(SetPixBounds(own, &ownBounds), noErr);
        QCOMPARE(GetPixBounds(own, &bounds)->left, SInt16(20));
        auto* ownBase = reinterpret_cast<UInt32*>(GetPixBaseAddr(own));
        ownBase[GetPixRowBytes(own) / 4 + 2] = 0xFFAA0000u; // row 1, column 2
        PixMapHandle copy = TxCopyHand(own);
        DisposePixMap(own);
        const Rect from = R(11, 22, 12, 23), to = R(0, 0, 1, 1);
        CopyBits(copy, GetPortBitMapForCopyBits(dst), &from, &to, srcCopy, nullptr);
        QCOMPARE(dst.pixel(0, 0), QRgb(0xFFAA0000u));
        DisposePixMap(copy);

        VelmarTest::IgnoredAssertions asserts;
        DisposePixMap(pm); // a port's pixmap goes with its port
        QVERIFY(IsValidPort(world));
        QCOMPARE(GetPixDepth(pm), SInt16(32));
        QCOMPARE(asserts.count(), 1);
    }

    // One-bit maps in the host's memory: copied onto a world, written to from one, and
    // made into regions.
    void oneBitMaps()
    {
        // 12 pixels wide, rows of 2 bytes: an X shape.
        UInt8 bits[8 * 2] = {};
        for (int i = 0; i < 8; ++i) {
            for (int x : {i, 11 - i})
                bits[i * 2 + x / 8] |= UInt8(0x80 >> (x % 8));
        }
        BitMap map{reinterpret_cast<Ptr>(bits), 2, makeRect(100, 50, 112, 58)};
        const auto set = [&](int x, int y) { return (bits[y * 2 + x / 8] >> (7 - x % 8)) & 1; };

        World dst(12, 8);
        const Rect to = R(0, 0, 8, 12);
        CopyBits(&map, GetPortBitMapForCopyBits(dst), &map.bounds, &to, srcCopy, nullptr);
        for (int y = 0; y < 8; ++y)
            for (int x = 0; x < 12; ++x)
                QCOMPARE(dst.pixel(x, y), set(x, y) ? 0xFF000000u : 0xFFFFFFFFu);

        const Rgn region = rgnOf();
        QCOMPARE(BitMapToRegion(region.get(), &map), noErr);
        const QImage shape(12, 8, QImage::Format_Mono);
        QVERIFY((*region ^ regionPixelByPixel(shape, set, QPoint(100, 50))).isEmpty());

        // Dark pixels of a world set bits; light ones clear them.
        dst.image().fill(0xFFFFFFFFu);
        dst.image().setPixel(3, 2, 0xFF202020u);
        dst.image().setPixel(4, 2, 0xFFB0B0B0u);
        CopyBits(GetPortBitMapForCopyBits(dst), &map, &to, &map.bounds, srcCopy, nullptr);
        for (int y = 0; y < 8; ++y)
            for (int x = 0; x < 12; ++x)
                QCOMPARE(set(x, y), x == 3 && y == 2 ? 1 : 0);
    }

    // Pixels differing from the port's back colour make the region, in banded form.
    void regionOfDeepMap()
    {
        World world(64, 48);
        const RGBColor back(0x2000, 0x4000, 0x6000);
        RGBBackColor(&back);
        const Rect all = R(0, 0, 48, 64);
        EraseRect(&all);
        world->EndPaint();
        QRandomGenerator random(9);
        for (int i = 0; i < 40; ++i) {
            const QRect blob(int(random.bounded(60)), int(random.bounded(44)),
                             1 + int(random.bounded(12)), 1 + int(random.bounded(9)));
            QPainter(&world.image()).fillRect(blob, QColor::fromRgb(random.generate() | 0xFF000000));
        }
        SetOrigin(-5, 7);
        const QRgb paper = world->backColor.rgb() & 0xFFFFFF;
        const Rgn region = rgnOf();
        QCOMPARE(BitMapToRegion(region.get(), GetPortBitMapForCopyBits(world)), noErr);
        const QRegion expected = regionPixelByPixel(world.image(), [&](int x, int y) {
                     return (world.pixel(x, y) & 0xFFFFFF) != paper;
                 }, QPoint(-5, 7));
        QVERIFY((*region ^ expected).isEmpty());
    }

    // Masks weigh the copy by their darkness; one field writes every other row.
    void masksAndFields()
    {
        World src(4, 4), mask(4, 4), dst(4, 4);
        src.image().fill(0xFF000000u);
        dst.image().fill(0xFFFFFFFFu);
        const QRgb shades[] = {0xFF000000u, 0xFFFFFFFFu, 0xFF404040u, 0xFFC0C0C0u};
        for (int x = 0; x < 4; ++x)
            for (int y = 0; y < 4; ++y)
                mask.image().setPixel(x, y, shades[x]);
        const Rect r = R(0, 0, 4, 4);
        CopyMask(GetPortBitMapForCopyBits(src), GetPortBitMapForCopyBits(mask),
                 GetPortBitMapForCopyBits(dst), &r, &r, &r);
        for (int x = 0; x < 4; ++x) {
            const int grey = qRed(shades[x]); // black source over white, weighed by the mask
            QVERIFY(near(dst.pixel(x, 1), qRgb(grey, grey, grey)));
        }

        dst.image().fill(0xFFFFFFFFu);
        const Rect rows = R(1, 0, 4, 4);
        CopyOneField(GetPortBitMapForCopyBits(src), GetPortBitMapForCopyBits(dst), &rows, &rows,
                     srcCopy, nullptr, 1);
        for (int y = 0; y < 4; ++y)
            QCOMPARE(dst.pixel(2, y), y == 2 ? 0xFF000000u : 0xFFFFFFFFu);
    }

    // What a hostile host passes: nothing crashes, nothing outside an image is written, and
    // the destination keeps its pixels.
    void badInput()
    {
        VelmarTest::IgnoredAssertions asserts;
        World src(8), dst(8);
        scramble(src, 1);
        const QImage before = dst.image().copy();
        // Made before anything is freed, so that it cannot take a freed pixmap's address.
        PixMapHandle empty = NewPixMap();
        GrafPtr gone = nullptr;
        const Rect eight = R(0, 0, 8, 8);
        NewGWorld(&gone, 32, &eight, nullptr, nullptr, 0);
        PixMapHandle stale = GetGWorldPixMap(gone);
        DisposeGWorld(gone);
        QRegion* disposedRgn = NewRgn();
        DisposeRgn(disposedRgn);
        PixMapHandle freed = NewPixMap();
        DisposePixMap(freed);
        BitMap malformed{nullptr, 2, makeRect(0, 0, 8, 8)};
        const Rect inverted = R(6, 6, 2, 2), far = R(-32000, -32000, -31990, -31990);
        const Rect huge = R(-32768, -32768, 32767, 32767);
        const BitMapPtr& to = GetPortBitMapForCopyBits(dst);
        const BitMapPtr& from = GetPortBitMapForCopyBits(src);
        const std::pair<const char*, std::function<void()>> calls[] = {
            {"null source", [&] { CopyBits(nullptr, to, &eight, &eight, srcCopy, nullptr); }},
            {"stale pixmap", [&] { CopyBits(stale, to, &eight, &eight, srcCopy, nullptr); }},
            {"freed pixmap", [&] { CopyBits(from, freed, &eight, &eight, srcCopy, nullptr); }},
            {"pixmap without pixels", [&] { CopyBits(empty, to, &eight, &eight, srcCopy, nullptr); }},
            {"malformed BitMap", [&] { CopyBits(&malformed, to, &eight, &eight, srcCopy, nullptr); }},
            {"null rects", [&] { CopyBits(from, to, nullptr, &eight, srcCopy, nullptr); }},
            {"inverted rect", [&] { CopyBits(from, to, &inverted, &eight, srcCopy, nullptr); }},
            {"far outside", [&] { CopyBits(from, to, &far, &far, srcCopy, nullptr); }},
            {"disposed mask region", [&] { CopyBits(from, to, &eight, &eight, srcCopy, disposedRgn); }},
            {"huge scaled onto a pixel", [&] { CopyBits(from, to, &huge, &far, notSrcCopy, nullptr); }},
            {"mask from a stale map", [&] { CopyMask(from, stale, to, &eight, &eight, &eight); }},
            {"region of nothing", [&] { QCOMPARE(BitMapToRegion(nullptr, from), OSErr(paramErr)); }},
            {"region into disposed", [&] { QCOMPARE(BitMapToRegion(disposedRgn, from), OSErr(paramErr)); }},
            {"region of stale map", [&] { QCOMPARE(BitMapToRegion(rgnOf().get(), stale), OSErr(paramErr)); }},
            {"pixmap accessors", [&] {
                 Rect b = eight;
                 QCOMPARE(GetPixBaseAddr(stale), nullptr);
                 QCOMPARE(GetPixRowBytes(freed), SInt32(0));
                 QCOMPARE(GetPixBounds(nullptr, &b)->right, SInt16(0));
                 QCOMPARE(SetPixBounds(stale, &eight), OSErr(paramErr));
                 DisposePixMap(stale);
             }},
        };
        for (const auto& [name, call] : calls) {
            call();
            QVERIFY2(dst.image() == before, name);
        }
        // Huge copies still land where they can: pixel 0 lies half way along the huge rectangle.
        CopyBits(from, to, &eight, &huge, srcCopy, nullptr);
        QCOMPARE(dst.pixel(0, 0), src.pixel(4, 4));
        DisposePixMap(empty);
    }
};

VELMAR_TEST_MAIN(TestCopyBits)
#include "tst_copybits.moc"
