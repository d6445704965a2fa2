// Reading the text a measuring or drawing call was given.
#pragma once

#include <Velmar/MacTypes.h>

#include <QString>

namespace Velmar::Private {

// Bytes first .. first + count - 1 of the host's text in its encoding; empty for null text
// or no count.
QString bytesText(const void* text, SInt16 first, SInt16 count);

// A character code as text: a value above 255 is a two-byte character, high byte first.
QString charText(SInt16 ch);

// False, with a warning naming `call`, when first or count is negative.
bool validRange(int first, int count, const char* call);

// Units first .. first + count - 1 of a zero-terminated UTF-16 buffer, reading no further
// than its terminator and never past first + count. Arguments must not be negative.
inline QString boundedUtf16(const unsigned short* text, int first, int count)
{
    const qsizetype end = qsizetype(first) + count;
    qsizetype length = 0;
    while (length < end && text[length] != 0)
        ++length;
    if (length <= first)
        return QString();
    return QString(reinterpret_cast<const QChar*>(text + first), length - first);
}

} // namespace Velmar::Private
