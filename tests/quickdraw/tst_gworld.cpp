// Offscreen worlds: creation rules, resizing, disposal, bounds and origin, bad input.
#include <Velmar/Diagnostics.h>
#include <Velmar/QtGrafPort.h>
#include <Velmar/QuickDraw.h>

#include "TestSupport.h"
#include "foundation/Conversions.h"
#include "quickdraw/GrafPortPrivate.h"
#include "quickdraw/PortPainter.h"

#include <QImage>

using namespace Velmar;
using Velmar::Private::makeRect;

namespace {

QString rectText(const Rect& r)
{
    return QStringLiteral("%1,%2,%3,%4").arg(r.top).arg(r.left).arg(r.bottom).arg(r.right);
}

QString boundsOf(GrafPtr port)
{
    Rect r;
    GetPortBounds(port, &r);
    return rectText(r);
}

} // namespace

class TestGWorld : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void init()
    {
        SetLogCategory(kLogQuickDraw | kLogGrafPort, true);
        SetPort(nullptr);
    }

    void newGWorldBounds_data()
    {
        QTest::addColumn<int>("depth");
        QTest::addColumn<int>("top");
        QTest::addColumn<int>("left");
        QTest::addColumn<int>("bottom");
        QTest::addColumn<int>("right");
        QTest::addColumn<QString>("expected");
        QTest::addColumn<QSize>("imageSize");
        QTest::newRow("zero size widened") << 32 << 10 << 10 << 10 << 10 << "10,10,11,11" << QSize(1, 1);
        QTest::newRow("depth 0 moves to origin") << 0 << 10 << 20 << 30 << 60 << "0,0,20,40" << QSize(40, 20);
        QTest::newRow("depth 32 keeps position") << 32 << 10 << 20 << 30 << 60 << "10,20,30,60" << QSize(40, 20);
        QTest::newRow("negative size forced to one") << 32 << 10 << 10 << 5 << 5 << "10,10,11,11" << QSize(1, 1);
        QTest::newRow("zero width only") << 32 << 0 << 0 << 10 << 0 << "0,0,10,1" << QSize(1, 10);
    }
    void newGWorldBounds()
    {
        QFETCH(int, depth);
        QFETCH(int, top);
        QFETCH(int, left);
        QFETCH(int, bottom);
        QFETCH(int, right);
        QFETCH(QString, expected);
        QFETCH(QSize, imageSize);
        const Rect r = makeRect(left, top, right, bottom);
        GrafPtr world = nullptr;
        QCOMPARE(NewGWorld(&world, SInt16(depth), &r, nullptr, nullptr, 0), SInt16(0));
        QVERIFY(IsValidPort(world));
        QCOMPARE(boundsOf(world), expected);
        QVERIFY(world->image());
        QCOMPARE(world->image()->size(), imageSize);
        QCOMPARE(world->image()->format(), QImage::Format_ARGB32_Premultiplied);
        QCOMPARE(GetPortPixMap(world)->pixelDepth(), SInt16(depth ? depth : 6));
        DisposeGWorld(world);
        QVERIFY(!IsValidPort(world));
    }

    void freshWorldState()
    {
        const Rect r = makeRect(5, 7, 25, 17);
        GrafPtr world = nullptr;
        NewGWorld(&world, 32, &r, nullptr, nullptr, 0);
        QCOMPARE(world->window, nullptr);
        QCOMPARE(world->opColor, QColor(Qt::black));
        QCOMPARE(world->backColor, QColor(Qt::white));
        QCOMPARE(world->penMode, SInt16(patCopy));
        QCOMPARE(world->penX, 5);
        QCOMPARE(world->penY, 7);
        QCOMPARE(world->magic, 0x51744750u);
        QCOMPARE(world->clipRegion, QRegion(QRect(-32767, -32767, 65534, 65534)));
        QCOMPARE(world->clipRegion.boundingRect().right(), 32766);
        QCOMPARE(world->visibleRegion, QRegion(QRect(5, 7, 20, 10)));
        QCOMPARE(world->appFontFlag, UInt8(1));
        QCOMPARE(world->clipInForce, UInt8(0));
        // Cleared with the back colour.
        QCOMPARE(world->image()->pixel(0, 0), qRgb(255, 255, 255));
        QCOMPARE(world->image()->pixel(19, 9), qRgb(255, 255, 255));
        DisposeGWorld(world);
    }

    void nullBoundsAndNullOut()
    {
        GrafPtr world = nullptr;
        NewGWorld(&world, 0, nullptr, nullptr, nullptr, 0);
        QCOMPARE(boundsOf(world), QStringLiteral("0,0,1,1"));
        DisposeGWorld(world);
        // No place to put the world: nothing leaks into the port list, nothing crashes.
        const auto before = Private::livePorts().size();
        QCOMPARE(NewGWorld(nullptr, 0, nullptr, nullptr, nullptr, 0), SInt16(0));
        QCOMPARE(Private::livePorts().size(), before);
    }

    void hugeWorldIsRefusedNotFatal()
    {
        VelmarTest::LogCapture log;
        const Rect r = makeRect(0, 0, 32767, 32767);
        GrafPtr world = nullptr;
        QCOMPARE(NewGWorld(&world, 32, &r, nullptr, nullptr, 0), SInt16(0));
        QVERIFY(IsValidPort(world));
        QVERIFY(log.contains(QStringLiteral("too large")));
        QCOMPARE(boundsOf(world), QStringLiteral("0,0,32767,32767"));
        QCOMPARE(world->image(), nullptr);
        // Drawing and reading pixels are harmless no-ops.
        SetPort(world);
        {
            MakeQPainter painter("PaintRect");
            QVERIFY(!painter);
        }
        RGBColor c(1, 2, 3);
        const RGBColor red(65535, 0, 0);
        SetCPixel(10, 10, &red);
        GetCPixel(10, 10, &c);
        QCOMPARE(c.red, (unsigned short)0);
        RGBColor pen(0, 0, 65535);
        RGBForeColor(&pen);
        PenSize(3, 3);
        // Shrinking it to something sane gives it pixels.
        const Rect small = makeRect(0, 0, 64, 32);
        GrafPtr handle = world;
        QCOMPARE(UpdateGWorld(&handle, 32, &small, nullptr, nullptr, 0), UInt32(reallocPix));
        QVERIFY(world->image());
        QCOMPARE(world->image()->size(), QSize(64, 32));
        DisposeGWorld(world);
        QCOMPARE(GetCurrentPort(), nullptr);
    }

    void updateGWorldKeepsTopLeftPixels()
    {
        const Rect r = makeRect(0, 0, 20, 20);
        GrafPtr world = nullptr;
        NewGWorld(&world, 32, &r, nullptr, nullptr, 0);
        SetPort(world);
        const RGBColor red(65535, 0, 0);
        const RGBColor blue(0, 0, 65535);
        SetCPixel(0, 0, &red);
        SetCPixel(9, 9, &blue);
        SetCPixel(15, 15, &blue); // cut off by the shrink

        GrafPtr handle = world;
        QCOMPARE(UpdateGWorld(&handle, 32, &r, nullptr, nullptr, 0), UInt32(0));
        const Rect wider = makeRect(0, 0, 30, 10);
        QCOMPARE(UpdateGWorld(&handle, 32, &wider, nullptr, nullptr, 0), UInt32(reallocPix));
        QCOMPARE(boundsOf(world), QStringLiteral("0,0,10,30"));
        QCOMPARE(world->image()->size(), QSize(30, 10));
        RGBColor c;
        GetCPixel(0, 0, &c);
        QCOMPARE(quint32(c), quint32(red));
        GetCPixel(9, 9, &c);
        QCOMPARE(quint32(c), quint32(blue));
        // The new area is cleared with the back colour and is drawable (not clipped away).
        GetCPixel(25, 5, &c);
        QCOMPARE(quint32(c), 0xFFFFFFFFu);
        SetCPixel(25, 5, &red);
        QPainter* p = Private::portPainter(world, "test");
        QVERIFY(p);
        p->fillRect(QRect(20, 0, 10, 10), Private::resolvedFillBrush(world));
        GetCPixel(29, 9, &c);
        QCOMPARE(quint32(c), 0xFF000000u);
        DisposeGWorld(world);
    }

    void setPortBoundsBadSizes()
    {
        VelmarTest::LogCapture log;
        GrafPtr port = CreateNewPort();
        QCOMPARE(boundsOf(port), QStringLiteral("0,0,1,1"));
        const Rect zeroWidth = makeRect(0, 0, 0, 10);
        SetPortBounds(port, &zeroWidth);
        QVERIFY(log.contains(QStringLiteral("Trying to SetBounds with negative width, port=")));
        QCOMPARE(port->image()->size(), QSize(1, 10));
        const Rect negativeHeight = makeRect(0, 10, 5, 0);
        SetPortBounds(port, &negativeHeight);
        QVERIFY(log.contains(QStringLiteral("Trying to SetBounds with negative height, port=")));
        QCOMPARE(port->image()->size(), QSize(5, 1));
        SetPortBounds(port, nullptr); // (0, 0, -1, -1): one pixel
        QCOMPARE(port->image()->size(), QSize(1, 1));
        SetPortBounds(nullptr, &zeroWidth); // ignored
        DisposePort(port);
        QVERIFY(!IsValidPort(port));
    }

    void portBoundsNull()
    {
        Rect r = makeRect(1, 2, 3, 4);
        QCOMPARE(GetPortBounds(nullptr, &r), &r);
        QCOMPARE(rectText(r), QStringLiteral("0,0,0,0"));
        QCOMPARE(GetPortBounds(nullptr, nullptr), nullptr);
    }

    void portSizeAndOrigin()
    {
        VelmarTest::LogCapture log;
        PortSize(10, 10);
        QVERIFY(log.contains(QStringLiteral("PortSize: current port is NULL")));
        SetOrigin(1, 1);
        QVERIFY(log.contains(QStringLiteral("SetOrigin: currentGrafPort = NULL")));

        const Rect r = makeRect(0, 0, 40, 30);
        GrafPtr world = nullptr;
        NewGWorld(&world, 32, &r, nullptr, nullptr, 0);
        SetPort(world);
        SetOrigin(100, 200);
        QCOMPARE(boundsOf(world), QStringLiteral("200,100,230,140"));
        // Local (100, 200) is the image's top-left pixel.
        const RGBColor red(65535, 0, 0);
        SetCPixel(100, 200, &red);
        QCOMPARE(world->image()->pixel(0, 0), qRgb(255, 0, 0));
        SetCPixel(139, 229, &red);
        QCOMPARE(world->image()->pixel(39, 29), qRgb(255, 0, 0));
        // Drawing through the painter uses the same mapping, also once it is active.
        QPainter* p = Private::portPainter(world, "test");
        QVERIFY(p);
        p->fillRect(QRect(101, 200, 1, 1), QColor(0, 0, 255));
        QCOMPARE(world->image()->pixel(1, 0), qRgb(0, 0, 255));
        SetOrigin(0, 0);
        p->fillRect(QRect(2, 0, 1, 1), QColor(0, 255, 0));
        QCOMPARE(world->image()->pixel(2, 0), qRgb(0, 255, 0));
        // PortSize keeps the origin.
        SetOrigin(5, 6);
        PortSize(20, 10);
        QCOMPARE(boundsOf(world), QStringLiteral("6,5,16,25"));
        QCOMPARE(world->image()->size(), QSize(20, 10));
        DisposeGWorld(world);
    }

    void disposeBadWorlds()
    {
        VelmarTest::ScriptedAutomationListener answers;
        DisposeGWorld(nullptr);
        QCOMPARE(answers.questions().size(), 1);
        QVERIFY(answers.questions().first().text.contains(
            QStringLiteral("offscreenGWorld != NULL && offscreenGWorld->window == NULL")));
        GrafPtr world = nullptr;
        NewGWorld(&world, 0, nullptr, nullptr, nullptr, 0);
        DisposeGWorld(world);
        DisposeGWorld(world); // stale: refused, no double free
        DisposePort(world);
        DisposePort(nullptr);
        QVERIFY(!GetPortPixMap(nullptr));
        QVERIFY(!GetPortBitMapForCopyBits(nullptr).image());
        QVERIFY(answers.questions().last().text.contains(QStringLiteral("port != NULL")));
    }

    void paintDeviceWorld()
    {
        QImage device(16, 16, QImage::Format_ARGB32_Premultiplied);
        device.fill(Qt::white);
        const Rect r = makeRect(0, 0, 16, 16);
        GrafPtr world = nullptr;
        NewGWorldForPaintDevice(&world, 0, &r, nullptr, nullptr, 0, &device);
        QCOMPARE(GetGWorldPaintDevice(&world), &device);
        QCOMPARE(GetGWorldPaintDevice(nullptr), nullptr);
        {
            MakeQPainter p(world, "test");
            QVERIFY(!!p);
            p->fillRect(QRect(3, 3, 1, 1), QColor(Qt::red));
        }
        world->EndPaint();
        QCOMPARE(device.pixel(3, 3), qRgb(255, 0, 0));
        QCOMPARE(world->image()->pixel(3, 3), qRgb(255, 255, 255));
        DisposeGWorld(world);
    }
};

VELMAR_TEST_MAIN(TestGWorld)
#include "tst_gworld.moc"
