// Qt's keyboard modifiers as Mac modifier bits: Control (and Meta) play the command key,
// Alt the option key; the Mac control bit is never produced.
#pragma once

#include <Velmar/MacTypes.h>

#include <Qt>

namespace Velmar::Private {

UInt32 macModifiers(Qt::KeyboardModifiers qt);

} // namespace Velmar::Private
