// The keyboard tables behind key events: Windows virtual keys to Mac character and key codes,
// Qt keys to virtual keys, typed characters to Mac codes, and Mac key codes back to virtual
// keys. Built once, before the first wait.
#include "events/KeyCodeTables.h"

#include "platform/VirtualKeys.h"

#include <QtCore/qnamespace.h>

#include <array>
#include <unordered_map>

namespace Velmar::Private {

namespace {

namespace VK = VirtualKey;

struct VirtualKeyRow {
    int vk;
    UInt8 charCode;
    UInt8 keyCode;
};

// Kept exactly, odd rows included (Print Screen on the comma key code, the left Windows key
// on the "[" key, Pause on F15, Insert and Help both on the help key): hosts match on them.
constexpr VirtualKeyRow kVirtualKeyRows[] = {
    {0x08, 0x08, 0x33}, {0x09, 0x09, 0x30}, {0x0C, 0x1B, 0x47}, {0x0D, 0x0D, 0x24},
    {0x0E, 0x03, 0x4C}, {0x1B, 0x1B, 0x35}, {0x20, 0x20, 0x31}, {0x2D, 0x05, 0x72},
    {0x2E, 0x7F, 0x75}, {0x2F, 0x05, 0x72},
    {0x10, 0x00, 0x38}, {0x11, 0x00, 0x37}, {0x12, 0x00, 0x3A}, {0x14, 0x00, 0x39},
    {0x5B, 0x5B, 0x21}, {0x5C, 0x00, 0x3C}, {0x5D, 0x5D, 0x1E},
    {0x21, 0x0B, 0x74}, {0x22, 0x0C, 0x79}, {0x23, 0x04, 0x77}, {0x24, 0x01, 0x73},
    {0x25, 0x1C, 0x7B}, {0x26, 0x1E, 0x7E}, {0x27, 0x1D, 0x7C}, {0x28, 0x1F, 0x7D},
    {0x13, 0x00, 0x71}, {0x2C, 0x00, 0x2B}, {0x90, 0x00, 0x47}, {0x91, 0x00, 0x6B},
    {0x6A, 0x2A, 0x43}, {0x6B, 0x2B, 0x45}, {0x6C, 0x03, 0x4C}, {0x6D, 0x2D, 0x4E},
    {0x6E, 0x2E, 0x41}, {0x6F, 0x2F, 0x4B},
    {0x80, 0x80, 0x00}, {0x81, 0x81, 0x00}, {0x82, 0xD5, 0x00}, {0x83, 0xC4, 0x00},
    {0x84, 0x80, 0x00}, {0x85, 0x81, 0x00}, {0x86, 0xD5, 0x00}, {0x87, 0xC4, 0x00},
    {0xBA, 0x3B, 0x29}, {0xBB, 0x3D, 0x18}, {0xBC, 0x2C, 0x2B}, {0xBD, 0x2D, 0x1B},
    {0xBE, 0x2E, 0x2F}, {0xBF, 0x2F, 0x2C}, {0xC0, 0x60, 0x32}, {0xDB, 0x5B, 0x21},
    {0xDC, 0x5C, 0x2A}, {0xDD, 0x5D, 0x1E}, {0xDE, 0x27, 0x27},
};

// The US keyboard's Mac key codes, by row: digits 0-9, letters A-Z, keypad 0-9, F1-F15.
constexpr UInt8 kDigitKeys[10] = {0x1D, 0x12, 0x13, 0x14, 0x15, 0x17, 0x16, 0x1A, 0x1C, 0x19};
constexpr UInt8 kLetterKeys[26] = {0x00, 0x0B, 0x08, 0x02, 0x0E, 0x03, 0x05, 0x04, 0x22,
                                   0x26, 0x28, 0x25, 0x2E, 0x2D, 0x1F, 0x23, 0x0C, 0x0F,
                                   0x01, 0x11, 0x20, 0x09, 0x0D, 0x07, 0x10, 0x06};
constexpr UInt8 kKeypadKeys[10] = {0x52, 0x53, 0x54, 0x55, 0x56, 0x57, 0x58, 0x59, 0x5B, 0x5C};
constexpr UInt8 kFunctionKeys[15] = {0x7A, 0x78, 0x63, 0x76, 0x60, 0x61, 0x62, 0x64,
                                     0x65, 0x6D, 0x67, 0x6F, 0x69, 0x6B, 0x71};

// The Qt key each Windows virtual key stands for in Qt's Windows key mapper. Unlisted keys
// are Qt::Key_unknown or character keys the layout decides; neither names a Qt key here.
// The keypad separator and decimal keys keep Qt 4's Key_Comma and Key_Period (later Qt
// versions leave them to the layout): without them the keypad's decimal point would fall
// through to virtual key 0x2E and arrive as a forward delete.
struct QtKeyRow {
    int vk;
    int qtKey;
};
constexpr QtKeyRow kQtKeyRows[] = {
    {0x03, Qt::Key_Cancel}, {0x08, Qt::Key_Backspace}, {0x09, Qt::Key_Tab},
    {0x0C, Qt::Key_Clear}, {0x0D, Qt::Key_Return}, {0x10, Qt::Key_Shift},
    {0x11, Qt::Key_Control}, {0x12, Qt::Key_Alt}, {0x13, Qt::Key_Pause},
    {0x14, Qt::Key_CapsLock}, {0x1B, Qt::Key_Escape}, {0x1F, Qt::Key_Mode_switch},
    {0x20, Qt::Key_Space}, {0x21, Qt::Key_PageUp}, {0x22, Qt::Key_PageDown},
    {0x23, Qt::Key_End}, {0x24, Qt::Key_Home}, {0x25, Qt::Key_Left}, {0x26, Qt::Key_Up},
    {0x27, Qt::Key_Right}, {0x28, Qt::Key_Down}, {0x29, Qt::Key_Select},
    {0x2A, Qt::Key_Printer}, {0x2B, Qt::Key_Execute}, {0x2C, Qt::Key_Print},
    {0x2D, Qt::Key_Insert}, {0x2E, Qt::Key_Delete}, {0x2F, Qt::Key_Help},
    {0x5B, Qt::Key_Meta}, {0x5C, Qt::Key_Meta}, {0x5D, Qt::Key_Menu}, {0x5F, Qt::Key_Sleep},
    {0x6A, Qt::Key_Asterisk}, {0x6B, Qt::Key_Plus}, {0x6C, Qt::Key_Comma},
    {0x6D, Qt::Key_Minus}, {0x6E, Qt::Key_Period}, {0x6F, Qt::Key_Slash},
    {0x90, Qt::Key_NumLock}, {0x91, Qt::Key_ScrollLock},
    {0x93, Qt::Key_Massyo}, {0x94, Qt::Key_Touroku}, {0xA0, Qt::Key_Shift},
    {0xA1, Qt::Key_Shift}, {0xA2, Qt::Key_Control}, {0xA3, Qt::Key_Control},
    {0xA4, Qt::Key_Alt}, {0xA5, Qt::Key_Alt}, {0xA6, Qt::Key_Back}, {0xA7, Qt::Key_Forward},
    {0xA8, Qt::Key_Refresh}, {0xA9, Qt::Key_Stop}, {0xAA, Qt::Key_Search},
    {0xAB, Qt::Key_Favorites}, {0xAC, Qt::Key_HomePage}, {0xAD, Qt::Key_VolumeMute},
    {0xAE, Qt::Key_VolumeDown}, {0xAF, Qt::Key_VolumeUp}, {0xB0, Qt::Key_MediaNext},
    {0xB1, Qt::Key_MediaPrevious}, {0xB2, Qt::Key_MediaStop}, {0xB3, Qt::Key_MediaPlay},
    {0xB4, Qt::Key_LaunchMail}, {0xB5, Qt::Key_LaunchMedia}, {0xB6, Qt::Key_Launch0},
    {0xB7, Qt::Key_Launch1}, {0xFA, Qt::Key_Play}, {0xFB, Qt::Key_Zoom},
    {0xFE, Qt::Key_Clear},
};

// Non-ASCII Mac OS Roman characters and the US Mac keyboard key that types them with Option
// or Shift-Option. Left out: the accented letters the Option dead keys compose (two keys),
// and the four spacing accents ´ ¨ ˆ ˜, which Shift-Option types on the dead keys themselves
// (E, U, I, N) but which hosts meet as the dead-key sequence's result.
struct CharacterRow {
    char16_t character;
    UInt8 macRoman;
    UInt8 keyCode;
};
constexpr CharacterRow kOptionCharacters[] = {
    {u'\u00E5', 0x8C, 0x00}, {u'\u00C5', 0x81, 0x00}, {u'\u222B', 0xBA, 0x0B}, {u'\u0131', 0xF5, 0x0B},
    {u'\u00E7', 0x8D, 0x08}, {u'\u00C7', 0x82, 0x08}, {u'\u2202', 0xB6, 0x02}, {u'\u00CE', 0xEB, 0x02},
    {u'\u0192', 0xC4, 0x03}, {u'\u00CF', 0xEC, 0x03}, {u'\u00A9', 0xA9, 0x05}, {u'\u02DD', 0xFD, 0x05},
    {u'\u02D9', 0xFA, 0x04}, {u'\u00D3', 0xEE, 0x04}, {u'\u2206', 0xC6, 0x26}, {u'\u00D4', 0xEF, 0x26},
    {u'\u02DA', 0xFB, 0x28}, {u'\uF8FF', 0xF0, 0x28}, {u'\u00AC', 0xC2, 0x25}, {u'\u00D2', 0xF1, 0x25},
    {u'\u00B5', 0xB5, 0x2E}, {u'\u00C2', 0xE5, 0x2E}, {u'\u00F8', 0xBF, 0x1F}, {u'\u00D8', 0xAF, 0x1F},
    {u'\u03C0', 0xB9, 0x23}, {u'\u220F', 0xB8, 0x23}, {u'\u0153', 0xCF, 0x0C}, {u'\u0152', 0xCE, 0x0C},
    {u'\u00AE', 0xA8, 0x0F}, {u'\u2030', 0xE4, 0x0F}, {u'\u00DF', 0xA7, 0x01}, {u'\u00CD', 0xEA, 0x01},
    {u'\u2020', 0xA0, 0x11}, {u'\u02C7', 0xFF, 0x11}, {u'\u221A', 0xC3, 0x09}, {u'\u25CA', 0xD7, 0x09},
    {u'\u2211', 0xB7, 0x0D}, {u'\u201E', 0xE3, 0x0D}, {u'\u2248', 0xC5, 0x07}, {u'\u02DB', 0xFE, 0x07},
    {u'\u00A5', 0xB4, 0x10}, {u'\u00C1', 0xE7, 0x10}, {u'\u03A9', 0xBD, 0x06}, {u'\u00B8', 0xFC, 0x06},
    {u'\u00A1', 0xC1, 0x12}, {u'\u2044', 0xDA, 0x12}, {u'\u2122', 0xAA, 0x13}, {u'\u20AC', 0xDB, 0x13},
    {u'\u00A3', 0xA3, 0x14}, {u'\u2039', 0xDC, 0x14}, {u'\u00A2', 0xA2, 0x15}, {u'\u203A', 0xDD, 0x15},
    {u'\u221E', 0xB0, 0x17}, {u'\uFB01', 0xDE, 0x17}, {u'\u00A7', 0xA4, 0x16}, {u'\uFB02', 0xDF, 0x16},
    {u'\u00B6', 0xA6, 0x1A}, {u'\u2021', 0xE0, 0x1A}, {u'\u2022', 0xA5, 0x1C}, {u'\u00B0', 0xA1, 0x1C},
    {u'\u00AA', 0xBB, 0x19}, {u'\u00B7', 0xE1, 0x19}, {u'\u00BA', 0xBC, 0x1D}, {u'\u201A', 0xE2, 0x1D},
    {u'\u2013', 0xD0, 0x1B}, {u'\u2014', 0xD1, 0x1B}, {u'\u2260', 0xAD, 0x18}, {u'\u00B1', 0xB1, 0x18},
    {u'\u201C', 0xD2, 0x21}, {u'\u201D', 0xD3, 0x21}, {u'\u2018', 0xD4, 0x1E}, {u'\u2019', 0xD5, 0x1E},
    {u'\u00AB', 0xC7, 0x2A}, {u'\u00BB', 0xC8, 0x2A}, {u'\u2026', 0xC9, 0x29}, {u'\u00DA', 0xF2, 0x29},
    {u'\u00E6', 0xBE, 0x27}, {u'\u00C6', 0xAE, 0x27}, {u'\u2264', 0xB2, 0x2B}, {u'\u00AF', 0xF8, 0x2B},
    {u'\u2265', 0xB3, 0x2F}, {u'\u02D8', 0xF9, 0x2F}, {u'\u00F7', 0xD6, 0x2C}, {u'\u00BF', 0xC0, 0x2C},
    {u'\u00A0', 0xCA, 0x31},
};
static_assert(std::size(kOptionCharacters) == 85, "95 ASCII and 85 Option characters make 180");

// Printable ASCII: the unshifted partner's key for shifted characters.
constexpr char kAsciiKeys[][2] = {
    {' ', 0x31}, {'!', 0x12}, {'"', 0x27}, {'#', 0x14}, {'$', 0x15}, {'%', 0x17}, {'&', 0x1A},
    {'\'', 0x27}, {'(', 0x19}, {')', 0x1D}, {'*', 0x1C}, {'+', 0x18}, {',', 0x2B}, {'-', 0x1B},
    {'.', 0x2F}, {'/', 0x2C}, {':', 0x29}, {';', 0x29}, {'<', 0x2B}, {'=', 0x18}, {'>', 0x2F},
    {'?', 0x2C}, {'@', 0x13}, {'[', 0x21}, {'\\', 0x2A}, {']', 0x1E}, {'^', 0x16}, {'_', 0x1B},
    {'`', 0x32}, {'{', 0x21}, {'|', 0x2A}, {'}', 0x1E}, {'~', 0x32},
};

struct Tables {
    std::array<MacKeyPair, 256> byVirtualKey{};
    std::unordered_map<int, int> virtualKeyByQtKey;
    std::unordered_map<char16_t, MacKeyPair> byCharacter;
    std::array<int, 256> virtualKeyByMacKey{};
};

Tables build()
{
    Tables t;
    for (const VirtualKeyRow& row : kVirtualKeyRows)
        t.byVirtualKey[row.vk] = {row.charCode, row.keyCode};
    for (int i = 0; i < 10; ++i) {
        t.byVirtualKey[VK::Digit0 + i] = {UInt8('0' + i), kDigitKeys[i]};
        t.byVirtualKey[VK::Numpad0 + i] = {UInt8('0' + i), kKeypadKeys[i]};
    }
    for (int i = 0; i < 26; ++i)
        t.byVirtualKey[VK::A + i] = {UInt8('A' + i), kLetterKeys[i]};
    for (int i = 0; i < 15; ++i)
        t.byVirtualKey[VK::F1 + i] = {0x10, kFunctionKeys[i]};

    // Every virtual key with the Qt key Qt's mapper gives it; a later key wins.
    std::array<int, 256> qtKeyOf;
    qtKeyOf.fill(Qt::Key_unknown);
    for (const QtKeyRow& row : kQtKeyRows)
        qtKeyOf[row.vk] = row.qtKey;
    for (int i = 0; i < 10; ++i)
        qtKeyOf[VK::Numpad0 + i] = Qt::Key_0 + i;
    for (int i = 0; i < 24; ++i)
        qtKeyOf[VK::F1 + i] = Qt::Key_F1 + i;
    for (int vk = 0; vk < 256; ++vk)
        t.virtualKeyByQtKey[qtKeyOf[vk]] = vk;
    // Qt's own names for two keys the mapper leaves to Windows: Backtab is Tab, the keypad
    // Enter has the converter's slot of its own.
    t.virtualKeyByQtKey[Qt::Key_Backtab] = VK::Tab;
    t.virtualKeyByQtKey[Qt::Key_Enter] = VK::QtEnter;

    for (char c = 'a'; c <= 'z'; ++c) {
        t.byCharacter[char16_t(c)] = {UInt8(c), kLetterKeys[c - 'a']};
        t.byCharacter[char16_t(c - 'a' + 'A')] = {UInt8(c - 'a' + 'A'), kLetterKeys[c - 'a']};
    }
    for (int i = 0; i < 10; ++i)
        t.byCharacter[char16_t('0' + i)] = {UInt8('0' + i), kDigitKeys[i]};
    for (const auto& row : kAsciiKeys)
        t.byCharacter[char16_t(row[0])] = {UInt8(row[0]), UInt8(row[1])};
    for (const CharacterRow& row : kOptionCharacters)
        t.byCharacter[row.character] = {row.macRoman, row.keyCode};

    // Key code 0 (the A key) means "none" here, so IsKeyPressed(0) is always false.
    for (int vk = 0; vk < 256; ++vk) {
        if (t.byVirtualKey[vk].keyCode != 0)
            t.virtualKeyByMacKey[t.byVirtualKey[vk].keyCode] = vk;
    }
    return t;
}

const Tables& tables()
{
    static const Tables sTables = build();
    return sTables;
}

} // namespace

void buildKeyboardTables()
{
    tables();
}

MacKeyPair macKeyForVirtualKey(int virtualKey)
{
    return virtualKey >= 0 && virtualKey < 256 ? tables().byVirtualKey[virtualKey] : MacKeyPair{};
}

int virtualKeyForQtKey(int qtKey)
{
    const auto& index = tables().virtualKeyByQtKey;
    auto it = index.find(qtKey);
    return it == index.end() ? -1 : it->second;
}

bool macKeyForCharacter(char16_t character, MacKeyPair* out)
{
    const auto& map = tables().byCharacter;
    auto it = map.find(character);
    if (it == map.end())
        return false;
    *out = it->second;
    return true;
}

int virtualKeyForMacKey(int macKeyCode)
{
    return macKeyCode > 0 && macKeyCode < 256 ? tables().virtualKeyByMacKey[macKeyCode] : 0;
}

int characterTableSize()
{
    return int(tables().byCharacter.size());
}

} // namespace Velmar::Private
