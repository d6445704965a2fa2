// The library's stand-ins for host services and their replacement by a host: ticks,
// foreground, error logging, handles, the text table, screens and the automation listener;
// the UI shell's palette, decoration managers, managed windows and left button; and the
// built-in Macintosh encoding pair (Mac OS Roman against an independent ICU conversion, the
// buffer contracts, encoding selection and the host converter hook).
#include "TestSupport.h"

#include <Velmar/HostCore.h>
#include <Velmar/HostEncoding.h>
#include <Velmar/HostShell.h>
#include <Velmar/TextUtils.h>

#include <unicode/ucnv.h>

#include <QGuiApplication>
#include <QScreen>
#include <QTemporaryDir>
#include <QWidget>

#include <cstring>
#include <memory>
#include <tuple>
#include <vector>

using namespace Velmar;
using Brindle::DecorationManager;
using Brindle::ManagedWindow;
using Palette::PaletteManager;

namespace {
UInt32 fixedTicks() { return 1234; }
bool alwaysForeground() { return true; }

const XError* gLogged = nullptr;
void recordXError(const XError& error) { gLogged = &error; }

// Counts what goes through it and leaves the work to the allocator it replaced.
class CountingAllocator : public HandleAllocator {
public:
    explicit CountingAllocator(HandleAllocator* inner) : m_inner(inner) {}
    Handle PtrToHand(const void* data, Size size) override { ++made; return m_inner->PtrToHand(data, size); }
    void DisposeHandle(Handle h) override { ++disposed; m_inner->DisposeHandle(h); }
    Handle CopyHand(Handle h) override { ++made; return m_inner->CopyHand(h); }
    Size GetHandleSize(Handle h) override { return m_inner->GetHandleSize(h); }
    bool IsValidHandle(Handle h) override { return m_inner->IsValidHandle(h); }
    int made = 0;
    int disposed = 0;

private:
    HandleAllocator* m_inner;
};

class ShoutingTable : public TextTable {
public:
    QString Translate(const char* key) const override { return TextTable::Translate(key).toUpper(); }
};

// A menu bar on one screen only, so asking the wrong screen shows.
class FixedScreens : public AScreenManOS {
public:
    SInt32 GetCurrentScreen() const override { return 2; }
    SInt16 GetMenuBarHeight(SInt32 screen) const override { return screen == 2 ? 42 : -1; }
};

// Installs `replacement` with `set`: `set` hands back `original`, null brings it back.
template <typename T, typename Set>
void checkRestored(Set set, T original, T replacement)
{
    QVERIFY(set(nullptr) == replacement);
    QVERIFY(set(nullptr) == original);
}
class TestWindow : public ManagedWindow {
public:
    explicit TestWindow(QWidget* widget) : m_widget(widget) {}
    QWidget* GetWidget() override { return m_widget; }
    void GetWindowProperties(Properties& p) override { p.set(kPropertyDocument); }
    const Brindle::DecorationState* GetDecorationState() override { return &m_state; }

private:
    QWidget* m_widget;
    Brindle::DecorationState m_state;
};

// A shell frame 20 pixels high above the content, in an area starting at (100, 50).
class TestDecorator : public Brindle::Decorator {
public:
    QPoint ReferenceOrigin() const override { return QPoint(100, 50); }
    QRect FrameGeometry() const override { return content.adjusted(0, -20, 0, 0); }
    QRect ContentGeometry() const override { return content; }
    void SetFrameGeometry(const QRect& f) override { content = f.adjusted(0, 20, 0, 0); }
    void SetContentGeometry(const QRect& c) override { content = c; }
    void MoveContent(const QPoint& p) override { content.moveTopLeft(p); }
    void SetContentSize(const QSize& s) override { content.setSize(s); }
    void SetTitle(const QString& t) override { title = t; }
    void SelectWindow() override { ++selections; }
    QRect content = QRect(0, 20, 200, 100);
    QString title;
    int selections = 0;
};

class RecordingManager : public DecorationManager {
public:
    RecordingManager(QMenuBar* bar, int mode) : DecorationManager(bar, mode) {}
    void Decorate(ManagedWindow* w) override { decorated.append(w); }
    void Undecorate(ManagedWindow* w) override { undecorated.append(w); }
    QWidget* HiddenDefaultParent() const override { return parent; }
    QList<ManagedWindow*> decorated, undecorated;
    QWidget* parent = nullptr;
};

DecorationManager* recordingFactory(QMenuBar* bar, int mode) { return new RecordingManager(bar, mode); }

bool buttonHeld() { return true; }
void countMove(ManagedWindow*, void* context) { ++*static_cast<int*>(context); }
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

class TestHostServices : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void servicesAreReplaceableAndRestored()
    {
        const TickSource ticks = SetTickSource(fixedTicks);
        QCOMPARE(TxGetTicks(), UInt32(1234));
        checkRestored(SetTickSource, ticks, TickSource(fixedTicks));

