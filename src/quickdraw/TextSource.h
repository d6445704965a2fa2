// Reading the text a measuring or drawing call was given.
#pragma once

#include <QString>

namespace Velmar::Private {

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
