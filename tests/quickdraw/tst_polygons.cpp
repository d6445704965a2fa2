// Polygons: recording with OpenPoly/ClosePoly, drawing under the odd-even rule, and misuse
// (nested opens, closing without opening, killing an open polygon, too few points).
#include "QuickDrawTestSupport.h"

using namespace Velmar;
using namespace QDTest;

class TestPolygons : public QObject {
    Q_OBJECT
private Q_SLOTS:
    void initTestCase() { SetLogCategory(kLogQuickDraw, true); }

    void recordingDrawsNothingAndMovesThePen()
    {
        World world;
        PolyPtr* poly = OpenPoly();
        QVERIFY(poly && poly->qPoly);
        MoveTo(10, 10);
        LineTo(40, 10);
        Line(0, 30);
        LineTo(10, 10);
        ClosePoly();
        QVERIFY(world.touched().isEmpty());
        QCOMPARE(*poly->qPoly, QPolygon({QPoint(10, 10), QPoint(40, 10), QPoint(40, 40), QPoint(10, 10)}));
        Point pen{};
        GetPen(&pen);
        QVERIFY(pen.h == 10 && pen.v == 10);
        // After ClosePoly lines draw again.
        LineTo(10, 20);
        QVERIFY(!world.touched().isEmpty());
        const Rect box = GetPolyBBox(poly);
        QVERIFY(box.left == 10 && box.top == 10 && box.right == 41 && box.bottom == 41);
        QRect q;
        GetPolyRect(poly, &q);
        QCOMPARE(q, QRect(QPoint(10, 10), QPoint(40, 40)));
        KillPoly(poly);
    }

    void paintPolyUsesOddEvenRule()
    {
        World world;
        // A five-pointed star drawn in one stroke: its centre is enclosed twice.
        PolyPtr* poly = recordPoly({QPoint(50, 5), QPoint(79, 95), QPoint(2, 39), QPoint(98, 39), QPoint(21, 95), QPoint(50, 5)});
        PaintPoly(poly);
        const QSet<QPoint> got = world.touched();
        QVERIFY(got.contains(QPoint(50, 20)));  // a point of the star
        QVERIFY(!got.contains(QPoint(50, 50))); // the centre, enclosed twice
        QVERIFY(!got.contains(QPoint(5, 90)));
        InvertPoly(poly);
        QVERIFY(world.touched().isEmpty());
        KillPoly(poly);
    }

    void offsetEraseFillFrame()
    {
        World world;
        PolyPtr* poly = recordPoly({QPoint(0, 0), QPoint(20, 0), QPoint(20, 20), QPoint(0, 20)});
        OffsetPoly(poly, 30, 40);
        QCOMPARE(poly->qPoly->boundingRect(), QRect(30, 40, 21, 21));
        const Rect all = R(0, 0, 100, 100);
        PaintRect(&all);
        ErasePoly(poly);
        QVERIFY(world.pixel(40, 50) == qRgb(255, 255, 255));
        QVERIFY(world.pixel(10, 10) == qRgb(0, 0, 0));
        FillPoly(poly, GetQDGlobalsBlack(nullptr));
        QVERIFY(world.pixel(40, 50) == qRgb(0, 0, 0));
        KillPoly(poly);

        EraseRect(&all);
        poly = recordPoly({QPoint(10, 10), QPoint(30, 10), QPoint(30, 30), QPoint(10, 10)});
        FramePoly(poly);
        const QSet<QPoint> got = world.touched(); // both legs and the diagonal; inside stays clear
        QVERIFY(got.contains(QPoint(20, 10)) && got.contains(QPoint(30, 20)) && got.contains(QPoint(20, 20)));
        QVERIFY(!got.contains(QPoint(27, 15)));
        KillPoly(poly);
    }

    void fewPointsDrawNothing()
    {
        for (const QList<QPoint>& points :
             {QList<QPoint>{}, {QPoint(10, 10)}, {QPoint(10, 10), QPoint(30, 17)}}) {
            World world;
            PolyPtr* poly = recordPoly(points);
            PaintPoly(poly);
            ErasePoly(poly);
            InvertPoly(poly);
            QVERIFY(world.touched().isEmpty());
            FramePoly(poly); // may draw the segment, never crashes
            const Rect box = GetPolyBBox(poly);
            if (points.isEmpty())
                QVERIFY(box.left == 0 && box.top == 0 && box.right == 0 && box.bottom == 0);
            KillPoly(poly);
        }
    }

    // A nested OpenPoly asserts and reopens; closing without opening is logged; killing the
    // open polygon stops the recording, so that later lines draw instead of writing into freed
    // memory; without a port OpenPoly asserts and gives a polygon that records nothing.
    void misuse()
    {
        World world;
        VelmarTest::ScriptedAutomationListener listener({}, QStringLiteral("Ignore"));
        VelmarTest::LogCapture log;
        PolyPtr* first = OpenPoly();
        LineTo(1, 1);
        PolyPtr* second = OpenPoly();
        QVERIFY(assertedWith(listener, "port->definingPoly == false"));
        LineTo(2, 2);
        ClosePoly();
        QCOMPARE(first->qPoly->size(), 1);
        QCOMPARE(second->qPoly->size(), 1);
        QVERIFY(!world.port()->definingPoly);
        ClosePoly();
        QVERIFY(log.contains("warning: ClosePoly: no polygon is open"));
        KillPoly(first);
        KillPoly(second);

        PolyPtr* poly = OpenPoly();
        LineTo(5, 5);
        KillPoly(poly);
        QVERIFY(!world.port()->definingPoly);
        QVERIFY(world.port()->polySave == nullptr);
        MoveTo(0, 0);
        LineTo(9, 0);
        QCOMPARE(world.touched().size(), 10);

        SetPort(nullptr);
        ClosePoly();
        QVERIFY(log.contains("warning: ClosePoly: cannot get current port"));
        poly = OpenPoly();
        QVERIFY(assertedWith(listener, "!!port"));
        QVERIFY(poly && poly->qPoly && poly->qPoly->isEmpty());
        KillPoly(poly);
    }
};

VELMAR_TEST_MAIN(TestPolygons)
#include "tst_polygons.moc"
