// The shell's view of the system's left mouse button.
#include <Velmar/HostShell.h>

#include "platform/Platform.h"

namespace Velmar::Brindle {

namespace {

bool defaultLeftButton()
{
    return Private::Platform::isSystemLeftButtonDown();
}

LeftButtonSource gLeftButtonSource = defaultLeftButton;

} // namespace

bool isLeftButtonDown_sys()
{
    return gLeftButtonSource();
}

LeftButtonSource SetLeftButtonSource(LeftButtonSource source)
{
    const LeftButtonSource previous = gLeftButtonSource;
    gLeftButtonSource = source ? source : defaultLeftButton;
    return previous;
}

} // namespace Velmar::Brindle
