// Shared helpers for the QtTest executables.
#pragma once

#include <QStringList>
#include <QTemporaryDir>
#include <QtTest>

namespace VelmarTest {

// Collects every log line the library writes while it lives.
class LogCapture {
public:
    LogCapture();
    ~LogCapture();
    LogCapture(const LogCapture&) = delete;
    LogCapture& operator=(const LogCapture&) = delete;

    const QStringList& lines() const { return m_lines; }
    bool contains(const QString& fragment) const;
    int count(const QString& fragment) const;
    void clear() { m_lines.clear(); }

private:
    static void hook(const char* line, void* context);
    QStringList m_lines;
    QtMessageHandler m_previousHandler = nullptr;
};

// Points QSettings at a private temporary directory so tests never touch the user's
// real settings. Call before any QSettings object exists (the test main macros do).
void isolateSettings();

} // namespace VelmarTest

// A QtTest main that isolates settings first, then runs TestObject under a QApplication.
#define VELMAR_TEST_MAIN(TestObject)                                                        \
    int main(int argc, char** argv)                                                         \
    {                                                                                       \
        VelmarTest::isolateSettings();                                                      \
        QApplication app(argc, argv);                                                       \
        TestObject tc;                                                                      \
        QTEST_SET_MAIN_SOURCE_PATH                                                          \
        return QTest::qExec(&tc, argc, argv);                                               \
    }
