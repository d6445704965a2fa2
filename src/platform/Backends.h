// What each window-system backend off Windows answers; platform/unix dispatches the calls of
// Platform.h to one of them by windowSystem(). A query that returns false had no answer, and
// the caller falls back to the state tracked from Qt's own events.
#pragma once

#include <Velmar/MacTypes.h>

class QLocale;
class QWidget;

namespace Velmar::Private::Platform {

namespace X11 {
// Keys and buttons from the server (Windows keyboard-state layout, cleared first).
bool queryKeyboardState(UInt8 state[256]);
bool queryCapsLock(bool& toggled);
// 0 when no key of the server's layout types `character`.
int virtualKeyForCharacter(unsigned char character);
int keyboardLanguageId();
void reserveScreenTop(QWidget* window, int height);
} // namespace X11

namespace Wayland {
// The compositor offers no query: keys and buttons come from the tracked events, the
// language from the input method once a keyboard has shown itself.
int keyboardLanguageId();
void placeWindowBehind(QWidget* window, QWidget* behind);
void reserveScreenTop(QWidget* window, int height);
// Watches the application's windows for requests the compositor ignores (placement), to say
// so once. Installed when the backend is first chosen.
void watchWindows();
} // namespace Wayland

// Shared by the backends: the Windows language identifier of a locale (0x0409 when the
// language has none in the table).
int languageIdForLocale(const QLocale& locale);

} // namespace Velmar::Private::Platform
