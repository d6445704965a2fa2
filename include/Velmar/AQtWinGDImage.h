// An image whose pixels a native drawing context can reach as well: on Windows a DIB
// section with a memory device context; elsewhere a plain QImage without one.
#pragma once

#include <Velmar/MacTypes.h>

#include <QImage>
#include <QSize>

namespace Velmar {

class VELMAR_EXPORT AQtWinGDImage : public QImage {
public:
    // 32 bits a pixel, or 16 (5-6-5) for QImage::Format_RGB16.
    AQtWinGDImage(const QSize& size, QImage::Format format);
    // The memory device context for native drawing calls; null off Windows.
    void* getDC() const;
};

} // namespace Velmar
