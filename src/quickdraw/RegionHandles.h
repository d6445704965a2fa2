// Which RgnHandles are live: those NewRgn made and DisposeRgn has not freed, plus the few
// regions the library itself hands out (GetGrayRgn, the saved regions of
// SavePortVisibleRegion). Every call that takes a region checks it here first.
#pragma once

#include <Velmar/QDTypes.h>

#include "foundation/LiveHandles.h"

#include <QRegion>

namespace Velmar::Private {

inline void registerRegion(const QRegion* region)
{
    LiveHandles<QRegion>::instance().add(region);
}

inline void unregisterRegion(const QRegion* region)
{
    LiveHandles<QRegion>::instance().remove(region);
}

} // namespace Velmar::Private

// A live region: true. Null: false, silently (each call says what null means). A disposed
// or made-up handle: the assertion "IsValidRgn(rgn)", false.
#define VELMAR_CHECK_REGION(rgn) VELMAR_LIVE((rgn), "IsValidRgn(rgn)")