        const ForegroundSource foreground = SetForegroundSource(alwaysForeground);
        QVERIFY(isRunningInForeground());
        checkRestored(SetForegroundSource, foreground, ForegroundSource(alwaysForeground));
        // The default follows Qt's application state; no window is active in this test.
        QCOMPARE(isRunningInForeground(), QGuiApplication::applicationState() == Qt::ApplicationActive);

        const XError error("std::exception", "boom", 7, "f.cpp");
        const XErrorLogger logger = SetXErrorLogger(recordXError);
        LogXError(error);
        QCOMPARE(gLogged, &error);
        checkRestored(SetXErrorLogger, logger, XErrorLogger(recordXError));
        gLogged = nullptr;
        QTest::ignoreMessage(QtCriticalMsg, "XError (std::exception):    Error: boom Line: 7 File: f.cpp");
        LogXError(error);
        QVERIFY(!gLogged);

        CountingAllocator counting(HandleAllocator::Get());
        HandleAllocator* allocator = HandleAllocator::SetInstance(&counting);
        Handle h = TxPtrToHand("ab", 2);
        TxDisposeHandle(TxCopyHand(h));
        TxDisposeHandle(h);
        QCOMPARE(counting.made, 2);
        QCOMPARE(counting.disposed, 2);
        checkRestored(HandleAllocator::SetInstance, allocator, static_cast<HandleAllocator*>(&counting));

        ShoutingTable shouting;
        TextTable* table = TextTable::SetInstance(&shouting);
        QCOMPARE(stx_func("quit").text(), QStringLiteral("QUIT"));
        checkRestored(TextTable::SetInstance, table, static_cast<TextTable*>(&shouting));
        QCOMPARE(stx_func("quit").text(), QStringLiteral("quit"));

        FixedScreens fixed;
        AScreenManOS* screens = AScreenManOS::SetInstance(&fixed);
        QCOMPARE(GetMBarHeight(), SInt16(42));
        checkRestored(AScreenManOS::SetInstance, screens, static_cast<AScreenManOS*>(&fixed));
    }

    void handles_data()
    {
        QTest::addColumn<int>("size");
        QTest::newRow("empty") << 0;
        QTest::newRow("Pascal string") << 256;
        QTest::newRow("large") << 100000;
    }
    void handles()
    {
        QFETCH(int, size);
        QByteArray bytes(size, Qt::Uninitialized);
        for (int i = 0; i < size; ++i)
            bytes[i] = char(i * 7 + 1);
        Handle h = TxPtrToHand(bytes.constData(), size);
        QVERIFY(TxIsValidHandle(h));
        QCOMPARE(TxGetHandleSize(h), Size(size));
        QCOMPARE(QByteArray(*h, size), bytes);
        QCOMPARE((*h)[size], '\0'); // text handles can be read as C strings

        Handle zeroed = TxPtrToHand(nullptr, size);
        QCOMPARE(QByteArray(*zeroed, size), QByteArray(size, '\0'));

        // A copy is independent and outlives its source.
        Handle copy = TxCopyHand(h);
        QVERIFY(copy && copy != h && *copy != *h);
        QCOMPARE(TxGetHandleSize(copy), Size(size));
        TxDisposeHandle(h);
        TxDisposeHandle(zeroed);
        QVERIFY(!TxIsValidHandle(h));
        QCOMPARE(TxGetHandleSize(h), Size(-1));
        QCOMPARE(QByteArray(*copy, size), bytes);
        TxDisposeHandle(copy);
    }

