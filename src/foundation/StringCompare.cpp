// The Toolbox string comparisons and number <-> text calls, on QString.
#include <Velmar/TextUtils.h>

#include <Velmar/Diagnostics.h>

#include <cstring>

namespace Velmar {

namespace {

Qt::CaseSensitivity sensitivity(Boolean caseSens)
{
    return caseSens ? Qt::CaseSensitive : Qt::CaseInsensitive;
}

int comparePascal(const unsigned char* a, const unsigned char* b, Qt::CaseSensitivity cs)
{
    return PascalString2QString(a).compare(PascalString2QString(b), cs);
}

// International resources are not supported; say so once per call and carry on without.
void warnIntlParam(Handle intlParam, const char* call)
{
    if (intlParam)
        VelmarLog(kLogNotImpl, "warning: %s: using with resource handle not implemented", call);
}

// Latin-1 text up to its NUL, never read past `length` bytes; a negative length reads the
// whole NUL-terminated text.
QString latin1Prefix(const void* text, SInt16 length)
{
    if (!text)
        return QString();
    const char* chars = static_cast<const char*>(text);
    const size_t n = length < 0 ? std::strlen(chars) : qstrnlen(chars, size_t(length));
    return QString::fromLatin1(chars, qsizetype(n));
}

} // namespace

void NumToString(SInt32 n, unsigned char* out)
{
    QString2PascalString(QString::number(n), out);
}

void StringToNum(const unsigned char* s, SInt32* out)
{
    if (!out)
        return;
    bool ok = false;
    const int value = PascalString2QString(s).toInt(&ok, 10);
    *out = ok ? SInt32(value) : 0;
}

Boolean EqualString(const unsigned char* a, const unsigned char* b, Boolean caseSens,
                    Boolean /*diacSens: accents always count*/)
{
    return comparePascal(a, b, sensitivity(caseSens)) == 0 ? 1 : 0;
}

SInt16 RelString(const unsigned char* a, const unsigned char* b, Boolean caseSens,
                 Boolean /*diacSens*/)
{
    // Deliberately QString's own value, not clamped: callers only look at the sign.
    return static_cast<SInt16>(comparePascal(a, b, sensitivity(caseSens)));
}

SInt16 CompareString(const unsigned char* a, const unsigned char* b, Handle intlParam)
{
    warnIntlParam(intlParam, "CompareString");
    return static_cast<SInt16>(comparePascal(a, b, Qt::CaseSensitive));
}

SInt16 IdenticalString(const unsigned char* a, const unsigned char* b, Handle intlParam)
{
    warnIntlParam(intlParam, "IdenticalString");
    return comparePascal(a, b, Qt::CaseSensitive) == 0 ? 0 : 1;
}

SInt16 IdenticalText(const void* a, const void* b, SInt16 aLen, SInt16 bLen, Handle intlParam)
{
    warnIntlParam(intlParam, "IdenticalText");
    // Unlike IdenticalString, deliberately case-insensitive.
    return latin1Prefix(a, aLen).compare(latin1Prefix(b, bLen), Qt::CaseInsensitive) == 0
        ? 0 : 1;
}

} // namespace Velmar
