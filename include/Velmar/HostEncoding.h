// The host's current Macintosh text encoding and its UTF-16 conversions.
//
// Pascal strings and every other Toolbox text travel in the Macintosh encoding the host has
// selected (Mac OS Roman unless told otherwise). The library converts through the pair below
// only, so a host that keeps its own encoding machinery can plug it in with
// SetMacEncodingConverter and every Toolbox call follows.
#pragma once

#include <Velmar/MacTypes.h>

namespace Velmar {

// Converts srcBytes bytes (a negative count: up to the first NUL) of the current Macintosh
// encoding to UTF-16. Writes as many units as fit into dst (dstUnits may be 0 and dst null to
// just measure), followed by a 0 unit when there is room for it, and returns the number of
// units the whole conversion needs, terminator excluded: a result >= dstUnits means the
// caller should grow its buffer to result + 1 and call again. Bytes with no mapping become
// substitution characters. Null or empty input returns 0.
VELMAR_EXPORT SInt32 CurrentMacMBCSEncodingToUTF16(const char* src, int srcBytes,
                                                   unsigned short* dst, int dstUnits);

// Converts srcUnits UTF-16 units (a negative count: up to the first 0 unit) to the current
// Macintosh encoding. Always NUL-terminates dst when dstBytes > 0 and never writes more than
// dstBytes bytes; text that does not fit is cut at a character boundary. Returns the number of
// bytes written, terminator excluded. *lossy (when not null) becomes true when a character had
// no mapping (it is written as '?') or the text was cut, false otherwise.
VELMAR_EXPORT SInt32 UTF16ToCurrentMacMBCSEncoding(const unsigned short* src, SInt32 srcUnits,
                                                   char* dst, SInt32 dstBytes, bool* lossy);

// Selects the current Macintosh encoding by converter name, for example "macintosh"
// (Mac OS Roman, the default), "x-mac-centraleurroman", "x-mac-cyrillic", "x-mac-greek",
// "x-mac-turkish" or "Shift_JIS". Any ASCII-compatible encoding the ICU data knows is
// accepted; a null or empty name restores Mac OS Roman. Returns false, keeping the current
// encoding, when the name is unknown or the encoding is not ASCII-compatible.
VELMAR_EXPORT bool SetCurrentMacEncoding(const char* name);

// The name last accepted by SetCurrentMacEncoding ("macintosh" by default), or the name of
// the installed host converter.
VELMAR_EXPORT const char* CurrentMacEncodingName();

// A host's own conversion pair, with the same contracts as the two functions above.
struct MacEncodingConverter {
    SInt32 (*toUTF16)(const char* src, int srcBytes, unsigned short* dst, int dstUnits);
    SInt32 (*fromUTF16)(const unsigned short* src, SInt32 srcUnits, char* dst, SInt32 dstBytes,
                        bool* lossy);
    const char* name; // reported by CurrentMacEncodingName; may be null
};

// Routes both conversions through the host's pair; the structure is copied. A null pointer,
// or one with either function null, restores the built-in ICU conversion.
VELMAR_EXPORT void SetMacEncodingConverter(const MacEncodingConverter* converter);

} // namespace Velmar
