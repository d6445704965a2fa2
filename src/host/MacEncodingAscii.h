// Whether the current Macintosh encoding leaves ASCII as it is, so that text conversions may
// take Qt's fast Latin-1 routes for pure-ASCII text.
#pragma once

#include <QStringView>

namespace Velmar::Private {

// True when bytes 0x01-0x7F convert to the same code points and back (checked once per
// encoding: Shift_JIS, for one, may give a yen sign for 0x5C).
bool asciiPassesUnchanged();
// The host's bytes of `text` when the encoding keeps ASCII and the text is ASCII: up to the
// first NUL, at most `capacity` bytes, written to `out`. -1 (nothing written) otherwise.
qsizetype asciiToHostBytes(QStringView text, char* out, qsizetype capacity);
// Called whenever the current encoding or the host's converter changes (checks it at once).
void encodingChanged();

} // namespace Velmar::Private
