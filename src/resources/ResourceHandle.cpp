// The ResourceHandle value, ResAssert and the typed payload accessors.
#include <Velmar/Diagnostics.h>
#include <Velmar/HostCore.h>
#include <Velmar/QDIcons.h>
#include <Velmar/Resources.h>

#include "resources/ResourceAccess.h"

namespace Velmar {

using namespace Private;

void ResAssert(bool condition)
{
    if (!condition)
        velmar_assert("x", "QtResources.cpp", __LINE__, "void __cdecl ResAssert(bool)", nullptr);
}

bool ResourceHandle::isNull() const
{
    if (!m_data)
        return true;
    switch (m_type) {
    case RT_ICON: {
        auto* icon = static_cast<AbstractIcon*>(m_data);
        return !VELMAR_CHECK_RESOURCE(icon) || icon->image().isNull();
    }
    case RT_QIMAGE: {
        auto* image = static_cast<QImage*>(m_data);
        return !VELMAR_CHECK_RESOURCE(image) || image->isNull();
    }
    default: return false;
    }
}

ResourceHandle ResourceHandle::clone() const
{
    if (isNull())
        return ResourceHandle();
    switch (m_type) {
    case RT_HANDLE: {
        ResourceHandle copy(TxCopyHand(resourceMemory(*this)), RT_HANDLE);
        copy.m_isClone = true;
        return copy;
    }
    // isNull() has checked that the icon is live.
    case RT_ICON: return ResourceHandle(static_cast<AbstractIcon*>(m_data)->clone(), RT_ICON);
    // Shared on purpose: the Toolbox contract copies the pointer, not the picture.
    case RT_QIMAGE: return ResourceHandle(m_data, RT_QIMAGE);
    default: return ResourceHandle();
    }
}

namespace Private {

AbstractIcon* resourceIcon(const ResourceHandle& handle)
{
    ResAssert(handle.getType() != 0);
    ResAssert(handle.getType() == RT_ICON || handle.getType() == RT_HANDLE);
    return static_cast<AbstractIcon*>(handle.data());
}

QImage* resourceImage(const ResourceHandle& handle)
{
    ResAssert(handle.getType() != 0);
    ResAssert(handle.getType() == RT_QIMAGE || handle.getType() == RT_HANDLE);
    return static_cast<QImage*>(handle.data());
}

Handle resourceMemory(const ResourceHandle& handle)
{
    ResAssert(handle.getType() != 0);
    ResAssert(handle.getType() == RT_HANDLE);
    return static_cast<Handle>(handle.data());
}

} // namespace Private

} // namespace Velmar
