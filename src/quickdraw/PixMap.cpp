// The pixmap and bitmap objects around a port's image.
#include <Velmar/QtGrafPort.h>

#include <QImage>

namespace Velmar {

PixMapPtr* PixMapPtr::createPixMap(QImage* image, QtGrafPort* port, SInt16 pixelDepth)
{
    return new PixMapPtr(image, port, pixelDepth);
}

void PixMapPtr::destroyPixMap(PixMapPtr* pixmap)
{
    delete pixmap;
}

void BitMapPtr::clear() const
{
    if (!m_image || !m_port)
        return;
    m_image->fill(m_port->window ? m_port->contentColor : m_port->backColor);
}

} // namespace Velmar
