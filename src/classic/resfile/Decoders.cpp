#include "classic/resfile/Decoders.h"
