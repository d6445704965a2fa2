#include "classic/resfile/Decoders.h"

#include "classic/resfile/BigEndian.h"

namespace Velmar::Classic {

namespace {

// The word after a title, present in later templates: only when two bytes remain after the
// title and its alignment.
std::optional<UInt16> positioningWord(BigEndianReader& in)
{
    in.alignWord();
    if (!in.has(2))
        return std::nullopt;
    return in.u16();
}

template <typename T>
std::optional<T> okOr(const BigEndianReader& in, T value)
{
    if (!in.ok())
        return std::nullopt;
    return value;
}

// A count word then entries of `entrySize` bytes each; a list cut short keeps what is whole.
template <typename T, typename Read>
std::optional<QList<T>> countedList(const QByteArray& data, qsizetype entrySize, Read read)
{
    BigEndianReader in(data);
    const UInt16 count = in.u16();
    if (!in.ok())
        return std::nullopt;
    QList<T> out;
    for (UInt32 i = 0; i < count && in.has(entrySize); ++i)
        out.append(read(in));
    return out;
}

} // namespace

std::optional<QByteArray> decodeString(const QByteArray& data)
{
    BigEndianReader in(data);
    const UInt8 length = in.u8();
    if (!in.ok())
        return std::nullopt;
    // A length past the end keeps the bytes that are there.
    return data.mid(1, std::min<qsizetype>(length, data.size() - 1));
}

std::optional<QList<QByteArray>> decodeStringList(const QByteArray& data)
{
    BigEndianReader in(data);
    const UInt16 count = in.u16();
    if (!in.ok())
        return std::nullopt;
    QList<QByteArray> out;
    for (UInt32 i = 0; i < count && in.has(1); ++i) {
        QByteArray s = in.pascal();
        if (!in.ok())
            break;
        out.append(s);
    }
    return out;
}

std::optional<WindowTemplate> decodeWindow(const QByteArray& data)
{
    BigEndianReader in(data);
    WindowTemplate w;
    w.bounds = in.rect();
    w.procID = in.s16();
    w.visible = in.u16() != 0;
    w.goAwayFlag = in.u16() != 0;
    w.refCon = in.s32();
    w.title = in.pascal();
    if (!in.ok())
        return std::nullopt;
    w.positioning = positioningWord(in);
    return w;
}

std::optional<MenuTemplate> decodeMenu(const QByteArray& data)
{
    BigEndianReader in(data);
    MenuTemplate m;
    m.menuID = in.s16();
    m.width = in.s16();
    m.height = in.s16();
    m.procID = in.s16();
    in.skip(2); // the rest of the definition procedure's handle
    m.enableFlags = in.u32();
    m.title = in.pascal();
    if (!in.ok())
        return std::nullopt;
    // Items until a zero length byte (or the end of a file that left it out).
    while (in.has(1)) {
        const UInt8 length = in.u8();
        if (length == 0)
            break;
        MenuItemTemplate item;
        item.text = in.bytes(length);
        item.icon = in.u8();
        item.keyEquivalent = in.u8();
        item.mark = in.u8();
        item.style = in.u8();
        if (!in.ok())
            break;
        m.items.append(item);
    }
    return m;
}

std::optional<QList<SInt16>> decodeMenuBar(const QByteArray& data)
{
    return countedList<SInt16>(data, 2, [](BigEndianReader& in) { return in.s16(); });
}

std::optional<CursorTemplate> decodeCursor(const QByteArray& data)
{
    BigEndianReader in(data);
    CursorTemplate c;
    for (UInt16& row : c.data)
        row = in.u16();
    for (UInt16& row : c.mask)
        row = in.u16();
    c.hotSpot = in.point();
    return okOr(in, c);
}

std::optional<PatternTemplate> decodePattern(const QByteArray& data)
{
    BigEndianReader in(data);
    PatternTemplate p;
    for (UInt8& row : p.pat)
        row = in.u8();
    return okOr(in, p);
}

std::optional<QList<PatternTemplate>> decodePatternList(const QByteArray& data)
{
    return countedList<PatternTemplate>(data, 8, [](BigEndianReader& in) {
        PatternTemplate p;
        for (UInt8& row : p.pat)
            row = in.u8();
        return p;
    });
}

std::optional<QByteArray> decodeIcon(const QByteArray& data)
{
    if (data.size() < 128)
        return std::nullopt;
    return data.left(128);
}

std::optional<IconFamily> decodeIconList(const QByteArray& data)
{
    if (data.size() < 256)
        return std::nullopt;
    return IconFamily{data.left(128), data.mid(128, 128)};
}

std::optional<QList<QByteArray>> decodeSmallIcons(const QByteArray& data)
{
    if (data.size() < 32)
        return std::nullopt;
    QList<QByteArray> out;
    for (qsizetype at = 0; at + 32 <= data.size(); at += 32)
        out.append(data.mid(at, 32));
    return out;
}

std::optional<QList<StyleRun>> decodeStyles(const QByteArray& data)
{
    return countedList<StyleRun>(data, 20, [](BigEndianReader& in) {
        StyleRun run;
        run.startChar = in.s32();
        run.lineHeight = in.s16();
        run.fontAscent = in.s16();
        run.fontID = in.s16();
        run.face = in.u8();
        in.skip(1);
        run.size = in.s16();
        run.color.red = in.u16();
        run.color.green = in.u16();
        run.color.blue = in.u16();
        return run;
    });
}

std::optional<DialogTemplate> decodeDialog(const QByteArray& data)
{
    BigEndianReader in(data);
    DialogTemplate d;
    d.bounds = in.rect();
    d.procID = in.s16();
    d.visible = in.u16() != 0;
    d.goAwayFlag = in.u16() != 0;
    d.refCon = in.s32();
    d.itemsID = in.s16();
    d.title = in.pascal();
    if (!in.ok())
        return std::nullopt;
    d.positioning = positioningWord(in);
    return d;
}

AlertStage AlertTemplate::stage(int oneBased) const
{
    if (oneBased < 1 || oneBased > 4)
        return {};
    const UInt8 nibble = UInt8((stages >> (4 * (oneBased - 1))) & 0xF);
    return AlertStage{(nibble & 0x8) != 0, (nibble & 0x4) != 0, UInt8(nibble & 0x3)};
}

std::optional<AlertTemplate> decodeAlert(const QByteArray& data)
{
    BigEndianReader in(data);
    AlertTemplate a;
    a.bounds = in.rect();
    a.itemsID = in.s16();
    a.stages = in.u16();
    if (!in.ok())
        return std::nullopt;
    a.positioning = positioningWord(in);
    return a;
}

std::optional<QList<DialogItemTemplate>> decodeDialogItems(const QByteArray& data)
{
    BigEndianReader in(data);
    const qint64 count = qint64(in.s16()) + 1; // stored as count - 1
    if (!in.ok())
        return std::nullopt;
    QList<DialogItemTemplate> out;
    for (qint64 i = 0; i < count && in.has(14); ++i) {
        DialogItemTemplate item;
        in.skip(4); // the item's handle or procedure, filled in at run time
        item.bounds = in.rect();
        item.type = in.u8();
        item.data = in.pascal();
        if (!in.ok())
            break;
        in.alignWord();
        const UInt8 kind = item.kind();
        if ((kind == kDialogItemIcon || kind == kDialogItemPicture || kind == kDialogItemResControl)
            && item.data.size() >= 2) {
            item.resourceID = SInt16(beAt(item.data, 0, 2));
        }
        out.append(item);
    }
    return out;
}

std::optional<ControlTemplate> decodeControl(const QByteArray& data)
{
    BigEndianReader in(data);
    ControlTemplate c;
    c.bounds = in.rect();
    c.value = in.s16();
    c.visible = in.u16() != 0;
    c.max = in.s16();
    c.min = in.s16();
    c.procID = in.s16();
    c.refCon = in.s32();
    c.title = in.pascal();
    return okOr(in, c);
}

QImage oneBitImage(const QByteArray& bits, int width, int height, const QByteArray& mask)
{
    if (width <= 0 || height <= 0 || width > 4096 || height > 4096)
        return {};
    const qsizetype rowBytes = (width + 7) / 8;
    const qsizetype needed = rowBytes * height;
    if (bits.size() < needed || (!mask.isEmpty() && mask.size() < needed))
        return {};
    QImage image(width, height, QImage::Format_ARGB32);
    for (int y = 0; y < height; ++y) {
        auto* line = reinterpret_cast<QRgb*>(image.scanLine(y));
        for (int x = 0; x < width; ++x) {
            const qsizetype at = y * rowBytes + x / 8;
            const int bit = 7 - (x % 8);
            const bool black = (UInt8(bits[at]) >> bit) & 1;
            const bool opaque = mask.isEmpty() || ((UInt8(mask[at]) >> bit) & 1);
            line[x] = !opaque ? qRgba(0, 0, 0, 0) : black ? qRgb(0, 0, 0) : qRgb(255, 255, 255);
        }
    }
    return image;
}

} // namespace Velmar::Classic
