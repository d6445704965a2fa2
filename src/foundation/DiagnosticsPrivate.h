// Private machinery shared by the logging, assertion and message-handler code.
#pragma once

#include <Velmar/MacTypes.h>

#include <QString>

#include <functional>
#include <optional>

namespace Velmar::Private {

// Hands one finished log line to the debug output hook when one is set, otherwise to the
// platform's debugger output channel.
void writeDebugOutput(const char* line);

// Answers a dialog on behalf of the user when the host's automation listener is installed.
// `choices` is the "|"-separated list of button texts. Returns the index of the chosen
// choice, -1 when the dialog counts as closed without a choice, or nullopt when no listener
// is present and the real dialog must be shown.
std::optional<int> askAutomationListener(const QString& title, const QString& text,
                                         const QString& choices);

// The address of "StackLogTo" in the optional stack logger, or null when it was not loaded.
void* stackLoggerEntry();

// Forgets every location ignored for good. Tests only.
void resetAssertionState();

} // namespace Velmar::Private
