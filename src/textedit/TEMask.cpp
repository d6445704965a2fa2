// Password-style masking: the document shows the mask character, the record keeps the text.
#include <Velmar/TextEdit.h>

#include "textedit/TERecordPrivate.h"

#include <QTextDocument>
#include <QTimer>

namespace Velmar::Private {

namespace {

// Text inserted through the record; the document change that follows is its masked twin.
struct PendingInsert {
    TEPtr* te = nullptr;
    QString text;
};
PendingInsert gPending;

// Replaces whatever the document shows with the mask, keeping the selection.
void remask(TEPtr* te)
{
    TEPtrPrivate* d = teData(te);
    CommonTextEditAPI* editor = te->Qt();
    if (!editor || !d->mask)
        return;
    const QTextCursor selection = editor->textCursor();
    const int anchor = selection.anchor(), position = selection.position();
    d->maskingEdit = true;
    editor->document()->setPlainText(QString(d->maskedText.size(), QChar(d->mask)));
    d->maskingEdit = false;
    QTextCursor restored(editor->document());
    restored.setPosition(std::min(anchor, int(d->maskedText.size())));
    restored.setPosition(std::min(position, int(d->maskedText.size())), QTextCursor::KeepAnchor);
    editor->setTextCursor(restored);
}

void contentsChanged(TEPtr* te, int position, int removed, int added)
{
    if (!isLive(te))
        return;
    TEPtrPrivate* d = teData(te);
    CommonTextEditAPI* editor = te->Qt();
    if (d->maskingEdit || !d->mask || !editor)
        return;
    if (gPending.te == te) {
        d->maskedText.replace(position, removed, gPending.text);
        gPending = {};
        return;
    }
    // Text that came some other way (a paste through the widget): keep it, mask it soon.
    const QString shown = editor->document()->toPlainText().mid(position, added);
    d->maskedText.replace(position, removed, shown);
    if (shown.count(QChar(d->mask)) != shown.size())
        QTimer::singleShot(0, editor->widget(), [te] {
            if (isLive(te))
                remask(te);
        });
}

} // namespace

void startMasking(TEPtr* te, unsigned short mask)
{
    TEPtrPrivate* d = teData(te);
    CommonTextEditAPI* editor = te->Qt();
    if (!editor)
        return;
    if (!d->mask) {
        d->maskedText = editor->document()->toPlainText();
        QObject::connect(editor->document(), &QTextDocument::contentsChange, editor->widget(),
            [te](int position, int removed, int added) {
                contentsChanged(te, position, removed, added);
            });
        // Undoing would bring back masks without their text.
        editor->document()->setUndoRedoEnabled(false);
    }
    d->mask = mask;
    remask(te);
}

void stopMasking(TEPtr* te)
{
    TEPtrPrivate* d = teData(te);
    CommonTextEditAPI* editor = te->Qt();
    if (!d->mask || !editor) {
        d->mask = 0;
        return;
    }
    d->mask = 0;
    QObject::disconnect(
        editor->document(), &QTextDocument::contentsChange, editor->widget(), nullptr);
    d->maskingEdit = true;
    editor->document()->setPlainText(d->maskedText);
    d->maskingEdit = false;
    editor->document()->setUndoRedoEnabled(true);
    d->maskedText.clear();
}

void maskedInsert(TEPtr* te, QTextCursor& cursor, const QString& text)
{
    gPending = {te, text};
    cursor.insertText(QString(text.size(), QChar(teData(te)->mask)));
    gPending = {};
}

} // namespace Velmar::Private
