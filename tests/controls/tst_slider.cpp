// The slider as a host drives it: the action procedure hears the user's drags, clicks and
// keys by part code, never the host's own setValue; values stay inside 32-bit ranges at
// their ends; help text arrives in the host's encoding.
#include "TestSupport.h"

#include <Velmar/AQSlider.h>

#include <QStyleOptionSlider>

#include <climits>

using namespace Velmar;

namespace {

VelmarTest::SequenceRecorder* gRecorder = nullptr;

void recordAction(AQSlider* slider, ControlPartCode part)
{
    gRecorder->record(QStringLiteral("%1 %2").arg(part).arg(slider->value()));
    if (slider->refCon() == &gRecorder) // the host disposes of its control from the proc
        delete slider;
}

QPoint handleCentre(AQSlider& slider)
{
    QStyleOptionSlider option;
    option.initFrom(&slider);
    option.orientation = slider.orientation();
    option.minimum = slider.minimum();
    option.maximum = slider.maximum();
    option.sliderPosition = slider.sliderPosition();
    option.sliderValue = slider.value();
    return slider.style()
        ->subControlRect(QStyle::CC_Slider, &option, QStyle::SC_SliderHandle, &slider)
        .center();
}

} // namespace

class tst_Slider : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void init() { gRecorder = &m_recorder; m_recorder.clear(); }

    void userActionsCallTheProc()
    {
        AQSlider slider(Qt::Horizontal);
        slider.resize(200, 24);
        slider.setRange(0, 100);
        slider.setPageStep(10);
        slider.setActionProc(recordAction);
        slider.setValue(50);
        slider.show();
        QVERIFY(QTest::qWaitForWindowExposed(&slider));
        QTest::keyClick(&slider, Qt::Key_Right);
        QTest::keyClick(&slider, Qt::Key_Left);
        QTest::keyClick(&slider, Qt::Key_PageDown); // PageDown lowers a horizontal slider
        QTest::keyClick(&slider, Qt::Key_End);
        const QPoint from = handleCentre(slider);
        QTest::mousePress(&slider, Qt::LeftButton, {}, from);
        QTest::mouseMove(&slider, from - QPoint(40, 0));
        QTest::mouseRelease(&slider, Qt::LeftButton, {}, from - QPoint(40, 0));
        const int dragged = slider.value();
        QVERIFY(dragged < 100);
        slider.setRange(0, 10); // the host's own change: no call
        VELMAR_COMPARE_SEQUENCE(m_recorder, "user actions",
                                {"21 51", "20 50", "22 40", "129 100", "*",
                                 "129 " + QString::number(dragged)});
    }

    // Steps at the ends of the 32-bit range pin instead of wrapping; setValue clamps.
    void extremeRanges()
    {
        AQSlider slider;
        slider.setActionProc(recordAction);
        slider.setRange(INT_MIN, INT_MAX);
        slider.setPageStep(INT_MAX);
        slider.setValue(INT_MAX - 1);
        QTest::keyClick(&slider, Qt::Key_PageUp);
        QCOMPARE(slider.value(), INT_MAX);
        slider.setValue(INT_MIN + 1);
        QTest::keyClick(&slider, Qt::Key_PageDown);
        QCOMPARE(slider.value(), INT_MIN);
        slider.setRange(5, 1);
        slider.setValue(-7);
        QCOMPARE(slider.value(), slider.minimum());
        VELMAR_COMPARE_SEQUENCE(m_recorder, "pinned", {"23 " + QString::number(INT_MAX),
                                                       "22 " + QString::number(INT_MIN)});
    }

    void procMayDisposeOfTheSlider()
    {
        auto* slider = new AQSlider;
        slider->setActionProc(recordAction);
        slider->setRefCon(&gRecorder);
        QPointer<AQSlider> alive(slider);
        QKeyEvent up(QEvent::KeyPress, Qt::Key_Up, Qt::NoModifier);
        QCoreApplication::sendEvent(slider, &up);
        QVERIFY(alive.isNull());
        QCOMPARE(m_recorder.entries().size(), 1);
    }

    void helpTextInTheHostsEncoding()
    {
        AQSlider slider;
        // Mac OS Roman: 0x8E is e with acute; a carriage return breaks the line.
        const unsigned char pascal[] = {9, 'V', 'o', 'l', 'u', 'm', 0x8E, '\r', '<', 'b'};
        slider.setHelpPString(pascal);
        QVERIFY(slider.toolTip().contains(QString::fromUtf8("Volum\xc3\xa9")));
        QVERIFY(!slider.toolTip().contains(u'\r'));
        slider.setHelpCString("<b>plain</b>");
        QVERIFY(slider.toolTip().contains(QLatin1String("&lt;b&gt;")));
        slider.setHelpCString(nullptr);
        QVERIFY(slider.toolTip().isEmpty());
        slider.setHelpPString(nullptr);
        QVERIFY(slider.toolTip().isEmpty());
    }

private:
    VelmarTest::SequenceRecorder m_recorder;
};

VELMAR_TEST_MAIN(tst_Slider)
#include "tst_slider.moc"
