// TextEdit: editable text records. A record (TEPtr) owns a Qt text widget placed on the
// window of the port it was made on; plain records use a QPlainTextEdit, styled records a
// QTextEdit. Input arrives the classic way: keys and clicks reach the host as events, and the
// host hands them to TEKey and TEClick.
//
// Offsets (selection, line starts, TEGetOffset) count characters, which are the bytes of the
// host's text for single-byte Macintosh encodings; after SetUseLocal8Bit(true) they count the
// bytes of the host's encoding exactly (two for a Shift_JIS kanji). Text crosses the
// interface with '\r' between lines, as TextEdit kept it.
#pragma once

#include <Velmar/Events.h>
#include <Velmar/MacTypes.h>
#include <Velmar/QDText.h>
#include <Velmar/QDTypes.h>
#include <Velmar/WindowRef.h>

#include <QPlainTextEdit>
#include <QTextEdit>

class QColor;
class QInputMethodEvent;
class QKeyEvent;

namespace Velmar {

class TEPtr;

// Justification (TESetAlignment, TETextBox).
enum : SInt16 {
    teFlushDefault = 0,
    teCenter = 1,
    teFlushRight = -1,
    teFlushLeft = -2,
    teJustLeft = 0,
    teJustCenter = 1,
    teJustRight = -1,
    teForceLeft = -2,
};

// TESetStyle modes.
enum : SInt16 {
    doFont = 1,
    doFace = 2,
    doSize = 4,
    doColor = 8,
    doAll = 15,
    addSize = 16,
    doToggle = 32,
};

struct TextStyle {
    SInt16 tsFont;
    Style tsFace;
    char filler;
    SInt16 tsSize;
    RGBColor tsColor;
};

// One style run of a style scrap.
struct ScrpSTElement {
    SInt32 scrpStartChar;
    SInt16 scrpHeight;
    SInt16 scrpAscent;
    SInt16 scrpFont;
    Style scrpFace;
    char filler;
    SInt16 scrpSize;
    RGBColor scrpColor;
};

// A style scrap: scrpNStyles runs follow (the array is as long as the count says).
struct StScrpRec {
    SInt16 scrpNStyles;
    ScrpSTElement scrpStyleTab[1];
};
using StScrpHandle = StScrpRec**;

// Called again and again while TEClick tracks the mouse; false stops the tracking.
using TEClickLoopProcPtr = Boolean (*)(TEPtr* te);
using TEClickLoopUPP = TEClickLoopProcPtr;
inline TEClickLoopUPP NewTEClickLoopUPP(TEClickLoopProcPtr proc)
{
    return proc;
}
inline void DisposeTEClickLoopUPP(TEClickLoopUPP)
{}

// What the record asks of its editor widget, whichever Qt class it is built on.
class VELMAR_EXPORT CommonTextEditAPI {
public:
    virtual ~CommonTextEditAPI();

    virtual QWidget* widget() = 0;
    virtual QWidget* viewportWidget() const = 0;
    virtual QTextDocument* document() const = 0;
    virtual QTextCursor textCursor() const = 0;
    virtual void setTextCursor(const QTextCursor& cursor) = 0;
    // Viewport coordinates.
    virtual QTextCursor cursorForPosition(const QPoint& point) const = 0;
    virtual QRect cursorRect(const QTextCursor& cursor) const = 0;
    virtual void ensureCursorVisible() = 0;
    virtual bool isStyled() const = 0;

    // The vertical scroll position in pixels, and the wrap width (0: the widget's width,
    // negative: no wrapping).
    virtual int scrollPixels() const = 0;
    virtual void setScrollPixels(int pixels) = 0;
    virtual void setWrapWidth(int width) = 0;
    virtual void setAlignment(Qt::Alignment alignment) = 0;

