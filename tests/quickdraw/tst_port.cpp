// The current port, the painter cap, dirty marking, port state, pixels and scrolling.
#include <Velmar/Diagnostics.h>
#include <Velmar/QtGrafPort.h>
#include <Velmar/QuickDraw.h>

#include "TestSupport.h"
#include "foundation/Conversions.h"
#include "quickdraw/GrafPortPrivate.h"
#include "quickdraw/PortPainter.h"

#include <QImage>

#include <memory>
#include <vector>

using namespace Velmar;
using Velmar::Private::makeRect;

namespace {

GrafPtr newWorld(int width, int height)
{
    const Rect r = makeRect(0, 0, width, height);
    GrafPtr world = nullptr;
    NewGWorld(&world, 32, &r, nullptr, nullptr, 0);
    return world;
}

// A window port without a real window: the hooks below stand in for the window layer.
AQtWindow* const kFakeWindow = reinterpret_cast<AQtWindow*>(0x1000);
QList<QRect> gDirty;
QtGrafPort* gFrontPort = nullptr;

void recordDirty(AQtWindow*, const QRect& r)
{
    gDirty.append(r);
}

QtGrafPort* frontPort(AQtWindow*)
{
    return gFrontPort;
}

struct HookScope {
    HookScope()
    {
        Private::PortWindowHooks hooks;
        hooks.markDirty = &recordDirty;
        hooks.frontVisiblePortExcept = &frontPort;
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

QRgb pixelAt(GrafPtr port, int x, int y)
{
    return port->image()->pixel(x, y);
}

} // namespace

class TestPort : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void init()
    {
        SetLogCategory(kLogQuickDraw | kLogGrafPort, true);
        SetPort(nullptr);
    }

    void currentPort()
    {
        GrafPtr a = newWorld(4, 4);
        GrafPtr b = newWorld(4, 4);
        SetPort(a);
        GrafPtr got = nullptr;
        GetPort(&got);
        QCOMPARE(got, a);
        SetGWorld(b, reinterpret_cast<void*>(0x1234)); // the device is ignored
        void* device = reinterpret_cast<void*>(0x1);
        GetGWorld(&got, &device);
        QCOMPARE(got, b);
        QCOMPARE(device, nullptr);
        GetGWorld(&got, nullptr);
        GetPort(nullptr);
        QCOMPARE(GetCurrentPort(), b);
        DisposeGWorld(a);
        DisposeGWorld(b);
        QCOMPARE(GetCurrentPort(), nullptr);
    }

    void setPortRefusesInvalidPorts()
    {
        VelmarTest::LogCapture log;
        GrafPtr live = newWorld(4, 4);
        GrafPtr dead = newWorld(4, 4);
        DisposeGWorld(dead);
        SetPort(live);
        SetPort(dead);
        QVERIFY(log.contains(QStringLiteral("Velmar::SetPort(")));
        QVERIFY(log.contains(QStringLiteral(") reset invalid GrafPort!")));
        QCOMPARE(GetCurrentPort(), nullptr);
        QVERIFY(!IsValidPort(dead));
        QVERIFY(!IsValidPort(nullptr));
        // Memory that merely looks like a port is not one, and is not read.
        alignas(QtGrafPort) unsigned char fake[sizeof(QtGrafPort)] = {};
        QVERIFY(!IsValidPort(reinterpret_cast<GrafPtr>(fake)));
        SetPort(live);
        SetPort(reinterpret_cast<GrafPtr>(fake));
        QCOMPARE(GetCurrentPort(), nullptr);
        QVERIFY(IsValidPort(live));
        DisposeGWorld(live);
    }

    void painterCap()
    {
        std::vector<GrafPtr> ports;
        for (int i = 0; i < 51; ++i) {
            ports.push_back(newWorld(2, 2));
            SetPort(ports.back());
            QVERIFY(Private::portPainter(ports.back(), "test"));
        }
        QCOMPARE(Private::activePainterCount(), 50);
        QVERIFY(!ports.front()->isActive());
        QVERIFY(!Private::isPainterListed(ports.front()));
        for (int i = 1; i < 51; ++i)
            QVERIFY(ports[i]->isActive());
        // Drawing into the first again restarts it and ends the next oldest.
        QVERIFY(Private::portPainter(ports.front(), "test"));
        QVERIFY(!ports[1]->isActive());
        QCOMPARE(Private::activePainterCount(), 50);
        for (GrafPtr p : ports)
            DisposeGWorld(p);
        QCOMPARE(Private::activePainterCount(), 0);
    }

