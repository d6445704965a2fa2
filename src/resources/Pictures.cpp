// Pictures: 'PICT' PNGs as heap images (RT_QIMAGE), DrawPicture and picture bounds.
#include <Velmar/QDIcons.h>
#include <Velmar/QtGrafPort.h>

#include "foundation/Conversions.h"
#include "resources/ImageCache.h"
#include "resources/ResourceAccess.h"

#include <QPainter>
#include <QtGlobal>

namespace Velmar {

using namespace Private;

namespace Private {

QImage* newPicture(const QImage& image)
{
    auto* picture = new QImage(image);
    LiveHandles<QImage>::instance().add(picture);
    return picture;
}

void freePicture(QImage* picture)
{
    LiveHandles<QImage>::instance().remove(picture);
    delete picture;
}

ResourceHandle loadPicture(SInt16 id)
{
    const QString path = QStringLiteral(":/images/PICT_%1.png").arg(id);
    const QImage image = resourceFileExists(path) ? cachedPictureImage(path) : QImage();
    return ResourceHandle(newPicture(image), RT_QIMAGE);
}

} // namespace Private

void DrawPicture(ResourceHandle picture, const Rect* rect)
{
    const UInt32 type = picture.getType();
    if (type == RT_HANDLE || type == RT_PICHANDLE) {
        qWarning("Velmar::DrawPicture: Resource handle has type RT_HANDLE or RT_PICHANDLE, "
                 "which should not happen in USE_BRINDLE version");
        return;
    }
    if (type != RT_QIMAGE) {
        qWarning("Velmar::DrawPicture: Unknown picture type");
        return;
    }
    QImage* image = resourceImage(picture);
    if (!image)
        qWarning("Velmar::DrawPicture: RT_QIMAGE handle contains NULL QImage");
    else if (!VELMAR_CHECK_RESOURCE(image))
        return;
    MakeQPainter painter("DrawPicture");
    if (!painter)
        return;
    const QRect target = toQRect(rect);
    // A missing picture stays blank.
    if (image && !image->isNull()) {
        // Pictures keep their own transparency whatever the pen mode.
        const QPainter::CompositionMode mode = painter->compositionMode();
        painter->setCompositionMode(QPainter::CompositionMode_SourceOver);
        painter->drawImage(target, *image);
        painter->setCompositionMode(mode);
    }
    // Marked even when nothing was drawn: the host expects the area to be repainted.
    painter |= target;
}

Rect* QDGetPictureBounds(ResourceHandle picture, Rect* bounds)
{
    if (!bounds)
        return bounds;
    *bounds = Rect{0, 0, 0, 0};
    auto* image = static_cast<QImage*>(picture.data());
    if (picture.getType() == RT_QIMAGE && VELMAR_CHECK_RESOURCE(image))
        *bounds = toRect(image->rect());
    return bounds;
}

} // namespace Velmar
