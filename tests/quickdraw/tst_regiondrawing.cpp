// Regions on a port: recording with OpenRgn/CloseRgn, drawing (exact pixel sets), the hilite
// inversion, clip calls, the desktop region, and recording misuse.
#include "QuickDrawTestSupport.h"

#include <QGuiApplication>
#include <QScreen>

using namespace Velmar;
using namespace QDTest;

static QRegion lShape()
{
    return QRegion(10, 10, 30, 8).united(QRegion(10, 10, 8, 30));
}

class TestRegionDrawing : public QObject {
    Q_OBJECT
private Q_SLOTS:
    void initTestCase() { SetLogCategory(kLogQuickDraw, true); }

    // Frames XOR their shapes in, recorded lines become one odd-even polygon, painting still
    // draws; the destination's old content is replaced and the port's scratch state freed.
    void recording()
    {
        World world;
        const Rect a = R(0, 0, 20, 20), b = R(10, 10, 30, 30), oval = R(20, 20, 30, 30), small = R(0, 0, 5, 5);
        PolyPtr* square = recordPoly({QPoint(0, 0), QPoint(20, 0), QPoint(20, 20), QPoint(0, 20)});
        Rgn inner = rgnOf(QRegion(5, 5, 5, 5));
        const QList<std::tuple<const char*, std::function<void()>, QRegion, int>> cases = {
            {"frames unite disjoint shapes", [&] { FrameRect(&small); FrameOval(&oval); },
             QRegion(0, 0, 5, 5).united(QRegion(20, 20, 10, 10, QRegion::Ellipse)), 0},
            {"the same frame twice cancels", [&] { FrameRect(&a); FrameRect(&a); }, QRegion(), 0},
            {"overlaps XOR", [&] { FrameRect(&a); FrameRect(&b); },
             QRegion(0, 0, 20, 20).xored(QRegion(10, 10, 20, 20)), 0},
            {"lines make an odd-even polygon", [&] { MoveTo(0, 0); LineTo(10, 0); LineTo(0, 10); },
             QRegion(QPolygon({QPoint(0, 0), QPoint(10, 0), QPoint(0, 10)}), Qt::OddEvenFill), 0},
            {"two points enclose nothing", [&] { MoveTo(0, 0); LineTo(10, 10); }, QRegion(), 0},
            {"FramePoly and FrameRgn", [&] { FramePoly(square); FrameRgn(inner.get()); },
             QRegion(*square->qPoly, Qt::OddEvenFill).xored(*inner), 0},
            {"paint draws, records nothing", [&] { PaintRect(&small); }, QRegion(), 25},
        };
        for (const auto& [name, draw, expected, drawn] : cases) {
            Rgn r = rgnOf(QRegion(40, 40, 5, 5));
            OpenRgn();
            draw();
            CloseRgn(r.get());
            QVERIFY2(*r == expected, name);
            QVERIFY2(world.touched().size() == drawn, name); // frames are recorded, not drawn
            QVERIFY(!world.port()->definingRgn);
            QVERIFY(world.port()->rgnSave == nullptr && world.port()->polySave == nullptr);
            const Rect all = R(0, 0, 100, 100);
            EraseRect(&all);
        }
        KillPoly(square);
    }

    void recordingMisuse()
    {
        World world;
        VelmarTest::ScriptedAutomationListener listener({}, QStringLiteral("Ignore"));
        Rgn r = rgnOf();
        OpenRgn();
        CloseRgn(nullptr); // keeps recording, deliberately
        QVERIFY(world.port()->definingRgn);
        { CleanupOpenRgn guard; } // closes the open region
        QVERIFY(!world.port()->definingRgn);
        QVERIFY(world.port()->rgnSave == nullptr);
        { CleanupOpenRgn idle; } // nothing open: nothing happens
        QVERIFY(listener.questions().isEmpty());

        CloseRgn(r.get()); // without OpenRgn
        QVERIFY(assertedWith(listener, "port->definingRgn == true"));
        QVERIFY(EmptyRgn(r.get()));

        OpenRgn();
        const Rect a = R(0, 0, 10, 10);
        FrameRect(&a);
        OpenRgn(); // nested: asserts, then starts afresh
        QVERIFY(assertedWith(listener, "port->definingRgn == false"));
        CloseRgn(r.get());
        QVERIFY(EmptyRgn(r.get()));

        PolyPtr* poly = OpenPoly();
        OpenRgn(); // while a polygon is open
        QVERIFY(assertedWith(listener, "port->definingPoly == false"));
        QVERIFY(!world.port()->definingPoly);
        PolyPtr* during = OpenPoly(); // while a region is open: detached polygon
        QVERIFY(assertedWith(listener, "port->definingRgn == false"));
        QVERIFY(world.port()->definingRgn);
        MoveTo(1, 1);
        QVERIFY(during->qPoly->isEmpty());
        CloseRgn(r.get());
        KillPoly(during);
        KillPoly(poly);

        SetPort(nullptr);
        VelmarTest::LogCapture log;
        OpenRgn();
        CloseRgn(r.get());
        FrameRgn(r.get());
        for (const char* call : {"OpenRgn", "CloseRgn", "FrameRgn"})
            QVERIFY(log.contains(QStringLiteral("warning: %1: cannot get current port").arg(QLatin1String(call))));
    }

    // Disposing the port while it records frees the scratch state (checked under ASan).
    void disposingARecordingPort()
    {
        auto* world = new World;
        OpenRgn();
        MoveTo(1, 1);
        delete world;
    }

