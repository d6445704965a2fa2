// What the cursor calls share: the process cursor table, the live-record check and picture
// loading.
#pragma once

#include <Velmar/Cursors.h>

#include "foundation/LiveHandles.h"

#include <QCursor>
#include <QLatin1String>

#include <map>

namespace Velmar::Private {

// A live record, silently false for null; a record that is gone or was never made raises
// the assertion "IsValidCursor(cursor)".
#define VELMAR_CHECK_CURSOR(cursor) VELMAR_LIVE((cursor), "IsValidCursor(cursor)")

// One per process, made on the first cursor call and never destroyed. Each map holds one
// reference to each of its records.
struct CursorTable {
    std::map<SInt16, CursPtr*> blackAndWhite; // GetCursor
    std::map<SInt16, CursPtr*> colour; // GetCCursor
    QCursor defaultCursor{Qt::ArrowCursor};
    bool hidden = false;
    bool obscured = false;
    // The top of the override stack is the cursor SetCCursor pushed last: the next one
    // replaces it instead of pushing, so that hosts setting cursors on every mouse move do
    // not grow the stack.
    bool setCursorOnTop = false;
};
CursorTable& cursorTable();

// True for a record one of the table's maps holds: its last reference is the table's.
bool isTableCursor(const CursPtr* cursor);

// Resource name prefixes of the two kinds.
inline constexpr QLatin1String kColourCursorPrefix{"crsr"};
inline constexpr QLatin1String kBlackAndWhiteCursorPrefix{"CURS"};

// ":/images/cursors/<prefix>_<id>.png" (the ID as an unsigned 16-bit number) as a cursor
// whose hot spot is the picture's centre; above a device pixel ratio of 1 the double-size
// "<prefix>_<id>@2x.png" where there is one. The table's default cursor when there is no
// picture.
QCursor loadCursorPicture(QLatin1String prefix, SInt16 id, qreal devicePixelRatio);

} // namespace Velmar::Private
