// Obtaining a port's painter, the scoped painter accessor and the visible-region saver.
#include <Velmar/Diagnostics.h>
#include <Velmar/QtGrafPort.h>

#include "quickdraw/CurrentPort.h"
#include "quickdraw/PortPainter.h"
#include "quickdraw/RegionHandles.h"

namespace Velmar {

namespace Private {

QPainter* startPortPainter(QtGrafPort* port, const char* caller)
{
    if (!port) {
        warnNoCurrentPort(caller);
        return nullptr;
    }
    if (painterRuns(port))
        return port->painter;
    const PortWindowHooks& hooks = portWindowHooks();
    if (port->window && hooks.isDirectDrawing && hooks.isDirectDrawing(port->window)) {
        VelmarLog(kLogQuickDraw, "Outside of PaintEvent: %s", caller ? caller : "");
        return nullptr;
    }
    port->BeginPaint();
    return painterRuns(port) ? port->painter : nullptr;
}

} // namespace Private

using namespace Private;

MakeQPainter::MakeQPainter(const char* caller)
    : m_port(gCurrentGrafPort), m_painter(portPainter(gCurrentGrafPort, caller))
{
}

// A port given explicitly may be stale: it is checked before anything reads it.
MakeQPainter::MakeQPainter(GrafPtr port, const char* caller)
    : m_port(port), m_painter(nullptr)
{
    if (!port || VELMAR_CHECK_PORT(port, nullptr))
        m_painter = portPainter(port, caller);
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
    lendRegions();
}

SavePortVisibleRegion::SavePortVisibleRegion(const SavePortVisibleRegion& other)
    : m_port(other.m_port), m_visible(other.m_visible), m_clip(other.m_clip),
      m_clipInForce(other.m_clipInForce)
{
    lendRegions();
}

SavePortVisibleRegion& SavePortVisibleRegion::operator=(const SavePortVisibleRegion& other)
{
    m_port = other.m_port;
    m_visible = other.m_visible;
    m_clip = other.m_clip;
    m_clipInForce = other.m_clipInForce;
    return *this;
}

SavePortVisibleRegion::~SavePortVisibleRegion()
{
    unregisterRegion(&m_visible);
    unregisterRegion(&m_clip);
    if (!isLivePort(m_port))
        return;
    m_port->visibleRegion = m_visible;
    m_port->clipRegion = m_clip;
    m_port->clipInForce = m_clipInForce;
    m_port->updateEffectiveClip();
}

// The saved regions are handed to the host as region handles, so they count as live.
void SavePortVisibleRegion::lendRegions()
{
    registerRegion(&m_visible);
    registerRegion(&m_clip);
}

} // namespace Velmar
