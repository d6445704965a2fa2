#include "host/FrameDecorator.h"

#include <QCloseEvent>
#include <QCoreApplication>
#include <QGuiApplication>
#include <QMouseEvent>
#include <QPainter>
#include <QScreen>

namespace Velmar::Brindle {

// The frame around one content widget. It follows the content's size, passes a close request
// on to the content (the window decides), and moves when its title bar is dragged.
class FrameWidget : public QWidget {
public:
    explicit FrameWidget(QWidget* content)
        : QWidget(nullptr, Qt::Window | Qt::FramelessWindowHint), m_content(content)
    {
        setAttribute(Qt::WA_DeleteOnClose, false);
        content->installEventFilter(this);
    }

    bool eventFilter(QObject* watched, QEvent* e) override
    {
        if (watched == m_content && e->type() == QEvent::Resize)
            resize(m_content->size() + FrameDecorator::frameExtra());
        return false;
    }

protected:
    void paintEvent(QPaintEvent*) override
    {
        QPainter p(this);
        const bool active = isActiveWindow();
        p.fillRect(rect(), active ? QColor(0x4a, 0x6e, 0xa9) : QColor(0x9a, 0x9a, 0x9a));
        p.setPen(Qt::white);
        p.drawText(QRect(FrameDecorator::kBorder, 0, width() - 2 * FrameDecorator::kBorder,
                         FrameDecorator::kTitleHeight + FrameDecorator::kBorder),
                   Qt::AlignCenter, windowTitle());
    }
    void changeEvent(QEvent* e) override
    {
        if (e->type() == QEvent::ActivationChange || e->type() == QEvent::WindowTitleChange)
            update();
        QWidget::changeEvent(e);
    }
    void closeEvent(QCloseEvent* e) override
    {
        e->ignore();
        if (m_content) {
            QCloseEvent request;
            QCoreApplication::sendEvent(m_content, &request);
        }
    }
    void mousePressEvent(QMouseEvent* e) override
    {
        if (e->button() == Qt::LeftButton && e->position().y() < FrameDecorator::contentOffset().y())
            m_dragFrom = e->globalPosition().toPoint() - pos();
    }
    void mouseMoveEvent(QMouseEvent* e) override
    {
        if (m_dragFrom && (e->buttons() & Qt::LeftButton))
            move(e->globalPosition().toPoint() - *m_dragFrom);
    }
    void mouseReleaseEvent(QMouseEvent*) override { m_dragFrom.reset(); }

private:
    QPointer<QWidget> m_content;
    std::optional<QPoint> m_dragFrom;
};

FrameDecorator::FrameDecorator(ManagedWindow* window)
{
    QWidget* content = window->GetWidget();
    m_content = content;
    const QRect globalContent = window->ContentGeometry();
    const bool visible = content->isVisible();
    m_frame = new FrameWidget(content);
    m_frame->setWindowTitle(content->windowTitle());
    content->setParent(m_frame, Qt::Widget);
    content->move(contentOffset());
    m_frame->setGeometry(QRect(globalContent.topLeft() - contentOffset(),
                               content->size() + frameExtra()));
    content->show();
    m_frame->setVisible(visible);
}

FrameDecorator::~FrameDecorator()
{
    // The content goes back to being a window of its own, where it was.
    if (m_content && m_frame) {
        const QRect global(m_frame->pos() + contentOffset(), m_content->size());
        const bool visible = m_frame->isVisible();
        m_content->removeEventFilter(m_frame);
        m_content->setParent(nullptr, Qt::Window);
        m_content->setGeometry(global);
        m_content->setVisible(visible);
    }
    delete m_frame;
}

QWidget* FrameDecorator::frame() const
{
    return m_frame;
}

QPoint FrameDecorator::ReferenceOrigin() const
{
    QScreen* screen = QGuiApplication::primaryScreen();
    return screen ? screen->availableGeometry().topLeft() : QPoint(0, 0);
}

QRect FrameDecorator::FrameGeometry() const
{
    return m_frame ? m_frame->geometry().translated(-ReferenceOrigin()) : QRect();
}

QRect FrameDecorator::ContentGeometry() const
{
    if (!m_frame || !m_content)
        return QRect();
    return QRect(m_frame->pos() + contentOffset() - ReferenceOrigin(), m_content->size());
}

void FrameDecorator::SetFrameGeometry(const QRect& frame)
{
    if (!m_frame || !m_content)
        return;
    m_frame->setGeometry(frame.translated(ReferenceOrigin()));
    m_content->resize((frame.size() - frameExtra()).expandedTo(QSize(1, 1)));
}

void FrameDecorator::SetContentGeometry(const QRect& content)
{
    if (!m_frame || !m_content)
        return;
    m_content->resize(content.size());
    m_frame->setGeometry(QRect(content.topLeft() + ReferenceOrigin() - contentOffset(),
                               content.size() + frameExtra()));
}

void FrameDecorator::MoveContent(const QPoint& topLeft)
{
    if (m_frame)
        m_frame->move(topLeft + ReferenceOrigin() - contentOffset());
}

void FrameDecorator::SetContentSize(const QSize& size)
{
    if (m_content)
        m_content->resize(size);
}

void FrameDecorator::SetTitle(const QString& title)
{
    if (m_frame)
        m_frame->setWindowTitle(title);
}

void FrameDecorator::SelectWindow()
{
    if (!m_frame)
        return;
    m_frame->raise();
    m_frame->activateWindow();
}

} // namespace Velmar::Brindle
