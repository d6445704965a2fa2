// The exported encoding pair: the host's own converter when it installed one, ICU otherwise.
#include <Velmar/HostEncoding.h>

#include "host/MacEncodingAscii.h"
#include "host/MacEncodingIcu.h"

#include <algorithm>
#include <string>

namespace Velmar {

namespace {

struct HostConverter {
    MacEncodingConverter functions{};
    std::string name;
    bool active = false;
};

HostConverter& hostConverter()
{
    static HostConverter h;
    return h;
}

} // namespace

SInt32 CurrentMacMBCSEncodingToUTF16(
    const char* src, int srcBytes, unsigned short* dst, int dstUnits)
{
    const HostConverter& h = hostConverter();
    if (h.active)
        return h.functions.toUTF16(src, srcBytes, dst, dstUnits);
    return Private::MacEncodingIcu::toUTF16(src, srcBytes, dst, dstUnits);
}

SInt32 UTF16ToCurrentMacMBCSEncoding(
    const unsigned short* src, SInt32 srcUnits, char* dst, SInt32 dstBytes, bool* lossy)
{
    const HostConverter& h = hostConverter();
    if (h.active)
        return h.functions.fromUTF16(src, srcUnits, dst, dstBytes, lossy);
    return Private::MacEncodingIcu::fromUTF16(src, srcUnits, dst, dstBytes, lossy);
}

bool SetCurrentMacEncoding(const char* name)
{
    const bool selected = Private::MacEncodingIcu::select(name);
    if (selected)
        Private::encodingChanged();
    return selected;
}

const char* CurrentMacEncodingName()
{
    const HostConverter& h = hostConverter();
    if (h.active)
        return h.name.c_str();
    return Private::MacEncodingIcu::name();
}

void SetMacEncodingConverter(const MacEncodingConverter* converter)
{
    HostConverter& h = hostConverter();
    h.active = converter && converter->toUTF16 && converter->fromUTF16;
    h.functions = h.active ? *converter : MacEncodingConverter{};
    h.name = h.active && converter->name ? converter->name : (h.active ? "host" : "");
    Private::encodingChanged();
}

namespace Private {

namespace {

// -1: not known yet for the current encoding.
int gAsciiIdentity = -1;

bool checkAscii()
{
    char bytes[128];
    for (int i = 1; i < 128; ++i)
        bytes[i - 1] = char(i);
    unsigned short units[128] = {};
    if (CurrentMacMBCSEncodingToUTF16(bytes, 127, units, 128) != 127)
        return false;
    for (int i = 0; i < 127; ++i)
        if (units[i] != i + 1)
            return false;
    char back[128] = {};
    bool lossy = false;
    return UTF16ToCurrentMacMBCSEncoding(units, 127, back, 128, &lossy) == 127 && !lossy
        && std::equal(bytes, bytes + 127, back);
}

} // namespace

bool asciiPassesUnchanged()
{
    if (gAsciiIdentity < 0)
        gAsciiIdentity = checkAscii() ? 1 : 0;
    return gAsciiIdentity == 1;
}

qsizetype asciiToHostBytes(QStringView text, char* out, qsizetype capacity)
{
    if (!asciiPassesUnchanged())
        return -1;
    const qsizetype nul = text.indexOf(QChar(0));
    const QStringView kept = nul >= 0 ? text.left(nul) : text;
    if (!QtPrivate::isAscii(kept))
        return -1;
    const qsizetype count = std::min(kept.size(), capacity);
    const char16_t* units = kept.utf16();
    for (qsizetype i = 0; i < count; ++i)
        out[i] = char(units[i]);
    return count;
}

// Checked at once, so that conversions never pay for it.
void encodingChanged()
{
    gAsciiIdentity = checkAscii() ? 1 : 0;
}

} // namespace Private

} // namespace Velmar
