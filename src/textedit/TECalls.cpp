// The TextEdit calls that make, drive and dispose of records: keys, clicks, activation,
// scrolling, updating, the clipboard and edit blocks.
#include <Velmar/AQtWindow.h>
#include <Velmar/Diagnostics.h>
#include <Velmar/HostEncoding.h>
#include <Velmar/TextEdit.h>
#include <Velmar/TextUtils.h>

#include "foundation/Conversions.h"
#include "foundation/NotImplemented.h"
#include "textedit/TERecordPrivate.h"

#include <QApplication>
#include <QClipboard>
#include <QKeyEvent>
#include <QTextDocument>

namespace Velmar {

using namespace Private;

namespace {

struct ControlKey {
    unsigned short unit;
    Qt::Key key;
};
// The classic control characters and the keys that type them.
constexpr ControlKey kControlKeys[] = {
    {0x01, Qt::Key_Home},
    {0x03, Qt::Key_Enter},
    {0x04, Qt::Key_End},
    {0x08, Qt::Key_Backspace},
    {0x09, Qt::Key_Tab},
    {0x0B, Qt::Key_PageUp},
    {0x0C, Qt::Key_PageDown},
    {0x0D, Qt::Key_Return},
    {0x1B, Qt::Key_Escape},
    {0x1C, Qt::Key_Left},
    {0x1D, Qt::Key_Right},
    {0x1E, Qt::Key_Up},
    {0x1F, Qt::Key_Down},
    {0x7F, Qt::Key_Delete},
};

Qt::Key keyForUnit(unsigned short unit)
{
    for (const ControlKey& k : kControlKeys)
        if (k.unit == unit)
            return k.key;
    const QChar c(unit);
    if (c.isLetterOrNumber() && unit < 0x80)
        return Qt::Key(c.toUpper().unicode());
    return Qt::Key_unknown;
}

Qt::KeyboardModifiers modifiersOf(const EventRecord& e)
{
    Qt::KeyboardModifiers modifiers;
    if (e.modifiers & (shiftKey | rightShiftKey))
        modifiers |= Qt::ShiftModifier;
    if (e.modifiers & cmdKey)
        modifiers |= Qt::ControlModifier;
    if (e.modifiers & (optionKey | rightOptionKey))
        modifiers |= Qt::AltModifier;
    return modifiers;
}

bool isTyped(unsigned short unit)
{
    return unit >= 0x20 && unit != 0x7F;
}

AQtWindow* recordWindow(const TEPtr* te)
{
    return qobject_cast<AQtWindow*>(teData(te)->window.data());
}

} // namespace

TEPtr* TENew(const Rect* dest, const Rect* view)
{
    return new TEPtr(dest, view, false);
}

TEPtr* TEStyleNew(const Rect* dest, const Rect* view)
{
    return new TEPtr(dest, view, true);
}

void TEDispose(TEPtr* te)
{
    if (!VELMAR_CHECK_TE(te))
        return;
    te->Dispose();
    delete te;
}

void TEKey(char key, TEPtr* te, EventRecord* event)
{
    // The key's own event carries the character as typed, also where the host's encoding
    // has no byte for it; otherwise the byte is converted, or taken as it is.
    const unsigned char byte = static_cast<unsigned char>(key);
    unsigned short unit = byte;
    if (event && event->textUnit && (event->message & charCodeMask) == byte) {
        unit = event->textUnit;
    } else {
        unsigned short converted[4] = {};
        const char bytes[1] = {key};
        const SInt32 units = CurrentMacMBCSEncodingToUTF16(bytes, 1, converted, 4);
        if (units >= 1 && converted[0] != 0xFFFD && converted[0] != 0x001A)
            unit = converted[0];
    }
    TEKeyUTF16(unit, te, event);
}

void TEKeyUTF16(unsigned short unit, TEPtr* te, EventRecord* event)
{
    if (!VELMAR_ASSERT(event, "eventRecord") || !VELMAR_CHECK_TE(te))
        return;
    CommonTextEditAPI* editor = editorOf(te, "TEKeyUTF16");
    if (!editor)
        return;
    TEPtrPrivate* d = teData(te);
    const bool ownKey = event->qtKey && event->textUnit == unit;
    const auto key = ownKey ? Qt::Key(event->qtKey) : keyForUnit(unit);
    if ((key == Qt::Key_Return || key == Qt::Key_Enter) && !d->allowMultipleBlocks)
        return;
    const QString text = isTyped(unit) ? QString(QChar(unit)) : QString();
    // Masked text, and characters Qt's editors refuse as keys (C1 controls), go in directly.
    if (!text.isEmpty() && (d->mask || !QChar(unit).isPrint())) {
        insertEditorText(te, text);
        return;
    }
    const auto modifiers = ownKey ? Qt::KeyboardModifiers(event->qtModifiers) : modifiersOf(*event);
    QKeyEvent qtEvent(QEvent::KeyPress, key, modifiers, text);
    editor->teKey(&qtEvent);
    if (d->autoView)
        editor->ensureCursorVisible();
}

void TEClick(Point point, Boolean extend, TEPtr* te)
{
    if (!VELMAR_CHECK_TE(te))
        return;
    if (CommonTextEditAPI* editor = editorOf(te, "TEClick"))
        editor->teClick(localToViewport(te, point), extend);
}

// ---- Activation ------------------------------------------------------------------------------

void TEActivate(TEPtr*)
{
    // The record needs the window that takes the keys: TEActivateEx.
    VELMAR_ASSERT(false, "false");
}

void TEActivateEx(TEPtr* te, WindowRef focusWindow)
{
    if (!VELMAR_CHECK_TE(te))
        return;
    if (!VELMAR_ASSERT(focusWindow != nullptr, "focusWindow != NULL"))
        focusWindow = recordWindow(te);
    te->SetFocusWindowOnActivate(focusWindow);
    CommonTextEditAPI* editor = editorOf(te, "TEActivateEx");
    if (!editor)
        return;
    if (AQtWindow* window = recordWindow(te))
        window->setFocusProxyTextEdit(editor);
    editor->widget()->setFocus(Qt::OtherFocusReason);
    editor->fullRepaint();
}

void TEDeactivate(TEPtr* te, Boolean)
{
    if (!VELMAR_CHECK_TE(te))
        return;
    CommonTextEditAPI* editor = te->Qt();
    if (!editor)
        return;
    if (AQtWindow* window = recordWindow(te)) {
        if (window->focusProxyTextEdit() == editor)
            window->setFocusProxyTextEdit(nullptr);
        if (editor->widget()->hasFocus())
            window->setFocus(Qt::OtherFocusReason);
    }
    editor->fullRepaint();
}

// The caret blinks by itself and the layout follows every edit.
void TEIdle(TEPtr* te)
{
    VELMAR_CHECK_TE(te);
}

void TECalText(TEPtr* te)
{
    if (VELMAR_CHECK_TE(te))
        if (CommonTextEditAPI* editor = editorOf(te, "TECalText"))
            editor->document()->adjustSize();
}

void TEAutoView(Boolean fAuto, TEPtr* te)
{
    if (VELMAR_CHECK_TE(te))
        teData(te)->autoView = fAuto != 0;
}

void TESelView(TEPtr* te)
{
    if (VELMAR_CHECK_TE(te))
        if (CommonTextEditAPI* editor = editorOf(te, "TESelView"))
            editor->ensureCursorVisible();
}

void TEUpdate(const Rect* rect, TEPtr* te)
{
    if (!rect || !VELMAR_CHECK_TE(te))
        return;
    const QRect area = toQRect(*rect);
    if (area.isEmpty())
        return;
    if (CommonTextEditAPI* editor = editorOf(te, "TEUpdate"))
        editor->teUpdate(area.translated(-teData(te)->view.left, -teData(te)->view.top));
}

void TEScroll(SInt16 dh, SInt16 dv, TEPtr* te)
{
    if (!VELMAR_CHECK_TE(te))
        return;
    if (dh != 0)
        notImplemented("TEScrollByPixel");
    CommonTextEditAPI* editor = editorOf(te, "TEScroll");
    const SInt16 lineHeight = te->lineHeight();
    if (!editor || dv == 0 || lineHeight <= 0)
        return;
    // The caret moves by whole lines and the editor scrolls to keep it in view; the
    // selection collapses on purpose.
    const int lines = std::abs(int(dv)) / lineHeight;
    QTextCursor cursor = editor->textCursor();
    cursor.movePosition(
        dv < 0 ? QTextCursor::Down : QTextCursor::Up, QTextCursor::MoveAnchor, lines);
    editor->setTextCursor(cursor);
}

void TEPinScroll(SInt16 dh, SInt16 dv, TEPtr* te)
{
    TEScroll(dh, dv, te);
}

// ---- The clipboard ---------------------------------------------------------------------------

void TECut(TEPtr* te)
{
    if (VELMAR_CHECK_TE(te))
        if (CommonTextEditAPI* editor = editorOf(te, "TECut"))
            editor->cut();
}

void TECopy(TEPtr* te)
{
    if (VELMAR_CHECK_TE(te))
        if (CommonTextEditAPI* editor = editorOf(te, "TECopy"))
            editor->copy();
}

void TEPaste(TEPtr* te)
{
    if (!VELMAR_CHECK_TE(te) || !editorOf(te, "TEPaste"))
        return;
    // Through the record, so that masking and single-line records see the text.
    insertEditorText(te, hostToEditorText(QGuiApplication::clipboard()->text()));
}

void TEStylePaste(TEPtr* te)
{
    if (!VELMAR_CHECK_TE(te))
        return;
    CommonTextEditAPI* editor = editorOf(te, "TEStylePaste");
    if (editor && editor->isStyled() && !teData(te)->mask && teData(te)->allowMultipleBlocks)
        editor->paste();
    else
        TEPaste(te);
}

OSErr TEFromScrap()
{
    return 0;
}

OSErr TEToScrap()
{
    return 0;
}

SInt32 TEGetScrapLength()
{
    return SInt32(MakeLocal8Bit(QGuiApplication::clipboard()->text()).size() - 1);
}

// ---- Click loop and edit blocks ----------------------------------------------------------------

void TESetClickLoop(TEClickLoopUPP clickLoop, TEPtr* te)
{
    if (VELMAR_CHECK_TE(te))
        teData(te)->clickLoop = clickLoop;
}

void TEBeginEditBlock(TEPtr* te)
{
    if (!VELMAR_CHECK_TE(te))
        return;
    CommonTextEditAPI* editor = editorOf(te, "TEBeginEditBlock");
    if (!editor)
        return;
    TEPtrPrivate* d = teData(te);
    if (d->editBlockDepth++ == 0)
        d->editBlock = QTextCursor(editor->document());
    d->editBlock.beginEditBlock();
}

void TEEndEditBlock(TEPtr* te)
{
    if (!VELMAR_CHECK_TE(te))
        return;
    TEPtrPrivate* d = teData(te);
    if (d->editBlockDepth == 0)
        return;
    --d->editBlockDepth;
    if (te->Qt())
        d->editBlock.endEditBlock();
}

} // namespace Velmar
