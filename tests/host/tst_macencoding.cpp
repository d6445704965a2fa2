// The built-in Macintosh encoding pair: Mac OS Roman against an independent ICU conversion,
// the buffer contracts, encoding selection and the host converter hook.
#include <Velmar/HostEncoding.h>
#include <Velmar/TextUtils.h>

#include "TestSupport.h"

#include <unicode/ucnv.h>

#include <cstring>
#include <tuple>
#include <vector>

using namespace Velmar;

namespace {

// A fresh converter, independent of the library's cached one.
std::u16string icuToUnicode(const char* encoding, const std::string& bytes)
{
    UErrorCode err = U_ZERO_ERROR;
    UConverter* cnv = ucnv_open(encoding, &err);
    std::u16string out(bytes.size() * 2 + 4, u'\0');
    const int32_t n = ucnv_toUChars(cnv, out.data(), int32_t(out.size()), bytes.data(),
                                    int32_t(bytes.size()), &err);
    ucnv_close(cnv);
    out.resize(size_t(n));
    return out;
}

std::u16string toUnicode(const std::string& bytes)
{
    std::vector<unsigned short> buf(bytes.size() + 1, 0xEEEE);
    const SInt32 n = CurrentMacMBCSEncodingToUTF16(bytes.data(), int(bytes.size()), buf.data(),
                                                   int(buf.size()));
    return std::u16string(reinterpret_cast<const char16_t*>(buf.data()), size_t(n));
}

std::string fromUnicode(const std::u16string& text, bool* lossy = nullptr, SInt32 dstBytes = -1)
{
    if (dstBytes < 0)
        dstBytes = SInt32(text.size() * 4 + 1);
    std::vector<char> buf(size_t(dstBytes) + 8, '\x55');
    const SInt32 n = UTF16ToCurrentMacMBCSEncoding(
        reinterpret_cast<const unsigned short*>(text.data()), SInt32(text.size()), buf.data(),
        dstBytes, lossy);
    if (dstBytes > 0) {
        // Written within the size given, terminated, nothing beyond touched.
        if (buf[size_t(n)] != '\0' || buf[size_t(dstBytes)] != '\x55')
            return "<contract broken>";
    }
    return std::string(buf.data(), size_t(n));
}

std::string allNonNulBytes()
{
    std::string all;
    for (int b = 1; b < 256; ++b)
        all.push_back(char(b));
    return all;
}

const char16_t kHiragana[] = u"\u3042\u3044\u3046"; // three characters, two bytes each in Shift_JIS
const char kHiraganaSjis[] = "\x82\xa0\x82\xa2\x82\xa4";

// Test host converter: every byte becomes two units, so the text grows on conversion.
int gDoublingCalls = 0;
SInt32 doublingToUTF16(const char* src, int srcBytes, unsigned short* dst, int dstUnits)
{
    ++gDoublingCalls;
    for (int i = 0; i < srcBytes * 2 && i < dstUnits; ++i)
        dst[i] = static_cast<unsigned char>(src[i / 2]);
    return srcBytes * 2;
}
SInt32 upperFromUTF16(const unsigned short* src, SInt32 srcUnits, char* dst, SInt32 dstBytes,
                      bool* lossy)
{
    SInt32 n = 0;
    for (; n < srcUnits && n + 1 < dstBytes; ++n)
        dst[n] = char(std::toupper(src[n] & 0x7F));
    dst[n] = '\0';
    if (lossy)
        *lossy = false;
    return n;
}

} // namespace

