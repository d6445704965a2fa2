// QuickDraw shapes, lines, polygons and rectangle and point utilities.
#pragma once

#include <Velmar/MacTypes.h>
