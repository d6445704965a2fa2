// The port object: creation, destruction, the lazily started painter, bounds and origin.
#include <Velmar/Diagnostics.h>
#include <Velmar/QDShapes.h>
#include <Velmar/QtGrafPort.h>

#include "quickdraw/GrafPortPrivate.h"

#include <QImage>

#include <algorithm>

namespace Velmar {

using namespace Private;

namespace {

// Ports with an active painter, oldest first.
std::vector<QtGrafPort*>& activePorts()
{
    static std::vector<QtGrafPort*> sActive;
    return sActive;
}

const QRect kWideOpenClip(-32767, -32767, 65534, 65534);

} // namespace

namespace Private {

int activePainterCount()
{
    return static_cast<int>(activePorts().size());
}

bool isPainterListed(const QtGrafPort* port)
{
    const auto& list = activePorts();
    return std::find(list.begin(), list.end(), port) != list.end();
}

} // namespace Private

// ---- PainterState -----------------------------------------------------------------------

PainterState::PainterState()
    : pen(QBrush(Qt::black), 1.0, Qt::SolidLine, Qt::SquareCap, Qt::BevelJoin),
      brush(Qt::black),
      background(Qt::white)
{
    // Whole-pixel advances, as the Toolbox and Windows measure text.
    font.setHintingPreference(QFont::PreferFullHinting);
}

void PainterState::saveFrom(const QPainter& painter)
{
    pen = painter.pen();
    font = painter.font();
    brush = painter.brush();
    background = painter.background();
    compositionMode = painter.compositionMode();
}

void PainterState::applyTo(QPainter& painter) const
{
    painter.setPen(pen);
    painter.setFont(font);
    painter.setBrush(brush);
    painter.setBackground(background);
    painter.setCompositionMode(compositionMode);
    // The clip is in local coordinates, so the transform goes first.
    painter.setTransform(transform);
    if (clipEnabled)
        painter.setClipRegion(clip);
    else
        painter.setClipping(false);
}

// ---- Construction and destruction ---------------------------------------------------------

QtGrafPort::QtGrafPort(const QRect& requested, SInt16 pixelDepth) : d(new QtGrafPortPrivate)
{
    QRect rect = requested;
    if (rect.width() < 1)
        rect.setWidth(1);
    if (rect.height() < 1)
        rect.setHeight(1);
    allocateImage(rect.size());
    init(rect, pixelDepth);
}

QtGrafPort::QtGrafPort(AQtWindow* owner, const QRect& widgetRect, QImage* backBuffer)
    : window(owner), d(new QtGrafPortPrivate)
{
    d->image.reset(backBuffer);
    init(widgetRect, 6);
}

void QtGrafPort::init(const QRect& rect, SInt16 pixelDepth)
{
    hiliteColor = globalHiliteColor();
    opColor = QColor(Qt::black);
    backColor = QColor(Qt::white);
    contentColor = QColor(Qt::white);
    penX = rect.left();
    penY = rect.top();
    painter = new QPainter;
    visibleRegion = QRegion(rect);
    clipRegion = QRegion(kWideOpenClip);
    bounds = rect;
    pixmap = PixMapPtr::createPixMap(d->image.get(), this, pixelDepth ? pixelDepth : 6);
    pixmap->clear();
    registerPort(this);
    applyOrigin();
}

QtGrafPort::~QtGrafPort()
{
    EndPaint();
    if (gCurrentGrafPort == this) {
        const PortWindowHooks& hooks = portWindowHooks();
        QtGrafPort* next = hooks.frontVisiblePortExcept ? hooks.frontVisiblePortExcept(window)
                                                        : nullptr;
        gCurrentGrafPort = (next && next != this && isLivePort(next)) ? next : nullptr;
    }
    magic = kDeadMagic;
    unregisterPort(this);
    // A region being recorded owns its scratch polygon; an open polygon belongs to its caller.
    if (definingRgn && polySave)
        KillPoly(polySave);
    polySave = nullptr;
    delete rgnSave;
    rgnSave = nullptr;
    delete painter;
    painter = nullptr;
    PixMapPtr::destroyPixMap(pixmap);
    pixmap = nullptr;
    delete d;
    d = nullptr;
}

bool QtGrafPort::allocateImage(const QSize& size)
{
    std::unique_ptr<QImage>& buffer = d->image;
    buffer.reset();
    const qint64 pixels = qint64(size.width()) * size.height();
    if (pixels > kMaxPortPixels) {
        qWarning("QtGrafPort: a %dx%d image is too large; port %p keeps its bounds but has "
                 "no pixels",
                 size.width(), size.height(), static_cast<void*>(this));
    } else {
        auto image = std::make_unique<QImage>(size, QImage::Format_ARGB32_Premultiplied);
        if (image->isNull())
            qWarning("QtGrafPort: cannot allocate a %dx%d image for port %p", size.width(),
                     size.height(), static_cast<void*>(this));
        else
            buffer = std::move(image);
    }
    if (pixmap)
        pixmap->m_image = buffer.get();
    return buffer != nullptr;
}

// ---- Painter ----------------------------------------------------------------------------

bool QtGrafPort::isActive() const
{
    return d->painterActive;
}

QImage* QtGrafPort::image() const
{
    return d->image.get();
}

void QtGrafPort::BeginPaint()
{
    if (!VELMAR_ASSERT(painter && !d->painterActive, "this && m_painter && !isActive()"))
        return;
    QPaintDevice* target = paintDevice ? paintDevice : static_cast<QPaintDevice*>(d->image.get());
    if (!target) {
        VelmarLog(kLogGrafPort, "Outside of PaintEvent: BeginPaint");
        return;
    }
    if (!paintDevice && !d->image->paintEngine())
        VelmarLog(kLogGrafPort, "Something bad happens. paintEngine is NULL, qtPort=%p",
                  static_cast<void*>(this));
    if (!painter->begin(target))
        return;
    painterState.applyTo(*painter);
    d->painterActive = true;
    d->inkChanged();

    auto& active = activePorts();
    active.push_back(this);
    // Open painters hold native resources; keep at most kMaxActivePainters of them.
    while (active.size() > std::size_t(kMaxActivePainters))
        active.front()->EndPaint();
}

void QtGrafPort::EndPaint()
{
    if (d->painterActive) {
        d->inkChanged();
        painterState.saveFrom(*painter);
        painter->end();
        d->painterActive = false;
    }
    auto& active = activePorts();
    auto it = std::find(active.begin(), active.end(), this);
    if (it != active.end())
        active.erase(it);
}

// ---- State that lives in the painter while it is active ------------------------------------

namespace {

// While the painter is active it holds the state; otherwise `saved` keeps it for BeginPaint.
template <typename Value, typename Setter>
void holdState(QPainter* painter, bool active, Setter set, Value& saved, const Value& value)
{
    if (active)
        (painter->*set)(value);
    else
        saved = value;
}

} // namespace

const QPen& QtGrafPort::currentPen() const
{
    return d->painterActive ? painter->pen() : painterState.pen;
}

const QBrush& QtGrafPort::currentBrush() const
{
    return d->painterActive ? painter->brush() : painterState.brush;
}

const QBrush& QtGrafPort::currentBackground() const
{
    return d->painterActive ? painter->background() : painterState.background;
}

QPainter::CompositionMode QtGrafPort::currentCompositionMode() const
{
    return d->painterActive ? painter->compositionMode() : painterState.compositionMode;
}

const QFont& QtGrafPort::currentFont() const
{
    return d->painterActive ? painter->font() : painterState.font;
}

void QtGrafPort::setPen(const QPen& pen)
{
    d->inkChanged();
    holdState(painter, d->painterActive, qOverload<const QPen&>(&QPainter::setPen),
              painterState.pen, pen);
}

void QtGrafPort::setForeColor(const QColor& color)
{
    if (!d->painterActive) {
        d->inkChanged();
        painterState.pen.setColor(color);
        return;
    }
    const QPen& current = painter->pen();
    if (current.color() == color)
        return;
    d->inkChanged();
    const bool back = d->penBeforeColour.color() == color && d->penAfterColour == current;
    QPen next = back ? std::move(d->penBeforeColour) : current;
    if (!back)
        next.setColor(color);
    d->penBeforeColour = current;
    painter->setPen(next);
    d->penAfterColour = std::move(next);
}

void QtGrafPort::setBrush(const QBrush& brush)
{
    d->inkChanged();
    holdState(painter, d->painterActive, qOverload<const QBrush&>(&QPainter::setBrush),
              painterState.brush, brush);
}

void QtGrafPort::setBackground(const QBrush& brush)
{
    d->inkChanged();
    holdState(painter, d->painterActive, &QPainter::setBackground, painterState.background,
              brush);
}

void QtGrafPort::setCompositionMode(QPainter::CompositionMode mode)
{
    d->inkChanged();
    holdState(painter, d->painterActive, &QPainter::setCompositionMode,
              painterState.compositionMode, mode);
}

void QtGrafPort::setFont(const QFont& font)
{
    holdState(painter, d->painterActive, &QPainter::setFont, painterState.font, font);
}

// ---- Geometry and clip ----------------------------------------------------------------------

void QtGrafPort::setBounds(const QRect& requested)
{
    std::unique_ptr<QImage>& buffer = d->image;
    if (buffer && buffer->size() == requested.size()) {
        visibleRegion.translate(requested.topLeft() - bounds.topLeft());
        bounds = requested;
        applyOrigin();
        return;
    }
    const bool wasActive = d->painterActive;
    if (wasActive)
        EndPaint();

    QRect rect = requested;
    if (rect.width() < 1) {
        VelmarLog(kLogGrafPort, "Trying to SetBounds with negative width, port=%p",
                  static_cast<void*>(this));
        rect.setWidth(1);
    }
    if (rect.height() < 1) {
        VelmarLog(kLogGrafPort, "Trying to SetBounds with negative height, port=%p",
                  static_cast<void*>(this));
        rect.setHeight(1);
    }

    if (window) {
        // A window's buffer is repainted by the window: the old content is not kept.
        if (buffer) {
            const PortWindowHooks& hooks = portWindowHooks();
            QImage* fresh = hooks.makeBackBuffer ? hooks.makeBackBuffer(window, rect.size())
                                                 : nullptr;
            if (fresh) {
                buffer.reset(fresh);
                pixmap->m_image = fresh;
            } else {
                allocateImage(rect.size());
            }
            pixmap->clear();
        }
    } else {
        std::unique_ptr<QImage> old = std::move(buffer);
        if (allocateImage(rect.size())) {
            pixmap->clear();
            if (old) {
                QPainter copier(buffer.get());
                copier.setCompositionMode(QPainter::CompositionMode_Source);
                copier.drawImage(0, 0, *old);
            }
        }
    }
    // Drawing reaches the whole new area.
    visibleRegion = QRegion(rect);

    if (wasActive) {
        BeginPaint();
        if (!d->painterActive)
            VelmarLog(kLogGrafPort, "Unable to start painter, grafPort: %p",
                      static_cast<void*>(this));
    }
    bounds = rect;
    applyOrigin();
}

void QtGrafPort::setOrigin(int h, int v)
{
    const QPoint delta = QPoint(h, v) - bounds.topLeft();
    bounds.moveTopLeft(QPoint(h, v));
    // The visible area is the same pixels, now under new local coordinates.
    visibleRegion.translate(delta);
    applyOrigin();
}

void QtGrafPort::applyOrigin()
{
    painterState.transform = QTransform::fromTranslate(-bounds.left(), -bounds.top());
    if (d->painterActive)
        painter->setTransform(painterState.transform);
    updateEffectiveClip();
}

void QtGrafPort::updateEffectiveClip()
{
    QRegion effective = visibleRegion;
    if (clipInForce)
        effective &= clipRegion;
    painterState.clip = effective;
    // Clipping costs on every fill; skip it when the clip covers the whole port.
    const bool coversPort = effective.rectCount() == 1 && effective.boundingRect().contains(bounds);
    painterState.clipEnabled = !coversPort;
    if (d->painterActive) {
        if (painterState.clipEnabled)
            painter->setClipRegion(effective);
        else
            painter->setClipping(false);
    }
}

void QtGrafPort::markWindowDirty(const QRect& localRect)
{
    const PortWindowHooks& hooks = portWindowHooks();
    if (hooks.markDirty)
        hooks.markDirty(window, localRect.translated(-bounds.topLeft()));
}

} // namespace Velmar
