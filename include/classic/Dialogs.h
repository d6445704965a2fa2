/* The Dialog Manager: only its initialisation so far. */
#ifndef VELMAR_CLASSIC_DIALOGS_H
#define VELMAR_CLASSIC_DIALOGS_H
#include "Windows.h"
VELMAR_CLASSIC_BEGIN
typedef WindowPtr DialogPtr;
typedef DialogPtr DialogRef;
VELMAR_CLASSIC_API void InitDialogs(void* resumeProc);
VELMAR_CLASSIC_END
#endif
