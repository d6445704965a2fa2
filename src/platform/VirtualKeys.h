// Windows virtual-key codes: the library's key vocabulary on every platform.
// Plain constants rather than the VK_ macros so that they never clash with <windows.h>.
#pragma once

namespace Velmar::Private::VirtualKey {

enum : int {
    LButton = 0x01, RButton = 0x02, Cancel = 0x03, MButton = 0x04, XButton1 = 0x05, XButton2 = 0x06,
    Back = 0x08, Tab = 0x09, Clear = 0x0C, Return = 0x0D,
    QtEnter = 0x0E, // not a Windows code: the key converter's slot for Qt's keypad Enter
    Shift = 0x10, Control = 0x11, Menu = 0x12, Pause = 0x13, Capital = 0x14,
    Escape = 0x1B, Space = 0x20,
    Prior = 0x21, Next = 0x22, End = 0x23, Home = 0x24,
    Left = 0x25, Up = 0x26, Right = 0x27, Down = 0x28,
    Select = 0x29, Print = 0x2A, Execute = 0x2B, Snapshot = 0x2C, Insert = 0x2D, Delete = 0x2E,
    Help = 0x2F,
    Digit0 = 0x30, // 0x30-0x39 are the digits
    A = 0x41,      // 0x41-0x5A are the capital letters
    Z = 0x5A,
    LWin = 0x5B, RWin = 0x5C, Apps = 0x5D,
    Numpad0 = 0x60, // 0x60-0x69
    Multiply = 0x6A, Add = 0x6B, Separator = 0x6C, Subtract = 0x6D, Decimal = 0x6E, Divide = 0x6F,
    F1 = 0x70, // 0x70-0x87 are F1-F24
    F24 = 0x87,
    NumLock = 0x90, ScrollLock = 0x91,
    LShift = 0xA0, RShift = 0xA1, LControl = 0xA2, RControl = 0xA3, LMenu = 0xA4, RMenu = 0xA5,
    Oem1 = 0xBA, OemPlus = 0xBB, OemComma = 0xBC, OemMinus = 0xBD, OemPeriod = 0xBE,
    Oem2 = 0xBF, Oem3 = 0xC0, Oem4 = 0xDB, Oem5 = 0xDC, Oem6 = 0xDD, Oem7 = 0xDE,
    Oem102 = 0xE2,
};

} // namespace Velmar::Private::VirtualKey
