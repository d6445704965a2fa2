// The one copy the CopyBits family shares: checked maps, scaled and clipped destination
// pixels, a transfer mode per row, an optional mask map, an optional single field.
#pragma once

#include <Velmar/QDBitmaps.h>

namespace Velmar::Private {

struct CopyJob {
    const char* call;
    BitMapView src;
    BitMapView dst;
    const Rect* srcRect;
    const Rect* dstRect;
    SInt16 mode;
    RgnHandle maskRgn;
    // A mask map, used only when hasMask.
    bool hasMask = false;
    BitMapView mask = nullptr;
    const Rect* maskRect = nullptr;
    // -1: every row; 0 or 1: only destination rows of that parity from dstRect's top.
    int field = -1;
    // Show the changed pixels of a window at once.
    bool toScreen = false;
};

void runCopy(const CopyJob& job);

} // namespace Velmar::Private
