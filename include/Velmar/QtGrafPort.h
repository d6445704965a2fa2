// Graphics ports and offscreen worlds: the port object, the current port, offscreen world
// calls, bounds and origin, colours and regions as port state, pixels and scrolling.
#pragma once

#include <Velmar/MacTypes.h>
#include <Velmar/QDTypes.h>

#include <QBrush>
#include <QColor>
#include <QFont>
#include <QPainter>
#include <QPen>
#include <QRect>
#include <QRegion>
#include <QTransform>


class QImage;
class QPaintDevice;

namespace Velmar {

// The drawing state a port keeps while it has no active painter; pushed into the painter
// when one starts and read back from it when it ends.
class VELMAR_EXPORT PainterState {
public:
    PainterState();

    QPen pen;
    QFont font;
    QBrush brush;       // the fill brush (pen pattern)
    QBrush background;  // the background brush (background pattern)
    QRegion clip;       // the effective clip, local coordinates
    bool clipEnabled = false;
    QTransform transform;
    QPainter::CompositionMode compositionMode = QPainter::CompositionMode_SourceOver;

    // Reads pen, font, brushes and composition mode back (clip and transform are the
    // port's own and are never read back).
    void saveFrom(const QPainter& painter);
    void applyTo(QPainter& painter) const;
};

// The bitmap view of a port's image, as the copy calls see it.
class VELMAR_EXPORT BitMapPtr {
public:
    QImage* image() const { return m_image; }
    QtGrafPort* port() const { return m_port; }
    // Fills the image with the colour a fresh port shows: the content colour for a window
    // port, the back colour for an offscreen world.
    void clear() const;

protected:
    BitMapPtr(QImage* image, QtGrafPort* port) : m_image(image), m_port(port) {}
    ~BitMapPtr() = default;
    QImage* m_image;
    QtGrafPort* m_port;
    friend class QtGrafPort;
};

// The pixmap object around a port's image (which the port owns), or around an image of its
// own (a host's pixmap: NewPixMap, TxCopyHand), which it owns.
class VELMAR_EXPORT PixMapPtr : public BitMapPtr {
public:
    static PixMapPtr* createPixMap(QImage* image, QtGrafPort* port, SInt16 pixelDepth);
    // Takes `image` over; it is freed with the pixmap.
    static PixMapPtr* createOwnedPixMap(QImage* image, SInt16 pixelDepth);
    static void destroyPixMap(PixMapPtr* pixmap);

    SInt16 pixelDepth() const { return m_pixelDepth; }
    bool ownsImage() const { return m_ownsImage; }
    // Local coordinates of the top-left pixel: the port's origin, or the pixmap's own.
    QPoint origin() const;
    // An owned pixmap's pixels are replaced (the old ones freed) and placed at `origin`.
    void replaceImage(QImage* image, const QPoint& origin);

private:
    PixMapPtr(QImage* image, QtGrafPort* port, SInt16 depth, bool owns)
        : BitMapPtr(image, port), m_pixelDepth(depth), m_ownsImage(owns) {}
    SInt16 m_pixelDepth;
    bool m_ownsImage;
    QPoint m_origin;
};

namespace Private {
struct QtGrafPortPrivate;
}

// A graphics port: a window's port (window set; its image is the window's back buffer)
// or an offscreen world (no window; it exists only as its image). The public fields are the
// port record hosts and the other managers read; caches and painter bookkeeping live in a
// private record.
class VELMAR_EXPORT QtGrafPort {
public:
    static constexpr UInt32 kLiveMagic = 0x51744750; // "PGtQ"
    static constexpr UInt32 kDeadMagic = 0xFFFFFFFFu;

    // An offscreen world whose bounds are `bounds` (inclusive corners, local coordinates);
    // a width or height below 1 is made 1.
    QtGrafPort(const QRect& bounds, SInt16 pixelDepth);
    // A window's port. `backBuffer` (taken over; null in direct drawing mode) is the
    // widget-sized image the window shows; `widgetRect` the widget's rectangle.
    QtGrafPort(AQtWindow* window, const QRect& widgetRect, QImage* backBuffer);
    ~QtGrafPort();

    QtGrafPort(const QtGrafPort&) = delete;
    QtGrafPort& operator=(const QtGrafPort&) = delete;

