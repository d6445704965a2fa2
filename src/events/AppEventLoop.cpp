#include "events/AppEventLoop.h"

#include "host/Replaceable.h"

#include <Velmar/CarbonEventHandlers.h>

#include <QCoreApplication>

namespace Velmar {

namespace {

Private::Replaceable<Private::ApplicationLoopProbe> gApplicationLoopProbe(nullptr);

} // namespace

Private::ApplicationLoopProbe Private::SetApplicationLoopProbe(ApplicationLoopProbe probe)
{
    return gApplicationLoopProbe.set(probe);
}

void QuitApplicationEventLoop()
{
    QCoreApplication::exit(0);
}

bool InApplicationEventLoop()
{
    const Private::ApplicationLoopProbe probe = gApplicationLoopProbe.get();
    return probe && probe();
}

} // namespace Velmar
