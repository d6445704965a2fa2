// X keyboard state: xcb_query_keymap for keys, xcb_query_pointer for buttons and locks,
// with the keycode -> virtual-key map built from the server's keyboard mapping.
#include "platform/x11/XcbKeyboard.h"

#if defined(VELMAR_HAVE_XCB)

#include "platform/KeyTables.h"
#include "platform/VirtualKeys.h"
#include "platform/x11/XcbConnection.h"

#include <QGuiApplication>

#include <chrono>
#include <cstdlib>
#include <cstring>

#include <xcb/xcb.h>
#include <xcb/xproto.h>

namespace Velmar::Private::Platform {

namespace {

namespace VK = VirtualKey;

// Layout changes reach us without an event we can rely on; re-reading the mapping now and
// then costs one round trip.
constexpr SInt64 kKeymapLifetimeMs = 5000;
constexpr UInt32 kNumLockKeysym = 0xff7f;

SInt64 nowMs()
{
    using namespace std::chrono;
    return duration_cast<milliseconds>(steady_clock::now().time_since_epoch()).count();
}

bool isLetterOrDigit(UInt32 keysym)
{
    return (keysym >= 'a' && keysym <= 'z') || (keysym >= 'A' && keysym <= 'Z')
        || (keysym >= '0' && keysym <= '9');
}

// Windows names a key by its letter or digit wherever it carries one (the French top row
// gives the digits with Shift), else by its unshifted symbol.
int keyFromColumns(const xcb_keysym_t* syms, int count)
{
    for (int column = 0; column < count && column < 2; ++column) {
        if (isLetterOrDigit(syms[column]))
            return virtualKeyFromKeysym(syms[column]);
    }
    for (int column = 0; column < count && column < 2; ++column) {
        if (const int vk = virtualKeyFromKeysym(syms[column]))
            return vk;
    }
    return 0;
}

} // namespace

XcbKeyboard* XcbKeyboard::get()
{
    xcb_connection_t* connection = xcbConnection();
    if (!connection)
        return nullptr;
    static XcbKeyboard keyboard;
    if (keyboard.m_connection != connection) {
        keyboard.m_connection = connection;
        keyboard.m_refreshedAtMs = -1;
    }
    return &keyboard;
}

void XcbKeyboard::refreshKeymap()
{
    const SInt64 now = nowMs();
    if (m_refreshedAtMs >= 0 && now - m_refreshedAtMs < kKeymapLifetimeMs)
        return;
    m_refreshedAtMs = now;

    auto* c = static_cast<xcb_connection_t*>(m_connection);
    const xcb_setup_t* setup = xcb_get_setup(c);
    const int minKeycode = setup->min_keycode;
    const int maxKeycode = setup->max_keycode;
    if (minKeycode > maxKeycode)
        return;

    xcb_get_keyboard_mapping_reply_t* mapping = xcb_get_keyboard_mapping_reply(
        c, xcb_get_keyboard_mapping(c, xcb_keycode_t(minKeycode), UInt8(maxKeycode - minKeycode + 1)),
        nullptr);
    xcb_get_modifier_mapping_reply_t* modifiers =
        xcb_get_modifier_mapping_reply(c, xcb_get_modifier_mapping(c), nullptr);
    if (!mapping) {
        std::free(modifiers);
        return;
    }

    for (KeyEntry& entry : m_keys)
        entry = KeyEntry();
    std::memset(m_unshiftedKeysyms, 0, sizeof m_unshiftedKeysyms);
    std::memset(m_shiftedKeysyms, 0, sizeof m_shiftedKeysyms);
    const int perKeycode = mapping->keysyms_per_keycode;
    const xcb_keysym_t* syms = xcb_get_keyboard_mapping_keysyms(mapping);
    const int symCount = xcb_get_keyboard_mapping_keysyms_length(mapping);
    for (int keycode = minKeycode; keycode <= maxKeycode && keycode < 256; ++keycode) {
        const int offset = (keycode - minKeycode) * perKeycode;
        if (perKeycode <= 0 || offset + perKeycode > symCount)
            break;
        const xcb_keysym_t* column = syms + offset;
        KeyEntry& entry = m_keys[keycode];
        entry.virtualKey = keyFromColumns(column, perKeycode);
        if (perKeycode > 1) {
            const int shifted = virtualKeyFromKeysym(column[1]);
            if (shifted >= VK::Numpad0 && shifted <= VK::Decimal && shifted != entry.virtualKey)
                entry.numLockVirtualKey = shifted;
            m_shiftedKeysyms[keycode] = column[1];
        }
        m_unshiftedKeysyms[keycode] = column[0];
    }

    // Which modifier bit Num Lock sets (usually Mod2).
    m_numLockMask = 0;
    if (modifiers) {
        const xcb_keycode_t* codes = xcb_get_modifier_mapping_keycodes(modifiers);
        const int perModifier = modifiers->keycodes_per_modifier;
        for (int modifier = 0; modifier < 8; ++modifier) {
            for (int i = 0; i < perModifier; ++i) {
                const xcb_keycode_t code = codes[modifier * perModifier + i];
                if (code && m_unshiftedKeysyms[code] == kNumLockKeysym)
                    m_numLockMask |= UInt16(1u << modifier);
            }
        }
    }
    std::free(modifiers);
    std::free(mapping);
}

namespace {

// Sends the pointer query without waiting, so that it can share a round trip.
bool sendPointerQuery(xcb_connection_t* c, xcb_query_pointer_cookie_t& cookie)
{
    const xcb_screen_t* screen = xcb_setup_roots_iterator(xcb_get_setup(c)).data;
    if (!screen)
        return false;
    cookie = xcb_query_pointer(c, screen->root);
    return true;
}

bool pointerMaskReply(xcb_connection_t* c, xcb_query_pointer_cookie_t cookie, UInt16& mask)
{
    xcb_query_pointer_reply_t* reply = xcb_query_pointer_reply(c, cookie, nullptr);
    if (!reply)
        return false;
    mask = reply->mask;
    std::free(reply);
    return true;
}

} // namespace

bool XcbKeyboard::queryPointerMask(UInt16& mask)
{
    auto* c = static_cast<xcb_connection_t*>(m_connection);
    xcb_query_pointer_cookie_t cookie;
    return sendPointerQuery(c, cookie) && pointerMaskReply(c, cookie, mask);
}

bool XcbKeyboard::queryCapsLock(bool& toggled)
{
    UInt16 mask = 0;
    if (!queryPointerMask(mask))
        return false;
    toggled = (mask & XCB_MOD_MASK_LOCK) != 0;
    return true;
}

bool XcbKeyboard::queryState(UInt8 state[256])
{
    std::memset(state, 0, 256);
    refreshKeymap();
    auto* c = static_cast<xcb_connection_t*>(m_connection);
    // Both requests go out before either reply is awaited: one round trip, not two.
    const xcb_query_keymap_cookie_t keymapCookie = xcb_query_keymap(c);
    xcb_query_pointer_cookie_t pointerCookie;
    const bool pointerSent = sendPointerQuery(c, pointerCookie);
    xcb_query_keymap_reply_t* keymap = xcb_query_keymap_reply(c, keymapCookie, nullptr);
    UInt16 mask = 0;
    const bool havePointer = pointerSent && pointerMaskReply(c, pointerCookie, mask);
    if (!keymap)
        return false;
    const bool numLockOn = havePointer && (mask & m_numLockMask) != 0;

    for (int keycode = 0; keycode < 256; ++keycode) {
        if (!(keymap->keys[keycode / 8] & (1u << (keycode % 8))))
            continue;
        const KeyEntry& entry = m_keys[keycode];
        const int vk = (numLockOn && entry.numLockVirtualKey) ? entry.numLockVirtualKey : entry.virtualKey;
        if (vk <= 0 || vk > 255)
            continue;
        state[vk] |= 0x80;
        if (const int generic = genericModifierKey(vk))
            state[generic] |= 0x80;
    }
    std::free(keymap);

    if (havePointer) {
        if (mask & XCB_BUTTON_MASK_1)
            state[VK::LButton] |= 0x80;
        if (mask & XCB_BUTTON_MASK_2)
            state[VK::MButton] |= 0x80;
        if (mask & XCB_BUTTON_MASK_3)
            state[VK::RButton] |= 0x80;
        if (mask & XCB_MOD_MASK_LOCK)
            state[VK::Capital] |= 0x01;
        if (numLockOn)
            state[VK::NumLock] |= 0x01;
    }
    return true;
}

int XcbKeyboard::virtualKeyForCharacter(unsigned char character)
{
    refreshKeymap();
    // Latin-1 keysyms are the character codes themselves.
    for (const UInt32* column : {m_unshiftedKeysyms, m_shiftedKeysyms}) {
        for (int keycode = 0; keycode < 256; ++keycode) {
            if (column[keycode] == character && m_keys[keycode].virtualKey)
                return m_keys[keycode].virtualKey;
        }
    }
    return 0;
}

} // namespace Velmar::Private::Platform

#else // no xcb headers: every query falls back to the tracked state

namespace Velmar::Private::Platform {

XcbKeyboard* XcbKeyboard::get()
{
    return nullptr;
}
void XcbKeyboard::refreshKeymap() {}
bool XcbKeyboard::queryState(UInt8 state[256])
{
    for (int i = 0; i < 256; ++i)
        state[i] = 0;
    return false;
}
bool XcbKeyboard::queryPointerMask(UInt16&)
{
    return false;
}
bool XcbKeyboard::queryCapsLock(bool&)
{
    return false;
}
int XcbKeyboard::virtualKeyForCharacter(unsigned char)
{
    return 0;
}

} // namespace Velmar::Private::Platform

#endif
