#include <Velmar/AQtWinGDImage.h>

#include "platform/Platform.h"

namespace Velmar {

AQtWinGDImage::AQtWinGDImage(const QSize& size, QImage::Format format)
    : QImage(Private::Platform::createWindowImage(size.width(), size.height(), format))
{
}

void* AQtWinGDImage::getDC() const
{
    return Private::Platform::windowImageDeviceContext(*this);
}

} // namespace Velmar
