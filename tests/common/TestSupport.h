// Shared helpers for the QtTest executables.
#pragma once

#include <Velmar/Application.h>
#include <Velmar/HostCore.h>

#include <QStringList>
#include <QTemporaryDir>
#include <QThread>
#include <QTimer>
#include <QtTest>

#include <functional>

namespace VelmarTest {

// Collects every log line the library writes while it lives.
class LogCapture {
public:
    LogCapture();
    ~LogCapture();
    LogCapture(const LogCapture&) = delete;
    LogCapture& operator=(const LogCapture&) = delete;

    const QStringList& lines() const { return m_lines; }
    bool contains(const QString& fragment) const { return count(fragment) > 0; }
    int count(const QString& fragment) const;
    void clear() { m_lines.clear(); }

private:
    static void hook(const char* line, void* context);
    QStringList m_lines;
    QtMessageHandler m_previousHandler = nullptr;
};

// Answers every dialog the library asks about while it lives (installed as the host's
// automation listener; the previous listener comes back on destruction). Answers are taken
// from the queue in order; when it runs dry, `fallback` is given. A responder, when set,
// runs instead of the queue and may do anything (raise a nested assertion, for instance).
class ScriptedAutomationListener : public Velmar::AutomationListener {
public:
    struct Question {
        QString title;
        QString text;
        QString choices;
    };
    using Responder = std::function<QString(const Question&)>;

    explicit ScriptedAutomationListener(QStringList answers = {},
                                        QString fallback = QStringLiteral("-1"));
    ~ScriptedAutomationListener() override;
    ScriptedAutomationListener(const ScriptedAutomationListener&) = delete;
    ScriptedAutomationListener& operator=(const ScriptedAutomationListener&) = delete;

    QString AnswerDialog(const QString& title, const QString& text,
                         const QString& choices) override;

    void setResponder(Responder responder) { m_responder = std::move(responder); }
    void queue(const QString& answer) { m_answers.append(answer); }
    const QList<Question>& questions() const { return m_questions; }
    int count() const { return int(m_questions.size()); }

private:
    QStringList m_answers;
    QString m_fallback;
    Responder m_responder;
    QList<Question> m_questions;
    Velmar::AutomationListener* m_previous = nullptr;
};

// Answers every assertion "Ignore" while it lives and keeps the texts raised (as
// assertionText gives them): for calls that are meant to refuse bad input and go on.
class IgnoredAssertions : public ScriptedAutomationListener {
public:
    IgnoredAssertions() : ScriptedAutomationListener({}, QStringLiteral("Ignore")) {}
    QStringList texts() const;
};

// For tests that show a real modal box: while it lives, no automation listener answers (so
// the library shows its real dialogs), and it polls for the active modal widget and hands
// the first one to `act` (which clicks or closes it). If `act` leaves it open, or nothing
// acts within ~5 s, the widget is closed anyway so that no test can hang on a box.
class ModalActor {
public:
    explicit ModalActor(std::function<void(QWidget* modal)> act);
    ~ModalActor();
    ModalActor(const ModalActor&) = delete;
    ModalActor& operator=(const ModalActor&) = delete;

    bool acted() const { return m_acted; }

private:
    void poll();

    std::function<void(QWidget*)> m_act;
    QObject* m_context;
    QThread* m_thread;
    bool m_acted = false;
    bool m_done = false;
    int m_attempts = 0;
    Velmar::AutomationListener* m_previousListener = nullptr;
};

// Points QSettings at a private temporary directory so tests never touch the user's
// real settings. Call before any QSettings object exists (the test main macros do).
void isolateSettings();

// The text an assertion dialog stands for: its first line without "velmar_assert: " (the
// message when one was given, otherwise the assertion text).
QString assertionText(const QString& dialogText);

// Installed by the test mains underneath every other listener: an assertion nothing in the
// test was waiting for fails the running test function (it is answered "Ignore", so the
// code under test goes on) instead of opening a box that nobody answers. Other dialogs are
// answered with their last choice ("Cancel" and the like).
void installUnexpectedAssertionGuard();

// Sets a replaceable hook or service for one scope and puts back what it replaced. Works
// with every setter that returns the previous value: SetWindowEventHooks, setPortWindowHooks,
// SetTickSource, SetRepaintDirtyPortsHook ...
//     VelmarTest::ScopedOverride ticks(&Velmar::SetTickSource, fixedTicks);
template <typename Value, typename Argument>
class ScopedOverride {
public:
    ScopedOverride(Value (*set)(Argument), Value value) : m_set(set), m_previous(set(value)) {}
    ~ScopedOverride() { m_set(m_previous); }
    ScopedOverride(const ScopedOverride&) = delete;
    ScopedOverride& operator=(const ScopedOverride&) = delete;
    const Value& previous() const { return m_previous; }

private:
    Value (*m_set)(Argument);
    Value m_previous;
};

// What happened, in order (events received, handlers called, assertions raised), compared
// with a named expected sequence. In an expected sequence an entry starting with "?" may
// be absent, and "*" stands for any run of entries (none included). On a mismatch both
// sequences are printed whole.
class SequenceRecorder {
public:
    void record(const QString& entry) { m_entries << entry; }
    // Skips an entry that repeats the last one: a run of identical calls shows once, however
    // often a Qt loop spun meanwhile.
    void recordOnce(const QString& entry);
    const QStringList& entries() const { return m_entries; }
    void clear() { m_entries.clear(); }

    // Empty when `actual` fits `expected`, otherwise the whole story for a failure message.
    static QString mismatch(const QString& name, const QStringList& expected,
                            const QStringList& actual);

private:
    QStringList m_entries;
};

// A Pascal string of `text` (up to 255 bytes), and the pointer the Toolbox calls take.
inline QByteArray pascal(const QByteArray& text)
{
    return char(text.size()) + text;
}
inline const unsigned char* P(const QByteArray& p)
{
    return reinterpret_cast<const unsigned char*>(p.constData());
}

} // namespace VelmarTest

// Fails the test unless what `recorder` saw fits the named expected sequence.
#define VELMAR_COMPARE_SEQUENCE(recorder, name, ...)                                        \
    do {                                                                                    \
        const QString velmarWhy = VelmarTest::SequenceRecorder::mismatch(                   \
            (name), QStringList(__VA_ARGS__), (recorder).entries());                       \
        if (!velmarWhy.isEmpty())                                                           \
            QFAIL(qPrintable(velmarWhy));                                                   \
    } while (0)

// A QtTest main that isolates settings first, then runs TestObject under a QApplication.
#define VELMAR_TEST_MAIN(TestObject)                                                        \
    int main(int argc, char** argv)                                                         \
    {                                                                                       \
        VelmarTest::isolateSettings();                                                      \
        QApplication app(argc, argv);                                                       \
        VelmarTest::installUnexpectedAssertionGuard();                                      \
        TestObject tc;                                                                      \
        QTEST_SET_MAIN_SOURCE_PATH                                                          \
        return QTest::qExec(&tc, argc, argv);                                               \
    }

// The same under the library's application object (not decorated), for tests of code that
// needs AQtApplication::instance().
#define VELMAR_APP_TEST_MAIN(TestObject)                                                    \
    int main(int argc, char** argv)                                                         \
    {                                                                                       \
        VelmarTest::isolateSettings();                                                      \
        Velmar::AQtApplication app(argc, argv, false);                                      \
        VelmarTest::installUnexpectedAssertionGuard();                                      \
        TestObject tc;                                                                      \
        QTEST_SET_MAIN_SOURCE_PATH                                                          \
        return QTest::qExec(&tc, argc, argv);                                               \
    }
