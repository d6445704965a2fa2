#include "windows/WindowPorts.h"

#include <Velmar/QtGrafPort.h>

#include "platform/Platform.h"

namespace Velmar::Private {

QImage* makeBackBuffer(const QSize& size)
{
    QImage image = Platform::createWindowImage(qMax(1, size.width()), qMax(1, size.height()));
    if (image.isNull())
        return nullptr;
    return new QImage(std::move(image));
}

QtGrafPort* makeWindowPort(AQtWindow* window)
{
    const QRect rect(QPoint(0, 0), window->size().expandedTo(QSize(1, 1)));
    QImage* buffer = window->isDirectQtDrawing() ? nullptr : makeBackBuffer(rect.size());
    return new QtGrafPort(window, rect, buffer);
}

QPoint windowToGlobal(AQtWindow* window, const QPoint& widgetPoint)
{
    if (window->GetDecorator())
        return window->ReferenceOrigin() + window->ContentGeometry().topLeft() + widgetPoint;
    return window->mapToGlobal(widgetPoint);
}

QPoint globalToWindow(AQtWindow* window, const QPoint& globalPoint)
{
    if (window->GetDecorator())
        return globalPoint - window->ReferenceOrigin() - window->ContentGeometry().topLeft();
    return window->mapFromGlobal(globalPoint);
}

} // namespace Velmar::Private
