// Rectangles, ovals, arcs, rounded rectangles and lines drawn into an offscreen world and
// read back: exact pixel sets where the Toolbox fixes them, containment where it does not.
#include "TestSupport.h"

#include "ShapeTestWorld.h"

#include <Velmar/Diagnostics.h>

#include "quickdraw/ArcAngles.h"
#include "quickdraw/GrafPortPrivate.h"

#include <QPolygon>

using namespace Velmar;
using namespace ShapeTest;

namespace {

QSet<QPoint> rectPixels(int left, int top, int right, int bottom) // Toolbox edges
{
    return regionPixels(QRegion(QRect(QPoint(left, top), QPoint(right - 1, bottom - 1))));
}

QSet<QPoint> framePixels(int left, int top, int right, int bottom, int w)
{
    return rectPixels(left, top, right, bottom) - rectPixels(left + w, top + w, right - w, bottom - w);
}

// Collects what the port reports dirty to its window.
struct DirtyLog {
    static QList<QRect>& rects()
    {
        static QList<QRect> r;
        return r;
    }
    static void mark(AQtWindow*, const QRect& r) { rects().append(r); }
};

} // namespace

class TestShapes : public QObject {
    Q_OBJECT
private Q_SLOTS:
    void initTestCase() { SetLogCategory(kLogQuickDraw, true); }

    void frameRectOnePixelPen()
    {
        World world;
        const Rect r = R(10, 10, 20, 20);
        FrameRect(&r);
        const QSet<QPoint> got = world.touched();
        QCOMPARE(got, framePixels(10, 10, 20, 20, 1));
        QCOMPARE(world.pixel(10, 10), qRgb(0, 0, 0));
    }

    // Shapes are given in local coordinates; the origin moves them on the image.
    void drawingFollowsTheOrigin()
    {
        World world;
        SetOrigin(-20, 30); // local (-20, 30) is the image's (0, 0)
        const Rect r = R(40, -10, 50, 0);
        FrameRect(&r);
        QCOMPARE(world.touched(), framePixels(10, 10, 20, 20, 1));
        MoveTo(-20, 80);
        LineTo(-20, 80);
        QVERIFY(world.touched().contains(QPoint(0, 50)));
    }

    void frameRectWidePens_data()
    {
        QTest::addColumn<int>("w");
        QTest::newRow("2") << 2;
        QTest::newRow("3") << 3;
        QTest::newRow("4") << 4;
    }
    // Every stroked pixel stays inside the rectangle, and the band along each edge is w wide.
    void frameRectWidePens()
    {
        QFETCH(int, w);
        World world;
        PenSize(short(w), short(w));
        const Rect r = R(10, 10, 30, 40);
        FrameRect(&r);
        const QSet<QPoint> got = world.touched();
        const QSet<QPoint> inside = rectPixels(10, 10, 40, 30);
        QVERIFY2((got - inside).isEmpty(), describe(got - inside));
        // The frame is the band w pixels deep along every edge, corners included.
        const QSet<QPoint> band = framePixels(10, 10, 40, 30, w);
        QVERIFY2(got == band, describe(got) + " / " + describe(band));
    }

    // A pen wider than half the rectangle covers all of it, never more.
    void frameRectSmallerThanPen()
    {
        World world;
        PenSize(5, 5);
        const Rect r = R(10, 10, 14, 13);
        FrameRect(&r);
        QCOMPARE(world.touched(), rectPixels(10, 10, 13, 14));
    }

    void frameRectWithPatternFramesTheRegion()
    {
        World world;
        Pattern gray;
        PenPat(GetQDGlobalsGray(&gray));
        PenSize(2, 2);
        const Rect r = R(10, 10, 30, 30);
        FrameRect(&r);
        const QSet<QPoint> got = world.touched();
        QVERIFY(!got.isEmpty());
        QVERIFY2((got - framePixels(10, 10, 30, 30, 2)).isEmpty(), describe(got));
        QVERIFY(got.size() < framePixels(10, 10, 30, 30, 2).size()); // the pattern has holes
    }

    void frameRectHiddenPenDrawsNothing()
    {
        World world;
        HidePen();
        const Rect r = R(10, 10, 20, 20);
        FrameRect(&r);
        ShowPen();
        QVERIFY(world.touched().isEmpty());
    }

