// Process services off Windows: standard error, dlopen, /proc.
#include "platform/Platform.h"

#include <QCoreApplication>
#include <QFile>
#include <QFileInfo>
#include <QGuiApplication>

#include <csignal>
#include <cstdio>
#include <cstring>
#include <dlfcn.h>

namespace Velmar::Private::Platform {

namespace {

// A breakpoint without a debugger would end the process; only trap when one is attached.
bool isDebuggerAttached()
{
    QFile status(QStringLiteral("/proc/self/status"));
    if (!status.open(QIODevice::ReadOnly | QIODevice::Text))
        return false;
    while (!status.atEnd()) {
        const QByteArray line = status.readLine();
        if (line.startsWith("TracerPid:"))
            return line.mid(10).trimmed().toInt() != 0;
    }
    return false;
}

} // namespace

void debugOutput(const char* line)
{
    if (!line)
        return;
    std::fputs(line, stderr);
    std::fflush(stderr);
}

QString executableDirectory()
{
    if (QCoreApplication::instance())
        return QCoreApplication::applicationDirPath();
    return QFileInfo(QFile::symLinkTarget(QStringLiteral("/proc/self/exe"))).absolutePath();
}

QString sharedLibraryFileName(const QString& baseName)
{
    return QStringLiteral("lib") + baseName + QStringLiteral(".so");
}

void* loadLibrary(const QString& path)
{
    if (path.isEmpty())
        return nullptr;
    return dlopen(QFile::encodeName(path).constData(), RTLD_NOW | RTLD_LOCAL);
}

void* resolveSymbol(void* library, const char* name)
{
    if (!library || !name)
        return nullptr;
    return dlsym(library, name);
}

void debugBreak()
{
    if (isDebuggerAttached()) {
        std::raise(SIGTRAP);
        return;
    }
    debugOutput("debugBreak: no debugger attached, continuing\n");
}

bool isApplicationInForeground()
{
    if (!qobject_cast<QGuiApplication*>(QCoreApplication::instance()))
        return false;
    return QGuiApplication::applicationState() == Qt::ApplicationActive;
}

} // namespace Velmar::Private::Platform
