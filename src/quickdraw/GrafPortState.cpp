// Colours, pen location and regions as stored port state.
#include <Velmar/Diagnostics.h>
#include <Velmar/QtGrafPort.h>

#include "quickdraw/GrafPortPrivate.h"

namespace Velmar {

using namespace Private;

namespace {

RGBColor* storeColor(const QColor& color, RGBColor* out)
{
    if (out)
        *out = RGBColor(color);
    return out;
}

bool checkPort(GrafPtr port, const char* function)
{
    if (port)
        return true;
    velmar_assert("port != NULL", __FILE__, __LINE__, function, "a port is required");
    return false;
}

// The colour setters of the current port: without a port they log `noPortWarning` (a fixed
// text); a null colour changes nothing.
template <typename Store>
void setCurrentPortColor(const RGBColor* color, const char* noPortWarning, Store store)
{
    QtGrafPort* port = gCurrentGrafPort;
    if (!port)
        warnNoPort(noPortWarning);
    else if (color)
        store(port, static_cast<QColor>(*color));
}

} // namespace

RGBColor* GetPortBackColor(GrafPtr port, RGBColor* color)
{
    return checkPort(port, __func__) ? storeColor(port->backColor, color) : color;
}

RGBColor* GetPortForeColor(GrafPtr port, RGBColor* color)
{
    return checkPort(port, __func__) ? storeColor(port->foreColor(), color) : color;
}

RGBColor* GetPortHiliteColor(GrafPtr port, RGBColor* color)
{
    return checkPort(port, __func__) ? storeColor(port->hiliteColor, color) : color;
}

RGBColor* GetPortOpColor(GrafPtr port, RGBColor* color)
{
    return checkPort(port, __func__) ? storeColor(port->opColor, color) : color;
}

void SetPortOpColor(GrafPtr port, const RGBColor* color)
{
    if (checkPort(port, __func__) && color)
        port->opColor = static_cast<QColor>(*color);
}

void GetBackColor(RGBColor* color)
{
    if (QtGrafPort* port = gCurrentGrafPort)
        storeColor(port->backColor, color);
    else
        warnNoPort("warning: GetBackColor: Can't get current port !");
}

void GetForeColor(RGBColor* color)
{
    if (QtGrafPort* port = gCurrentGrafPort)
        storeColor(port->foreColor(), color);
    else
        warnNoPort("warning: GetForeColor: Can't get current port!");
}

void RGBBackColor(const RGBColor* color)
{
    setCurrentPortColor(color, "warning: RGBBackColor: Can't get current port!",
                        [](QtGrafPort* port, const QColor& c) {
                            port->backColor = c;
                            port->inkChanged();
                        });
}

void RGBForeColor(const RGBColor* color)
{
    setCurrentPortColor(color, "warning: RGBForeColor: Can't get current port!",
                        [](QtGrafPort* port, const QColor& c) { port->setForeColor(c); });
}

void OpColor(const RGBColor* color)
{
    setCurrentPortColor(color, "OpColor: Can't get port",
                        [](QtGrafPort* port, const QColor& c) { port->opColor = c; });
}

void HiliteColor(const RGBColor* color)
{
    setCurrentPortColor(color, "warning: HiliteColor: Can't get current port!",
                        [](QtGrafPort* port, const QColor& c) { port->hiliteColor = c; });
}

Point* GetPortPenLocation(GrafPtr port, Point* location)
{
    if (!port) {
        warnNoPort("warning: GetPortPenLocation: cannot get Qt port");
        return nullptr;
    }
    if (location) {
        location->v = static_cast<SInt16>(port->penY);
        location->h = static_cast<SInt16>(port->penX);
    }
    return location;
}

SInt16 GetPortPenMode(GrafPtr port)
{
    if (!port) {
        warnNoPort("warning: GetPortPenMode: cannot get Qt port");
        return 0;
    }
    return port->penMode;
}

void SetPortVisibleRegion(GrafPtr port, RgnHandle region)
{
    if (!port || !region)
        return;
    port->visibleRegion = *region;
    port->updateEffectiveClip();
}

void SetPortClipRegion(GrafPtr port, RgnHandle region)
{
    if (!port) {
        velmar_assert("port", __FILE__, __LINE__, __func__, "SetPortClipRegion needs a port");
        return;
    }
    if (!region)
        return;
    port->clipRegion = *region;
    port->clipInForce = 1;
    port->updateEffectiveClip();
}

RgnHandle GetPortVisibleRegion(GrafPtr port, RgnHandle region)
{
    if (!port || !region)
        return region;
    const PortWindowHooks& hooks = portWindowHooks();
    if (port->window && hooks.visibleRegion && hooks.visibleRegion(port->window, region))
        return region;
    *region = QRegion(port->bounds);
    return region;
}

RgnHandle GetPortClipRegion(GrafPtr port, RgnHandle region)
{
    if (port && region)
        *region = port->clipRegion;
    return region;
}

} // namespace Velmar
