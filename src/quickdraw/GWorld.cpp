// Offscreen worlds, bare ports, and the bounds and origin calls.
#include <Velmar/Diagnostics.h>
#include <Velmar/QtGrafPort.h>

#include "foundation/Conversions.h"
#include "quickdraw/GrafPortPrivate.h"

namespace Velmar {

using namespace Private;

namespace {

// The world rectangle a Toolbox rectangle asks for; a depth of 0 also moves it to (0, 0).
QRect worldRect(const Rect* bounds, SInt16 depth)
{
    QRect rect = toQRect(bounds);
    if (depth == 0)
        rect.moveTopLeft(QPoint(0, 0));
    return rect;
}

// A static, imageless bitmap for copy calls given no port.
const BitMapPtr& emptyBitMap()
{
    static PixMapPtr* sEmpty = PixMapPtr::createPixMap(nullptr, nullptr, 0);
    return *sEmpty;
}

} // namespace

SInt16 NewGWorld(GrafPtr* out, SInt16 depth, const Rect* bounds, void* /*colorTable*/,
                 void* /*device*/, UInt32 /*flags*/)
{
    QRect rect = worldRect(bounds, depth);
    if (rect.width() == 0 && rect.height() == 0) {
        rect.setWidth(1);
        rect.setHeight(1);
    }
    if (rect.width() < 1 || rect.height() < 1)
        VelmarLog(kLogGrafPort, "NewGWorld: empty bounds %dx%d made at least one pixel",
                  rect.width(), rect.height());
    if (!out) {
        VelmarLog(kLogGrafPort, "NewGWorld: no place to store the world");
        return 0;
    }
    *out = new QtGrafPort(rect, depth ? depth : 6);
    return 0;
}

SInt16 NewGWorldForPaintDevice(GrafPtr* out, SInt16 depth, const Rect* bounds, void* colorTable,
                               void* device, UInt32 flags, QPaintDevice* paintDevice)
{
    const SInt16 result = NewGWorld(out, depth, bounds, colorTable, device, flags);
    if (out && *out)
        (*out)->paintDevice = paintDevice;
    return result;
}

UInt32 UpdateGWorld(GrafPtr* gw, SInt16 depth, const Rect* bounds, void* /*colorTable*/,
                    void* /*device*/, UInt32 /*flags*/)
{
    if (!gw || !isLivePort(*gw)) {
        velmar_assert("gw && IsValidPort(*gw)", __FILE__, __LINE__, __func__,
                      "UpdateGWorld needs a live world");
        return 0;
    }
    const QRect rect = worldRect(bounds, depth);
    QtGrafPort* port = *gw;
    const bool same = rect == port->bounds;
    port->setBounds(rect);
    return same ? UInt32(0) : UInt32(reallocPix);
}

void DisposeGWorld(GrafPtr offscreenGWorld)
{
    // A stale pointer is never dereferenced: liveness is checked first.
    const bool live = isLivePort(offscreenGWorld);
    if (!offscreenGWorld || (live && offscreenGWorld->window)) {
        velmar_assert("offscreenGWorld != NULL && offscreenGWorld->window == NULL", __FILE__,
                      __LINE__, __func__, "DisposeGWorld needs an offscreen world");
        return;
    }
    if (!live) {
        VelmarLog(kLogGrafPort, "DisposeGWorld: %p is not a live world",
                  static_cast<void*>(offscreenGWorld));
        return;
    }
    delete offscreenGWorld;
}

GrafPtr CreateNewPort()
{
    return new QtGrafPort(QRect(0, 0, 1, 1), 6);
}

void DisposePort(GrafPtr port)
{
    if (isLivePort(port) && !port->window)
        delete port;
}

QPaintDevice* GetGWorldPaintDevice(GrafPtr* port)
{
    return (port && isLivePort(*port)) ? (*port)->paintDevice : nullptr;
}

PixMapPtr* GetPortPixMap(GrafPtr port)
{
    if (!port) {
        velmar_assert("port != NULL", __FILE__, __LINE__, __func__, "GetPortPixMap");
        return nullptr;
    }
    return port->pixmap;
}

PixMapPtr* GetGWorldPixMap(GrafPtr port)
{
    return GetPortPixMap(port);
}

const BitMapPtr& GetPortBitMapForCopyBits(GrafPtr port)
{
    if (!port) {
        velmar_assert("port != NULL", __FILE__, __LINE__, __func__, "GetPortBitMapForCopyBits");
        return emptyBitMap();
    }
    return *port->pixmap;
}

Rect* GetPortBounds(GrafPtr port, Rect* rect)
{
    if (!rect)
        return rect;
    if (!port)
        *rect = makeRect(0, 0, 0, 0);
    else
        *rect = toRect(port->bounds);
    return rect;
}

void SetPortBounds(GrafPtr port, const Rect* rect)
{
    if (!port)
        return;
    port->setBounds(toQRect(rect));
}

void PortSize(SInt16 width, SInt16 height)
{
    QtGrafPort* port = gCurrentGrafPort;
    if (!port) {
        VelmarLog(kLogQuickDraw, "PortSize: current port is NULL");
        return;
    }
    port->setBounds(QRect(port->bounds.topLeft(), QSize(width, height)));
}

void SetOrigin(SInt16 h, SInt16 v)
{
    QtGrafPort* port = gCurrentGrafPort;
    if (!port) {
        VelmarLog(kLogQuickDraw, "SetOrigin: currentGrafPort = NULL");
        return;
    }
    port->setOrigin(h, v);
}

} // namespace Velmar
