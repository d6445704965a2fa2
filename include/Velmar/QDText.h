// QuickDraw fonts and text: font IDs and names, the port's font, size, face and text mode,
// measuring and drawing Toolbox and Unicode text at the pen.
#pragma once

#include <Velmar/MacTypes.h>
#include <Velmar/QDTypes.h>

#include <QFont>
#include <QSize>
#include <QString>

class QFontMetrics;

namespace Velmar {

// Font IDs of the classic families (any other ID the font table knows works as well).
enum : SInt16 {
    systemFont = 0,
    applFont = 1,
    newYork = 2,
    geneva = 3,
    monaco = 4,
    venice = 5,
    london = 6,
    athens = 7,
    sanFran = 8,
    toronto = 9,
    cairo = 11,
    losAngeles = 12,
    times = 20,
    helvetica = 21,
    courier = 22,
    symbol = 23,
    mobile = 24,
};

// Face bits (TextFace). Shadow and extend are accepted and have no effect.
enum : SInt16 {
    normal = 0,
    bold = 1,
    italic = 2,
    underline = 4,
    outline = 8,
    shadow = 16,
    condense = 32,
    extend = 64,
};
using Style = UInt8;
using StyleParameter = SInt16;

using Fixed = SInt32; // 16.16 fixed point
using JustStyleCode = SInt16;

// Metrics of a font. Holds its own QFontMetrics; copies are independent.
class VELMAR_EXPORT FontInfo {
public:
    FontInfo();
    explicit FontInfo(const QFont& font);
    FontInfo(const FontInfo& other);
    FontInfo& operator=(const FontInfo& other);
    ~FontInfo();

    void setFont(const QFont& font);
    const QFontMetrics& metrics() const { return *m_metrics; }

    int ascent() const;
    int descent() const;
    int lineSpacing() const;
    int leading() const;
    // The widest character; fonts that do not say give the width of "W".
    int widMax() const;
    QString fitTextToWidth(
        const QString& text, int width, Qt::TextElideMode mode = Qt::ElideRight) const;
    // The size of Macintosh-encoded (NUL-terminated) text: "\r", "\r\n" and "\n\r" break
    // lines; *lineCount (when given) receives the number of lines.
    QSize CalculateTextRectSize(const char* text, int* lineCount, int flags = 0) const;
    QSize calculateTextRectSizeUTF16(const QString& text, int* lineCount, int flags = 0) const;

private:
    QFontMetrics* m_metrics;
};

// ---- Fonts by ID and name ------------------------------------------------------------
// The ID of the font whose Toolbox name is `name` (a Pascal string read as Latin-1);
// 0 for an unknown name. A null `id` is ignored.
VELMAR_EXPORT void GetFNum(const unsigned char* name, SInt16* id);
// Writes the Toolbox name of `id` as a NUL-terminated C string starting at name[0] (not as
// a Pascal string). A null `name` is ignored.
VELMAR_EXPORT void GetFontName(SInt16 id, unsigned char* name);
VELMAR_EXPORT SInt16 GetAppFont();
VELMAR_EXPORT SInt16 GetSysFont();

// ---- The current port's font -----------------------------------------------------------
// The one-argument forms go through the host's application-font settings (appFont true).
VELMAR_EXPORT void TextFont(SInt16 id);
VELMAR_EXPORT void TextFont(SInt16 id, bool appFont);
// `size` in pixels; 0 takes the application font's size.
VELMAR_EXPORT void TextSize(SInt16 size);
VELMAR_EXPORT void TextSize(SInt16 size, bool appFont);
VELMAR_EXPORT void TextFace(SInt16 face);
VELMAR_EXPORT void TextFace(SInt16 face, bool appFont);
// srcCopy paints the text's background in the back colour; srcOr (the usual mode) does not.
// Fresh ports draw text without a background until TextMode(srcCopy) is called.
VELMAR_EXPORT void TextMode(SInt16 mode);

VELMAR_EXPORT QFont TxFontSizeFaceToQFont(SInt16 id, SInt16 size, SInt16 face, bool appFont);
VELMAR_EXPORT SInt16 GetTxFontFromQFont(const QFont& font);
VELMAR_EXPORT SInt16 GetTxSizeFromQFont(const QFont& font);
VELMAR_EXPORT SInt16 GetTxFaceFromQFont(const QFont& font);
VELMAR_EXPORT SInt16 GetPortTextFont(GrafPtr port);
VELMAR_EXPORT SInt16 GetPortTextSize(GrafPtr port);
VELMAR_EXPORT Style GetPortTextFace(GrafPtr port);
VELMAR_EXPORT SInt16 GetPortTextMode(GrafPtr port);

VELMAR_EXPORT void GetFontInfo(FontInfo* info);

// ---- Measuring --------------------------------------------------------------------------
// locs receives count + 1 SInt16 offsets: locs[i] is the width of the first i bytes.
VELMAR_EXPORT void MeasureText(SInt16 count, const void* text, void* locs);
VELMAR_EXPORT SInt16 StringWidth(const unsigned char* s);
VELMAR_EXPORT SInt16 TextWidth(const void* text, SInt16 first, SInt16 count);
VELMAR_EXPORT SInt16 CharWidth(SInt16 ch);
VELMAR_EXPORT SInt16 TextWidthUTF16(const QString& text, int first, int count);
VELMAR_EXPORT SInt16 TextWidthBufUTF16(const unsigned short* text, SInt16 first, SInt16 count);
// The length without trailing spaces, line feeds and tabs (the first byte always stays).
VELMAR_EXPORT SInt32 VisibleLength(const char* text, SInt32 length);

// ---- Drawing (baseline on the pen; the pen moves right by the text's width) -------------
VELMAR_EXPORT void DrawText(const void* text, SInt16 first, SInt16 count);
VELMAR_EXPORT void DrawString(const unsigned char* s);
// A value above 255 draws the two-byte character (high byte first).
VELMAR_EXPORT void DrawChar(SInt16 ch);
// numer / denom scale the text; equal or zero values draw it at its size.
VELMAR_EXPORT void StdText(SInt16 count, const void* text, Point numer, Point denom);
VELMAR_EXPORT void DrawTextUTF16(bool transparent, const QString& text, SInt16 first, SInt16 count);
// The buffer is read up to its first zero unit (and never past first + count).
VELMAR_EXPORT void DrawTextBufUTF16(
    bool transparent, const unsigned short* text, SInt16 first, SInt16 count);
// `slop` (16.16 pixels) is spread over the spaces of the text.
VELMAR_EXPORT void DrawJustified(const void* textPtr, SInt32 textLength, Fixed slop,
    JustStyleCode styleRunPosition, Point numer, Point denom);

// ---- Anti-aliasing ----------------------------------------------------------------------
// Text smaller than minSize pixels, or all text when disabled, is drawn without
// anti-aliasing. Returns noErr.
VELMAR_EXPORT OSStatus SetAntiAliasedTextEnabled(Boolean enable, SInt16 minSize);
VELMAR_EXPORT Boolean IsAntiAliasedTextEnabled(SInt16* minSize);

} // namespace Velmar
