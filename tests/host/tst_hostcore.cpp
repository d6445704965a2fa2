// Default host core services and their replacement by a host.
#include "TestSupport.h"

#include <Velmar/HostCore.h>

#include <QGuiApplication>
#include <QScreen>
#include <QTemporaryDir>

#include <cstring>

using namespace Velmar;

namespace {

UInt32 fixedTicks()
{
    return 1234;
}

bool alwaysForeground()
{
    return true;
}

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

class FixedScreens : public AScreenManOS {
public:
    SInt16 GetMenuBarHeight(SInt32) const override { return 42; }
    QRect GetUsableRect(SInt32) const override { return QRect(0, 22, 800, 578); }
};

const XError* gLogged = nullptr;
void recordXError(const XError& error)
{
    gLogged = &error;
}

class Listener : public AutomationListener {
public:
    QString AnswerDialog(const QString& t, const QString& x, const QString& c) override
    {
        title = t;
        text = x;
        choices = c;
        return answer;
    }
    QString answer, title, text, choices;
};

} // namespace

class HostCoreTest : public QObject {
    Q_OBJECT
private Q_SLOTS:
    void ticksAdvanceMonotonically();
    void tickAndForegroundSourcesAreReplaceable();
    void handles_data();
    void handles();
    void handleCopiesAreIndependent();
    void unusableHandlesAreRefused();
    void handleAllocatorIsReplaceable();
    void textTable();
    void textTableLoadsTranslations();
    void textTableIsReplaceable();
    void screens();
    void screenManagerIsReplaceable();
    void xerror();
    void xerrorLog();
    void automationListener();
};

void HostCoreTest::ticksAdvanceMonotonically()
{
    UInt32 previous = TxGetTicks();
    for (int i = 0; i < 20; ++i) {
        const UInt32 now = TxGetTicks();
        QVERIFY(now >= previous);
        previous = now;
    }
    const UInt32 start = TxGetTicks();
    QTest::qSleep(250); // about 15 ticks; only sanity bounds, never timing
    const UInt32 elapsed = TxGetTicks() - start;
    QVERIFY(elapsed >= 1);
    QVERIFY(elapsed < 60 * 30);
}

void HostCoreTest::tickAndForegroundSourcesAreReplaceable()
{
    SetTickSource(fixedTicks);
    QCOMPARE(TxGetTicks(), UInt32(1234));
    QVERIFY(SetTickSource(nullptr) == &fixedTicks);
    QVERIFY(SetTickSource(nullptr) != &fixedTicks); // the default is back

    SetForegroundSource(alwaysForeground);
    QVERIFY(isRunningInForeground());
    QVERIFY(SetForegroundSource(nullptr) == &alwaysForeground);
    // The default follows Qt's application state; no window is active in this test.
    QCOMPARE(isRunningInForeground(),
             QGuiApplication::applicationState() == Qt::ApplicationActive);
}

void HostCoreTest::handles_data()
{
    QTest::addColumn<int>("size");
    QTest::newRow("empty") << 0;
    QTest::newRow("one byte") << 1;
    QTest::newRow("Pascal string") << 256;
    QTest::newRow("large") << 100000;
}

void HostCoreTest::handles()
{
    QFETCH(int, size);
    QByteArray bytes(size, Qt::Uninitialized);
    for (int i = 0; i < size; ++i)
        bytes[i] = char(i * 7 + 1);
    Handle h = TxPtrToHand(bytes.constData(), size);
    QVERIFY(h && *h);
    QVERIFY(TxIsValidHandle(h));
    QCOMPARE(TxGetHandleSize(h), Size(size));
    QCOMPARE(QByteArray(*h, size), bytes);
    QCOMPARE((*h)[size], '\0'); // text handles can be read as C strings

    Handle zeroed = TxPtrToHand(nullptr, size);
    QVERIFY(zeroed);
    QCOMPARE(QByteArray(*zeroed, size), QByteArray(size, '\0'));

    TxDisposeHandle(h);
    TxDisposeHandle(zeroed);
    QVERIFY(!TxIsValidHandle(h));
    QCOMPARE(TxGetHandleSize(h), Size(-1));
}

void HostCoreTest::handleCopiesAreIndependent()
{
    const char text[] = "\x05hello";
    Handle original = TxPtrToHand(text, 6);
    Handle copy = TxCopyHand(original);
    QVERIFY(copy && copy != original && *copy != *original);
    QCOMPARE(TxGetHandleSize(copy), Size(6));
    (*copy)[1] = 'J';
    QCOMPARE(QByteArray(*original, 6), QByteArray(text, 6));
    TxDisposeHandle(original);
    QCOMPARE(QByteArray(*copy, 6), QByteArray("\x05Jello", 6)); // outlives its source
    TxDisposeHandle(copy);
}

