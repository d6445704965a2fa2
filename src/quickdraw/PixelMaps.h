// What a copy call's map argument stands for once checked: an image, where its top-left
// pixel lies in local coordinates, and the port it belongs to, if any.
#pragma once

#include <Velmar/QDBitmaps.h>
#include <Velmar/QtGrafPort.h>

#include <QImage>

namespace Velmar::Private {

struct PixelMap {
    QImage* image = nullptr;
    QPoint origin;
    QtGrafPort* port = nullptr;
    PixMapPtr* pixmap = nullptr;
    QImage wrapped; // pixels the map holds itself: a BitMap's memory seen in place, or a detached copy

    QRect localRect() const { return image ? QRect(origin, image->size()) : QRect(); }
    QPoint toImage(const QPoint& local) const { return local - origin; }
};

// True for a pixmap the library made and has not freed (never reads `p` otherwise).
bool isLivePixMap(const void* p);

// Resolves `view`. Null, stale and malformed maps give false with a log line naming `call`;
// a live map without pixels (a direct-drawing window's port) gives true with a null image
// and its port set, so the caller can draw through the port's painter instead.
bool resolvePixelMap(const BitMapView& view, PixelMap* out, const char* call);

// The 32-bit formats whose words the copy calls read and write directly.
inline bool isWordFormat(QImage::Format f)
{
    return f == QImage::Format_ARGB32_Premultiplied || f == QImage::Format_ARGB32
        || f == QImage::Format_RGB32;
}

} // namespace Velmar::Private
