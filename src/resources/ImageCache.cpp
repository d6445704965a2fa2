// Icon and picture image caches.
#include "resources/ImageCache.h"

#include <QFileInfo>
#include <QHash>

namespace Velmar::Private {

namespace {

// Never destroyed: icons may still be made while other statics go away at exit.
QHash<QString, QImage>& iconCache()
{
    static auto* sCache = new QHash<QString, QImage>;
    return *sCache;
}

QHash<QString, QImage>& pictureCache()
{
    static auto* sCache = new QHash<QString, QImage>;
    return *sCache;
}

QImage cached(QHash<QString, QImage>& cache, const QString& path)
{
    auto it = cache.constFind(path);
    if (it == cache.constEnd())
        it = cache.insert(path, QImage(path));
    return it.value();
}

} // namespace

bool resourceFileExists(const QString& path)
{
    return QFileInfo(path).isFile();
}

QImage cachedIconImage(const QString& path)
{
    return cached(iconCache(), path);
}

QImage cachedPictureImage(const QString& path)
{
    return cached(pictureCache(), path);
}

} // namespace Velmar::Private
