// Assertions, categorised logging, the classic debugger calls and the fatal-error dialog.
#pragma once

#include <Velmar/MacTypes.h>

namespace Velmar {

// Log categories: bit flags of one process-wide mask, all off at start.
enum LogCategory : UInt32 {
    kLogUnknown = 0x001,
    kLogWindowManagement = 0x002,
    kLogEvents = 0x004,
    kLogTextEdit = 0x008,
    kLogQuickDraw = 0x010,
    kLogGrafPort = 0x020,
    kLogNotImpl = 0x040,
    kLogMenus = 0x080,
    kLogActivation = 0x100,
};

// Shows the assertion dialog (Abort, Retry, Ignore, Ignore all) and then lets the caller go on.
VELMAR_EXPORT void velmar_assert(const char* expression, const char* file, int line,
                                 const char* function, const char* message);

VELMAR_EXPORT bool LogCategoryEnabled(UInt32 category);
VELMAR_EXPORT void SetLogCategory(UInt32 category, bool on);
// The display name of one category bit ("N/A" for anything else).
VELMAR_EXPORT const char* LogCategoryName(UInt32 category);
// printf-style; writes "[Name] text" through qDebug when the category is enabled.
VELMAR_EXPORT void VelmarLog(UInt32 category, const char* format, ...)
#if defined(__GNUC__)
    __attribute__((format(printf, 2, 3)))
#endif
    ;

VELMAR_EXPORT void DebugStr(ConstStr255Param message);
VELMAR_EXPORT void Debugger();
// Returns what the host should do: 3 create report, 2 exit, 5 continue, 4 debugger.
VELMAR_EXPORT SInt16 FatalErrDialog(const char* message, const char* file, int line);
VELMAR_EXPORT void StartLoggingStackCalls();

// Every finished log line passes through this hook instead of the debugger output channel
// when one is set (null restores the default). Lines arrive with their prefix and newline.
using DebugOutputHook = void (*)(const char* line, void* context);
VELMAR_EXPORT void SetDebugOutputHook(DebugOutputHook hook, void* context);

// What VELMAR_ASSERT expands to: raises the assertion `text` when `ok` is false, and gives `ok`
// back so that a call can go on to its error result.
inline bool velmar_check(bool ok, const char* text, const char* file, int line,
                         const char* function)
{
    if (!ok)
        velmar_assert(text, file, line, function, nullptr);
    return ok;
}

} // namespace Velmar

// The one way the library asserts. `text` is what the dialog and the log show after
// "velmar_assert: " (the documented assertion text, which need not be the C++ condition).
// Evaluates to the condition: `if (!VELMAR_ASSERT(port, "port != NULL")) return paramErr;`
#define VELMAR_ASSERT(cond, text)                                                           \
    ::Velmar::velmar_check(static_cast<bool>(cond), (text), __FILE__, __LINE__, __func__)
