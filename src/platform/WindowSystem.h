// Which window system Qt runs on, from its platform plugin's name. Off Windows the platform
// layer picks its backend from this at run time: the X11 backend only when Qt talks to an
// X server ("xcb"), the Wayland one under a compositor, and state tracked from Qt's own
// events for everything else (offscreen, minimal, no application yet).
#pragma once

#include <QString>

namespace Velmar::Private::Platform {

enum class WindowSystem { None, X11, Wayland, Windows, Other };

// The window system for a Qt platform name ("xcb", "wayland", "wayland-egl", "offscreen" ...).
WindowSystem windowSystemForPlatformName(const QString& platformName);
// The running application's; None before a QGuiApplication exists. Cheap after the first
// call: Qt cannot change its plugin while the application lives.
WindowSystem windowSystem();

} // namespace Velmar::Private::Platform
