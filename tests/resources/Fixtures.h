// The test resource tree that make_fixtures writes and the resource and icon tests read.
#pragma once

#include <QColor>
#include <QRect>
#include <QResource>

#include <cstring>

namespace Fixtures {

// Registers the compiled fixture tree; false when it cannot be had.
inline bool registerTree()
{
#ifdef VELMAR_RESOURCE_FIXTURES
    return QResource::registerResource(QStringLiteral(VELMAR_RESOURCE_FIXTURES));
#else
    return false;
#endif
}

// Icon family 200 has every member, family 201 only 'icl8', 'icl4' and 'SICN', family 202
// none. Each member is one flat colour of its own with a transparent corner pixel (so it is
// drawn as it is), and one pixel tells which member was drawn.
constexpr int kFullFamily = 200;
constexpr int kPartFamily = 201;
constexpr int kNoFamily = 202;

struct FamilyMember {
    const char* type;
    QRgb colour;
};
inline constexpr FamilyMember kFamily[] = {
    {"cicn", 0xFFE00000},
    {"icl8", 0xFF00A000},
    {"icl4", 0xFF0000E0},
    {"ICON", 0xFFE0E000},
    {"SICN", 0xFFE000E0},
    {"ics8", 0xFF00E0E0},
    {"ics4", 0xFF804000},
    {"ICN#", 0xFF008040},
    {"cccn", 0xFF400080},
    {"ics#", 0xFF808000},
};
inline constexpr const char* kPartFamilyTypes[] = {"icl8", "icl4", "SICN"};

inline QRgb familyColour(const char* type)
{
    for (const FamilyMember& m : kFamily)
        if (std::strcmp(m.type, type) == 0)
            return m.colour;
    return 0;
}

// Mask fixtures, ID 128, 32x32 and opaque: white with a square of ink at kSquare. 'ICN#' in
// black, 'icl8' and 'cicn' in red; 'ICON' 129 is the red one too (a colour image of a
// black-and-white type).
constexpr int kMaskId = 128;
constexpr int kColourIconId = 129;
inline const QRect kSquare(8, 8, 16, 16);
// 'ICN#' 300: blue square on full transparency (a PNG with real alpha).
constexpr int kAlphaIconId = 300;
constexpr QRgb kAlphaBlue = 0xFF0000FF;
// 'cicn' 0: solid magenta, which stop icon requests must never show.
constexpr QRgb kStopDecoy = 0xFFFF00FF;

// 'PICT' 200: 10x10, left half red, right half blue.
constexpr int kPictureId = 200;

// Plain files of the tree, by path, and their bytes.
struct DataFile {
    const char* path;
    const char* bytes;
};
inline constexpr DataFile kDataFiles[] = {
    {"TEXT/00128", "Velmar test text"},
    {"TEXT/-0005", "negative"},
    {"TEXT/notes", "notes"},
    {"icl4/00128", "raw icl4 bytes"},
};

} // namespace Fixtures
