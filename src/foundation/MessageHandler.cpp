#include "foundation/MessageHandler.h"

#include "foundation/DiagnosticsPrivate.h"
#include "foundation/NameTable.h"

#include <QElapsedTimer>
#include <QString>

#include <algorithm>
#include <cstdlib>
#include <cstring>

namespace Velmar::Private {

namespace {

constexpr NamedValue<QtMsgType> kPrefixes[] = {
    {QtDebugMsg, "DEBUG"},
    {QtWarningMsg, "WARNING"},
    {QtCriticalMsg, "CRITICAL"},
    {QtFatalMsg, "FATAL"},
};

const char* typeLabel(QtMsgType type)
{
    return nameOf(kPrefixes, type, "UNKNOWN"); // QtInfoMsg and anything newer
}

// One buffer for the whole process, as the debugger channel wants a finished C string.
char gLineBuffer[kLogLineBufferSize];

} // namespace

std::size_t formatLogLine(char (&buffer)[kLogLineBufferSize], QtMsgType type,
                          qint64 elapsedMilliseconds, const char* text)
{
    const QByteArray elapsed =
        QString::number(double(elapsedMilliseconds) / 1000.0, 'f', 3).rightJustified(8, u' ')
            .toLocal8Bit();

    // The line is cut at the buffer's last usable byte; a cut line has no newline.
    const std::size_t limit = kLogLineBufferSize - 1;
    std::size_t length = 0;
    auto append = [&](const char* piece, std::size_t n) {
        const std::size_t take = std::min(n, limit - length);
        std::memcpy(buffer + length, piece, take);
        length += take;
    };
    append("[", 1);
    append(elapsed.constData(), std::size_t(elapsed.size()));
    append("][", 2);
    const char* label = typeLabel(type);
    append(label, std::strlen(label));
    append("]: ", 3);
    if (text)
        append(text, std::strlen(text));
    append("\n", 1);
    buffer[length] = '\0';
    return length;
}

void messageHandler(QtMsgType type, const QMessageLogContext&, const QString& message)
{
    static QElapsedTimer sStart;
    if (!sStart.isValid())
        sStart.start();

    formatLogLine(gLineBuffer, type, sStart.elapsed(), message.toLocal8Bit().constData());
    writeDebugOutput(gLineBuffer);
    if (type == QtFatalMsg)
        std::abort();
}

QtMessageHandler installMessageHandler()
{
    return qInstallMessageHandler(&messageHandler);
}

} // namespace Velmar::Private
