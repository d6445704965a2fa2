// Process services on Windows: the debugger channel, DLLs and the foreground window.
#include "platform/windows/Win32.h"

#include "platform/Platform.h"

#include <QCoreApplication>
#include <QDir>
#include <QFileInfo>

namespace Velmar::Private::Platform {

void debugOutput(const char* line)
{
    if (line)
        OutputDebugStringA(line);
}

QString executableDirectory()
{
    wchar_t path[MAX_PATH];
    const DWORD length = GetModuleFileNameW(nullptr, path, MAX_PATH);
    if (length == 0 || length >= MAX_PATH)
        return QCoreApplication::instance() ? QCoreApplication::applicationDirPath() : QString();
    return QFileInfo(QString::fromWCharArray(path, int(length))).absolutePath();
}

QString sharedLibraryFileName(const QString& baseName)
{
    return baseName + QStringLiteral(".dll");
}

void* loadLibrary(const QString& path)
{
    if (path.isEmpty())
        return nullptr;
    const QString native = QDir::toNativeSeparators(path);
    return LoadLibraryW(reinterpret_cast<LPCWSTR>(native.utf16()));
}

void* resolveSymbol(void* library, const char* name)
{
    if (!library || !name)
        return nullptr;
    return reinterpret_cast<void*>(GetProcAddress(static_cast<HMODULE>(library), name));
}

void debugBreak()
{
    // Without a debugger the breakpoint would end the process; behave as on the other
    // platforms and carry on.
    if (IsDebuggerPresent()) {
        DebugBreak();
        return;
    }
    debugOutput("debugBreak: no debugger attached, continuing\n");
}

bool isApplicationInForeground()
{
    HWND foreground = GetForegroundWindow();
    if (!foreground)
        return false;
    DWORD process = 0;
    GetWindowThreadProcessId(foreground, &process);
    return process == GetCurrentProcessId();
}

} // namespace Velmar::Private::Platform
