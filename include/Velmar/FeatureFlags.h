// Feature flags that select older or newer behaviours, and their preferences dialog.
#pragma once

#include <Velmar/MacTypes.h>
