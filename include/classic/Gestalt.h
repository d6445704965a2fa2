/* Gestalt lives in OSUtils.h here. */
#include "OSUtils.h"
