// Regions on a port: recording with OpenRgn/CloseRgn, drawing (exact pixel sets), the hilite
// inversion, clip calls, the desktop region, and recording misuse.
#include "TestSupport.h"

#include "ShapeTestWorld.h"

#include <Velmar/Diagnostics.h>

#include <QGuiApplication>
#include <QPolygon>
#include <QScreen>

#include <memory>

using namespace Velmar;
using namespace ShapeTest;

namespace {

struct RgnDeleter {
    void operator()(QRegion* r) const { DisposeRgn(r); }
};
using Rgn = std::unique_ptr<QRegion, RgnDeleter>;

Rgn rgnOf(const QRegion& region)
{
    Rgn r(NewRgn());
    *r = region;
    return r;
}

QRegion lShape()
{
    return QRegion(10, 10, 30, 8).united(QRegion(10, 10, 8, 30));
}

bool assertedWith(const VelmarTest::ScriptedAutomationListener& l, const char* expression)
{
    for (const auto& q : l.questions())
        if (q.text.contains(QString::fromLatin1(expression)))
            return true;
    return false;
}

} // namespace

class TestRegionDrawing : public QObject {
    Q_OBJECT
private Q_SLOTS:
    void initTestCase() { SetLogCategory(kLogQuickDraw, true); }

    // ---- Recording -----------------------------------------------------------------------

    void recordingFramesUnitesDisjointShapes()
    {
        World world;
        Rgn r(NewRgn());
        OpenRgn();
        const Rect box = R(0, 0, 10, 10), oval = R(20, 20, 30, 30);
        FrameRect(&box);
        FrameOval(&oval);
        CloseRgn(r.get());
        QCOMPARE(*r, QRegion(0, 0, 10, 10).united(QRegion(20, 20, 10, 10, QRegion::Ellipse)));
        QVERIFY(world.touched().isEmpty()); // frames were recorded, not drawn
        QVERIFY(!world.port()->definingRgn);
        QVERIFY(world.port()->rgnSave == nullptr && world.port()->polySave == nullptr);
    }

    void recordingXorsOverlaps()
    {
        World world;
        Rgn r(NewRgn());
        const Rect a = R(0, 0, 20, 20), b = R(10, 10, 30, 30);
        OpenRgn();
        FrameRect(&a);
        FrameRect(&a);
        CloseRgn(r.get());
        QVERIFY(EmptyRgn(r.get())); // the same rectangle twice cancels out
        OpenRgn();
        FrameRect(&a);
        FrameRect(&b);
        CloseRgn(r.get());
        QCOMPARE(*r, QRegion(0, 0, 20, 20).xored(QRegion(10, 10, 20, 20)));
        QVERIFY(!PtInRgn(Point{15, 15}, r.get()));
    }

    void recordingLinesMakesAnOddEvenPolygon()
    {
        World world;
        Rgn r(NewRgn());
        OpenRgn();
        MoveTo(0, 0);
        LineTo(10, 0);
        LineTo(0, 10);
        CloseRgn(r.get());
        const QPolygon triangle({QPoint(0, 0), QPoint(10, 0), QPoint(0, 10)});
        QCOMPARE(*r, QRegion(triangle, Qt::OddEvenFill));
        QVERIFY(!EmptyRgn(r.get()));
        QVERIFY(world.touched().isEmpty());
        Point pen{};
        GetPen(&pen);
        QVERIFY(pen.h == 0 && pen.v == 10);
    }

    void recordingTwoPointsGivesNothing()
    {
        World world;
        Rgn r(NewRgn());
        SetRectRgn(r.get(), 0, 0, 5, 5);
        OpenRgn();
        MoveTo(0, 0);
        LineTo(10, 10);
        CloseRgn(r.get());
        QVERIFY(EmptyRgn(r.get()));
    }

    void recordingFramePolyAndFrameRgn()
    {
        World world;
        PolyPtr* poly = OpenPoly();
        MoveTo(0, 0);
        LineTo(20, 0);
        LineTo(20, 20);
        LineTo(0, 20);
        ClosePoly();
        Rgn inner = rgnOf(QRegion(5, 5, 5, 5));
        Rgn r(NewRgn());
        OpenRgn();
        FramePoly(poly);
        FrameRgn(inner.get());
        CloseRgn(r.get());
        const QRegion expected = QRegion(poly->qPoly->toList(), Qt::OddEvenFill).xored(*inner);
        QCOMPARE(*r, expected);
        QVERIFY(!PtInRgn(Point{7, 7}, r.get())); // the hole
        KillPoly(poly);
    }

    void paintingStillDrawsWhileRecording()
    {
        World world;
        OpenRgn();
        const Rect r = R(0, 0, 5, 5);
        PaintRect(&r);
        Rgn out(NewRgn());
        CloseRgn(out.get());
        QCOMPARE(world.touched().size(), 25);
        QVERIFY(EmptyRgn(out.get()));
    }

