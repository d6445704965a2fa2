// Key tables. Ranges (letters, digits, function keys) are computed; everything else is
// looked up in small sorted-free tables, which are short enough for a linear scan.
#include "platform/KeyTables.h"
#include "platform/VirtualKeys.h"

#include <QtCore/qnamespace.h>

#include <array>
#include <unordered_map>

namespace Velmar::Private::Platform {

namespace {

namespace VK = VirtualKey;

struct KeyPair {
    UInt32 from;
    int to;
};

template <size_t N>
int lookup(const KeyPair (&table)[N], UInt32 key)
{
    for (const KeyPair& pair : table) {
        if (pair.from == key)
            return pair.to;
    }
    return 0;
}

// The keys whose answer here differs from the index below: the side-less modifier keys
// (key state is kept for them, the index names the right-hand ones), keys Qt's Windows mapper
// has no name for, and the US layout's character keys.
const KeyPair kQtKeys[] = {
    {Qt::Key_Shift, VK::Shift}, {Qt::Key_Control, VK::Control}, {Qt::Key_Alt, VK::Menu},
    {Qt::Key_AltGr, VK::Menu}, {Qt::Key_SysReq, VK::Snapshot},
    {Qt::Key_Super_L, VK::LWin}, {Qt::Key_Super_R, VK::RWin},
    // US layout: a shifted symbol is reported on the key that carries it.
    {Qt::Key_Exclam, VK::Digit0 + 1}, {Qt::Key_At, VK::Digit0 + 2},
    {Qt::Key_NumberSign, VK::Digit0 + 3}, {Qt::Key_Dollar, VK::Digit0 + 4},
    {Qt::Key_Percent, VK::Digit0 + 5}, {Qt::Key_AsciiCircum, VK::Digit0 + 6},
    {Qt::Key_Ampersand, VK::Digit0 + 7}, {Qt::Key_Asterisk, VK::Digit0 + 8},
    {Qt::Key_ParenLeft, VK::Digit0 + 9}, {Qt::Key_ParenRight, VK::Digit0},
    {Qt::Key_Semicolon, VK::Oem1}, {Qt::Key_Colon, VK::Oem1},
    {Qt::Key_Equal, VK::OemPlus}, {Qt::Key_Plus, VK::OemPlus},
    {Qt::Key_Comma, VK::OemComma}, {Qt::Key_Less, VK::OemComma},
    {Qt::Key_Minus, VK::OemMinus}, {Qt::Key_Underscore, VK::OemMinus},
    {Qt::Key_Period, VK::OemPeriod}, {Qt::Key_Greater, VK::OemPeriod},
    {Qt::Key_Slash, VK::Oem2}, {Qt::Key_Question, VK::Oem2},
    {Qt::Key_QuoteLeft, VK::Oem3}, {Qt::Key_AsciiTilde, VK::Oem3},
    {Qt::Key_BracketLeft, VK::Oem4}, {Qt::Key_BraceLeft, VK::Oem4},
    {Qt::Key_Backslash, VK::Oem5}, {Qt::Key_Bar, VK::Oem5},
    {Qt::Key_BracketRight, VK::Oem6}, {Qt::Key_BraceRight, VK::Oem6},
    {Qt::Key_Apostrophe, VK::Oem7}, {Qt::Key_QuoteDbl, VK::Oem7},
};

// Keys whose code differs when they come from the numeric keypad.
const KeyPair kQtKeypadKeys[] = {
    {Qt::Key_Asterisk, VK::Multiply}, {Qt::Key_Plus, VK::Add}, {Qt::Key_Comma, VK::Separator},
    {Qt::Key_Minus, VK::Subtract}, {Qt::Key_Period, VK::Decimal}, {Qt::Key_Slash, VK::Divide},
};

const KeyPair kKeysyms[] = {
    {0xff08, VK::Back}, {0xff09, VK::Tab}, {0xfe20, VK::Tab} /* ISO_Left_Tab */,
    {0xff0b, VK::Clear}, {0xff0d, VK::Return}, {0xff13, VK::Pause}, {0xff14, VK::ScrollLock},
    {0xff15, VK::Snapshot} /* Sys_Req */, {0xff1b, VK::Escape}, {0xffff, VK::Delete},
    {0xff50, VK::Home}, {0xff51, VK::Left}, {0xff52, VK::Up}, {0xff53, VK::Right},
    {0xff54, VK::Down}, {0xff55, VK::Prior}, {0xff56, VK::Next}, {0xff57, VK::End},
    {0xff60, VK::Select}, {0xff61, VK::Snapshot}, {0xff62, VK::Execute}, {0xff63, VK::Insert},
    {0xff67, VK::Apps}, {0xff6a, VK::Help}, {0xff6b, VK::Cancel} /* Break */,
    {0xff7f, VK::NumLock},
    // Keypad with Num Lock off: the navigation codes, as Windows reports them.
    {0xff8d, VK::Return}, {0xff95, VK::Home}, {0xff96, VK::Left}, {0xff97, VK::Up},
    {0xff98, VK::Right}, {0xff99, VK::Down}, {0xff9a, VK::Prior}, {0xff9b, VK::Next},
    {0xff9c, VK::End}, {0xff9d, VK::Clear}, {0xff9e, VK::Insert}, {0xff9f, VK::Delete},
    {0xffaa, VK::Multiply}, {0xffab, VK::Add}, {0xffac, VK::Separator},
    {0xffad, VK::Subtract}, {0xffae, VK::Decimal}, {0xffaf, VK::Divide},
    {0xffe1, VK::LShift}, {0xffe2, VK::RShift}, {0xffe3, VK::LControl}, {0xffe4, VK::RControl},
    {0xffe5, VK::Capital}, {0xffe6, VK::Capital} /* Shift_Lock */,
    {0xffe7, VK::LWin} /* Meta_L */, {0xffe8, VK::RWin}, {0xffe9, VK::LMenu}, {0xffea, VK::RMenu},
    {0xffeb, VK::LWin}, {0xffec, VK::RWin}, {0xfe03, VK::RMenu} /* ISO_Level3_Shift: AltGr */,
    {0x20, VK::Space},
    {0x3b, VK::Oem1}, {0x3a, VK::Oem1}, {0x3d, VK::OemPlus}, {0x2b, VK::OemPlus},
    {0x2c, VK::OemComma}, {0x2d, VK::OemMinus}, {0x5f, VK::OemMinus}, {0x2e, VK::OemPeriod},
    {0x3e, VK::OemPeriod}, {0x2f, VK::Oem2}, {0x3f, VK::Oem2}, {0x60, VK::Oem3},
    {0x7e, VK::Oem3}, {0x5b, VK::Oem4}, {0x7b, VK::Oem4}, {0x5c, VK::Oem5}, {0x7c, VK::Oem5},
    {0x5d, VK::Oem6}, {0x7d, VK::Oem6}, {0x27, VK::Oem7}, {0x22, VK::Oem7},
    {0x3c, VK::Oem102} /* "<" unshifted: the extra key of ISO keyboards */,
};

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
    {0xFE, Qt::Key_Clear}, // after 0x0C: Clear is OEM Clear, which has no Mac key
};

std::unordered_map<int, int> buildQtKeyIndex()
{
    std::unordered_map<int, int> index;
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
        index[qtKeyOf[vk]] = vk;
    // Qt's own names for two keys the mapper leaves to Windows: Backtab is Tab, the keypad
    // Enter has the converter's slot of its own.
    index[Qt::Key_Backtab] = VK::Tab;
    index[Qt::Key_Enter] = VK::QtEnter;
    return index;
}

const KeyPair kGenericModifiers[] = {
    {VK::LShift, VK::Shift}, {VK::RShift, VK::Shift}, {VK::LControl, VK::Control},
    {VK::RControl, VK::Control}, {VK::LMenu, VK::Menu}, {VK::RMenu, VK::Menu},
};

} // namespace

