// QuickDraw: current port, pens, patterns and colours.
#pragma once

#include <Velmar/MacTypes.h>