    void closeRgnWithNullKeepsRecording()
    {
        World world;
        OpenRgn();
        CloseRgn(nullptr);
        QVERIFY(world.port()->definingRgn);
        Rgn r(NewRgn());
        CloseRgn(r.get());
        QVERIFY(!world.port()->definingRgn);
    }

    void cleanupOpenRgnClosesAnOpenRegion()
    {
        World world;
        {
            CleanupOpenRgn guard;
            OpenRgn();
            const Rect r = R(0, 0, 10, 10);
            FrameRect(&r);
        }
        QVERIFY(!world.port()->definingRgn);
        QVERIFY(world.port()->rgnSave == nullptr);
        { CleanupOpenRgn idle; } // nothing open: nothing happens
    }

    void recordingMisuse()
    {
        World world;
        VelmarTest::ScriptedAutomationListener listener({}, QStringLiteral("Ignore"));
        Rgn r(NewRgn());
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

        listener.questions();
        GrafPtr saved = world.port();
        SetPort(nullptr);
        VelmarTest::LogCapture log;
        OpenRgn();
        CloseRgn(r.get());
        FrameRgn(r.get());
        QVERIFY(log.contains("warning: OpenRgn: cannot get current port"));
        QVERIFY(log.contains("warning: CloseRgn: cannot get current port"));
        QVERIFY(log.contains("warning: FrameRgn: cannot get current port"));
        SetPort(saved);
    }

    // Disposing the port while it records frees the scratch state (checked under ASan).
    void disposingARecordingPort()
    {
        auto* world = new World;
        OpenRgn();
        MoveTo(1, 1);
        delete world;
    }

    // ---- Drawing --------------------------------------------------------------------------

    void paintRgnTouchesExactlyTheRegion()
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
    }

    void paintRgnWithPatternAndClip()
    {
        World world;
        Pattern gray;
        PenPat(GetQDGlobalsGray(&gray));
        Rgn r = rgnOf(QRegion(0, 0, 40, 40));
        Rgn clip = rgnOf(QRegion(10, 10, 10, 10));
        SetClip(clip.get());
        PaintRgn(r.get());
        const QSet<QPoint> got = world.touched();
        QCOMPARE(got.size(), 50); // half of the clipped 10x10 square
        QVERIFY((got - regionPixels(*clip)).isEmpty());
    }

    void frameRgnIsTheRegionMinusItsInset()
    {
        World world;
        Rgn r = rgnOf(lShape());
        FrameRgn(r.get());
        QCOMPARE(world.touched(), regionPixels(lShape() - QRegion(11, 11, 28, 6) - QRegion(11, 11, 6, 28)));
        // On a rectangle it matches FrameRect's pixels.
        World second;
        Rgn rect = rgnOf(QRegion(10, 10, 10, 10));
        PenSize(2, 2);
        FrameRgn(rect.get());
        const QSet<QPoint> viaRgn = second.touched();
        World third;
        PenSize(2, 2);
        const Rect tr = R(10, 10, 20, 20);
        FrameRect(&tr);
        QVERIFY2(third.touched() == viaRgn, describe(third.touched()) + " / " + describe(viaRgn));
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
        PaintRgn(nullptr);
        EraseRgn(nullptr);
        FillRgn(nullptr, GetQDGlobalsBlack(nullptr));
        FrameRgn(nullptr);
        InvertRgn(nullptr);
        StdRgn(kQDGrafVerbPaint, nullptr);
        Rgn empty(NewRgn());
        PaintRgn(empty.get());
        FrameRgn(empty.get());
        InvertRgn(empty.get());
        QVERIFY(world.touched().isEmpty());
    }

    // ---- Clip and desktop -------------------------------------------------------------------

    void clipCalls()
    {
        World world;
        Rgn got(NewRgn());
        GetClip(got.get());
        QVERIFY(got->contains(QRect(-30000, -30000, 60000, 60000))); // wide open at first
        const Rect r = R(5, 5, 15, 25);
        ClipRect(&r);
        GetClip(got.get());
        QCOMPARE(*got, QRegion(5, 5, 20, 10));
        const Rect all = R(0, 0, 100, 100);
        PaintRect(&all);
        QCOMPARE(world.touched(), regionPixels(QRegion(5, 5, 20, 10)));
        Rgn set = rgnOf(QRegion(50, 50, 3, 3));
        SetClip(set.get());
        GetClip(got.get());
        QCOMPARE(*got, *set);
        VelmarTest::LogCapture log;
        ClipRect(nullptr);
        SetClip(nullptr);
        GetClip(nullptr);
        GetClip(got.get());
        QCOMPARE(*got, *set); // the null calls changed nothing
        GrafPtr saved = world.port();
        SetPort(nullptr);
        GetClip(got.get());
        SetClip(got.get());
        ClipRect(&r);
        QVERIFY(log.contains("warning: GetClip: cannot get current port"));
        QVERIFY(log.contains("warning: SetClip: cannot get current port"));
        QVERIFY(log.contains("warning: ClipRect: cannot get current port"));
        SetPort(saved);
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
