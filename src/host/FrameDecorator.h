// The default UI shell's own frame: a plain top-level widget that draws a title bar and a
// border around a managed window's widget and lets the user move it by the title bar. Used
// when the application asks for decorated windows; otherwise the window system frames them.
#pragma once

#include <Velmar/HostShell.h>

#include <QPointer>
#include <QWidget>

namespace Velmar::Brindle {

class FrameWidget;

class FrameDecorator : public Decorator {
public:
    static constexpr int kBorder = 4;
    static constexpr int kTitleHeight = 20;

    explicit FrameDecorator(ManagedWindow* window);
    ~FrameDecorator() override;

    QPoint ReferenceOrigin() const override;
    QRect FrameGeometry() const override;
    QRect ContentGeometry() const override;
    void SetFrameGeometry(const QRect& frame) override;
    void SetContentGeometry(const QRect& content) override;
    void MoveContent(const QPoint& topLeft) override;
    void SetContentSize(const QSize& size) override;
    void SetTitle(const QString& title) override;
    void SelectWindow() override;

    QWidget* frame() const;
    // Where the content sits inside the frame, and how much larger the frame is.
    static QPoint contentOffset() { return QPoint(kBorder, kTitleHeight + kBorder); }
    static QSize frameExtra() { return QSize(2 * kBorder, kTitleHeight + 2 * kBorder); }

private:
    QPointer<QWidget> m_content;
    QPointer<FrameWidget> m_frame;
};

} // namespace Velmar::Brindle
