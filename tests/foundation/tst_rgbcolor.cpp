// RGBColor's conversions and the private Toolbox <-> Qt value conversions.
#include <Velmar/MacTypes.h>

#include "foundation/Conversions.h"

#include "TestSupport.h"

using namespace Velmar;
using namespace Velmar::Private;

class TestRGBColor : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void fromArgb_data()
    {
        QTest::addColumn<uint>("argb");
        QTest::addColumn<int>("red");
        QTest::addColumn<int>("green");
        QTest::addColumn<int>("blue");
        QTest::addColumn<uint>("back");
        QTest::newRow("mixed") << 0x00FF8001u << 65535 << 32896 << 257 << 0xFFFF8001u;
        QTest::newRow("alpha ignored") << 0x7F000000u << 0 << 0 << 0 << 0xFF000000u;
    }
    void fromArgb()
    {
        QFETCH(uint, argb);
        QFETCH(int, red);
        QFETCH(int, green);
        QFETCH(int, blue);
        QFETCH(uint, back);
        RGBColor c(argb);
        QCOMPARE(int(c.red), red);
        QCOMPARE(int(c.green), green);
        QCOMPARE(int(c.blue), blue);
        QCOMPARE(static_cast<unsigned int>(c), back);
        RGBColor d;
        d.set(argb);
        QCOMPARE(int(d.green), green);
    }

    void narrowingTruncates()
    {
        // 0x80FF / 257 = 128.99...: truncated, never rounded.
        QCOMPARE(static_cast<unsigned int>(RGBColor(0x80FF, 0x0101, 0x0100)), 0xFF800100u);
        // Every 8-bit value survives widening and narrowing.
        for (uint b = 0; b < 256; ++b) {
            const RGBColor c(b << 16 | b << 8 | b);
            QCOMPARE(int(c.red), int(b * 257));
            QCOMPARE(static_cast<unsigned int>(c), 0xFF000000u | b << 16 | b << 8 | b);
            QCOMPARE(int(channel8To16(int(b))), int(b * 257));
            QCOMPARE(channel16To8(c.red), int(b));
        }
    }

    void qcolorBothWays()
    {
        QCOMPARE(int(RGBColor(QColor(128, 0, 0)).red), 32896);
        const QColor red = RGBColor(65535, 0, 0);
        QCOMPARE(red, QColor(Qt::red));
        QCOMPARE(red.alpha(), 255);
        // Every 16-bit value round-trips.
        for (int v = 0; v < 65536; v += 7) {
            const RGBColor c(static_cast<unsigned short>(v), 0, static_cast<unsigned short>(65535 - v));
            const RGBColor back(static_cast<QColor>(c));
            QCOMPARE(int(back.red), v);
            QCOMPARE(int(back.blue), 65535 - v);
        }
        QCOMPARE(int(RGBColor(QColor()).red), 0);
        QCOMPARE(int(RGBColor(QColor::fromRgbF(2.0f, -1.0f, 0.5f).convertTo(QColor::ExtendedRgb)).red), 65535);
    }

    void rectConversions_data()
    {
        QTest::addColumn<int>("top");
        QTest::addColumn<int>("left");
        QTest::addColumn<int>("bottom");
        QTest::addColumn<int>("right");
        QTest::newRow("ordinary") << 10 << 20 << 30 << 60;
        QTest::newRow("empty") << 10 << 10 << 10 << 20;
        QTest::newRow("extremes") << -32768 << -32768 << 32767 << 32767;
    }
    void rectConversions()
    {
        QFETCH(int, top);
        QFETCH(int, left);
        QFETCH(int, bottom);
        QFETCH(int, right);
        const Rect r = makeRect(left, top, right, bottom);
        const QRect q = toQRect(r);
        QCOMPARE(q, QRect(QPoint(left, top), QPoint(right - 1, bottom - 1)));
        QVERIFY(sameRect(toRect(q), r));
        QCOMPARE(rectSize(r), QSize(right - left, bottom - top));
        QCOMPARE(isEmptyRect(&r), q.isEmpty());
    }

    void pointsAndNulls()
    {
        const Point p = toPoint(QPoint(5, -7));
        QCOMPARE(p.h, 5);
        QCOMPARE(p.v, -7);
        QCOMPARE(toQPoint(p), QPoint(5, -7));
        QVERIFY(isEmptyRect(nullptr));
        QVERIFY(toQRect(static_cast<const Rect*>(nullptr)).isNull());
        toRect(QRect(0, 0, 1, 1), nullptr); // ignored
        QCOMPARE(fourCharByte(FOUR_CHAR_CODE("TEXT"), 1), 'E');
    }
};

VELMAR_TEST_MAIN(TestRGBColor)
#include "tst_rgbcolor.moc"
