// The shell's view of the system's left mouse button.
#include <Velmar/HostShell.h>

#include "host/Replaceable.h"
#include "platform/Platform.h"

namespace Velmar::Brindle {

namespace {

bool defaultLeftButton()
{
    return Private::Platform::isSystemLeftButtonDown();
}

Private::Replaceable<LeftButtonSource> gLeftButtonSource(defaultLeftButton);

} // namespace

bool isLeftButtonDown_sys()
{
    return gLeftButtonSource.get()();
}

LeftButtonSource SetLeftButtonSource(LeftButtonSource source)
{
    return gLeftButtonSource.set(source);
}

} // namespace Velmar::Brindle
