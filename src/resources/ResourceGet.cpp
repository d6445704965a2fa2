// Resources by type and ID, and ReleaseResource.
#include <Velmar/HostCore.h>
#include <Velmar/QDIcons.h>
#include <Velmar/Resources.h>

#include "resources/ResourceAccess.h"

#include <cstdio>

namespace Velmar {

using namespace Private;

namespace {

bool isIconType(ResType type)
{
    switch (type) {
    case FOUR_CHAR_CODE("ICN#"):
    case FOUR_CHAR_CODE("ICON"):
    case FOUR_CHAR_CODE("SICN"):
    case FOUR_CHAR_CODE("cccn"):
    case FOUR_CHAR_CODE("cicn"):
    case FOUR_CHAR_CODE("icl8"):
    case FOUR_CHAR_CODE("ics#"):
    case FOUR_CHAR_CODE("ics8"): return true;
    // 'icl4' and 'ics4' are icon types too, but the host reads them as raw files: they take
    // the generic path.
    default: return false;
    }
}

ResourceHandle iconHandle(ResType type, SInt16 id)
{
    return ResourceHandle(LoadIcon(type, id), RT_ICON);
}

} // namespace

ResourceHandle GetResource(ResType type, SInt16 id)
{
    if (isIconType(type))
        return iconHandle(type, id);
    if (type == FOUR_CHAR_CODE("PICT"))
        return loadPicture(id);
    // The ID as five digits, zero-padded after any sign: 128 is "00128", -5 is "-0005".
    unsigned char name[8];
    const int length =
        std::snprintf(reinterpret_cast<char*>(name + 1), sizeof name - 1, "%05d", int(id));
    name[0] = static_cast<unsigned char>(length);
    return namedResource("GetResource", type, name);
}

ResourceHandle Get1Resource(ResType type, SInt16 id)
{
    return GetResource(type, id);
}

ResourceHandle GetIndResource(ResType, SInt16)
{
    return ResourceHandle();
}

ResourceHandle Get1IndResource(ResType, SInt16)
{
    return ResourceHandle();
}

ResourceHandle GetCIcon(SInt16 id)
{
    return iconHandle(FOUR_CHAR_CODE("cicn"), id);
}

ResourceHandle GetSIcon(SInt16 id)
{
    return iconHandle(FOUR_CHAR_CODE("SICN"), id);
}

ResourceHandle GetIcon(SInt16 id)
{
    return iconHandle(FOUR_CHAR_CODE("ICON"), id);
}

ResourceHandle GetPicture(SInt16 id)
{
    return GetResource(FOUR_CHAR_CODE("PICT"), id);
}

// An icon or picture whose image is null (a missing PNG) is freed as well: the handle still
// owns the object. A released one is refused (with its assertion) and left alone.
void ReleaseResource(ResourceHandle handle)
{
    switch (handle.getType()) {
    case RT_HANDLE:
        if (handle.data())
            TxDisposeHandle(resourceMemory(handle));
        return;
    case RT_ICON: {
        auto* icon = static_cast<AbstractIcon*>(handle.data());
        if (VELMAR_CHECK_RESOURCE(icon))
            delete icon;
        return;
    }
    case RT_QIMAGE: {
        auto* picture = static_cast<QImage*>(handle.data());
        if (VELMAR_CHECK_RESOURCE(picture))
            freePicture(picture);
        return;
    }
    default: return;
    }
}

} // namespace Velmar
