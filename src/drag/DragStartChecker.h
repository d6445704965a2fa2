// Whether a mouse-down becomes a drag: the mouse moves far enough, or stays down long enough.
#pragma once

#include <QEventLoop>
#include <QObject>
#include <QPoint>
#include <QPointer>
#include <QTimer>

class QWidget;

namespace Velmar::Private {

class DragStartChecker : public QObject {
    Q_OBJECT

public:
    DragStartChecker(QWidget* source, const QPoint& globalPress);
    // True to start the drag; false when the button went up first.
    bool run();

public Q_SLOTS:
    void startDragTimeCheckerSlot();

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    void finish(bool start);

    QPointer<QWidget> m_source;
    QPoint m_press;
    QEventLoop m_loop;
    QTimer m_timer;
    bool m_start = false;
};

} // namespace Velmar::Private
