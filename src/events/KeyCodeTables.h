// The keyboard tables behind key events (see KeyCodeTables.cpp).
#pragma once

#include <Velmar/MacTypes.h>

namespace Velmar::Private {

struct MacKeyPair {
    UInt8 charCode = 0;
    UInt8 keyCode = 0;
};

// Builds all tables now (they are otherwise built at first use).
void buildKeyboardTables();
// The Mac character and key code of a Windows virtual key; (0, 0) for none.
MacKeyPair macKeyForVirtualKey(int virtualKey);
// The Mac OS Roman code and key code of a typed UTF-16 character; false when not in the table.
bool macKeyForCharacter(char16_t character, MacKeyPair* out);
// The virtual key of a Mac key code (0 for none; the A key's code 0 always answers none).
int virtualKeyForMacKey(int macKeyCode);
int characterTableSize();

} // namespace Velmar::Private