    void painterStateSurvivesEndPaint()
    {
        GrafPtr world = newWorld(8, 8);
        SetPort(world);
        QVERIFY(Private::portPainter(world, "test"));
        const RGBColor green(0, 65535, 0);
        RGBForeColor(&green);
        PenSize(3, 3);
        PenMode(patXor);
        SetOrigin(2, 2);
        world->EndPaint();
        RGBColor c;
        GetForeColor(&c);
        QCOMPARE(quint32(c), 0xFF00FF00u);
        QCOMPARE(world->currentPen().width(), 3);
        QVERIFY(Private::portPainter(world, "test"));
        QCOMPARE(world->painter->pen().width(), 3);
        QCOMPARE(world->painter->compositionMode(), QPainter::RasterOp_NotSourceXorDestination);
        QCOMPARE(world->painter->transform(), QTransform::fromTranslate(-2, -2));
        DisposeGWorld(world);
    }

    void noPortWarnings()
    {
        VelmarTest::LogCapture log;
        QVERIFY(!Private::portPainter(nullptr, "FrameRect"));
        QVERIFY(log.contains(QStringLiteral("warning: FrameRect: Can't get current port!")));
        {
            MakeQPainter p("PaintOval");
            QVERIFY(!p);
        }
        QVERIFY(log.contains(QStringLiteral("warning: PaintOval: Can't get current port!")));
        RGBColor c(7, 7, 7);
        GetBackColor(&c);
        GetForeColor(&c);
        RGBBackColor(&c);
        RGBForeColor(&c);
        OpColor(&c);
        SetCPixel(0, 0, &c);
        QCOMPARE(c.red, (unsigned short)7);
        QVERIFY(!GetPortPenLocation(nullptr, nullptr));
        QCOMPARE(GetPortPenMode(nullptr), SInt16(0));
        for (const char* text : {"warning: GetBackColor: Can't get current port !",
                                 "warning: GetForeColor: Can't get current port!",
                                 "warning: RGBBackColor: Can't get current port!",
                                 "warning: RGBForeColor: Can't get current port!",
                                 "OpColor: Can't get port", "warning: SetCPixel: cannot get Qt port",
                                 "warning: GetPortPenLocation: cannot get Qt port",
                                 "warning: GetPortPenMode: cannot get Qt port"})
            QVERIFY2(log.contains(QString::fromLatin1(text)), text);
        // A disabled category writes nothing.
        SetLogCategory(kLogQuickDraw, false);
        log.clear();
        RGBForeColor(&c);
        QVERIFY(log.lines().isEmpty());
    }

    void dirtyMarkingReachesTheWindow()
    {
        HookScope hooks;
        QtGrafPort* port = newWindowPort(50, 40);
        QCOMPARE(port->window, kFakeWindow);
        QCOMPARE(port->image()->pixel(0, 0), qRgb(255, 255, 255)); // content colour
        SetPort(port);
        {
            MakeQPainter p("test");
            QVERIFY(!!p);
            p |= QRect(5, 5, 10, 10);
            p |= QRect(20, 5, 2, 2);
        }
        QCOMPARE(gDirty, QList<QRect>{QRect(5, 5, 17, 10)});
        gDirty.clear();
        {
            MakeQPainter p("test"); // nothing named: the whole port
        }
        QCOMPARE(gDirty, QList<QRect>{QRect(0, 0, 50, 40)});
        gDirty.clear();
        {
            MakeQPainter p("test");
            p |= QRect(0, 0, 30, 30);
            p &= QRect(10, 10, 100, 100);
        }
        QCOMPARE(gDirty, QList<QRect>{QRect(10, 10, 20, 20)});
        // Dirty rectangles are reported in widget coordinates.
        gDirty.clear();
        SetOrigin(100, 100);
        const RGBColor red(65535, 0, 0);
        SetCPixel(101, 102, &red);
        QCOMPARE(gDirty, QList<QRect>{QRect(1, 2, 1, 1)});
        // A window port is not disposed through the offscreen calls.
        DisposePort(port);
        QVERIFY(IsValidPort(port));
        delete port;
        QCOMPARE(GetCurrentPort(), nullptr);
    }

    void disposingTheCurrentPortPicksTheFrontWindow()
    {
        HookScope hooks;
        QtGrafPort* windowPort = newWindowPort(10, 10);
        gFrontPort = windowPort;
        GrafPtr world = newWorld(4, 4);
        SetPort(world);
        DisposeGWorld(world);
        QCOMPARE(GetCurrentPort(), windowPort);
        gFrontPort = nullptr;
        delete windowPort;
        QCOMPARE(GetCurrentPort(), nullptr);
    }

