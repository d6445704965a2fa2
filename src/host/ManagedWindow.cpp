// Default behaviour of a managed window: the window system's own frame, unless the shell
// gave the window a decorator, in which case geometry and selection go through it.
#include <Velmar/HostShell.h>

#include <QWidget>

namespace Velmar::Brindle {

Decorator::~Decorator() = default;

ManagedWindow::ManagedWindow() = default;
ManagedWindow::~ManagedWindow() = default;

void ManagedWindow::SkinChangedHandle()
{
    if (QWidget* widget = GetWidget())
        widget->update();
}

void ManagedWindow::SetContentSize(const QSize& size)
{
    if (m_decorator)
        m_decorator->SetContentSize(size);
    else if (QWidget* widget = GetWidget())
        widget->resize(size);
}

void ManagedWindow::MoveWindow(const QPoint& contentTopLeft)
{
    if (m_decorator) {
        m_decorator->MoveContent(contentTopLeft);
    } else {
        QWidget* widget = GetWidget();
        QWidget* top = GetTopWindow();
        if (!widget || !top)
            return;
        // Moving the top-level widget moves its frame; shift it by what the content is off.
        const QPoint delta = contentTopLeft - ContentGeometry().topLeft();
        top->move(top->pos() + delta);
    }
    InformHandlerManagedWindowHasMoved();
}

QWidget* ManagedWindow::GetTopWindow()
{
    QWidget* widget = GetWidget();
    return widget ? widget->window() : nullptr;
}

void ManagedWindow::ActivateWindow(bool activate)
{
    SetWindowActivated(activate);
    if (activate) {
        if (QWidget* top = GetTopWindow())
            top->activateWindow();
    }
}

bool ManagedWindow::IsWindowActivated()
{
    return m_activated;
}

void ManagedWindow::SetWindowActivated(bool activated)
{
    m_activated = activated;
}

void ManagedWindow::SelectWindow()
{
    if (m_decorator) {
        m_decorator->SelectWindow();
        return;
    }
    if (QWidget* top = GetTopWindow()) {
        top->raise();
        top->activateWindow();
    }
    SetWindowActivated(true);
}

void ManagedWindow::CloseWindow()
{
    if (DecorationManager* manager = DecorationManager::Instance())
        manager->Undecorate(this);
    m_decorator = nullptr;
    if (QWidget* top = GetTopWindow())
        top->hide();
}

void ManagedWindow::SelectAndShow()
{
    SetWindowVisible(true);
    SelectWindow();
}

void ManagedWindow::SetWindowVisible(bool visible)
{
    if (QWidget* top = GetTopWindow())
        top->setVisible(visible);
}

bool ManagedWindow::IsGrowBoxIconDrawnByDecorator()
{
    return m_decorator != nullptr;
}

void ManagedWindow::UpdateSizeLimits() {}

bool ManagedWindow::ZoomEvent()
{
    return false;
}

bool ManagedWindow::GrowEvent(SInt32, SInt32, SInt32, SInt32)
{
    return false;
}

void ManagedWindow::SetInResizeState(bool) {}

void ManagedWindow::SetInHighlightState(bool) {}

void ManagedWindow::InstallManagedWindowHasMovedHandler(MovedHandler handler, void* context)
{
    m_movedHandler = handler;
    m_movedContext = context;
}

void ManagedWindow::InformHandlerManagedWindowHasMoved()
{
    if (m_movedHandler)
        m_movedHandler(this, m_movedContext);
}

bool ManagedWindow::AcceptDropOnWindowTab(Qt::KeyboardModifiers)
{
    return false;
}

QPoint ManagedWindow::ReferenceOrigin() const
{
    return m_decorator ? m_decorator->ReferenceOrigin() : QPoint(0, 0);
}

QRect ManagedWindow::ContentGeometry()
{
    if (m_decorator)
        return m_decorator->ContentGeometry();
    QWidget* widget = GetWidget();
    if (!widget)
        return QRect();
    if (widget->isWindow())
        return widget->geometry(); // a top-level's geometry is its client area, global
    return QRect(widget->mapToGlobal(QPoint(0, 0)), widget->size());
}

QRect ManagedWindow::FrameGeometry()
{
    if (m_decorator)
        return m_decorator->FrameGeometry();
    QWidget* top = GetTopWindow();
    return top ? top->frameGeometry() : QRect();
}

void ManagedWindow::SetContentGeometry(const QRect& content)
{
    if (m_decorator) {
        m_decorator->SetContentGeometry(content);
        InformHandlerManagedWindowHasMoved();
        return;
    }
    QWidget* widget = GetWidget();
    if (!widget)
        return;
    if (widget->isWindow()) {
        widget->setGeometry(content);
    } else {
        widget->resize(content.size());
        if (QWidget* top = GetTopWindow())
            top->move(top->pos() + (content.topLeft() - ContentGeometry().topLeft()));
    }
    InformHandlerManagedWindowHasMoved();
}

void ManagedWindow::SetFrameGeometry(const QRect& frame)
{
    if (m_decorator) {
        m_decorator->SetFrameGeometry(frame);
        InformHandlerManagedWindowHasMoved();
        return;
    }
    QWidget* top = GetTopWindow();
    if (!top)
        return;
    // The window system's frame keeps its margins; the client area takes the rest.
    const QRect outer = top->frameGeometry();
    const QRect inner = top->geometry();
    top->setGeometry(frame.adjusted(inner.left() - outer.left(), inner.top() - outer.top(),
                                    inner.right() - outer.right(), inner.bottom() - outer.bottom()));
    InformHandlerManagedWindowHasMoved();
}

bool ManagedWindow::IsCurrentlyVisible()
{
    QWidget* top = GetTopWindow();
    return top && top->isVisible() && !top->isMinimized();
}

} // namespace Velmar::Brindle
