// Icons and pictures: the host's icon and picture resources as PNG images in the Qt resource
// tree (":/images/TYPE_ID.png"), the icon objects that draw them into the current port, and
// the Toolbox icon and picture calls.
#pragma once

#include <Velmar/MacTypes.h>
#include <Velmar/Resources.h>

#include <QImage>
#include <QRect>
#include <QString>

namespace Velmar {

// The host's skinned interface names its rectangles and colours so.
using TxRect = Rect;
using TxRGBColor = RGBColor;

// ":/images/TYPE_ID.png" for the icon types; any other type takes the 'cicn' pattern.
VELMAR_EXPORT QString MakeImageResourceName(ResType type, SInt16 id);

// An icon loaded from a PNG, with the transparency its type's mask rules give it. Icons are
// owned by the ResourceHandle that carries them and deleted by ReleaseResource.
class VELMAR_EXPORT AbstractIcon {
public:
    AbstractIcon(const QImage& image, bool hasPartialAlpha, SInt32 id);
    virtual ~AbstractIcon();
    AbstractIcon(const AbstractIcon&) = delete;
    AbstractIcon& operator=(const AbstractIcon&) = delete;

    // A new icon of the same class and image, its fields filled by copyTo.
    virtual AbstractIcon* clone() const = 0;
    virtual void copyTo(AbstractIcon* other) const;
    virtual QImage image() const;
    // The image as it is to be drawn: opacity applied (its alpha scaled by
    // floor(opacity * 256), opacity clamped to [0, 1]). Kept until an argument changes.
    virtual QImage prepare(SInt32 transform, float opacity, bool skinFlag,
        const RGBColor* firstColor, const RGBColor* secondColor);
    // Draws into the current port, centred in `target` at the image's own size. `ink`
    // tints a monochrome icon (null: the port's foreground colour). `caller` names the
    // call in the no-port warning.
    virtual void Draw(const QRect& target, SInt32 transform, float opacity, const RGBColor* ink,
        const char* caller);
    // `source` as this icon draws it in `ink` (through transferImage).
    virtual QImage colorize(const QImage& source, const QColor& ink) const;
    // Colour icons: `target` becomes `source`. Monochrome icons: `target` is `ink` wherever
    // `source` is opaque, keeping its transparency.
    virtual void transferImage(QImage& target, const QImage& source, const QColor& ink) const = 0;

    SInt32 id() const { return m_id; }
    bool hasPartialAlpha() const { return m_hasPartialAlpha; }

protected:
    QImage m_image;
    bool m_hasPartialAlpha;
    QImage m_prepared;
    SInt32 m_transform = 0;
    float m_opacity = 1.0f;
    SInt64 m_skinIndex = -1;
    bool m_skinFlag = false;
    RGBColor m_firstColor;
    RGBColor m_secondColor;
    SInt32 m_id;
};

class VELMAR_EXPORT ColorIcon : public AbstractIcon {
public:
    ColorIcon(const QImage& image, bool hasPartialAlpha, SInt32 id);
    AbstractIcon* clone() const override;
    void transferImage(QImage& target, const QImage& source, const QColor& ink) const override;
};

// Drawn in the port's foreground colour (or the colour a paint call gives).
class VELMAR_EXPORT MonochromeIcon : public AbstractIcon {
public:
    MonochromeIcon(const QImage& image, bool hasPartialAlpha, SInt32 id);
    AbstractIcon* clone() const override;
    void transferImage(QImage& target, const QImage& source, const QColor& ink) const override;
};

// What a missing PNG gives: a null image that draws nothing.
class VELMAR_EXPORT NullIcon : public AbstractIcon {
public:
    NullIcon();
    AbstractIcon* clone() const override;
    void transferImage(QImage& target, const QImage& source, const QColor& ink) const override;
};

// IDs 0, 1 and 2 are the style's stop, note and caution icons at 32x32, whatever the type;
// otherwise the PNG for (type, id), or a NullIcon when there is none. The caller owns it.
VELMAR_EXPORT AbstractIcon* LoadIcon(ResType type, SInt16 id);

// ---- Icon calls ----------------------------------------------------------------------
VELMAR_EXPORT void PlotIcon(const Rect* rect, ResourceHandle icon);
// The same as PlotCIcon(rect, icon): opacity and colour are not used.
VELMAR_EXPORT void PlotIcon(const Rect* rect, ResourceHandle icon, float opacity, RGBColor color);
VELMAR_EXPORT void PlotCIcon(const Rect* rect, ResourceHandle icon);
VELMAR_EXPORT void PlotCIcon(const Rect* rect, ResourceHandle icon, float opacity, RGBColor color);
VELMAR_EXPORT SInt16 PlotCIconHandle(
    const Rect* rect, SInt16 align, SInt16 transform, ResourceHandle icon);
// Draws the first icon of the family `id` that exists, large ones ('cicn' first) for a
// rectangle at least 17 pixels wide, small ones ('ics8' first) otherwise. Returns 0.
VELMAR_EXPORT SInt16 PlotIconID(const Rect* rect, SInt16 align, SInt16 transform, SInt16 id);
VELMAR_EXPORT SInt16 PlotIconID(
    const Rect* rect, SInt16 align, SInt16 transform, SInt16 id, float opacity, RGBColor color);
// The icon image's rectangle; all zero for a handle without an icon.
VELMAR_EXPORT Rect GetCIconBounds(ResourceHandle icon);
// Icon suites do not exist here: the outputs are set to null and the calls answer 0.
VELMAR_EXPORT OSErr GetIconSuite(Handle* suite, SInt16 id, UInt32 selector);
VELMAR_EXPORT OSErr GetIconFromSuite(Handle* icon, Handle suite, ResType type);
VELMAR_EXPORT OSErr PlotIconSuite(const Rect* rect, SInt16 align, SInt16 transform, Handle suite);
VELMAR_EXPORT Boolean PtInIconID(Point point, const Rect* rect, SInt16 align, SInt16 id);

// The host's skinned paint calls: the icon drawn as PlotIcon draws it, a monochrome icon in
// the given colour (null: the foreground colour), with the given opacity. The index and state
// arguments select skin pieces, which do not exist here.
VELMAR_EXPORT void PaintSiconIndexed(
    ResourceHandle icon, const Rect& rect, SInt16 index, SInt16 state);
VELMAR_EXPORT void PaintSiconIndexed(ResourceHandle icon, const Rect& rect, SInt16 index,
    SInt16 state, float opacity, RGBColor color);
VELMAR_EXPORT void PaintCiconEx(ResourceHandle icon, TxRect rect, float opacity,
    TxRGBColor* firstColor, TxRGBColor* secondColor, bool skinFlag);
VELMAR_EXPORT void PaintSiconEx(ResourceHandle icon, TxRect rect, float opacity,
    TxRGBColor* firstColor, TxRGBColor* secondColor, bool skinFlag);

// ---- Pictures ------------------------------------------------------------------------
// Draws an RT_QIMAGE picture scaled into `rect`; a missing picture draws nothing.
VELMAR_EXPORT void DrawPicture(ResourceHandle picture, const Rect* rect);
VELMAR_EXPORT Rect* QDGetPictureBounds(ResourceHandle picture, Rect* bounds);

} // namespace Velmar
