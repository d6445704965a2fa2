// What a TextEdit record keeps beyond its editor, the registry of live records, and the
// conversions between the host's text and offsets and the editor's.
#pragma once

#include <Velmar/TextEdit.h>

#include "foundation/LiveHandles.h"

#include <QColor>
#include <QHash>
#include <QPointer>
#include <QTextCursor>

#include <vector>

namespace Velmar::Private {

struct TEPtrPrivate {
    GrafPtr port = nullptr;
    QPointer<QWidget> window; // the port's window widget
    Rect view{};
    Rect dest{};
    Rect clip{};
    SInt16 just = teFlushDefault;
    SInt16 crOnly = 0;
    SInt16 lineHeight = 0; // 0: the font's
    SInt16 fontAscent = 0; // 0: the font's
    SInt16 txFont = 0;
    SInt16 txSize = 0;
    Style txFace = 0;
    bool displayOnly = false;
    bool useAccentColor = false;
    bool transparentBackground = false;
    bool alwaysDrawAsActive = false;
    bool pixelWrap = false;
    bool noWrap = false;
    bool allowMultipleBlocks = true;
    bool autoView = true;
    unsigned short mask = 0;
    QString maskedText; // the real text while characters are masked
    bool maskingEdit = false;
    Handle hText = nullptr; // the text handle TEGetText hands out
    std::vector<SInt16> lineStarts;
    TEClickLoopUPP clickLoop = nullptr;
    WindowRef focusWindow = nullptr;
    QString orphanText; // the text when the editor went with its window
    QTextCursor editBlock;
    int editBlockDepth = 0;
    QHash<int, QColor> paletteColours; // TESetPaletteColor, by QPalette::ColorRole
};

inline TEPtrPrivate* teData(const TEPtr* te)
{
    return te->d();
}

// A record the call may use: null raises "te != NULL", a disposed or made-up one
// "IsValidTERecord(te)". Both give false.
bool checkRecord(const TEPtr* te, const char* file, int line, const char* function);
#define VELMAR_CHECK_TE(te) ::Velmar::Private::checkRecord((te), __FILE__, __LINE__, __func__)

// The record's editor, or null (logging `call` once) when its window took it along.
CommonTextEditAPI* editorOf(const TEPtr* te, const char* call);

void registerRecord(TEPtr* te);
void unregisterRecord(TEPtr* te);

// Host text to the editor's ('\r' breaks lines) and back; positions stay where they are.
QString hostToEditorText(const QString& text);
QString editorToHostText(const QString& text);
// Bytes of the host's encoding (up to an embedded NUL) as editor text.
QString editorTextFromBytes(const void* bytes, SInt32 length);

// The horizontal alignment a justification asks for.
inline Qt::Alignment alignmentForJust(SInt16 just)
{
    if (just == teCenter)
        return Qt::AlignHCenter;
    return just == teFlushRight ? Qt::AlignRight : Qt::AlignLeft;
}

// The editor's text ('\n' between lines), or the kept text when the editor is gone.
QString recordText(const TEPtr* te);

// Offsets as the host counts them (characters, or bytes with UseLocal8Bit) and editor
// positions.
int editorPosition(const TEPtr* te, SInt32 offset);
SInt32 hostOffset(const TEPtr* te, int position);
// The same for `text`, the record's text already in hand (many offsets of one text).
SInt32 hostOffset(const TEPtr* te, const QString& text, int position);

// Local (port) coordinates and the editor's viewport coordinates.
QPoint localToViewport(const TEPtr* te, Point local);
Point viewportToLocal(const TEPtr* te, const QPoint& viewport);

// Re-applies geometry (clip and view widgets, wrapping, scroll position).
void applyGeometry(TEPtr* te);

// Masking: the real text behind masked characters.
void startMasking(TEPtr* te, unsigned short mask);
void stopMasking(TEPtr* te);
// Inserts `text` at the selection, masked when masking is on.
void insertEditorText(TEPtr* te, const QString& text);
// Inserts the mask in place of `text`, which the record keeps.
void maskedInsert(TEPtr* te, QTextCursor& cursor, const QString& text);

// The fonts and colours of the record's editor, from the port or the host palette.
void applyRecordFont(TEPtr* te);

} // namespace Velmar::Private
