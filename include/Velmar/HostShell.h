// Default host UI-shell services: managed windows, decorations and the palette.
#pragma once

#include <Velmar/MacTypes.h>
