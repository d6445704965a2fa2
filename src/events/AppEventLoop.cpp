#include "events/AppEventLoop.h"

#include <Velmar/CarbonEventHandlers.h>

#include <QCoreApplication>

namespace Velmar {

namespace {

Private::ApplicationLoopProbe gApplicationLoopProbe = nullptr;

} // namespace

Private::ApplicationLoopProbe Private::SetApplicationLoopProbe(ApplicationLoopProbe probe)
{
    ApplicationLoopProbe old = gApplicationLoopProbe;
    gApplicationLoopProbe = probe;
    return old;
}

void QuitApplicationEventLoop()
{
    QCoreApplication::exit(0);
}

bool InApplicationEventLoop()
{
    return gApplicationLoopProbe && gApplicationLoopProbe();
}

} // namespace Velmar
