// Text through the classic interface: the record's text fields handed to the library before
// drawing or measuring, and the classic transfer modes the library draws otherwise (srcBic
// clears the glyphs' pixels to the background colour).
#include "classic/ClassicPrivate.h"

#include <cstring>

using namespace VelmarClassic;

namespace {

template <typename Call> void drawText(Call&& call)
{
    PortLink* link = currentLink();
    if (!link)
        return;
    pullPort(*link);
    if (link->record->txMode == srcBic) {
        // The glyphs in the background colour, as the classic mode left them.
        Velmar::RGBColor fore, back;
        Velmar::GetForeColor(&fore);
        Velmar::GetBackColor(&back);
        Velmar::RGBForeColor(&back);
        call();
        Velmar::RGBForeColor(&fore);
    } else {
        call();
    }
    pushPen(*link);
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
    drawText([&] { Velmar::DrawChar(ch); });
}

void DrawString(ConstStr255Param s)
{
    if (VELMAR_ASSERT(s, "s != NULL"))
        drawText([&] { Velmar::DrawString(s); });
}

void DrawText(const void* textBuf, short firstByte, short byteCount)
{
    if (byteCount > 0 && !VELMAR_ASSERT(textBuf, "textBuf != NULL"))
        return;
    drawText([&] { Velmar::DrawText(textBuf, firstByte, byteCount); });
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
