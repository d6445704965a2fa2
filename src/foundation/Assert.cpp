// The assertion dialog and the host's fatal-error dialog.
#include <Velmar/Diagnostics.h>

#include <Velmar/CarbonEventHandlers.h>

#include "foundation/DiagnosticsPrivate.h"
#include "platform/Platform.h"

#include <QApplication>
#include <QCoreApplication>
#include <QMessageBox>
#include <QMutex>
#include <QPushButton>
#include <QSet>
#include <QStringList>
#include <QThread>

#include <array>
#include <cstdlib>

namespace Velmar {

namespace {

// Locations ("file:line function") the developer chose to ignore for good.
QSet<QString>& ignoredLocations()
{
    static QSet<QString> sIgnored;
    return sIgnored;
}

// Held while an assertion dialog shows; assertions never nest.
QMutex gAssertMutex;

enum class AssertChoice { Abort, Retry, Ignore, IgnoreAll };

// Boxes need the widget application and its thread; elsewhere the answer is "go on".
bool canShowWidgets()
{
    QCoreApplication* app = QCoreApplication::instance();
    return qobject_cast<QApplication*>(app) && app->thread() == QThread::currentThread();
}

AssertChoice runAssertDialog(const QString& text)
{
    const QString title = QCoreApplication::translate("velmar_assert", "Velmar assert");
    if (std::optional<int> answer = Private::askAutomationListener(
            title, text, QStringLiteral("Abort|Retry|Ignore|Ignore All"))) {
        switch (*answer) {
        case 0: return AssertChoice::Abort;
        case 1: return AssertChoice::Retry;
        case 3: return AssertChoice::IgnoreAll;
        default: return AssertChoice::Ignore;
        }
    }
    if (!canShowWidgets())
        return AssertChoice::Ignore;

    QMessageBox box(QMessageBox::Critical, title, text,
                    QMessageBox::Abort | QMessageBox::Retry | QMessageBox::Ignore);
    QPushButton* ignoreAll =
        box.addButton(QCoreApplication::translate("velmar_assert", "Ignore all"),
                      QMessageBox::AcceptRole);
    box.setDefaultButton(QMessageBox::Ignore);
    // Abort carries the reject role; closing the box must not end the process.
    box.setEscapeButton(QMessageBox::Ignore);
    box.exec();

    QAbstractButton* clicked = box.clickedButton();
    if (clicked == ignoreAll)
        return AssertChoice::IgnoreAll;
    if (clicked == box.button(QMessageBox::Abort))
        return AssertChoice::Abort;
    if (clicked == box.button(QMessageBox::Retry))
        return AssertChoice::Retry;
    return AssertChoice::Ignore;
}

QString locationKey(const char* file, int line, const char* function)
{
    return QStringLiteral("%1:%2 %3")
        .arg(QString::fromLocal8Bit(file), QString::number(line), QString::fromLocal8Bit(function));
}

} // namespace

void velmar_assert(const char* expression, const char* file, int line, const char* function,
                   const char* message)
{
    QStringList lines;
    if (message)
        lines << QString::fromLocal8Bit(message);
    lines << QStringLiteral("velmar_assert: %1").arg(QString::fromLocal8Bit(expression));
    lines << QStringLiteral("Location: %1").arg(locationKey(file, line, function));
    const QString text = lines.join(u'\n');
    qDebug("%s", qPrintable(text));

    if (!gAssertMutex.tryLock()) {
        qDebug("velmar_assert: another assert is displayed. Something bad happens");
        return;
    }
    const QString key = locationKey(file, line, function);
    if (ignoredLocations().contains(key)) {
        gAssertMutex.unlock();
        return;
    }

    AssertChoice choice;
    {
        // No Carbon handler or event loop timer may run while the developer decides.
        ScopedCarbonEventsBlocker blocker("velmar_assert");
        choice = runAssertDialog(text);
        if (choice == AssertChoice::IgnoreAll)
            ignoredLocations().insert(key);
        gAssertMutex.unlock();
    }

    switch (choice) {
    case AssertChoice::Retry: Private::Platform::debugBreak(); break;
    case AssertChoice::Abort: std::abort();
    case AssertChoice::Ignore:
    case AssertChoice::IgnoreAll: break;
    }
}

SInt16 FatalErrDialog(const char* message, const char* file, int line)
{
    // Host answers in the order of the choices given to the automation listener.
    static constexpr std::array<SInt16, 4> kResults{3, 2, 5, 4};
    constexpr SInt16 kClosed = 4;

    const QString title = QStringLiteral("An error has occurred");
    const QString text = QStringLiteral("An error has occurred:")
        + QStringLiteral("%1\nFile: %2,  Line: %3")
              .arg(QString::fromLocal8Bit(message), QString::fromLocal8Bit(file),
                   QString::number(line));

    if (std::optional<int> answer = Private::askAutomationListener(
            title, text, QStringLiteral("Create Report|Exit Application|Continue|Debugger"))) {
        return (*answer >= 0 && *answer < int(kResults.size())) ? kResults[*answer] : kClosed;
    }
    if (!canShowWidgets())
        return kClosed;

    QMessageBox box(QMessageBox::Critical, title, text, QMessageBox::NoButton);
    const std::array<QPushButton*, 4> buttons{
        box.addButton(QStringLiteral("Create Report"), QMessageBox::ActionRole),
        box.addButton(QStringLiteral("Exit Application"), QMessageBox::ActionRole),
        box.addButton(QStringLiteral("Continue"), QMessageBox::ActionRole),
        box.addButton(QStringLiteral("Debugger"), QMessageBox::ActionRole),
    };
    box.setDefaultButton(buttons[2]);
    // Without an escape button Qt refuses to close the box; closing answers "Debugger".
    box.setEscapeButton(buttons[3]);
    box.exec();
    for (std::size_t i = 0; i < buttons.size(); ++i) {
        if (box.clickedButton() == buttons[i])
            return kResults[i];
    }
    return kClosed;
}

namespace Private {

void resetAssertionState()
{
    ignoredLocations().clear();
}

} // namespace Private

} // namespace Velmar
