#include "host/MacEncodingIcu.h"

#include <unicode/ucnv.h>
#include <unicode/ucnv_err.h>
#include <unicode/ustring.h>

#include <algorithm>
#include <atomic>
#include <mutex>
#include <string>
#include <vector>

namespace Velmar::Private::MacEncodingIcu {

namespace {

// The selected name is process-wide; each thread converts with its own cached converter
// (an ICU converter carries state and must not be shared), reopened when the name changes.
struct Selection {
    std::mutex mutex;
    std::string name = kDefaultEncoding;
    std::atomic<int> generation{0};
};

Selection& selection()
{
    static Selection s;
    return s;
}

// Notes every character that had no mapping, then writes the substitution byte as usual.
void noteLoss(const void* context, UConverterFromUnicodeArgs* args, const UChar* units,
              int32_t length, UChar32 codePoint, UConverterCallbackReason reason, UErrorCode* err)
{
    if (reason == UCNV_UNASSIGNED || reason == UCNV_ILLEGAL || reason == UCNV_IRREGULAR)
        *static_cast<bool*>(const_cast<void*>(context)) = true;
    UCNV_FROM_U_CALLBACK_SUBSTITUTE(nullptr, args, units, length, codePoint, reason, err);
}

UConverter* openConverter(const char* name, bool* lossFlag)
{
    UErrorCode err = U_ZERO_ERROR;
    UConverter* cnv = ucnv_open(name, &err);
    if (U_FAILURE(err) || !cnv)
        return nullptr;
    err = U_ZERO_ERROR;
    ucnv_setSubstChars(cnv, "?", 1, &err);
    err = U_ZERO_ERROR;
    ucnv_setFromUCallBack(cnv, noteLoss, lossFlag, nullptr, nullptr, &err);
    return cnv;
}

// Toolbox text is NUL-terminated and ASCII-based: refuse anything else (UTF-16, EBCDIC,
// ISO-2022 and the like), or Pascal strings and C strings would stop making sense.
bool isAsciiCompatible(UConverter* cnv)
{
    if (ucnv_getMinCharSize(cnv) != 1)
        return false;
    static const char16_t probe[] = u"AZaz09 .\n";
    static const char expected[] = "AZaz09 .\n";
    char out[32] = {};
    UErrorCode err = U_ZERO_ERROR;
    const int32_t n = ucnv_fromUChars(cnv, out, sizeof out, probe, -1, &err);
    return U_SUCCESS(err) && n == int32_t(sizeof expected - 1)
        && std::string(out, n) == expected;
}

class CachedConverter {
public:
    CachedConverter() = default;
    CachedConverter(const CachedConverter&) = delete;
    CachedConverter& operator=(const CachedConverter&) = delete;
    ~CachedConverter()
    {
        if (m_cnv)
            ucnv_close(m_cnv);
    }

    UConverter* get()
    {
        Selection& s = selection();
        const int generation = s.generation.load(std::memory_order_acquire);
        if (m_cnv && generation == m_generation)
            return m_cnv;
        if (m_cnv)
            ucnv_close(m_cnv);
        std::string name;
        {
            std::lock_guard<std::mutex> lock(s.mutex);
            name = s.name;
        }
        m_cnv = openConverter(name.c_str(), &m_lost);
        m_generation = generation;
        return m_cnv;
    }

    bool m_lost = false; // set by noteLoss during a conversion

private:
    UConverter* m_cnv = nullptr;
    int m_generation = -1;
};

CachedConverter& cache()
{
    static thread_local CachedConverter c;
    return c;
}

// Writes the longest prefix of the conversion that ends on a character boundary and leaves
// room for the terminator. Only reached when the text does not fit, so it may allocate.
SInt32 writeCut(UConverter* cnv, const UChar* src, int32_t srcUnits, int32_t needed, char* dst,
                int32_t dstBytes)
{
    std::vector<char> bytes(size_t(needed) + 1);
    std::vector<int32_t> offsets(size_t(needed) + 1);
    ucnv_resetFromUnicode(cnv);
    char* target = bytes.data();
    const UChar* source = src;
    UErrorCode err = U_ZERO_ERROR;
    ucnv_fromUnicode(cnv, &target, bytes.data() + bytes.size(), &source, src + srcUnits,
                     offsets.data(), true, &err);
    const int32_t produced = int32_t(target - bytes.data());
    // Every byte of one character carries that character's source offset.
    int32_t cut = std::min(dstBytes - 1, produced);
    while (cut > 0 && cut < produced && offsets[size_t(cut)] == offsets[size_t(cut) - 1])
        --cut;
    std::copy(bytes.data(), bytes.data() + cut, dst);
    dst[cut] = '\0';
    return cut;
}

} // namespace

bool select(const char* requested)
{
    const char* name = (requested && *requested) ? requested : kDefaultEncoding;
    bool ignored = false;
    UConverter* probe = openConverter(name, &ignored);
    if (!probe)
        return false;
    const bool usable = isAsciiCompatible(probe);
    ucnv_close(probe);
    if (!usable)
        return false;
    Selection& s = selection();
    {
        std::lock_guard<std::mutex> lock(s.mutex);
        s.name = name;
    }
    s.generation.fetch_add(1, std::memory_order_release);
    return true;
}

const char* name()
{
    Selection& s = selection();
    std::lock_guard<std::mutex> lock(s.mutex);
    return s.name.c_str();
}

SInt32 toUTF16(const char* src, int srcBytes, unsigned short* dst, int dstUnits)
{
    if (!dst || dstUnits < 0)
        dstUnits = 0;
    if (dstUnits == 0)
        dst = nullptr;
    else
        dst[0] = 0;
    if (!src || srcBytes == 0)
        return 0;
    UConverter* cnv = cache().get();
    if (!cnv)
        return 0;
    UErrorCode err = U_ZERO_ERROR;
    const int32_t needed = ucnv_toUChars(cnv, reinterpret_cast<UChar*>(dst), dstUnits, src,
                                         srcBytes < 0 ? -1 : srcBytes, &err);
    if (U_FAILURE(err) && err != U_BUFFER_OVERFLOW_ERROR)
        return 0;
    return needed;
}

SInt32 fromUTF16(const unsigned short* src, SInt32 srcUnits, char* dst, SInt32 dstBytes,
                 bool* lossy)
{
    bool dummy = false;
    bool& lost = lossy ? *lossy : dummy;
    lost = false;
    if (!dst || dstBytes <= 0) {
        lost = src && srcUnits != 0 && (srcUnits > 0 || src[0] != 0);
        return 0;
    }
    dst[0] = '\0';
    if (!src || srcUnits == 0)
        return 0;
    const UChar* text = reinterpret_cast<const UChar*>(src);
    if (srcUnits < 0)
        srcUnits = u_strlen(text);
    CachedConverter& c = cache();
    UConverter* cnv = c.get();
    if (!cnv)
        return 0;
    c.m_lost = false;
    UErrorCode err = U_ZERO_ERROR;
    const int32_t needed = ucnv_fromUChars(cnv, dst, dstBytes, text, srcUnits, &err);
    if (U_FAILURE(err) && err != U_BUFFER_OVERFLOW_ERROR) {
        dst[0] = '\0';
        lost = true;
        return 0;
    }
    if (needed < dstBytes) {
        lost = c.m_lost;
        return needed;
    }
    const SInt32 written = writeCut(cnv, text, srcUnits, needed, dst, dstBytes);
    lost = true;
    return written;
}

} // namespace Velmar::Private::MacEncodingIcu
