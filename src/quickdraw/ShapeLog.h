// The one place where the shape and region calls write their warnings.
#pragma once

#include "quickdraw/GrafPortPrivate.h"

namespace Velmar::Private {

// Writes a finished warning line ("warning: CopyRgn: null region").
void shapeWarning(const char* text);

// True when the argument `p` is given; otherwise writes `warning` and gives false.
inline bool given(const void* p, const char* warning)
{
    if (!p)
        shapeWarning(warning);
    return p != nullptr;
}

} // namespace Velmar::Private
