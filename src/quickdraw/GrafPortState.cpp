// Colours, pen location and regions as stored port state.
#include <Velmar/Diagnostics.h>
#include <Velmar/QtGrafPort.h>

#include "quickdraw/CurrentPort.h"
#include "quickdraw/GrafPortPrivate.h"
#include "quickdraw/RegionHandles.h"

namespace Velmar {

using namespace Private;

namespace {

RGBColor* storeColor(const QColor& color, RGBColor* out)
{
    if (out)
        *out = RGBColor(color);
    return out;
}

// The colour setters of the current port: without a port they log the call's warning; a null
// colour changes nothing.
template <typename Store>
void setCurrentPortColor(const char* call, const RGBColor* color, Store store)
{
    CurrentPort port(call);
    if (port && color)
        store(port, static_cast<QColor>(*color));
}

} // namespace

RGBColor* GetPortBackColor(GrafPtr port, RGBColor* color)
{
    return VELMAR_CHECK_PORT(port, "port != NULL") ? storeColor(port->backColor, color) : color;
}

RGBColor* GetPortForeColor(GrafPtr port, RGBColor* color)
{
    return VELMAR_CHECK_PORT(port, "port != NULL") ? storeColor(port->foreColor(), color) : color;
}

RGBColor* GetPortHiliteColor(GrafPtr port, RGBColor* color)
{
    return VELMAR_CHECK_PORT(port, "port != NULL") ? storeColor(port->hiliteColor, color) : color;
}

RGBColor* GetPortOpColor(GrafPtr port, RGBColor* color)
{
    return VELMAR_CHECK_PORT(port, "port != NULL") ? storeColor(port->opColor, color) : color;
}

void SetPortOpColor(GrafPtr port, const RGBColor* color)
{
    if (VELMAR_CHECK_PORT(port, "port != NULL") && color)
        port->opColor = static_cast<QColor>(*color);
}

void GetBackColor(RGBColor* color)
{
    if (CurrentPort port("GetBackColor"); port)
        storeColor(port->backColor, color);
}

void GetForeColor(RGBColor* color)
{
    if (CurrentPort port("GetForeColor"); port)
        storeColor(port->foreColor(), color);
}

void RGBBackColor(const RGBColor* color)
{
    setCurrentPortColor("RGBBackColor", color, [](QtGrafPort* port, const QColor& c) {
        port->backColor = c;
        portData(port)->inkChanged();
    });
}

void RGBForeColor(const RGBColor* color)
{
    setCurrentPortColor("RGBForeColor", color,
                        [](QtGrafPort* port, const QColor& c) { port->setForeColor(c); });
}

void OpColor(const RGBColor* color)
{
    setCurrentPortColor("OpColor", color,
                        [](QtGrafPort* port, const QColor& c) { port->opColor = c; });
}

void HiliteColor(const RGBColor* color)
{
    setCurrentPortColor("HiliteColor", color,
                        [](QtGrafPort* port, const QColor& c) { port->hiliteColor = c; });
}

Point* GetPortPenLocation(GrafPtr port, Point* location)
{
    if (!port) {
        warnNoCurrentPort("GetPortPenLocation");
        return nullptr;
    }
    if (!VELMAR_CHECK_PORT(port, nullptr))
        return nullptr;
    if (location) {
        location->v = static_cast<SInt16>(port->penY);
        location->h = static_cast<SInt16>(port->penX);
    }
    return location;
}

SInt16 GetPortPenMode(GrafPtr port)
{
    if (!port) {
        warnNoCurrentPort("GetPortPenMode");
        return 0;
    }
    return VELMAR_CHECK_PORT(port, nullptr) ? port->penMode : SInt16(0);
}

namespace Private {

void setPortClip(QtGrafPort* port, const QRegion& region)
{
    port->clipRegion = region;
    port->clipInForce = 1;
    port->updateEffectiveClip();
}

} // namespace Private

void SetPortVisibleRegion(GrafPtr port, RgnHandle region)
{
    if (!VELMAR_CHECK_PORT(port, nullptr) || !VELMAR_CHECK_REGION(region))
        return;
    port->visibleRegion = *region;
    port->updateEffectiveClip();
}

void SetPortClipRegion(GrafPtr port, RgnHandle region)
{
    if (VELMAR_CHECK_PORT(port, "port") && VELMAR_CHECK_REGION(region))
        setPortClip(port, *region);
}

RgnHandle GetPortVisibleRegion(GrafPtr port, RgnHandle region)
{
    if (!VELMAR_CHECK_PORT(port, nullptr) || !VELMAR_CHECK_REGION(region))
        return region;
    const PortWindowHooks& hooks = portWindowHooks();
    if (port->window && hooks.visibleRegion && hooks.visibleRegion(port->window, region))
        return region;
    *region = QRegion(port->bounds);
    return region;
}

RgnHandle GetPortClipRegion(GrafPtr port, RgnHandle region)
{
    if (VELMAR_CHECK_PORT(port, nullptr) && VELMAR_CHECK_REGION(region))
        *region = port->clipRegion;
    return region;
}

} // namespace Velmar
