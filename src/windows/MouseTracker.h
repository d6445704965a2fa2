// The modal mouse loops of GrowWindow and DragGrayRgn: a local event loop that sees every
// mouse move and release on a widget until the drag ends.
#pragma once

#include <QEventLoop>
#include <QObject>
#include <QPoint>
#include <QPointer>
#include <QWidget>

#include <functional>

namespace Velmar::Private {

class MouseTracker : public QObject {
public:
    // `step(globalPos, leftButtonHeld)` is called for each move and release; it returns false
    // to end the loop. The loop also ends when the widget goes away.
    using Step = std::function<bool(const QPoint& global, bool leftHeld)>;

    explicit MouseTracker(QWidget* widget);
    ~MouseTracker() override;
    MouseTracker(const MouseTracker&) = delete;
    MouseTracker& operator=(const MouseTracker&) = delete;

    void run(Step step);

protected:
    bool eventFilter(QObject* watched, QEvent* e) override;

private:
    QPointer<QWidget> m_widget;
    QEventLoop m_loop;
    Step m_step;
    bool m_hadTracking = false;
};

} // namespace Velmar::Private
