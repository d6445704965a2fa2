// The "Fonts & Icons" window: text in several fonts, sizes and faces, a sample line in the
// font, size, style and colour the menus choose, icons and a picture from the demo's own
// resource file, and a pop-up menu for the sample's colour.
#pragma once

#include <Velmar/Velmar.h>

namespace Demo {

struct TextSample {
    Velmar::SInt16 font = Velmar::geneva;
    Velmar::SInt16 size = 18;
    Velmar::SInt16 face = Velmar::normal;
    Velmar::RGBColor colour;
};
TextSample& textSample();

Velmar::WindowRef openTextWindow();
bool isTextWindow(Velmar::WindowRef window);
void drawTextWindow(Velmar::WindowRef window);
// A click in the window: the colour pop-up. True when it was handled.
bool clickTextWindow(Velmar::WindowRef window, Point where);
// Redraw after the sample changed.
void invalidateTextWindow();

} // namespace Demo
