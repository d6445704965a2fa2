/* The same as Types.h, under the later name. */
#include "Types.h"
