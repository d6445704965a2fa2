// The built-in Macintosh encoding conversion, on ICU converters.
#pragma once

#include <Velmar/MacTypes.h>

namespace Velmar::Private::MacEncodingIcu {

inline constexpr const char* kDefaultEncoding = "macintosh"; // Mac OS Roman

// Opens name to check it; on success it becomes the encoding of every later conversion.
bool select(const char* name);
const char* name();

// Same contracts as the exported pair in <Velmar/HostEncoding.h>.
SInt32 toUTF16(const char* src, int srcBytes, unsigned short* dst, int dstUnits);
SInt32 fromUTF16(const unsigned short* src, SInt32 srcUnits, char* dst, SInt32 dstBytes,
                 bool* lossy);

} // namespace Velmar::Private::MacEncodingIcu
