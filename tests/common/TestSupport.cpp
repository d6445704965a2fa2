#include "TestSupport.h"

#include <Velmar/Diagnostics.h>

#include "foundation/MessageHandler.h"

#include <QApplication>
#include <QDialog>
#include <QSettings>
#include <QTimer>

#include <algorithm>

namespace VelmarTest {

LogCapture::LogCapture()
{
    // QtTest installs its own message handler while it runs; put the library's back so that
    // every qDebug/qWarning of the code under test becomes a formatted line here.
    m_previousHandler = Velmar::Private::installMessageHandler();
    Velmar::SetDebugOutputHook(&LogCapture::hook, this);
}

LogCapture::~LogCapture()
{
    Velmar::SetDebugOutputHook(nullptr, nullptr);
    qInstallMessageHandler(m_previousHandler);
}

void LogCapture::hook(const char* line, void* context)
{
    static_cast<LogCapture*>(context)->m_lines.append(QString::fromLocal8Bit(line));
}

int LogCapture::count(const QString& fragment) const
{
    return int(std::count_if(m_lines.cbegin(), m_lines.cend(),
                             [&](const QString& line) { return line.contains(fragment); }));
}

ScriptedAutomationListener::ScriptedAutomationListener(QStringList answers, QString fallback)
    : m_answers(std::move(answers)), m_fallback(std::move(fallback)),
      m_previous(Velmar::AutomationListenerManager::SetListener(this))
{
}

ScriptedAutomationListener::~ScriptedAutomationListener()
{
    Velmar::AutomationListenerManager::SetListener(m_previous);
}

QString ScriptedAutomationListener::AnswerDialog(const QString& title, const QString& text,
                                                 const QString& choices)
{
    m_questions.append({title, text, choices});
    if (m_responder)
        return m_responder(m_questions.last());
    return m_answers.isEmpty() ? m_fallback : m_answers.takeFirst();
}

ModalActor::ModalActor(std::function<void(QWidget* modal)> act)
    : m_act(std::move(act)), m_context(new QObject), m_thread(new QThread),
      m_previousListener(Velmar::AutomationListenerManager::SetListener(nullptr))
{
    // The clock ticks in its own thread and calls back through queued calls: the
    // application postpones GUI-thread timers while Carbon events are blocked (as they are
    // under an assertion box), but never posted calls.
    auto* timer = new QTimer;
    timer->setInterval(20);
    timer->moveToThread(m_thread);
    QObject::connect(m_thread, &QThread::started, timer, qOverload<>(&QTimer::start));
    QObject::connect(m_thread, &QThread::finished, timer, &QObject::deleteLater);
    QObject::connect(timer, &QTimer::timeout, m_context, [this] { poll(); },
                     Qt::QueuedConnection);
    m_thread->start();
}

ModalActor::~ModalActor()
{
    m_thread->quit();
    m_thread->wait();
    delete m_thread;
    delete m_context; // drops calls still queued
    Velmar::AutomationListenerManager::SetListener(m_previousListener);
}

void ModalActor::poll()
{
    if (m_done)
        return;
    // Gives up after ~5 s, closing whatever is modal, so that no test hangs on a box.
    QWidget* modal = QApplication::activeModalWidget();
    if (modal && !m_acted) {
        m_acted = true;
        m_act(modal);
        modal = QApplication::activeModalWidget();
    }
    const bool givingUp = ++m_attempts > 250;
    if (modal && (m_acted || givingUp)) {
        if (auto* dialog = qobject_cast<QDialog*>(modal))
            dialog->reject();
        modal->close();
    }
    m_done = m_acted || givingUp;
}

QString assertionText(const QString& dialogText)
{
    QString first = dialogText.section(u'\n', 0, 0);
    if (first.startsWith(QLatin1String("velmar_assert: ")))
        first.remove(0, int(qstrlen("velmar_assert: ")));
    return first;
}

namespace {

class UnexpectedAssertionGuard : public Velmar::AutomationListener {
public:
    QString AnswerDialog(const QString& title, const QString& text,
                         const QString& choices) override
    {
        if (title == QLatin1String("Velmar assert")) {
            const QByteArray what = "unexpected assertion: " + text.toLocal8Bit();
            if (QTest::currentTestFunction())
                QTest::qFail(what.constData(), __FILE__, __LINE__);
            else
                qWarning("%s", what.constData());
            return QStringLiteral("Ignore");
        }
        return choices.section(u'|', -1);
    }
};

} // namespace

void installUnexpectedAssertionGuard()
{
    static UnexpectedAssertionGuard sGuard;
    Velmar::AutomationListenerManager::SetListener(&sGuard);
}

void SequenceRecorder::recordOnce(const QString& entry)
{
    if (m_entries.isEmpty() || m_entries.last() != entry)
        m_entries << entry;
}

namespace {

// Whether actual[a..] fits expected[e..]; small lists, so plain backtracking.
bool fits(const QStringList& expected, qsizetype e, const QStringList& actual, qsizetype a)
{
    if (e == expected.size())
        return a == actual.size();
    const QString& want = expected[e];
    if (want == u'*') {
        for (qsizetype skip = a; skip <= actual.size(); ++skip) {
            if (fits(expected, e + 1, actual, skip))
                return true;
        }
        return false;
    }
    if (want.startsWith(u'?')) {
        if (a < actual.size() && actual[a] == want.mid(1) && fits(expected, e + 1, actual, a + 1))
            return true;
        return fits(expected, e + 1, actual, a);
    }
    return a < actual.size() && actual[a] == want && fits(expected, e + 1, actual, a + 1);
}

} // namespace

QString SequenceRecorder::mismatch(const QString& name, const QStringList& expected,
                                   const QStringList& actual)
{
    if (fits(expected, 0, actual, 0))
        return QString();
    QString text = QStringLiteral("sequence \"%1\" does not fit\n  expected:").arg(name);
    for (const QString& e : expected)
        text += QStringLiteral("\n    ") + e;
    text += QStringLiteral("\n  actual:");
    for (const QString& e : actual)
        text += QStringLiteral("\n    ") + e;
    return text;
}

void isolateSettings()
{
    static QTemporaryDir dir;
    qputenv("XDG_CONFIG_HOME", dir.path().toLocal8Bit());
    QSettings::setPath(QSettings::NativeFormat, QSettings::UserScope, dir.path());
    QSettings::setPath(QSettings::IniFormat, QSettings::UserScope, dir.path());
}

QStringList IgnoredAssertions::texts() const
{
    QStringList out;
    for (const Question& q : questions())
        out << assertionText(q.text);
    return out;
}

} // namespace VelmarTest
