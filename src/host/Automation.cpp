// The automation listener slot: empty unless a host or a test installs one.
#include <Velmar/HostCore.h>

#include "host/Replaceable.h"

#include <QStringList>

namespace Velmar {

namespace {
Private::Replaceable<AutomationListener*> gListener(nullptr);
}

AutomationListener::~AutomationListener() = default;

AutomationListener* AutomationListenerManager::GetListener()
{
    return gListener.get();
}

AutomationListener* AutomationListenerManager::SetListener(AutomationListener* listener)
{
    return gListener.set(listener);
}

SInt32 AskAutomationListener(const QString& title, const QString& text, const QString& choices)
{
    AutomationListener* listener = AutomationListenerManager::GetListener();
    if (!listener)
        return -1;
    const QStringList labels = choices.split(QLatin1Char('|'));
    const QString answer = listener->AnswerDialog(title, text, choices).trimmed();
    for (int i = 0; i < labels.size(); ++i) {
        if (labels.at(i).compare(answer, Qt::CaseInsensitive) == 0)
            return SInt32(i);
    }
    bool isNumber = false;
    const int index = answer.toInt(&isNumber);
    if (isNumber && index >= 0 && index < labels.size())
        return SInt32(index);
    return -1;
}

} // namespace Velmar