class TestMacEncoding : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void cleanup()
    {
        SetMacEncodingConverter(nullptr);
        QVERIFY(SetCurrentMacEncoding(nullptr));
        QCOMPARE(QByteArray(CurrentMacEncodingName()), QByteArray("macintosh"));
    }

    void everyMacRomanByteBothWays()
    {
        for (int b = 1; b < 256; ++b) {
            const std::string byte(1, char(b));
            const std::u16string expected = icuToUnicode("macintosh", byte);
            QCOMPARE(expected.size(), size_t(1));
            const std::u16string got = toUnicode(byte);
            QVERIFY2(got == expected, qPrintable(QString::number(b, 16)));
            bool lossy = true;
            QVERIFY2(fromUnicode(got, &lossy) == byte, qPrintable(QString::number(b, 16)));
            QVERIFY(!lossy);
        }
        // And all at once.
        const std::string all = allNonNulBytes();
        QVERIFY(toUnicode(all) == icuToUnicode("macintosh", all));
        QVERIFY(fromUnicode(toUnicode(all)) == all);
    }

    void measuresAndGrowsWithMultiByteEncoding()
    {
        QVERIFY(SetCurrentMacEncoding("Shift_JIS"));
        const std::string sjis(kHiraganaSjis);
        // Just measuring.
        QCOMPARE(CurrentMacMBCSEncodingToUTF16(sjis.data(), int(sjis.size()), nullptr, 0), 3);
        // Too small: the whole count comes back, what fits is written.
        unsigned short small[2] = {0, 0};
        QCOMPARE(CurrentMacMBCSEncodingToUTF16(sjis.data(), int(sjis.size()), small, 2), 3);
        QCOMPARE(int(small[0]), 0x3042);
        QCOMPARE(int(small[1]), 0x3044);
        // Enough room: written and terminated.
        unsigned short room[4] = {1, 1, 1, 1};
        QCOMPARE(CurrentMacMBCSEncodingToUTF16(sjis.data(), int(sjis.size()), room, 4), 3);
        QCOMPARE(int(room[2]), 0x3046);
        QCOMPARE(int(room[3]), 0);
        // Negative count: up to the NUL.
        QCOMPARE(CurrentMacMBCSEncodingToUTF16(sjis.c_str(), -1, room, 4), 3);

        QCOMPARE(MakeQString(kHiraganaSjis, -1), QString::fromUtf16(kHiragana));
        QCOMPARE(MakeLocal8Bit(QString::fromUtf16(kHiragana)), QByteArray(kHiraganaSjis, 7));
    }

    // Output is cut at a character boundary, never inside a two-byte character.
    void cutsAtCharacterBoundary()
    {
        QVERIFY(SetCurrentMacEncoding("Shift_JIS"));
        const std::pair<int, QByteArray> rows[] = {
            {1, QByteArray()}, {2, QByteArray()}, {4, QByteArray("\x82\xa0")},
            {6, QByteArray("\x82\xa0\x82\xa2")}, {7, QByteArray(kHiraganaSjis)}};
        for (const auto& [dstBytes, expected] : rows) {
            bool lossy = false;
            QCOMPARE(QByteArray::fromStdString(fromUnicode(kHiragana, &lossy, dstBytes)), expected);
            QCOMPARE(lossy, expected.size() < 6);
        }
    }

    void unmappableCharacters()
    {
        bool lossy = false;
        QCOMPARE(QByteArray::fromStdString(fromUnicode(u"A\u20AC\u4E2D", &lossy)),
                 QByteArray("A\xDB?"));
        QVERIFY(lossy);
        // A lone surrogate is not a character.
        lossy = false;
        QCOMPARE(QByteArray::fromStdString(fromUnicode(std::u16string(u"x") + char16_t(0xD800),
                                                       &lossy)),
                 QByteArray("x?"));
        QVERIFY(lossy);
        // Clean text clears a flag left set by the caller.
        lossy = true;
        fromUnicode(u"plain", &lossy);
        QVERIFY(!lossy);
        // Invalid Shift_JIS bytes become substitution characters, never a crash.
        QVERIFY(SetCurrentMacEncoding("Shift_JIS"));
        const std::u16string bad = toUnicode("\x81\x20\xA0\xFF");
        QVERIFY(!bad.empty());
        QCOMPARE(MakeQString("\x82", 1).size(), 1); // a lead byte cut off at the end
    }

    void selectsAndRefusesEncodings()
    {
        const std::tuple<const char*, int, int> usable[] = {{"x-mac-cyrillic", 0x80, 0x0410},
                                                            {"x-mac-greek", 0xA1, 0x0393}};
        for (const auto& [name, byte, unit] : usable) {
            QVERIFY(SetCurrentMacEncoding(name));
            QCOMPARE(QByteArray(CurrentMacEncodingName()), QByteArray(name));
            QCOMPARE(int(toUnicode(std::string(1, char(byte))).at(0)), unit);
            QVERIFY(toUnicode(allNonNulBytes()) == icuToUnicode(name, allNonNulBytes()));
        }
        // Unknown, not byte-based, or not ASCII-compatible: refused, the current one stays.
        for (const char* name : {"no-such-encoding", "UTF-16", "ibm-037"}) {
            QVERIFY(!SetCurrentMacEncoding(name));
            QCOMPARE(QByteArray(CurrentMacEncodingName()), QByteArray("x-mac-greek"));
        }
        QVERIFY(SetCurrentMacEncoding(""));
        QCOMPARE(QByteArray(CurrentMacEncodingName()), QByteArray("macintosh"));
    }

    void hostConverterReplacesIcu()
    {
        const MacEncodingConverter host{doublingToUTF16, upperFromUTF16, "TestHost"};
        SetMacEncodingConverter(&host);
        QCOMPARE(QByteArray(CurrentMacEncodingName()), QByteArray("TestHost"));
        // MakeQString's first buffer is too small for this host's output: it has to grow.
        gDoublingCalls = 0;
        QCOMPARE(MakeQString("abc", 3), QStringLiteral("aabbcc"));
        QCOMPARE(gDoublingCalls, 2);
        QCOMPARE(MakeLocal8Bit(QStringLiteral("abc")), QByteArray("ABC", 4));

        // Half a converter is no converter.
        const MacEncodingConverter half{doublingToUTF16, nullptr, "Half"};
        SetMacEncodingConverter(&half);
        QCOMPARE(QByteArray(CurrentMacEncodingName()), QByteArray("macintosh"));
        QCOMPARE(MakeQString("abc", 3), QStringLiteral("abc"));

        SetMacEncodingConverter(&host);
        SetMacEncodingConverter(nullptr);
        QCOMPARE(MakeQString("\x80", 1), QStringLiteral("\u00C4"));
    }
};

VELMAR_TEST_MAIN(TestMacEncoding)
#include "tst_macencoding.moc"
