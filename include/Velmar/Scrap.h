// The Scrap Manager over the system clipboard: one scrap, the clipboard itself, and text only.
// Text crosses in the host's Macintosh encoding; a clipboard without text is noTypeErr.
#pragma once

#include <Velmar/MacTypes.h>

namespace Velmar {

struct OpaqueScrapRef;
using ScrapRef = OpaqueScrapRef*;
using ScrapFlavorType = FourCharCode;
using ScrapFlavorFlags = UInt32;

enum : ScrapFlavorType {
    kScrapFlavorTypeText = FOUR_CHAR_CODE("TEXT"),
    kScrapFlavorTypePicture = FOUR_CHAR_CODE("PICT"),
};

enum : ScrapFlavorFlags {
    kScrapFlavorMaskNone = 0,
};

// Calls given no size, no data or nothing to put answer this (callers test for non-zero).
constexpr OSStatus kScrapMissingArgument = 1;

// Stores null: the library keeps no scrap object, and ignores the one it is given.
VELMAR_EXPORT OSStatus GetCurrentScrap(ScrapRef* scrap);
VELMAR_EXPORT OSStatus ClearCurrentScrap();
// Only 'TEXT' is served; a picture flavour ends the process (it was never supported).
VELMAR_EXPORT OSStatus GetScrapFlavorSize(ScrapRef scrap, ScrapFlavorType flavorType, SInt32* size);
VELMAR_EXPORT OSStatus GetScrapFlavorFlags(
    ScrapRef scrap, ScrapFlavorType flavorType, ScrapFlavorFlags* flags);
VELMAR_EXPORT OSStatus PutScrapFlavor(ScrapRef scrap, ScrapFlavorType flavorType,
    ScrapFlavorFlags flavorFlags, SInt32 size, const void* data);
// Copies at most *size bytes of the text (no terminating zero) and stores how many.
VELMAR_EXPORT OSStatus GetScrapFlavorData(
    ScrapRef scrap, ScrapFlavorType flavorType, SInt32* size, void* data);

} // namespace Velmar
