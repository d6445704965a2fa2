// The current port, the painter cap, dirty marking, port state, the no-port warnings,
// pixels and scrolling.
#include "QuickDrawTestSupport.h"

#include <functional>
#include <memory>
#include <vector>

using namespace Velmar;
using Velmar::Private::makeRect;
using namespace QDTest;

namespace {

// A window port without a real window: the hooks below stand in for the window layer.
AQtWindow* const kFakeWindow = reinterpret_cast<AQtWindow*>(0x1000);
QList<QRect> gDirty;
QtGrafPort* gFrontPort = nullptr;

struct HookScope {
    HookScope()
    {
        Private::PortWindowHooks hooks;
        hooks.markDirty = [](AQtWindow*, const QRect& r) { gDirty.append(r); };
        hooks.frontVisiblePortExcept = [](AQtWindow*) { return gFrontPort; };
        Private::setPortWindowHooks(hooks);
        gDirty.clear();
    }
    ~HookScope() { Private::setPortWindowHooks(Private::PortWindowHooks()); }
};

QtGrafPort* newWindowPort(int width, int height)
{
    auto* image = new QImage(width, height, QImage::Format_ARGB32_Premultiplied);
    return new QtGrafPort(kFakeWindow, QRect(0, 0, width, height), image);
}

// Calls that need the current port (one per source file), and the exact line each logs
// without one.
const std::pair<const char*, void (*)()> kNoPortCases[] = {
    {"warning: PaintOval: Can't get current port!", [] { QVERIFY(!MakeQPainter("PaintOval")); }},
    {"warning: GetForeColor: Can't get current port!",
     [] { RGBColor c(7, 7, 7); GetForeColor(&c); QCOMPARE(c.red, (unsigned short)7); }},
    {"warning: SetCPixel: cannot get Qt port", [] { SetCPixel(0, 0, nullptr); }},
    {"PortSize: current port is NULL", [] { PortSize(10, 10); }},
    {"warning: PenSize: Can't get current port !", [] { PenSize(1, 1); }},
    {"warning: LineTo: cannot get current port", [] { LineTo(1, 1); }},
    {"warning: FrameRect: cannot get current port", [] { const Rect r = makeRect(0, 0, 9, 9); FrameRect(&r); }},
    {"warning: FrameOval: cannot get current port", [] { const Rect r = makeRect(0, 0, 9, 9); FrameOval(&r); }},
    // Both point-list calls warn under the first one's name.
    {"warning: DrawLinesFromPointPairs: cannot get Qt port", [] { DrawPolylineFromPoints({QPoint(1, 1)}); }},
    {"OpColor: Can't get port", [] { const RGBColor c; OpColor(&c); }},
};

} // namespace

