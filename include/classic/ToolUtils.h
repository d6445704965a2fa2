/* Toolbox utilities: words of a long, bit operations, strings and patterns from resources. */
#ifndef VELMAR_CLASSIC_TOOLUTILS_H
#define VELMAR_CLASSIC_TOOLUTILS_H
#include "Types.h"
VELMAR_CLASSIC_BEGIN

VELMAR_CLASSIC_API short HiWord(long x);
VELMAR_CLASSIC_API short LoWord(long x);
VELMAR_CLASSIC_API long BitAnd(long a, long b);
VELMAR_CLASSIC_API long BitOr(long a, long b);
VELMAR_CLASSIC_API long BitXor(long a, long b);
VELMAR_CLASSIC_API long BitNot(long a);
VELMAR_CLASSIC_API long BitShift(long value, short count);
/* Bit n counts from the most significant bit of the byte at bytePtr, as the Toolbox did. */
VELMAR_CLASSIC_API Boolean BitTst(const void* bytePtr, long bitNum);
VELMAR_CLASSIC_API void BitSet(void* bytePtr, long bitNum);
VELMAR_CLASSIC_API void BitClr(void* bytePtr, long bitNum);
VELMAR_CLASSIC_API StringHandle GetString(short stringID);
VELMAR_CLASSIC_API void GetIndString(Str255 theString, short strListID, short index);
VELMAR_CLASSIC_API StringHandle NewString(ConstStr255Param theString);
VELMAR_CLASSIC_API void SetString(StringHandle h, ConstStr255Param theString);
VELMAR_CLASSIC_API Fixed FixRatio(short numer, short denom);
VELMAR_CLASSIC_API Fixed FixMul(Fixed a, Fixed b);
VELMAR_CLASSIC_API short FixRound(Fixed x);

VELMAR_CLASSIC_END
#endif
