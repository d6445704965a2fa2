// Styles: runs of fonts, faces, sizes and colours in styled records, style scraps in the
// Toolbox layout, the record's font and alignment.
#include <Velmar/HostCore.h>
#include <Velmar/QtGrafPort.h>
#include <Velmar/TextEdit.h>
#include <Velmar/TextUtils.h>

#include "foundation/Conversions.h"
#include "quickdraw/FontTable.h"
#include "textedit/TERecordPrivate.h"

#include <QTextBlock>
#include <QTextCharFormat>
#include <QTextDocument>
#include <QTextFragment>

#include <vector>

namespace Velmar {

using namespace Private;

namespace {

constexpr Style kFormatFaces = Style(bold | italic | underline);

qreal pointsOf(const QFont& font)
{
    return font.pointSizeF() > 0 ? font.pointSizeF() : 9.0;
}

// One run of a single character format inside a selection.
struct FormatRun {
    int from, to;
    QFont font;
};

// The runs of [start, end), each with its font resolved against the editor's.
std::vector<FormatRun> runsOf(CommonTextEditAPI* editor, int start, int end)
{
    std::vector<FormatRun> runs;
    const QFont base = editor->widget()->font();
    for (QTextBlock block = editor->document()->findBlock(start);
         block.isValid() && block.position() < end; block = block.next()) {
        for (auto it = block.begin(); !it.atEnd(); ++it) {
            const QTextFragment fragment = it.fragment();
            const int from = std::max(start, fragment.position());
            const int to = std::min(end, fragment.position() + fragment.length());
            if (from < to)
                runs.push_back({from, to, fragment.charFormat().font().resolve(base)});
        }
    }
    return runs;
}

// A style as a character format; `mode` says which parts are set.
QTextCharFormat formatOf(SInt16 mode, const TextStyle& style, const QFont& current)
{
    QTextCharFormat format;
    if (mode & doFont) {
        const FontRow* row = findFontRow(style.tsFont);
        format.setFontFamilies({row ? row->family : current.family()});
    }
    if (mode & doFace) {
        format.setFontWeight(style.tsFace & bold ? QFont::Bold : QFont::Normal);
        format.setFontItalic(style.tsFace & italic);
        format.setFontUnderline(style.tsFace & underline);
    }
    if (mode & doSize)
        format.setFontPointSize(std::max<qreal>(1, style.tsSize) * 0.75);
    if (mode & addSize) // to the size of the text it goes on (`current`)
        format.setFontPointSize(std::max<qreal>(0.75, pointsOf(current) + style.tsSize * 0.75));
    if (mode & doColor)
        format.setForeground(toQColor(style.tsColor));
    return format;
}

TextStyle styleOf(const QTextCharFormat& format, const QFont& fallback)
{
    const QFont font = format.font().resolve(fallback);
    TextStyle style{};
    style.tsFont = GetTxFontFromQFont(font);
    style.tsFace = Style(GetTxFaceFromQFont(font));
    style.tsSize = GetTxSizeFromQFont(font);
    const QBrush brush = format.foreground();
    style.tsColor = toRGBColor(brush.style() == Qt::NoBrush ? QColor(Qt::black) : brush.color());
    return style;
}

bool sameStyle(const ScrpSTElement& run, const TextStyle& style)
{
    return run.scrpFont == style.tsFont && run.scrpFace == style.tsFace
        && run.scrpSize == style.tsSize && run.scrpColor.red == style.tsColor.red
        && run.scrpColor.green == style.tsColor.green && run.scrpColor.blue == style.tsColor.blue;
}

// The style of the character at `position` (the one after it).
QTextCharFormat formatAt(CommonTextEditAPI* editor, int position)
{
    QTextCursor cursor(editor->document());
    cursor.setPosition(std::min(position + 1, int(editor->document()->characterCount() - 1)));
    return cursor.charFormat();
}

} // namespace

void TESetStyle(SInt16 mode, const TextStyle* style, Boolean, TEPtr* te)
{
    if (!VELMAR_CHECK_TE(te) || !style)
        return;
    CommonTextEditAPI* editor = editorOf(te, "TESetStyle");
    // Plain records have one style: TextEdit leaves them alone.
    if (!editor || !editor->isStyled())
        return;
    QTextCursor cursor = editor->textCursor();
    const bool toggle = (mode & doToggle) && (mode & doFace);
    if (!cursor.hasSelection()) {
        // The style of what is typed next.
        const QFont current = cursor.charFormat().font().resolve(editor->widget()->font());
        TextStyle next = *style;
        if (toggle)
            next.tsFace = Style(GetTxFaceFromQFont(current) ^ (style->tsFace & kFormatFaces));
        cursor.mergeCharFormat(formatOf(mode, next, current));
        editor->setTextCursor(cursor);
        return;
    }
    // Sizes are added to, and faces toggled on, each run's own style; a face bit the whole
    // selection has is taken off it, any other one is set on all of it.
    const std::vector<FormatRun> runs =
        runsOf(editor, cursor.selectionStart(), cursor.selectionEnd());
    Style everywhere = kFormatFaces;
    for (const FormatRun& run : runs)
        everywhere = Style(everywhere & GetTxFaceFromQFont(run.font));
    const Style taken = Style(style->tsFace & everywhere);
    const Style given = Style(style->tsFace & ~everywhere);
    QTextCursor part(editor->document());
    part.beginEditBlock();
    for (const FormatRun& run : runs) {
        TextStyle own = *style;
        if (toggle)
            own.tsFace = Style((GetTxFaceFromQFont(run.font) & ~taken) | given);
        part.setPosition(run.from);
        part.setPosition(run.to, QTextCursor::KeepAnchor);
        part.mergeCharFormat(formatOf(mode, own, run.font));
    }
    part.endEditBlock();
    editor->setTextCursor(cursor);
}

void TEGetStyle(SInt16 offset, TextStyle* style, SInt16* lineHeight, SInt16* fontAscent, TEPtr* te)
{
    if (!VELMAR_CHECK_TE(te))
        return;
    CommonTextEditAPI* editor = editorOf(te, "TEGetStyle");
    if (style) {
        if (editor && editor->isStyled()) {
            *style =
                styleOf(formatAt(editor, editorPosition(te, offset)), editor->widget()->font());
        } else {
            *style = TextStyle{};
            style->tsFont = te->txFont();
            style->tsFace = te->txFace();
            style->tsSize = te->txSize();
            const GrafPtr port = te->inPort();
            style->tsColor = port && IsValidPort(port) ? toRGBColor(port->foreColor()) : RGBColor();
        }
    }
    if (lineHeight)
        *lineHeight = te->lineHeight();
    if (fontAscent)
        *fontAscent = te->fontAscent();
}

void TEStyleInsert(const void* text, SInt32 length, StScrpHandle styles, TEPtr* te)
{
    if (!VELMAR_CHECK_TE(te))
        return;
    CommonTextEditAPI* editor = editorOf(te, "TEStyleInsert");
    if (!editor || !text || length <= 0)
        return;
    const StScrpRec* scrap = styles && *styles ? *styles : nullptr;
    if (!scrap || scrap->scrpNStyles <= 0 || !editor->isStyled()) {
        insertEditorText(te, editorTextFromBytes(text, length));
        return;
    }
    // Each run is converted on its own, so that its byte offsets need no mapping.
    QTextCursor cursor = editor->textCursor();
    cursor.beginEditBlock();
    const auto* bytes = static_cast<const char*>(text);
    const int runs = scrap->scrpNStyles;
    for (int i = 0; i < runs; ++i) {
        const ScrpSTElement& run = scrap->scrpStyleTab[i];
        const SInt32 from = std::clamp<SInt32>(run.scrpStartChar, 0, length);
        const SInt32 to = i + 1 < runs
            ? std::clamp<SInt32>(scrap->scrpStyleTab[i + 1].scrpStartChar, from, length)
            : length;
        if (to <= from)
            continue;
        TextStyle style{run.scrpFont, run.scrpFace, 0, run.scrpSize, run.scrpColor};
        cursor.insertText(editorTextFromBytes(bytes + from, to - from),
            formatOf(doAll, style, editor->widget()->font()));
    }
    cursor.endEditBlock();
    editor->setTextCursor(cursor);
}

StScrpHandle TEGetStyleScrapHandle(TEPtr* te)
{
    if (!VELMAR_CHECK_TE(te))
        return nullptr;
    CommonTextEditAPI* editor = editorOf(te, "TEGetStyleScrapHandle");
    if (!editor || !editor->isStyled())
        return nullptr;
    const QTextCursor selection = editor->textCursor();
    const int from = selection.selectionStart(), to = selection.selectionEnd();
    std::vector<ScrpSTElement> runs;
    SInt32 byte = 0;
    // Fragments are the document's runs of one format; those crossing the ends are cut.
    for (QTextBlock block = editor->document()->findBlock(from);
         block.isValid() && block.position() <= to; block = block.next()) {
        for (auto it = block.begin(); !it.atEnd(); ++it) {
            const QTextFragment fragment = it.fragment();
            const int start = std::max(from, fragment.position());
            const int end = std::min(to, fragment.position() + fragment.length());
            if (end <= start)
                continue;
            const TextStyle style = styleOf(fragment.charFormat(), editor->widget()->font());
            const QFontMetrics metrics(
                fragment.charFormat().font().resolve(editor->widget()->font()));
            if (runs.empty() || !sameStyle(runs.back(), style))
                runs.push_back({byte, SInt16(metrics.lineSpacing()), SInt16(metrics.ascent()),
                    style.tsFont, style.tsFace, 0, style.tsSize, style.tsColor});
            const QString text =
                editorToHostText(fragment.text().mid(start - fragment.position(), end - start));
            byte += SInt32(MakeLocal8Bit(text).size() - 1);
        }
        if (block.position() + block.length() <= to)
            byte += 1; // the line break between blocks
    }
    const size_t count = runs.size();
    const Size size = Size(
        offsetof(StScrpRec, scrpStyleTab) + std::max<size_t>(count, 1) * sizeof(ScrpSTElement));
    Handle handle = TxPtrToHand(nullptr, size);
    if (!handle)
        return nullptr;
    auto* scrap = reinterpret_cast<StScrpRec*>(*handle);
    scrap->scrpNStyles = SInt16(count);
    if (count)
        std::memcpy(scrap->scrpStyleTab, runs.data(), count * sizeof(ScrpSTElement));
    return reinterpret_cast<StScrpHandle>(handle);
}

void TESetTextFontAndSize(SInt16 font, SInt16 size, TEPtr* te)
{
    if (!VELMAR_CHECK_TE(te))
        return;
    te->setTxFont(font, false);
    te->setTxSize(size, false);
}

void TESetAlignment(SInt16 just, TEPtr* te)
{
    if (VELMAR_CHECK_TE(te))
        te->setJust(just);
}

void TESetPaletteColor(int role, const QColor* color, TEPtr* te)
{
    if (!VELMAR_CHECK_TE(te) || role < 0 || role >= QPalette::NColorRoles)
        return;
    if (color)
        teData(te)->paletteColours.insert(role, *color);
    else
        teData(te)->paletteColours.remove(role);
    if (CommonTextEditAPI* editor = te->Qt())
        editor->fullRepaint();
}

} // namespace Velmar