    void paintEraseInvertRect()
    {
        World world;
        const Rect r = R(5, 6, 15, 26);
        PaintRect(&r);
        QCOMPARE(world.touched(), rectPixels(6, 5, 26, 15));
        const Rect inner = R(7, 8, 9, 10);
        EraseRect(&inner);
        QCOMPARE(world.touched(), rectPixels(6, 5, 26, 15) - rectPixels(8, 7, 10, 9));
        InvertRect(&r); // black <-> white inside r
        QCOMPARE(world.touched(), rectPixels(8, 7, 10, 9));
        InvertRect(&r);
        QCOMPARE(world.touched(), rectPixels(6, 5, 26, 15) - rectPixels(8, 7, 10, 9));
    }

    void fillRectUsesPatternAndForeColor()
    {
        World world;
        const RGBColor red(65535, 0, 0);
        RGBForeColor(&red);
        const Rect r = R(0, 0, 8, 8);
        FillRect(&r, GetQDGlobalsBlack(nullptr));
        QCOMPARE(world.pixel(3, 3), qRgb(255, 0, 0));
        Pattern gray;
        FillRect(&r, GetQDGlobalsGray(&gray));
        // A gray pattern: neighbours differ, every other pixel is ink.
        QVERIFY(world.pixel(0, 0) != world.pixel(1, 0));
        QCOMPARE(world.touched().size(), 32);
    }

    void nullAndEmptyRectsDrawNothing()
    {
        World world;
        VelmarTest::LogCapture log;
        const Rect box = R(0, 0, 10, 10);
        FillRect(&box, PatPtr(static_cast<const Pattern*>(nullptr)));
        QVERIFY(log.contains("warning: FillRect: null pattern"));
        FrameRect(nullptr);
        PaintRect(nullptr);
        EraseRect(nullptr);
        InvertRect(nullptr);
        PaintOval(nullptr);
        FrameOval(nullptr);
        PaintArc(nullptr, 0, 90);
        FrameRoundRect(nullptr, 4, 4);
        const Rect empty = R(10, 10, 10, 20), inverted = R(20, 20, 10, 10);
        FrameRect(&empty);
        PaintRect(&inverted);
        PaintOval(&empty);
        InvertRoundRect(&inverted, 3, 3);
        QVERIFY(world.touched().isEmpty());
    }

    void lineToPenLocationDrawsOnePoint()
    {
        World world;
        MoveTo(30, 40);
        LineTo(30, 40);
        QCOMPARE(world.touched(), QSet<QPoint>{QPoint(30, 40)});
        Point pen{};
        GetPen(&pen);
        QCOMPARE(pen.h, 30);
        QCOMPARE(pen.v, 40);
    }

    void linesAreCentredOnTheirPoints()
    {
        World world;
        MoveTo(5, 5);
        LineTo(15, 5);
        QCOMPARE(world.touched(), rectPixels(5, 5, 16, 6));
        Line(0, 10); // from the pen location (15, 5) down to (15, 15)
        QCOMPARE(world.touched(), rectPixels(5, 5, 16, 6) + rectPixels(15, 5, 16, 16));
        Move(-10, 0); // pen to (5, 15), nothing drawn
        Point pen{};
        GetPen(&pen);
        QVERIFY(pen.h == 5 && pen.v == 15);
        QCOMPARE(world.touched().size(), 21);
    }

    void arcAngleConversion_data()
    {
        QTest::addColumn<int>("start");
        QTest::addColumn<int>("arc");
        QTest::addColumn<int>("qtStart");
        QTest::addColumn<int>("qtSpan");
        QTest::newRow("12 to 3 o'clock") << 0 << 90 << 0 << 90;
        QTest::newRow("3 to 6 o'clock") << 90 << 90 << 270 << 90;
        QTest::newRow("counter-clockwise") << 0 << -90 << 180 << -90;
        QTest::newRow("full circle") << 0 << 360 << 90 << 360;
        QTest::newRow("large start") << 720 << 45 << 45 << 45;
    }
    void arcAngleConversion()
    {
        QFETCH(int, start);
        QFETCH(int, arc);
        QFETCH(int, qtStart);
        QFETCH(int, qtSpan);
        const Private::QtArc a = Private::toQtArc(start, arc);
        QCOMPARE(a.start, qtStart * 16);
        QCOMPARE(a.span, qtSpan * 16);
    }