void HostCoreTest::unusableHandlesAreRefused()
{
    VelmarTest::LogCapture log;
    TxDisposeHandle(nullptr);
    QVERIFY(!TxCopyHand(nullptr));
    QCOMPARE(TxGetHandleSize(nullptr), Size(-1));

    Handle h = TxPtrToHand("abc", 3);
    TxDisposeHandle(h);
    TxDisposeHandle(h); // twice: refused, not freed again
    QVERIFY(log.contains(QStringLiteral("TxDisposeHandle: not a live handle")));
    QVERIFY(!TxCopyHand(h));

    char block[16] = {};
    Ptr master = block;
    QVERIFY(!TxIsValidHandle(&master)); // a foreign master pointer is never taken for ours
    TxDisposeHandle(&master);

    QVERIFY(!TxPtrToHand("x", -1));
    QVERIFY(!TxPtrToHand(nullptr, 0x7fffffff));
    QVERIFY(log.contains(QStringLiteral("TxPtrToHand: refused size")));
}

void HostCoreTest::handleAllocatorIsReplaceable()
{
    CountingAllocator counting(HandleAllocator::Get());
    HandleAllocator* previous = HandleAllocator::SetInstance(&counting);
    Handle h = TxPtrToHand("ab", 2);
    Handle c = TxCopyHand(h);
    TxDisposeHandle(h);
    TxDisposeHandle(c);
    QCOMPARE(counting.made, 2);
    QCOMPARE(counting.disposed, 2);
    QCOMPARE(HandleAllocator::SetInstance(nullptr), &counting);
    QCOMPARE(HandleAllocator::Get(), previous);
}

void HostCoreTest::textTable()
{
    TextTable* table = TextTable::Get();
    QCOMPARE(table->Translate("Untranslated key"), QStringLiteral("Untranslated key"));
    QCOMPARE(table->Translate(nullptr), QString());
    QVERIFY(!table->HasTranslation("Cancel"));
    table->Insert(QStringLiteral("Cancel"), QStringLiteral("Abbrechen"));
    QVERIFY(table->HasTranslation("Cancel"));
    QCOMPARE(QByteArray(stx_func("Cancel").c_str()), QByteArray("Abbrechen"));
    QCOMPARE(stx_func("Other").text(), QStringLiteral("Other"));
    table->Clear();
    QCOMPARE(table->Translate("Cancel"), QStringLiteral("Cancel"));
}

void HostCoreTest::textTableLoadsTranslations()
{
    QTemporaryDir dir;
    const QString good = dir.filePath(QStringLiteral("texts.json"));
    QFile file(good);
    QVERIFY(file.open(QIODevice::WriteOnly));
    file.write(QStringLiteral("{\"Open\": \"Öffnen\", \"Quit\": \"Beenden\", \"Number\": 3}").toUtf8());
    file.close();
    const QString bad = dir.filePath(QStringLiteral("bad.json"));
    QFile badFile(bad);
    QVERIFY(badFile.open(QIODevice::WriteOnly));
    badFile.write("[\"not an object\"]");
    badFile.close();

    VelmarTest::LogCapture log;
    TextTable table;
    table.Insert(QStringLiteral("Quit"), QStringLiteral("old"));
    table.Insert(QStringLiteral("Keep"), QStringLiteral("kept"));
    QVERIFY(table.LoadJsonFile(good));
    QCOMPARE(table.Translate("Open"), QStringLiteral("Öffnen"));
    QCOMPARE(table.Translate("Quit"), QStringLiteral("Beenden"));
    QCOMPARE(table.Translate("Keep"), QStringLiteral("kept"));
    QVERIFY(!table.HasTranslation("Number")); // only texts are taken
    QVERIFY(!table.LoadJsonFile(bad));
    QVERIFY(!table.LoadJsonFile(dir.filePath(QStringLiteral("missing.json"))));
    QCOMPARE(table.Translate("Open"), QStringLiteral("Öffnen"));
    QCOMPARE(log.count(QStringLiteral("TextTable:")), 2);
}

void HostCoreTest::textTableIsReplaceable()
{
    ShoutingTable shouting;
    TextTable* previous = TextTable::SetInstance(&shouting);
    QCOMPARE(stx_func("quit").text(), QStringLiteral("QUIT"));
    QCOMPARE(TextTable::SetInstance(nullptr), &shouting);
    QCOMPARE(TextTable::Get(), previous);
    QCOMPARE(stx_func("quit").text(), QStringLiteral("quit"));
}

