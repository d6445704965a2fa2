/* The Resource Manager: the program's resource file (opened at start) and others, with one
   handle per resource holding the resource's raw bytes. */
#ifndef VELMAR_CLASSIC_RESOURCES_H
#define VELMAR_CLASSIC_RESOURCES_H
#include "Types.h"
VELMAR_CLASSIC_BEGIN

enum {
    resSysHeap = 64, resPurgeable = 32, resLocked = 16, resProtected = 8, resPreload = 4,
    resChanged = 2
};

/* File permissions (OpenRFPerm, HOpenResFile). */
enum { fsCurPerm = 0, fsRdPerm = 1, fsWrPerm = 2, fsRdWrPerm = 3, fsRdWrShPerm = 4 };

VELMAR_CLASSIC_API short OpenResFile(ConstStr255Param fileName);
VELMAR_CLASSIC_API short OpenRFPerm(
    ConstStr255Param fileName, short vRefNum, SignedByte permission);
VELMAR_CLASSIC_API short HOpenResFile(
    short vRefNum, long dirID, ConstStr255Param fileName, SignedByte permission);
VELMAR_CLASSIC_API void CloseResFile(short refNum);
VELMAR_CLASSIC_API void UseResFile(short refNum);
VELMAR_CLASSIC_API short CurResFile(void);
VELMAR_CLASSIC_API short HomeResFile(Handle theResource);
VELMAR_CLASSIC_API OSErr ResError(void);
VELMAR_CLASSIC_API void SetResLoad(Boolean load);
VELMAR_CLASSIC_API Handle GetResource(ResType theType, short theID);
VELMAR_CLASSIC_API Handle Get1Resource(ResType theType, short theID);
VELMAR_CLASSIC_API Handle GetNamedResource(ResType theType, ConstStr255Param name);
VELMAR_CLASSIC_API Handle Get1NamedResource(ResType theType, ConstStr255Param name);
VELMAR_CLASSIC_API Handle GetIndResource(ResType theType, short index);
VELMAR_CLASSIC_API Handle Get1IndResource(ResType theType, short index);
VELMAR_CLASSIC_API short CountResources(ResType theType);
VELMAR_CLASSIC_API short Count1Resources(ResType theType);
VELMAR_CLASSIC_API short CountTypes(void);
VELMAR_CLASSIC_API void GetIndType(ResType* theType, short index);
VELMAR_CLASSIC_API void GetResInfo(Handle theResource, short* theID, ResType* theType,
                                   Str255 name);
VELMAR_CLASSIC_API short GetResAttrs(Handle theResource);
VELMAR_CLASSIC_API long SizeResource(Handle theResource);
VELMAR_CLASSIC_API long GetMaxResourceSize(Handle theResource);
VELMAR_CLASSIC_API void LoadResource(Handle theResource);
VELMAR_CLASSIC_API void ReleaseResource(Handle theResource);
VELMAR_CLASSIC_API void DetachResource(Handle theResource);

/* Writing: a new file's empty map; resources added to, changed in and removed from the current
   file, written (the whole file, replaced at once) by WriteResource, UpdateResFile and
   CloseResFile. Files opened read-only, and those whose fork sits in a container with other
   data (MacBinary, AppleSingle/AppleDouble), are not written: ResError says wrPermErr. */
VELMAR_CLASSIC_API void CreateResFile(ConstStr255Param fileName);
VELMAR_CLASSIC_API void HCreateResFile(short vRefNum, long dirID, ConstStr255Param fileName);
VELMAR_CLASSIC_API void AddResource(
    Handle theData, ResType theType, short theID, ConstStr255Param name);
VELMAR_CLASSIC_API void ChangedResource(Handle theResource);
VELMAR_CLASSIC_API void WriteResource(Handle theResource);
VELMAR_CLASSIC_API void UpdateResFile(short refNum);
VELMAR_CLASSIC_API void RemoveResource(Handle theResource);
VELMAR_CLASSIC_API void SetResInfo(Handle theResource, short theID, ConstStr255Param name);
VELMAR_CLASSIC_API void SetResAttrs(Handle theResource, short attrs);
VELMAR_CLASSIC_API void SetResPurge(Boolean install);
VELMAR_CLASSIC_API short UniqueID(ResType theType);
VELMAR_CLASSIC_API short Unique1ID(ResType theType);

/* Where the program's own resource file is: a host may name it before the first call
   (VELMAR_CLASSIC_RESOURCES in the environment does the same). */
VELMAR_CLASSIC_API void VelmarClassicSetResourceFile(const char* path);

/* Later names of the same calls. */
#if !defined(VELMAR_CLASSIC_IMPLEMENTATION)
#define GetResourceSizeOnDisk SizeResource
#define RmveResource RemoveResource
#endif

VELMAR_CLASSIC_END
#endif