    void textTable()
    {
        TextTable* table = TextTable::Get();
        QCOMPARE(table->Translate(nullptr), QString());
        table->Insert(QStringLiteral("Cancel"), QStringLiteral("Abbrechen"));
        QCOMPARE(QByteArray(stx_func("Cancel").c_str()), QByteArray("Abbrechen"));
        QCOMPARE(stx_func("Other").text(), QStringLiteral("Other"));
        table->Clear();
        QVERIFY(!table->HasTranslation("Cancel"));

        QTemporaryDir dir;
        const auto write = [&](const char* name, const QByteArray& content) {
            QFile file(dir.filePath(QLatin1String(name)));
            QVERIFY(file.open(QIODevice::WriteOnly));
            file.write(content);
        };
        write("texts.json", QStringLiteral("{\"Open\": \"Öffnen\", \"Quit\": \"Beenden\", \"Number\": 3}").toUtf8());
        write("bad.json", "[\"not an object\"]");

        VelmarTest::LogCapture log;
        TextTable own;
        own.Insert(QStringLiteral("Quit"), QStringLiteral("old"));
        own.Insert(QStringLiteral("Keep"), QStringLiteral("kept"));
        QVERIFY(own.LoadJsonFile(dir.filePath(QStringLiteral("texts.json"))));
        QCOMPARE(own.Translate("Open"), QStringLiteral("Öffnen"));
        QCOMPARE(own.Translate("Quit"), QStringLiteral("Beenden"));
        QCOMPARE(own.Translate("Keep"), QStringLiteral("kept"));
        QVERIFY(!own.HasTranslation("Number")); // only texts are taken
        QVERIFY(!own.LoadJsonFile(dir.filePath(QStringLiteral("bad.json"))));
        QVERIFY(!own.LoadJsonFile(dir.filePath(QStringLiteral("missing.json"))));
        QCOMPARE(own.Translate("Open"), QStringLiteral("Öffnen"));
        QCOMPARE(log.count(QStringLiteral("TextTable:")), 2);
    }

    void screens()
    {
        AScreenManOS* screens = AScreenManOS::Get();
        const SInt32 current = screens->GetCurrentScreen();
        QVERIFY(current >= 0 && current < screens->GetScreenCount());
        QScreen* primary = QGuiApplication::primaryScreen();
        QCOMPARE(screens->GetScreenRect(current), primary->geometry());
        const QPoint centre = primary->geometry().center();
        QCOMPARE(screens->GetScreenForPoint(centre), current);
        QCOMPARE(screens->GetUsableRectForPoint(centre), primary->availableGeometry());
        // A point off every screen belongs to the nearest one.
        QVERIFY(!screens->GetUsableRectForPoint(QPoint(-100000, -100000)).isEmpty());
        QVERIFY(screens->GetUsableRect(-1).isNull());
        QVERIFY(screens->GetUsableRect(9999).isNull());
        const SInt16 menuBar = screens->GetMenuBarHeight(current);
        QVERIFY(menuBar > 0 && menuBar < 200);
    }

    void automationListener()
    {
        const QString choices = QStringLiteral("Abort|Retry|Ignore|Ignore All");
        VelmarTest::ScopedOverride none(&AutomationListenerManager::SetListener,
                                        static_cast<AutomationListener*>(nullptr));
        QVERIFY(!AutomationListenerManager::GetListener());
        QCOMPARE(AskAutomationListener(QStringLiteral("t"), QStringLiteral("x"), choices), SInt32(-1));

        VelmarTest::ScriptedAutomationListener listener;
        const std::pair<const char*, int> answers[] = {
            {"ignore all", 3}, {" 1 ", 1}, {"4", -1},
            {"Ignore", 2}, // not a prefix of "Ignore All" by mistake
            {"Later", -1}};
        for (const auto& [answer, index] : answers) {
            listener.queue(QLatin1String(answer));
            QCOMPARE(AskAutomationListener(QStringLiteral("Velmar assert"), QStringLiteral("text"), choices),
                     SInt32(index));
        }
        const auto& q = listener.questions().at(0);
        QCOMPARE(q.title, QStringLiteral("Velmar assert"));
        QCOMPARE(q.text, QStringLiteral("text"));
        QCOMPARE(q.choices, choices);
    }

