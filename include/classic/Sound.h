/* Sound: the system beep. */
#ifndef VELMAR_CLASSIC_SOUND_H
#define VELMAR_CLASSIC_SOUND_H
#include "Types.h"
VELMAR_CLASSIC_BEGIN
VELMAR_CLASSIC_API void SysBeep(short duration);
VELMAR_CLASSIC_END
#endif
