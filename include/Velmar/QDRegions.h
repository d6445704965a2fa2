// QuickDraw regions.
#pragma once

#include <Velmar/MacTypes.h>
