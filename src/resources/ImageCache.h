// The process-wide image caches of icon and picture PNGs, keyed by resource path. Filled on
// first use, never emptied: every icon or picture made from a PNG shares its pixels.
#pragma once

#include <QImage>
#include <QString>

namespace Velmar::Private {

// True when the resource tree has a file (not a folder) at `path`.
bool resourceFileExists(const QString& path);

// The image at `path`, loaded once.
QImage cachedIconImage(const QString& path);
QImage cachedPictureImage(const QString& path);

} // namespace Velmar::Private
