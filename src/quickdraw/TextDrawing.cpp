// Drawing text at the pen: the baseline lies on the pen, the touched rectangle is reported
// to the port's window, and the pen moves right by the text's width.
#include <Velmar/QDText.h>
#include <Velmar/TextUtils.h>

#include "foundation/Conversions.h"
#include "quickdraw/CurrentPort.h"
#include "quickdraw/FontCache.h"
#include "quickdraw/ShapeLog.h"
#include "quickdraw/TextSource.h"

namespace Velmar {

using namespace Private;

namespace {

struct AntiAliasing {
    bool enabled = true;
    SInt16 minSize = 0;
};
AntiAliasing gAntiAliasing;

bool antiAliased(const FontEntry& font)
{
    return gAntiAliasing.enabled && font.pixelSize >= gAntiAliasing.minSize;
}

// StdText's numer / denom as scale factors; equal or zero values leave the text as it is.
struct TextScale {
    qreal h = 1.0;
    qreal v = 1.0;
    bool identity() const { return h == 1.0 && v == 1.0; }
};

TextScale scaleOf(Point numer, Point denom)
{
    TextScale s;
    if (numer.h > 0 && denom.h > 0)
        s.h = qreal(numer.h) / denom.h;
    if (numer.v > 0 && denom.v > 0)
        s.v = qreal(numer.v) / denom.v;
    return s;
}

struct TextRun {
    QString text;
    bool transparent;
    TextScale scale;
    qreal extraPerSpace = 0; // DrawJustified's slop
};

// Draws with everything the plain path leaves alone: the text mode's composition, a
// background, a pen that PenSize(0, 0) made invisible, scaling, spacing and no
// anti-aliasing. The painter gets back its own state at the end.
void drawWithOverrides(QtGrafPort* port, QPainter* painter, const FontEntry& entry,
    const TextRun& run, const QPoint& at)
{
    const PortTextState& state = portData(port)->text;
    painter->save();
    painter->setCompositionMode(state.composition);
    if (painter->pen().style() == Qt::NoPen)
        painter->setPen(QPen(port->foreColor()));
    if (!antiAliased(entry) || run.extraPerSpace != 0) {
        QFont font = entry.font;
        if (!antiAliased(entry))
            font.setStyleStrategy(QFont::StyleStrategy(font.styleStrategy() | QFont::NoAntialias));
        font.setWordSpacing(run.extraPerSpace);
        painter->setFont(font);
    }
    if (!run.transparent) {
        painter->setBackgroundMode(Qt::OpaqueMode);
        painter->setBackground(QBrush(port->backColor));
    }
    painter->translate(at);
    painter->scale(run.scale.h, run.scale.v);
    painter->drawText(QPoint(0, 0), run.text);
    painter->restore();
}

void drawAtPen(const TextRun& run)
{
    MakeQPainter painter("StdTextInternal");
    if (!painter)
        return;
    if (run.text.isEmpty()) {
        shapeWarning("warning: Velmar::StdTextInternal: bytes_count is less or zero");
        return;
    }
    QtGrafPort* port = painter.port();
    FontEntry& entry = portFontEntry(port);
    const qreal spaces = run.extraPerSpace ? qreal(run.text.count(QLatin1Char(' '))) : 0.0;
    const qint64 width =
        qRound64((entry.width(run.text) + run.extraPerSpace * spaces) * run.scale.h);
    const qint64 x = port->penX;
    const qint64 y = port->penY;
    // A hidden pen draws nothing, but the pen still moves.
    if (port->penVisibility >= 0) {
        const QPoint at(clampFar(x), clampFar(y));
        const bool plain = run.transparent && run.scale.identity() && run.extraPerSpace == 0
            && portData(port)->text.composition == painter->compositionMode()
            && painter->pen().style() != Qt::NoPen && antiAliased(entry);
        if (plain)
            painter->drawText(at, run.text);
        else
            drawWithOverrides(port, painter, entry, run, at);
        const qint64 ascent = qRound64(entry.ascent * run.scale.v);
        const qint64 height = qRound64(entry.height * run.scale.v);
        // Slanted glyphs reach past their advance.
        const qint64 overhang = entry.italic ? entry.ascent / 2 : 0;
        painter |= farRect(x - 1, y - ascent - 1, x + width + overhang, y - ascent + height);
    }
    port->penX = clampFar(x + width);
}

bool opaqueTextMode()
{
    const QtGrafPort* port = currentGrafPort();
    return port && QtGrafPortPrivate::get(port)->text.opaque;
}

// The byte forms draw with a background only after an explicit TextMode(srcCopy).
void drawBytes(const QString& text, TextScale scale = {}, qreal extraPerSpace = 0)
{
    drawAtPen({text, !opaqueTextMode(), scale, extraPerSpace});
}

} // namespace

void DrawText(const void* text, SInt16 first, SInt16 count)
{
    if (first < 0) {
        shapeWarning("warning: Velmar::DrawText: byteCount is less or zero");
        return;
    }
    drawBytes(bytesText(text, first, count));
}

void DrawString(const unsigned char* s)
{
    drawBytes(PascalString2QString(s));
}

void DrawChar(SInt16 ch)
{
    drawBytes(charText(ch));
}

void StdText(SInt16 count, const void* text, Point numer, Point denom)
{
    drawBytes(bytesText(text, 0, count), scaleOf(numer, denom));
}

void DrawTextUTF16(bool transparent, const QString& text, SInt16 first, SInt16 count)
{
    if (validRange(first, count, "Velmar::DrawTextUTF16"))
        drawAtPen({text.mid(first, count), transparent, {}});
}

void DrawTextBufUTF16(bool transparent, const unsigned short* text, SInt16 first, SInt16 count)
{
    if (validRange(first, count, "Velmar::DrawTextBufUTF16"))
        drawAtPen({text ? boundedUtf16(text, first, count) : QString(), transparent, {}});
}

void DrawJustified(const void* textPtr, SInt32 textLength, Fixed slop,
    JustStyleCode /*styleRunPosition*/, Point numer, Point denom)
{
    const SInt16 count = SInt16(std::clamp<SInt32>(textLength, 0, INT16_MAX));
    const QString text = bytesText(textPtr, 0, count);
    const qsizetype spaces = text.count(QLatin1Char(' '));
    drawBytes(text, scaleOf(numer, denom), spaces ? slop / 65536.0 / qreal(spaces) : 0.0);
}

OSStatus SetAntiAliasedTextEnabled(Boolean enable, SInt16 minSize)
{
    gAntiAliasing.enabled = enable != 0;
    gAntiAliasing.minSize = minSize;
    return 0;
}

Boolean IsAntiAliasedTextEnabled(SInt16* minSize)
{
    if (minSize)
        *minSize = gAntiAliasing.minSize;
    return gAntiAliasing.enabled ? 1 : 0;
}

} // namespace Velmar
