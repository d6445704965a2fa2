/* The same as Quickdraw.h. */
#include "Quickdraw.h"
