/* Text utilities: numbers and dates as text, string comparison. */
#ifndef VELMAR_CLASSIC_TEXTUTILS_H
#define VELMAR_CLASSIC_TEXTUTILS_H
#include "Types.h"
VELMAR_CLASSIC_BEGIN

enum { shortDate = 0, longDate = 1, abbrevDate = 2 };

VELMAR_CLASSIC_API void NumToString(long theNum, Str255 theString);
VELMAR_CLASSIC_API void StringToNum(ConstStr255Param theString, long* theNum);
VELMAR_CLASSIC_API void IUDateString(unsigned long dateTime, short longFlag, Str255 result);
VELMAR_CLASSIC_API void IUTimeString(unsigned long dateTime, Boolean wantSeconds, Str255 result);
VELMAR_CLASSIC_API Boolean EqualString(ConstStr255Param a, ConstStr255Param b, Boolean caseSens,
                                       Boolean diacSens);
VELMAR_CLASSIC_API short RelString(ConstStr255Param a, ConstStr255Param b, Boolean caseSens,
                                   Boolean diacSens);
VELMAR_CLASSIC_API void UpperString(Str255 theString, Boolean diacSens);
VELMAR_CLASSIC_API StringPtr c2pstr(char* s);
VELMAR_CLASSIC_API char* p2cstr(StringPtr s);
VELMAR_CLASSIC_API void CopyPascalStringToC(ConstStr255Param src, char* dst);
VELMAR_CLASSIC_API void CopyCStringToPascal(const char* src, Str255 dst);

#define DateString(t, f, r, h) IUDateString((t), (f), (r))
#define TimeString(t, s, r, h) IUTimeString((t), (s), (r))
#define CtoPstr c2pstr
#define PtoCstr p2cstr

VELMAR_CLASSIC_END
#endif
