// Process-wide port machinery: the current port, the registry of live ports and the
// hooks through which a port reaches its window.
#pragma once

#include <Velmar/QtGrafPort.h>

#include "foundation/LiveHandles.h"

#include <QImage>

#include <memory>
#include <vector>

namespace Velmar::Private {

struct FontEntry;

// Text state a port keeps beyond its public fields: the font ID and face as the host last
// set them (-1 until then: read back from the font), how text meets what is under it, and
// the interned metrics of the font last drawn or measured with.
struct PortTextState {
    SInt16 fontId = -1;
    SInt16 face = -1;
    QPainter::CompositionMode composition = QPainter::CompositionMode_SourceOver;
    // Set only by an explicit TextMode(srcCopy): fresh ports draw text without a background.
    bool opaque = false;
    FontEntry* entry = nullptr;
    UInt32 entryGeneration = 0;
    QFont entryFont; // the font `entry` was found for
};

// A port's private record: its pixels, whether its painter runs, and the caches that spare
// repeated drawing any work. None of it is port state a host can see.
struct QtGrafPortPrivate {
    std::unique_ptr<QImage> image;
    bool painterActive = false;

    // Bumped by every ink setter and by BeginPaint/EndPaint, by RGBBackColor and the pen
    // mode: the resolved brushes below are reused while it is unchanged. Code that changes
    // the painter's pen or brush directly and leaves it changed must call inkChanged().
    UInt32 inkSerial = 0;
    void inkChanged() { ++inkSerial; }

    // Last resolved fill and background brushes, so that repeated drawing with the same
    // pattern and colours builds nothing.
    struct BrushCache {
        UInt32 serial = 0;
        bool valid = false;
        QBrush source;
        QRgb ink = 0;
        QRgb paper = 0;
        bool transparentPaper = false;
        QBrush result;
    };
    BrushCache fillCache;
    BrushCache backCache;

    // The pen as it was when HidePen hid it.
    QPen savedPen;

    // The painter's pen before the last colour change and the pen it became (the same but
    // for the colour): a host that alternates two colours gets the earlier pen back instead
    // of a newly allocated one.
    QPen penBeforeColour;
    QPen penAfterColour;

    PortTextState text;

    static QtGrafPortPrivate* get(QtGrafPort* port) { return port->d; }
    static const QtGrafPortPrivate* get(const QtGrafPort* port) { return port->d; }
};

inline QtGrafPortPrivate* portData(QtGrafPort* port)
{
    return QtGrafPortPrivate::get(port);
}

inline bool painterRuns(const QtGrafPort* port)
{
    return QtGrafPortPrivate::get(port)->painterActive;
}

// The current port. Read on every drawing call, so it is a plain global.
extern QtGrafPort* gCurrentGrafPort;

inline QtGrafPort* currentGrafPort()
{
    return gCurrentGrafPort;
}

// True when `port` is a live port of this process (registered and carrying the live magic).
// Never dereferences a pointer that is not registered.
inline bool isLivePort(const QtGrafPort* port)
{
    return isLive(port) && port->magic == QtGrafPort::kLiveMagic;
}

// The port a call was given, when it is live. Null is refused with the assertion `nullText`
// (the call's documented one, e.g. "port != NULL"), or silently when `nullText` is null (the
// call then logs its own line); a stale port with "IsValidPort(port)". Either gives false.
// The current port is live by construction and costs no lookup.
bool checkPort(const QtGrafPort* port, const char* nullText, const char* file, int line,
               const char* function);
#define VELMAR_CHECK_PORT(port, nullText)                                                  \
    ::Velmar::Private::checkPort((port), (nullText), __FILE__, __LINE__, __func__)

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

// Sets a port's clip region and puts it in force (SetPortClipRegion without the handle).
void setPortClip(QtGrafPort* port, const QRegion& region);

// Installs the window hooks; returns the ones they replace (an empty set removes them).
PortWindowHooks setPortWindowHooks(const PortWindowHooks& hooks);
const PortWindowHooks& portWindowHooks();

// Ports whose painter is active, oldest first; at most kMaxActivePainters.
inline constexpr int kMaxActivePainters = 50;
int activePainterCount();
bool isPainterListed(const QtGrafPort* port);


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
