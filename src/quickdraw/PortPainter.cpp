// Obtaining a port's painter, the scoped painter accessor and the visible-region saver.
#include <Velmar/Diagnostics.h>
#include <Velmar/QtGrafPort.h>

#include "quickdraw/PortPainter.h"

namespace Velmar {

namespace Private {

QPainter* startPortPainter(QtGrafPort* port, const char* caller)
{
    if (!port) {
        VelmarLog(kLogQuickDraw, "warning: %s: Can't get current port!", caller ? caller : "");
        return nullptr;
    }
    if (port->isActive())
        return port->painter;
    const PortWindowHooks& hooks = portWindowHooks();
    if (port->window && hooks.isDirectDrawing && hooks.isDirectDrawing(port->window)) {
        VelmarLog(kLogQuickDraw, "Outside of PaintEvent: %s", caller ? caller : "");
        return nullptr;
    }
    port->BeginPaint();
    return port->isActive() ? port->painter : nullptr;
}

} // namespace Private

using namespace Private;

MakeQPainter::MakeQPainter(const char* caller)
    : m_port(gCurrentGrafPort), m_painter(portPainter(gCurrentGrafPort, caller))
{
}

MakeQPainter::MakeQPainter(GrafPtr port, const char* caller)
    : m_port(port), m_painter(portPainter(port, caller))
{
}

void MakeQPainter::report()
{
    m_port->markDirty(m_dirty.isNull() ? m_port->bounds : m_dirty);
}

SavePortVisibleRegion::SavePortVisibleRegion()
    : m_port(gCurrentGrafPort), m_clipInForce(0)
{
    if (m_port) {
        m_visible = m_port->visibleRegion;
        m_clip = m_port->clipRegion;
        m_clipInForce = m_port->clipInForce;
    }
}

SavePortVisibleRegion::~SavePortVisibleRegion()
{
    if (!isLivePort(m_port))
        return;
    m_port->visibleRegion = m_visible;
    m_port->clipRegion = m_clip;
    m_port->clipInForce = m_clipInForce;
    m_port->updateEffectiveClip();
}

} // namespace Velmar
