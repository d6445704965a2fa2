/* Trap numbers, so that programs can ask whether a call exists. Every trap listed here
   exists; _Unimplemented's address differs from theirs. */
#ifndef VELMAR_CLASSIC_TRAPS_H
#define VELMAR_CLASSIC_TRAPS_H
#include "Types.h"
VELMAR_CLASSIC_BEGIN

typedef signed char TrapType;
enum { OSTrap = 0, ToolTrap = 1 };
enum {
    _Unimplemented = 0xA89F,
    _WaitNextEvent = 0xA860,
    _Gestalt = 0xA1AD,
    _GetNextEvent = 0xA970,
    _SysEnvirons = 0xA090,
    _InitGraf = 0xA86E
};

VELMAR_CLASSIC_API UniversalProcPtr NGetTrapAddress(unsigned short trapNum, TrapType tType);
VELMAR_CLASSIC_API UniversalProcPtr GetToolTrapAddress(unsigned short trapNum);
VELMAR_CLASSIC_API UniversalProcPtr GetOSTrapAddress(unsigned short trapNum);
VELMAR_CLASSIC_API UniversalProcPtr GetTrapAddress(unsigned short trapNum);

VELMAR_CLASSIC_END
#endif
