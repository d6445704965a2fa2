// Graphics ports and offscreen worlds.
#pragma once

#include <Velmar/MacTypes.h>
