// The pen: size, visibility, mode, style, pen state, and the no-port warnings.
#include <Velmar/Diagnostics.h>
#include <Velmar/QtGrafPort.h>
#include <Velmar/QuickDraw.h>

#include "TestSupport.h"
#include "foundation/Conversions.h"
#include "quickdraw/PortPainter.h"

using namespace Velmar;
using Velmar::Private::makeRect;

namespace {

GrafPtr newCurrentWorld()
{
    const Rect r = makeRect(0, 0, 8, 8);
    GrafPtr world = nullptr;
    NewGWorld(&world, 32, &r, nullptr, nullptr, 0);
    SetPort(world);
    return world;
}

} // namespace

class TestPen : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void init()
    {
        SetLogCategory(kLogQuickDraw | kLogGrafPort, true);
        SetPort(nullptr);
    }

    // Each case runs with the painter inactive and active: the state must not depend on it.
    void penSizeVisibility_data()
    {
        QTest::addColumn<bool>("active");
        QTest::newRow("no painter") << false;
        QTest::newRow("painter") << true;
    }
    void penSizeVisibility()
    {
        QFETCH(bool, active);
        GrafPtr world = newCurrentWorld();
        if (active)
            QVERIFY(Private::portPainter(world, "test"));
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
        DisposeGWorld(world);
    }

    void hideAndShowNest_data() { penSizeVisibility_data(); }
    void hideAndShowNest()
    {
        QFETCH(bool, active);
        GrafPtr world = newCurrentWorld();
        if (active)
            QVERIFY(Private::portPainter(world, "test"));
        PenSize(2, 2);
        SetPenStyle(Qt::DashLine);
        HidePen();
        HidePen();
        QCOMPARE(world->penVisibility, SInt16(-2));
        QCOMPARE(world->currentPen().style(), Qt::NoPen);
        ShowPen();
        QCOMPARE(world->currentPen().style(), Qt::NoPen);
        // A colour chosen while hidden is kept when the pen shows again.
        const RGBColor green(0, 65535, 0);
        RGBForeColor(&green);
        ShowPen();
        QCOMPARE(world->penVisibility, SInt16(0));
        QCOMPARE(world->currentPen().style(), Qt::DashLine);
        QCOMPARE(world->currentPen().width(), 2);
        QCOMPARE(world->currentPen().color(), QColor(0, 255, 0));
        QCOMPARE(GetPenStyle(), int(Qt::DashLine));
        DisposeGWorld(world);
    }

    void penModes_data()
    {
        QTest::addColumn<int>("mode");
        QTest::addColumn<int>("composition");
        const struct {
            int mode;
            QPainter::CompositionMode composition;
        } table[] = {
            {srcCopy, QPainter::CompositionMode_SourceOver},
            {srcOr, QPainter::CompositionMode_SourceOver},
            {srcXor, QPainter::RasterOp_NotSourceXorDestination},
            {3, QPainter::CompositionMode_SourceOver},
            {patCopy, QPainter::CompositionMode_SourceOver},
            {patOr, QPainter::CompositionMode_SourceOver},
            {patXor, QPainter::RasterOp_NotSourceXorDestination},
            {patBic, QPainter::CompositionMode_DestinationOver},
            {notPatCopy, QPainter::CompositionMode_SourceOver},
            {subPin, QPainter::CompositionMode_Exclusion},
            {-1, QPainter::CompositionMode_SourceOver},
            {1000, QPainter::CompositionMode_SourceOver},
        };
        for (const auto& row : table)
            QTest::newRow(qPrintable(QString::number(row.mode))) << row.mode << int(row.composition);
    }
    void penModes()
    {
        QFETCH(int, mode);
        QFETCH(int, composition);
        GrafPtr world = newCurrentWorld();
        PenMode(SInt16(mode));
        QCOMPARE(GetPortPenMode(world), SInt16(mode));
        QCOMPARE(int(world->currentCompositionMode()), composition);
        QVERIFY(Private::portPainter(world, "test"));
        QCOMPARE(int(world->painter->compositionMode()), composition);
        PenNormal();
        QCOMPARE(GetPortPenMode(world), SInt16(patCopy));
        QCOMPARE(world->painter->compositionMode(), QPainter::CompositionMode_SourceOver);
        DisposeGWorld(world);
    }

    void penStateRoundTrip()
    {
        GrafPtr world = newCurrentWorld();
        PenState state(QPoint(3, 4), 5, patXor, *GetQDGlobalsGray(nullptr).brush());
        SetPenState(&state);
        Point pen;
        GetPen(&pen);
        QCOMPARE(pen.h, SInt16(3));
        QCOMPARE(pen.v, SInt16(4));
        QCOMPARE(world->currentPen().width(), 5);
        QCOMPARE(world->currentCompositionMode(), QPainter::RasterOp_NotSourceXorDestination);
        PenNormal();
        PenState saved;
        QCOMPARE(saved.penMode(), SInt16(0));
        QCOMPARE(saved.penSize(), 0);
        SetPenState(&state);
        GetPenState(&saved);
        QCOMPARE(saved.penLocation(), QPoint(3, 4));
        QCOMPARE(saved.penSize(), 5);
        QCOMPARE(saved.penMode(), SInt16(patXor));
        QCOMPARE(saved.penPattern(), *GetQDGlobalsGray(nullptr).brush());
        // Copies are independent.
        PenState copy(saved);
        copy.setPenLocation(QPoint(9, 9));
        copy.setPenSize(1);
        QCOMPARE(saved.penLocation(), QPoint(3, 4));
        saved = copy;
        QCOMPARE(saved.penSize(), 1);
        SetPenState(nullptr);
        GetPenState(nullptr);
        GetPen(nullptr);
        DisposeGWorld(world);
    }

    void noPortWarnings()
    {
        VelmarTest::LogCapture log;
        PenPat(GetQDGlobalsGray(nullptr));
        BackPat(GetQDGlobalsGray(nullptr));
        PenSize(1, 1);
        PenMode(patCopy);
        HidePen();
        ShowPen();
        SetPenStyle(1);
        QCOMPARE(GetPenStyle(), int(Qt::SolidLine));
        PenState state;
        GetPenState(&state);
        SetPenState(&state);
        PenNormal();
        Point p;
        GetPen(&p);
        for (const char* name : {"PenPat", "BackPat", "PenSize", "PenMode", "HidePen", "ShowPen",
                                 "SetPenStyle", "GetPenStyle", "GetPenState", "SetPenState",
                                 "PenNormal", "GetPen"}) {
            const QString text = QStringLiteral("warning: %1: Can't get current port !")
                                     .arg(QLatin1String(name));
            QVERIFY2(log.contains(text), qPrintable(text));
        }
    }
};

VELMAR_TEST_MAIN(TestPen)
#include "tst_pen.moc"
