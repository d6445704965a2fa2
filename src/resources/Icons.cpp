// The icon objects: their fields, preparation for drawing (opacity) and drawing centred
// into the current port.
#include <Velmar/QDIcons.h>
#include <Velmar/QtGrafPort.h>

#include "foundation/Conversions.h"
#include "foundation/LiveHandles.h"

#include <QPainter>

#include <cmath>

namespace Velmar {

using namespace Private;

namespace {

// What the skinning library's colours default to: black and one step below white.
const RGBColor kRGBBlack(0, 0, 0);
const RGBColor kRGBAlmostWhite(0xFFFE, 0xFFFE, 0xFFFE);

// The image with its alpha scaled by floor(opacity * 256): 256, not 255, is the factor the
// host's artwork was tuned against.
QImage withOpacity(const QImage& image, float opacity)
{
    QImage out(image.size(), QImage::Format_ARGB32_Premultiplied);
    QPainter painter(&out);
    painter.setCompositionMode(QPainter::CompositionMode_Source);
    painter.drawImage(0, 0, image);
    const int alpha = std::min(255, int(std::floor(double(opacity) * 256.0)));
    painter.setCompositionMode(QPainter::CompositionMode_DestinationIn);
    painter.fillRect(out.rect(), QColor(0, 0, 0, alpha));
    return out;
}

} // namespace

AbstractIcon::AbstractIcon(const QImage& image, bool hasPartialAlpha, SInt32 id)
    : m_image(image), m_hasPartialAlpha(hasPartialAlpha), m_id(id)
{
    LiveHandles<AbstractIcon>::instance().add(this);
}

AbstractIcon::~AbstractIcon()
{
    LiveHandles<AbstractIcon>::instance().remove(this);
}

void AbstractIcon::copyTo(AbstractIcon* other) const
{
    if (!other || other == this)
        return;
    other->m_image = m_image;
    other->m_hasPartialAlpha = m_hasPartialAlpha;
    other->m_prepared = m_prepared;
    other->m_transform = m_transform;
    other->m_opacity = m_opacity;
    other->m_skinIndex = m_skinIndex;
    other->m_skinFlag = m_skinFlag;
    other->m_firstColor = m_firstColor;
    other->m_secondColor = m_secondColor;
    other->m_id = m_id;
}

QImage AbstractIcon::image() const
{
    return m_image;
}

// There is no skinning library here, so the skin index, flag and colours are remembered but
// never decide whether the prepared image can be reused.
QImage AbstractIcon::prepare(SInt32 transform, float opacity, bool skinFlag,
    const RGBColor* firstColor, const RGBColor* secondColor)
{
    if (opacity > 1.0f)
        opacity = 1.0f;
    else if (!(opacity > 0.0f))
        opacity = 0.0f;
    if (transform == m_transform && opacity == m_opacity && !m_prepared.isNull())
        return m_prepared;
    m_transform = transform;
    m_opacity = opacity;
    m_skinFlag = skinFlag;
    m_firstColor = firstColor ? *firstColor : kRGBBlack;
    m_secondColor = secondColor ? *secondColor : kRGBAlmostWhite;
    m_prepared = (opacity == 1.0f || m_image.isNull()) ? m_image : withOpacity(m_image, opacity);
    return m_prepared;
}

void AbstractIcon::Draw(
    const QRect& target, SInt32 transform, float opacity, const RGBColor* ink, const char* caller)
{
    const QImage prepared = prepare(transform, opacity, false, ink, nullptr);
    if (prepared.isNull())
        return;
    MakeQPainter painter(caller);
    if (!painter)
        return;
    const QImage drawn = colorize(prepared, ink ? toQColor(*ink) : painter.port()->foreColor());
    QRect placed = drawn.rect();
    placed.moveCenter(target.center());
    // Icons keep their own transparency whatever the pen mode.
    const QPainter::CompositionMode mode = painter->compositionMode();
    if (mode == QPainter::CompositionMode_SourceOver) {
        painter->drawImage(placed.topLeft(), drawn);
    } else {
        painter->setCompositionMode(QPainter::CompositionMode_SourceOver);
        painter->drawImage(placed.topLeft(), drawn);
        painter->setCompositionMode(mode);
    }
    painter |= placed;
}

QImage AbstractIcon::colorize(const QImage& source, const QColor& ink) const
{
    QImage out;
    transferImage(out, source, ink);
    return out;
}

ColorIcon::ColorIcon(const QImage& image, bool hasPartialAlpha, SInt32 id)
    : AbstractIcon(image, hasPartialAlpha, id)
{}

AbstractIcon* ColorIcon::clone() const
{
    auto* copy = new ColorIcon(m_image, m_hasPartialAlpha, m_id);
    copyTo(copy);
    return copy;
}

void ColorIcon::transferImage(QImage& target, const QImage& source, const QColor&) const
{
    target = source;
}

MonochromeIcon::MonochromeIcon(const QImage& image, bool hasPartialAlpha, SInt32 id)
    : AbstractIcon(image, hasPartialAlpha, id)
{}

AbstractIcon* MonochromeIcon::clone() const
{
    auto* copy = new MonochromeIcon(m_image, m_hasPartialAlpha, m_id);
    copyTo(copy);
    return copy;
}

// Ink everywhere, then kept only where the icon is: DestinationAtop takes the icon's alpha
// and the ink's colour.
void MonochromeIcon::transferImage(QImage& target, const QImage& source, const QColor& ink) const
{
    target = QImage(source.size(), QImage::Format_ARGB32_Premultiplied);
    target.fill(ink);
    QPainter painter(&target);
    painter.setCompositionMode(QPainter::CompositionMode_DestinationAtop);
    painter.drawImage(0, 0, source);
}

NullIcon::NullIcon() : AbstractIcon(QImage(), true, -1)
{}

AbstractIcon* NullIcon::clone() const
{
    auto* copy = new NullIcon;
    copyTo(copy);
    return copy;
}

void NullIcon::transferImage(QImage& target, const QImage&, const QColor&) const
{
    target = QImage();
}

} // namespace Velmar
