// A slider control for the library's windows: a QSlider whose value, minimum and maximum are
// the control's 32-bit Toolbox values, with a classic action procedure called while the user
// moves it and help text in the host's Macintosh encoding. See docs/slider.md.
#pragma once

#include <Velmar/MacTypes.h>

#include <QSlider>

#include <memory>
#include <type_traits>

class QKeyEvent;
class QMouseEvent;
class QTimerEvent;
class QWheelEvent;

namespace Velmar {

class AQSlider;
namespace Private {
struct AQSliderPrivate;
}

// QAbstractSlider's int value, minimum and maximum are the Toolbox's SInt32 ones unchanged.
static_assert(std::is_same_v<SInt32, int>, "SInt32 must be int for QSlider's values");

// The part codes the action procedure is given, named as on a classic scroll bar: the "up"
// parts move toward the minimum, the "down" parts toward the maximum, whichever way the
// slider lies on the screen.
using ControlPartCode = SInt16;
enum : ControlPartCode {
    kControlNoPart = 0,
    kControlUpButtonPart = 20,   // one single step toward the minimum
    kControlDownButtonPart = 21, // one single step toward the maximum
    kControlPageUpPart = 22,     // one page step toward the minimum
    kControlPageDownPart = 23,   // one page step toward the maximum
    kControlIndicatorPart = 129, // dragged, or sent to an end (Home, End)
};

// Called after the user's action has moved the slider: value() is already the new value.
// The slider's refCon() is the host's own data.
using AQSliderActionProc = void (*)(AQSlider* slider, ControlPartCode partCode);

class VELMAR_EXPORT AQSlider : public QSlider {
    Q_OBJECT

public:
    explicit AQSlider(QWidget* parent = nullptr);
    explicit AQSlider(Qt::Orientation orientation, QWidget* parent = nullptr);
    ~AQSlider() override;

    // Null (the default) calls nothing. The procedure is called for the user's drags, clicks
    // and keys only, never for setValue, setMinimum, setMaximum or setRange.
    void setActionProc(AQSliderActionProc proc) { m_actionProc = proc; }
    AQSliderActionProc actionProc() const { return m_actionProc; }
    void setRefCon(void* refCon) { m_refCon = refCon; }
    void* refCon() const { return m_refCon; }

    // The tool tip, from text in the host's current Macintosh encoding; null or empty text
    // removes it. Carriage returns break lines; the text is shown as plain text.
    void setHelpPString(ConstStr255Param text);
    void setHelpCString(const char* text);

protected:
    void mousePressEvent(QMouseEvent* e) override;
    void mouseMoveEvent(QMouseEvent* e) override;
    void mouseReleaseEvent(QMouseEvent* e) override;
    void keyPressEvent(QKeyEvent* e) override;
    void timerEvent(QTimerEvent* e) override;
    void wheelEvent(QWheelEvent* e) override;

private:
    AQSliderActionProc m_actionProc = nullptr;
    void* m_refCon = nullptr;
    std::unique_ptr<Private::AQSliderPrivate> d;

    friend struct Private::AQSliderPrivate;
};

} // namespace Velmar