    // Empty by default (callers keep their defaults); a host's palette answers a value only
    // as what it is, and null brings the default back.
    void palette()
    {
        QString text = QStringLiteral("mine");
        QVERIFY(!PaletteManager::Instance()->GetString(QStringLiteral("AppFontNameWin"), text));
        QCOMPARE(text, QStringLiteral("mine"));
        PaletteManager mine;
        mine.SetColor(QStringLiteral("Frame"), RGBColor(65535, 32768, 1));
        mine.SetUint16(QStringLiteral("Width"), 3);
        mine.SetSInt32(QStringLiteral("Offset"), -4);
        mine.SetString(QStringLiteral("AppFontNameWin"), QStringLiteral("Tahoma"));
        PaletteManager* previous = PaletteManager::SetInstance(&mine);
        const PaletteManager* palette = PaletteManager::Instance();
        RGBColor colour;
        QVERIFY(palette->GetTxRGBColorBasedOnHighlightIndex(QStringLiteral("Frame"), colour));
        QCOMPARE(colour.green, (unsigned short)32768);
        UInt16 u = 9;
        SInt32 offset = 0;
        QVERIFY(palette->GetSInt32(QStringLiteral("Offset"), offset));
        QCOMPARE(offset, SInt32(-4));
        QVERIFY(!palette->GetUint16(QStringLiteral("Offset"), u)); // negative: no 16-bit reading
        QVERIFY(!palette->GetUint16(QStringLiteral("AppFontNameWin"), u));
        QVERIFY(!palette->GetString(QStringLiteral("Width"), text));
        QVERIFY(!palette->GetTxRGBColorBasedOnHighlightIndex(QStringLiteral("Width"), colour));
        QCOMPARE(u, UInt16(9));
        mine.Remove(QStringLiteral("Width"));
        QVERIFY(!palette->GetUint16(QStringLiteral("Width"), u));
        QCOMPARE(PaletteManager::SetInstance(nullptr), &mine);
        QCOMPARE(PaletteManager::Instance(), previous);
    }

    void decorationManagers()
    {
        QVERIFY(!DecorationManager::Instance());
        {
            DecorationManager outer(nullptr, DecorationManager::kMdiNative);
            QCOMPARE(DecorationManager::Instance(), &outer);
            QVERIFY(!DecorationManager::GetHiddenDefaultParent());
            {
                RecordingManager inner(nullptr, 0);
                QWidget hidden;
                inner.parent = &hidden;
                QCOMPARE(DecorationManager::Instance(), static_cast<DecorationManager*>(&inner));
                QCOMPARE(DecorationManager::GetHiddenDefaultParent(), &hidden);
            }
            QCOMPARE(DecorationManager::Instance(), &outer);
        }
        QVERIFY(!DecorationManager::Instance());

        // The factory: replaced, handed back, and null restores the default.
        QVERIFY(DecorationManager::SetFactory(recordingFactory) != recordingFactory);
        std::unique_ptr<DecorationManager> made(DecorationManager::Create(nullptr, 0));
        QVERIFY(dynamic_cast<RecordingManager*>(made.get()));
        made.reset();
        QVERIFY(DecorationManager::SetFactory(nullptr) == recordingFactory);
        made.reset(DecorationManager::Create(nullptr, 2));
        QVERIFY(!dynamic_cast<RecordingManager*>(made.get()));
        QCOMPARE(made->MdiMode(), 2);
    }