class TestPort : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void init()
    {
        SetLogCategory(kLogQuickDraw | kLogGrafPort, true);
        SetPort(nullptr);
    }

    void currentPortAndInvalidPorts()
    {
        VelmarTest::LogCapture log;
        World a(4), b(4);
        SetPort(a);
        GrafPtr got = nullptr;
        GetPort(&got);
        QCOMPARE(got, GrafPtr(a));
        SetGWorld(b, reinterpret_cast<void*>(0x1234)); // the device is ignored
        void* device = reinterpret_cast<void*>(0x1);
        GetGWorld(&got, &device);
        QCOMPARE(got, GrafPtr(b));
        QCOMPARE(device, nullptr);
        GetGWorld(&got, nullptr);
        GetPort(nullptr);
        QCOMPARE(GetCurrentPort(), GrafPtr(b));
        DisposeGWorld(b);
        QCOMPARE(GetCurrentPort(), nullptr);
        // A disposed port is refused and resets the current port.
        SetPort(a);
        SetPort(b);
        QVERIFY(log.contains(QStringLiteral("Velmar::SetPort(")));
        QVERIFY(log.contains(QStringLiteral(") reset invalid GrafPort!")));
        QCOMPARE(GetCurrentPort(), nullptr);
        QVERIFY(!IsValidPort(b));
        QVERIFY(!IsValidPort(nullptr));
        // Memory that merely looks like a port is not one, and is not read.
        alignas(QtGrafPort) unsigned char fake[sizeof(QtGrafPort)] = {};
        QVERIFY(!IsValidPort(reinterpret_cast<GrafPtr>(fake)));
        SetPort(a);
        SetPort(reinterpret_cast<GrafPtr>(fake));
        QCOMPARE(GetCurrentPort(), nullptr);
        QVERIFY(IsValidPort(a));
    }

    void painterCap()
    {
        std::vector<std::unique_ptr<World>> ports;
        for (int i = 0; i < 51; ++i) {
            ports.push_back(std::make_unique<World>(2));
            QVERIFY(ports.back()->painter());
        }
        QCOMPARE(Private::activePainterCount(), 50);
        QVERIFY(!(*ports.front())->isActive());
        QVERIFY(!Private::isPainterListed(*ports.front()));
        for (int i = 1; i < 51; ++i)
            QVERIFY((*ports[i])->isActive());
        // Drawing into the first again restarts it and ends the next oldest.
        QVERIFY(ports.front()->painter());
        QVERIFY(!(*ports[1])->isActive());
        QCOMPARE(Private::activePainterCount(), 50);
        ports.clear();
        QCOMPARE(Private::activePainterCount(), 0);
    }

    void painterStateSurvivesEndPaint()
    {
        World world(8);
        QVERIFY(world.painter());
        const RGBColor green(0, 65535, 0);
        RGBForeColor(&green);
        QCOMPARE(world->painter->pen().color(), QColor(0, 255, 0));
        PenSize(3, 3);
        PenMode(patXor);
        SetOrigin(2, 2);
        world->EndPaint();
        RGBColor c;
        GetForeColor(&c);
        QCOMPARE(quint32(c), 0xFF00FF00u);
        QCOMPARE(world->currentPen().width(), 3);
        QVERIFY(world.painter());
        QCOMPARE(world->painter->pen().width(), 3);
        QCOMPARE(world->painter->compositionMode(), QPainter::RasterOp_NotSourceXorDestination);
        QCOMPARE(world->painter->transform(), QTransform::fromTranslate(-2, -2));
    }

    void noPortWarnings()
    {
        for (const auto& [warning, call] : kNoPortCases) {
            SetLogCategory(kLogQuickDraw, true);
            VelmarTest::LogCapture log;
            call();
            QVERIFY2(log.contains(QLatin1String(warning)), warning);
            // A disabled category writes nothing.
            SetLogCategory(kLogQuickDraw, false);
            log.clear();
            call();
            QVERIFY2(log.lines().isEmpty(), warning);
        }
    }

    // What a call names is reported to the port's window in widget coordinates: exactly the
    // union for the port's own painter, and a covering rectangle well short of the whole port
    // (what a call naming nothing reports) for the drawing calls.
    void dirtyMarking()
    {
        HookScope hooks;
        QtGrafPort* port = newWindowPort(100, 100);
        QCOMPARE(port->image()->pixel(0, 0), qRgb(255, 255, 255)); // content colour
        SetPort(port);
        const RGBColor red(65535, 0, 0);
        const Rect r = R(10, 20, 30, 60);
        const QRect q(20, 10, 40, 20), rq(30, 40, 20, 10), pq(10, 10, 31, 21);
        const Rgn region = rgnOf(QRegion(rq));
        PolyPtr* poly = recordPoly({QPoint(10, 10), QPoint(40, 10), QPoint(40, 30)});
        const QList<std::tuple<const char*, std::function<void()>, QRect, bool>> cases = {
            {"union of the named", [] { MakeQPainter p("test"); QVERIFY(!!p); p |= QRect(5, 5, 10, 10);
                                        p |= QRect(20, 5, 2, 2); }, QRect(5, 5, 17, 10), true},
            {"nothing named", [] { MakeQPainter p("test"); }, QRect(0, 0, 100, 100), true},
            {"clipped", [] { MakeQPainter p("test"); p |= QRect(0, 0, 30, 30); p &= QRect(10, 10, 100, 100); },
             QRect(10, 10, 20, 20), true},
            {"widget coordinates", [&] { SetOrigin(100, 100); SetCPixel(101, 102, &red); SetOrigin(0, 0); },
             QRect(1, 2, 1, 1), true},
            {"FrameRect", [&] { FrameRect(&r); }, q, false},
            {"PaintRect", [&] { PaintRect(&r); }, q, false},
            {"FillRect", [&] { FillRect(&r, GetQDGlobalsGray(nullptr)); }, q, false},
            {"PaintOval", [&] { PaintOval(&r); }, q, false},
            {"FrameArc", [&] { FrameArc(&r, 0, 90); }, q, false},
            {"PaintRoundRect", [&] { PaintRoundRect(&r, 6, 6); }, q, false},
            {"LineTo", [&] { MoveTo(5, 70); LineTo(50, 60); }, QRect(5, 60, 46, 11), false},
            {"PaintRgn", [&] { PaintRgn(region.get()); }, rq, false},
            {"FrameRgn", [&] { FrameRgn(region.get()); }, rq, false},
            {"InvertRgn", [&] { InvertRgn(region.get()); }, rq, false},
            {"FramePoly", [&] { FramePoly(poly); }, pq, false},
            {"PaintPoly", [&] { PaintPoly(poly); }, pq, false},
        };
        for (const auto& [name, draw, expected, exact] : cases) {
            gDirty.clear();
            draw();
            QRect dirty;
            for (const QRect& d : gDirty)
                dirty |= d;
            if (exact)
                QVERIFY2(gDirty == QList<QRect>{expected}, name);
            else
                QVERIFY2(dirty.contains(expected) && dirty.width() < 90 && dirty.height() < 90, name);
        }
        KillPoly(poly);
        // A window port is not disposed through the offscreen calls.
        DisposePort(port);
        QVERIFY(IsValidPort(port));
        delete port;
        QCOMPARE(GetCurrentPort(), nullptr);
        // Offscreen worlds have no window to mark.
        gDirty.clear();
        World world(10);
        {
            MakeQPainter p("test");
            p |= QRect(1, 1, 2, 2);
        }
        SetCPixel(1, 1, &red);
        QVERIFY(gDirty.isEmpty());
    }

    void disposingTheCurrentPortPicksTheFrontWindow()
    {
        HookScope hooks;
        QtGrafPort* windowPort = newWindowPort(10, 10);
        gFrontPort = windowPort;
        {
            World world(4);
        }
        QCOMPARE(GetCurrentPort(), windowPort);
        gFrontPort = nullptr;
        delete windowPort;
        QCOMPARE(GetCurrentPort(), nullptr);
    }

    void cpixelRoundTrip()
    {
        World world(4);
        const RGBColor in(0x1234, 0x8000, 0xFEDC);
        SetCPixel(2, 3, &in);
        RGBColor out;
        GetCPixel(2, 3, &out);
        // Stored as opaque 8-bit ARGB with the library's channel scale.
        const auto scaled = [](int c) { return Private::channel8To16(Private::channel16To8(c)); };
        QCOMPARE(QList<int>({out.red, out.green, out.blue}), QList<int>({scaled(0x1234), scaled(0x8000), scaled(0xFEDC)}));
        QCOMPARE(qAlpha(world.pixel(2, 3)), 255);
        // Exactly that one pixel changed.
        QImage expected(4, 4, QImage::Format_ARGB32_Premultiplied);
        expected.fill(Qt::white);
        expected.setPixel(2, 3, in);
        QCOMPARE(world.image(), expected);
        // Outside the port: no write, black read, no crash.
        SetCPixel(-1, 0, &in);
        SetCPixel(4, 4, &in);
        GetCPixel(100, 100, &out);
        QCOMPARE(quint32(out), 0xFF000000u);
        GetCPixel(0, 0, nullptr);
        SetCPixel(0, 0, nullptr);
    }

    void scrollRectMovesRows()
    {
        World world(100);
        // Row y gets a colour of its own.
        for (int y = 0; y < 100; ++y)
            for (int x = 0; x < 100; ++x)
                world.image().setPixel(x, y, qRgb(y, 255 - y, x));
        const RGBColor back(0, 0, 65535);
        RGBBackColor(&back);
        const Rect r = makeRect(0, 0, 100, 100);
        const Rgn rgn = rgnOf();
        QRegion& update = *rgn;
        ScrollRect(&r, 0, 10, rgn.get());
        QCOMPARE(update, QRegion(QRect(0, 0, 100, 10)));
        for (int y = 10; y < 100; ++y)
            for (int x = 0; x < 100; x += 33)
                QCOMPARE(world.pixel(x, y), qRgb(y - 10, 255 - (y - 10), x));
        for (int y = 0; y < 10; ++y)
            QCOMPARE(world.pixel(50, y), qRgb(0, 0, 255));

        // Left by 5 inside a sub-rectangle: columns outside it stay.
        const QRgb outside = world.pixel(80, 50);
        const Rect sub = makeRect(10, 20, 60, 70);
        ScrollRect(&sub, -5, 0, rgn.get());
        QCOMPARE(update, QRegion(QRect(55, 20, 5, 50)));
        QCOMPARE(world.pixel(10, 30), qRgb(20, 235, 15));
        QCOMPARE(world.pixel(54, 30), qRgb(20, 235, 59));
        QCOMPARE(world.pixel(55, 30), qRgb(0, 0, 255));
        QCOMPARE(world.pixel(80, 50), outside);
        QCOMPARE(world.pixel(9, 30), qRgb(20, 235, 9));

        // No offset: empty update region, pixels untouched.
        update = QRegion(0, 0, 5, 5);
        ScrollRect(&sub, 0, 0, rgn.get());
        QVERIFY(update.isEmpty());
        // Scrolling by more than the rectangle erases all of it.
        ScrollRect(&sub, 0, 200, rgn.get());
        QCOMPARE(update, QRegion(QRect(10, 20, 50, 50)));
        QCOMPARE(world.pixel(30, 60), qRgb(0, 0, 255));
    }

    void scrollRectBadInput()
    {
        VelmarTest::ScriptedAutomationListener answers;
        World world(10);
        const Rgn rgn = rgnOf();
        QRegion& update = *rgn;
        ScrollRect(nullptr, 1, 1, rgn.get());
        const Rect r = makeRect(0, 0, 10, 10);
        ScrollRect(&r, 1, 1, nullptr);
        QCOMPARE(answers.questions().size(), 2);
        QVERIFY(answers.questions().at(0).text.contains(QStringLiteral("NULL != r")));
        QVERIFY(answers.questions().at(1).text.contains(QStringLiteral("NULL != updateRgn")));
        SetPort(nullptr);
        update = QRegion(0, 0, 3, 3);
        ScrollRect(&r, 1, 1, rgn.get());
        QVERIFY(update.isEmpty());
    }

    void clipAndVisibleRegions()
    {
        World world(20);
        const Rgn rgn = rgnOf();
        QCOMPARE(*GetPortVisibleRegion(world, rgn.get()), QRegion(QRect(0, 0, 20, 20)));
        const QRegion clip(QRect(5, 5, 5, 5));
        SetPortClipRegion(world, rgnOf(clip).get());
        QCOMPARE(world->clipInForce, UInt8(1));
        QPainter* p = world.painter();
        p->fillRect(QRect(0, 0, 20, 20), QColor(Qt::red));
        QCOMPARE(world.pixel(4, 4), qRgb(255, 255, 255));
        QCOMPARE(world.pixel(5, 5), qRgb(255, 0, 0));
        QCOMPARE(world.pixel(10, 10), qRgb(255, 255, 255));
        {
            SavePortVisibleRegion saved;
            QCOMPARE(*saved.clip(), clip);
            SetPortVisibleRegion(world, rgnOf(QRegion(0, 0, 6, 6)).get());
            p->fillRect(QRect(0, 0, 20, 20), QColor(Qt::blue));
            QCOMPARE(world.pixel(5, 5), qRgb(0, 0, 255));
            QCOMPARE(world.pixel(6, 6), qRgb(255, 0, 0));
        }
        // Restored: the whole clip square is reachable again.
        QCOMPARE(world->visibleRegion, QRegion(QRect(0, 0, 20, 20)));
        p->fillRect(QRect(0, 0, 20, 20), QColor(Qt::green));
        QCOMPARE(world.pixel(9, 9), qRgb(0, 255, 0));
        QCOMPARE(world.pixel(4, 4), qRgb(255, 255, 255));
        SetPortVisibleRegion(nullptr, rgn.get());
        SetPortVisibleRegion(world, nullptr);
        QCOMPARE(*GetPortClipRegion(world, rgn.get()), clip);
    }
};

VELMAR_TEST_MAIN(TestPort)
#include "tst_port.moc"