    void offscreenPortsMarkNothing()
    {
        HookScope hooks;
        GrafPtr world = newWorld(10, 10);
        SetPort(world);
        {
            MakeQPainter p("test");
            p |= QRect(1, 1, 2, 2);
        }
        const RGBColor red(65535, 0, 0);
        SetCPixel(1, 1, &red);
        QVERIFY(gDirty.isEmpty());
        DisposeGWorld(world);
    }

    void cpixelRoundTrip_data()
    {
        QTest::addColumn<int>("r");
        QTest::addColumn<int>("g");
        QTest::addColumn<int>("b");
        QTest::newRow("black") << 0 << 0 << 0;
        QTest::newRow("white") << 65535 << 65535 << 65535;
        QTest::newRow("mixed") << 0x1234 << 0x8000 << 0xFEDC;
    }
    void cpixelRoundTrip()
    {
        QFETCH(int, r);
        QFETCH(int, g);
        QFETCH(int, b);
        GrafPtr world = newWorld(4, 4);
        SetPort(world);
        const RGBColor in(r, g, b);
        SetCPixel(2, 3, &in);
        RGBColor out;
        GetCPixel(2, 3, &out);
        // Stored as opaque 8-bit ARGB with the library's channel scale.
        using Private::channel16To8;
        using Private::channel8To16;
        QCOMPARE(out.red, channel8To16(channel16To8(r)));
        QCOMPARE(out.green, channel8To16(channel16To8(g)));
        QCOMPARE(out.blue, channel8To16(channel16To8(b)));
        QCOMPARE(qAlpha(pixelAt(world, 2, 3)), 255);
        // Exactly that one pixel changed.
        int changed = 0;
        for (int y = 0; y < 4; ++y)
            for (int x = 0; x < 4; ++x)
                changed += pixelAt(world, x, y) != qRgb(255, 255, 255) ? 1 : 0;
        QCOMPARE(changed, (r == 65535 && g == 65535 && b == 65535) ? 0 : 1);
        // Outside the port: no write, black read, no crash.
        SetCPixel(-1, 0, &in);
        SetCPixel(4, 4, &in);
        GetCPixel(100, 100, &out);
        QCOMPARE(quint32(out), 0xFF000000u);
        GetCPixel(0, 0, nullptr);
        SetCPixel(0, 0, nullptr);
        DisposeGWorld(world);
    }

    void scrollRectMovesRows()
    {
        GrafPtr world = newWorld(100, 100);
        SetPort(world);
        // Row y gets a colour of its own.
        for (int y = 0; y < 100; ++y)
            for (int x = 0; x < 100; ++x)
                world->image()->setPixel(x, y, qRgb(y, 255 - y, x));
        const RGBColor back(0, 0, 65535);
        RGBBackColor(&back);
        const Rect r = makeRect(0, 0, 100, 100);
        std::unique_ptr<QRegion> update(new QRegion);
        ScrollRect(&r, 0, 10, update.get());
        QCOMPARE(*update, QRegion(QRect(0, 0, 100, 10)));
        for (int y = 10; y < 100; ++y)
            for (int x = 0; x < 100; x += 33)
                QCOMPARE(pixelAt(world, x, y), qRgb(y - 10, 255 - (y - 10), x));
        for (int y = 0; y < 10; ++y)
            QCOMPARE(pixelAt(world, 50, y), qRgb(0, 0, 255));

        // Left by 5 inside a sub-rectangle: columns outside it stay.
        const QRgb outside = pixelAt(world, 80, 50);
        const Rect sub = makeRect(10, 20, 60, 70);
        ScrollRect(&sub, -5, 0, update.get());
        QCOMPARE(*update, QRegion(QRect(55, 20, 5, 50)));
        QCOMPARE(pixelAt(world, 10, 30), qRgb(20, 235, 15));
        QCOMPARE(pixelAt(world, 54, 30), qRgb(20, 235, 59));
        QCOMPARE(pixelAt(world, 55, 30), qRgb(0, 0, 255));
        QCOMPARE(pixelAt(world, 80, 50), outside);
        QCOMPARE(pixelAt(world, 9, 30), qRgb(20, 235, 9));

        // No offset: empty update region, pixels untouched.
        *update = QRegion(0, 0, 5, 5);
        ScrollRect(&sub, 0, 0, update.get());
        QVERIFY(update->isEmpty());
        // Scrolling by more than the rectangle erases all of it.
        ScrollRect(&sub, 0, 200, update.get());
        QCOMPARE(*update, QRegion(QRect(10, 20, 50, 50)));
        QCOMPARE(pixelAt(world, 30, 60), qRgb(0, 0, 255));
        DisposeGWorld(world);
    }

