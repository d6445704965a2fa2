// Measuring text in the current port's font.
#include <Velmar/QDText.h>
#include <Velmar/TextUtils.h>

#include "foundation/Conversions.h"
#include "quickdraw/CurrentPort.h"
#include "quickdraw/FontCache.h"
#include "quickdraw/ShapeLog.h"
#include "quickdraw/TextSource.h"

#include <QTextLayout>

#include <algorithm>
#include <vector>

namespace Velmar {

using namespace Private;

namespace {

SInt16 toWidth(int w)
{
    return SInt16(std::clamp(w, int(INT16_MIN), int(INT16_MAX)));
}

// The width of `text` in the current port's font; 0 (after the no-port line) without one.
SInt16 portWidth(const QString& text)
{
    CurrentPort port("TextWidthInternal");
    if (!port || text.isEmpty())
        return 0;
    return toWidth(portFontEntry(port).width(text));
}

// The number of bytes each character of `text` takes in the current Macintosh encoding.
std::vector<int> encodedLengths(const QString& text)
{
    std::vector<int> lengths;
    lengths.reserve(size_t(text.size()));
    for (qsizetype i = 0; i < text.size();) {
        const qsizetype units = text.at(i).isHighSurrogate() && i + 1 < text.size() ? 2 : 1;
        const QByteArray bytes = MakeLocal8Bit(text.mid(i, units));
        lengths.push_back(std::max(1, int(bytes.size()) - 1));
        i += units;
    }
    return lengths;
}

} // namespace

void MeasureText(SInt16 count, const void* text, void* locs)
{
    if (count <= 0 || !text || !locs)
        return;
    CurrentPort port("MeasureText");
    if (!port)
        return;
    auto* out = static_cast<SInt16*>(locs);
    const QString s = MakeQString(static_cast<const char*>(text), count);
    QTextLayout layout(s, portFontEntry(port).font, port->image());
    layout.beginLayout();
    const QTextLine line = layout.createLine();
    layout.endLayout();

    // Bytes inside a multi-byte character share the offset of the character's start; bytes
    // past the converted text (an embedded NUL ends it) share the offset of its end.
    const std::vector<int> lengths = encodedLengths(s);
    int byte = 0;
    qsizetype unit = 0;
    out[0] = 0;
    for (int length : lengths) {
        const SInt16 start = toWidth(qRound(line.cursorToX(int(unit))));
        for (int k = 1; k < length && byte + k <= count; ++k)
            out[byte + k] = start;
        byte += length;
        unit += s.at(unit).isHighSurrogate() && unit + 1 < s.size() ? 2 : 1;
        if (byte <= count)
            out[byte] = toWidth(qRound(line.cursorToX(int(unit))));
        if (byte >= count)
            break;
    }
    const SInt16 end = toWidth(qRound(line.cursorToX(int(s.size()))));
    for (int b = byte + 1; b <= count; ++b)
        out[b] = end;
}

SInt16 StringWidth(const unsigned char* s)
{
    if (!s)
        return 0;
    return portWidth(PascalString2QString(s));
}

SInt16 TextWidth(const void* text, SInt16 first, SInt16 count)
{
    if (!text || !validRange(first, count, "TextWidth") || count == 0)
        return 0;
    return portWidth(bytesText(text, first, count));
}

SInt16 CharWidth(SInt16 ch)
{
    return portWidth(charText(ch));
}

SInt16 TextWidthUTF16(const QString& text, int first, int count)
{
    if (!validRange(first, count, "TextWidthUTF16"))
        return 0;
    return portWidth(text.mid(first, count));
}

SInt16 TextWidthBufUTF16(const unsigned short* text, SInt16 first, SInt16 count)
{
    if (!text || !validRange(first, count, "TextWidthBufUTF16"))
        return 0;
    return portWidth(boundedUtf16(text, first, count));
}

SInt32 VisibleLength(const char* text, SInt32 length)
{
    if (!text || length < 1)
        return 0;
    SInt32 n = length;
    while (n > 1 && (text[n - 1] == ' ' || text[n - 1] == '\n' || text[n - 1] == '\t'))
        --n;
    return n;
}

} // namespace Velmar
