// Cursor pictures from the resource tree: the library's own and the host's, by kind and ID.
#include "cursors/CursorPrivate.h"

#include <QGuiApplication>
#include <QImage>
#include <QPixmap>

namespace Velmar::Private {

namespace {

// The hot spot is the picture's centre whatever the picture: the Toolbox's own hot spot is
// not kept with the PNGs, so pictures put their point there.
QCursor centredCursor(const QImage& image, qreal devicePixelRatio)
{
    QPixmap pixmap = QPixmap::fromImage(image);
    pixmap.setDevicePixelRatio(devicePixelRatio);
    return QCursor(pixmap, -1, -1);
}

} // namespace

QCursor loadCursorPicture(QLatin1String prefix, SInt16 id, qreal devicePixelRatio)
{
    // Pixmaps need the application: an ID asked for before it exists stays the arrow.
    if (!qGuiApp)
        return cursorTable().defaultCursor;
    // The host's picture first; the library ships its own for a few IDs, in a tree of its
    // own, so that a host's picture always wins.
    const QString name = QStringLiteral("%1_%2").arg(prefix).arg(UInt16(id));
    for (const char* tree : {":/images/cursors/", ":/velmar/cursors/"}) {
        const QString base = QLatin1String(tree) + name;
        if (devicePixelRatio > 1) {
            const QImage doubled(base + QStringLiteral("@2x.png"));
            if (!doubled.isNull())
                return centredCursor(doubled, 2);
        }
        const QImage image(base + QStringLiteral(".png"));
        if (!image.isNull())
            return centredCursor(image, 1);
    }
    return cursorTable().defaultCursor;
}

} // namespace Velmar::Private
