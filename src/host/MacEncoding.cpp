// The exported encoding pair: the host's own converter when it installed one, ICU otherwise.
#include <Velmar/HostEncoding.h>

#include "host/MacEncodingIcu.h"

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

SInt32 CurrentMacMBCSEncodingToUTF16(const char* src, int srcBytes, unsigned short* dst,
                                     int dstUnits)
{
    const HostConverter& h = hostConverter();
    if (h.active)
        return h.functions.toUTF16(src, srcBytes, dst, dstUnits);
    return Private::MacEncodingIcu::toUTF16(src, srcBytes, dst, dstUnits);
}

SInt32 UTF16ToCurrentMacMBCSEncoding(const unsigned short* src, SInt32 srcUnits, char* dst,
                                     SInt32 dstBytes, bool* lossy)
{
    const HostConverter& h = hostConverter();
    if (h.active)
        return h.functions.fromUTF16(src, srcUnits, dst, dstBytes, lossy);
    return Private::MacEncodingIcu::fromUTF16(src, srcUnits, dst, dstBytes, lossy);
}

bool SetCurrentMacEncoding(const char* name)
{
    return Private::MacEncodingIcu::select(name);
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
}

} // namespace Velmar
