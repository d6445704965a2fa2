#include "quickdraw/ShapeLog.h"

#include <Velmar/Diagnostics.h>

namespace Velmar::Private {

// Warnings of the shape and region calls belong to the QuickDraw log category.
void shapeWarning(const char* text)
{
    VelmarLog(kLogQuickDraw, "%s", text);
}

} // namespace Velmar::Private