    void windowWithoutDecorator()
    {
        QWidget widget;
        widget.setGeometry(10, 20, 120, 80);
        TestWindow window(&widget);
        int moves = 0;
        window.InstallManagedWindowHasMovedHandler(countMove, &moves);

        QCOMPARE(window.GetTopWindow(), &widget);
        QCOMPARE(window.ReferenceOrigin(), QPoint(0, 0));
        QCOMPARE(window.ContentGeometry(), QRect(10, 20, 120, 80));
        QVERIFY(!window.IsGrowBoxIconDrawnByDecorator());
        window.MoveWindow(QPoint(200, 150));
        QCOMPARE(window.ContentGeometry().topLeft(), QPoint(200, 150));
        window.SetContentSize(QSize(300, 40));
        QCOMPARE(widget.size(), QSize(300, 40));
        window.SetContentGeometry(QRect(5, 6, 70, 80));
        QCOMPARE(window.ContentGeometry(), QRect(5, 6, 70, 80));
        QCOMPARE(moves, 2);
    }

    void windowWithDecorator()
    {
        QWidget widget;
        TestWindow window(&widget);
        TestDecorator decorator;
        window.SetDecorator(&decorator);
        int moves = 0;
        window.InstallManagedWindowHasMovedHandler(countMove, &moves);

        QCOMPARE(window.ReferenceOrigin(), QPoint(100, 50));
        QVERIFY(window.IsGrowBoxIconDrawnByDecorator());
        window.MoveWindow(QPoint(30, 40));
        QCOMPARE(window.FrameGeometry(), QRect(30, 20, 200, 120));
        window.SetFrameGeometry(QRect(0, 0, 50, 60));
        QCOMPARE(window.ContentGeometry(), QRect(0, 20, 50, 40));
        window.SetContentSize(QSize(11, 12));
        QCOMPARE(decorator.content.size(), QSize(11, 12));
        window.SelectWindow();
        QCOMPARE(decorator.selections, 1);
        QCOMPARE(moves, 2);
    }

    void childWidgetWindow()
    {
        QWidget top;
        top.setGeometry(300, 200, 400, 300);
        auto* child = new QWidget(&top);
        child->setGeometry(10, 30, 100, 50);
        TestWindow window(child);
        QCOMPARE(window.GetTopWindow(), &top);
        QCOMPARE(window.ContentGeometry(), QRect(310, 230, 100, 50));
        // Moving the content moves the whole top-level window with it.
        window.MoveWindow(QPoint(320, 260));
        QCOMPARE(window.ContentGeometry().topLeft(), QPoint(320, 260));
        QCOMPARE(child->pos(), QPoint(10, 30));
    }

    void visibilityAndClosing()
    {
        RecordingManager manager(nullptr, 0);
        QWidget widget;
        widget.resize(50, 50);
        TestWindow window(&widget);
        TestDecorator decorator;
        window.SetDecorator(&decorator);
        QVERIFY(!window.IsCurrentlyVisible());
        window.SetWindowVisible(true);
        QVERIFY(window.IsCurrentlyVisible());
        window.CloseWindow();
        QVERIFY(!window.IsCurrentlyVisible());
        QVERIFY(!window.GetDecorator());
        QCOMPARE(manager.undecorated, QList<ManagedWindow*>{&window});

        TestWindow orphan(nullptr); // a window whose widget is gone answers safely
        QVERIFY(!orphan.GetTopWindow());
        QVERIFY(orphan.ContentGeometry().isNull());
        orphan.MoveWindow(QPoint(1, 1));
        orphan.SetFrameGeometry(QRect(0, 0, 5, 5));
        orphan.SelectAndShow();
        QVERIFY(!orphan.IsCurrentlyVisible());
    }

    void leftButtonSource()
    {
        QVERIFY(!Brindle::isLeftButtonDown_sys()); // nobody holds a button on the test display
        Brindle::SetLeftButtonSource(buttonHeld);
        QVERIFY(Brindle::isLeftButtonDown_sys());
        QVERIFY(Brindle::SetLeftButtonSource(nullptr) == buttonHeld);
        QVERIFY(!Brindle::isLeftButtonDown_sys());
    }

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

VELMAR_TEST_MAIN(TestHostServices)
#include "tst_hostservices.moc"
