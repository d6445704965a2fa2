// Process and window services of the platform layer.
#include "TestSupport.h"

#include "platform/Platform.h"

#include <QCoreApplication>
#include <QFile>
#include <QImage>
#include <QWidget>

#include <cstring>

using namespace Velmar::Private;

class SystemTest : public QObject {
    Q_OBJECT
private Q_SLOTS:
    void libraries();
    void executableDirectory();
    void windowImages_data();
    void windowImages();
    void siblingStacking();
    void nullWidgetsAreHarmless();
    void debugBreakWithoutDebuggerContinues();
    void languageId();
};

void SystemTest::libraries()
{
    QCOMPARE(Platform::sharedLibraryFileName(QStringLiteral("StackLogger")),
             QStringLiteral("libStackLogger.so"));
    void* c = Platform::loadLibrary(QStringLiteral("libc.so.6"));
    QVERIFY(c);
    auto* length = reinterpret_cast<size_t (*)(const char*)>(Platform::resolveSymbol(c, "strlen"));
    QVERIFY(length);
    QCOMPARE(length("four"), size_t(4));
    QVERIFY(!Platform::resolveSymbol(c, "velmar_no_such_symbol"));
    QVERIFY(!Platform::resolveSymbol(nullptr, "strlen"));
    QVERIFY(!Platform::resolveSymbol(c, nullptr));
    QVERIFY(!Platform::loadLibrary(QStringLiteral("/nonexistent/libNothing.so")));
    QVERIFY(!Platform::loadLibrary(QString()));
}

void SystemTest::executableDirectory()
{
    QCOMPARE(Platform::executableDirectory(), QCoreApplication::applicationDirPath());
}

void SystemTest::windowImages_data()
{
    QTest::addColumn<int>("width");
    QTest::addColumn<int>("height");
    QTest::addColumn<bool>("valid");
    QTest::newRow("ordinary") << 40 << 30 << true;
    QTest::newRow("one pixel") << 1 << 1 << true;
    QTest::newRow("zero width") << 0 << 30 << false;
    QTest::newRow("negative") << -5 << -5 << false;
    QTest::newRow("absurd") << 100000 << 100000 << false;
}

void SystemTest::windowImages()
{
    QFETCH(int, width);
    QFETCH(int, height);
    QFETCH(bool, valid);
    if (width > 32767)
        QTest::ignoreMessage(QtWarningMsg, "createWindowImage: refused size 100000 x 100000");
    const QImage image = Platform::createWindowImage(width, height);
    QCOMPARE(!image.isNull(), valid);
    if (valid) {
        QCOMPARE(image.size(), QSize(width, height));
        QCOMPARE(image.format(), QImage::Format_ARGB32_Premultiplied);
    }
}

void SystemTest::siblingStacking()
{
    QWidget parent;
    auto* a = new QWidget(&parent);
    auto* b = new QWidget(&parent);
    // Children are stacked in list order, later on top.
    QVERIFY(parent.children().indexOf(a) < parent.children().indexOf(b));
    Platform::placeNativeWindowBehind(b, a);
    QVERIFY(parent.children().indexOf(b) < parent.children().indexOf(a));
    Platform::placeNativeWindowBehind(a, nullptr);
    QVERIFY(parent.children().indexOf(a) < parent.children().indexOf(b));
}

void SystemTest::nullWidgetsAreHarmless()
{
    QVERIFY(!Platform::nativeWindowHandle(nullptr));
    Platform::placeNativeWindowBehind(nullptr, nullptr);
    QWidget top;
    Platform::placeNativeWindowBehind(&top, &top);
    QWidget other;
    Platform::placeNativeWindowBehind(&top, &other); // top-levels: the window manager's
    Platform::debugOutput(nullptr);
}

void SystemTest::debugBreakWithoutDebuggerContinues()
{
    QFile status(QStringLiteral("/proc/self/status"));
    QVERIFY(status.open(QIODevice::ReadOnly));
    if (!status.readAll().contains("TracerPid:\t0"))
        QSKIP("running under a debugger: the break would stop here");
    Platform::debugBreak();
}

void SystemTest::languageId()
{
    const int id = Platform::keyboardLanguageId();
    QVERIFY(id > 0 && id <= 0xFFFF);
}

VELMAR_TEST_MAIN(SystemTest)
#include "tst_system.moc"
