// Meeting the desktop: a "Drag me" box in the Fonts and Icons window whose text can be
// dragged into the Notes window or out to other applications, boxes that show theme cursors
// and tool tips, and drops of text into the Notes window.
#pragma once

#include <Velmar/Velmar.h>

namespace Demo {

void installDesktop(Velmar::WindowRef fontsWindow, Velmar::WindowRef notesWindow);
// Draws the boxes into the Fonts and Icons window (its port is current).
void drawDesktopBoxes();
// A mouse-down in the Fonts and Icons window: true when it started a drag.
bool dragFromBox(Velmar::WindowRef window, const Velmar::EventRecord& e);
// Idle time: the cursor and tool tip follow the mouse.
void trackMouse();

} // namespace Demo