    // One key for the editor, as its own widget would take it.
    virtual void teKey(QKeyEvent* event) = 0;
    // Places the caret (or extends the selection) at `point` and tracks the mouse until the
    // button is released, calling the click loop meanwhile. Viewport coordinates.
    virtual void teClick(const QPoint& point, unsigned char extend) = 0;
    virtual void teUpdate(const QRect& viewportRect) = 0;
    virtual void teInputMethod(QInputMethodEvent* event) = 0;
    // Applies the record's colours (port colours, or the host palette's).
    virtual void fullRepaint() = 0;

    virtual void cut() = 0;
    virtual void copy() = 0;
    virtual void paste() = 0;
    virtual void undo() = 0;
    virtual void redo() = 0;
    virtual bool canUndo() const = 0;
    virtual bool canRedo() const = 0;
};

// The editor widget template: Base is QPlainTextEdit or QTextEdit. Its own widget takes no
// mouse input and passes keys on to the window (which makes events of them), except
// Control+C and Control+V.
template <class Base> class VELMAR_EXPORT AQTextEdit : public Base, public CommonTextEditAPI {
public:
    AQTextEdit(TEPtr* owner, QWidget* parent);
    ~AQTextEdit() override;

    TEPtr* owner() const { return m_owner; }
    void setOwner(TEPtr* owner) { m_owner = owner; }

    QWidget* widget() override { return this; }
    QWidget* viewportWidget() const override { return Base::viewport(); }
    QTextDocument* document() const override { return Base::document(); }
    QTextCursor textCursor() const override { return Base::textCursor(); }
    void setTextCursor(const QTextCursor& cursor) override { Base::setTextCursor(cursor); }
    QTextCursor cursorForPosition(const QPoint& point) const override
    {
        return Base::cursorForPosition(point);
    }
    QRect cursorRect(const QTextCursor& cursor) const override { return Base::cursorRect(cursor); }
    void ensureCursorVisible() override { Base::ensureCursorVisible(); }
    bool isStyled() const override;
    int scrollPixels() const override;
    void setScrollPixels(int pixels) override;
    void setWrapWidth(int width) override;
    void setAlignment(Qt::Alignment alignment) override;
    void teKey(QKeyEvent* event) override;
    void teClick(const QPoint& point, unsigned char extend) override;
    void teUpdate(const QRect& viewportRect) override;
    void teInputMethod(QInputMethodEvent* event) override;
    void fullRepaint() override;
    void cut() override { Base::cut(); }
    void copy() override { Base::copy(); }
    void paste() override { Base::paste(); }
    void undo() override { Base::undo(); }
    void redo() override { Base::redo(); }
    bool canUndo() const override { return document()->isUndoAvailable(); }
    bool canRedo() const override { return document()->isRedoAvailable(); }

protected:
    void keyPressEvent(QKeyEvent* event) override;
    void keyReleaseEvent(QKeyEvent* event) override;
    bool event(QEvent* event) override;

private:
    TEPtr* m_owner;
    QEventLoop* m_localLoop = nullptr;
    qint64 m_lastClickMs = -1;
    QPoint m_lastClickPoint;
    int m_clickCount = 0;
    bool m_inRepaint = false;
};

// Made inside the library only.
extern template class AQTextEdit<QPlainTextEdit>;
extern template class AQTextEdit<QTextEdit>;

class VELMAR_EXPORT SimpleQTextEdit : public AQTextEdit<QPlainTextEdit> {
public:
    using AQTextEdit<QPlainTextEdit>::AQTextEdit;
};

class VELMAR_EXPORT ComplexQTextEdit : public AQTextEdit<QTextEdit> {
public:
    using AQTextEdit<QTextEdit>::AQTextEdit;
};

namespace Private {
struct TEPtrPrivate;
void editorGone(TEPtr* te, const QString& text);
} // namespace Private

// A TextEdit record. Rectangles are in the local coordinates of the port it was made on:
// the view rectangle is the widget's visible area, the destination rectangle's offset from it
// is the scroll position (styled records wrap at its width), and the clip rectangle clips the
// widget.
class VELMAR_EXPORT TEPtr {
public:
    TEPtr(const Rect* dest, const Rect* view, bool styled);
    ~TEPtr();
    TEPtr(const TEPtr&) = delete;
    TEPtr& operator=(const TEPtr&) = delete;

