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

// Reports a fixed menu bar height for one screen only, so asking the wrong screen shows.
class FakeScreens : public AScreenManOS {
public:
    SInt32 GetCurrentScreen() const override { return 2; }
    SInt16 GetMenuBarHeight(SInt32 screen) const override { return screen == 2 ? 23 : -1; }
};

} // namespace

class TestTextUtils : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void cleanup() { QVERIFY(SetCurrentMacEncoding(nullptr)); }

    void makeQString()
    {
        QVERIFY(MakeQString(nullptr, 5).isNull());
        QVERIFY(MakeQString("abc", 0).isNull());
        QVERIFY(MakeQString("", -1).isNull());
        QCOMPARE(MakeQString("abc", -1), QStringLiteral("abc"));
        QCOMPARE(MakeQString("abcdef", 2), QStringLiteral("ab"));
        const char embedded[] = {'a', '\0', 'b'};
        QCOMPARE(MakeQString(embedded, 3), QStringLiteral("a"));
        QCOMPARE(MakeQString("\x80\xA5\xDB", 3), QStringLiteral("\u00C4\u2022\u20AC"));
    }

    void makeLocal8Bit()
    {
        const QByteArray abc = MakeLocal8Bit(QStringLiteral("abc"));
        QCOMPARE(abc.size(), 4);
        QCOMPARE(abc.at(3), '\0');
        QCOMPARE(MakeLocal8Bit(QString()), QByteArray(1, '\0'));
        QCOMPARE(MakeLocal8Bit(QStringLiteral("\u00C4\u20AC")), QByteArray("\x80\xDB", 3));
        QCOMPARE(MakeLocal8Bit(QStringLiteral("x\u4E2Dy")), QByteArray("x?y", 4));
        // An embedded NUL ends the text.
        QCOMPARE(MakeLocal8Bit(QString::fromUtf16(u"a\0b", 3)), QByteArray("a", 2));
    }

    void pascalToQString()
    {
        QVERIFY(PascalString2QString(nullptr).isNull());
        const unsigned char empty[] = {0, 'x'};
        QVERIFY(PascalString2QString(empty).isNull());
        QCOMPARE(PascalString2QString(up(pstr("Hello"))), QStringLiteral("Hello"));
        // Only the length byte decides: no terminator needed or read.
        QByteArray full = pstr(QByteArray(255, 'z'));
        full.append("tail");
        QCOMPARE(PascalString2QString(up(full)), QString(255, QLatin1Char('z')));
    }

    void qstringToPascal_data()
    {
        QTest::addColumn<QString>("text");
        QTest::addColumn<QByteArray>("expected");
        QTest::newRow("empty") << QString() << QByteArray();
        QTest::newRow("ascii") << QStringLiteral("Hello") << QByteArray("Hello");
        QTest::newRow("roman") << QStringLiteral("\u00C4\uF8FF") << QByteArray("\x80\xF0");
        QTest::newRow("255") << QString(255, QLatin1Char('q')) << QByteArray(255, 'q');
        QTest::newRow("300 cut") << QString(300, QLatin1Char('w')) << QByteArray(255, 'w');
        QTest::newRow("unmappable") << QStringLiteral("\u4E2D") << QByteArray("?");
    }
    void qstringToPascal()
    {
        QFETCH(QString, text);
        QFETCH(QByteArray, expected);
        unsigned char p[260];
        std::memset(p, 0xEE, sizeof p);
        QString2PascalString(text, p);
        QCOMPARE(int(p[0]), expected.size());
        QCOMPARE(QByteArray(reinterpret_cast<const char*>(p + 1), p[0]), expected);
        QCOMPARE(int(p[1 + p[0]]), 0xEE); // nothing written after the text
        QString2PascalString(text, nullptr); // ignored
    }

    void everyRomanByteThroughPascalStrings()
    {
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

    void fourCharToString_data()
    {
        QTest::addColumn<uint>("code");
        QTest::addColumn<QString>("text");
        QTest::newRow("TEXT") << 0x54455854u << QStringLiteral("TEXT");
        QTest::newRow("controls") << 0x41000A42u << QStringLiteral("A  B");
        QTest::newRow("latin1") << 0xE9FF7F20u << QStringLiteral("\u00E9\u00FF  ");
    }
    void fourCharToString()
    {
        QFETCH(uint, code);
        QFETCH(QString, text);
        QCOMPARE(FourCharToString(code), text);
    }

    void pointerText()
    {
        QCOMPARE(ptrToString(reinterpret_cast<const void*>(quintptr(0x1234))),
                 QStringLiteral("0x0000000000001234"));
        QCOMPARE(ptrToString(nullptr), QStringLiteral("0x0000000000000000"));
        QCOMPARE(ptrToString(reinterpret_cast<const void*>(quintptr(0xDEADBEEF))),
                 QStringLiteral("0x00000000deadbeef"));
    }

    void numbers_data()
    {
        QTest::addColumn<int>("n");
        QTest::addColumn<QByteArray>("text");
        QTest::newRow("zero") << 0 << QByteArray("0");
        QTest::newRow("negative") << -42 << QByteArray("-42");
        QTest::newRow("min") << std::numeric_limits<int>::min() << QByteArray("-2147483648");
        QTest::newRow("max") << std::numeric_limits<int>::max() << QByteArray("2147483647");
    }
    void numbers()
    {
        QFETCH(int, n);
        QFETCH(QByteArray, text);
        Str255 s;
        NumToString(n, s);
        QCOMPARE(QByteArray(reinterpret_cast<const char*>(s + 1), s[0]), text);
        SInt32 back = 12345;
        StringToNum(s, &back);
        QCOMPARE(back, n);
        NumToString(n, nullptr);
    }

    void unparsableNumbers_data()
    {
        QTest::addColumn<QByteArray>("text");
        QTest::newRow("empty") << QByteArray();
        QTest::newRow("trailing letters") << QByteArray("12a");
        QTest::newRow("leading letters") << QByteArray("a12");
        QTest::newRow("hex") << QByteArray("0x10");
        QTest::newRow("too big") << QByteArray("99999999999");
    }
    void unparsableNumbers()
    {
        QFETCH(QByteArray, text);
        SInt32 n = 777;
        StringToNum(up(pstr(text)), &n);
        QCOMPARE(n, 0);
        n = 777;
        StringToNum(nullptr, &n);
        QCOMPARE(n, 0);
        StringToNum(up(pstr("5")), nullptr);
    }

    void equalString_data()
    {
        QTest::addColumn<QByteArray>("a");
        QTest::addColumn<QByteArray>("b");
        QTest::addColumn<int>("caseSens");
        QTest::addColumn<int>("equal");
        QTest::newRow("case ignored") << QByteArray("Abc") << QByteArray("abc") << 0 << 1;
        QTest::newRow("case counts") << QByteArray("Abc") << QByteArray("abc") << 1 << 0;
        QTest::newRow("accents count") << QByteArray("\x8E") << QByteArray("e") << 0 << 0; // é / e
        QTest::newRow("accented case") << QByteArray("\x83") << QByteArray("\x8E") << 0 << 1; // É / é
        QTest::newRow("empty") << QByteArray() << QByteArray() << 1 << 1;
        QTest::newRow("prefix") << QByteArray("ab") << QByteArray("abc") << 0 << 0;
    }
    void equalString()
    {
        QFETCH(QByteArray, a);
        QFETCH(QByteArray, b);
        QFETCH(int, caseSens);
        QFETCH(int, equal);
        for (Boolean diacSens : {Boolean(0), Boolean(1)})
            QCOMPARE(int(EqualString(up(pstr(a)), up(pstr(b)), Boolean(caseSens), diacSens)), equal);
        QCOMPARE(int(IdenticalString(up(pstr(a)), up(pstr(b)), nullptr)),
                 a == b ? 0 : 1);
    }

    void relativeOrder()
    {
        const QByteArray a = pstr("apple"), b = pstr("banana"), upper = pstr("APPLE");
        QVERIFY(RelString(up(a), up(b), 1, 0) < 0);
        QVERIFY(RelString(up(b), up(a), 1, 0) > 0);
        QCOMPARE(RelString(up(a), up(a), 1, 0), SInt16(0));
        QCOMPARE(RelString(up(a), up(upper), 0, 1), SInt16(0));
        QVERIFY(RelString(up(a), up(upper), 1, 1) != 0);
        // Not clamped: whatever QString::compare says, cut to 16 bits.
        const int raw = QStringLiteral("apple").compare(QStringLiteral("APPLE"), Qt::CaseSensitive);
        QCOMPARE(RelString(up(a), up(upper), 1, 0), SInt16(raw));
        QCOMPARE(CompareString(up(a), up(upper), nullptr), SInt16(raw));
        QVERIFY(CompareString(up(a), up(b), nullptr) < 0);
        QCOMPARE(RelString(nullptr, up(pstr("")), 1, 0), SInt16(0));
    }

    void identicalText()
    {
        QCOMPARE(IdenticalText("Hello", "HELP", 3, 3, nullptr), SInt16(0));
        QCOMPARE(IdenticalText("Hello", "HELP", 4, 4, nullptr), SInt16(1));
        QCOMPARE(IdenticalText("ab", "ab\0zz", 10, 10, nullptr), SInt16(0)); // stops at NUL
        const char unterminated[3] = {'x', 'y', 'z'};
        QCOMPARE(IdenticalText(unterminated, "XYZ", 3, 3, nullptr), SInt16(0));
        QCOMPARE(IdenticalText(nullptr, "", 0, 0, nullptr), SInt16(0));
        QCOMPARE(IdenticalText(nullptr, "a", 1, 1, nullptr), SInt16(1));
        QCOMPARE(IdenticalText("\xC9", "\xE9", 1, 1, nullptr), SInt16(0)); // Latin-1 É / é
    }

    void internationalArgumentWarns_data()
    {
        QTest::addColumn<QString>("call");
        QTest::newRow("CompareString") << QStringLiteral("CompareString");
        QTest::newRow("IdenticalString") << QStringLiteral("IdenticalString");
        QTest::newRow("IdenticalText") << QStringLiteral("IdenticalText");
    }
    void internationalArgumentWarns()
    {
        QFETCH(QString, call);
        SetLogCategory(kLogNotImpl, true);
        VelmarTest::LogCapture log;
        char data = 0;
        char* master = &data;
        const Handle intl = &master;
        const QByteArray a = pstr("same"), b = pstr("same");
        SInt16 result = -1;
        for (Handle h : {Handle(nullptr), intl}) {
            if (call == QLatin1String("CompareString"))
                result = CompareString(up(a), up(b), h);
            else if (call == QLatin1String("IdenticalString"))
                result = IdenticalString(up(a), up(b), h);
            else
                result = IdenticalText("same", "SAME", 4, 4, h);
            QCOMPARE(result, SInt16(0)); // compared as if there were no argument
        }
        const QString expected =
            QStringLiteral("warning: %1: using with resource handle not implemented").arg(call);
        QCOMPARE(log.count(expected), 1);
        SetLogCategory(kLogNotImpl, false);
    }

    void ticksAndMisc()
    {
        QCOMPARE(EventTimeToTicks(1.0), 60);
        QCOMPARE(EventTimeToTicks(0.999), 59);
        QCOMPARE(EventTimeToTicks(-0.999), -59);
        QCOMPARE(EventTimeToTicks(0.0), 0);
        QCOMPARE(EventTimeToTicks(1e300), std::numeric_limits<SInt32>::max());
        QCOMPARE(EventTimeToTicks(std::numeric_limits<double>::quiet_NaN()), 0);
        SysBeep(30);
        QVERIFY(GetMBarHeight() >= 0);
    }

    void menuBarHeightFromScreenManager()
    {
        FakeScreens screens;
        AScreenManOS::SetInstance(&screens);
        const SInt16 height = GetMBarHeight();
        AScreenManOS::SetInstance(nullptr);
        QCOMPARE(height, SInt16(23));
    }
};

VELMAR_TEST_MAIN(TestTextUtils)
#include "tst_textutils.moc"
