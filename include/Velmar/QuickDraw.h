// QuickDraw pens, patterns and colours, and the colour-model conversions.
#pragma once

#include <Velmar/MacTypes.h>
#include <Velmar/QDTypes.h>
#include <Velmar/QtGrafPort.h>

#include <QBrush>
#include <QPoint>

namespace Velmar {

// A pattern as a brush. Built from eight pattern bytes (each byte inverted, bit 0 the
// leftmost pixel) or copied from a brush. A null pattern pointer gives a null PatPtr.
class VELMAR_EXPORT PatPtr {
public:
    PatPtr(const Pattern* pattern); // NOLINT: hosts pass &pattern where a PatPtr is taken
    PatPtr(const QBrush& brush);    // NOLINT
    PatPtr(const PatPtr& other);
    PatPtr& operator=(const PatPtr& other);
    ~PatPtr();

    bool operator==(void* p) const { return static_cast<void*>(m_brush) == p; }
    bool operator!=(void* p) const { return static_cast<void*>(m_brush) != p; }

    const QBrush* brush() const { return m_brush; }

private:
    QBrush* m_brush;
};

class VELMAR_EXPORT PenState {
public:
    PenState();
    PenState(const QPoint& location, int size, SInt16 mode, const QBrush& pattern);
    PenState(const PenState& other);
    PenState& operator=(const PenState& other);
    ~PenState();

    const QPoint& penLocation() const { return *m_location; }
    int penSize() const { return m_size; }
    SInt16 penMode() const { return m_mode; }
    const QBrush& penPattern() const { return *m_pattern; }
    void setPenLocation(const QPoint& location) { *m_location = location; }
    void setPenSize(int size) { m_size = size; }
    void setPenMode(SInt16 mode) { m_mode = mode; }
    void setPenPattern(const QBrush& pattern) { *m_pattern = pattern; }

private:
    QPoint* m_location;
    int m_size;
    SInt16 m_mode;
    QBrush* m_pattern;
};

// Each field a fraction scaled to 0-65535.
struct HSVColor {
    UInt16 hue;
    UInt16 saturation;
    UInt16 value;
};

struct HSLColor {
    UInt16 hue;
    UInt16 saturation;
    UInt16 lightness;
};

// ---- Pen ----------------------------------------------------------------------------
VELMAR_EXPORT void PenPat(const PatPtr& pattern);
VELMAR_EXPORT void BackPat(const PatPtr& pattern);
VELMAR_EXPORT void PenSize(SInt16 width, SInt16 height);
VELMAR_EXPORT void PenMode(SInt16 mode);
VELMAR_EXPORT void PenNormal();
VELMAR_EXPORT void HidePen();
VELMAR_EXPORT void ShowPen();
VELMAR_EXPORT void GetPen(Point* location);
VELMAR_EXPORT void SetPenStyle(int style);
VELMAR_EXPORT int GetPenStyle();
VELMAR_EXPORT void GetPenState(PenState* state);
VELMAR_EXPORT void SetPenState(const PenState* state);

// ---- Standard patterns (each also copied into *pattern when it is not null) ----------
VELMAR_EXPORT const PatPtr& GetQDGlobalsBlack(Pattern* pattern);
VELMAR_EXPORT const PatPtr& GetQDGlobalsWhite(Pattern* pattern);
VELMAR_EXPORT const PatPtr& GetQDGlobalsGray(Pattern* pattern);
VELMAR_EXPORT const PatPtr& GetQDGlobalsLightGray(Pattern* pattern);
VELMAR_EXPORT const PatPtr& GetQDGlobalsDarkGray(Pattern* pattern);

// ---- Hilite state ---------------------------------------------------------------------
VELMAR_EXPORT void LMGetHiliteRGB(RGBColor* color);
VELMAR_EXPORT void LMSetHiliteRGB(const RGBColor* color);
VELMAR_EXPORT unsigned char LMGetHiliteMode();
VELMAR_EXPORT void LMSetHiliteMode(unsigned char mode);
// Once per process: the hilite colour becomes the application palette's highlight colour.
VELMAR_EXPORT void Initialize();

// ---- Colour models ---------------------------------------------------------------------
VELMAR_EXPORT void HSV2RGB(const HSVColor* hsv, RGBColor* rgb);
VELMAR_EXPORT void RGB2HSV(const RGBColor* rgb, HSVColor* hsv);
VELMAR_EXPORT void RGB2HSL(const RGBColor* rgb, HSLColor* hsl);
VELMAR_EXPORT void InvertColor(RGBColor* color);
// Modal colour dialog; 1 when the user accepted a colour (stored in *outColor), else 0.
VELMAR_EXPORT unsigned char GetColor(Point where, const unsigned char* prompt,
                                     const RGBColor* inColor, RGBColor* outColor);

} // namespace Velmar
