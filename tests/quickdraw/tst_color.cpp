// Colour models, InvertColor, the hilite state and the colour dialog.
#include <Velmar/QtGrafPort.h>
#include <Velmar/QuickDraw.h>

#include "TestSupport.h"

#include <QColorDialog>

using namespace Velmar;

class TestColor : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void invertColor()
    {
        RGBColor c(0, 32768, 65535);
        InvertColor(&c);
        QCOMPARE(c.red, (unsigned short)65535);
        QCOMPARE(c.green, (unsigned short)32767);
        QCOMPARE(c.blue, (unsigned short)0);
        InvertColor(nullptr);
    }

    void rgbToHsv_data()
    {
        QTest::addColumn<int>("r");
        QTest::addColumn<int>("g");
        QTest::addColumn<int>("b");
        QTest::addColumn<int>("hue");
        QTest::addColumn<int>("saturation");
        QTest::addColumn<int>("value");
        // A grey has no hue: Qt says -1, stored as 1.
        QTest::newRow("mid grey") << 32768 << 32768 << 32768 << 1 << 0 << -1;
        QTest::newRow("black") << 0 << 0 << 0 << 1 << 0 << 0;
        QTest::newRow("red") << 65535 << 0 << 0 << 0 << 65535 << 65535;
        QTest::newRow("blue") << 0 << 0 << 65535 << 43690 << 65535 << 65535;
    }
    void rgbToHsv()
    {
        QFETCH(int, r);
        QFETCH(int, g);
        QFETCH(int, b);
        QFETCH(int, hue);
        QFETCH(int, saturation);
        QFETCH(int, value);
        const RGBColor rgb(r, g, b);
        HSVColor hsv{9, 9, 9};
        RGB2HSV(&rgb, &hsv);
        QCOMPARE(int(hsv.hue), hue);
        QCOMPARE(int(hsv.saturation), saturation);
        if (value >= 0)
            QCOMPARE(int(hsv.value), value);
        RGB2HSV(nullptr, &hsv);
        RGB2HSV(&rgb, nullptr);
    }

    void hsvRoundTrip()
    {
        const RGBColor in(0xFFFF, 0x8080, 0x0000);
        HSVColor hsv;
        RGB2HSV(&in, &hsv);
        RGBColor out;
        HSV2RGB(&hsv, &out);
        QVERIFY(qAbs(int(out.red) - int(in.red)) <= 0x101);
        QVERIFY(qAbs(int(out.green) - int(in.green)) <= 0x101);
        QVERIFY(qAbs(int(out.blue) - int(in.blue)) <= 0x101);
        const HSVColor white{0, 0, 65535};
        HSV2RGB(&white, &out);
        QCOMPARE(out.red, (unsigned short)65535);
        QCOMPARE(out.blue, (unsigned short)65535);
        HSV2RGB(nullptr, nullptr);
        HSV2RGB(&white, nullptr);
        HSV2RGB(nullptr, &out);
    }

    void rgbToHsl()
    {
        const RGBColor rgb(65535, 0, 0);
        HSLColor hsl;
        RGB2HSL(&rgb, &hsl);
        QCOMPARE(hsl.hue, UInt16(0));
        QCOMPARE(hsl.saturation, UInt16(65535));
        QCOMPARE(hsl.lightness, UInt16(32767));
        RGB2HSL(nullptr, &hsl);
    }

    void hiliteState()
    {
        Initialize();
        Initialize(); // once only
        RGBColor c;
        LMGetHiliteRGB(&c);
        QCOMPARE(QColor(c).rgb(),
                 QGuiApplication::palette().color(QPalette::Active, QPalette::Highlight).rgb());
        const RGBColor pink(65535, 0, 65535);
        LMSetHiliteRGB(&pink);
        LMGetHiliteRGB(&c);
        QCOMPARE(quint32(c), 0xFFFF00FFu);
        LMSetHiliteRGB(nullptr);
        LMGetHiliteRGB(nullptr);
        QCOMPARE(LMGetHiliteMode(), (unsigned char)0);
        LMSetHiliteMode(3);
        QCOMPARE(LMGetHiliteMode(), (unsigned char)3);
        LMSetHiliteMode(0);
        // New ports copy the global hilite colour.
        GrafPtr port = CreateNewPort();
        GetPortHiliteColor(port, &c);
        QCOMPARE(quint32(c), 0xFFFF00FFu);
        DisposePort(port);
    }

    void getColorAccepts()
    {
        const RGBColor in(0, 65535, 0);
        RGBColor out;
        QString title;
        QColor initial;
        VelmarTest::ModalActor actor([&](QWidget* modal) {
            auto* dialog = qobject_cast<QColorDialog*>(modal);
            QVERIFY(dialog);
            title = dialog->windowTitle();
            initial = dialog->currentColor();
            dialog->setCurrentColor(QColor(255, 0, 0));
            dialog->accept();
        });
        const unsigned char prompt[] = "\x0APick a hue";
        Point where{0, 0};
        QCOMPARE(GetColor(where, prompt, &in, &out), (unsigned char)1);
        QVERIFY(actor.acted());
        QCOMPARE(title, QStringLiteral("Pick a hue"));
        QCOMPARE(initial, QColor(0, 255, 0));
        QCOMPARE(quint32(out), 0xFFFF0000u);
    }

    void getColorRejects()
    {
        RGBColor out(1, 2, 3);
        VelmarTest::ModalActor actor(
            [](QWidget* modal) { qobject_cast<QDialog*>(modal)->reject(); });
        Point where{0, 0};
        QCOMPARE(GetColor(where, nullptr, nullptr, &out), (unsigned char)0);
        QVERIFY(actor.acted());
        QCOMPARE(out.red, (unsigned short)1);
        // No place for the answer: no dialog at all.
        QCOMPARE(GetColor(where, nullptr, nullptr, nullptr), (unsigned char)0);
    }
};

VELMAR_TEST_MAIN(TestColor)
#include "tst_color.moc"
