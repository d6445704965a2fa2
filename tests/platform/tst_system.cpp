// Process and window services of the platform layer.
#include "TestSupport.h"

#include "platform/Platform.h"

#include <QCoreApplication>
#include <QFile>
#include <QImage>
#include <QWidget>

using namespace Velmar::Private;

class SystemTest : public QObject {
    Q_OBJECT
private Q_SLOTS:
    void libraries()
    {
        QCOMPARE(Platform::sharedLibraryFileName(QStringLiteral("StackLogger")),
                 QStringLiteral("libStackLogger.so"));
        void* c = Platform::loadLibrary(QStringLiteral("libc.so.6"));
        auto* length = reinterpret_cast<size_t (*)(const char*)>(Platform::resolveSymbol(c, "strlen"));
        QVERIFY(length);
        QCOMPARE(length("four"), size_t(4));
        QVERIFY(!Platform::resolveSymbol(c, "velmar_no_such_symbol"));
        QVERIFY(!Platform::resolveSymbol(nullptr, "strlen"));
        QVERIFY(!Platform::resolveSymbol(c, nullptr));
        QVERIFY(!Platform::loadLibrary(QStringLiteral("/nonexistent/libNothing.so")));
        QVERIFY(!Platform::loadLibrary(QString()));
        QCOMPARE(Platform::executableDirectory(), QCoreApplication::applicationDirPath());
        const int language = Platform::keyboardLanguageId();
        QVERIFY(language > 0 && language <= 0xFFFF);
    }

    void windowImages()
    {
        const QImage image = Platform::createWindowImage(40, 30);
        QCOMPARE(image.size(), QSize(40, 30));
        QCOMPARE(image.format(), QImage::Format_ARGB32_Premultiplied);
        QVERIFY(Platform::createWindowImage(0, 30).isNull());
        QVERIFY(Platform::createWindowImage(-5, -5).isNull());
        QTest::ignoreMessage(QtWarningMsg, "createWindowImage: refused size 100000 x 100000");
        QVERIFY(Platform::createWindowImage(100000, 100000).isNull());
    }

    void siblingStackingAndNulls()
    {
        QWidget parent;
        auto* a = new QWidget(&parent);
        auto* b = new QWidget(&parent);
        // Children are stacked in list order, later on top.
        Platform::placeNativeWindowBehind(b, a);
        QVERIFY(parent.children().indexOf(b) < parent.children().indexOf(a));
        Platform::placeNativeWindowBehind(a, nullptr);
        QVERIFY(parent.children().indexOf(a) < parent.children().indexOf(b));

        QVERIFY(!Platform::nativeWindowHandle(nullptr));
        Platform::placeNativeWindowBehind(nullptr, nullptr);
        Platform::placeNativeWindowBehind(&parent, &parent);
        QWidget other;
        Platform::placeNativeWindowBehind(&parent, &other); // top-levels: the window manager's
        Platform::debugOutput(nullptr);
    }

    void debugBreakWithoutDebuggerContinues()
    {
        QFile status(QStringLiteral("/proc/self/status"));
        QVERIFY(status.open(QIODevice::ReadOnly));
        if (!status.readAll().contains("TracerPid:\t0"))
            QSKIP("running under a debugger: the break would stop here");
        Platform::debugBreak();
    }
};

VELMAR_TEST_MAIN(SystemTest)
#include "tst_system.moc"