    // ---- Fields, in their documented order -------------------------------------------
    AQtWindow* window = nullptr;
    QColor hiliteColor;
    QColor opColor;
    QColor backColor;
    QColor contentColor;
    PixMapPtr* pixmap = nullptr;
    QPaintDevice* paintDevice = nullptr;
    SInt32 penX = 0; // pen location
    SInt32 penY = 0;
    // Polygon and region recording (the shape and region calls own their meaning).
    UInt8 definingPoly = 0;
    UInt8 definingRgn = 0;
    PolyPtr* polySave = nullptr;
    QRegion* rgnSave = nullptr;
    SInt16 penMode = 8; // patCopy
    SInt16 textMode = 0;
    SInt16 textSize = 0;
    SInt16 penVisibility = 0; // 0 visible, negative hidden
    // The pen lives in painterState.pen while no painter is active (one place for it).
    QPainter* painter = nullptr;
    QRegion visibleRegion;
    QRegion clipRegion;
    QRect bounds;
    PainterState painterState;
    bool ownsPainter = true;
    UInt32 magic = kLiveMagic;
    UInt8 appFontFlag = 1;
    UInt8 clipInForce = 0;

    // ---- Painter --------------------------------------------------------------------
    bool isActive() const;
    // Starts the painter on the paint device or the image; ends the oldest active painter
    // when more than 50 would be active.
    void BeginPaint();
    void EndPaint();

    // The pixels (null in direct drawing mode, or for a world too large to allocate).
    QImage* image() const;
    // The origin (local coordinates of the image's top-left pixel).
    QPoint origin() const { return bounds.topLeft(); }

    // ---- State that lives in the painter while it is active --------------------------
    const QPen& currentPen() const;
    const QBrush& currentBrush() const;
    const QBrush& currentBackground() const;
    QPainter::CompositionMode currentCompositionMode() const;
    const QFont& currentFont() const;
    QColor foreColor() const { return currentPen().color(); }
    void setPen(const QPen& pen);
    void setForeColor(const QColor& color);
    void setBrush(const QBrush& brush);
    void setBackground(const QBrush& brush);
    void setCompositionMode(QPainter::CompositionMode mode);
    void setFont(const QFont& font);

    // ---- Geometry and clip ------------------------------------------------------------
    // Resizes the port (image reallocated, offscreen content kept at the top-left).
    void setBounds(const QRect& rect);
    void setOrigin(int h, int v);
    // Visible region, intersected with the clip region when the clip is in force.
    void updateEffectiveClip();

    // Reports a rectangle (local coordinates) as touched; offscreen ports have no window
    // and ignore it.
    void markDirty(const QRect& localRect)
    {
        if (window)
            markWindowDirty(localRect);
    }

private:
    void init(const QRect& rect, SInt16 pixelDepth);
    void applyOrigin();
    void markWindowDirty(const QRect& localRect);
    bool allocateImage(const QSize& size);

    Private::QtGrafPortPrivate* d;
    friend struct Private::QtGrafPortPrivate;
};

// Scoped access to the current (or a given) port's painter. The destructor reports the
// dirty rectangle to the port's window; a null dirty rectangle reports the whole bounds.
class VELMAR_EXPORT MakeQPainter {
public:
    explicit MakeQPainter(const char* caller);
    MakeQPainter(GrafPtr port, const char* caller);
    ~MakeQPainter()
    {
        if (m_painter && m_port->window)
            report();
    }
    MakeQPainter(const MakeQPainter&) = delete;
    MakeQPainter& operator=(const MakeQPainter&) = delete;

    operator QPainter*() const { return m_painter; }
    QPainter* operator->() const { return m_painter; }
    bool operator!() const { return m_painter == nullptr; }
    MakeQPainter& operator|=(const QRect& r)
    {
        m_dirty |= r;
        return *this;
    }
    MakeQPainter& operator&=(const QRect& r)
    {
        m_dirty &= r;
        return *this;
    }
    GrafPtr port() const { return m_port; }
    const QRect& dirty() const { return m_dirty; }

private:
    void report();
    GrafPtr m_port;
    QPainter* m_painter;
    QRect m_dirty;
};

// Snapshots the current port's visible and clip regions and clip-in-force flag; writes
// them back into that port when it goes out of scope.
class VELMAR_EXPORT SavePortVisibleRegion {
public:
    SavePortVisibleRegion();
    ~SavePortVisibleRegion();
    SavePortVisibleRegion(const SavePortVisibleRegion& other);
    SavePortVisibleRegion& operator=(const SavePortVisibleRegion& other);

    RgnHandle visible() { return &m_visible; }
    RgnHandle clip() { return &m_clip; }

private:
    void lendRegions();

