// Fonts and text: the font table and the three font rules, widths against the metrics a
// Windows user sees, and text drawn at the pen (baseline, touched rectangle, pen advance,
// background, modes).
#include "QuickDrawTestSupport.h"

#include <Velmar/HostShell.h>
#include <Velmar/QDText.h>

#include <QFontInfo>
#include <QGuiApplication>

#include <cmath>
#include <cstring>

using namespace Velmar;
using namespace QDTest;
using VelmarTest::P;
using VelmarTest::pascal;

namespace {

Palette::PaletteManager& palette()
{
    return *Palette::PaletteManager::Instance();
}

// Advance widths of Arial's glyphs in thousandths of an em (the same as Helvetica's).
int arialWidth(char c)
{
    static const QHash<char, int> kWidths = {{' ', 278}, {'a', 556}, {'b', 556}, {'c', 500},
        {'d', 556}, {'e', 556}, {'f', 278}, {'g', 556}, {'h', 556}, {'i', 222}, {'j', 222},
        {'k', 500}, {'l', 222}, {'m', 833}, {'n', 556}, {'o', 556}, {'p', 556}, {'q', 556},
        {'r', 333}, {'s', 500}, {'t', 278}, {'u', 556}, {'v', 500}, {'w', 722}, {'x', 500},
        {'y', 500}, {'z', 500}, {'H', 722}, {'T', 611}, {'W', 944}};
    return kWidths.value(c, -1);
}

// What Windows measures: each glyph's advance in font units (2048 an em) rounded to whole
// pixels at the size, then summed.
int windowsWidth(const char* text, int pixels)
{
    int sum = 0;
    for (const char* c = text; *c; ++c) {
        const int units = int(std::lround(arialWidth(*c) * 2.048));
        sum += int(std::lround(units * pixels / 2048.0));
    }
    return sum;
}

int penH()
{
    Point p{};
    GetPen(&p);
    return p.h;
}

} // namespace

