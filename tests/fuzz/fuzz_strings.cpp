// Pascal strings and multi-byte text: conversions in both directions, in the default and in
// multi-byte encodings, and the Toolbox string calls, on arbitrary bytes.
#include "FuzzSupport.h"

#include <Velmar/HostEncoding.h>
#include <Velmar/TextUtils.h>

using namespace Velmar;
using VelmarFuzz::Bytes;

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    VelmarFuzz::ensureApplication();
    Bytes in(data, size);
    static const char* const kEncodings[] = {
        "macintosh", "Shift_JIS", "x-mac-cyrillic", "x-mac-greek"};
    SetCurrentMacEncoding(kEncodings[in.u8() % 4]);

    unsigned char a[256] = {}, b[256] = {};
    a[0] = uint8_t(in.take(a + 1, in.u8()));
    b[0] = uint8_t(in.take(b + 1, in.u8()));

    // Bytes to UTF-16: measuring and converting agree, and nothing is written past the buffer.
    unsigned short units[300];
    const SInt32 needed =
        CurrentMacMBCSEncodingToUTF16(reinterpret_cast<const char*>(a + 1), a[0], nullptr, 0);
    FUZZ_CHECK(needed >= 0 && needed <= 255 * 2);
    const int room = in.u8() % 300;
    units[room < 300 ? room : 299] = 0xBEEF;
    const SInt32 got =
        CurrentMacMBCSEncodingToUTF16(reinterpret_cast<const char*>(a + 1), a[0], units, room);
    FUZZ_CHECK(got == needed);

    // And back, into buffers of every small size: always terminated, never overrun.
    char bytes[600];
    const SInt32 dst = SInt32(in.u8()) + 1;
    bytes[dst] = 0x5A;
    bool lossy = false;
    const SInt32 written =
        UTF16ToCurrentMacMBCSEncoding(units, qMin(got, SInt32(room)), bytes, dst, &lossy);
    FUZZ_CHECK(written >= 0 && written < dst && bytes[written] == 0 && bytes[dst] == 0x5A);

    // Pascal strings through QString and back stay within 255 bytes.
    const QString text = PascalString2QString(a);
    unsigned char back[256];
    back[0] = 0;
    QString2PascalString(text, back);
    FUZZ_CHECK(back[0] <= 255);
    if (QString(CurrentMacEncodingName()) == QLatin1String("macintosh")) {
        // A single-byte encoding with no holes maps every byte one to one, up to the first
        // NUL, which ends the text.
        const auto* nul = static_cast<const unsigned char*>(std::memchr(a + 1, 0, a[0]));
        const size_t kept = nul ? size_t(nul - (a + 1)) : a[0];
        FUZZ_CHECK(back[0] == kept && std::memcmp(back + 1, a + 1, kept) == 0);
    }

    // The string calls agree with each other.
    const bool equal = EqualString(a, b, true, true);
    FUZZ_CHECK(equal == (RelString(a, b, true, true) == 0));
    FUZZ_CHECK(EqualString(a, a, in.u8() & 1, true));
    SInt32 number = 0;
    StringToNum(a, &number);
    unsigned char digits[256];
    NumToString(number, digits);
    SInt32 again = 0;
    StringToNum(digits, &again);
    FUZZ_CHECK(again == number);
    MakeQString(reinterpret_cast<const char*>(a + 1), a[0]);
    IdenticalText(a + 1, b + 1, SInt16(a[0]), SInt16(b[0]), nullptr);
    SetCurrentMacEncoding(nullptr);
    return 0;
}
