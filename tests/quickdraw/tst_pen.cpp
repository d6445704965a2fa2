// The pen: size, visibility, mode and the pen state record.
#include "QuickDrawTestSupport.h"

using namespace Velmar;
using namespace QDTest;

class TestPen : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void init()
    {
        SetLogCategory(kLogQuickDraw | kLogGrafPort, true);
        SetPort(nullptr);
    }

    // The rules hold with the painter inactive and active: the state must not depend on it.
    void penSizeAndVisibility_data()
    {
        QTest::addColumn<bool>("active");
        QTest::newRow("no painter") << false;
        QTest::newRow("painter") << true;
    }
    void penSizeAndVisibility()
    {
        QFETCH(bool, active);
        World world(8);
        if (active)
            QVERIFY(world.painter());
        const RGBColor blue(0, 0, 65535);
        RGBForeColor(&blue);
        PenSize(0, 5);
        QCOMPARE(world->currentPen().style(), Qt::NoPen);
        PenSize(3, 3);
        QCOMPARE(world->currentPen().style(), Qt::NoPen); // deliberately stays invisible
        QCOMPARE(world->currentPen().width(), 3);
        PenSize(4, 9);
        QCOMPARE(world->currentPen().width(), 4); // the height is ignored
        PenNormal();
        const QPen& pen = world->currentPen();
        QCOMPARE(pen.style(), Qt::SolidLine);
        QCOMPARE(pen.widthF(), 1.0);
        QCOMPARE(pen.capStyle(), Qt::SquareCap);
        QCOMPARE(pen.joinStyle(), Qt::BevelJoin);
        QCOMPARE(pen.color(), QColor(0, 0, 255));
        QCOMPARE(world->isActive(), active);

        // HidePen and ShowPen nest; the pen comes back with the colour chosen while hidden.
        PenSize(2, 2);
        SetPenStyle(Qt::DashLine);
        HidePen();
        HidePen();
        QCOMPARE(world->penVisibility, SInt16(-2));
        QCOMPARE(world->currentPen().style(), Qt::NoPen);
        ShowPen();
        QCOMPARE(world->currentPen().style(), Qt::NoPen);
        const RGBColor green(0, 65535, 0);
        RGBForeColor(&green);
        ShowPen();
        QCOMPARE(world->penVisibility, SInt16(0));
        QCOMPARE(world->currentPen().style(), Qt::DashLine);
        QCOMPARE(world->currentPen().width(), 2);
        QCOMPARE(world->currentPen().color(), QColor(0, 255, 0));
        QCOMPARE(GetPenStyle(), int(Qt::DashLine));
    }

    void penModes_data()
    {
        QTest::addColumn<int>("mode");
        QTest::addColumn<int>("composition");
        const int over = QPainter::CompositionMode_SourceOver;
        const int notXor = QPainter::RasterOp_NotSourceXorDestination;
        for (const auto& [name, mode, composition] :
             {std::tuple{"srcCopy", int(srcCopy), over}, {"srcOr", srcOr, over}, {"srcXor", srcXor, notXor},
              {"3", 3, over}, {"patCopy", patCopy, over}, {"patOr", patOr, over}, {"patXor", patXor, notXor},
              {"patBic", patBic, int(QPainter::CompositionMode_DestinationOver)},
              {"notPatCopy", notPatCopy, over}, {"subPin", subPin, int(QPainter::CompositionMode_Exclusion)},
              {"-1", -1, over}, {"1000", 1000, over}})
            QTest::newRow(name) << mode << composition;
    }
    void penModes()
    {
        QFETCH(int, mode);
        QFETCH(int, composition);
        World world(8);
        PenMode(SInt16(mode));
        QCOMPARE(GetPortPenMode(world), SInt16(mode));
        QCOMPARE(int(world->currentCompositionMode()), composition);
        QVERIFY(world.painter());
        QCOMPARE(int(world->painter->compositionMode()), composition);
        PenNormal();
        QCOMPARE(GetPortPenMode(world), SInt16(patCopy));
        QCOMPARE(world->painter->compositionMode(), QPainter::CompositionMode_SourceOver);
    }

    // Colours that alternate reuse earlier pens: everything else the pen held must survive,
    // whatever changed between two colour changes.
    void alternatingColoursKeepThePen()
    {
        World world(8);
        QVERIFY(world.painter());
        const RGBColor red(65535, 0, 0), blue(0, 0, 65535);
        for (const RGBColor* c : {&red, &blue, &red})
            RGBForeColor(c);
        PenSize(3, 3);
        RGBForeColor(&blue);
        QCOMPARE(world->painter->pen().width(), 3);
        SetPenStyle(Qt::DashLine);
        RGBForeColor(&red);
        RGBForeColor(&blue);
        QCOMPARE(world->painter->pen().style(), Qt::DashLine);
        QCOMPARE(world->painter->pen().width(), 3);
        QCOMPARE(world->painter->pen().color(), QColor(0, 0, 255));
    }

    void penStateRoundTrip()
    {
        World world(8);
        const QBrush gray = *GetQDGlobalsGray(nullptr).brush();
        PenState state(QPoint(3, 4), 5, patXor, gray);
        SetPenState(&state);
        Point pen;
        GetPen(&pen);
        QCOMPARE(pen.h, SInt16(3));
        QCOMPARE(pen.v, SInt16(4));
        QCOMPARE(world->currentPen().width(), 5);
        QCOMPARE(world->currentCompositionMode(), QPainter::RasterOp_NotSourceXorDestination);
        SetPenState(nullptr);
        GetPenState(nullptr);
        GetPen(nullptr);
    }
};

VELMAR_TEST_MAIN(TestPen)
#include "tst_pen.moc"
