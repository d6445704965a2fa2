// Telling a drop onto another application from everything else, without the toolkit's help.
#include "drag/DragPrivate.h"

#include "platform/Platform.h"

namespace Velmar::Private {

namespace {

int gLocalDrops = 0; // drops being delivered to the library's own windows

} // namespace

void localDropStarted()
{
    ++gLocalDrops;
}

void localDropEnded()
{
    if (gLocalDrops > 0)
        --gLocalDrops;
}

// While dragging, the target asks for data only after the user let go over it; asking the
// window system for the button (not Qt, which has not seen the release the drag took) tells
// the drop from the drag.
bool droppedOutside(MimeData::Phase phase)
{
    switch (phase) {
    case MimeData::Phase::DroppedOutside: return true;
    case MimeData::Phase::Dragging: return gLocalDrops == 0 && !Platform::isSystemLeftButtonDown();
    default: return false;
    }
}

} // namespace Velmar::Private
