// The host's current Macintosh text encoding and its UTF-16 conversions.
#pragma once

#include <Velmar/MacTypes.h>
