// Pixmap calls: a host's own pixmaps, and the accessors that read any pixmap. Pixels never
// move, so the locking calls only answer.
#include <Velmar/Diagnostics.h>
#include <Velmar/MacErrors.h>
#include <Velmar/QDBitmaps.h>

#include "foundation/Conversions.h"
#include "quickdraw/GrafPortPrivate.h"
#include "quickdraw/PixelMaps.h"

namespace Velmar {

using namespace Private;

namespace {

// The pixmap when it is live; a stale one raises the assertion, null is refused quietly.
PixMapPtr* livePixMap(PixMapHandle pixmap)
{
    return VELMAR_LIVE(pixmap, "IsValidPixMap(pixmap)") ? pixmap : nullptr;
}

// A pixmap's pixels: its port's when it belongs to one (they follow the port's size).
QImage* pixelsOf(PixMapPtr* pixmap)
{
    if (!pixmap)
        return nullptr;
    return pixmap->port() ? pixmap->port()->image() : pixmap->image();
}

} // namespace

PixMapHandle NewPixMap()
{
    return PixMapPtr::createOwnedPixMap(nullptr, 32);
}

OSErr SetPixBounds(PixMapHandle pixmap, const Rect* bounds)
{
    PixMapPtr* live = livePixMap(pixmap);
    if (!live || !bounds)
        return paramErr;
    if (!VELMAR_ASSERT(live->ownsImage(), "pixmap is not a port's"))
        return paramErr;
    const QRect rect = toQRect(bounds);
    if (rect.width() < 1 || rect.height() < 1) {
        live->replaceImage(nullptr, rect.topLeft());
        return noErr;
    }
    auto* image = new QImage(rect.size(), QImage::Format_ARGB32_Premultiplied);
    if (image->isNull()) {
        delete image;
        return memFullErr;
    }
    image->fill(0xFFFFFFFFu);
    live->replaceImage(image, rect.topLeft());
    return noErr;
}

void DisposePixMap(PixMapHandle pixmap)
{
    PixMapPtr* live = livePixMap(pixmap);
    if (live && VELMAR_ASSERT(live->ownsImage(), "pixmap is not a port's"))
        PixMapPtr::destroyPixMap(live);
}

Ptr GetPixBaseAddr(PixMapHandle pixmap)
{
    QImage* image = pixelsOf(livePixMap(pixmap));
    return image ? reinterpret_cast<Ptr>(image->bits()) : nullptr;
}

SInt32 GetPixRowBytes(PixMapHandle pixmap)
{
    const QImage* image = pixelsOf(livePixMap(pixmap));
    return image ? SInt32(image->bytesPerLine()) : 0;
}

Rect* GetPixBounds(PixMapHandle pixmap, Rect* bounds)
{
    if (!bounds)
        return bounds;
    PixMapPtr* live = livePixMap(pixmap);
    if (live && live->port()) {
        *bounds = toRect(live->port()->bounds);
    } else if (const QImage* image = pixelsOf(live)) {
        *bounds = toRect(QRect(live->origin(), image->size()));
    } else {
        *bounds = makeRect(0, 0, 0, 0);
    }
    return bounds;
}

SInt16 GetPixDepth(PixMapHandle pixmap)
{
    PixMapPtr* live = livePixMap(pixmap);
    if (const QImage* image = pixelsOf(live))
        return SInt16(image->depth());
    return live ? SInt16(32) : SInt16(0);
}

Boolean LockPixels(PixMapHandle)
{
    return true;
}

void UnlockPixels(PixMapHandle)
{}

GWorldFlags GetPixelsState(PixMapHandle)
{
    return 0;
}

void SetPixelsState(PixMapHandle, GWorldFlags)
{}

void AllowPurgePixels(PixMapHandle)
{}

void NoPurgePixels(PixMapHandle)
{}

} // namespace Velmar
