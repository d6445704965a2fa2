// Checking the maps copy calls are given, before a byte of them is read.
#include "quickdraw/PixelMaps.h"

#include <Velmar/Diagnostics.h>

#include "foundation/Conversions.h"
#include "quickdraw/GrafPortPrivate.h"

namespace Velmar::Private {

namespace {

// Classic code passing a pixmap's row bytes kept flag bits in the top two bits.
constexpr int kRowBytesMask = 0x3FFF;

bool wrapBits(const BitMap& bits, PixelMap* out, const char* call)
{
    const QRect bounds = toQRect(&bits.bounds);
    const int rowBytes = bits.rowBytes & kRowBytesMask;
    if (!bits.baseAddr || bounds.width() < 1 || bounds.height() < 1
        || rowBytes * 8 < bounds.width()) {
        VelmarLog(kLogQuickDraw, "%s: BitMap %p is malformed (baseAddr %p, rowBytes %d, %dx%d)",
                  call, static_cast<const void*>(&bits), static_cast<const void*>(bits.baseAddr),
                  int(bits.rowBytes), bounds.width(), bounds.height());
        return false;
    }
    out->wrapped = QImage(reinterpret_cast<uchar*>(bits.baseAddr), bounds.width(),
                          bounds.height(), rowBytes, QImage::Format_Mono);
    // A set bit is black.
    out->wrapped.setColorTable({qRgb(255, 255, 255), qRgb(0, 0, 0)});
    out->image = &out->wrapped;
    out->origin = bounds.topLeft();
    return true;
}

} // namespace

bool isLivePixMap(const void* p)
{
    return isLive(static_cast<const PixMapPtr*>(p));
}

bool resolvePixelMap(const BitMapView& view, PixelMap* out, const char* call)
{
    if (view.bits())
        return wrapBits(*view.bits(), out, call);
    const BitMapPtr* map = view.map();
    if (!map) {
        VelmarLog(kLogQuickDraw, "%s: no map", call);
        return false;
    }
    // Every map the library hands out is a pixmap; liveness is checked on the bare address.
    if (!isLivePixMap(map)) {
        refuseStaleHandle("IsValidPixMap(map)", __FILE__, __LINE__, call);
        return false;
    }
    auto* pixmap = const_cast<PixMapPtr*>(static_cast<const PixMapPtr*>(map));
    out->pixmap = pixmap;
    out->port = pixmap->port();
    if (out->port && !isLivePort(out->port))
        return false;
    out->image = out->port ? out->port->image() : pixmap->image();
    out->origin = pixmap->origin();
    if (!out->image && !out->port) {
        VelmarLog(kLogQuickDraw, "%s: pixmap %p has no pixels", call, static_cast<void*>(pixmap));
        return false;
    }
    return true;
}

} // namespace Velmar::Private
