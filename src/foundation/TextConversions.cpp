// QString <-> Macintosh-encoded text, through the host's encoding pair.
#include <Velmar/TextUtils.h>

#include <Velmar/HostEncoding.h>

#include "host/MacEncodingAscii.h"

#include <QVarLengthArray>

#include <algorithm>
#include <cstring>

namespace Velmar {

QString MakeQString(const char* text, SInt32 length)
{
    if (!text)
        return QString();
    const size_t n = length < 0 ? std::strlen(text) : size_t(length);
    if (n == 0)
        return QString();
    if (n > size_t(INT32_MAX) - 1)
        return QString();
    // Pure ASCII in an encoding that keeps ASCII: Qt's vectorised Latin-1 route. An embedded
    // NUL ends the text, as the conversion below would end it.
    if (Private::asciiPassesUnchanged()) {
        const void* nul = std::memchr(text, 0, n);
        const qsizetype length = nul ? static_cast<const char*>(nul) - text : qsizetype(n);
        if (QtPrivate::isAscii(QLatin1StringView(text, length)))
            return length ? QString::fromLatin1(text, length) : QString();
    }

    // Grow until the whole conversion fits; one spare unit keeps the buffer terminated.
    // Pascal strings (the common case, drawn on every DrawString) fit on the stack.
    QVarLengthArray<unsigned short, 256 + 1> buffer(qsizetype(n) + 1);
    for (;;) {
        std::fill(buffer.begin(), buffer.end(), 0);
        const SInt32 needed =
            CurrentMacMBCSEncodingToUTF16(text, int(n), buffer.data(), int(buffer.size()));
        if (needed < SInt32(buffer.size()))
            break;
        if (needed >= INT32_MAX)
            return QString();
        buffer.resize(qsizetype(needed) + 1);
    }
    // An embedded NUL converts to a 0 unit and ends the text.
    return QString::fromUtf16(reinterpret_cast<const char16_t*>(buffer.data()));
}

QByteArray MakeLocal8Bit(const QString& s)
{
    if (Private::asciiPassesUnchanged()) {
        QByteArray bytes(s.size() + 1, Qt::Uninitialized);
        const qsizetype length = Private::asciiToHostBytes(s, bytes.data(), s.size());
        if (length >= 0) {
            bytes.truncate(length + 1);
            bytes[length] = '\0'; // part of the array, as below
            return bytes;
        }
    }
    const qsizetype length = s.size();
    const qsizetype capacity = (length + 1) * 4;
    if (capacity > INT32_MAX) // beyond what the 32-bit conversion call can describe
        return QByteArray(1, '\0');
    QByteArray bytes(capacity, '\0');
    bool lossy = false;
    UTF16ToCurrentMacMBCSEncoding(reinterpret_cast<const unsigned short*>(s.utf16()),
        SInt32(length), bytes.data(), SInt32(capacity), &lossy);
    // Keep the text and its terminating NUL, deliberately part of the array.
    bytes.truncate(qstrnlen(bytes.constData(), size_t(capacity - 1)) + 1);
    return bytes;
}

QString PascalString2QString(const unsigned char* p)
{
    if (!p || p[0] == 0)
        return QString();
    return MakeQString(reinterpret_cast<const char*>(p + 1), p[0]);
}

void QString2PascalString(QString s, unsigned char* p)
{
    if (!p)
        return;
    const QByteArray bytes = MakeLocal8Bit(s);
    const size_t count = std::min<size_t>(qstrnlen(bytes.constData(), size_t(bytes.size())), 255);
    p[0] = static_cast<unsigned char>(count);
    std::memcpy(p + 1, bytes.constData(), count);
}

QString FourCharToString(UInt32 code)
{
    QString out(4, QLatin1Char(' '));
    for (int i = 0; i < 4; ++i) {
        const QChar c = QLatin1Char(static_cast<char>((code >> (8 * (3 - i))) & 0xFF));
        if (c.isPrint())
            out[i] = c;
    }
    return out;
}

QString ptrToString(const void* p)
{
    return QStringLiteral("0x")
        + QStringLiteral("%1").arg(
            quint64(reinterpret_cast<quintptr>(p)), 16, 16, QLatin1Char('0'));
}

} // namespace Velmar
