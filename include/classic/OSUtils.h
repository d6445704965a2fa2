/* Operating-system utilities: the clock and dates, the machine's description, Gestalt,
   delays, leaving the program. */
#ifndef VELMAR_CLASSIC_OSUTILS_H
#define VELMAR_CLASSIC_OSUTILS_H
#include "Types.h"
VELMAR_CLASSIC_BEGIN

typedef struct DateTimeRec {
    short year;
    short month;
    short day;
    short hour;
    short minute;
    short second;
    short dayOfWeek;
} DateTimeRec;

typedef struct SysEnvRec {
    short environsVersion;
    short machineType;
    short systemVersion;
    short processor;
    Boolean hasFPU;
    Boolean hasColorQD;
    short keyBoardType;
    short atDrvrVersNum;
    short sysVRefNum;
} SysEnvRec;
typedef SysEnvRec* SysEnvRecPtr;

enum {
    envMachUnknown = 0,
    envMacII = 2,
    env68020 = 3,
    env68030 = 4,
    env68040 = 5,
    envStandADBKbd = 3,
    envBadVers = -5501,
    envVersTooBig = -5502,
    gestaltUndefSelectorErr = -5551
};

/* Gestalt selectors answered (others give gestaltUndefSelectorErr). */
#define gestaltSystemVersion 'sysv'
#define gestaltQuickdrawVersion 'qd  '
#define gestaltQuickdrawFeatures 'qdrw'
#define gestaltPhysicalRAMSize 'ram '
#define gestaltLogicalRAMSize 'lram'
#define gestaltProcessorType 'proc'
#define gestaltFPUType 'fpu '
#define gestaltMachineType 'mach'
#define gestaltTextEditVersion 'te  '
#define gestaltAppleEventsAttr 'evnt'
#define gestaltFSAttr 'fs  '
#define gestaltDragMgrAttr 'drag'
#define gestaltOSAttr 'os  '
enum {
    gestalt32BitQD = 0x0220,
    gestaltHasColor = 0,
    gestaltCPU68040 = 4,
    gestaltNoFPU = 0,
    gestaltTE4 = 4,
    gestaltTempMemSupport = 4
};

VELMAR_CLASSIC_API void GetDateTime(unsigned long* secs);
VELMAR_CLASSIC_API void Secs2Date(unsigned long secs, DateTimeRec* d);
VELMAR_CLASSIC_API void Date2Secs(const DateTimeRec* d, unsigned long* secs);
VELMAR_CLASSIC_API void GetTime(DateTimeRec* d);
VELMAR_CLASSIC_API OSErr SysEnvirons(short versionRequested, SysEnvRec* theWorld);
VELMAR_CLASSIC_API OSErr Gestalt(OSType selector, long* response);
VELMAR_CLASSIC_API void Delay(long numTicks, unsigned long* finalTicks);
VELMAR_CLASSIC_API void ExitToShell(void);
VELMAR_CLASSIC_API void Debugger(void);
VELMAR_CLASSIC_API void DebugStr(ConstStr255Param message);

#define SecondsToDate Secs2Date
#define DateToSeconds Date2Secs

VELMAR_CLASSIC_END
#endif
