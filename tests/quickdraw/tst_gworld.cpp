// Offscreen worlds: creation rules, resizing, disposal, bounds and origin, bad input.
#include "QuickDrawTestSupport.h"

using namespace Velmar;
using Velmar::Private::makeRect;
using namespace QDTest;

namespace {

// "top,left,bottom,right"
QString text(const Rect& r)
{
    return QStringLiteral("%1,%2,%3,%4").arg(r.top).arg(r.left).arg(r.bottom).arg(r.right);
}
QString boundsOf(GrafPtr port)
{
    Rect r;
    return text(*GetPortBounds(port, &r));
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

    void newGWorld_data()
    {
        QTest::addColumn<int>("depth");
        QTest::addColumn<QString>("ltrb"); // the Rect asked for: left, top, right, bottom
        QTest::addColumn<QString>("expected");
        QTest::addColumn<QSize>("imageSize");
        for (const auto& [name, depth, ltrb, expected, size] :
             {std::tuple{"zero size widened", 32, "10,10,10,10", "10,10,11,11", QSize(1, 1)},
              {"depth 0 at origin", 0, "20,10,60,30", "0,0,20,40", QSize(40, 20)},
              {"depth 32 in place", 32, "20,10,60,30", "10,20,30,60", QSize(40, 20)},
              {"negative size to one", 32, "10,10,5,5", "10,10,11,11", QSize(1, 1)},
              {"zero width only", 32, "0,0,0,10", "0,0,10,1", QSize(1, 10)}})
            QTest::newRow(name) << depth << QString::fromLatin1(ltrb) << QString::fromLatin1(expected) << size;
    }
    void newGWorld()
    {
        QFETCH(int, depth);
        QFETCH(QString, ltrb);
        QFETCH(QString, expected);
        QFETCH(QSize, imageSize);
        const QStringList v = ltrb.split(QLatin1Char(','));
        const Rect r = makeRect(v[0].toInt(), v[1].toInt(), v[2].toInt(), v[3].toInt());
        GrafPtr world = nullptr;
        QCOMPARE(NewGWorld(&world, SInt16(depth), &r, nullptr, nullptr, 0), SInt16(0));
        QVERIFY(IsValidPort(world));
        QCOMPARE(boundsOf(world), expected);
        QVERIFY(world->image());
        QCOMPARE(world->image()->size(), imageSize);
        QCOMPARE(world->image()->format(), QImage::Format_ARGB32_Premultiplied);
        QCOMPARE(GetPortPixMap(world)->pixelDepth(), SInt16(depth ? depth : 6));
        // A fresh world: cleared with the back colour, pen at the top-left, nothing clipped.
        QCOMPARE(world->image()->pixel(imageSize.width() - 1, imageSize.height() - 1),
                 qRgb(255, 255, 255));
        QCOMPARE(world->opColor, QColor(Qt::black));
        QCOMPARE(world->backColor, QColor(Qt::white));
        QCOMPARE(world->penMode, SInt16(patCopy));
        QCOMPARE(QPoint(world->penX, world->penY), world->bounds.topLeft());
        QCOMPARE(world->visibleRegion, QRegion(world->bounds));
        QCOMPARE(world->clipRegion, QRegion(QRect(-32767, -32767, 65534, 65534)));
        QCOMPARE(world->clipInForce, UInt8(0));
        DisposeGWorld(world);
        QVERIFY(!IsValidPort(world));
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
        QVERIFY(!MakeQPainter("PaintRect"));
        RGBColor c(1, 2, 3);
        const RGBColor red(65535, 0, 0);
        SetCPixel(10, 10, &red);
        GetCPixel(10, 10, &c);
        QCOMPARE(c.red, (unsigned short)0);
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
        World world(20);
        const RGBColor red(65535, 0, 0), blue(0, 0, 65535);
        SetCPixel(0, 0, &red);
        SetCPixel(9, 9, &blue);
        SetCPixel(15, 15, &blue); // cut off by the shrink

        GrafPtr handle = world;
        const Rect same = makeRect(0, 0, 20, 20);
        QCOMPARE(UpdateGWorld(&handle, 32, &same, nullptr, nullptr, 0), UInt32(0));
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
        QPainter* p = world.painter();
        QVERIFY(p);
        p->fillRect(QRect(20, 0, 10, 10), Private::resolvedFillBrush(world));
        GetCPixel(29, 9, &c);
        QCOMPARE(quint32(c), 0xFF000000u);
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

    void portSizeAndOrigin()
    {
        World world(40, 30);
        SetOrigin(100, 200);
        QCOMPARE(boundsOf(world), QStringLiteral("200,100,230,140"));
        // Local (139, 229) is the image's bottom-right pixel.
        const RGBColor red(65535, 0, 0);
        SetCPixel(139, 229, &red);
        QCOMPARE(world.pixel(39, 29), qRgb(255, 0, 0));
        // PortSize keeps the origin.
        SetOrigin(5, 6);
        PortSize(20, 10);
        QCOMPARE(boundsOf(world), QStringLiteral("6,5,16,25"));
        QCOMPARE(world.image().size(), QSize(20, 10));
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
