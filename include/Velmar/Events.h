// Classic Event Manager: event records, posting, flushing, masks and ticks.
#pragma once

#include <Velmar/MacTypes.h>
