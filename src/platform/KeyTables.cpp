// Key tables. Ranges (letters, digits, function keys) are computed; everything else is
// looked up in small sorted-free tables, which are short enough for a linear scan.
#include "platform/KeyTables.h"
#include "platform/VirtualKeys.h"

#include <QtCore/qnamespace.h>

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

const KeyPair kQtKeys[] = {
    {Qt::Key_Escape, VK::Escape}, {Qt::Key_Tab, VK::Tab}, {Qt::Key_Backtab, VK::Tab},
    {Qt::Key_Backspace, VK::Back}, {Qt::Key_Return, VK::Return}, {Qt::Key_Enter, VK::QtEnter},
    {Qt::Key_Insert, VK::Insert}, {Qt::Key_Delete, VK::Delete}, {Qt::Key_Pause, VK::Pause},
    {Qt::Key_Print, VK::Snapshot}, {Qt::Key_SysReq, VK::Snapshot}, {Qt::Key_Clear, VK::Clear},
    {Qt::Key_Home, VK::Home}, {Qt::Key_End, VK::End}, {Qt::Key_Left, VK::Left},
    {Qt::Key_Up, VK::Up}, {Qt::Key_Right, VK::Right}, {Qt::Key_Down, VK::Down},
    {Qt::Key_PageUp, VK::Prior}, {Qt::Key_PageDown, VK::Next},
    {Qt::Key_Shift, VK::Shift}, {Qt::Key_Control, VK::Control}, {Qt::Key_Meta, VK::LWin},
    {Qt::Key_Alt, VK::Menu}, {Qt::Key_AltGr, VK::Menu}, {Qt::Key_CapsLock, VK::Capital},
    {Qt::Key_NumLock, VK::NumLock}, {Qt::Key_ScrollLock, VK::ScrollLock},
    {Qt::Key_Super_L, VK::LWin}, {Qt::Key_Super_R, VK::RWin}, {Qt::Key_Menu, VK::Apps},
    {Qt::Key_Help, VK::Help}, {Qt::Key_Cancel, VK::Cancel}, {Qt::Key_Select, VK::Select},
    {Qt::Key_Execute, VK::Execute}, {Qt::Key_Printer, VK::Print}, {Qt::Key_Space, VK::Space},
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
    return qtKey < 0 ? 0 : lookup(kQtKeys, UInt32(qtKey));
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
