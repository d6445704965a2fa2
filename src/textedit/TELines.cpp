// Lines as the editor lays them out, and the geometry queries answered from that layout.
#include <Velmar/TextEdit.h>

#include "foundation/Conversions.h"
#include "textedit/TERecordPrivate.h"

#include <QAbstractTextDocumentLayout>
#include <QTextBlock>
#include <QTextDocument>
#include <QTextLayout>

namespace Velmar {

using namespace Private;

namespace {

// One laid-out line: where it starts in the text and its place in the document.
struct LineInfo {
    int start;
    QTextLine line;
    QTextBlock block;
};

// Every line on screen, in order; an empty document has none.
std::vector<LineInfo> layoutLines(CommonTextEditAPI* editor)
{
    std::vector<LineInfo> lines;
    QTextDocument* document = editor->document();
    if (document->isEmpty())
        return lines;
    QAbstractTextDocumentLayout* layout = document->documentLayout();
    for (QTextBlock block = document->begin(); block.isValid(); block = block.next()) {
        layout->blockBoundingRect(block); // lays the block out when it was not yet
        const QTextLayout* text = block.layout();
        if (!text || text->lineCount() == 0) {
            lines.push_back({block.position(), QTextLine(), block});
            continue;
        }
        for (int i = 0; i < text->lineCount(); ++i)
            lines.push_back(
                {block.position() + text->lineAt(i).textStart(), text->lineAt(i), block});
    }
    return lines;
}

SInt16 clamp16(qint64 v)
{
    return SInt16(std::clamp<qint64>(v, INT16_MIN, INT16_MAX));
}

} // namespace

SInt16 TEPtr::nLines() const
{
    return m_editor ? clamp16(qint64(layoutLines(m_editor).size())) : SInt16(0);
}

const SInt16* TEPtr::lineStarts() const
{
    std::vector<SInt16>& starts = m_d->lineStarts;
    starts.clear();
    // One copy of the text for every offset: counting bytes reads it once per line.
    const QString text = recordText(this);
    if (m_editor)
        for (const LineInfo& line : layoutLines(m_editor))
            starts.push_back(clamp16(hostOffset(this, text, line.start)));
    starts.push_back(clamp16(hostOffset(this, text, int(text.size()))));
    return starts.data();
}

void TEPtr::GetYInfo(SInt32* total, SInt32* visible, SInt32* position) const
{
    if (total)
        *total =
            m_editor ? SInt32(m_editor->document()->documentLayout()->documentSize().height()) : 0;
    if (visible)
        *visible = m_d->view.bottom - m_d->view.top;
    if (position)
        *position = m_editor ? m_editor->scrollPixels() : 0;
}

SInt16 TEGetOffset(Point point, TEPtr* te)
{
    if (!VELMAR_CHECK_TE(te))
        return 0;
    CommonTextEditAPI* editor = editorOf(te, "TEGetOffset");
    if (!editor)
        return 0;
    const int position = editor->cursorForPosition(localToViewport(te, point)).position();
    return clamp16(hostOffset(te, position));
}

Point TEGetPoint(SInt16 offset, TEPtr* te, bool lineBottom)
{
    if (!VELMAR_CHECK_TE(te))
        return Point{0, 0};
    CommonTextEditAPI* editor = editorOf(te, "TEGetPoint");
    if (!editor)
        return Point{0, 0};
    QTextCursor cursor(editor->document());
    const int length = int(editor->document()->characterCount() - 1);
    cursor.setPosition(std::clamp(editorPosition(te, offset), 0, length));
    const QRect caret = editor->cursorRect(cursor);
    int v = caret.bottom() + 1;
    if (!lineBottom) {
        // The baseline: the top of the caret's line and that line's ascent.
        const QTextBlock block = cursor.block();
        const QTextLine line = block.layout()
            ? block.layout()->lineForTextPosition(cursor.position() - block.position())
            : QTextLine();
        v = caret.top() + (line.isValid() ? qRound(line.ascent()) : te->fontAscent());
    }
    return viewportToLocal(te, QPoint(caret.left(), v));
}

SInt32 TEGetHeight(SInt32 endLine, SInt32 startLine, TEPtr* te)
{
    if (!VELMAR_CHECK_TE(te))
        return 0;
    CommonTextEditAPI* editor = editorOf(te, "TEGetHeight");
    if (!editor)
        return 0;
    const std::vector<LineInfo> lines = layoutLines(editor);
    if (lines.empty())
        return 0;
    const SInt32 last = SInt32(lines.size());
    const SInt32 from = std::clamp(std::min(startLine, endLine), SInt32(1), last);
    const SInt32 to = std::clamp(std::max(startLine, endLine), SInt32(1), last);
    qreal height = 0;
    for (SInt32 i = from; i <= to; ++i) {
        const QTextLine& line = lines[size_t(i - 1)].line;
        height += line.isValid() ? line.height() : te->lineHeight();
    }
    return SInt32(qRound(height));
}

} // namespace Velmar
