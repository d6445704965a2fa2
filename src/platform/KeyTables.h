// Translation of Qt keys and X keysyms into Windows virtual-key codes.
#pragma once

#include <Velmar/MacTypes.h>

namespace Velmar::Private::Platform {

// The virtual key of a Qt::Key (0 when there is none). `keypad` selects the numeric-keypad
// codes for digits and operators. Punctuation follows the US layout, as the shifted symbols
// do (Qt::Key_Exclam is the "1" key). Qt::Key_Enter gives VirtualKey::QtEnter.
int virtualKeyFromQtKey(int qtKey, bool keypad = false);

// The one index of Qt keys to virtual keys, as Qt's Windows key mapper names them (a later
// virtual key wins); -1 when the index has none. Key events take their codes from it; the
// function above answers from it for every key it has no row of its own for.
int virtualKeyIndexForQtKey(int qtKey);

// The virtual key of an X keysym (0 when there is none). Keypad Enter is Return, as on
// Windows; left and right modifier keys keep their sides (LShift, RControl ...).
int virtualKeyFromKeysym(UInt32 keysym);

// The side-less modifier key for a sided one (LShift -> Shift ...), else 0.
int genericModifierKey(int virtualKey);

} // namespace Velmar::Private::Platform
