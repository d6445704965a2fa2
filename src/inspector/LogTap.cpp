#include "inspector/LogTap.h"

#include <QTime>

#include <mutex>

namespace Velmar::Private::Inspector {

namespace {

// Lines the view has not collected yet are capped: a host logging in a tight loop while
// the refresh timer is held back must not grow this without end.
constexpr qsizetype kMaxPendingLines = 5000;

constexpr const char* kTypeLabels[] = {"", "[WARNING] ", "[CRITICAL] ", "[FATAL] ", ""};

QtMessageHandler gPrevious = nullptr;
bool gChained = false;
bool gCopying = false;
// Qt may log from any thread; the rest of the inspector runs on the GUI thread only.
std::mutex gPendingMutex;
QStringList gPending;

void tap(QtMsgType type, const QMessageLogContext& context, const QString& message)
{
    if (gCopying) {
        const int index = int(type) >= 0 && int(type) < 5 ? int(type) : 0;
        QString line = QTime::currentTime().toString(QStringLiteral("hh:mm:ss.zzz "))
                     + QLatin1String(kTypeLabels[index]) + message;
        const std::lock_guard<std::mutex> lock(gPendingMutex);
        if (gPending.size() >= kMaxPendingLines)
            gPending.removeFirst();
        gPending.append(std::move(line));
    }
    // Last, since a fatal message ends the process there.
    if (gPrevious)
        gPrevious(type, context, message);
}

} // namespace

void attachLogTap()
{
    gCopying = true;
    if (gChained)
        return;
    gPrevious = qInstallMessageHandler(tap);
    gChained = true;
}

void detachLogTap()
{
    gCopying = false;
    if (!gChained)
        return;
    const QtMessageHandler top = qInstallMessageHandler(gPrevious);
    if (top == tap) {
        gChained = false;
        return;
    }
    qInstallMessageHandler(top); // someone installed over the tap: it stays in their chain
}

bool logTapAttached()
{
    return gCopying;
}

QStringList takeLoggedLines()
{
    const std::lock_guard<std::mutex> lock(gPendingMutex);
    QStringList lines;
    lines.swap(gPending);
    return lines;
}

} // namespace Velmar::Private::Inspector
