// Polygons: recording with OpenPoly/ClosePoly, drawing under the odd-even rule, and misuse
// (nested opens, closing without opening, killing an open polygon, too few points).
#include "TestSupport.h"

#include "ShapeTestWorld.h"

#include <Velmar/Diagnostics.h>

#include <QPolygon>

using namespace Velmar;
using namespace ShapeTest;

namespace {

// A five-pointed star drawn in one stroke: its centre is enclosed twice.
PolyPtr* star()
{
    PolyPtr* poly = OpenPoly();
    MoveTo(50, 5);
    LineTo(79, 95);
    LineTo(2, 39);
    LineTo(98, 39);
    LineTo(21, 95);
    LineTo(50, 5);
    ClosePoly();
    return poly;
}

bool assertedWith(const VelmarTest::ScriptedAutomationListener& l, const char* expression)
{
    for (const auto& q : l.questions())
        if (q.text.contains(QString::fromLatin1(expression)))
            return true;
    return false;
}

} // namespace

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
        QCOMPARE(*poly->qPoly, QPolygon({QPoint(10, 10), QPoint(40, 10), QPoint(40, 40),
                                         QPoint(10, 10)}));
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
        PolyPtr* poly = star();
        PaintPoly(poly);
        const QSet<QPoint> got = world.touched();
        QVERIFY(got.contains(QPoint(50, 20)));  // a point of the star
        QVERIFY(!got.contains(QPoint(50, 50))); // the centre, enclosed twice
        QVERIFY(!got.contains(QPoint(5, 90)));
        InvertPoly(poly);
        QVERIFY(world.touched().isEmpty());
        KillPoly(poly);
    }

    void offsetPolyAndErase()
    {
        World world;
        PolyPtr* poly = OpenPoly();
        MoveTo(0, 0);
        LineTo(20, 0);
        LineTo(20, 20);
        LineTo(0, 20);
        ClosePoly();
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
    }

    void framePolyStrokesTheOutline()
    {
        World world;
        PolyPtr* poly = OpenPoly();
        MoveTo(10, 10);
        LineTo(30, 10);
        LineTo(30, 30);
        LineTo(10, 10);
        ClosePoly();
        FramePoly(poly);
        const QSet<QPoint> got = world.touched();
        QVERIFY(got.contains(QPoint(20, 10)));
        QVERIFY(got.contains(QPoint(30, 20)));
        QVERIFY(got.contains(QPoint(20, 20))); // the diagonal
        QVERIFY(!got.contains(QPoint(27, 15))); // inside stays clear
        KillPoly(poly);
    }

    void fewPointsDrawNothing_data()
    {
        QTest::addColumn<int>("points");
        QTest::newRow("0") << 0;
        QTest::newRow("1") << 1;
        QTest::newRow("2") << 2;
    }
    void fewPointsDrawNothing()
    {
        QFETCH(int, points);
        World world;
        PolyPtr* poly = OpenPoly();
        for (int i = 0; i < points; ++i)
            LineTo(short(10 + 20 * i), short(10 + 7 * i));
        ClosePoly();
        PaintPoly(poly);
        ErasePoly(poly);
        InvertPoly(poly);
        QVERIFY(world.touched().isEmpty());
        FramePoly(poly); // may draw the segment, never crashes
        const Rect box = GetPolyBBox(poly);
        if (points == 0)
            QVERIFY(box.left == 0 && box.top == 0 && box.right == 0 && box.bottom == 0);
        KillPoly(poly);
    }

    void nullPolygonsAreSafe()
    {
        World world;
        VelmarTest::LogCapture log;
        KillPoly(nullptr);
        OffsetPoly(nullptr, 1, 1);
        FramePoly(nullptr);
        PaintPoly(nullptr);
        ErasePoly(nullptr);
        InvertPoly(nullptr);
        FillPoly(nullptr, GetQDGlobalsBlack(nullptr));
        PolyPtr* const none = nullptr;
        const Rect box = GetPolyBBox(none);
        QVERIFY(box.left == 0 && box.right == 0);
        GetPolyRect(nullptr, nullptr);
        QVERIFY(log.contains("PaintPoly"));
    }

    void nestedOpenPolyAssertsAndReopens()
    {
        World world;
        VelmarTest::ScriptedAutomationListener listener({}, QStringLiteral("Ignore"));
        PolyPtr* first = OpenPoly();
        LineTo(1, 1);
        PolyPtr* second = OpenPoly();
        QVERIFY(assertedWith(listener, "port->definingPoly == false"));
        LineTo(2, 2);
        ClosePoly();
        QCOMPARE(first->qPoly->size(), 1);
        QCOMPARE(second->qPoly->size(), 1);
        QVERIFY(!world.port()->definingPoly);
        KillPoly(first);
        KillPoly(second);
    }

    void closeWithoutOpenIsLogged()
    {
        World world;
        VelmarTest::LogCapture log;
        ClosePoly();
        QVERIFY(log.contains("ClosePoly"));
        GrafPtr saved = world.port();
        SetPort(nullptr);
        ClosePoly();
        QVERIFY(log.contains("warning: ClosePoly: cannot get current port"));
        SetPort(saved);
    }

    // Killing the open polygon stops the recording; later lines draw instead of writing
    // into freed memory.
    void killWhileOpenStopsRecording()
    {
        World world;
        VelmarTest::LogCapture log;
        PolyPtr* poly = OpenPoly();
        LineTo(5, 5);
        KillPoly(poly);
        QVERIFY(!world.port()->definingPoly);
        QVERIFY(world.port()->polySave == nullptr);
        MoveTo(0, 0);
        LineTo(9, 0);
        QCOMPARE(world.touched().size(), 10);
    }

    void openPolyWithoutPortGivesAPolygonThatRecordsNothing()
    {
        GrafPtr saved = nullptr;
        GetPort(&saved);
        SetPort(nullptr);
        VelmarTest::ScriptedAutomationListener listener({}, QStringLiteral("Ignore"));
        PolyPtr* poly = OpenPoly();
        QVERIFY(assertedWith(listener, "!!port"));
        QVERIFY(poly && poly->qPoly && poly->qPoly->isEmpty());
        KillPoly(poly);
        SetPort(saved);
    }
};

VELMAR_TEST_MAIN(TestPolygons)
#include "tst_polygons.moc"
