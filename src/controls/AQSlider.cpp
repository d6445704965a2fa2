// The slider control: Qt's own slider does the tracking; this class turns its actions into
// classic action-procedure calls and keeps input it does not act on flowing to the window.
#include <Velmar/AQSlider.h>

#include <Velmar/AQtWindow.h>
#include <Velmar/HostCore.h>
#include <Velmar/TextUtils.h>

#include "foundation/Lifetime.h"

#include <QKeyEvent>
#include <QMouseEvent>
#include <QPointer>
#include <QTextDocument>
#include <QWheelEvent>

#include <algorithm>
#include <utility>

namespace Velmar {

namespace {

struct ActionRow {
    QAbstractSlider::SliderAction action;
    ControlPartCode part;
    int direction; // the step's sign; 0 for actions that do not step
    bool page;
};

constexpr ActionRow kActions[] = {
    {QAbstractSlider::SliderSingleStepSub, kControlUpButtonPart, -1, false},
    {QAbstractSlider::SliderSingleStepAdd, kControlDownButtonPart, 1, false},
    {QAbstractSlider::SliderPageStepSub, kControlPageUpPart, -1, true},
    {QAbstractSlider::SliderPageStepAdd, kControlPageDownPart, 1, true},
    {QAbstractSlider::SliderToMinimum, kControlIndicatorPart, 0, false},
    {QAbstractSlider::SliderToMaximum, kControlIndicatorPart, 0, false},
    {QAbstractSlider::SliderMove, kControlIndicatorPart, 0, false},
};

const ActionRow* findAction(int action)
{
    for (const ActionRow& row : kActions) {
        if (row.action == action)
            return &row;
    }
    return nullptr;
}

// The library's window the slider sits on, however deep (a decorated window is not the
// top level).
const AQtWindow* owningWindow(const QWidget* widget)
{
    for (const QWidget* w = widget->parentWidget(); w; w = w->parentWidget()) {
        if (const auto* window = qobject_cast<const AQtWindow*>(w))
            return window;
    }
    return nullptr;
}

// Toolbox help text as a tool tip: Mac line breaks, and plain even where Qt would take text
// that starts like a tag for rich text.
QString toolTipText(QString help)
{
    help.replace(QLatin1String("\r\n"), QLatin1String("\n")).replace(u'\r', u'\n');
    return Qt::mightBeRichText(help) ? Qt::convertFromPlainText(help, Qt::WhiteSpacePre) : help;
}

} // namespace

namespace Private {

struct AQSliderPrivate {
    ControlPartCode pendingPart = kControlNoPart; // the last action of the input being handled
    int inputDepth = 0;
    bool inActionProc = false;
    bool ownsPress = false; // the slider took the press of the click under way

    // Runs Qt's handler for one piece of user input, then calls the action procedure once
    // for what it did. False when the slider is gone.
    template <typename Handler>
    static bool deliver(AQSlider* slider, Handler handler)
    {
        const QPointer<AQSlider> alive(slider);
        ++slider->d->inputDepth;
        handler();
        if (!alive)
            return false;
        AQSliderPrivate* d = slider->d.get();
        if (--d->inputDepth > 0)
            return true;
        const ControlPartCode part = std::exchange(d->pendingPart, kControlNoPart);
        if (part != kControlNoPart)
            callActionProc(slider, part);
        return !alive.isNull();
    }

    static void callActionProc(AQSlider* slider, ControlPartCode part)
    {
        AQSliderActionProc proc = slider->m_actionProc;
        // Classic procedures were never re-entered; one that waits for events meanwhile
        // sees the value move without being called again. Once the window is disposed, the
        // host's data behind the refCon may be gone with it.
        const AQtWindow* window = owningWindow(slider);
        if (!proc || slider->d->inActionProc || (window && window->IsDeletePending()))
            return;
        const QPointer<AQSlider> alive(slider);
        slider->d->inActionProc = true;
        callGuarded([&] { proc(slider, part); }, "A slider action procedure threw");
        if (alive)
            slider->d->inActionProc = false;
    }

    void actionTriggered(AQSlider* slider, int action)
    {
        const ActionRow* row = findAction(action);
        if (!row)
            return;
        if (row->direction != 0) {
            // Qt adds the step in int and wraps near INT_MIN and INT_MAX; the value has not
            // been set yet, so the position can still be put right.
            const qint64 step = qAbs(qint64(row->page ? slider->pageStep() : slider->singleStep()));
            const qint64 target = qint64(slider->value()) + row->direction * step;
            slider->setSliderPosition(
                int(std::clamp<qint64>(target, slider->minimum(), slider->maximum())));
        }
        if (inputDepth > 0)
            pendingPart = row->part;
    }
};

} // namespace Private

using Private::AQSliderPrivate;

AQSlider::AQSlider(QWidget* parent) : AQSlider(Qt::Vertical, parent) {}

AQSlider::AQSlider(Qt::Orientation orientation, QWidget* parent)
    : QSlider(orientation, parent), d(std::make_unique<AQSliderPrivate>())
{
    // Keys belong to the host's event loop, as with a classic control, until the host gives
    // the slider the focus itself.
    setFocusPolicy(Qt::NoFocus);
    // Classic controls draw their own background: the window never repaints what lies under
    // the slider when it moves.
    setAutoFillBackground(true);
    connect(this, &QAbstractSlider::actionTriggered, this,
            [this](int action) { d->actionTriggered(this, action); });
}

AQSlider::~AQSlider() = default;

void AQSlider::setHelpPString(ConstStr255Param text)
{
    setToolTip(toolTipText(PascalString2QString(text)));
}

void AQSlider::setHelpCString(const char* text)
{
    setToolTip(toolTipText(MakeQString(text, -1)));
}

void AQSlider::mousePressEvent(QMouseEvent* e)
{
    // A second button during the slider's own click stays with the slider.
    if (d->ownsPress && e->buttons() != e->button()) {
        e->accept();
        return;
    }
    if (AQSliderPrivate::deliver(this, [&] { QSlider::mousePressEvent(e); }))
        d->ownsPress = e->isAccepted();
}

void AQSlider::mouseMoveEvent(QMouseEvent* e)
{
    if (!AQSliderPrivate::deliver(this, [&] { QSlider::mouseMoveEvent(e); }))
        return;
    // Qt passes on moves of a held page click; the window would post them as drags of a
    // press the host never saw.
    if (d->ownsPress)
        e->accept();
}

void AQSlider::mouseReleaseEvent(QMouseEvent* e)
{
    if (!AQSliderPrivate::deliver(this, [&] { QSlider::mouseReleaseEvent(e); }) || !d->ownsPress)
        return;
    e->accept();
    if (e->buttons() == Qt::NoButton)
        d->ownsPress = false;
}

void AQSlider::keyPressEvent(QKeyEvent* e)
{
    AQSliderPrivate::deliver(this, [&] { QSlider::keyPressEvent(e); });
}

void AQSlider::timerEvent(QTimerEvent* e)
{
    // The repeat of a held page click.
    AQSliderPrivate::deliver(this, [&] { QSlider::timerEvent(e); });
}

void AQSlider::wheelEvent(QWheelEvent* e)
{
    // A classic control never saw the wheel: it goes on to the window and the host.
    e->ignore();
}

} // namespace Velmar
