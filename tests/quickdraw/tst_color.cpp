// Colour models, InvertColor, the hilite colour and the colour dialog.
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

    // HSL takes the HSV hue and saturation; -1 marks a component left unchecked (rounding).
    void rgbToHsvAndHsl_data()
    {
        QTest::addColumn<QList<int>>("rgb");
        QTest::addColumn<QList<int>>("hsvl"); // hue, saturation, value, lightness
        // A grey has no hue: Qt says -1, stored as 1.
        QTest::newRow("mid grey") << QList<int>{32768, 32768, 32768} << QList<int>{1, 0, -1, -1};
        QTest::newRow("black") << QList<int>{0, 0, 0} << QList<int>{1, 0, 0, 0};
        QTest::newRow("red") << QList<int>{65535, 0, 0} << QList<int>{0, 65535, 65535, 32767};
        QTest::newRow("blue") << QList<int>{0, 0, 65535} << QList<int>{43690, 65535, 65535, 32767};
    }
    void rgbToHsvAndHsl()
    {
        QFETCH(QList<int>, rgb);
        QFETCH(QList<int>, hsvl);
        const RGBColor in(rgb[0], rgb[1], rgb[2]);
        HSVColor hsv{9, 9, 9};
        RGB2HSV(&in, &hsv);
        HSLColor hsl{9, 9, 9};
        RGB2HSL(&in, &hsl);
        QCOMPARE(int(hsv.hue), hsvl[0]);
        QCOMPARE(int(hsv.saturation), hsvl[1]);
        QCOMPARE(int(hsl.hue), hsvl[0]);
        QCOMPARE(int(hsl.saturation), hsvl[1]);
        if (hsvl[2] >= 0)
            QCOMPARE(int(hsv.value), hsvl[2]);
        if (hsvl[3] >= 0)
            QCOMPARE(int(hsl.lightness), hsvl[3]);
        RGB2HSV(nullptr, &hsv);
        RGB2HSV(&in, nullptr);
        RGB2HSL(nullptr, &hsl);
        RGB2HSL(&in, nullptr);
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

    void hiliteColour()
    {
        Initialize();
        Initialize(); // once only
        RGBColor c;
        LMGetHiliteRGB(&c);
        QCOMPARE(QColor(c).rgb(),
                 QGuiApplication::palette().color(QPalette::Active, QPalette::Highlight).rgb());
        const RGBColor pink(65535, 0, 65535);
        LMSetHiliteRGB(&pink);
        LMSetHiliteRGB(nullptr);
        LMGetHiliteRGB(nullptr);
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
        QCOMPARE(GetColor(Point{0, 0}, prompt, &in, &out), (unsigned char)1);
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
        QCOMPARE(GetColor(Point{0, 0}, nullptr, nullptr, &out), (unsigned char)0);
        QVERIFY(actor.acted());
        QCOMPARE(out.red, (unsigned short)1);
        // No place for the answer: no dialog at all.
        QCOMPARE(GetColor(Point{0, 0}, nullptr, nullptr, nullptr), (unsigned char)0);
    }
};

VELMAR_TEST_MAIN(TestColor)
#include "tst_color.moc"
