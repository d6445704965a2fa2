// Categorised logging and the route every finished log line takes to the debugger output.
#include <Velmar/Diagnostics.h>

#include "foundation/DiagnosticsPrivate.h"
#include "foundation/NameTable.h"
#include "platform/Notices.h"
#include "platform/Platform.h"

#include <QtGlobal>

#include <cstdarg>
#include <cstdio>

namespace Velmar {

namespace {

constexpr Private::NamedValue<UInt32> kCategoryNames[] = {
    {kLogUnknown, "Unknown"},
    {kLogWindowManagement, "WindowManagement"},
    {kLogEvents, "Events"},
    {kLogTextEdit, "TextEdit"},
    {kLogQuickDraw, "QuickDraw"},
    {kLogGrafPort, "GrafPort"},
    {kLogNotImpl, "NotImpl"},
    {kLogMenus, "Menus"},
    {kLogActivation, "Activation"},
};

// Messages longer than this (with the terminator) are cut.
constexpr std::size_t kLogMessageBufferSize = 1024;

UInt32 gEnabledLogCategories = 0;

DebugOutputHook gDebugOutputHook = nullptr;
void* gDebugOutputContext = nullptr;

// What the window system refused (platform/Notices.h) goes to the NotImpl category.
bool logPlatformNotice(const char* text)
{
    if ((gEnabledLogCategories & kLogNotImpl) == 0)
        return false;
    VelmarLog(kLogNotImpl, "%s", text);
    return true;
}

const bool gPlatformNoticesRouted = (Private::Platform::setNoticeSink(&logPlatformNotice), true);

} // namespace

bool LogCategoryEnabled(UInt32 category)
{
    return (gEnabledLogCategories & category) != 0;
}

void SetLogCategory(UInt32 category, bool on)
{
    if (on)
        gEnabledLogCategories |= category;
    else
        gEnabledLogCategories &= ~category;
}

const char* LogCategoryName(UInt32 category)
{
    return Private::nameOf(kCategoryNames, category, "N/A");
}

void VelmarLog(UInt32 category, const char* format, ...)
{
    // Read the mask directly: a disabled category must cost no more than this test, and the
    // exported LogCategoryEnabled may be reached through the PLT.
    if ((gEnabledLogCategories & category) == 0 || !format)
        return;
    char text[kLogMessageBufferSize];
    va_list args;
    va_start(args, format);
    std::vsnprintf(text, sizeof text, format, args);
    va_end(args);
    qDebug("[%s] %s", LogCategoryName(category), text);
}

void SetDebugOutputHook(DebugOutputHook hook, void* context)
{
    gDebugOutputHook = hook;
    gDebugOutputContext = hook ? context : nullptr;
}

namespace Private {

void writeDebugOutput(const char* line)
{
    if (gDebugOutputHook)
        gDebugOutputHook(line, gDebugOutputContext);
    else
        Platform::debugOutput(line);
}

} // namespace Private

} // namespace Velmar
