// TextEdit records on their Qt widgets: text and offsets, keys as a host hands them over,
// lines and geometry, styles, undo, masking, TETextBox, and hostile calls.
#include "../quickdraw/QuickDrawTestSupport.h"
#include "../windows/WindowTestSupport.h"

#include <Velmar/HostEncoding.h>
#include <Velmar/QDShapes.h>
#include <Velmar/TextEdit.h>

#include <QInputMethodEvent>
#include <QPlainTextEdit>
#include <QTextEdit>

#include <functional>

using namespace Velmar;
using namespace WindowTest;

namespace {

using Asserts = VelmarTest::IgnoredAssertions;

// A window with a record on its port, both gone with the scope.
class Record {
public:
    explicit Record(bool styled = false, const Rect& view = R(10, 10, 110, 210))
        : m_window(R(100, 100, 300, 400))
    {
        OnPort on(m_window);
        m_te = styled ? TEStyleNew(&view, &view) : TENew(&view, &view);
    }
    ~Record()
    {
        if (Private::isLive(m_te))
            TEDispose(m_te);
    }
    TEPtr* operator->() const { return m_te; }
    operator TEPtr*() const { return m_te; }
    WindowRef window() const { return m_window; }
    QString text() const
    {
        Handle h = TEGetText(m_te);
        return QString::fromLatin1(*h, TxGetHandleSize(h));
    }
    void set(const char* text) const { TESetText(text, SInt32(std::strlen(text)), m_te); }

private:
    Window m_window;
    TEPtr* m_te = nullptr;
};

// A key-down the way the window makes one: the character, and the key as Qt saw it.
EventRecord keyEvent(unsigned short unit, UInt32 qtKey = 0, UInt16 modifiers = 0)
{
    EventRecord e{};
    e.what = keyDown;
    e.message = unit < 0x100 ? unit : '?';
    e.modifiers = modifiers;
    e.textUnit = unit;
    e.qtKey = qtKey;
    return e;
}

void type(TEPtr* te, const char* keys)
{
    for (const char* k = keys; *k; ++k) {
        EventRecord e = keyEvent(static_cast<unsigned char>(*k));
        TEKey(*k, te, &e);
    }
}

} // namespace

