// Dialog answers from the host's automation listener, so scripted runs never wait on a box.
#include "foundation/DiagnosticsPrivate.h"

#include <Velmar/HostCore.h>

namespace Velmar::Private {

std::optional<int> askAutomationListener(const QString& title, const QString& text,
                                         const QString& choices)
{
    if (!AutomationListenerManager::GetListener())
        return std::nullopt;
    return int(AskAutomationListener(title, text, choices));
}

} // namespace Velmar::Private
