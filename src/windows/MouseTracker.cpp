#include "windows/MouseTracker.h"

#include <QMouseEvent>

namespace Velmar::Private {

MouseTracker::MouseTracker(QWidget* widget) : m_widget(widget)
{
    if (!widget)
        return;
    m_hadTracking = widget->hasMouseTracking();
    widget->setMouseTracking(true);
    widget->installEventFilter(this);
    widget->grabMouse();
    connect(widget, &QObject::destroyed, &m_loop, &QEventLoop::quit);
}

MouseTracker::~MouseTracker()
{
    if (!m_widget)
        return;
    m_widget->removeEventFilter(this);
    m_widget->releaseMouse();
    m_widget->setMouseTracking(m_hadTracking);
}

void MouseTracker::run(Step step)
{
    if (!m_widget)
        return;
    m_step = std::move(step);
    m_loop.exec(QEventLoop::ExcludeSocketNotifiers);
}

bool MouseTracker::eventFilter(QObject* watched, QEvent* e)
{
    if (watched != m_widget || !m_loop.isRunning())
        return false;
    if (e->type() != QEvent::MouseMove && e->type() != QEvent::MouseButtonRelease)
        return e->type() == QEvent::MouseButtonPress || e->type() == QEvent::MouseButtonDblClick;
    auto* mouse = static_cast<QMouseEvent*>(e);
    const bool leftHeld = e->type() == QEvent::MouseMove && (mouse->buttons() & Qt::LeftButton);
    if (!m_step(mouse->globalPosition().toPoint(), leftHeld))
        m_loop.quit();
    return true;
}

} // namespace Velmar::Private
