// The Resource Manager calls that succeed without effect: there is one resource file (0),
// nothing is written, counted or attributed, and no error is ever set.
#include <Velmar/Diagnostics.h>
#include <Velmar/MacErrors.h>
#include <Velmar/Resources.h>

namespace Velmar {

SInt16 CountResources(ResType)
{
    return 0;
}

SInt16 Count1Resources(ResType)
{
    return 0;
}

SInt16 CurResFile()
{
    return 0;
}

SInt16 HomeResFile(ResourceHandle)
{
    return 0;
}

SInt16 GetResAttrs(ResourceHandle)
{
    return 0;
}

SInt32 GetResourceSizeOnDisk(ResourceHandle)
{
    return 0;
}

OSErr ResError()
{
    return noErr;
}

OSErr QDError()
{
    return noErr;
}

void AddResource(ResourceHandle, ResType, SInt16, const unsigned char*)
{}

void ChangedResource(ResourceHandle)
{}

void WriteResource(ResourceHandle)
{}

void RemoveResource(ResourceHandle)
{}

void DetachResource(ResourceHandle)
{}

void GetResInfo(ResourceHandle, SInt16*, ResType*, unsigned char*)
{}

void CloseResFile(SInt16)
{}

void SetResLoad(Boolean)
{}

void UseResFile(SInt16 refNum)
{
    if (refNum != 0)
        VelmarLog(kLogQuickDraw, "warning: refNum is not 0");
}

} // namespace Velmar
