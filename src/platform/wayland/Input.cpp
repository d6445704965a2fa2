// The Wayland backend's input answers. A compositor offers no query for keys, buttons or
// the pointer: platform/unix answers those from the events Qt delivered. What is left here
// is the keyboard language.
#include "platform/Backends.h"
#include "platform/InputTracker.h"

#include <QGuiApplication>
#include <QInputMethod>
#include <QLocale>

namespace Velmar::Private::Platform::Wayland {

int keyboardLanguageId()
{
    // Qt 6.4's Wayland input context dereferences the seat without checking it, so asking a
    // compositor that has no seat (a headless one, a kiosk without a keyboard) ends the
    // process. A key event proves a seat with a keyboard; before one, the system's locale.
    QLocale locale = QLocale::system();
    if (InputTracker::instance().hasSeenKeyboard()) {
        if (QInputMethod* im = QGuiApplication::inputMethod())
            locale = im->locale();
    }
    return languageIdForLocale(locale);
}

} // namespace Velmar::Private::Platform::Wayland