int virtualKeyFromQtKey(int qtKey, bool keypad)
{
    if (qtKey >= Qt::Key_0 && qtKey <= Qt::Key_9)
        return (keypad ? VK::Numpad0 : VK::Digit0) + (qtKey - Qt::Key_0);
    if (qtKey >= Qt::Key_A && qtKey <= Qt::Key_Z)
        return VK::A + (qtKey - Qt::Key_A);
    if (qtKey >= Qt::Key_F1 && qtKey <= Qt::Key_F24)
        return VK::F1 + (qtKey - Qt::Key_F1);
    if (keypad) {
        if (const int vk = lookup(kQtKeypadKeys, UInt32(qtKey)))
            return vk;
    }
    if (qtKey < 0)
        return 0;
    if (const int vk = lookup(kQtKeys, UInt32(qtKey)))
        return vk;
    const int vk = virtualKeyIndexForQtKey(qtKey);
    return vk > 0 && qtKey != Qt::Key_unknown ? vk : 0;
}

int virtualKeyIndexForQtKey(int qtKey)
{
    static const std::unordered_map<int, int> sIndex = buildQtKeyIndex();
    const auto it = sIndex.find(qtKey);
    return it == sIndex.end() ? -1 : it->second;
}

int virtualKeyFromKeysym(UInt32 keysym)
{
    if (keysym >= 'a' && keysym <= 'z')
        return VK::A + int(keysym - 'a');
    if (keysym >= 'A' && keysym <= 'Z')
        return VK::A + int(keysym - 'A');
    if (keysym >= '0' && keysym <= '9')
        return VK::Digit0 + int(keysym - '0');
    if (keysym >= 0xffb0 && keysym <= 0xffb9) // KP_0 .. KP_9
        return VK::Numpad0 + int(keysym - 0xffb0);
    if (keysym >= 0xffbe && keysym <= 0xffd5) // F1 .. F24
        return VK::F1 + int(keysym - 0xffbe);
    return lookup(kKeysyms, keysym);
}

int genericModifierKey(int virtualKey)
{
    return virtualKey < 0 ? 0 : lookup(kGenericModifiers, UInt32(virtualKey));
}

} // namespace Velmar::Private::Platform
