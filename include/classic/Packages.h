/* The international utilities and number conversion lived here once. */
#include "TextUtils.h"
