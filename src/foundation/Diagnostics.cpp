// The classic debugger calls and the optional stack logger.
#include <Velmar/Diagnostics.h>

#include <Velmar/TextUtils.h>

#include "foundation/DiagnosticsPrivate.h"
#include "platform/Platform.h"

#include <QDir>
#include <QFileInfo>
#include <QString>
#include <QtGlobal>

namespace Velmar {

namespace {

void* gStackLogTo = nullptr;

} // namespace

void DebugStr(ConstStr255Param message)
{
    qDebug("%s", qPrintable(PascalString2QString(message)));
}

void Debugger()
{
    Private::Platform::debugBreak();
}

void StartLoggingStackCalls()
{
    static bool sStarted = false;
    if (sStarted)
        return;
    sStarted = true;

    const QString path = QDir(Private::Platform::executableDirectory())
                             .filePath(Private::Platform::sharedLibraryFileName(
                                 QStringLiteral("StackLogger")));
    if (!QFileInfo::exists(path))
        return;
    if (void* library = Private::Platform::loadLibrary(path))
        gStackLogTo = Private::Platform::resolveSymbol(library, "StackLogTo");
}

namespace Private {

void* stackLoggerEntry()
{
    return gStackLogTo;
}

} // namespace Private

} // namespace Velmar