    // The quadrant from 12 o'clock to 3 o'clock: top-right of the centre.
    void paintArcQuadrant()
    {
        World world;
        const Rect r = R(0, 0, 80, 80);
        PaintArc(&r, 0, 90);
        const QSet<QPoint> got = world.touched();
        QVERIFY(got.size() > 1000);
        for (const QPoint& p : got)
            QVERIFY2(p.x() >= 39 && p.y() <= 40, describe({p}));
        QVERIFY(got.contains(QPoint(60, 20)));
        QVERIFY(!got.contains(QPoint(20, 20)));
        QVERIFY(!got.contains(QPoint(60, 60)));
    }

    void ovalsStayInTheirRectangle()
    {
        World world;
        const Rect r = R(10, 20, 50, 90);
        PaintOval(&r);
        const QSet<QPoint> got = world.touched();
        QVERIFY2((got - rectPixels(20, 10, 90, 50)).isEmpty(), describe(got));
        QVERIFY(got.contains(QPoint(55, 30)));  // centre
        QVERIFY(!got.contains(QPoint(20, 10))); // corner
        EraseOval(&r);
        QVERIFY(world.touched().isEmpty());
        FrameOval(&r);
        QVERIFY(!world.touched().contains(QPoint(55, 30))); // a frame leaves the inside alone
    }

    void roundRectCorners()
    {
        World world;
        const Rect r = R(10, 10, 50, 50);
        PaintRoundRect(&r, 20, 20);
        const QSet<QPoint> got = world.touched();
        QVERIFY2((got - rectPixels(10, 10, 50, 50)).isEmpty(), describe(got));
        QVERIFY(!got.contains(QPoint(10, 10)));
        QVERIFY(got.contains(QPoint(30, 10))); // straight edge
        InvertRoundRect(&r, 20, 20);
        QVERIFY(world.touched().isEmpty());
    }

    void lineHelpers()
    {
        World world;
        DrawLinesFromPointPairs({QPoint(0, 0), QPoint(4, 0), QPoint(0, 2), QPoint(4, 2), QPoint(9, 9)});
        QCOMPARE(world.touched(), rectPixels(0, 0, 5, 1) + rectPixels(0, 2, 5, 3));
        DrawPolylineFromPoints({QPoint(20, 20), QPoint(20, 24), QPoint(24, 24)});
        QVERIFY(world.touched().contains(QPoint(20, 22)));
        QVERIFY(world.touched().contains(QPoint(22, 24)));
        DrawPolylineFromPoints({});
        DrawLinesFromPointPairs({QPoint(1, 1)});
    }

    void stdRectDispatches()
    {
        World world;
        const Rect r = R(0, 0, 10, 10);
        StdRect(kQDGrafVerbPaint, &r);
        QCOMPARE(world.touched().size(), 100);
        StdRect(kQDGrafVerbErase, &r);
        QVERIFY(world.touched().isEmpty());
        StdRect(kQDGrafVerbFrame, &r);
        QCOMPARE(world.touched(), framePixels(0, 0, 10, 10, 1));
        StdRect(kQDGrafVerbInvert, &r);
        QCOMPARE(world.touched(), rectPixels(1, 1, 9, 9));
        VelmarTest::LogCapture log;
        StdRect(42, &r);
        QVERIFY(log.contains("StdRect"));
    }

