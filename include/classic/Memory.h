/* The Memory Manager: handles with master pointers, pointers, block moves. */
#ifndef VELMAR_CLASSIC_MEMORY_H
#define VELMAR_CLASSIC_MEMORY_H
#include "Types.h"
VELMAR_CLASSIC_BEGIN

VELMAR_CLASSIC_API Handle NewHandle(Size byteCount);
VELMAR_CLASSIC_API Handle NewHandleClear(Size byteCount);
VELMAR_CLASSIC_API Handle NewHandleSys(Size byteCount);
VELMAR_CLASSIC_API Handle NewHandleSysClear(Size byteCount);
VELMAR_CLASSIC_API Handle NewEmptyHandle(void);
VELMAR_CLASSIC_API void DisposeHandle(Handle h);
VELMAR_CLASSIC_API Size GetHandleSize(Handle h);
VELMAR_CLASSIC_API void SetHandleSize(Handle h, Size newSize);
VELMAR_CLASSIC_API void EmptyHandle(Handle h);
VELMAR_CLASSIC_API void ReallocateHandle(Handle h, Size byteCount);
VELMAR_CLASSIC_API Handle RecoverHandle(Ptr p);
VELMAR_CLASSIC_API void HLock(Handle h);
VELMAR_CLASSIC_API void HUnlock(Handle h);
VELMAR_CLASSIC_API void HPurge(Handle h);
VELMAR_CLASSIC_API void HNoPurge(Handle h);
VELMAR_CLASSIC_API void HLockHi(Handle h);
VELMAR_CLASSIC_API void MoveHHi(Handle h);
VELMAR_CLASSIC_API SignedByte HGetState(Handle h);
VELMAR_CLASSIC_API void HSetState(Handle h, SignedByte flags);
VELMAR_CLASSIC_API Ptr NewPtr(Size byteCount);
VELMAR_CLASSIC_API Ptr NewPtrClear(Size byteCount);
VELMAR_CLASSIC_API Ptr NewPtrSys(Size byteCount);
VELMAR_CLASSIC_API Ptr NewPtrSysClear(Size byteCount);
VELMAR_CLASSIC_API void DisposePtr(Ptr p);
VELMAR_CLASSIC_API Size GetPtrSize(Ptr p);
VELMAR_CLASSIC_API void SetPtrSize(Ptr p, Size newSize);
VELMAR_CLASSIC_API void BlockMove(const void* src, void* dst, Size byteCount);
VELMAR_CLASSIC_API void BlockMoveData(const void* src, void* dst, Size byteCount);
VELMAR_CLASSIC_API OSErr MemError(void);
VELMAR_CLASSIC_API OSErr HandToHand(Handle* h);
VELMAR_CLASSIC_API OSErr PtrToHand(const void* src, Handle* dst, long size);
VELMAR_CLASSIC_API OSErr PtrToXHand(const void* src, Handle dst, long size);
VELMAR_CLASSIC_API OSErr HandAndHand(Handle a, Handle b);
VELMAR_CLASSIC_API OSErr PtrAndHand(const void* p, Handle h, long size);
VELMAR_CLASSIC_API long FreeMem(void);
VELMAR_CLASSIC_API long MaxBlock(void);
VELMAR_CLASSIC_API Size MaxMem(Size* grow);
VELMAR_CLASSIC_API Size CompactMem(Size needed);
VELMAR_CLASSIC_API void PurgeMem(Size needed);
VELMAR_CLASSIC_API void MaxApplZone(void);
VELMAR_CLASSIC_API void MoreMasters(void);
VELMAR_CLASSIC_API void SetApplLimit(void* limit);
VELMAR_CLASSIC_API Ptr GetApplLimit(void);

/* The names of the earliest interfaces. */
#define DisposHandle DisposeHandle
#define DisposPtr DisposePtr
#define NewHandleCl NewHandleClear

VELMAR_CLASSIC_END
#endif
