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

    // Anchor values: HSL takes the HSV hue and saturation; a grey has no hue (Qt's -1 is
    // stored as 1).
    void rgbToHsvAndHsl()
    {
        for (const auto& [rgb, hsvl] : {std::pair{RGBColor(0, 0, 0), QList<int>{1, 0, 0, 0}},
                                        {RGBColor(65535, 0, 0), {0, 65535, 65535, 32767}},
                                        {RGBColor(0, 0, 65535), {43690, 65535, 65535, 32767}}}) {
            HSVColor hsv{9, 9, 9};
            RGB2HSV(&rgb, &hsv);
            HSLColor hsl{9, 9, 9};
            RGB2HSL(&rgb, &hsl);
            QCOMPARE(QList<int>({hsv.hue, hsv.saturation, hsv.value, hsl.lightness}), hsvl);
            QCOMPARE(QList<int>({hsl.hue, hsl.saturation}), hsvl.mid(0, 2));
            RGB2HSV(nullptr, &hsv);
            RGB2HSL(&rgb, nullptr);
        }
        const HSVColor white{0, 0, 65535};
        RGBColor out;
        HSV2RGB(&white, &out);
        QCOMPARE(quint32(out), 0xFFFFFFFFu);
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

    // A scripted run answers instead of a user, so no box ever waits.
    void getColorAsksTheListener()
    {
        const RGBColor in(0, 65535, 0);
        RGBColor out(1, 2, 3);
        VelmarTest::ScriptedAutomationListener listener({"OK", "#3366cc", "Cancel"});
        const unsigned char prompt[] = "\x04Tint";
        QCOMPARE(GetColor(Point{0, 0}, prompt, &in, &out), (unsigned char)1);
        QCOMPARE(quint32(out), 0xFF00FF00u);
        QCOMPARE(GetColor(Point{0, 0}, prompt, &in, &out), (unsigned char)1);
        QCOMPARE(quint32(out), 0xFF3366CCu);
        QCOMPARE(GetColor(Point{0, 0}, prompt, &in, &out), (unsigned char)0);
        QCOMPARE(quint32(out), 0xFF3366CCu);
        QCOMPARE(listener.count(), 3);
        QCOMPARE(listener.questions().at(0).title, QStringLiteral("Tint"));
        QCOMPARE(listener.questions().at(0).choices, QStringLiteral("OK|Cancel"));
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
