#include "drag/DragStartChecker.h"

#include <QApplication>
#include <QMouseEvent>
#include <QWidget>

namespace Velmar::Private {

DragStartChecker::DragStartChecker(QWidget* source, const QPoint& globalPress)
    : m_source(source), m_press(globalPress)
{
    m_timer.setSingleShot(true);
    connect(&m_timer, &QTimer::timeout, this, &DragStartChecker::startDragTimeCheckerSlot);
}

bool DragStartChecker::run()
{
    if (!m_source)
        return false;
    // The button may already be up (a quick click whose release Qt has seen).
    if (!(QGuiApplication::mouseButtons() & Qt::LeftButton)) {
        QCoreApplication::processEvents(QEventLoop::ExcludeUserInputEvents);
        if (!(QGuiApplication::mouseButtons() & Qt::LeftButton))
            return false;
    }
    m_source->installEventFilter(this);
    m_timer.start(QApplication::startDragTime());
    m_loop.exec();
    if (m_source)
        m_source->removeEventFilter(this);
    return m_start;
}

void DragStartChecker::startDragTimeCheckerSlot()
{
    finish(true);
}

bool DragStartChecker::eventFilter(QObject*, QEvent* event)
{
    if (event->type() == QEvent::MouseMove) {
        const QPoint at = static_cast<QMouseEvent*>(event)->globalPosition().toPoint();
        if ((at - m_press).manhattanLength() > QApplication::startDragDistance())
            finish(true);
    } else if (event->type() == QEvent::MouseButtonRelease) {
        finish(false);
    }
    return false;
}

void DragStartChecker::finish(bool start)
{
    m_start = start;
    m_timer.stop();
    m_loop.quit();
}

} // namespace Velmar::Private
