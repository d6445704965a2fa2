#include "foundation/NotImplemented.h"

#include <Velmar/Diagnostics.h>
#include <Velmar/MacErrors.h>

namespace Velmar::Private {

OSStatus notImplemented(const char* call)
{
    VelmarLog(kLogNotImpl, "Velmar::%s", call ? call : "");
    return unimpErr;
}

} // namespace Velmar::Private