    GrafPtr m_port;
    QRegion m_visible;
    QRegion m_clip;
    UInt8 m_clipInForce;
};

// ---- Current port -------------------------------------------------------------------
VELMAR_EXPORT void GetPort(GrafPtr* port);
VELMAR_EXPORT void SetPort(GrafPtr port);
VELMAR_EXPORT bool IsValidPort(GrafPtr port);
VELMAR_EXPORT GrafPtr GetCurrentPort();
VELMAR_EXPORT void GetGWorld(GrafPtr* port, void** device);
VELMAR_EXPORT void SetGWorld(GrafPtr port, void* device);

// ---- Offscreen worlds -----------------------------------------------------------------
VELMAR_EXPORT SInt16 NewGWorld(GrafPtr* out, SInt16 depth, const Rect* bounds, void* colorTable,
                               void* device, UInt32 flags);
VELMAR_EXPORT SInt16 NewGWorldForPaintDevice(GrafPtr* out, SInt16 depth, const Rect* bounds,
                                             void* colorTable, void* device, UInt32 flags,
                                             QPaintDevice* paintDevice);
VELMAR_EXPORT UInt32 UpdateGWorld(GrafPtr* gw, SInt16 depth, const Rect* bounds, void* colorTable,
                                  void* device, UInt32 flags);
VELMAR_EXPORT void DisposeGWorld(GrafPtr offscreenGWorld);
VELMAR_EXPORT GrafPtr CreateNewPort();
VELMAR_EXPORT void DisposePort(GrafPtr port);
VELMAR_EXPORT QPaintDevice* GetGWorldPaintDevice(GrafPtr* port);
VELMAR_EXPORT PixMapPtr* GetPortPixMap(GrafPtr port);
VELMAR_EXPORT PixMapPtr* GetGWorldPixMap(GrafPtr port);
VELMAR_EXPORT const BitMapPtr& GetPortBitMapForCopyBits(GrafPtr port);

// ---- Bounds and origin ----------------------------------------------------------------
VELMAR_EXPORT Rect* GetPortBounds(GrafPtr port, Rect* rect);
VELMAR_EXPORT void SetPortBounds(GrafPtr port, const Rect* rect);
VELMAR_EXPORT void PortSize(SInt16 width, SInt16 height);
VELMAR_EXPORT void SetOrigin(SInt16 h, SInt16 v);

// ---- Colours as port state ------------------------------------------------------------
VELMAR_EXPORT RGBColor* GetPortBackColor(GrafPtr port, RGBColor* color);
VELMAR_EXPORT RGBColor* GetPortForeColor(GrafPtr port, RGBColor* color);
VELMAR_EXPORT RGBColor* GetPortHiliteColor(GrafPtr port, RGBColor* color);
VELMAR_EXPORT RGBColor* GetPortOpColor(GrafPtr port, RGBColor* color);
VELMAR_EXPORT void SetPortOpColor(GrafPtr port, const RGBColor* color);
VELMAR_EXPORT void GetBackColor(RGBColor* color);
VELMAR_EXPORT void GetForeColor(RGBColor* color);
VELMAR_EXPORT void RGBBackColor(const RGBColor* color);
VELMAR_EXPORT void RGBForeColor(const RGBColor* color);
VELMAR_EXPORT void OpColor(const RGBColor* color);
VELMAR_EXPORT void HiliteColor(const RGBColor* color);
VELMAR_EXPORT Point* GetPortPenLocation(GrafPtr port, Point* location);
VELMAR_EXPORT SInt16 GetPortPenMode(GrafPtr port);

// ---- Regions as port state -------------------------------------------------------------
VELMAR_EXPORT void SetPortVisibleRegion(GrafPtr port, RgnHandle region);
VELMAR_EXPORT void SetPortClipRegion(GrafPtr port, RgnHandle region);
VELMAR_EXPORT RgnHandle GetPortVisibleRegion(GrafPtr port, RgnHandle region);
VELMAR_EXPORT RgnHandle GetPortClipRegion(GrafPtr port, RgnHandle region);

// ---- Pixels, screen coordinates, flushing, scrolling ------------------------------------
VELMAR_EXPORT void SetCPixel(SInt16 h, SInt16 v, const RGBColor* color);
VELMAR_EXPORT void GetCPixel(SInt16 h, SInt16 v, RGBColor* color);
VELMAR_EXPORT void GlobalToLocal(Point* point);
VELMAR_EXPORT void LocalToGlobal(Point* point);
VELMAR_EXPORT Rect* QDLocalToGlobalRect(GrafPtr port, Rect* rect);
VELMAR_EXPORT Point* QDGlobalToLocalPoint(GrafPtr port, Point* point);
VELMAR_EXPORT void QDFlushPortBuffer(GrafPtr port, RgnHandle region);
VELMAR_EXPORT void ScrollRect(const Rect* r, SInt16 dh, SInt16 dv, RgnHandle updateRgn);

} // namespace Velmar
