// The core library's handle calls for pixmaps: nothing moves, so nothing is locked.
#include <Velmar/QtGrafPort.h>
#include <Velmar/Resources.h>

#include "foundation/LiveHandles.h"

#include <QImage>

namespace Velmar {

Boolean TxHLock(PixMapPtr*)
{
    return 1;
}

void TxHUnLock(PixMapPtr*, Boolean)
{}

PixMapPtr* TxCopyHand(PixMapPtr* pixmap)
{
    if (!pixmap || !VELMAR_LIVE(pixmap, "IsValidPixMap(pixmap)"))
        return nullptr;
    const QImage* image = pixmap->image();
    PixMapPtr* copy = PixMapPtr::createOwnedPixMap(nullptr, pixmap->pixelDepth());
    copy->replaceImage(image ? new QImage(image->copy()) : nullptr, pixmap->origin());
    return copy;
}

} // namespace Velmar
