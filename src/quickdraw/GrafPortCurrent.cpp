// The current port, the registry of live ports and the window hooks.
#include <Velmar/Diagnostics.h>
#include <Velmar/QtGrafPort.h>

#include "host/Replaceable.h"
#include "quickdraw/GrafPortPrivate.h"

#include <algorithm>
#include <cstdio>

namespace Velmar {

namespace Private {

QtGrafPort* gCurrentGrafPort = nullptr;

namespace {

// Live ports in creation order; the live-handle registry answers the lookups.
std::vector<QtGrafPort*>& orderedPorts()
{
    static std::vector<QtGrafPort*> sOrdered;
    return sOrdered;
}

Replaceable<PortWindowHooks> gHooks;

} // namespace

void registerPort(QtGrafPort* port)
{
    orderedPorts().push_back(port);
    LiveHandles<QtGrafPort>::instance().add(port);
}

void unregisterPort(QtGrafPort* port)
{
    auto& ordered = orderedPorts();
    auto it = std::find(ordered.begin(), ordered.end(), port);
    if (it != ordered.end())
        ordered.erase(it);
    LiveHandles<QtGrafPort>::instance().remove(port);
}

const std::vector<QtGrafPort*>& livePorts()
{
    return orderedPorts();
}

bool checkPort(const QtGrafPort* port, const char* nullText, const char* file, int line,
               const char* function)
{
    if (port == gCurrentGrafPort && port)
        return true;
    if (!port) {
        if (nullText)
            velmar_assert(nullText, file, line, function, nullptr);
        return false;
    }
    if (isLivePort(port))
        return true;
    velmar_assert("IsValidPort(port)", file, line, function, nullptr);
    return false;
}

PortWindowHooks setPortWindowHooks(const PortWindowHooks& hooks)
{
    return gHooks.set(hooks);
}

const PortWindowHooks& portWindowHooks()
{
    return gHooks.get();
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
