// Offscreen worlds, bare ports, and the bounds and origin calls.
#include <Velmar/Diagnostics.h>
#include <Velmar/QtGrafPort.h>

#include "foundation/Conversions.h"
#include "quickdraw/CurrentPort.h"
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
    if (!VELMAR_ASSERT(gw && isLivePort(*gw), "gw && IsValidPort(*gw)"))
        return 0;
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
    if (!VELMAR_ASSERT(offscreenGWorld && !(live && offscreenGWorld->window),
                       "offscreenGWorld != NULL && offscreenGWorld->window == NULL"))
        return;
    if (!VELMAR_ASSERT(live, "IsValidPort(offscreenGWorld)"))
        return;
    delete offscreenGWorld;
}

GrafPtr CreateNewPort()
{
    return new QtGrafPort(QRect(0, 0, 1, 1), 6);
}

void DisposePort(GrafPtr port)
{
    if (VELMAR_CHECK_PORT(port, nullptr) && !port->window)
        delete port;
}

QPaintDevice* GetGWorldPaintDevice(GrafPtr* port)
{
    return (port && VELMAR_CHECK_PORT(*port, nullptr)) ? (*port)->paintDevice : nullptr;
}

PixMapPtr* GetPortPixMap(GrafPtr port)
{
    return VELMAR_CHECK_PORT(port, "port != NULL") ? port->pixmap : nullptr;
}

PixMapPtr* GetGWorldPixMap(GrafPtr port)
{
    return GetPortPixMap(port);
}

const BitMapPtr& GetPortBitMapForCopyBits(GrafPtr port)
{
    return VELMAR_CHECK_PORT(port, "port != NULL") ? *port->pixmap : emptyBitMap();
}

Rect* GetPortBounds(GrafPtr port, Rect* rect)
{
    if (!rect)
        return rect;
    *rect = VELMAR_CHECK_PORT(port, nullptr) ? toRect(port->bounds) : makeRect(0, 0, 0, 0);
    return rect;
}

void SetPortBounds(GrafPtr port, const Rect* rect)
{
    if (VELMAR_CHECK_PORT(port, nullptr))
        port->setBounds(toQRect(rect));
}

void PortSize(SInt16 width, SInt16 height)
{
    CurrentPort port("PortSize");
    if (port)
        port->setBounds(QRect(port->bounds.topLeft(), QSize(width, height)));
}

void SetOrigin(SInt16 h, SInt16 v)
{
    CurrentPort port("SetOrigin");
    if (port)
        port->setOrigin(h, v);
}

} // namespace Velmar
