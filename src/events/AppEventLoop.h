// What the application event loop calls need from the waiters.
#pragma once

namespace Velmar::Private {

// Set by the waiters: true when the top-most waiter runs the application event loop.
// Unset, no application event loop is running. Returns the previous probe.
using ApplicationLoopProbe = bool (*)();
ApplicationLoopProbe SetApplicationLoopProbe(ApplicationLoopProbe probe);

} // namespace Velmar::Private
