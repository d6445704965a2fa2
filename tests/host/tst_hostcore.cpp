// Default host core services and their replacement by a host.
#include "TestSupport.h"

#include <Velmar/HostCore.h>
#include <Velmar/TextUtils.h>

#include <QGuiApplication>
#include <QScreen>
#include <QTemporaryDir>

using namespace Velmar;

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

} // namespace

class HostCoreTest : public QObject {
    Q_OBJECT
private Q_SLOTS:
    void ticksAdvance()
    {
        const UInt32 start = TxGetTicks();
        QTest::qSleep(250); // about 15 ticks; only sanity bounds, never timing
        const UInt32 elapsed = TxGetTicks() - start;
        QVERIFY(elapsed >= 1 && elapsed < 60 * 30);
    }

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
};

VELMAR_TEST_MAIN(HostCoreTest)
#include "tst_hostcore.moc"
