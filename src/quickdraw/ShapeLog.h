// The one place where the shape and region calls write their warnings.
#pragma once

namespace Velmar::Private {

// Writes a finished warning line ("warning: FrameRect: cannot get current port").
void shapeWarning(const char* text);

} // namespace Velmar::Private
