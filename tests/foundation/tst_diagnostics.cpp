// Log line format, category gating, the assertion dialog's rules and the fatal-error answers.
#include "TestSupport.h"

#include <Velmar/Diagnostics.h>

#include "events/EventQueue.h"
#include "foundation/DiagnosticsPrivate.h"
#include "foundation/MessageHandler.h"

#include <QMessageBox>
#include <QProcess>
#include <QThread>
#include <QPushButton>
#include <QRegularExpression>

#include <cstring>

using namespace Velmar;
using Velmar::Private::formatLogLine;
using Velmar::Private::kLogLineBufferSize;

namespace {

QString formatted(QtMsgType type, qint64 ms, const QByteArray& text)
{
    static char buffer[kLogLineBufferSize];
    const std::size_t length = formatLogLine(buffer, type, ms, text.constData());
    const QString line = QString::fromLocal8Bit(buffer);
    return qsizetype(length) == line.size() ? line : QStringLiteral("<length mismatch>");
}

void assertAt(int line, const char* function = "someFunction")
{
    velmar_assert("x > 0", "Window.cpp", line, function, nullptr);
}

} // namespace

class TestDiagnostics : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void init()
    {
        Private::resetAssertionState();
        SetLogCategory(0xFFFFFFFF, false);
    }

    void lineFormat_data()
    {
        QTest::addColumn<int>("type");
        QTest::addColumn<qint64>("ms");
        QTest::addColumn<QString>("expected");
        QTest::newRow("debug at start") << int(QtDebugMsg) << qint64(0)
                                        << QStringLiteral("[   0.000][DEBUG]: hi\n");
        QTest::newRow("warning") << int(QtWarningMsg) << qint64(12345)
                                 << QStringLiteral("[  12.345][WARNING]: hi\n");
        QTest::newRow("critical") << int(QtCriticalMsg) << qint64(7)
                                  << QStringLiteral("[   0.007][CRITICAL]: hi\n");
        QTest::newRow("fatal") << int(QtFatalMsg) << qint64(1000)
                               << QStringLiteral("[   1.000][FATAL]: hi\n");
        QTest::newRow("info has no label of its own") << int(QtInfoMsg) << qint64(1)
                                  << QStringLiteral("[   0.001][UNKNOWN]: hi\n");
        QTest::newRow("wider than eight is not cut") << int(QtDebugMsg) << qint64(123456789)
                                  << QStringLiteral("[123456.789][DEBUG]: hi\n");
    }

    void lineFormat()
    {
        QFETCH(int, type);
        QFETCH(qint64, ms);
        QFETCH(QString, expected);
        QCOMPARE(formatted(QtMsgType(type), ms, "hi"), expected);
    }

    void longLinesAreCutWithoutNewline()
    {
        const int prefix = int(std::strlen("[   0.000][DEBUG]: "));
        const int limit = int(kLogLineBufferSize) - 1;

        // One short of the limit: the newline still fits.
        QString fits = formatted(QtDebugMsg, 0, QByteArray(limit - prefix - 1, 'a'));
        QCOMPARE(fits.size(), limit);
        QVERIFY(fits.endsWith(u'\n'));

        // Text reaching the limit loses the newline; longer text is cut at the limit.
        for (int extra : {0, 1, 20000}) {
            QString cut = formatted(QtDebugMsg, 0, QByteArray(limit - prefix + extra, 'b'));
            QCOMPARE(cut.size(), limit);
            QVERIFY(cut.endsWith(u'b'));
        }
    }

    void handlerWritesThroughHook()
    {
        VelmarTest::LogCapture log;
        qWarning("handler %d", 42);
        qInfo("informative");
        QCOMPARE(log.lines().size(), 2);
        static const QRegularExpression warning(
            QStringLiteral("^\\[ *\\d+\\.\\d{3}\\]\\[WARNING\\]: handler 42\\n$"));
        QVERIFY2(warning.match(log.lines().at(0)).hasMatch(), qPrintable(log.lines().at(0)));
        QVERIFY(log.lines().at(1).contains(QStringLiteral("][UNKNOWN]: informative")));

        // DebugStr logs a Pascal string's text, and nothing for null.
        const unsigned char text[] = "\x05hello world";
        DebugStr(text);
        DebugStr(nullptr);
        QCOMPARE(log.lines().size(), 4);
        QVERIFY(log.lines().at(2).endsWith(QStringLiteral("[DEBUG]: hello\n")));
        QVERIFY(log.lines().at(3).endsWith(QStringLiteral("[DEBUG]: \n")));
    }

    // Run by fatalMessageAborts in a child process only.
    void fatalChild()
    {
        if (qEnvironmentVariableIsEmpty("VELMAR_FATAL_CHILD"))
            QSKIP("only as the child process of fatalMessageAborts");
        Private::installMessageHandler();
        qFatal("dying now");
    }

    void fatalMessageAborts()
    {
#ifdef Q_OS_WIN
        QSKIP("the line goes to the debugger, not to standard error");
#endif
        QProcess child;
        QProcessEnvironment env = QProcessEnvironment::systemEnvironment();
        env.insert(QStringLiteral("VELMAR_FATAL_CHILD"), QStringLiteral("1"));
        child.setProcessEnvironment(env);
        child.start(QCoreApplication::applicationFilePath(), {QStringLiteral("fatalChild")});
        QVERIFY(child.waitForFinished(60000));
        QCOMPARE(child.exitStatus(), QProcess::CrashExit);
        const QString err = QString::fromLocal8Bit(child.readAllStandardError());
        QVERIFY2(err.contains(QStringLiteral("][FATAL]: dying now\n")), qPrintable(err));
    }

    void categoryGating()
    {
        QCOMPARE(LogCategoryName(kLogEvents | kLogMenus), "N/A"); // one category at a time
        VelmarTest::LogCapture log;
        VelmarLog(kLogNotImpl, "PlotCIcon %d", 7);
        QVERIFY(log.lines().isEmpty());

        SetLogCategory(kLogNotImpl | kLogMenus, true);
        QVERIFY(LogCategoryEnabled(kLogMenus));
        VelmarLog(kLogNotImpl, "PlotCIcon %d", 7);
        QCOMPARE(log.lines().size(), 1);
        QVERIFY(log.lines().at(0).endsWith(QStringLiteral("[DEBUG]: [NotImpl] PlotCIcon 7\n")));

        SetLogCategory(kLogNotImpl, false);
        QVERIFY(LogCategoryEnabled(kLogMenus));
        VelmarLog(kLogNotImpl, "again");
        VelmarLog(kLogEvents, "never on");
        QCOMPARE(log.lines().size(), 1);

        // Messages are cut at 1023 characters.
        SetLogCategory(kLogEvents, true);
        const QByteArray big(5000, 'z');
        VelmarLog(kLogEvents, "%s", big.constData());
        QCOMPARE(log.lines().size(), 2);
        QCOMPARE(log.lines().at(1).count(u'z'), 1023);
    }

    void assertionTextAndQuestion()
    {
        VelmarTest::LogCapture log;
        VelmarTest::ScriptedAutomationListener listener({QStringLiteral("Ignore")});
        velmar_assert("port != NULL", "Port.cpp", 12, "SetPort", "no port");
        QCOMPARE(listener.count(), 1);
        const auto& q = listener.questions().at(0);
        QCOMPARE(q.title, QStringLiteral("Velmar assert"));
        QCOMPARE(q.choices, QStringLiteral("Abort|Retry|Ignore|Ignore All"));
        QCOMPARE(q.text, QStringLiteral("no port\nvelmar_assert: port != NULL\n"
                                        "Location: Port.cpp:12 SetPort"));
        QVERIFY(log.contains(QStringLiteral("[DEBUG]: no port\nvelmar_assert: port != NULL")));

        // Without a message the text starts with the expression.
        velmar_assert("ok", "Port.cpp", 13, "SetPort", nullptr);
        QCOMPARE(listener.questions().at(1).text,
                 QStringLiteral("velmar_assert: ok\nLocation: Port.cpp:13 SetPort"));
    }

    void ignoreAllSilencesOnlyThatLocation()
    {
        VelmarTest::LogCapture log;
        VelmarTest::ScriptedAutomationListener listener({QStringLiteral("Ignore All")},
                                                         QStringLiteral("Ignore"));
        assertAt(40);
        assertAt(40);
        assertAt(40);
        QCOMPARE(listener.count(), 1);
        QCOMPARE(log.count(QStringLiteral("Location: Window.cpp:40 someFunction")), 3);

        assertAt(41);                 // another line in the same file
        assertAt(40, "otherFunction"); // same line, another function
        QCOMPARE(listener.count(), 3);

        // Plain "Ignore" asks again next time.
        assertAt(41);
        QCOMPARE(listener.count(), 4);
    }

    void assertionsNeverNest()
    {
        VelmarTest::LogCapture log;
        VelmarTest::ScriptedAutomationListener listener;
        int inner = 0;
        bool blockedDuringDialog = false;
        listener.setResponder([&](const VelmarTest::ScriptedAutomationListener::Question&) {
            // Carbon events wait while the user is asked.
            blockedDuringDialog = Private::MainEventQueue()->CheckCarbonEventsDisabled();
            if (inner++ == 0)
                assertAt(99, "nested");
            return QStringLiteral("Ignore");
        });
        assertAt(98);
        QVERIFY(blockedDuringDialog);
        QVERIFY(!Private::MainEventQueue()->CheckCarbonEventsDisabled());
        QCOMPARE(listener.count(), 1);
        QCOMPARE(log.count(QStringLiteral(
                     "velmar_assert: another assert is displayed. Something bad happens")),
                 1);
        QVERIFY(log.contains(QStringLiteral("Location: Window.cpp:99 nested")));

        // The dialog is free again afterwards.
        assertAt(99, "nested");
        QCOMPARE(listener.count(), 2);
    }

    void realAssertBoxIgnoreAll()
    {
        QString title;
        int buttons = 0;
        {
            VelmarTest::ModalActor actor([&](QWidget* modal) {
                auto* box = qobject_cast<QMessageBox*>(modal);
                QVERIFY(box);
                title = box->windowTitle();
                buttons = int(box->buttons().size());
                QCOMPARE(box->defaultButton(), box->button(QMessageBox::Ignore));
                for (QAbstractButton* b : box->buttons()) {
                    if (b->text() == QStringLiteral("Ignore all"))
                        b->click();
                }
            });
            assertAt(120);
            QVERIFY(actor.acted());
        }
        QCOMPARE(title, QStringLiteral("Velmar assert"));
        QCOMPARE(buttons, 4);

        // Ignored for good: no box appears.
        VelmarTest::ModalActor actor([](QWidget*) {});
        assertAt(120);
        QTest::qWait(100);
        QVERIFY(!actor.acted());
    }

    void assertionOffTheGuiThreadShowsNoBox()
    {
        VelmarTest::LogCapture log;
        VelmarTest::ModalActor actor([](QWidget*) {});
        QThread* worker = QThread::create([] { assertAt(300, "worker"); });
        worker->start();
        QVERIFY(worker->wait(30000));
        delete worker;
        QVERIFY(log.contains(QStringLiteral("Location: Window.cpp:300 worker")));
        QVERIFY(!actor.acted());
    }

    void fatalErrAnswers_data()
    {
        QTest::addColumn<QString>("answer");
        QTest::addColumn<int>("result");
        QTest::newRow("create report") << QStringLiteral("Create Report") << 3;
        QTest::newRow("exit") << QStringLiteral("Exit Application") << 2;
        QTest::newRow("continue") << QStringLiteral("Continue") << 5;
        QTest::newRow("debugger") << QStringLiteral("Debugger") << 4;
        QTest::newRow("by index") << QStringLiteral("2") << 5;
        QTest::newRow("closed") << QStringLiteral("") << 4;
    }

    void fatalErrAnswers()
    {
        QFETCH(QString, answer);
        QFETCH(int, result);
        VelmarTest::ScriptedAutomationListener listener({answer});
        QCOMPARE(int(FatalErrDialog("disk full", "Save.cpp", 77)), result);
        QCOMPARE(listener.count(), 1);
        const auto& q = listener.questions().at(0);
        QCOMPARE(q.title, QStringLiteral("An error has occurred"));
        QCOMPARE(q.choices, QStringLiteral("Create Report|Exit Application|Continue|Debugger"));
        QCOMPARE(q.text, QStringLiteral("An error has occurred:disk full\nFile: Save.cpp,  Line: 77"));
    }

    void realFatalBox()
    {
        // Closing the box counts as "Debugger".
        {
            VelmarTest::ModalActor actor([](QWidget* modal) { modal->close(); });
            QCOMPARE(int(FatalErrDialog("m", "f.cpp", 1)), 4);
            QVERIFY(actor.acted());
        }

        QStringList buttons;
        VelmarTest::ModalActor actor([&](QWidget* modal) {
            auto* box = qobject_cast<QMessageBox*>(modal);
            QVERIFY(box);
            QCOMPARE(box->defaultButton()->text(), QStringLiteral("Continue"));
            for (QAbstractButton* b : box->buttons())
                buttons << b->text();
            box->defaultButton()->click();
        });
        QCOMPARE(int(FatalErrDialog("m", "f.cpp", 1)), 5);
        buttons.sort();
        QCOMPARE(buttons, (QStringList{QStringLiteral("Continue"), QStringLiteral("Create Report"),
                                       QStringLiteral("Debugger"),
                                       QStringLiteral("Exit Application")}));
    }

    void stackLoggerMissingIsQuiet()
    {
        VelmarTest::LogCapture log;
        StartLoggingStackCalls();
        StartLoggingStackCalls();
        QVERIFY(!Private::stackLoggerEntry());
        QVERIFY(log.lines().isEmpty());
    }
};

VELMAR_TEST_MAIN(TestDiagnostics)
#include "tst_diagnostics.moc"