void HostCoreTest::screens()
{
    AScreenManOS* screens = AScreenManOS::Get();
    QVERIFY(screens);
    const SInt32 current = screens->GetCurrentScreen();
    QVERIFY(current >= 0 && current < screens->GetScreenCount());
    QScreen* primary = QGuiApplication::primaryScreen();
    QCOMPARE(screens->GetScreenRect(current), primary->geometry());
    const QPoint centre = primary->geometry().center();
    QCOMPARE(screens->GetScreenForPoint(centre), current);
    QCOMPARE(screens->GetUsableRectForPoint(centre), primary->availableGeometry());
    // A point off every screen belongs to the nearest one.
    QVERIFY(screens->GetScreenForPoint(QPoint(-100000, -100000)) >= 0);
    QVERIFY(!screens->GetUsableRectForPoint(QPoint(-100000, -100000)).isEmpty());
    QVERIFY(screens->GetUsableRect(-1).isNull());
    QVERIFY(screens->GetUsableRect(9999).isNull());
    const SInt16 menuBar = screens->GetMenuBarHeight(current);
    QVERIFY(menuBar > 0 && menuBar < 200);
}

void HostCoreTest::screenManagerIsReplaceable()
{
    FixedScreens fixed;
    AScreenManOS* previous = AScreenManOS::SetInstance(&fixed);
    QCOMPARE(AScreenManOS::Get()->GetMenuBarHeight(AScreenManOS::Get()->GetCurrentScreen()), SInt16(42));
    QCOMPARE(AScreenManOS::Get()->GetUsableRectForPoint(QPoint(5, 5)), QRect(0, 22, 800, 578));
    QCOMPARE(AScreenManOS::SetInstance(nullptr), &fixed);
    QCOMPARE(AScreenManOS::Get(), previous);
}

void HostCoreTest::xerror()
{
    try {
        throw XError("std::exception", "boom", 7, "f.cpp");
    } catch (const XError& e) {
        QCOMPARE(QByteArray(e.GetErrorMessage()), QByteArray("boom"));
        QCOMPARE(QByteArray(e.GetType()), QByteArray("std::exception"));
        QCOMPARE(e.GetLine(), SInt32(7));
        QCOMPARE(QByteArray(e.GetFile()), QByteArray("f.cpp"));
    }
    const XError empty(nullptr, nullptr);
    QCOMPARE(QByteArray(empty.GetErrorMessage()), QByteArray());
    QCOMPARE(QByteArray(empty.GetFile()), QByteArray());
    QCOMPARE(empty.GetLine(), SInt32(0));
}

void HostCoreTest::xerrorLog()
{
    const XError error("std::exception", "boom", 7, "f.cpp");
    QTest::ignoreMessage(QtCriticalMsg, "XError (std::exception):    Error: boom Line: 7 File: f.cpp");
    LogXError(error);

    SetXErrorLogger(recordXError);
    LogXError(error);
    QCOMPARE(gLogged, &error);
    QVERIFY(SetXErrorLogger(nullptr) == &recordXError);
    gLogged = nullptr;
    QTest::ignoreMessage(QtCriticalMsg, "XError (std::exception):    Error: boom Line: 7 File: f.cpp");
    LogXError(error);
    QVERIFY(!gLogged);
}

void HostCoreTest::automationListener()
{
    const QString choices = QStringLiteral("Abort|Retry|Ignore|Ignore All");
    QVERIFY(!AutomationListenerManager::GetListener());
    QCOMPARE(AskAutomationListener(QStringLiteral("t"), QStringLiteral("x"), choices), SInt32(-1));

    Listener listener;
    QVERIFY(!AutomationListenerManager::SetListener(&listener));
    QCOMPARE(AutomationListenerManager::GetListener(), &listener);
    listener.answer = QStringLiteral("ignore all");
    QCOMPARE(AskAutomationListener(QStringLiteral("Velmar assert"), QStringLiteral("text"), choices),
             SInt32(3));
    QCOMPARE(listener.title, QStringLiteral("Velmar assert"));
    QCOMPARE(listener.text, QStringLiteral("text"));
    QCOMPARE(listener.choices, choices);
    listener.answer = QStringLiteral(" 1 ");
    QCOMPARE(AskAutomationListener(QString(), QString(), choices), SInt32(1));
    listener.answer = QStringLiteral("4");
    QCOMPARE(AskAutomationListener(QString(), QString(), choices), SInt32(-1));
    listener.answer = QStringLiteral("Ignore"); // not a prefix of "Ignore All" by mistake
    QCOMPARE(AskAutomationListener(QString(), QString(), choices), SInt32(2));
    listener.answer = QStringLiteral("Later");
    QCOMPARE(AskAutomationListener(QString(), QString(), choices), SInt32(-1));

    QCOMPARE(AutomationListenerManager::SetListener(nullptr), &listener);
    QVERIFY(!AutomationListenerManager::GetListener());
}

VELMAR_TEST_MAIN(HostCoreTest)
#include "tst_hostcore.moc"
