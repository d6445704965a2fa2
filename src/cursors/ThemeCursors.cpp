// Theme cursors: each one shows the cursor of an ID. Cursors the library has no shape or
// picture of share the nearest one (the copy arrow and the counting hands show the arrow, the
// spinning cursor the watch, the one-way resize cursors the two-way ones).
#include <Velmar/Cursors.h>
#include <Velmar/MacErrors.h>

#include <iterator>

namespace Velmar {

namespace {

// Indexed by theme cursor.
constexpr SInt16 kThemeCursorIds[] = {
    0, // arrow
    0, // copy arrow
    6609, // alias arrow
    6610, // contextual-menu arrow
    1, // I-beam
    2, // cross
    6608, // plus
    4, // watch
    8, // closed hand
    9, // open hand
    13, // pointing hand
    0, // counting up hand
    0, // counting down hand
    0, // counting up and down hand
    4, // spinning
    17, // resize left
    17, // resize right
    17, // resize left and right
    18, // not allowed
    21, // resize up
    21, // resize down
    21, // resize up and down
};

SInt16 themeCursorId(ThemeCursor themeCursor)
{
    return themeCursor < std::size(kThemeCursorIds) ? kThemeCursorIds[themeCursor] : 0;
}

} // namespace

OSStatus SetThemeCursor(ThemeCursor themeCursor)
{
    CursPtr* cursor = GetCCursor(themeCursorId(themeCursor));
    if (!cursor)
        return paramErr;
    SetCCursor(cursor);
    return noErr;
}

} // namespace Velmar
