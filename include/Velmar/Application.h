// The application object.
#pragma once

#include <Velmar/MacTypes.h>
