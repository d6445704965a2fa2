// The rules that turn a Toolbox font ID, pixel size and face into a QFont.
#pragma once

#include <Velmar/MacTypes.h>

#include <QFont>

namespace Velmar::Private {

// Family and style hint of `id`; with `appFont`, the host's configured application font
// replaces whatever ID was asked for. Returns the ID whose row was used.
SInt16 applyFontFamily(QFont& font, SInt16 id, bool appFont);
// Pixel size to points (x 0.75); 0 takes the application font's size, and with `appFont`
// the standard sizes take the host's configured ones.
void applyFontSize(QFont& font, SInt16 size, bool appFont);
// Face bits: bold, italic, underline, outline, condense (shadow and extend do nothing).
void applyFontFace(QFont& font, SInt16 face);

} // namespace Velmar::Private
