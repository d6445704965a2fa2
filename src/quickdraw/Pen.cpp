// The pen: pattern, size, mode, visibility, style and the pen state record.
#include <Velmar/Diagnostics.h>
#include <Velmar/QuickDraw.h>

#include "quickdraw/PortPainter.h"
#include "quickdraw/CurrentPort.h"
#include "quickdraw/ShapeLog.h"

namespace Velmar {

using namespace Private;

namespace {

void applyPenMode(QtGrafPort* port, SInt16 mode)
{
    port->penMode = mode;
    portData(port)->inkChanged();
    port->setCompositionMode(compositionModeForPenMode(mode));
}

} // namespace

void PenPat(const PatPtr& pattern)
{
    CurrentPort port("PenPat");
    if (port && pattern.brush())
        port->setBrush(*pattern.brush());
}

void BackPat(const PatPtr& pattern)
{
    CurrentPort port("BackPat");
    if (port && pattern.brush())
        port->setBackground(*pattern.brush());
}

void PenSize(SInt16 width, SInt16 height)
{
    CurrentPort port("PenSize");
    if (!port)
        return;
    const QPen& current = port->currentPen();
    if (width == 0 || height == 0) {
        if (current.style() == Qt::NoPen)
            return;
        QPen pen = current;
        pen.setStyle(Qt::NoPen);
        port->setPen(pen);
        return;
    }
    // Only the width: a pen hidden by a zero size stays hidden.
    if (current.widthF() == width)
        return;
    QPen pen = current;
    pen.setWidth(width);
    port->setPen(pen);
}

void PenMode(SInt16 mode)
{
    CurrentPort port("PenMode");
    if (port)
        applyPenMode(port, mode);
}

void PenNormal()
{
    CurrentPort port("PenNormal");
    if (!port)
        return;
    applyPenMode(port, patCopy);
    port->setBrush(QBrush(Qt::black));
    port->setPen(QPen(QBrush(port->foreColor()), 1.0, Qt::SolidLine, Qt::SquareCap,
                      Qt::BevelJoin));
}

void HidePen()
{
    CurrentPort port("HidePen");
    if (!port)
        return;
    if (port->penVisibility-- == 0) {
        portData(port)->savedPen = port->currentPen();
        QPen hidden = portData(port)->savedPen;
        hidden.setStyle(Qt::NoPen); // keeps the colour: it is the foreground colour
        port->setPen(hidden);
    }
}

void ShowPen()
{
    CurrentPort port("ShowPen");
    if (!port)
        return;
    if (++port->penVisibility == 0) {
        QPen restored = portData(port)->savedPen;
        // A colour set while hidden stays.
        restored.setColor(port->foreColor());
        port->setPen(restored);
    }
}

void GetPen(Point* location)
{
    CurrentPort port("GetPen");
    if (!port || !location)
        return;
    location->v = static_cast<SInt16>(port->penY);
    location->h = static_cast<SInt16>(port->penX);
}

void SetPenStyle(int style)
{
    CurrentPort port("SetPenStyle");
    if (!port)
        return;
    QPen pen = port->currentPen();
    pen.setStyle(static_cast<Qt::PenStyle>(style));
    port->setPen(pen);
}

int GetPenStyle()
{
    CurrentPort port("GetPenStyle");
    return port ? static_cast<int>(port->currentPen().style()) : static_cast<int>(Qt::SolidLine);
}

void GetPenState(PenState* state)
{
    CurrentPort port("GetPenState");
    if (!port || !state)
        return;
    state->setPenLocation(QPoint(port->penX, port->penY));
    state->setPenMode(port->penMode);
    state->setPenSize(port->currentPen().width());
    state->setPenPattern(port->currentBrush());
}

void SetPenState(const PenState* state)
{
    CurrentPort port("SetPenState");
    if (!port || !state)
        return;
    port->penX = state->penLocation().x();
    port->penY = state->penLocation().y();
    applyPenMode(port, state->penMode());
    QPen pen = port->currentPen();
    pen.setWidth(state->penSize());
    port->setPen(pen);
    port->setBrush(state->penPattern());
}

// ---- PenState ------------------------------------------------------------------------------

PenState::PenState() : m_location(new QPoint(0, 0)), m_size(0), m_mode(0), m_pattern(new QBrush)
{
}

PenState::PenState(const QPoint& location, int size, SInt16 mode, const QBrush& pattern)
    : m_location(new QPoint(location)), m_size(size), m_mode(mode), m_pattern(new QBrush(pattern))
{
}

PenState::PenState(const PenState& other)
    : m_location(new QPoint(*other.m_location)),
      m_size(other.m_size),
      m_mode(other.m_mode),
      m_pattern(new QBrush(*other.m_pattern))
{
}

PenState& PenState::operator=(const PenState& other)
{
    *m_location = *other.m_location;
    m_size = other.m_size;
    m_mode = other.m_mode;
    *m_pattern = *other.m_pattern;
    return *this;
}

PenState::~PenState()
{
    delete m_location;
    delete m_pattern;
}

} // namespace Velmar
