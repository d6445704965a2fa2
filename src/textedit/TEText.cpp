// The record's text: the host's bytes with '\r' between lines against the editor's text,
// offsets, the selection, and the text calls.
#include <Velmar/HostCore.h>
#include <Velmar/TextEdit.h>
#include <Velmar/TextUtils.h>

#include "textedit/TERecordPrivate.h"

#include <QTextBlock>
#include <QTextDocument>

namespace Velmar {

using namespace Private;

namespace Private {

QString hostToEditorText(const QString& text)
{
    QString out = text;
    out.replace(QLatin1Char('\r'), QLatin1Char('\n'));
    return out;
}

QString editorToHostText(const QString& text)
{
    QString out = text;
    for (QChar& c : out)
        if (c == QLatin1Char('\n') || c == QChar::ParagraphSeparator || c == QChar::LineSeparator)
            c = QLatin1Char('\r');
    return out;
}

QString editorTextFromBytes(const void* bytes, SInt32 length)
{
    if (!bytes || length <= 0)
        return QString();
    return hostToEditorText(MakeQString(static_cast<const char*>(bytes), length));
}

QString recordText(const TEPtr* te)
{
    const TEPtrPrivate* d = teData(te);
    if (d->mask)
        return d->maskedText;
    CommonTextEditAPI* editor = te->Qt();
    return editor ? editor->document()->toPlainText() : d->orphanText;
}

namespace {

// Bytes the first `units` UTF-16 units take in the host's encoding.
SInt32 encodedLength(const QString& text, int units)
{
    if (units <= 0)
        return 0;
    return SInt32(MakeLocal8Bit(text.left(units)).size() - 1);
}

} // namespace

int editorPosition(const TEPtr* te, SInt32 offset)
{
    const QString text = recordText(te);
    if (offset <= 0)
        return 0;
    if (!te->UseLocal8Bit())
        return int(std::min<qsizetype>(offset, text.size()));
    // The first position whose encoded prefix reaches the offset.
    int low = 0, high = int(text.size());
    while (low < high) {
        const int mid = (low + high) / 2;
        if (encodedLength(text, mid) < offset)
            low = mid + 1;
        else
            high = mid;
    }
    return low;
}

SInt32 hostOffset(const TEPtr* te, int position)
{
    if (!te->UseLocal8Bit())
        return position;
    return encodedLength(recordText(te), position);
}

SInt32 hostOffset(const TEPtr* te, const QString& text, int position)
{
    return te->UseLocal8Bit() ? encodedLength(text, position) : position;
}

void insertEditorText(TEPtr* te, const QString& text)
{
    CommonTextEditAPI* editor = te->Qt();
    if (!editor)
        return;
    QString inserted = text;
    if (!teData(te)->allowMultipleBlocks)
        inserted.replace(QLatin1Char('\n'), QLatin1Char(' '));
    QTextCursor cursor = editor->textCursor();
    if (teData(te)->mask)
        maskedInsert(te, cursor, inserted);
    else
        cursor.insertText(inserted);
    editor->setTextCursor(cursor);
}

} // namespace Private

// ---- Text ----------------------------------------------------------------------------------

void TEPtr::setText(const void* text, SInt32 length)
{
    const QString converted = editorTextFromBytes(text, length);
    if (!m_editor) {
        m_d->orphanText = converted;
        return;
    }
    QTextCursor all(m_editor->document());
    all.select(QTextCursor::Document);
    if (m_d->mask) {
        m_editor->setTextCursor(all);
        insertEditorText(this, converted);
    } else {
        m_editor->document()->setPlainText(converted);
    }
    // The caret ends up after the last character.
    QTextCursor end(m_editor->document());
    end.movePosition(QTextCursor::End);
    m_editor->setTextCursor(end);
}

void TEPtr::setTextUTF16(const unsigned short* text)
{
    const QString converted =
        text ? QString::fromUtf16(reinterpret_cast<const char16_t*>(text)) : QString();
    const QByteArray bytes = MakeLocal8Bit(editorToHostText(converted));
    setText(bytes.constData(), SInt32(bytes.size() - 1));
}

Handle TEPtr::hText() const
{
    const QByteArray bytes = MakeLocal8Bit(editorToHostText(recordText(this)));
    const Size size = Size(bytes.size() - 1);
    // The same handle whenever the text fits, as a host keeping it expects.
    if (m_d->hText && TxGetHandleSize(m_d->hText) != size) {
        TxDisposeHandle(m_d->hText);
        m_d->hText = nullptr;
    }
    if (!m_d->hText)
        m_d->hText = TxPtrToHand(bytes.constData(), size);
    else if (size > 0)
        std::memcpy(*m_d->hText, bytes.constData(), size_t(size));
    return m_d->hText;
}

QString TEPtr::hTextUnicode() const
{
    return editorToHostText(recordText(this));
}

SInt32 TEPtr::getTextUTF16(unsigned short* buffer, int units) const
{
    if (!buffer || units <= 0)
        return 0;
    const QString text = hTextUnicode();
    const int n = int(std::min<qsizetype>(text.size(), units - 1));
    std::memcpy(buffer, text.utf16(), size_t(n) * sizeof(unsigned short));
    buffer[n] = 0;
    return n;
}

SInt32 TEPtr::getUTF16BufSizeNeeded() const
{
    return SInt32(recordText(this).size() + 1);
}

SInt32 TEPtr::teLengthEx() const
{
    const QString text = recordText(this);
    return hostOffset(this, text, int(text.size()));
}

SInt16 TEPtr::teLength() const
{
    return SInt16(std::min<SInt32>(teLengthEx(), INT16_MAX));
}

SInt32 TEPtr::teCharacterCount() const
{
    return SInt32(recordText(this).size());
}

// ---- Selection -----------------------------------------------------------------------------

SInt32 TEPtr::cursorPos() const
{
    return m_editor ? hostOffset(this, m_editor->textCursor().position()) : 0;
}

SInt16 TEPtr::selStart() const
{
    return m_editor ? SInt16(std::min<SInt32>(
               hostOffset(this, m_editor->textCursor().selectionStart()), INT16_MAX))
                    : SInt16(0);
}

SInt16 TEPtr::selEnd() const
{
    return m_editor ? SInt16(
               std::min<SInt32>(hostOffset(this, m_editor->textCursor().selectionEnd()), INT16_MAX))
                    : SInt16(0);
}

void TEPtr::setSelStart(SInt16 start)
{
    TESetSelect(start, selEnd(), this);
}

void TEPtr::setSelEnd(SInt16 end)
{
    TESetSelect(selStart(), end, this);
}

void TEPtr::clearSelection()
{
    if (!m_editor)
        return;
    QTextCursor cursor = m_editor->textCursor();
    cursor.clearSelection();
    m_editor->setTextCursor(cursor);
}

// ---- The text calls ------------------------------------------------------------------------

void TESetText(const void* text, SInt32 length, TEPtr* te)
{
    if (VELMAR_CHECK_TE(te))
        te->setText(text, length);
}

Handle TEGetText(TEPtr* te)
{
    return VELMAR_CHECK_TE(te) ? te->hText() : nullptr;
}

void TEInsert(const void* text, SInt32 length, TEPtr* te, Boolean)
{
    CommonTextEditAPI* editor = VELMAR_CHECK_TE(te) ? editorOf(te, "TEInsert") : nullptr;
    if (!editor)
        return;
    // The text goes in just before the selection, which keeps its characters: hosts that
    // want it replaced call TEDelete first.
    const QTextCursor selection = editor->textCursor();
    const int anchor = selection.anchor();
    const int position = selection.position();
    const int before = editor->document()->characterCount();
    QTextCursor at(editor->document());
    at.setPosition(std::min(anchor, position));
    editor->setTextCursor(at);
    insertEditorText(te, editorTextFromBytes(text, length));
    const int added = editor->document()->characterCount() - before;
    QTextCursor restored(editor->document());
    restored.setPosition(anchor + added);
    restored.setPosition(position + added, QTextCursor::KeepAnchor);
    editor->setTextCursor(restored);
}

void TEDelete(TEPtr* te)
{
    if (!VELMAR_CHECK_TE(te))
        return;
    if (CommonTextEditAPI* editor = editorOf(te, "TEDelete")) {
        QTextCursor cursor = editor->textCursor();
        cursor.removeSelectedText();
        editor->setTextCursor(cursor);
    }
}

void TESetSelect(SInt32 start, SInt32 end, TEPtr* te)
{
    if (!VELMAR_CHECK_TE(te))
        return;
    CommonTextEditAPI* editor = editorOf(te, "TESetSelect");
    if (!editor)
        return;
    // Offsets beyond the text or below zero are pinned, as TextEdit pinned them.
    const int length = int(editor->document()->characterCount() - 1);
    const int from = std::clamp(editorPosition(te, start), 0, length);
    const int to = std::clamp(editorPosition(te, end), 0, length);
    QTextCursor cursor = editor->textCursor();
    cursor.setPosition(from);
    cursor.setPosition(to, QTextCursor::KeepAnchor);
    editor->setTextCursor(cursor);
}

} // namespace Velmar
