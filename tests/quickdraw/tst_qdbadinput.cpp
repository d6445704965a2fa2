// What a hostile host hands QuickDraw: disposed and made-up ports, regions and polygons,
// coordinates at the ends of the 32-bit range, and shapes as large as 16 bits allow. Every
// call must refuse or cope, never read freed memory or overflow (run under the sanitizer
// build to see the difference).
#include "QuickDrawTestSupport.h"

#include "quickdraw/ShapeRegions.h"

#include <Velmar/QDText.h>

#include <climits>
#include <functional>

using namespace Velmar;
using namespace QDTest;
using Velmar::Private::makeRect;

namespace {

using Asserts = VelmarTest::IgnoredAssertions;

// A port that was live once: its memory is freed by the time the calls get it.
GrafPtr disposedPort()
{
    GrafPtr port = nullptr;
    const Rect bounds = makeRect(0, 0, 10, 10);
    NewGWorld(&port, 32, &bounds, nullptr, nullptr, 0);
    DisposeGWorld(port);
    return port;
}

const Rect kFull16 = makeRect(-32768, -32768, 32767, 32767);

} // namespace

class TestBadInput : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void initTestCase() { SetLogCategory(kLogQuickDraw | kLogGrafPort, true); }

    // Each call is refused with one assertion and answers its neutral result.
    void disposedPortIsRefusedEverywhere()
    {
        World world(10);
        const GrafPtr stale = disposedPort();
        const Rgn rgn = rgnOf(QRegion(1, 1, 2, 2));
        RGBColor color(1, 2, 3);
        Rect rect = makeRect(1, 2, 3, 4);
        Point point{5, 6};
        const std::pair<const char*, std::function<void()>> calls[] = {
            {"GetPortBounds", [&] { QCOMPARE(GetPortBounds(stale, &rect)->right, short(0)); }},
            {"SetPortBounds", [&] { SetPortBounds(stale, &rect); }},
            {"GetPortBackColor", [&] { GetPortBackColor(stale, &color); }},
            {"GetPortForeColor", [&] { GetPortForeColor(stale, &color); }},
            {"GetPortHiliteColor", [&] { GetPortHiliteColor(stale, &color); }},
            {"SetPortOpColor", [&] { SetPortOpColor(stale, &color); }},
            {"GetPortPenLocation", [&] { QCOMPARE(GetPortPenLocation(stale, &point), nullptr); }},
            {"GetPortPenMode", [&] { QCOMPARE(GetPortPenMode(stale), SInt16(0)); }},
            {"GetPortTextFont", [&] { QCOMPARE(GetPortTextFont(stale), SInt16(0)); }},
            {"GetPortTextSize", [&] { QCOMPARE(GetPortTextSize(stale), SInt16(0)); }},
            {"GetPortTextFace", [&] { QCOMPARE(GetPortTextFace(stale), Style(0)); }},
            {"GetPortTextMode", [&] { QCOMPARE(GetPortTextMode(stale), SInt16(0)); }},
            {"GetPortPixMap", [&] { QCOMPARE(GetPortPixMap(stale), nullptr); }},
            {"GetPortBitMapForCopyBits", [&] { QVERIFY(!GetPortBitMapForCopyBits(stale).image()); }},
            {"SetPortClipRegion", [&] { SetPortClipRegion(stale, rgn.get()); }},
            {"SetPortVisibleRegion", [&] { SetPortVisibleRegion(stale, rgn.get()); }},
            {"GetPortVisibleRegion", [&] { GetPortVisibleRegion(stale, rgn.get()); }},
            {"GetPortClipRegion", [&] { GetPortClipRegion(stale, rgn.get()); }},
            {"QDLocalToGlobalRect", [&] { QDLocalToGlobalRect(stale, &rect); }},
            {"QDGlobalToLocalPoint", [&] { QDGlobalToLocalPoint(stale, &point); }},
            {"QDFlushPortBuffer", [&] { QDFlushPortBuffer(stale, rgn.get()); }},
            {"MakeQPainter", [&] { QVERIFY(!MakeQPainter(stale, "test")); }},
            {"DisposePort", [&] { DisposePort(stale); }},
        };
        for (const auto& [name, call] : calls) {
            Asserts asserts;
            call();
            QVERIFY2(asserts.texts() == QStringList{QStringLiteral("IsValidPort(port)")}, name);
        }
        QCOMPARE(*rgn, QRegion(1, 1, 2, 2));
        QCOMPARE(color.red, (unsigned short)1);
        Asserts asserts;
        DisposeGWorld(stale);
        QCOMPARE(asserts.texts(), QStringList{QStringLiteral("IsValidPort(offscreenGWorld)")});
        SetPort(stale);
        QCOMPARE(GetCurrentPort(), nullptr);
    }

    // Disposed twice, killed twice, or never made: refused, nothing freed twice.
    void staleRegionsAndPolygons()
    {
        World world(10);
        RgnHandle rgn = NewRgn();
        DisposeRgn(rgn);
        QRegion onTheStack(0, 0, 5, 5);
        PolyPtr* poly = recordPoly({QPoint(0, 0), QPoint(5, 0), QPoint(0, 5)});
        KillPoly(poly);
        PolyPtr madeUp{nullptr};
        const Rect r = makeRect(0, 0, 5, 5);
        const std::pair<const char*, std::function<void()>> calls[] = {
            {"DisposeRgn", [&] { DisposeRgn(rgn); }},
            {"CopyRgn", [&] { CopyRgn(rgn, &onTheStack); }},
            {"SetEmptyRgn", [&] { SetEmptyRgn(&onTheStack); }},
            {"RectRgn", [&] { RectRgn(rgn, &r); }},
            {"UnionRgn", [&] { UnionRgn(rgn, rgn, rgn); }},
            {"OffsetRgn", [&] { OffsetRgn(&onTheStack, 1, 1); }},
            {"InsetRgn", [&] { InsetRgn(rgn, 1, 1); }},
            {"MapRgn", [&] { MapRgn(rgn, &r, &r); }},
            {"PtInRgn", [&] { QCOMPARE(PtInRgn(Point{1, 1}, &onTheStack), (unsigned char)0); }},
            {"EmptyRgn", [&] { QCOMPARE(EmptyRgn(rgn), (unsigned char)1); }},
            {"PaintRgn", [&] { PaintRgn(rgn); }},
            {"FrameRgn", [&] { FrameRgn(&onTheStack); }},
            {"InvertRgn", [&] { InvertRgn(rgn); }},
            {"SetClip", [&] { SetClip(rgn); }},
            {"CloseRgn", [&] { OpenRgn(); CloseRgn(rgn); CleanupOpenRgn cleanup; }},
            {"KillPoly", [&] { KillPoly(poly); }},
            {"OffsetPoly", [&] { OffsetPoly(poly, 1, 1); }},
            {"PaintPoly", [&] { PaintPoly(&madeUp); }},
            {"FramePoly", [&] { FramePoly(poly); }},
        };
        for (const auto& [name, call] : calls) {
            Asserts asserts;
            call();
            QVERIFY2(asserts.count() == 1, name);
            QVERIFY2(asserts.texts().first().startsWith(QLatin1String("IsValid")), name);
        }
        QCOMPARE(onTheStack, QRegion(0, 0, 5, 5));
        QVERIFY(world.touched().isEmpty());
    }

    // Pen locations and point lists at the ends of the 32-bit range: drawing clips, the dirty
    // arithmetic saturates, and relative moves wrap as 16-bit values.
    void extremeCoordinates()
    {
        World world(20);
        const QList<QPoint> far = {QPoint(INT_MAX, INT_MAX), QPoint(INT_MIN, INT_MIN),
                                   QPoint(INT_MIN, INT_MAX), QPoint(5, 5)};
        for (int pen : {1, 40}) {
            PenSize(short(pen), short(pen));
            DrawLinesFromPointPairs(far);
            DrawPolylineFromPoints(far);
        }
        PenNormal();
        PenState state(QPoint(INT_MAX, INT_MIN), 30000, patCopy, QBrush(Qt::black));
        SetPenState(&state);
        LineTo(10, 10);
        SetPenState(&state);
        Move(1, 1);
        Point where;
        GetPen(&where);
        QCOMPARE(where.h, short(0));
        QCOMPARE(where.v, short(1));
        SetPenState(&state);
        Line(-1, -1);
        QVERIFY(!world.touched().isEmpty());
        // Far offsets stop at the edge of the range instead of overflowing.
        const Rgn rgn = rgnOf(QRegion(0, 0, 4, 4));
        for (int i = 0; i < 20000; ++i)
            OffsetRgn(rgn.get(), 32767, 32767);
        QVERIFY(rgn->boundingRect().right() > 0);
        PolyPtr* poly = recordPoly({QPoint(0, 0), QPoint(5, 0), QPoint(0, 5)});
        for (int i = 0; i < 20000; ++i)
            OffsetPoly(poly, -32768, -32768);
        QVERIFY(GetPolyBBox(poly).left <= 0);
        KillPoly(poly);
        // A steep map keeps the part that lands in range and drops the rest.
        const Rect one = makeRect(0, 0, 1, 1);
        *rgn = QRegion(0, 0, 32767, 1);
        MapRgn(rgn.get(), &one, &kFull16);
        QVERIFY(rgn->contains(QPoint(-32768, -32768)));
        QVERIFY(rgn->boundingRect().right() < INT_MAX / 2);
    }

    // The whole 16-bit plane scrolled on a small port: only the port's pixels move.
    void scrollRectOfTheWholePlane()
    {
        World world(100);
        PaintRect(&kFull16);
        const Rgn update = rgnOf();
        ScrollRect(&kFull16, 0, 10, update.get());
        QCOMPARE(*update, QRegion(0, 0, 100, 10));
        QCOMPARE(world.pixel(50, 5), qRgb(255, 255, 255));
        QCOMPARE(world.pixel(50, 50), qRgb(0, 0, 0));
    }

    // Recording the largest oval and polygon: the region is the shape, built row by row.
    void recordingHugeShapes()
    {
        World world(50);
        const Rgn rgn = rgnOf();
        OpenRgn();
        FrameOval(&kFull16);
        CloseRgn(rgn.get());
        QCOMPARE(rgn->boundingRect(), Private::toQRect(kFull16));
        QVERIFY(rgn->contains(QPoint(0, 0)));
        QVERIFY(!rgn->contains(QPoint(-30000, -30000)));
        OpenRgn();
        MoveTo(-32768, -32768);
        LineTo(32767, -32768);
        LineTo(-32768, 32767);
        CloseRgn(rgn.get());
        QVERIFY(rgn->contains(QPoint(-32000, 30000)));
        QVERIFY(!rgn->contains(QPoint(32000, 30000)));
        // Just above the size Qt builds itself, the two ways differ by edge pixels only.
        const int n = Private::kQtShapeRegionLimit + 100;
        const QRect box(0, 0, n, n / 2);
        const QRegion ours = Private::ellipseRegion(box), qts(box, QRegion::Ellipse);
        QVERIFY(!ours.isEmpty());
        QVERIFY(regionPixels(ours ^ qts).size() < 4 * box.height());
        const QPolygon triangle({QPoint(0, 0), QPoint(n, n / 3), QPoint(n / 5, n)});
        const QRegion ourTriangle = Private::polygonRegion(triangle);
        QVERIFY(regionPixels(ourTriangle ^ QRegion(triangle, Qt::OddEvenFill)).size() < 4 * n);
        // Banded as Qt bands: equal areas compare equal.
        QCOMPARE(ourTriangle, ourTriangle.united(ourTriangle.translated(0, 0)));
    }
};

VELMAR_TEST_MAIN(TestBadInput)
#include "tst_qdbadinput.moc"
