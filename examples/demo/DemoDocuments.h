// The shape documents: windows drawn with QuickDraw shapes, regions and patterns, a shape
// the user drags (DragGrayRgn), a grow box, and an idle animation.
#pragma once

#include <Velmar/Velmar.h>

namespace Demo {

Velmar::WindowRef openDocument(Velmar::SInt16 procID, Velmar::SInt16 top, Velmar::SInt16 left,
    const char* title, const Velmar::RGBColor& paper);
// A floating palette or a dialog drawn like a document, with a shape of its own.
void adoptAsDocument(Velmar::WindowRef window, const Velmar::RGBColor& paper, const Rect& shape);
bool isDocument(Velmar::WindowRef window);
void forgetDocument(Velmar::WindowRef window);
void drawDocument(Velmar::WindowRef window, bool active);
void animate(Velmar::WindowRef window);
// A click in a document's content: grow box or shape drag.
void clickDocument(
    Velmar::WindowRef window, const Velmar::EventRecord& e, Velmar::WindowPartCode part);

} // namespace Demo
