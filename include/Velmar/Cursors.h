// Cursors and tool tips: the Toolbox cursor calls on Qt's application override cursor, with
// cursor pictures from the compiled-in resource tree (":/images/cursors/crsr_ID.png" for
// colour cursors, ":/images/cursors/CURS_ID.png" for black-and-white ones), and tool tips on
// QToolTip for one parent window.
#pragma once

#include <Velmar/MacErrors.h>
#include <Velmar/MacTypes.h>
#include <Velmar/WindowRef.h>

class QCursor;

namespace Velmar {

// A cursor record, counted: it starts with one reference, AddRef adds one, Release takes one
// away and the record goes at 0 (so it is never deleted directly). Calls refuse, with the
// assertion "IsValidCursor(cursor)", a record that is gone or that was never made.
//
// The records GetCursor and GetCCursor answer belong to the library for the life of the
// process: Release and DisposeCCursor never take away the library's own reference, so a
// host may dispose of them as it would of a colour cursor it made.
class VELMAR_EXPORT CursPtr {
public:
    explicit CursPtr(const QCursor& cursor);
    CursPtr(const CursPtr&) = delete;
    CursPtr& operator=(const CursPtr&) = delete;

    // The new count (0 for a record that is gone).
    SInt32 AddRef();
    SInt32 Release();

    void setCursor(const QCursor& cursor);
    // A copy; the arrow for a record that is gone.
    QCursor getCursor() const;

private:
    ~CursPtr(); // Release deletes

    SInt32 m_refCount = 1;
    QCursor* m_cursor = nullptr;
};

using CursHandle = CursPtr*;
using CCrsrHandle = CursPtr*;

// Cursor IDs the library always knows (besides 0, the arrow).
enum : SInt16 {
    iBeamCursor = 1,
    crossCursor = 2,
    plusCursor = 3,
    watchCursor = 4,
};

using ThemeCursor = UInt32;
enum : ThemeCursor {
    kThemeArrowCursor = 0,
    kThemeCopyArrowCursor = 1,
    kThemeAliasArrowCursor = 2,
    kThemeContextualMenuArrowCursor = 3,
    kThemeIBeamCursor = 4,
    kThemeCrossCursor = 5,
    kThemePlusCursor = 6,
    kThemeWatchCursor = 7,
    kThemeClosedHandCursor = 8,
    kThemeOpenHandCursor = 9,
    kThemePointingHandCursor = 10,
    kThemeCountingUpHandCursor = 11,
    kThemeCountingDownHandCursor = 12,
    kThemeCountingUpAndDownHandCursor = 13,
    kThemeSpinningCursor = 14,
    kThemeResizeLeftCursor = 15,
    kThemeResizeRightCursor = 16,
    kThemeResizeLeftRightCursor = 17,
    kThemeNotAllowedCursor = 18,
    kThemeResizeUpCursor = 19,
    kThemeResizeDownCursor = 20,
    kThemeResizeUpDownCursor = 21,
};

// ---- Cursors by ID ----------------------------------------------------------------------
// The record for the ID, made on the first request and the same one afterwards. Never null:
// an ID with neither a built-in shape nor a picture gives the arrow. A picture's hot spot is
// its centre.
VELMAR_EXPORT CursPtr* GetCursor(SInt16 id);
VELMAR_EXPORT CursPtr* GetCCursor(SInt16 id);
// Makes the cursor the application's override cursor (pushed), unless the override cursor
// showing is a shaped cursor of the same shape. Null is ignored.
VELMAR_EXPORT void SetCCursor(CursPtr* cursor);
// Releases one reference. Null is ignored.
VELMAR_EXPORT void DisposeCCursor(CursPtr* cursor);
// SetCCursor(GetCCursor(id)) for the theme cursor's ID; unknown theme cursors show the arrow.
// Answers noErr (paramErr when no cursor could be had).
VELMAR_EXPORT OSStatus SetThemeCursor(ThemeCursor themeCursor);

// ---- Hiding and the override stack ----------------------------------------------------------
// Pushes a blank override cursor unless the cursor is hidden already.
VELMAR_EXPORT void HideCursor();
// Pushes a blank override cursor on every call.
VELMAR_EXPORT void ObscureCursor();
// When hidden or obscured: pops one override cursor and clears both states. Otherwise
// nothing happens.
VELMAR_EXPORT void ShowCursor();
// ShowCursor when obscured.
VELMAR_EXPORT void RestoreObscuredCursor();
VELMAR_EXPORT Boolean CursorObscured();
// Pops every override cursor, then ShowCursor: the widgets' own cursors (the arrow) show.
// Called on every window activation and deactivation once the host has made a cursor call.
VELMAR_EXPORT void InitCursor();
// Pops every override cursor.
VELMAR_EXPORT void RemoveOverrideCursor();

// Pops one override cursor when the scope ends, whatever was pushed within it: the first
// SetCCursor within the scope pushes its cursor.
class VELMAR_EXPORT AutoRestoreCursor {
public:
    AutoRestoreCursor();
    ~AutoRestoreCursor();
    AutoRestoreCursor(const AutoRestoreCursor&) = delete;
    AutoRestoreCursor& operator=(const AutoRestoreCursor&) = delete;
};

// ---- Tool tips --------------------------------------------------------------------------------
// Shows `text` (NUL-terminated, in the host's Mac encoding) at the global point (h, v), for
// the tool-tip parent window. Nothing shows unless the parent is set and not disposed, the
// application has an active window, and the point is a visible part of the parent that no
// other window covers.
VELMAR_EXPORT void ShowToolTip(int h, int v, const char* text);
// false: hides the tip showing. true: closes and deletes every tool-tip window.
VELMAR_EXPORT void HideToolTip(bool destroy);
// The window tool tips belong to; null forgets it. A disposed window is not taken.
VELMAR_EXPORT void SetToolTipParent(WindowRef window);

} // namespace Velmar