    // The editor; null once the window it sat on is gone.
    CommonTextEditAPI* Qt() const { return m_editor; }
    QWidget* QtClip() const { return m_clip; }

    Rect destRect() const;
    void setDestRect(const Rect& rect);
    Rect viewRect() const;
    void setViewRect(const Rect& rect);
    void setClipRect(const Rect& rect);
    SInt16 lineHeight() const;
    void setLineHeight(SInt16 height);
    SInt16 fontAscent() const;
    void setFontAscent(SInt16 ascent);
    SInt16 txFont() const;
    void setTxFont(SInt16 font, bool appFont = true);
    SInt16 txSize() const;
    void setTxSize(SInt16 size, bool appFont = true);
    Style txFace() const;
    void setTxFace(Style face, bool appFont = true);
    SInt16 just() const;
    void setJust(SInt16 just);
    SInt16 crOnly() const;
    void setCrOnly(SInt16 crOnly);
    SInt16 selStart() const;
    void setSelStart(SInt16 start);
    SInt16 selEnd() const;
    void setSelEnd(SInt16 end);
    void clearSelection();
    SInt32 cursorPos() const;
    SInt16 nLines() const;
    // nLines() + 1 offsets: where each line starts, then the text's length.
    const SInt16* lineStarts() const;
    SInt16 teLength() const;
    SInt32 teLengthEx() const;
    SInt32 teCharacterCount() const;
    // The text in the host's encoding, as a handle the record owns (valid until the next call).
    Handle hText() const;
    QString hTextUnicode() const;
    // Copies at most `units` UTF-16 units and a terminating zero; returns the units copied.
    SInt32 getTextUTF16(unsigned short* buffer, int units) const;
    SInt32 getUTF16BufSizeNeeded() const;
    void setText(const void* text, SInt32 length);
    void setTextUTF16(const unsigned short* text);
    GrafPtr inPort() const;
    void setInPort(GrafPtr port);
    bool displayOnly() const;
    void setDisplayOnly(bool displayOnly);
    void SetReadOnly(bool readOnly);
    bool useAccentColor() const;
    void setUseAccentColor(bool use);
    bool useTransparentBackground() const;
    void setUseTransparentBackground(bool use);
    bool alwaysDrawAsActive() const;
    void setAlwaysDrawAsActive(bool always);
    void setUsePixelWrapMode(bool pixelWrap);
    void SetLineNoWrapMode();
    void setAllowMultipleBlocks(bool allow);
    // Shows every character as `mask` (0 shows the text again); the text itself is kept.
    void maskAllCharacters(unsigned short mask);
    bool UseLocal8Bit() const { return m_useLocal8Bit; }
    void SetUseLocal8Bit(bool use) { m_useLocal8Bit = use; }
    void undo();
    void redo();
    bool canUndo() const;
    bool canRedo() const;
    // The document's height, the visible height and the scroll position, in pixels.
    void GetYInfo(SInt32* total, SInt32* visible, SInt32* position) const;
    WindowRef GetFocusWindowOnActivate() const;
    void SetFocusWindowOnActivate(WindowRef window);
    void Dispose();

    Private::TEPtrPrivate* d() const { return m_d; }

private:
    friend void Private::editorGone(TEPtr* te, const QString& text);

