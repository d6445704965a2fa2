#include "platform/WindowSystem.h"

#include <QGuiApplication>

namespace Velmar::Private::Platform {

WindowSystem windowSystemForPlatformName(const QString& platformName)
{
    if (platformName.isEmpty())
        return WindowSystem::None;
    if (platformName == QLatin1String("xcb"))
        return WindowSystem::X11;
    // "wayland", "wayland-egl", "wayland-brcm" ...: every flavour of Qt's Wayland client.
    if (platformName.startsWith(QLatin1String("wayland")))
        return WindowSystem::Wayland;
    if (platformName == QLatin1String("windows") || platformName == QLatin1String("direct2d"))
        return WindowSystem::Windows;
    return WindowSystem::Other;
}

WindowSystem windowSystem()
{
    // Keyed by the application object: a test may end one application and start another.
    static const QCoreApplication* sFor = nullptr;
    static WindowSystem sSystem = WindowSystem::None;
    const QCoreApplication* app = QCoreApplication::instance();
    if (app != sFor) {
        sFor = app;
        sSystem = qobject_cast<const QGuiApplication*>(app)
            ? windowSystemForPlatformName(QGuiApplication::platformName())
            : WindowSystem::None;
    }
    return sSystem;
}

} // namespace Velmar::Private::Platform
