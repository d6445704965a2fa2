// QuickDraw regions.
#pragma once

#include <Velmar/QDTypes.h>

namespace Velmar {

// A region (RgnHandle) is a heap-allocated QRegion in the local coordinates of the port it is
// used in, owned by whoever called NewRgn and freed by DisposeRgn.

// Lifetime and content.
VELMAR_EXPORT RgnHandle NewRgn();
VELMAR_EXPORT void DisposeRgn(RgnHandle rgn);
VELMAR_EXPORT void CopyRgn(RgnHandle src, RgnHandle dst);
VELMAR_EXPORT void SetEmptyRgn(RgnHandle rgn);
VELMAR_EXPORT void RectRgn(RgnHandle rgn, const Rect* r);
VELMAR_EXPORT void SetRectRgn(RgnHandle rgn, short left, short top, short right, short bottom);

// Recording: between OpenRgn and CloseRgn the frame calls and MoveTo/LineTo build the region.
VELMAR_EXPORT void OpenRgn();
VELMAR_EXPORT void CloseRgn(RgnHandle dst);

// Arithmetic. A null destination does nothing; a null source leaves the destination as it was.
VELMAR_EXPORT void UnionRgn(RgnHandle a, RgnHandle b, RgnHandle dst);
VELMAR_EXPORT void SectRgn(RgnHandle a, RgnHandle b, RgnHandle dst);
VELMAR_EXPORT void DiffRgn(RgnHandle a, RgnHandle b, RgnHandle dst);
VELMAR_EXPORT void XorRgn(RgnHandle a, RgnHandle b, RgnHandle dst);
VELMAR_EXPORT void OffsetRgn(RgnHandle rgn, short dh, short dv);
VELMAR_EXPORT void InsetRgn(RgnHandle rgn, short dh, short dv);
VELMAR_EXPORT void MapRgn(RgnHandle rgn, const Rect* src, const Rect* dst);

// Tests.
VELMAR_EXPORT unsigned char PtInRgn(Point pt, RgnHandle rgn);
VELMAR_EXPORT unsigned char RectInRgn(const Rect* r, RgnHandle rgn);
VELMAR_EXPORT unsigned char EqualRgn(RgnHandle a, RgnHandle b);
VELMAR_EXPORT unsigned char EmptyRgn(RgnHandle rgn);
VELMAR_EXPORT Rect* GetRegionBounds(RgnHandle rgn, Rect* bounds);

// Drawing on the current port.
VELMAR_EXPORT void PaintRgn(RgnHandle rgn);
VELMAR_EXPORT void EraseRgn(RgnHandle rgn);
VELMAR_EXPORT void FillRgn(RgnHandle rgn, const PatPtr& pattern);
VELMAR_EXPORT void FrameRgn(RgnHandle rgn);
VELMAR_EXPORT void InvertRgn(RgnHandle rgn);
VELMAR_EXPORT void StdRgn(SInt16 verb, RgnHandle rgn);

// The current port's clip.
VELMAR_EXPORT void GetClip(RgnHandle rgn);
VELMAR_EXPORT void SetClip(RgnHandle rgn);
VELMAR_EXPORT void ClipRect(const Rect* r);

// The desktop: the available geometry of every screen. The region belongs to the library.
VELMAR_EXPORT RgnHandle GetGrayRgn();

// Axis constraints for dragging a region's outline.
enum : SInt16 {
    noConstraint = 0,
    hAxisOnly = 1,
    vAxisOnly = 2,
};

// Closes and discards a region still being defined on the current port when the scope ends,
// so that an early return or an exception never leaves the port recording.
class VELMAR_EXPORT CleanupOpenRgn {
public:
    CleanupOpenRgn() = default;
    ~CleanupOpenRgn();
    CleanupOpenRgn(const CleanupOpenRgn&) = delete;
    CleanupOpenRgn& operator=(const CleanupOpenRgn&) = delete;
};

} // namespace Velmar
