// The one idiom for a Toolbox call the library does not implement: it names itself in the
// "NotImpl" log category and answers unimpErr. scripts/list-stubs.sh collects every name
// passed here into docs/not-implemented.md, so keep the name a string literal.
#pragma once

#include <Velmar/MacTypes.h>

namespace Velmar::Private {

// Logs "Velmar::<call>" in the NotImpl category; returns unimpErr.
OSStatus notImplemented(const char* call);

} // namespace Velmar::Private
