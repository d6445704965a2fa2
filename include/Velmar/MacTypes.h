// Toolbox scalar and value types. Defined once here; every other header builds on them.
#pragma once

#include <Velmar/VelmarExport.h>

#include <cstdint>

class QColor;

// Rect and Point keep their Toolbox form as plain global structures so that host code
// declared against the Toolbox headers links unchanged.
struct Rect {
    std::int16_t top;
    std::int16_t left;
    std::int16_t bottom;
    std::int16_t right;
};

struct Point {
    std::int16_t v;
    std::int16_t h;
};

namespace Velmar {

using SInt8 = std::int8_t;
using SInt16 = std::int16_t;
using SInt32 = std::int32_t; // a Toolbox "long": 32 bits on every platform
using SInt64 = std::int64_t;
using UInt8 = std::uint8_t;
using UInt16 = std::uint16_t;
using UInt32 = std::uint32_t; // a Toolbox "unsigned long"
using UInt64 = std::uint64_t;

using Boolean = unsigned char;
using OSErr = SInt16;
using OSStatus = SInt32;
using FourCharCode = UInt32;
using OSType = FourCharCode;
using ResType = FourCharCode;
using Size = SInt32;

using Ptr = char*;
using Handle = Ptr*;

using Str255 = unsigned char[256];
using Str63 = unsigned char[64];
using Str32 = unsigned char[33];
using Str31 = unsigned char[32];
using Str27 = unsigned char[28];
using Str15 = unsigned char[16];
using StringPtr = unsigned char*;
using ConstStringPtr = const unsigned char*;
using ConstStr255Param = const unsigned char*;
using ConstStr63Param = const unsigned char*;
using ConstStr31Param = const unsigned char*;

using RectPtr = Rect*;

// Builds a four-character code at compile time: FOUR_CHAR_CODE("TEXT").
constexpr FourCharCode FOUR_CHAR_CODE(const char (&s)[5])
{
    return (FourCharCode(UInt8(s[0])) << 24) | (FourCharCode(UInt8(s[1])) << 16)
         | (FourCharCode(UInt8(s[2])) << 8) | FourCharCode(UInt8(s[3]));
}

// Sixteen bits a channel, 65535 full intensity.
struct VELMAR_EXPORT RGBColor {
    unsigned short red;
    unsigned short green;
    unsigned short blue;

    RGBColor() : red(0), green(0), blue(0) {}
    RGBColor(unsigned short r, unsigned short g, unsigned short b) : red(r), green(g), blue(b) {}
    RGBColor(const RGBColor& other) = default;
    RGBColor& operator=(const RGBColor& other) = default;
    RGBColor(const QColor& c);     // NOLINT: implicit like the Toolbox helpers it replaces
    RGBColor(unsigned int argb);   // NOLINT

    void set(const QColor& c);
    void set(unsigned int argb);

    operator QColor() const;
    operator unsigned int() const;
};

using RGBColorPtr = RGBColor*;

// 65535.0 / 255 kept in single precision: every 8-bit <-> 16-bit channel conversion uses it.
VELMAR_EXPORT extern const float kChannelScale;

} // namespace Velmar
