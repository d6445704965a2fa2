// Process-wide port machinery: the current port, the registry of live ports and the
// hooks through which a port reaches its window.
#pragma once

#include <Velmar/QtGrafPort.h>

#include <vector>

class QImage;

namespace Velmar::Private {

// The current port. Read on every drawing call, so it is a plain global.
extern QtGrafPort* gCurrentGrafPort;

inline QtGrafPort* currentGrafPort()
{
    return gCurrentGrafPort;
}

// True when `port` is a live port of this process (registered and carrying the live magic).
// Never dereferences a pointer that is not registered.
bool isLivePort(const QtGrafPort* port);

// What a port needs from its window. The window layer installs these once; while a hook is
// null the port behaves as an offscreen world would. Rectangles are in device (widget)
// coordinates.
struct PortWindowHooks {
    // A drawing call touched `deviceRect` of the window's back buffer.
    void (*markDirty)(AQtWindow* window, const QRect& deviceRect) = nullptr;
    // The window's widget is painted only inside paint events (no back buffer).
    bool (*isDirectDrawing)(AQtWindow* window) = nullptr;
    // A direct-drawing window scrolls itself; `update` receives the uncovered area.
    void (*scrollRect)(AQtWindow* window, const QRect& rect, int dh, int dv, QRegion* update) =
        nullptr;
    // The port of the front-most visible window other than `except`, or null.
    QtGrafPort* (*frontVisiblePortExcept)(AQtWindow* except) = nullptr;
    // The widget's visible region when drawing is limited to it; false to use the bounds.
    bool (*visibleRegion)(AQtWindow* window, QRegion* out) = nullptr;
    // Local (widget) to global screen coordinates and back.
    QPoint (*mapToGlobal)(AQtWindow* window, const QPoint& local) = nullptr;
    QPoint (*mapFromGlobal)(AQtWindow* window, const QPoint& global) = nullptr;
    // Copy the dirty area to the screen now.
    void (*flush)(AQtWindow* window) = nullptr;
    // A new back buffer of `size` after a resize (GDI-backed where the window wants one);
    // null falls back to a plain premultiplied ARGB image.
    QImage* (*makeBackBuffer)(AQtWindow* window, const QSize& size) = nullptr;
};

void setPortWindowHooks(const PortWindowHooks& hooks);
const PortWindowHooks& portWindowHooks();

// Ports whose painter is active, oldest first; at most kMaxActivePainters.
inline constexpr int kMaxActivePainters = 50;
int activePainterCount();
bool isPainterListed(const QtGrafPort* port);

// Logs a fixed "warning: X: Can't get current port !" style message in the QuickDraw
// category.
void warnNoPort(const char* message);

// The global hilite colour every new port copies.
QColor globalHiliteColor();

// Live ports in creation order (for inspection).
const std::vector<QtGrafPort*>& livePorts();
void registerPort(QtGrafPort* port);
void unregisterPort(QtGrafPort* port);

// The largest image a port allocates (pixels). Larger worlds keep their bounds but get no
// image: drawing into them does nothing.
inline constexpr qint64 kMaxPortPixels = qint64(64) * 1024 * 1024;

} // namespace Velmar::Private
