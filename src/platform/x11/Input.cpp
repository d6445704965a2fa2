// Key and button state off Windows: asked of the X server when Qt runs on X, else taken
// from the events Qt delivered to this process.
#include "platform/InputTracker.h"
#include "platform/KeyTables.h"
#include "platform/Platform.h"
#include "platform/VirtualKeys.h"
#include "platform/x11/XcbKeyboard.h"

#include <QGuiApplication>
#include <QInputMethod>
#include <QLocale>

#include <cstring>

namespace Velmar::Private::Platform {

namespace {

bool gWindowSystemInput = true;

XcbKeyboard* windowSystemKeyboard()
{
    return gWindowSystemInput ? XcbKeyboard::get() : nullptr;
}

// Fills the state from the server, or from the tracked events when it cannot answer.
void currentState(UInt8 state[256])
{
    if (XcbKeyboard* keyboard = windowSystemKeyboard()) {
        if (keyboard->queryState(state))
            return;
    }
    InputTracker::instance().getState(state);
}

struct LanguageId {
    QLocale::Language language;
    int id;
};

// Primary languages with their default sublanguage, as Windows numbers them.
const LanguageId kLanguageIds[] = {
    {QLocale::English, 0x0409}, {QLocale::French, 0x040C}, {QLocale::German, 0x0407},
    {QLocale::Italian, 0x0410}, {QLocale::Spanish, 0x0C0A}, {QLocale::Dutch, 0x0413},
    {QLocale::Portuguese, 0x0416}, {QLocale::Swedish, 0x041D}, {QLocale::Danish, 0x0406},
    {QLocale::NorwegianBokmal, 0x0414}, {QLocale::Finnish, 0x040B}, {QLocale::Polish, 0x0415},
    {QLocale::Czech, 0x0405}, {QLocale::Russian, 0x0419}, {QLocale::Japanese, 0x0411},
    {QLocale::Korean, 0x0412}, {QLocale::Chinese, 0x0804}, {QLocale::Greek, 0x0408},
    {QLocale::Turkish, 0x041F}, {QLocale::Hungarian, 0x040E},
};

} // namespace

bool isAsyncKeyDown(int virtualKey)
{
    if (virtualKey <= 0 || virtualKey > 255)
        return false;
    UInt8 state[256];
    currentState(state);
    return (state[virtualKey] & 0x80) != 0;
}

bool isCapsLockToggled()
{
    // Asked on every modifier query: only the pointer query, not the whole keyboard.
    if (XcbKeyboard* keyboard = windowSystemKeyboard()) {
        bool toggled = false;
        if (keyboard->queryCapsLock(toggled))
            return toggled;
    }
    return InputTracker::instance().isToggled(VirtualKey::Capital);
}

void getKeyboardState(UInt8 state[256])
{
    if (state)
        currentState(state);
}

bool isSystemLeftButtonDown()
{
    return isAsyncKeyDown(VirtualKey::LButton);
}

int virtualKeyForCharacter(char character)
{
    const auto c = static_cast<unsigned char>(character);
    if (XcbKeyboard* keyboard = windowSystemKeyboard()) {
        if (const int vk = keyboard->virtualKeyForCharacter(c))
            return vk;
    }
    // US layout: Qt's key codes for ASCII are the upper-case characters.
    if (c < 0x20 || c > 0x7e)
        return 0;
    const int key = (c >= 'a' && c <= 'z') ? c - 'a' + 'A' : c;
    return virtualKeyFromQtKey(key);
}

int keyboardLanguageId()
{
    QLocale locale = QLocale::system();
    if (qobject_cast<QGuiApplication*>(QCoreApplication::instance())) {
        if (QInputMethod* im = QGuiApplication::inputMethod())
            locale = im->locale();
    }
    for (const LanguageId& entry : kLanguageIds) {
        if (entry.language == locale.language())
            return entry.id;
    }
    return 0x0409;
}

void trackInputEvent(const QEvent* event)
{
    InputTracker::instance().track(event);
}

void setWindowSystemInputEnabled(bool enabled)
{
    gWindowSystemInput = enabled;
}

bool isNativeInputPending()
{
    return false; // Qt drains the X connection itself; there is no queue to peek into
}

} // namespace Velmar::Private::Platform
