// srcCopy without tinting, the copy nearly every host makes: the words, made opaque.
#include "quickdraw/TransferModes.h"

#if (defined(__GNUC__) || defined(__clang__)) && defined(__x86_64__)
#define VELMAR_WIDE_COPY 1
#include <immintrin.h>
#else
#define VELMAR_WIDE_COPY 0
#endif

namespace Velmar::Private {

namespace {

constexpr QRgb kOpaque = 0xFF000000u;

// The common copy has to keep up with a plain memcpy of the row, which uses the widest
// stores the processor has: narrow stores run out of store buffer long before the cache
// is busy. So the word loop comes in the widest variant the processor supports, chosen once.
#if VELMAR_WIDE_COPY
__attribute__((target("avx512f"))) void opaqueWords512(const QRgb* src, QRgb* dst, int count)
{
    int i = 0;
    const __m512i opaque = _mm512_set1_epi32(int(kOpaque));
    for (; i + 16 <= count; i += 16)
        _mm512_storeu_si512(dst + i, _mm512_or_si512(_mm512_loadu_si512(src + i), opaque));
    for (; i < count; ++i)
        dst[i] = src[i] | kOpaque;
}

__attribute__((target("avx2"))) void opaqueWords256(const QRgb* src, QRgb* dst, int count)
{
    int i = 0;
    const __m256i opaque = _mm256_set1_epi32(int(kOpaque));
    for (; i + 8 <= count; i += 8) {
        const __m256i words = _mm256_loadu_si256(reinterpret_cast<const __m256i*>(src + i));
        _mm256_storeu_si256(reinterpret_cast<__m256i*>(dst + i), _mm256_or_si256(words, opaque));
    }
    for (; i < count; ++i)
        dst[i] = src[i] | kOpaque;
}
#endif

void opaqueWords(const QRgb* src, QRgb* dst, int count)
{
    for (int i = 0; i < count; ++i)
        dst[i] = src[i] | kOpaque;
}

using WordLoop = void (*)(const QRgb*, QRgb*, int);

WordLoop widestOpaqueWords()
{
#if VELMAR_WIDE_COPY
    if (__builtin_cpu_supports("avx512f"))
        return opaqueWords512;
    if (__builtin_cpu_supports("avx2"))
        return opaqueWords256;
#endif
    return opaqueWords;
}

} // namespace

void copyRowOpaque(const QRgb* src, QRgb* dst, int count, const TransferInk&)
{
    static const WordLoop loop = widestOpaqueWords();
    loop(src, dst, count);
}

} // namespace Velmar::Private