    void withoutPortEveryCallWarns()
    {
        GrafPtr saved = nullptr;
        GetPort(&saved);
        SetPort(nullptr);
        VelmarTest::LogCapture log;
        const Rect r = R(0, 0, 10, 10);
        FrameRect(&r);
        PaintRect(&r);
        FrameOval(&r);
        FrameRoundRect(&r, 2, 2);
        MoveTo(1, 1);
        Move(1, 1);
        LineTo(1, 1);
        Line(1, 1);
        StdRect(kQDGrafVerbFrame, &r);
        DrawLinesFromPointPairs({QPoint(0, 0), QPoint(1, 1)});
        for (const char* text : {"warning: FrameRect: cannot get current port",
                                 "warning: PaintRect: Can't get current port!",
                                 "warning: FrameOval: cannot get current port",
                                 "warning: FrameRoundRect: cannot get current port",
                                 "warning: MoveTo: cannot get current port",
                                 "warning: Move: cannot get current port",
                                 "warning: LineTo: cannot get current port",
                                 "warning: Line: cannot get current port",
                                 "warning: StdRect: cannot get current port",
                                 "warning: DrawLinesFromPointPairs: cannot get Qt port"})
            QVERIFY2(log.contains(QString::fromLatin1(text)), text);
        SetPort(saved);
    }

    // Each drawing call reports what it touched to the port's window.
    void drawingMarksDirty()
    {
        Private::PortWindowHooks hooks = Private::portWindowHooks();
        Private::PortWindowHooks saved = hooks;
        hooks.markDirty = &DirtyLog::mark;
        Private::setPortWindowHooks(hooks);
        int fakeWindow = 0;
        auto* image = new QImage(100, 100, QImage::Format_ARGB32_Premultiplied);
        auto* port = new QtGrafPort(reinterpret_cast<AQtWindow*>(&fakeWindow), QRect(0, 0, 100, 100),
                                    image);
        GrafPtr previous = nullptr;
        GetPort(&previous);
        SetPort(port);
        struct Case {
            const char* name;
            std::function<void()> draw;
            QRect mustCover;
        };
        const Rect r = R(10, 20, 30, 60);
        QRegion region(30, 40, 20, 10);
        RgnHandle rgn = &region;
        QPolygon points({QPoint(10, 10), QPoint(40, 10), QPoint(40, 30)});
        PolyPtr poly{&points};
        const QList<Case> cases = {
            {"FrameRect", [&] { FrameRect(&r); }, QRect(20, 10, 40, 20)},
            {"PaintRect", [&] { PaintRect(&r); }, QRect(20, 10, 40, 20)},
            {"InvertRect", [&] { InvertRect(&r); }, QRect(20, 10, 40, 20)},
            {"PaintOval", [&] { PaintOval(&r); }, QRect(20, 10, 40, 20)},
            {"FrameOval", [&] { FrameOval(&r); }, QRect(20, 10, 40, 20)},
            {"FrameArc", [&] { FrameArc(&r, 0, 90); }, QRect(20, 10, 40, 20)},
            {"PaintRoundRect", [&] { PaintRoundRect(&r, 6, 6); }, QRect(20, 10, 40, 20)},
            {"LineTo", [&] { MoveTo(5, 70); LineTo(50, 60); }, QRect(5, 60, 46, 11)},
            {"EraseRect", [&] { EraseRect(&r); }, QRect(20, 10, 40, 20)},
            {"FillRect", [&] { FillRect(&r, GetQDGlobalsGray(nullptr)); }, QRect(20, 10, 40, 20)},
            {"PaintRgn", [&] { PaintRgn(rgn); }, QRect(30, 40, 20, 10)},
            {"FrameRgn", [&] { FrameRgn(rgn); }, QRect(30, 40, 20, 10)},
            {"InvertRgn", [&] { InvertRgn(rgn); }, QRect(30, 40, 20, 10)},
            {"FramePoly", [&] { FramePoly(&poly); }, QRect(10, 10, 31, 21)},
            {"PaintPoly", [&] { PaintPoly(&poly); }, QRect(10, 10, 31, 21)},
        };
        for (const Case& c : cases) {
            DirtyLog::rects().clear();
            c.draw();
            QRect dirty;
            for (const QRect& d : DirtyLog::rects())
                dirty |= d;
            QVERIFY2(dirty.contains(c.mustCover), c.name);
            // Precise: not the whole port, which is what a call that named nothing reports.
            QVERIFY2(dirty.width() < 90 && dirty.height() < 90, c.name);
        }
        SetPort(previous);
        delete port;
        Private::setPortWindowHooks(saved);
    }
};

VELMAR_TEST_MAIN(TestShapes)
#include "tst_shapes.moc"
