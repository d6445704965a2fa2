// Decoders for the classic resource types a program's resource file carries. Every field is
// read big-endian, one at a time, with its length checked first: resource data is never cast
// onto a struct. Each decoder answers nullopt for data too short for its fixed part; lists cut
// short keep the whole entries before the cut.
#pragma once

#include <Velmar/MacTypes.h>

#include <QByteArray>
#include <QImage>
#include <QList>

#include <array>
#include <optional>

namespace Velmar::Classic {

// 'STR ': one Pascal string. 'STR#': a count and that many Pascal strings.
std::optional<QByteArray> decodeString(const QByteArray& data);
std::optional<QList<QByteArray>> decodeStringList(const QByteArray& data);
// 'TEXT': the bytes as they are (Mac Roman, lines end in CR).
inline QByteArray decodeText(const QByteArray& data) { return data; }

// 'WIND'
struct WindowTemplate {
    Rect bounds{};
    SInt16 procID = 0;
    bool visible = false;
    bool goAwayFlag = false;
    SInt32 refCon = 0;
    QByteArray title;
    std::optional<UInt16> positioning; // the word after the title, when present
};
std::optional<WindowTemplate> decodeWindow(const QByteArray& data);

// 'MENU'
struct MenuItemTemplate {
    QByteArray text;
    UInt8 icon = 0;          // icon number (resource ID - 256), 0 for none
    UInt8 keyEquivalent = 0; // 0 for none; 0x1B a hierarchical item (mark holds the menu ID)
    UInt8 mark = 0;
    UInt8 style = 0;
};
struct MenuTemplate {
    SInt16 menuID = 0;
    SInt16 width = 0;  // placeholders in the file, computed when the menu is drawn
    SInt16 height = 0;
    SInt16 procID = 0; // 'MDEF' ID, 0 for the standard one
    UInt32 enableFlags = 0; // bit 0 the whole menu, bit n item n
    QByteArray title;
    QList<MenuItemTemplate> items;
};
std::optional<MenuTemplate> decodeMenu(const QByteArray& data);

// 'MBAR': the menu IDs in order.
std::optional<QList<SInt16>> decodeMenuBar(const QByteArray& data);

// 'CURS'
struct CursorTemplate {
    std::array<UInt16, 16> data{}; // rows, most significant bit leftmost
    std::array<UInt16, 16> mask{};
    Point hotSpot{};
};
std::optional<CursorTemplate> decodeCursor(const QByteArray& data);

// 'PAT ' and 'PAT#'
struct PatternTemplate {
    std::array<UInt8, 8> pat{};
};
std::optional<PatternTemplate> decodePattern(const QByteArray& data);
std::optional<QList<PatternTemplate>> decodePatternList(const QByteArray& data);

// 'ICON' (32x32, 128 bytes), 'ICN#' (a list of 128-byte bitmaps: icon then mask),
// 'SICN' (a list of 16x16 bitmaps, 32 bytes each).
std::optional<QByteArray> decodeIcon(const QByteArray& data);
struct IconFamily {
    QByteArray icon; // 128 bytes
    QByteArray mask; // 128 bytes
};
std::optional<IconFamily> decodeIconList(const QByteArray& data);
std::optional<QList<QByteArray>> decodeSmallIcons(const QByteArray& data);

// 'styl': style runs of a TextEdit text.
struct StyleRun {
    SInt32 startChar = 0;
    SInt16 lineHeight = 0;
    SInt16 fontAscent = 0;
    SInt16 fontID = 0;
    UInt8 face = 0;
    SInt16 size = 0;
    RGBColor color;
};
std::optional<QList<StyleRun>> decodeStyles(const QByteArray& data);

// 'DLOG'
struct DialogTemplate {
    Rect bounds{};
    SInt16 procID = 0;
    bool visible = false;
    bool goAwayFlag = false;
    SInt32 refCon = 0;
    SInt16 itemsID = 0; // its 'DITL'
    QByteArray title;
    std::optional<UInt16> positioning;
};
std::optional<DialogTemplate> decodeDialog(const QByteArray& data);

// 'ALRT'. Stage n (1-4) is the nibble at bits 4(n-1)..4(n-1)+3 of `stages`.
struct AlertStage {
    bool boldItem2 = false; // the default (outlined) item is 2 rather than 1
    bool drawn = false;     // the alert shows at this stage
    UInt8 sound = 0;        // 0-3
};
struct AlertTemplate {
    Rect bounds{};
    SInt16 itemsID = 0;
    UInt16 stages = 0;
    std::optional<UInt16> positioning;
    AlertStage stage(int oneBased) const;
};
std::optional<AlertTemplate> decodeAlert(const QByteArray& data);

// 'DITL'
enum : UInt8 {
    kDialogItemUser = 0,
    kDialogItemHelp = 1,
    kDialogItemControl = 4, // + 0 button, 1 check box, 2 radio button, 3 'CNTL' resource
    kDialogItemButton = 4,
    kDialogItemCheckBox = 5,
    kDialogItemRadio = 6,
    kDialogItemResControl = 7,
    kDialogItemStaticText = 8,
    kDialogItemEditText = 16,
    kDialogItemIcon = 32,
    kDialogItemPicture = 64,
    kDialogItemDisabled = 128,
};
struct DialogItemTemplate {
    Rect bounds{};
    UInt8 type = 0;          // including the disabled bit
    QByteArray data;         // the text, or the raw bytes of other kinds
    SInt16 resourceID = 0;   // icon, picture and 'CNTL' items
    UInt8 kind() const { return type & 0x7F; }
    bool enabled() const { return (type & kDialogItemDisabled) == 0; }
};
std::optional<QList<DialogItemTemplate>> decodeDialogItems(const QByteArray& data);

// 'CNTL'
struct ControlTemplate {
    Rect bounds{};
    SInt16 value = 0;
    bool visible = false;
    SInt16 max = 0;
    SInt16 min = 0;
    SInt16 procID = 0;
    SInt32 refCon = 0;
    QByteArray title;
};
std::optional<ControlTemplate> decodeControl(const QByteArray& data);

// A one-bit bitmap (rows of (width + 7) / 8 bytes, most significant bit leftmost, set bits
// black) as an ARGB32 image. With a mask of the same shape, clear mask bits are transparent;
// without one every pixel is opaque (white where the bit is clear). A null image when `bits`
// (or a given mask) is too short.
QImage oneBitImage(const QByteArray& bits, int width, int height, const QByteArray& mask = {});

} // namespace Velmar::Classic
