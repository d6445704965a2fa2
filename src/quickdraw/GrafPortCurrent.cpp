// The current port, the registry of live ports and the window hooks.
#include <Velmar/Diagnostics.h>
#include <Velmar/QtGrafPort.h>

#include "quickdraw/GrafPortPrivate.h"

#include <algorithm>
#include <cstdio>
#include <unordered_set>

namespace Velmar {

namespace Private {

QtGrafPort* gCurrentGrafPort = nullptr;

namespace {

struct PortRegistry {
    std::vector<QtGrafPort*> ordered;
    std::unordered_set<const QtGrafPort*> lookup;
};

PortRegistry& registry()
{
    static PortRegistry sRegistry;
    return sRegistry;
}

PortWindowHooks gHooks;

} // namespace

bool isLivePort(const QtGrafPort* port)
{
    if (!port)
        return false;
    const auto& lookup = registry().lookup;
    return lookup.find(port) != lookup.end() && port->magic == QtGrafPort::kLiveMagic;
}

void registerPort(QtGrafPort* port)
{
    registry().ordered.push_back(port);
    registry().lookup.insert(port);
}

void unregisterPort(QtGrafPort* port)
{
    auto& ordered = registry().ordered;
    auto it = std::find(ordered.begin(), ordered.end(), port);
    if (it != ordered.end())
        ordered.erase(it);
    registry().lookup.erase(port);
}

const std::vector<QtGrafPort*>& livePorts()
{
    return registry().ordered;
}

void setPortWindowHooks(const PortWindowHooks& hooks)
{
    gHooks = hooks;
}

const PortWindowHooks& portWindowHooks()
{
    return gHooks;
}

void warnNoPort(const char* message)
{
    VelmarLog(kLogQuickDraw, "%s", message);
}

} // namespace Private

using namespace Private;

void GetPort(GrafPtr* port)
{
    if (port)
        *port = gCurrentGrafPort;
}

void SetPort(GrafPtr port)
{
    if (port == gCurrentGrafPort)
        return;
    if (port && !isLivePort(port)) {
        qWarning("Velmar::SetPort(%p) reset invalid GrafPort!", static_cast<void*>(port));
        gCurrentGrafPort = nullptr;
        return;
    }
    gCurrentGrafPort = port;
}

bool IsValidPort(GrafPtr port)
{
    return isLivePort(port);
}

GrafPtr GetCurrentPort()
{
    return gCurrentGrafPort;
}

void GetGWorld(GrafPtr* port, void** device)
{
    GetPort(port);
    if (device)
        *device = nullptr;
}

void SetGWorld(GrafPtr port, void* /*device*/)
{
    SetPort(port);
}

} // namespace Velmar
