// Rectangles, ovals, arcs, rounded rectangles and lines drawn into an offscreen world and
// read back: exact pixel sets where the Toolbox fixes them, containment where it does not.
#include "QuickDrawTestSupport.h"

using namespace Velmar;
using namespace QDTest;

class TestShapes : public QObject {
    Q_OBJECT
private Q_SLOTS:
    void initTestCase() { SetLogCategory(kLogQuickDraw, true); }

    // The frame is the band w pixels deep along every edge, corners included, in the pen's
    // colour; a pen wider than half the rectangle covers all of it, never more.
    void frameRect()
    {
        for (const auto& [w, r] : {std::pair{1, R(10, 10, 20, 20)}, {3, R(10, 10, 30, 40)}, {5, R(10, 10, 14, 13)}}) {
            World world;
            PenSize(short(w), short(w));
            FrameRect(&r);
            const QSet<QPoint> got = world.touched(), band = framePixels(r.left, r.top, r.right, r.bottom, w);
            QVERIFY2(got == band, describe(got) + " / " + describe(band));
            QCOMPARE(world.pixel(r.left, r.top), qRgb(0, 0, 0));
        }
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

    void nullEmptyAndHiddenDrawNothing()
    {
        World world;
        VelmarTest::LogCapture log;
        const Rect box = R(0, 0, 10, 10);
        FillRect(&box, PatPtr(static_cast<const Pattern*>(nullptr)));
        QVERIFY(log.contains("warning: FillRect: null pattern"));
        for (auto call : {FrameRect, PaintRect, EraseRect, InvertRect, PaintOval, FrameOval})
            call(nullptr);
        PaintArc(nullptr, 0, 90);
        FrameRoundRect(nullptr, 4, 4);
        const Rect empty = R(10, 10, 10, 20), inverted = R(20, 20, 10, 10);
        FrameRect(&empty);
        PaintRect(&inverted);
        PaintOval(&empty);
        InvertRoundRect(&inverted, 3, 3);
        HidePen();
        FrameRect(&box);
        ShowPen();
        QVERIFY(world.touched().isEmpty());
    }

    // A line to the pen location is one point; lines are centred on their points and move
    // the pen; Move moves it without drawing.
    void linesAreCentredOnTheirPoints()
    {
        World world;
        MoveTo(30, 40);
        LineTo(30, 40);
        QCOMPARE(world.touched(), QSet<QPoint>{QPoint(30, 40)});
        MoveTo(5, 5);
        LineTo(15, 5);
        Line(0, 10); // from the pen location (15, 5) down to (15, 15)
        Move(-10, 0);
        QCOMPARE(world.touched(), rectPixels(5, 5, 16, 6) + rectPixels(15, 5, 16, 16) + QSet{QPoint(30, 40)});
        Point pen{};
        GetPen(&pen);
        QVERIFY(pen.h == 5 && pen.v == 15);
    }

    // Toolbox angles run clockwise from 12 o'clock: each arc stays in its quadrant of the
    // 80x80 oval (give or take the centre lines) and fills it.
    void paintArcQuadrant()
    {
        const QRect topRight(38, 0, 42, 42), bottomRight(38, 38, 42, 42), topLeft(0, 0, 42, 42);
        for (const auto& [start, arc, allowed, inside] :
             {std::tuple{0, 90, topRight, QPoint(60, 20)}, {90, 90, bottomRight, QPoint(60, 60)},
              {0, -90, topLeft, QPoint(20, 20)}, {900, 90, QRect(0, 38, 42, 42), QPoint(20, 60)},
              {0, 360, QRect(0, 0, 80, 80), QPoint(60, 60)}}) {
            World world;
            const Rect r = R(0, 0, 80, 80);
            PaintArc(&r, short(start), short(arc));
            const QSet<QPoint> got = world.touched();
            QVERIFY2(got.size() > 1000 && got.contains(inside), describe(got));
            QVERIFY2((got - regionPixels(QRegion(allowed))).isEmpty(), describe(got));
        }
    }

    void ovalsAndRoundRectsStayInTheirRectangle()
    {
        World world;
        const Rect r = R(10, 20, 50, 90);
        PaintOval(&r);
        QSet<QPoint> got = world.touched();
        QVERIFY2((got - rectPixels(20, 10, 90, 50)).isEmpty(), describe(got));
        QVERIFY(got.contains(QPoint(55, 30)));  // centre
        QVERIFY(!got.contains(QPoint(20, 10))); // corner
        EraseOval(&r);
        QVERIFY(world.touched().isEmpty());
        FrameOval(&r);
        QVERIFY(!world.touched().contains(QPoint(55, 30))); // a frame leaves the inside alone
        const Rect all = R(0, 0, 100, 100);
        EraseRect(&all);
        PaintRoundRect(&r, 20, 20);
        got = world.touched();
        QVERIFY2((got - rectPixels(20, 10, 90, 50)).isEmpty(), describe(got));
        QVERIFY(!got.contains(QPoint(20, 10)));
        QVERIFY(got.contains(QPoint(55, 10))); // straight edge
        InvertRoundRect(&r, 20, 20);
        QVERIFY(world.touched().isEmpty());
    }

    void lineHelpers()
    {
        World world;
        DrawLinesFromPointPairs({QPoint(0, 0), QPoint(4, 0), QPoint(0, 2), QPoint(4, 2), QPoint(9, 9)});
        QCOMPARE(world.touched(), rectPixels(0, 0, 5, 1) + rectPixels(0, 2, 5, 3));
        DrawPolylineFromPoints({QPoint(20, 20), QPoint(20, 24), QPoint(24, 24)});
        QVERIFY(world.touched().contains(QPoint(20, 22)) && world.touched().contains(QPoint(22, 24)));
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
};

VELMAR_TEST_MAIN(TestShapes)
#include "tst_shapes.moc"
