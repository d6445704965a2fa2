// The CopyBits family as hosts call it; each is one job for the copy engine.
#include <Velmar/QDBitmaps.h>

#include "quickdraw/CopyEngine.h"

namespace Velmar {

using namespace Private;

void CopyBits(BitMapView src, BitMapView dst, const Rect* srcRect, const Rect* dstRect,
              SInt16 mode, RgnHandle maskRgn)
{
    runCopy({"CopyBits", src, dst, srcRect, dstRect, mode, maskRgn});
}

void CopyBitsToScreen(BitMapView src, BitMapView dst, const Rect* srcRect, const Rect* dstRect,
                      SInt16 mode, RgnHandle maskRgn)
{
    CopyJob job{"CopyBitsToScreen", src, dst, srcRect, dstRect, mode, maskRgn};
    job.toScreen = true;
    runCopy(job);
}

void CopyOneField(BitMapView src, BitMapView dst, const Rect* srcRect, const Rect* dstRect,
                  SInt16 mode, RgnHandle maskRgn, SInt16 field)
{
    CopyJob job{"CopyOneField", src, dst, srcRect, dstRect, mode, maskRgn};
    job.field = field & 1;
    runCopy(job);
}

void CopyDeepMask(BitMapView src, BitMapView mask, BitMapView dst, const Rect* srcRect,
                  const Rect* maskRect, const Rect* dstRect, SInt16 mode, RgnHandle maskRgn)
{
    CopyJob job{"CopyDeepMask", src, dst, srcRect, dstRect, mode, maskRgn};
    job.hasMask = true;
    job.mask = mask;
    job.maskRect = maskRect;
    runCopy(job);
}

void CopyMask(BitMapView src, BitMapView mask, BitMapView dst, const Rect* srcRect,
              const Rect* maskRect, const Rect* dstRect)
{
    CopyJob job{"CopyMask", src, dst, srcRect, dstRect, srcCopy, nullptr};
    job.hasMask = true;
    job.mask = mask;
    job.maskRect = maskRect;
    runCopy(job);
}

} // namespace Velmar
