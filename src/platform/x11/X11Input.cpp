// The X11 backend's answers to the input queries: the server's keyboard and pointer state
// over Qt's own connection, the language of the input method.
#include "platform/Backends.h"
#include "platform/x11/XcbKeyboard.h"

#include <QGuiApplication>
#include <QInputMethod>
#include <QLocale>

namespace Velmar::Private::Platform::X11 {

bool queryKeyboardState(UInt8 state[256])
{
    XcbKeyboard* keyboard = XcbKeyboard::get();
    return keyboard && keyboard->queryState(state);
}

bool queryCapsLock(bool& toggled)
{
    XcbKeyboard* keyboard = XcbKeyboard::get();
    return keyboard && keyboard->queryCapsLock(toggled);
}

int virtualKeyForCharacter(unsigned char character)
{
    XcbKeyboard* keyboard = XcbKeyboard::get();
    return keyboard ? keyboard->virtualKeyForCharacter(character) : 0;
}

int keyboardLanguageId()
{
    QLocale locale = QLocale::system();
    if (QInputMethod* im = QGuiApplication::inputMethod())
        locale = im->locale();
    return languageIdForLocale(locale);
}

} // namespace Velmar::Private::Platform::X11
