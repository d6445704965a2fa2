// The host's "did the user cancel?" poll: Escape or Cancel, or command-period, waiting in the
// queue or held on the keyboard now.
#include "events/EventQueue.h"

#include <Velmar/EventWaiting.h>
#include <Velmar/HostCore.h>

#include "platform/Platform.h"
#include "platform/VirtualKeys.h"

namespace Velmar {

using namespace Private;

namespace {

namespace VK = VirtualKey;

constexpr int kFrenchLanguage = 1036;
constexpr UInt8 kEscapeChar = 27;

bool queuedEscape()
{
    return gMainEventQueue.firstWhere([](const EventQueueItem* item) {
        return item->eventClass == kEventClassKeyboard && item->charCode == kEscapeChar
            && item->modifiers == 0;
    }) != nullptr;
}

// Command-period: Control plays the command key; a French keyboard has its period shifted,
// so the key beside it (";") stands in.
bool cancelKeysDown()
{
    if (Platform::isAsyncKeyDown(VK::Escape) || Platform::isAsyncKeyDown(VK::Cancel))
        return true;
    if (!Platform::isAsyncKeyDown(VK::Control))
        return false;
    const char period = Platform::keyboardLanguageId() == kFrenchLanguage ? ';' : '.';
    const int key = Platform::virtualKeyForCharacter(period);
    return key != 0 && Platform::isAsyncKeyDown(key);
}

} // namespace

Boolean CheckEventQueueForUserCancel()
{
    const bool cancelled = queuedEscape() || (isRunningInForeground() && cancelKeysDown());
    if (!cancelled)
        return false;
    // The cancelling keystroke and the clicks made meanwhile must not act later.
    gMainEventQueue.removeIf([](EventQueueItem* item) {
        return item->eventClass == kEventClassKeyboard || item->eventClass == kEventClassMouse;
    });
    return true;
}

void ClearAbortRequested()
{
    // Reading the asynchronous state is what clears an earlier press where the platform
    // remembers one.
    Platform::isAsyncKeyDown(VK::Cancel);
    Platform::isAsyncKeyDown(VK::Escape);
}

} // namespace Velmar