    CommonTextEditAPI* m_editor = nullptr;
    QWidget* m_clip = nullptr;
    Private::TEPtrPrivate* m_d = nullptr;
    bool m_useLocal8Bit = false;
};
using TEHandle = TEPtr*;

VELMAR_EXPORT TEPtr* TENew(const Rect* dest, const Rect* view);
VELMAR_EXPORT TEPtr* TEStyleNew(const Rect* dest, const Rect* view);
VELMAR_EXPORT void TEDispose(TEPtr* te);
VELMAR_EXPORT void TESetText(const void* text, SInt32 length, TEPtr* te);
// The record's own handle of its text (do not dispose of it).
VELMAR_EXPORT Handle TEGetText(TEPtr* te);
VELMAR_EXPORT void TEInsert(const void* text, SInt32 length, TEPtr* te, Boolean redraw = 1);
VELMAR_EXPORT void TEDelete(TEPtr* te);
VELMAR_EXPORT void TEKey(char key, TEPtr* te, EventRecord* event);
VELMAR_EXPORT void TEKeyUTF16(unsigned short unit, TEPtr* te, EventRecord* event);
VELMAR_EXPORT void TEClick(Point point, Boolean extend, TEPtr* te);
VELMAR_EXPORT void TESetSelect(SInt32 start, SInt32 end, TEPtr* te);
VELMAR_EXPORT void TEActivate(TEPtr* te);
VELMAR_EXPORT void TEActivateEx(TEPtr* te, WindowRef focusWindow);
VELMAR_EXPORT void TEDeactivate(TEPtr* te, Boolean keepSelectionVisible = 0);
VELMAR_EXPORT void TEIdle(TEPtr* te);
VELMAR_EXPORT void TECalText(TEPtr* te);
VELMAR_EXPORT void TEAutoView(Boolean fAuto, TEPtr* te);
VELMAR_EXPORT void TESelView(TEPtr* te);
VELMAR_EXPORT void TEUpdate(const Rect* rect, TEPtr* te);
VELMAR_EXPORT void TEScroll(SInt16 dh, SInt16 dv, TEPtr* te);
VELMAR_EXPORT void TEPinScroll(SInt16 dh, SInt16 dv, TEPtr* te);
VELMAR_EXPORT SInt16 TEGetOffset(Point point, TEPtr* te);
// The caret position before `offset`: its left edge and the baseline of its line (with
// `lineBottom`, the bottom of the line).
VELMAR_EXPORT Point TEGetPoint(SInt16 offset, TEPtr* te, bool lineBottom = false);
// The height of lines startLine to endLine (1-based, in either order).
VELMAR_EXPORT SInt32 TEGetHeight(SInt32 endLine, SInt32 startLine, TEPtr* te);
VELMAR_EXPORT void TECut(TEPtr* te);
VELMAR_EXPORT void TECopy(TEPtr* te);
VELMAR_EXPORT void TEPaste(TEPtr* te);
VELMAR_EXPORT void TEStylePaste(TEPtr* te);
VELMAR_EXPORT void TEStyleInsert(const void* text, SInt32 length, StScrpHandle styles, TEPtr* te);
// Text moves through the system clipboard itself: these two do nothing and return 0.
VELMAR_EXPORT OSErr TEFromScrap();
VELMAR_EXPORT OSErr TEToScrap();
VELMAR_EXPORT SInt32 TEGetScrapLength();
// The styles of the selection as a new handle the caller disposes (TxDisposeHandle);
// null for plain records.
VELMAR_EXPORT StScrpHandle TEGetStyleScrapHandle(TEPtr* te);
VELMAR_EXPORT void TESetStyle(SInt16 mode, const TextStyle* style, Boolean redraw, TEPtr* te);
VELMAR_EXPORT void TEGetStyle(
    SInt16 offset, TextStyle* style, SInt16* lineHeight, SInt16* fontAscent, TEPtr* te);
VELMAR_EXPORT void TESetTextFontAndSize(SInt16 font, SInt16 size, TEPtr* te);
VELMAR_EXPORT void TESetAlignment(SInt16 just, TEPtr* te);
// `role` is a QPalette::ColorRole; a null colour restores the record's own.
VELMAR_EXPORT void TESetPaletteColor(int role, const QColor* color, TEPtr* te);
VELMAR_EXPORT void TESetClickLoop(TEClickLoopUPP clickLoop, TEPtr* te);
// Edits between the two are one undo step.
VELMAR_EXPORT void TEBeginEditBlock(TEPtr* te);
VELMAR_EXPORT void TEEndEditBlock(TEPtr* te);
// Draws text into the current port, broken into lines within `box`.
VELMAR_EXPORT void TETextBox(const void* text, SInt32 length, const Rect* box, SInt16 just);

} // namespace Velmar
