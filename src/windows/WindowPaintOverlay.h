// A debugging overlay drawn over a window's finished paint (the inspector's outlines of the
// update, dirty, visible and clip areas). Unset, the paint event spends nothing on it.
#pragma once

#include <Velmar/AQtWindow.h>

#include <QRect>
#include <QRegion>

class QPainter;

namespace Velmar::Private {

// What the window held when its paint event began, in widget coordinates: the paint
// consumes the update region and clears the dirty rectangle before the overlay runs.
struct PaintOverlayInput {
    QRegion updateRegion;
    QRect dirtyRect;
};

// Draws on `painter`, which is active on the window's widget in widget coordinates with
// clipping off; the window saves and restores the painter around the call.
using PaintOverlayHook = void (*)(AQtWindow* window, QPainter& painter,
                                  const PaintOverlayInput& input);

PaintOverlayHook paintOverlayHook();
// Null removes the overlay. Returns the hook it replaces.
PaintOverlayHook SetPaintOverlayHook(PaintOverlayHook hook);

} // namespace Velmar::Private
