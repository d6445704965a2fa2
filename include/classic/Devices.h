/* Desk accessories: there are none; the calls answer so. */
#ifndef VELMAR_CLASSIC_DEVICES_H
#define VELMAR_CLASSIC_DEVICES_H
#include "Types.h"
VELMAR_CLASSIC_BEGIN
VELMAR_CLASSIC_API short OpenDeskAcc(ConstStr255Param deskAccName);
VELMAR_CLASSIC_API void CloseDeskAcc(short refNum);
VELMAR_CLASSIC_API Boolean SystemEdit(short editCmd);
VELMAR_CLASSIC_END
#endif
