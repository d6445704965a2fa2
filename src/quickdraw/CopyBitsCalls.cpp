// The CopyBits family as hosts call it; each is one job for the copy engine.
#include <Velmar/QDBitmaps.h>

#include "quickdraw/CopyEngine.h"

namespace Velmar {

using namespace Private;

namespace {

void copyThroughMask(const char* call, BitMapView src, BitMapView mask, BitMapView dst,
                     const Rect* srcRect, const Rect* maskRect, const Rect* dstRect, SInt16 mode,
                     RgnHandle maskRgn)
{
    CopyJob job{call, src, dst, srcRect, dstRect, mode, maskRgn};
    job.hasMask = true;
    job.mask = mask;
    job.maskRect = maskRect;
    runCopy(job);
}

} // namespace

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
    copyThroughMask("CopyDeepMask", src, mask, dst, srcRect, maskRect, dstRect, mode, maskRgn);
}

void CopyMask(BitMapView src, BitMapView mask, BitMapView dst, const Rect* srcRect,
              const Rect* maskRect, const Rect* dstRect)
{
    copyThroughMask("CopyMask", src, mask, dst, srcRect, maskRect, dstRect, srcCopy, nullptr);
}

} // namespace Velmar
