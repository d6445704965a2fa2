// Text through the classic interface: the record's text fields handed to the library before
// drawing or measuring, and the classic transfer modes the library draws otherwise: in
// srcXor, srcBic and the notSrc modes the glyphs are drawn black on white into a world over
// the text's box, and that box is copied onto the port through the mode, as the classic
// calls transferred the characters' bits.
#include "classic/ClassicPrivate.h"

#include <QColor>

#include <algorithm>
#include <cstring>

using namespace VelmarClassic;

namespace {

bool copiedThroughMode(short mode)
{
    return mode == srcXor || mode == srcBic || (mode >= notSrcCopy && mode <= notSrcBic);
}

short clampShort(int value)
{
    return short(std::clamp(value, -32767, 32767));
}

// Every pixel of the world pure black or white: the classic modes work on bits.
void toBits(Velmar::GrafPtr world, const Rect& box)
{
    Velmar::PixMapHandle pixmap = Velmar::GetGWorldPixMap(world);
    auto* base =
        reinterpret_cast<Velmar::UInt32*>(pixmap ? Velmar::GetPixBaseAddr(pixmap) : nullptr);
    if (!base)
        return;
    const qsizetype stride = Velmar::GetPixRowBytes(pixmap) / 4;
    for (int y = 0; y < box.bottom - box.top; ++y)
        for (int x = 0; x < box.right - box.left; ++x) {
            Velmar::UInt32& word = base[y * stride + x];
            word = qGray(QRgb(word)) < 128 ? 0xFF000000u : 0xFFFFFFFFu;
        }
}

template <typename Draw> void drawThroughMode(PortLink& link, short mode, short width, Draw&& draw)
{
    Velmar::GrafPtr port = link.port();
    const GrafPort* r = link.record;
    Point pen{};
    Velmar::GetPen(&pen);
    Velmar::FontInfo info;
    Velmar::GetFontInfo(&info);
    // The not- modes change the whole character box; the others only where glyphs are, so
    // their box leaves room for overhanging (italic, outlined) glyphs.
    const int pad = mode >= notSrcCopy ? 0 : int(info.ascent()) / 3 + 2;
    const Rect text{clampShort(pen.v - int(info.ascent())), clampShort(pen.h - pad),
        clampShort(pen.v + int(info.descent())), clampShort(pen.h + width + pad)};
    // Only what the port has pixels for.
    Rect bounds{}, box{};
    Velmar::GetPortBounds(port, &bounds);
    Velmar::GrafPtr world = nullptr;
    if (Velmar::SectRect(&text, &bounds, &box)
        && Velmar::NewGWorld(&world, 32, &box, nullptr, nullptr, 0) == Velmar::noErr && world) {
        Velmar::SetPort(world);
        Velmar::TextFont(r->txFont);
        Velmar::TextFace(r->txFace);
        Velmar::TextSize(r->txSize);
        Velmar::TextMode(srcOr);
        Velmar::MoveTo(pen.h, pen.v);
        draw();
        Velmar::SetPort(port);
        toBits(world, box);
        Velmar::CopyBits(Velmar::GetPortBitMapForCopyBits(world),
            Velmar::GetPortBitMapForCopyBits(port), &box, &box, mode, nullptr);
        Velmar::DisposeGWorld(world);
    }
    Velmar::MoveTo(clampShort(pen.h + width), pen.v);
}

template <typename Draw, typename Width> void drawText(Draw&& draw, Width&& width)
{
    PortLink* link = currentLink();
    if (!link)
        return;
    pullPort(*link);
    const short mode = link->record->txMode;
    if (copiedThroughMode(mode))
        drawThroughMode(*link, mode, width(), draw);
    else
        draw();
    pushPen(*link);
    storeProgramBits(*link);
}

template <typename Call> short measure(Call&& call)
{
    PortLink* link = currentLink();
    if (!link)
        return 0;
    pullPort(*link);
    return call();
}

} // namespace

void TextFont(short font)
{
    if (PortLink* link = currentLink()) {
        link->record->txFont = font;
        pullPort(*link);
    }
}

void TextFace(StyleParameter face)
{
    if (PortLink* link = currentLink()) {
        link->record->txFace = Style(face);
        pullPort(*link);
    }
}

void TextMode(short mode)
{
    if (PortLink* link = currentLink()) {
        link->record->txMode = mode;
        pullPort(*link);
    }
}

void TextSize(short size)
{
    if (PortLink* link = currentLink()) {
        link->record->txSize = size;
        pullPort(*link);
    }
}

void DrawChar(CharParameter ch)
{
    drawText([&] { Velmar::DrawChar(ch); }, [&] { return Velmar::CharWidth(ch); });
}

void DrawString(ConstStr255Param s)
{
    if (VELMAR_ASSERT(s, "s != NULL"))
        drawText([&] { Velmar::DrawString(s); }, [&] { return Velmar::StringWidth(s); });
}

void DrawText(const void* textBuf, short firstByte, short byteCount)
{
    if (byteCount > 0 && !VELMAR_ASSERT(textBuf, "textBuf != NULL"))
        return;
    drawText([&] { Velmar::DrawText(textBuf, firstByte, byteCount); },
        [&] { return Velmar::TextWidth(textBuf, firstByte, byteCount); });
}

short CharWidth(CharParameter ch)
{
    return measure([&] { return Velmar::CharWidth(ch); });
}

short StringWidth(ConstStr255Param s)
{
    if (!VELMAR_ASSERT(s, "s != NULL"))
        return 0;
    return measure([&] { return Velmar::StringWidth(s); });
}

short TextWidth(const void* textBuf, short firstByte, short byteCount)
{
    if (byteCount > 0 && !VELMAR_ASSERT(textBuf, "textBuf != NULL"))
        return 0;
    return measure([&] { return Velmar::TextWidth(textBuf, firstByte, byteCount); });
}

void GetFontInfo(FontInfo* info)
{
    if (!VELMAR_ASSERT(info, "info != NULL"))
        return;
    std::memset(info, 0, sizeof *info);
    measure([&] {
        Velmar::FontInfo f;
        Velmar::GetFontInfo(&f);
        info->ascent = short(f.ascent());
        info->descent = short(f.descent());
        info->widMax = short(f.widMax());
        info->leading = short(f.leading());
        return short(0);
    });
}

void GetFNum(ConstStr255Param name, short* familyID)
{
    ensureStarted();
    if (VELMAR_ASSERT(name && familyID, "name && familyID"))
        Velmar::GetFNum(name, familyID);
}

void GetFontName(short familyID, Str255 name)
{
    ensureStarted();
    if (VELMAR_ASSERT(name, "name != NULL"))
        Velmar::GetFontName(familyID, name);
}

Boolean RealFont(short, short size)
{
    return size > 0;
}

void SetFScaleDisable(Boolean)
{}
