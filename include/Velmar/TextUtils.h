// Pascal-string and text utilities: conversions between Toolbox text (in the host's current
// Macintosh encoding, see <Velmar/HostEncoding.h>) and QString, and the Toolbox string calls.
#pragma once

#include <Velmar/MacTypes.h>

#include <QByteArray>
#include <QString>

namespace Velmar {

// ---------------------------------------------------------------------------------------
// Conversions

// `length` bytes of Macintosh-encoded text (negative: up to the first NUL) as a QString.
// Null text or zero length give a null QString; an embedded NUL ends the text.
VELMAR_EXPORT QString MakeQString(const char* text, SInt32 length);

// The text in the Macintosh encoding, followed by one NUL byte that is part of the array:
// size() is the text's byte count plus one.
VELMAR_EXPORT QByteArray MakeLocal8Bit(const QString& s);

// Null pointer or length byte 0 give a null QString.
VELMAR_EXPORT QString PascalString2QString(const unsigned char* p);

// Stores at most 255 bytes (cut even inside a multi-byte character); p needs 256 bytes.
VELMAR_EXPORT void QString2PascalString(QString s, unsigned char* p);

// Four Latin-1 characters, most significant byte first; unprintable bytes become spaces.
VELMAR_EXPORT QString FourCharToString(UInt32 code);

// "0x" and sixteen lower-case hexadecimal digits.
VELMAR_EXPORT QString ptrToString(const void* p);

// ---------------------------------------------------------------------------------------
// Toolbox string calls

VELMAR_EXPORT void NumToString(SInt32 n, unsigned char* out);
// Text that is not a base-10 number (surrounding letters, empty) stores 0.
VELMAR_EXPORT void StringToNum(const unsigned char* s, SInt32* out);

// Accents always count: diacSens is accepted and ignored.
VELMAR_EXPORT Boolean EqualString(const unsigned char* a, const unsigned char* b,
                                  Boolean caseSens, Boolean diacSens);
// QString::compare's own value cut to 16 bits, not clamped to -1/0/1.
VELMAR_EXPORT SInt16 RelString(const unsigned char* a, const unsigned char* b, Boolean caseSens,
                               Boolean diacSens);

// International resources are not supported: a non-null intlParam logs a warning and the
// call compares as if it were null.
VELMAR_EXPORT SInt16 CompareString(const unsigned char* a, const unsigned char* b,
                                   Handle intlParam);
// 0 when identical (case-sensitive), 1 otherwise.
VELMAR_EXPORT SInt16 IdenticalString(const unsigned char* a, const unsigned char* b,
                                     Handle intlParam);
// NUL-terminated Latin-1 texts cut to aLen / bLen characters; 0 when equal ignoring case.
VELMAR_EXPORT SInt16 IdenticalText(const void* a, const void* b, SInt16 aLen, SInt16 bLen,
                                   Handle intlParam);

// ---------------------------------------------------------------------------------------
// Miscellaneous

VELMAR_EXPORT void SysBeep(SInt16 duration); // duration ignored
VELMAR_EXPORT SInt16 GetMBarHeight();        // from the host's screen manager
VELMAR_EXPORT SInt32 EventTimeToTicks(double seconds); // truncated toward zero

} // namespace Velmar
