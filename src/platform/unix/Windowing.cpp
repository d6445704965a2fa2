// Native windows off Windows: Qt's window ids, Qt's restacking and plain images; the
// requests only a window system can grant go to the backend Qt runs on.
#include "platform/Backends.h"
#include "platform/Platform.h"
#include "platform/WindowSystem.h"

#include <QImage>
#include <QWidget>

namespace Velmar::Private::Platform {

void* nativeWindowHandle(QWidget* window)
{
    if (!window)
        return nullptr;
    return reinterpret_cast<void*>(window->winId());
}

void placeNativeWindowBehind(QWidget* window, QWidget* behind)
{
    if (windowSystem() == WindowSystem::Wayland) {
        Wayland::placeWindowBehind(window, behind);
        return;
    }
    if (!window || window == behind)
        return;
    if (!behind) {
        window->lower();
        return;
    }
    // Qt restacks siblings; top-level windows are stacked by the window manager.
    if (!window->isWindow() && window->parentWidget() == behind->parentWidget())
        window->stackUnder(behind);
}

QImage createWindowImage(int width, int height, QImage::Format format)
{
    // Toolbox coordinates are 16-bit: nothing larger can be a window's content.
    if (width <= 0 || height <= 0 || width > 32767 || height > 32767) {
        if (width > 0 && height > 0)
            qWarning("createWindowImage: refused size %d x %d", width, height);
        return QImage();
    }
    return QImage(width, height,
                  format == QImage::Format_RGB16 ? format : QImage::Format_ARGB32_Premultiplied);
}

void* windowImageDeviceContext(const QImage&)
{
    return nullptr;
}

void reserveScreenTop(QWidget* window, int height)
{
    switch (windowSystem()) {
    case WindowSystem::X11:
        X11::reserveScreenTop(window, height);
        break;
    case WindowSystem::Wayland:
        Wayland::reserveScreenTop(window, height);
        break;
    default:
        break; // no window manager to ask
    }
}

} // namespace Velmar::Private::Platform