    void paintEraseFillRgn()
    {
        World world;
        const QRegion shape = lShape().united(QRegion(60, 60, 5, 5));
        Rgn r = rgnOf(shape);
        PaintRgn(r.get());
        QCOMPARE(world.touched(), regionPixels(shape));
        EraseRgn(r.get());
        QVERIFY(world.touched().isEmpty());
        FillRgn(r.get(), GetQDGlobalsBlack(nullptr));
        QCOMPARE(world.touched(), regionPixels(shape));
        StdRgn(kQDGrafVerbErase, r.get());
        // Painting uses the pen pattern and honours the clip.
        Pattern gray;
        PenPat(GetQDGlobalsGray(&gray));
        Rgn clip = rgnOf(QRegion(10, 10, 10, 10));
        SetClip(clip.get());
        PaintRgn(r.get());
        const QSet<QPoint> got = world.touched();
        QCOMPARE(got.size(), 48); // half of the L shape's 96 pixels inside the clip
        QVERIFY((got - regionPixels(*clip)).isEmpty());
    }

    void frameRgnIsTheRegionMinusItsInset()
    {
        World world;
        Rgn r = rgnOf(lShape());
        FrameRgn(r.get());
        QCOMPARE(world.touched(), regionPixels(lShape() - QRegion(11, 11, 28, 6) - QRegion(11, 11, 6, 28)));
        // On a rectangle it matches FrameRect's pixels.
        const Rect all = R(0, 0, 100, 100), tr = R(10, 10, 20, 20);
        EraseRect(&all);
        PenSize(2, 2);
        Rgn rect = rgnOf(QRegion(10, 10, 10, 10));
        FrameRgn(rect.get());
        const QSet<QPoint> viaRgn = world.touched();
        EraseRect(&all);
        FrameRect(&tr);
        QVERIFY2(world.touched() == viaRgn, describe(world.touched()) + " / " + describe(viaRgn));
    }

    void invertRgnSwapsBackAndHilite()
    {
        World world;
        const RGBColor hilite(0, 0, 65535);
        HiliteColor(&hilite);
        const QRgb back = qRgb(255, 255, 255), blue = qRgb(0, 0, 255), black = qRgb(0, 0, 0);
        const Rect dot = R(15, 15, 16, 16);
        PaintRect(&dot); // one black pixel inside the region
        Rgn r = rgnOf(QRegion(10, 10, 10, 10));
        const unsigned char mode = LMGetHiliteMode();
        InvertRgn(r.get());
        QCOMPARE(LMGetHiliteMode(), mode);
        QCOMPARE(world.pixel(10, 10), blue);
        QCOMPARE(world.pixel(15, 15), black); // neither colour: left alone
        QCOMPARE(world.pixel(9, 10), back);
        QCOMPARE(world.touched(back).size(), 100);
        InvertRgn(r.get()); // twice is the identity
        QCOMPARE(world.touched(back), QSet<QPoint>{QPoint(15, 15)});
        StdRgn(kQDGrafVerbInvert, r.get());
        QCOMPARE(world.pixel(12, 12), blue);
    }

    void invertRgnHonoursClipAndOrigin()
    {
        World world;
        const RGBColor hilite(0, 65535, 0);
        HiliteColor(&hilite);
        SetOrigin(100, 100); // local (100, 100) is the image's (0, 0)
        Rgn clip = rgnOf(QRegion(100, 100, 5, 5));
        SetClip(clip.get());
        Rgn r = rgnOf(QRegion(100, 100, 20, 20));
        InvertRgn(r.get());
        QCOMPARE(world.touched().size(), 25);
        QCOMPARE(world.pixel(0, 0), qRgb(0, 255, 0));
    }

    void nullRegionsDrawNothing()
    {
        World world;
        Rgn empty = rgnOf();
        for (auto call : {PaintRgn, EraseRgn, FrameRgn, InvertRgn}) {
            call(nullptr);
            call(empty.get());
        }
        FillRgn(nullptr, GetQDGlobalsBlack(nullptr));
        StdRgn(kQDGrafVerbPaint, nullptr);
        QVERIFY(world.touched().isEmpty());
    }

    void clipCalls()
    {
        World world;
        Rgn got = rgnOf();
        GetClip(got.get());
        QVERIFY(got->contains(QRect(-30000, -30000, 60000, 60000))); // wide open at first
        const Rect r = R(5, 5, 15, 25);
        ClipRect(&r);
        GetClip(got.get());
        QCOMPARE(*got, QRegion(5, 5, 20, 10));
        const Rect all = R(0, 0, 100, 100);
        PaintRect(&all);
        QCOMPARE(world.touched(), regionPixels(QRegion(5, 5, 20, 10)));
        VelmarTest::LogCapture log;
        ClipRect(nullptr);
        SetClip(nullptr);
        GetClip(nullptr);
        GetClip(got.get());
        QCOMPARE(*got, QRegion(5, 5, 20, 10)); // the null calls changed nothing
        SetPort(nullptr);
        GetClip(got.get());
        SetClip(got.get());
        ClipRect(&r);
        for (const char* call : {"GetClip", "SetClip", "ClipRect"})
            QVERIFY(log.contains(QStringLiteral("warning: %1: cannot get current port").arg(QLatin1String(call))));
    }

    void grayRegionCoversEveryScreen()
    {
        RgnHandle gray = GetGrayRgn();
        QVERIFY(gray);
        QCOMPARE(GetGrayRgn(), gray); // the library's own region
        for (QScreen* screen : QGuiApplication::screens())
            QVERIFY(gray->contains(screen->availableGeometry()));
    }
};

VELMAR_TEST_MAIN(TestRegionDrawing)
#include "tst_regiondrawing.moc"
