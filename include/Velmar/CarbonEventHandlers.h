// Carbon event handlers, targets, the dispatch blocker and event loop timers.
#pragma once

#include <Velmar/MacTypes.h>
