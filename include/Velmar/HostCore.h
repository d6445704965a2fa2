// Default host core services: ticks, memory handles, text table, screens, errors, automation.
#pragma once

#include <Velmar/MacTypes.h>
