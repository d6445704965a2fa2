// Typed access to a ResourceHandle's payload, and the registries that tell a live icon or
// picture from a released one before anything reads it.
#pragma once

#include <Velmar/QDIcons.h>
#include <Velmar/Resources.h>

#include "foundation/LiveHandles.h"

#include <QImage>

namespace Velmar::Private {

// The payload as an icon, an image or a memory handle. Each asserts (ResAssert) that the
// handle is not empty and of a type that may carry it, then gives the pointer as it is: a
// caller checks liveness before it reads.
AbstractIcon* resourceIcon(const ResourceHandle& handle); // RT_ICON or RT_HANDLE
QImage* resourceImage(const ResourceHandle& handle); // RT_QIMAGE or RT_HANDLE
Handle resourceMemory(const ResourceHandle& handle); // RT_HANDLE only

// A released (or made-up) icon or picture is refused with this assertion.
#define VELMAR_CHECK_RESOURCE(payload) VELMAR_LIVE((payload), "IsValidResource(handle)")

// A picture payload: a heap copy of `image`, registered until freePicture.
QImage* newPicture(const QImage& image);
void freePicture(QImage* picture);

// 'PICT' `id` as an RT_QIMAGE handle; a missing PNG gives a null image.
ResourceHandle loadPicture(SInt16 id);

// The named resource route with `call` naming the public call in its warnings.
ResourceHandle namedResource(const char* call, ResType type, const unsigned char* name);

} // namespace Velmar::Private
