// The library's Qt message handler: one formatted line per Qt message, written to the
// debugger output channel.
#pragma once

#include <QtGlobal>

#include <cstddef>

namespace Velmar::Private {

// The process-wide line buffer size; a finished line holds at most kLogLineBufferSize - 1
// characters and loses its newline when it reaches that limit.
inline constexpr std::size_t kLogLineBufferSize = 10240;

// Formats one line "[elapsed][TYPE]: text\n" into `buffer` (NUL-terminated) and returns its
// length. Pure: no clock, no output, no abort.
std::size_t formatLogLine(char (&buffer)[kLogLineBufferSize], QtMsgType type,
                          qint64 elapsedMilliseconds, const char* text);

// The handler itself. Aborts the process after writing a fatal message.
void messageHandler(QtMsgType type, const QMessageLogContext& context, const QString& message);

// Installs messageHandler and returns the handler it replaced.
QtMessageHandler installMessageHandler();

} // namespace Velmar::Private
