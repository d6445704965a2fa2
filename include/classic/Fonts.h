/* The Font Manager: font numbers and names. */
#ifndef VELMAR_CLASSIC_FONTS_H
#define VELMAR_CLASSIC_FONTS_H
#include "Types.h"
VELMAR_CLASSIC_BEGIN
enum {
    systemFont = 0, applFont = 1, newYork = 2, geneva = 3, monaco = 4, venice = 5, london = 6,
    athens = 7, sanFran = 8, toronto = 9, cairo = 11, losAngeles = 12, times = 20,
    helvetica = 21, courier = 22, symbol = 23, mobile = 24
};
VELMAR_CLASSIC_API void InitFonts(void);
VELMAR_CLASSIC_API void GetFNum(ConstStr255Param name, short* familyID);
VELMAR_CLASSIC_API void GetFontName(short familyID, Str255 name);
VELMAR_CLASSIC_API Boolean RealFont(short fontNum, short size);
VELMAR_CLASSIC_API void SetFScaleDisable(Boolean fscaleDisable);
VELMAR_CLASSIC_END
#endif