class TestTextEdit : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void initTestCase() { SetLogCategory(kLogQuickDraw | kLogNotImpl | kLogTextEdit, true); }

    void recordsAndWidgets()
    {
        Record plain, styled(true);
        QVERIFY(qobject_cast<QPlainTextEdit*>(plain->Qt()->widget()));
        QVERIFY(qobject_cast<QTextEdit*>(styled->Qt()->widget()));
        QCOMPARE(plain->QtClip()->parentWidget(), static_cast<QWidget*>(plain.window().get()));
        QCOMPARE(plain->Qt()->widget()->geometry(), QRect(0, 0, 200, 100));
        QCOMPARE(plain->inPort(), plain.window()->GetPort());

        // Without a port, or on an offscreen one, the record is made but shows nowhere.
        GrafPtr saved = nullptr;
        GetPort(&saved);
        SetPort(nullptr);
        Asserts asserts;
        const Rect r = R(0, 0, 10, 10);
        TEPtr* orphan = TENew(&r, &r);
        GrafPtr world = nullptr;
        NewGWorld(&world, 32, &r, nullptr, nullptr, 0);
        SetPort(world);
        TEPtr* offscreen = TENew(&r, &r);
        QCOMPARE(asserts.texts(), (QStringList{"port", "port->window != NULL"}));
        TESetText("kept", 4, orphan);
        TEDispose(orphan);
        TEDispose(offscreen);
        DisposeGWorld(world);
        SetPort(saved);
    }

    void textAndSelection()
    {
        Record te;
        te.set("Hello\rWorld");
        QCOMPARE(te.text(), QStringLiteral("Hello\rWorld"));
        QCOMPARE(TxGetHandleSize(TEGetText(te)), Size(11));
        QCOMPARE(te->selStart(), SInt16(11)); // the caret stands after the last character
        QCOMPARE(te->selEnd(), SInt16(11));
        QCOMPARE(te->teLength(), SInt16(11));
        TESetSelect(-5, 3, te);
        QCOMPARE(te->selStart(), SInt16(0));
        QCOMPARE(te->selEnd(), SInt16(3));
        TESetSelect(7, 900, te);
        QCOMPARE(te->selEnd(), SInt16(11));
        TEDelete(te);
        TEInsert("\xA5!", 2, te); // Mac OS Roman bullet
        QCOMPARE(te->hTextUnicode(), QString::fromUtf8("Hello\rW\u2022!"));
        unsigned short utf16[6];
        QCOMPARE(te->getTextUTF16(utf16, 6), SInt32(5)); // cut to the buffer
        QCOMPARE(utf16[5], (unsigned short)0);
        QCOMPARE(te->selStart(), SInt16(9)); // the caret stays after what went in before it
        TESetSelect(0, 5, te);
        TEInsert("<", 1, te); // before the selection, which keeps its characters
        QCOMPARE(te->selStart(), SInt16(1));
        QCOMPARE(te->selEnd(), SInt16(6));
        // An embedded NUL ends the text; bytes the encoding cannot map become U+FFFD.
        TESetText("ab\0cd", 5, te);
        QCOMPARE(te.text(), QStringLiteral("ab"));
        SetCurrentMacEncoding("Shift_JIS");
        TESetText("x\x80y", 3, te);
        QCOMPARE(te->teCharacterCount(), SInt32(3));
        SetCurrentMacEncoding(nullptr);
    }

    void keysAsAHostHandsThemOver_data()
    {
        QTest::addColumn<QString>("start");
        QTest::addColumn<int>("caret");
        QTest::addColumn<QList<int>>("units"); // with the Qt key when negative: -key
        QTest::addColumn<QString>("text");
        QTest::addColumn<int>("selStart");
        QTest::addColumn<int>("selEnd");
        QTest::newRow("typing") << "" << 0 << QList<int>{'a', 'b', 'c'} << "abc" << 3 << 3;
        QTest::newRow("backspace") << "abc" << 3 << QList<int>{0x08} << "ab" << 2 << 2;
        QTest::newRow("forward delete") << "abc" << 0 << QList<int>{0x7F} << "bc" << 0 << 0;
        QTest::newRow("arrows") << "abc" << 3 << QList<int>{0x1C, 0x1C, 'x'} << "axbc" << 2 << 2;
        QTest::newRow("return") << "ab" << 1 << QList<int>{0x0D} << "a\rb" << 2 << 2;
        QTest::newRow("down") << "ab\rcd" << 1 << QList<int>{0x1F, 'x'} << "ab\rcxd" << 5 << 5;
    }
    void keysAsAHostHandsThemOver()
    {
        QFETCH(QString, start);
        QFETCH(int, caret);
        QFETCH(QList<int>, units);
        Record te;
        te.set(start.toLatin1().constData());
        TESetSelect(caret, caret, te);
        for (int unit : units) {
            EventRecord e = keyEvent(UInt16(unit));
            TEKey(char(unit), te, &e);
        }
        QTEST(te.text(), "text");
        QTEST(int(te->selStart()), "selStart");
        QTEST(int(te->selEnd()), "selEnd");
    }

    void keysBeyondTheEncoding()
    {
        Record te;
        // Shift extends the selection, with the key Qt saw.
        te.set("abcd");
        EventRecord left = keyEvent(0x1C, Qt::Key_Left, shiftKey);
        left.qtModifiers = Qt::ShiftModifier;
        TEKey(0x1C, te, &left);
        TEKey(0x1C, te, &left);
        QCOMPARE(te->selStart(), SInt16(2));
        QCOMPARE(te->selEnd(), SInt16(4));
        // A letter the host's encoding cannot carry arrives as '?' with its unit: it is typed.
        te.set("");
        EventRecord cyrillic = keyEvent(0x0436);
        TEKey('?', te, &cyrillic);
        QCOMPARE(te->hTextUnicode(), QString(QChar(0x0436)));
        // A byte with no character of its own is typed as its value.
        SetCurrentMacEncoding("Shift_JIS");
        EventRecord lead = keyEvent(0);
        lead.textUnit = 0;
        TEKey(char(0x81), te, &lead);
        SetCurrentMacEncoding(nullptr);
        QCOMPARE(te->hTextUnicode().back(), QChar(0x81));
        TEKeyUTF16(0x00E9, te, &lead);
        QCOMPARE(te->hTextUnicode().back(), QChar(0xE9));
        // Single-line records take no returns.
        te->setAllowMultipleBlocks(false);
        EventRecord ret = keyEvent(0x0D);
        TEKey(0x0D, te, &ret);
        QVERIFY(!te->hTextUnicode().contains(QLatin1Char('\r')));
    }

    // Input methods deliver text, straight to the editor or through the window standing in.
    void inputMethods()
    {
        Record te;
        te.set("a");
        QInputMethodEvent commit;
        commit.setCommitString(QString::fromUtf8("\u65e5\u672c"));
        QCoreApplication::sendEvent(te->Qt()->widget(), &commit);
        TEActivateEx(te, te.window());
        QInputMethodEvent accent;
        accent.setCommitString(QString::fromUtf8("\u00e9"));
        QCoreApplication::sendEvent(te.window().get(), &accent);
        QCOMPARE(te->hTextUnicode(), QString::fromUtf8("a\u65e5\u672c\u00e9"));
        TEDeactivate(te);
        QVERIFY(!te.window()->focusProxyTextEdit());
    }

    // Lines agree with the layout on screen; TEGetPoint and TEGetOffset are inverse.
    void linesAndGeometry()
    {
        Record te(false, R(10, 10, 110, 90));
        te.set("The quick brown fox jumps over the lazy dog.\rSecond\r\rFourth");
        const SInt16 lines = te->nLines();
        QVERIFY(lines > 4); // the first paragraph wraps in 80 pixels
        const SInt16* starts = te->lineStarts();
        QCOMPARE(starts[0], SInt16(0));
        QCOMPARE(starts[lines], te->teLength());
        for (int i = 1; i <= lines; ++i)
            QVERIFY(starts[i] > starts[i - 1] || (i == lines && starts[i] >= starts[i - 1]));
        for (SInt16 offset = 0; offset <= te->teLength(); ++offset) {
            const Point p = TEGetPoint(offset, te);
            QVERIFY(p.h >= 10 && p.v > 10);
            const bool lineEnd = std::find(starts + 1, starts + lines, offset) != starts + lines;
            if (!lineEnd) // at a wrap, the point of the line's end is the next line's start
                QCOMPARE(TEGetOffset(p, te), offset);
        }
        const SInt32 all = TEGetHeight(lines, 1, te);
        QCOMPARE(all, lines * SInt32(te->lineHeight()));
        QCOMPARE(TEGetHeight(1, lines, te), all);
        QCOMPARE(TEGetHeight(0, 0, te), SInt32(te->lineHeight()));
        QCOMPARE(
            TEGetPoint(0, te, true).v - TEGetPoint(0, te).v, te->lineHeight() - te->fontAscent());
    }

    void scrolling()
    {
        Record te(false, R(10, 10, 50, 210));
        te.set("1\r2\r3\r4\r5\r6\r7\r8");
        TESetSelect(0, 0, te);
        TEScroll(0, SInt16(-2 * te->lineHeight()), te);
        QCOMPARE(te->selStart(), SInt16(4)); // two lines down
        VelmarTest::LogCapture log;
        TEScroll(5, 0, te);
        QVERIFY(log.contains("Velmar::TEScrollByPixel"));
        QCOMPARE(te->selStart(), SInt16(4));
        TESetSelect(14, 14, te); // the last line: the editor scrolls to show it
        TESelView(te);
        QVERIFY(te->destRect().top < te->viewRect().top);
    }

    void stylesAndScraps()
    {
        Record te(true);
        te.set("plain bold");
        TESetSelect(6, 10, te);
        TextStyle style{};
        style.tsFace = bold;
        style.tsColor = RGBColor(0xFFFF, 0, 0);
        TESetStyle(doFace | doColor, &style, 1, te);
        TextStyle got{};
        TEGetStyle(7, &got, nullptr, nullptr, te);
        QCOMPARE(int(got.tsFace), int(bold));
        QCOMPARE(got.tsColor.red, (unsigned short)0xFFFF);
        TEGetStyle(1, &got, nullptr, nullptr, te);
        QCOMPARE(int(got.tsFace), int(normal));
        TESetStyle(doFace | doToggle, &style, 1, te); // all bold: toggled off
        TEGetStyle(7, &got, nullptr, nullptr, te);
        QCOMPARE(int(got.tsFace), int(normal));

        TESetSelect(0, 10, te);
        style.tsFace = italic;
        TESetSelect(0, 5, te);
        TESetStyle(doFace, &style, 1, te);
        TESetSelect(0, 10, te);
        StScrpHandle scrap = TEGetStyleScrapHandle(te);
        QVERIFY(scrap);
        QCOMPARE((*scrap)->scrpNStyles, SInt16(3)); // italic, plain black, red
        QCOMPARE((*scrap)->scrpStyleTab[1].scrpStartChar, SInt32(5));
        QCOMPARE(int((*scrap)->scrpStyleTab[0].scrpFace), int(italic));

        // Inserted with the runs it came with.
        TESetSelect(10, 10, te);
        TEStyleInsert("XY", 2, scrap, te);
        TEGetStyle(10, &got, nullptr, nullptr, te);
        QCOMPARE(int(got.tsFace), int(italic));
        TxDisposeHandle(reinterpret_cast<Handle>(scrap));

        Record plain;
        QVERIFY(!TEGetStyleScrapHandle(plain));
        plain.set("abc");
        TESetSelect(0, 3, plain);
        TESetStyle(doFace, &style, 1, plain); // one style only: left alone
        TEGetStyle(1, &got, nullptr, nullptr, plain);
        QCOMPARE(int(got.tsFace), int(plain->txFace()));

        // Sizes add to each run's own size; a face bit part of the selection lacks is set on
        // all of it, and one all of it has is taken off.
        Record runs(true);
        runs.set("small LARGE");
        TESetSelect(6, 11, runs);
        style.tsSize = 24;
        style.tsFace = bold;
        TESetStyle(doSize | doFace, &style, 1, runs);
        TEGetStyle(1, &got, nullptr, nullptr, runs);
        const SInt16 small = got.tsSize;
        TESetSelect(0, 11, runs);
        style.tsSize = 2;
        TESetStyle(addSize | doFace | doToggle, &style, 1, runs);
        for (const auto& [offset, size] : {std::pair{1, small + 2}, std::pair{7, 26}}) {
            TEGetStyle(SInt16(offset), &got, nullptr, nullptr, runs);
            QCOMPARE(got.tsSize, SInt16(size));
            QCOMPARE(int(got.tsFace), int(bold));
        }
        TESetStyle(doFace | doToggle, &style, 1, runs);
        TEGetStyle(7, &got, nullptr, nullptr, runs);
        QCOMPARE(int(got.tsFace), int(normal));
    }

    void undoAndEditBlocks()
    {
        Record te;
        TEBeginEditBlock(te);
        type(te, "abc");
        TEInsert("de", 2, te);
        TEEndEditBlock(te);
        TEEndEditBlock(te); // unbalanced: nothing
        QCOMPARE(te.text(), QStringLiteral("abcde"));
        QVERIFY(te->canUndo());
        te->undo();
        QCOMPARE(te.text(), QString());
        te->redo();
        QCOMPARE(te.text(), QStringLiteral("abcde"));
    }

    // Cut, copy and paste through the scrap are tst_scrap's and tst_textedithost's; here the
    // mask: the record keeps the text, the widget shows only the mask character.
    void masking()
    {
        Record te;
        te.set(" secretwords");
        TESetSelect(7, 7, te);
        te->maskAllCharacters('*');
        EventRecord e = keyEvent('!');
        TEKey('!', te, &e);
        QCOMPARE(te.text(), QStringLiteral(" secret!words"));
        QCOMPARE(te->Qt()->document()->toPlainText(), QString(13, QLatin1Char('*')));
        EventRecord back = keyEvent(0x08);
        TEKey(0x08, te, &back);
        QCOMPARE(te.text(), QStringLiteral(" secretwords"));
        te->maskAllCharacters(0);
        QCOMPARE(te->Qt()->document()->toPlainText(), QStringLiteral(" secretwords"));
        QCOMPARE(TEToScrap(), OSErr(0));
        QCOMPARE(TEFromScrap(), OSErr(0));
    }

    // Offsets count bytes of the host's encoding when asked to.
    void localEightBitOffsets()
    {
        SetCurrentMacEncoding("Shift_JIS");
        Record te;
        te->SetUseLocal8Bit(true);
        const char text[] = "a\x88\x9f"
                            "b"; // a, one kanji (two bytes), b
        TESetText(text, 4, te);
        QCOMPARE(te->teLength(), SInt16(4));
        QCOMPARE(te->teCharacterCount(), SInt32(3));
        TESetSelect(3, 4, te);
        QCOMPARE(te->Qt()->textCursor().selectedText(), QStringLiteral("b"));
        QCOMPARE(te->selStart(), SInt16(3));
        SetCurrentMacEncoding(nullptr);
    }

    void textBox()
    {
        QDTest::World world(100);
        VelmarTest::LogCapture log;
        const Rect box = R(10, 10, 90, 60);
        TETextBox("x", 0, &box, teFlushLeft);
        QVERIFY(log.contains("warning: Velmar::TETextBox: count is less or zero"));
        const char text[] = "many words that wrap\rand a second line";
        TETextBox(text, SInt32(sizeof text - 1), &box, teCenter);
        const QRect inked = QDTest::boundingBox(world.touched());
        QVERIFY(!inked.isEmpty());
        QVERIFY(QRect(10, 10, 50, 80).contains(inked));
        QVERIFY(inked.height() > 30); // several lines
        TETextBox(text, 5, nullptr, teFlushLeft);
    }

    // Every call with no record asserts; a disposed record is refused; a record whose
    // window went first keeps its text and never touches the widget that is gone.
    void hostileRecords()
    {
        const Rect r = R(0, 0, 10, 10);
        EventRecord e = keyEvent('a');
        const std::pair<const char*, std::function<void(TEPtr*)>> calls[] = {
            {"TESetText", [](TEPtr* te) { TESetText("x", 1, te); }},
            {"TEGetText", [](TEPtr* te) { QCOMPARE(TEGetText(te), nullptr); }},
            {"TEInsert", [](TEPtr* te) { TEInsert("x", 1, te); }},
            {"TEDelete", [](TEPtr* te) { TEDelete(te); }},
            {"TEKey", [&](TEPtr* te) { TEKey('a', te, &e); }},
            {"TEClick",
                [](TEPtr* te) {
                    TEClick(Point{1, 1}, 0, te);
                }},
            {"TESetSelect", [](TEPtr* te) { TESetSelect(0, 1, te); }},
            {"TEUpdate", [&](TEPtr* te) { TEUpdate(&r, te); }},
            {"TEScroll", [](TEPtr* te) { TEScroll(0, 10, te); }},
            {"TEGetOffset",
                [](TEPtr* te) {
                    QCOMPARE(TEGetOffset(Point{1, 1}, te), SInt16(0));
                }},
            {"TEGetPoint", [](TEPtr* te) { TEGetPoint(0, te); }},
            {"TEGetHeight", [](TEPtr* te) { QCOMPARE(TEGetHeight(1, 1, te), SInt32(0)); }},
            {"TECut", [](TEPtr* te) { TECut(te); }},
            {"TEPaste", [](TEPtr* te) { TEPaste(te); }},
            {"TESetStyle",
                [](TEPtr* te) {
                    TextStyle s{};
                    TESetStyle(doAll, &s, 1, te);
                }},
            {"TEActivateEx", [](TEPtr* te) { TEActivateEx(te, nullptr); }},
            {"TEDeactivate", [](TEPtr* te) { TEDeactivate(te); }},
            {"TEBeginEditBlock", [](TEPtr* te) { TEBeginEditBlock(te); }},
            {"TEDispose", [](TEPtr* te) { TEDispose(te); }},
        };
        TEPtr* disposed = nullptr;
        {
            Record gone;
            disposed = gone;
        }
        for (const auto& [name, call] : calls) {
            Asserts none, stale;
            {
                Asserts asserts;
                call(nullptr);
                QVERIFY2(asserts.texts() == QStringList{QStringLiteral("te != NULL")}, name);
            }
            Asserts asserts;
            call(disposed);
            QVERIFY2(asserts.texts() == QStringList{QStringLiteral("IsValidTERecord(te)")}, name);
        }
        {
            Asserts asserts;
            TEKeyUTF16('a', nullptr, nullptr);
            TEActivate(nullptr);
            QCOMPARE(asserts.texts(), (QStringList{"eventRecord", "false"}));
        }

        // The window goes first.
        auto* window = new Window(R(100, 100, 200, 300));
        TEPtr* te = nullptr;
        {
            OnPort on(*window);
            te = TENew(&r, &r);
        }
        TESetText("survives", 8, te);
        delete window;
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
        QVERIFY(!te->Qt());
        VelmarTest::LogCapture log;
        TEKey('x', te, &e);
        TEClick(Point{1, 1}, 0, te);
        QVERIFY(log.contains("Velmar::TEKeyUTF16: the record's window is gone"));
        Handle text = TEGetText(te);
        QCOMPARE(QByteArray(*text, TxGetHandleSize(text)), QByteArray("survives"));
        TEDispose(te);
    }

    // The click loop runs while the button is down; a loop that disposes of its record ends
    // the tracking without touching it again.
    void clickLoopMayDisposeTheRecord()
    {
        static TEPtr* sRecord = nullptr;
        static int sCalls = 0;
        Record owner;
        const Rect view = R(10, 10, 110, 210);
        TEPtr* te = nullptr;
        {
            OnPort on(owner.window());
            te = TENew(&view, &view);
        }
        TESetText("click here", 10, te);
        sRecord = te;
        sCalls = 0;
        TESetClickLoop(
            [](TEPtr* record) -> Boolean {
                ++sCalls;
                TEDispose(record);
                sRecord = nullptr;
                return true;
            },
            te);
        owner.window()->show();
        QVERIFY(QTest::qWaitForWindowExposed(owner.window()->window()));
        QTest::mousePress(owner.window().get(), Qt::LeftButton, {}, QPoint(20, 20));
        TEClick(Point{20, 20}, 0, te);
        QTest::mouseRelease(owner.window().get(), Qt::LeftButton, {}, QPoint(20, 20));
        QCOMPARE(sCalls, 1);
        QVERIFY(!sRecord);
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    }
};

VELMAR_APP_TEST_MAIN(TestTextEdit)
#include "tst_textedit.moc"
