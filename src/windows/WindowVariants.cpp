// Window definition variants: what GetWVariant answers for a window made from a class and
// attribute set (CreateNewWindow) or from a classic definition ID (NewCWindow), and the
// class and attributes a classic definition ID stands for.
#include "windows/WindowVariants.h"

#include <Velmar/Windows.h>

namespace Velmar::Private {

namespace {

// The variant is the low four bits of the window definition ID a class and attribute set
// selects among the appearance-savvy definitions 1024-1999. Per class: the ID with no
// optional parts, the attributes that leave the ID alone, and what each optional part adds.
struct ClassDefinition {
    WindowClass windowClass;
    int baseId;
    WindowAttributes neutral;  // allowed, no effect on the ID (close and collapse boxes)
    int growStep;              // added for kWindowResizableAttribute (0: not allowed)
    int verticalZoomStep;      // for kWindowVerticalZoomAttribute (0: not allowed)
    int horizontalZoomStep;    // for kWindowHorizontalZoomAttribute
    int sideTitleStep;         // for kWindowSideTitlebarAttribute
    bool zoomOnlyFull;         // both zoom directions or neither
};

constexpr WindowAttributes kBoxes = kWindowCloseBoxAttribute | kWindowCollapseBoxAttribute;

constexpr ClassDefinition kClassDefinitions[] = {
    // Dialogs and alerts: 1040 plain, 1041 shadow, 1042 modal, 1043 movable modal,
    // 1044 alert, 1045 movable alert, 1046 movable modal with a grow box.
    {kAlertWindowClass, 1044, 0, 0, 0, 0, 0, false},
    {kMovableAlertWindowClass, 1045, kWindowCollapseBoxAttribute, 0, 0, 0, 0, false},
    {kModalWindowClass, 1042, 0, 0, 0, 0, 0, false},
    {kMovableModalWindowClass, 1043, kWindowCollapseBoxAttribute, 3, 0, 0, 0, false},
    // Floating windows: 1057 and up, odd IDs; grow +2, vertical zoom +4, horizontal +8,
    // side title bar +16.
    {kFloatingWindowClass, 1057, kBoxes, 2, 4, 8, 16, false},
    // Documents: 1024 and up; grow +1, vertical zoom +2, horizontal zoom +4.
    {kDocumentWindowClass, 1024, kBoxes, 1, 2, 4, 0, false},
    // Utility windows use the floating definitions, with both zoom directions or neither
    // (their classic IDs 1985-1999 carry the same variants).
    {kUtilityWindowClass, 1057, kBoxes, 2, 4, 8, 16, true},
    {kHelpWindowClass, 1041, 0, 0, 0, 0, 0, false},
    {kSheetWindowClass, 1088, 0, 0, 0, 0, 0, false},
    {kToolbarWindowClass, 1040, 0, 0, 0, 0, 0, false},
    {kPlainWindowClass, 1040, 0, 0, 0, 0, 0, false},
    {kOverlayWindowClass, 1104, 0, 0, 0, 0, 0, false},
    {kSheetAlertWindowClass, 1088, 0, 0, 0, 0, 0, false},
    {kAltPlainWindowClass, 1041, 0, 0, 0, 0, 0, false},
};

// Never change the variant: the window system ignores them anyway.
constexpr WindowAttributes kUnsupported = kWindowHideOnSuspendAttribute | kWindowNoShadowAttribute;

struct ProcIdRow {
    SInt16 procID;
    WindowClass windowClass;
    WindowAttributes attributes;
};

// The first matching row wins, so the second row of 5 is never reached; kept as it is.
constexpr ProcIdRow kProcIdRows[] = {
    {0, 6, 0x19},       {1, 3, 0},        {2, 5, 0x200200}, {4, 6, 0x9},   {5, 4, 0},
    {5, 6, 0x9},        {8, 6, 0x1F},     {11, 6, 0x10},    {3378, 4, 0x10},
    {3392, 10, 0x1200000}, {3424, 5, 0x11}, {3426, 5, 0x11}, {3432, 5, 0x17},
    {3520, 5, 0x9},     {3524, 5, 0x9},
};

struct ProcIdVariant {
    SInt16 procID;
    SInt16 variant;
};

constexpr ProcIdVariant kProcIdVariants[] = {
    {0, 1},     {1, 2},     {3, 1},     {5, 3},     {8, 7},     {12, 6},    {1025, 1},
    {1026, 2},  {1027, 3},  {1028, 4},  {1029, 5},  {1030, 6},  {1031, 7},  {1041, 1},
    {1042, 2},  {1043, 3},  {1044, 4},  {1045, 5},  {1046, 6},  {1057, 1},  {1059, 3},
    {1061, 5},  {1063, 7},  {1065, 9},  {1067, 11}, {1069, 13}, {1071, 15}, {1073, 1},
    {1075, 3},  {1077, 5},  {1079, 7},  {1081, 9},  {1083, 11}, {1085, 13}, {1087, 15},
    {1985, 1},  {1987, 3},  {1989, 13}, {1991, 15}, {1993, 1},  {1995, 3},  {1997, 13},
    {1999, 15},
};

} // namespace

SInt16 classAttributesVariant(WindowClass windowClass, WindowAttributes attributes)
{
    for (const ClassDefinition& c : kClassDefinitions) {
        if (c.windowClass != windowClass)
            continue;
        WindowAttributes rest = attributes & ~(kUnsupported | c.neutral);
        int id = c.baseId;
        const auto take = [&rest, &id](WindowAttributes bits, int step) {
            if (step && (rest & bits) == bits) {
                rest &= ~bits;
                id += step;
            }
        };
        if (c.zoomOnlyFull) {
            take(kWindowFullZoomAttribute, c.verticalZoomStep + c.horizontalZoomStep);
        } else {
            take(kWindowVerticalZoomAttribute, c.verticalZoomStep);
            take(kWindowHorizontalZoomAttribute, c.horizontalZoomStep);
        }
        take(kWindowResizableAttribute, c.growStep);
        take(kWindowSideTitlebarAttribute, c.sideTitleStep);
        // An attribute the class's definitions do not know: no such row, no variant.
        return rest ? SInt16(0) : SInt16(id & 0xF);
    }
    return 0;
}

void procIdClassAndAttributes(SInt16 procID, WindowClass* windowClass, WindowAttributes* attributes)
{
    for (const ProcIdRow& row : kProcIdRows) {
        if (row.procID == procID) {
            *windowClass = row.windowClass;
            *attributes = row.attributes;
            return;
        }
    }
    *windowClass = kDocumentWindowClass;
    *attributes = kWindowNoAttributes;
}

SInt16 procIdVariant(SInt16 procID)
{
    for (const ProcIdVariant& row : kProcIdVariants) {
        if (row.procID == procID)
            return row.variant;
    }
    return 0;
}

} // namespace Velmar::Private
