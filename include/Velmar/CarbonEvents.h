// Carbon event objects, parameters and the event queue.
#pragma once

#include <Velmar/MacTypes.h>
