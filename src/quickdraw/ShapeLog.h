// The one place where the shape and region calls write their warnings.
#pragma once

#include "quickdraw/GrafPortPrivate.h"

namespace Velmar::Private {

// Writes a finished warning line ("warning: FrameRect: cannot get current port").
void shapeWarning(const char* text);

// The current port, or null after writing `warning` (the call's "cannot get current port").
inline QtGrafPort* shapePort(const char* warning)
{
    QtGrafPort* port = currentGrafPort();
    if (!port)
        shapeWarning(warning);
    return port;
}

// True when the argument `p` is given; otherwise writes `warning` and gives false.
inline bool given(const void* p, const char* warning)
{
    if (!p)
        shapeWarning(warning);
    return p != nullptr;
}

} // namespace Velmar::Private
