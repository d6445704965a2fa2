// The paint-debugging switches: outlines of a window's update region, dirty area, visible
// region and clip region, drawn over every paint while their switch is on.
#pragma once

#include <QRgb>

namespace Velmar::Private::Inspector {

enum PaintOutline : unsigned {
    kOutlineUpdate = 1u << 0,
    kOutlineDirty = 1u << 1,
    kOutlineVisible = 1u << 2,
    kOutlineClip = 1u << 3,
};

bool paintOutlineOn(PaintOutline outline);
// Installs the windows' paint overlay while any outline is on and removes it with the last
// one, then repaints the windows so that the change shows at once.
void setPaintOutline(PaintOutline outline, bool on);
// The colour each outline is drawn in.
QRgb paintOutlineColor(PaintOutline outline);

} // namespace Velmar::Private::Inspector
