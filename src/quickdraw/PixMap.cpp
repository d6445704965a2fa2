// The pixmap and bitmap objects around a port's image or an image of their own.
#include <Velmar/QtGrafPort.h>

#include "foundation/LiveHandles.h"

#include <QImage>

namespace Velmar {

using namespace Private;

PixMapPtr* PixMapPtr::createPixMap(QImage* image, QtGrafPort* port, SInt16 pixelDepth)
{
    auto* pixmap = new PixMapPtr(image, port, pixelDepth, false);
    LiveHandles<PixMapPtr>::instance().add(pixmap);
    return pixmap;
}

PixMapPtr* PixMapPtr::createOwnedPixMap(QImage* image, SInt16 pixelDepth)
{
    auto* pixmap = new PixMapPtr(image, nullptr, pixelDepth, true);
    LiveHandles<PixMapPtr>::instance().add(pixmap);
    return pixmap;
}

void PixMapPtr::destroyPixMap(PixMapPtr* pixmap)
{
    if (!pixmap)
        return;
    LiveHandles<PixMapPtr>::instance().remove(pixmap);
    if (pixmap->m_ownsImage)
        delete pixmap->m_image;
    delete pixmap;
}

QPoint PixMapPtr::origin() const
{
    return m_port ? m_port->origin() : m_origin;
}

void PixMapPtr::replaceImage(QImage* image, const QPoint& origin)
{
    if (!m_ownsImage)
        return;
    delete m_image;
    m_image = image;
    m_origin = origin;
}

void BitMapPtr::clear() const
{
    if (!m_image || !m_port)
        return;
    m_image->fill(m_port->window ? m_port->contentColor : m_port->backColor);
}

} // namespace Velmar
