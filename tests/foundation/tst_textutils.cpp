// Pascal-string conversions and the Toolbox string calls, in the default Mac OS Roman.
#include <Velmar/Diagnostics.h>
#include <Velmar/HostCore.h>
#include <Velmar/HostEncoding.h>
#include <Velmar/TextUtils.h>

#include "TestSupport.h"

#include <cstring>
#include <limits>

using namespace Velmar;

namespace {

// A Pascal string from raw bytes (at most 255).
QByteArray pstr(const QByteArray& text)
{
    QByteArray p(1, char(text.size()));
    return p + text;
}

const unsigned char* up(const QByteArray& p)
{
    return reinterpret_cast<const unsigned char*>(p.constData());
}

} // namespace

class TestTextUtils : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void cleanup() { QVERIFY(SetCurrentMacEncoding(nullptr)); }

    void makeQStringAndBack()
    {
        QVERIFY(MakeQString(nullptr, 5).isNull());
        QVERIFY(MakeQString("abc", 0).isNull());
        QVERIFY(MakeQString("", -1).isNull());
        QCOMPARE(MakeQString("abc", -1), QStringLiteral("abc"));
        QCOMPARE(MakeQString("abcdef", 2), QStringLiteral("ab"));
        const char embedded[] = {'a', '\0', 'b'};
        QCOMPARE(MakeQString(embedded, 3), QStringLiteral("a"));
        QCOMPARE(MakeQString("\x80\xA5\xDB", 3), QStringLiteral("\u00C4\u2022\u20AC"));

        const QByteArray abc = MakeLocal8Bit(QStringLiteral("abc"));
        QCOMPARE(abc.size(), 4);
        QCOMPARE(abc.at(3), '\0');
        QCOMPARE(MakeLocal8Bit(QString()), QByteArray(1, '\0'));
        QCOMPARE(MakeLocal8Bit(QStringLiteral("\u00C4\u20AC")), QByteArray("\x80\xDB", 3));
        QCOMPARE(MakeLocal8Bit(QStringLiteral("x\u4E2Dy")), QByteArray("x?y", 4));
        // An embedded NUL ends the text.
        QCOMPARE(MakeLocal8Bit(QString::fromUtf16(u"a\0b", 3)), QByteArray("a", 2));

        QVERIFY(PascalString2QString(nullptr).isNull());
        const unsigned char empty[] = {0, 'x'};
        QVERIFY(PascalString2QString(empty).isNull());
        QCOMPARE(PascalString2QString(up(pstr("Hello"))), QStringLiteral("Hello"));
        // Only the length byte decides: no terminator needed or read.
        QByteArray full = pstr(QByteArray(255, 'z'));
        full.append("tail");
        QCOMPARE(PascalString2QString(up(full)), QString(255, QLatin1Char('z')));
    }

    void qstringToPascal()
    {
        const std::pair<QString, QByteArray> rows[] = {
            {QString(), QByteArray()},
            {QStringLiteral("Hello"), QByteArray("Hello")},
            {QStringLiteral("\u00C4\uF8FF"), QByteArray("\x80\xF0")},
            {QString(255, QLatin1Char('q')), QByteArray(255, 'q')},
            {QString(300, QLatin1Char('w')), QByteArray(255, 'w')}, // longer than the buffer
            {QStringLiteral("\u4E2D"), QByteArray("?")},              // unmappable
        };
        for (const auto& [text, expected] : rows) {
            unsigned char p[260];
            std::memset(p, 0xEE, sizeof p);
            QString2PascalString(text, p);
            QCOMPARE(QByteArray(reinterpret_cast<const char*>(p + 1), p[0]), expected);
            QCOMPARE(int(p[1 + p[0]]), 0xEE); // nothing written after the text
        }
        QString2PascalString(QStringLiteral("x"), nullptr); // ignored

        // Every byte there and back through a full-length Pascal string.
        QByteArray bytes;
        for (int b = 1; b < 256; ++b)
            bytes.append(char(b));
        const QString text = PascalString2QString(up(pstr(bytes)));
        QCOMPARE(text.size(), 255);
        Str255 back;
        QString2PascalString(text, back);
        QCOMPARE(QByteArray(reinterpret_cast<const char*>(back), 256), pstr(bytes));
    }

    void cutInsideMultiByteCharacter()
    {
        QVERIFY(SetCurrentMacEncoding("Shift_JIS"));
        Str255 p;
        QString2PascalString(QString(200, QChar(0x3042)), p); // 400 bytes of text
        QCOMPARE(int(p[0]), 255);
        QCOMPARE(int(p[255]), 0x82); // the lead byte of the 128th character, its trail lost
        QCOMPARE(int(p[254]), 0xA0);
        // Reading it back keeps the 127 whole characters and does not crash on the stray byte.
        QVERIFY(PascalString2QString(p).startsWith(QString(127, QChar(0x3042))));
    }

    void textOfValues()
    {
        QCOMPARE(FourCharToString(0x54455854u), QStringLiteral("TEXT"));
        QCOMPARE(FourCharToString(0x41000A42u), QStringLiteral("A  B")); // controls
        QCOMPARE(FourCharToString(0xE9FF7F20u), QStringLiteral("\u00E9\u00FF  "));
        QCOMPARE(ptrToString(reinterpret_cast<const void*>(quintptr(0xDEADBEEF))),
                 QStringLiteral("0x00000000deadbeef"));
        QCOMPARE(EventTimeToTicks(1.0), 60);
        QCOMPARE(EventTimeToTicks(0.999), 59);
        QCOMPARE(EventTimeToTicks(-0.999), -59);
        QCOMPARE(EventTimeToTicks(1e300), std::numeric_limits<SInt32>::max());
        QCOMPARE(EventTimeToTicks(std::numeric_limits<double>::quiet_NaN()), 0);
        SysBeep(30);
    }

    void numbers()
    {
        for (int n : {-42, std::numeric_limits<int>::min(), std::numeric_limits<int>::max()}) {
            Str255 s;
            NumToString(n, s);
            QCOMPARE(QByteArray(reinterpret_cast<const char*>(s + 1), s[0]), QByteArray::number(n));
            SInt32 back = 12345;
            StringToNum(s, &back);
            QCOMPARE(back, n);
        }
        NumToString(1, nullptr);
        for (const char* text : {"", "12a", "0x10", "99999999999"}) {
            SInt32 n = 777;
            StringToNum(up(pstr(text)), &n);
            QCOMPARE(n, 0);
        }
        SInt32 n = 777;
        StringToNum(nullptr, &n);
        QCOMPARE(n, 0);
        StringToNum(up(pstr("5")), nullptr);
    }

    void equalString()
    {
        struct Row { const char* a; const char* b; int caseSens; int equal; };
        const Row rows[] = {
            {"Abc", "abc", 0, 1}, {"Abc", "abc", 1, 0},
            {"\x8E", "e", 0, 0},    // é / e: accents count
            {"\x83", "\x8E", 0, 1}, // É / é
            {"", "", 1, 1}, {"ab", "abc", 0, 0},
        };
        for (const Row& r : rows) {
            const QByteArray a = pstr(r.a), b = pstr(r.b);
            for (Boolean diacSens : {Boolean(0), Boolean(1)})
                QCOMPARE(int(EqualString(up(a), up(b), Boolean(r.caseSens), diacSens)), r.equal);
            QCOMPARE(int(IdenticalString(up(a), up(b), nullptr)), a == b ? 0 : 1);
        }
    }

    void relativeOrder()
    {
        const QByteArray a = pstr("apple"), b = pstr("banana"), upper = pstr("APPLE");
        QVERIFY(RelString(up(a), up(b), 1, 0) < 0);
        QCOMPARE(RelString(up(a), up(upper), 0, 1), SInt16(0));
        // Not clamped: whatever QString::compare says, cut to 16 bits.
        const int raw = QStringLiteral("apple").compare(QStringLiteral("APPLE"), Qt::CaseSensitive);
        QCOMPARE(RelString(up(a), up(upper), 1, 0), SInt16(raw));
        QCOMPARE(CompareString(up(a), up(upper), nullptr), SInt16(raw));
        QCOMPARE(RelString(nullptr, up(pstr("")), 1, 0), SInt16(0));

        QCOMPARE(IdenticalText("Hello", "HELP", 3, 3, nullptr), SInt16(0));
        QCOMPARE(IdenticalText("Hello", "HELP", 4, 4, nullptr), SInt16(1));
        QCOMPARE(IdenticalText("ab", "ab\0zz", 10, 10, nullptr), SInt16(0)); // stops at NUL
        const char unterminated[3] = {'x', 'y', 'z'};
        QCOMPARE(IdenticalText(unterminated, "XYZ", 3, 3, nullptr), SInt16(0));
        QCOMPARE(IdenticalText(nullptr, "a", 1, 1, nullptr), SInt16(1));
        QCOMPARE(IdenticalText("\xC9", "\xE9", 1, 1, nullptr), SInt16(0)); // Latin-1 É / é
    }

    // An international resource is not supported: compared as if there were none, one warning.
    void internationalArgumentWarns()
    {
        SetLogCategory(kLogNotImpl, true);
        VelmarTest::LogCapture log;
        char data = 0;
        char* master = &data;
        const QByteArray same = pstr("same");
        for (Handle h : {Handle(nullptr), Handle(&master)}) {
            QCOMPARE(CompareString(up(same), up(same), h), SInt16(0));
            QCOMPARE(IdenticalString(up(same), up(same), h), SInt16(0));
            QCOMPARE(IdenticalText("same", "SAME", 4, 4, h), SInt16(0));
        }
        for (const char* call : {"CompareString", "IdenticalString", "IdenticalText"})
            QCOMPARE(log.count(QStringLiteral("warning: %1: using with resource handle not implemented")
                                   .arg(QLatin1String(call))), 1);
        SetLogCategory(kLogNotImpl, false);
    }
};

VELMAR_TEST_MAIN(TestTextUtils)
#include "tst_textutils.moc"
