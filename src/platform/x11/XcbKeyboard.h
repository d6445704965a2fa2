// Keyboard and pointer state asked of the X server over the connection Qt already has.
#pragma once

#include <Velmar/MacTypes.h>

namespace Velmar::Private::Platform {

class XcbKeyboard {
public:
    // The keyboard of Qt's X connection; null without one (offscreen, Wayland, no app).
    static XcbKeyboard* get();

    // Fills `state` (256 entries, cleared first) like the Windows keyboard state: 0x80 for
    // keys and buttons down, 0x01 on Caps Lock and Num Lock while toggled. False when the
    // server did not answer.
    bool queryState(UInt8 state[256]);
    bool queryPointerMask(UInt16& mask);
    // Caps Lock alone, from the pointer query's modifier mask: one round trip. False when
    // the server did not answer.
    bool queryCapsLock(bool& toggled);

    // The virtual key of the key that types `character`; 0 when no key does.
    int virtualKeyForCharacter(unsigned char character);

private:
    XcbKeyboard() = default;
    void refreshKeymap();

    struct KeyEntry {
        int virtualKey = 0;
        int numLockVirtualKey = 0; // keypad digits while Num Lock is on
    };
    KeyEntry m_keys[256] = {};
    UInt32 m_unshiftedKeysyms[256] = {}; // per keycode, to find the key of a character
    UInt32 m_shiftedKeysyms[256] = {};
    UInt16 m_numLockMask = 0;
    SInt64 m_refreshedAtMs = -1;
    void* m_connection = nullptr; // the connection the keymap was read from
};

} // namespace Velmar::Private::Platform