class TestText : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void initTestCase() { SetLogCategory(kLogQuickDraw | kLogNotImpl, true); }
    void cleanup() { palette().Clear(); }

    void namesAndIds()
    {
        SInt16 id = -1;
        GetFNum(P(pascal("geneva")), &id);
        QCOMPARE(id, SInt16(geneva));
        GetFNum(P(pascal("Geneva")), &id); // the classic spelling finds it too
        QCOMPARE(id, SInt16(geneva));
        GetFNum(P(pascal("Courier New")), &id);
        QCOMPARE(id, SInt16(141));
        VelmarTest::LogCapture log;
        GetFNum(P(pascal("No Such Font")), &id);
        QCOMPARE(id, SInt16(0));
        QVERIFY(log.contains("getFontID(): Unknown font requested"));
        GetFNum(P(pascal("geneva")), nullptr);

        unsigned char name[16];
        std::memset(name, 0xAA, sizeof name);
        GetFontName(monaco, name);
        QCOMPARE(QByteArray(reinterpret_cast<char*>(name), 8), QByteArray("monaco\0\xAA", 8));
        GetFontName(999, name);
        QCOMPARE(name[0], (unsigned char)0);
        QVERIFY(log.contains("getFontName(): Unknown font ID - 999"));
        GetFontName(monaco, nullptr);

        QCOMPARE(GetAppFont(), SInt16(applFont));
        QCOMPARE(GetSysFont(), SInt16(systemFont));
        // Families Qt knows get IDs of their own above the fixed ones.
        const QString family = QFontInfo(QFont(QStringLiteral("Liberation Sans"))).family();
        GetFNum(P(pascal(family.toLatin1().constData())), &id);
        QVERIFY(id >= 256);
    }

    void fontRules_data()
    {
        QTest::addColumn<int>("id");
        QTest::addColumn<int>("size");
        QTest::addColumn<int>("face");
        QTest::addColumn<bool>("appFont");
        QTest::addColumn<QString>("settingKey");
        QTest::addColumn<QString>("settingValue");
        QTest::addColumn<QString>("family");
        QTest::addColumn<int>("hint");
        QTest::addColumn<double>("points");
        QTest::addColumn<int>("gotFace"); // read back from the QFont

        QTest::newRow("geneva") << 3 << 12 << 0 << false << "" << "" << "Arial" << 3 << 9.0 << 0;
        QTest::newRow("monaco") << 4 << 10 << 0 << false << "" << "" << "Courier New" << 2 << 7.5
            << 0;
        QTest::newRow("app name wins") << 4 << 12 << 0 << true << "AppFontNameWin" << "Arial"
            << "Arial" << 3 << 9.0 << 0;
        QTest::newRow("app name by toolbox name") << 22 << 12 << 0 << true << "AppFontNameWin"
            << "Times" << "Times New Roman" << 1 << 9.0 << 0;
        QTest::newRow("app name unknown") << 4 << 12 << 0 << true << "AppFontNameWin" << "Nope"
            << QGuiApplication::font().family() << 3 << 9.0 << 0;
        QTest::newRow("app size") << 3 << 12 << 0 << true << "AppFontSizeLarge" << "14" << "Arial"
            << 3 << 10.5 << 0;
        QTest::newRow("app size not asked") << 3 << 12 << 0 << false << "AppFontSizeLarge" << "14"
            << "Arial" << 3 << 9.0 << 0;
        QTest::newRow("humongous") << 3 << 64 << 0 << true << "AppFontSizeHumongous" << "96"
            << "Arial" << 3 << 72.0 << 0;
        QTest::newRow("bold underline") << 3 << 12 << (bold | underline) << false << "" << ""
            << "Arial" << 3 << 9.0 << (bold | underline);
        QTest::newRow("italic outline condense") << 3 << 12 << (italic | outline | condense)
            << false << "" << "" << "Arial" << 3 << 9.0 << (italic | outline | condense);
        QTest::newRow("shadow extend nothing") << 3 << 12 << (shadow | extend) << false << "" << ""
            << "Arial" << 3 << 9.0 << 0;
        QTest::newRow("face is a byte") << 3 << 12 << 0x101 << false << "" << "" << "Arial" << 3
            << 9.0 << int(bold);
    }

    void fontRules()
    {
        QFETCH(int, id);
        QFETCH(int, size);
        QFETCH(int, face);
        QFETCH(bool, appFont);
        QFETCH(QString, settingKey);
        QFETCH(QString, settingValue);
        if (settingKey == QLatin1String("AppFontNameWin"))
            palette().SetString(settingKey, settingValue);
        else if (!settingKey.isEmpty())
            palette().SetUint16(settingKey, UInt16(settingValue.toUInt()));

        const QFont font = TxFontSizeFaceToQFont(SInt16(id), SInt16(size), SInt16(face), appFont);
        QTEST(font.family(), "family");
        QTEST(int(font.styleHint()), "hint");
        QTEST(font.pointSizeF(), "points");
        QTEST(int(GetTxFaceFromQFont(font)), "gotFace");

        // The port calls apply the same rules and keep what the host asked for.
        World world(20);
        TextFont(SInt16(id), appFont);
        TextSize(SInt16(size), appFont);
        TextFace(SInt16(face), appFont);
        QCOMPARE(world->currentFont(), font);
        QCOMPARE(GetPortTextSize(world), SInt16(size));
        QCOMPARE(int(GetPortTextFace(world)), face & 0xFF);
        QCOMPARE(world->appFontFlag, UInt8(appFont));
    }

    void sizesAndReadBack()
    {
        World world(20);
        QCOMPARE(GetPortTextSize(world), SInt16(0));
        QCOMPARE(GetPortTextMode(world), SInt16(0));
        TextSize(0);
        QCOMPARE(world->currentFont().pointSizeF(), QGuiApplication::font().pointSizeF());
        VelmarTest::LogCapture log;
        TextSize(-12, false);
        QCOMPARE(world->currentFont().pointSizeF(), QGuiApplication::font().pointSizeF());
        QVERIFY(log.contains("warning: TextSize: size -12 is negative"));
        TextSize(SHRT_MAX, false); // kept as asked; drawing at it must not fail
        QCOMPARE(GetPortTextSize(world), SInt16(SHRT_MAX));

        TextFont(times, false);
        QCOMPARE(GetPortTextFont(world), SInt16(times));
        QCOMPARE(GetTxFontFromQFont(world->currentFont()), SInt16(newYork)); // first row
        TextFont(9999, false); // unknown: the application font
        QVERIFY(log.contains("getFontName(): Unknown font ID - 9999"));
        QVERIFY(log.contains("getFontStyle(): Unknown font ID - 9999"));
        QCOMPARE(world->currentFont().family(), QGuiApplication::font().family());
        QCOMPARE(GetTxSizeFromQFont(TxFontSizeFaceToQFont(geneva, 18, 0, false)), SInt16(18));
        TextMode(srcXor);
        QCOMPARE(GetPortTextMode(world), SInt16(srcXor));
    }

    // A user on Windows measures "geneva" 12 in Arial; the metric-compatible font must agree.
    void widthsMatchWindowsMetrics()
    {
        World world(20);
        TextFont(geneva, false);
        TextSize(12, false);
        QVERIFY2(QFontInfo(world->currentFont()).family() == QLatin1String("Liberation Sans")
                || QFontInfo(world->currentFont()).family() == QLatin1String("Arial"),
            "no Arial-compatible font: install fonts-liberation2");
        for (const char* text : {"Hello World", "The quick brown fox jumps over the lazy dog"}) {
            const int got = StringWidth(P(pascal(text)));
            QVERIFY2(std::abs(got - windowsWidth(text, 12)) <= 1,
                qPrintable(QStringLiteral("%1: %2 against %3")
                               .arg(text)
                               .arg(got)
                               .arg(windowsWidth(text, 12))));
        }
    }

    void measuring()
    {
        World world(20);
        TextFont(geneva, false);
        TextSize(12, false);
        const char text[] = "Wide words";
        const SInt16 all = TextWidth(text, 0, 10);
        QCOMPARE(StringWidth(P(pascal(text))), all);
        QCOMPARE(TextWidth(text, 5, 5), StringWidth(P(pascal("words"))));
        QCOMPARE(CharWidth('W'), TextWidth(text, 0, 1));
        QCOMPARE(TextWidthUTF16(QStringLiteral("Wide words"), 5, 100), TextWidth(text, 5, 5));
        const unsigned short buf[] = {'W', 'i', 'd', 'e', 0, 'x'};
        QCOMPARE(TextWidthBufUTF16(buf, 0, 6), TextWidth(text, 0, 4)); // stops at the zero
        QCOMPARE(StringWidth(nullptr), SInt16(0));

        SInt16 locs[12];
        std::fill(std::begin(locs), std::end(locs), SInt16(-1));
        MeasureText(10, text, locs);
        QCOMPARE(locs[0], SInt16(0));
        QVERIFY(std::abs(locs[10] - all) <= 1);
        QCOMPARE(locs[11], SInt16(-1));
        for (int i = 1; i <= 10; ++i)
            QVERIFY(locs[i] >= locs[i - 1]);
        MeasureText(0, text, locs);
        MeasureText(3, nullptr, locs);
        MeasureText(3, text, nullptr);

        FontInfo info;
        GetFontInfo(&info);
        QVERIFY(info.widMax() >= CharWidth('W'));
        QCOMPARE(info.lineSpacing(), info.ascent() + info.descent() + info.leading());
        GetFontInfo(nullptr);
        int lines = 0;
        info.CalculateTextRectSize("one\r\ntwo\rthree", &lines);
        QCOMPARE(lines, 3);
        info.CalculateTextRectSize("one\n\rtwo", &lines);
        QCOMPARE(lines, 2);
        QVERIFY(info.fitTextToWidth(QStringLiteral("a long line of text"), 30).size() < 19);
    }

    void visibleLength_data()
    {
        QTest::addColumn<QByteArray>("text");
        QTest::addColumn<int>("length");
        QTest::addColumn<int>("visible");
        QTest::newRow("trailing blanks") << QByteArray("ab  \n") << 5 << 2;
        QTest::newRow("tabs") << QByteArray("a\t\t") << 3 << 1;
        QTest::newRow("first stays") << QByteArray("  ") << 2 << 1;
        QTest::newRow("carriage return kept") << QByteArray("a\r") << 2 << 2;
        QTest::newRow("empty") << QByteArray("a") << 0 << 0;
        QTest::newRow("negative") << QByteArray("a") << -3 << 0;
    }
    void visibleLength()
    {
        QFETCH(QByteArray, text);
        QFETCH(int, length);
        QTEST(int(VisibleLength(text.constData(), length)), "visible");
    }

    // The one drawing oracle: ink lies above the pen's baseline, inside the reported
    // rectangle, and the pen moves by the text's width.
    void drawingAtThePen_data()
    {
        QTest::addColumn<int>("form");
        QTest::newRow("DrawString") << 0;
        QTest::newRow("DrawText") << 1;
        QTest::newRow("StdText") << 2;
        QTest::newRow("DrawTextUTF16") << 3;
        QTest::newRow("DrawTextBufUTF16") << 4;
        QTest::newRow("DrawChar") << 5;
        QTest::newRow("DrawJustified") << 6;
    }
    void drawingAtThePen()
    {
        QFETCH(int, form);
        World world(120, 60);
        TextFont(geneva, false);
        TextSize(18, false);
        MoveTo(10, 40);
        const char bytes[] = "xxHHxx";
        const unsigned short units[] = {'H', 'H', 0};
        DirtyRecorder recorder(world);
        switch (form) {
        case 0: DrawString(P(pascal("HH"))); break;
        case 1: DrawText(bytes, 2, 2); break;
        case 2: StdText(2, bytes + 2, Point{1, 1}, Point{1, 1}); break;
        case 3: DrawTextUTF16(true, QStringLiteral("xHH"), 1, 2); break;
        case 4: DrawTextBufUTF16(true, units, 0, 80); break;
        case 5:
            DrawChar('H');
            DrawChar('H');
            break;
        case 6: DrawJustified(bytes + 2, 2, 0, 0, Point{1, 1}, Point{1, 1}); break;
        }
        const QSet<QPoint> ink = world.touched();
        QVERIFY(!ink.isEmpty());
        const QRect box = boundingBox(ink);
        QCOMPARE(box.bottom(), 39); // "H" sits on the baseline
        QVERIFY(box.top() < 30 && box.left() >= 10 && box.left() <= 12);
        QVERIFY2(recorder.dirty().contains(box.adjusted(-1, -1, 1, 1)), describe(ink));
        QCOMPARE(penH(), 10 + StringWidth(P(pascal("HH"))));
    }

    void backgroundAndModes()
    {
        World world(120, 40);
        const RGBColor grey(0x8080, 0x8080, 0x8080), white(0xFFFF, 0xFFFF, 0xFFFF);
        const Rect all = R(0, 0, 40, 120);
        auto reset = [&] {
            RGBBackColor(&grey);
            EraseRect(&all);
            RGBBackColor(&white);
            MoveTo(10, 30);
        };
        auto whitePixels = [&] { return countOf(world, 0xFFFFFFFF); };
        TextFont(geneva, false);
        TextSize(18, false);
        reset();
        DrawString(P(pascal("Hi"))); // a fresh port draws no background
        QCOMPARE(whitePixels(), 0);
        reset();
        DrawTextUTF16(false, QStringLiteral("Hi"), 0, 2);
        QVERIFY(whitePixels() > 20);
        reset();
        DrawTextUTF16(true, QStringLiteral("Hi"), 0, 2);
        QCOMPARE(whitePixels(), 0);
        reset();
        TextMode(srcCopy);
        DrawString(P(pascal("Hi")));
        QVERIFY(whitePixels() > 20);
        reset();
        TextMode(srcOr);
        DrawString(P(pascal("Hi")));
        QCOMPARE(whitePixels(), 0);

        // Without anti-aliasing the ink is the foreground colour only; srcXor drawn twice
        // leaves the background as it was.
        SetAntiAliasedTextEnabled(false, 0);
        SInt16 minSize = -1;
        QCOMPARE(IsAntiAliasedTextEnabled(&minSize), Boolean(0));
        reset();
        DrawString(P(pascal("Hi")));
        const QSet<QPoint> ink = world.touched(0xFF808080);
        QVERIFY(!ink.isEmpty());
        for (const QPoint& p : ink)
            QCOMPARE(world.pixel(p.x(), p.y()), 0xFF000000u);
        reset();
        EraseRect(&all); // white, so that xor inverts cleanly
        TextMode(srcXor);
        DrawString(P(pascal("Hi")));
        QVERIFY(!world.touched().isEmpty());
        MoveTo(10, 30);
        DrawString(P(pascal("Hi")));
        QVERIFY(world.touched().isEmpty());
        SetAntiAliasedTextEnabled(true, 0);
    }

    void penStatesAndScaling()
    {
        World world(200, 60);
        TextFont(geneva, false);
        TextSize(12, false);
        const SInt16 w = StringWidth(P(pascal("Hi")));
        MoveTo(10, 30);
        HidePen();
        DrawString(P(pascal("Hi"))); // nothing drawn, the pen still moves
        QVERIFY(world.touched().isEmpty());
        QCOMPARE(penH(), 10 + w);
        ShowPen();
        PenSize(0, 0); // pen size does not concern text
        DrawString(P(pascal("Hi")));
        QVERIFY(!world.touched().isEmpty());
        PenNormal();

        const char hi[] = "Hi";
        MoveTo(10, 50);
        StdText(2, hi, Point{2, 2}, Point{1, 1});
        QVERIFY(std::abs(penH() - (10 + 2 * w)) <= 1);
        MoveTo(10, 50);
        const char spaced[] = "a b";
        const SInt16 plain = TextWidth(spaced, 0, 3);
        DrawJustified(spaced, 3, 5 << 16, 0, Point{1, 1}, Point{1, 1});
        QCOMPARE(penH(), 10 + plain + 5);
    }

    void hostileInput()
    {
        World world(40);
        VelmarTest::LogCapture log;
        DrawText("abc", -1, 2);
        QVERIFY(log.contains("warning: Velmar::DrawText: byteCount is less or zero"));
        DrawText("abc", 0, 0);
        DrawText(nullptr, 0, 3);
        DrawString(nullptr);
        StdText(-4, "abc", Point{1, 1}, Point{1, 1});
        QCOMPARE(log.count("warning: Velmar::StdTextInternal: bytes_count is less or zero"), 4);
        DrawTextUTF16(true, QStringLiteral("abc"), -1, 2);
        DrawTextBufUTF16(true, nullptr, 0, 2);
        QVERIFY(log.contains("warning: Velmar::DrawTextUTF16: first -1 or count 2 is negative"));
        QCOMPARE(TextWidth("abc", -1, 2), SInt16(0));
        QCOMPARE(TextWidthUTF16(QStringLiteral("abc"), 1, -5), SInt16(0));
        QVERIFY(world.touched().isEmpty());
        // A buffer exactly first + count long and without its terminator is not overread.
        const unsigned short exact[] = {'a', 'b'};
        DrawTextBufUTF16(true, exact, 1, 1);
        QCOMPARE(TextWidthBufUTF16(exact, 0, 2), TextWidth("ab", 0, 2));
        // An embedded NUL ends the text.
        QCOMPARE(TextWidth("a\0b", 0, 3), TextWidth("a", 0, 1));

        SetPort(nullptr);
        log.clear();
        DrawString(P(pascal("x")));
        TextFont(3);
        TextMode(srcOr);
        QCOMPARE(StringWidth(P(pascal("x"))), SInt16(0));
        GetFontInfo(nullptr);
        QCOMPARE(GetPortTextFont(nullptr), SInt16(0));
        QCOMPARE(log.lines().filter("port").size(), 6);
        QVERIFY(log.contains("warning: StdTextInternal: Can't get current port!"));
        QVERIFY(log.contains("warning: Velmar::TextMode: Can't get current port !"));
        QVERIFY(log.contains("warning: TextWidthInternal: cannot get current port"));
        QVERIFY(log.contains("warning: GetFontInfo: cannot get current port"));
    }

private:
    static int countOf(const World& world, QRgb colour)
    {
        world->EndPaint();
        int n = 0;
        const QImage& image = world.image();
        for (int y = 0; y < image.height(); ++y)
            for (int x = 0; x < image.width(); ++x)
                n += image.pixel(x, y) == colour;
        return n;
    }
};

VELMAR_TEST_MAIN(TestText)
#include "tst_text.moc"