    void scrollRectBadInput()
    {
        VelmarTest::ScriptedAutomationListener answers;
        GrafPtr world = newWorld(10, 10);
        SetPort(world);
        QRegion update;
        ScrollRect(nullptr, 1, 1, &update);
        const Rect r = makeRect(0, 0, 10, 10);
        ScrollRect(&r, 1, 1, nullptr);
        QCOMPARE(answers.questions().size(), 2);
        QVERIFY(answers.questions().at(0).text.contains(QStringLiteral("NULL != r")));
        QVERIFY(answers.questions().at(1).text.contains(QStringLiteral("NULL != updateRgn")));
        SetPort(nullptr);
        update = QRegion(0, 0, 3, 3);
        ScrollRect(&r, 1, 1, &update);
        QVERIFY(update.isEmpty());
        DisposeGWorld(world);
    }

    void colourState()
    {
        GrafPtr world = newWorld(4, 4);
        SetPort(world);
        RGBColor c;
        GetPortOpColor(world, &c);
        QCOMPARE(quint32(c), 0xFF000000u);
        const RGBColor op(0x1111, 0x2222, 0x3333);
        SetPortOpColor(world, &op);
        GetPortOpColor(world, &c);
        QCOMPARE(c.red >> 8, 0x11);
        const RGBColor back(0, 65535, 0);
        RGBBackColor(&back);
        GetPortBackColor(world, &c);
        QCOMPARE(quint32(c), 0xFF00FF00u);
        const RGBColor hilite(65535, 0, 65535);
        HiliteColor(&hilite);
        GetPortHiliteColor(world, &c);
        QCOMPARE(quint32(c), 0xFFFF00FFu);
        // The foreground colour follows the pen, whether or not a painter is active.
        const RGBColor fore(65535, 0, 0);
        RGBForeColor(&fore);
        GetPortForeColor(world, &c);
        QCOMPARE(quint32(c), 0xFFFF0000u);
        QVERIFY(Private::portPainter(world, "test"));
        const RGBColor fore2(0, 0, 65535);
        RGBForeColor(&fore2);
        QCOMPARE(world->painter->pen().color(), QColor(0, 0, 255));
        GetForeColor(&c);
        QCOMPARE(quint32(c), 0xFF0000FFu);
        Point pt;
        world->penX = 3;
        world->penY = 2;
        QCOMPARE(GetPortPenLocation(world, &pt), &pt);
        QCOMPARE(pt.h, SInt16(3));
        QCOMPARE(pt.v, SInt16(2));
        QCOMPARE(GetPortPenMode(world), SInt16(patCopy));
        DisposeGWorld(world);
    }

    void clipAndVisibleRegions()
    {
        GrafPtr world = newWorld(20, 20);
        SetPort(world);
        QRegion rgn;
        QCOMPARE(*GetPortVisibleRegion(world, &rgn), QRegion(QRect(0, 0, 20, 20)));
        QRegion clip(QRect(5, 5, 5, 5));
        SetPortClipRegion(world, &clip);
        QCOMPARE(world->clipInForce, UInt8(1));
        QPainter* p = Private::portPainter(world, "test");
        p->fillRect(QRect(0, 0, 20, 20), QColor(Qt::red));
        QCOMPARE(pixelAt(world, 4, 4), qRgb(255, 255, 255));
        QCOMPARE(pixelAt(world, 5, 5), qRgb(255, 0, 0));
        QCOMPARE(pixelAt(world, 10, 10), qRgb(255, 255, 255));
        {
            SavePortVisibleRegion saved;
            QCOMPARE(*saved.clip(), clip);
            QRegion visible(QRect(0, 0, 6, 6));
            SetPortVisibleRegion(world, &visible);
            p->fillRect(QRect(0, 0, 20, 20), QColor(Qt::blue));
            QCOMPARE(pixelAt(world, 5, 5), qRgb(0, 0, 255));
            QCOMPARE(pixelAt(world, 6, 6), qRgb(255, 0, 0));
        }
        // Restored: the whole clip square is reachable again.
        QCOMPARE(world->visibleRegion, QRegion(QRect(0, 0, 20, 20)));
        p->fillRect(QRect(0, 0, 20, 20), QColor(Qt::green));
        QCOMPARE(pixelAt(world, 9, 9), qRgb(0, 255, 0));
        QCOMPARE(pixelAt(world, 4, 4), qRgb(255, 255, 255));
        SetPortVisibleRegion(nullptr, &rgn);
        SetPortVisibleRegion(world, nullptr);
        QCOMPARE(*GetPortClipRegion(world, &rgn), clip);
        DisposeGWorld(world);
    }
};

VELMAR_TEST_MAIN(TestPort)
#include "tst_port.moc"
