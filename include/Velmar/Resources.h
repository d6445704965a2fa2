// The Resource Manager: resources by type and ID (or name) from the Qt resource tree, icons
// and pictures from its PNG images, 'STR ' from the host's text table. Resource files,
// writing, counting and attributes are calls that succeed and do nothing.
#pragma once

#include <Velmar/MacTypes.h>
#include <Velmar/QDTypes.h>

namespace Velmar {

// What a ResourceHandle's payload is.
enum ResourcePayloadType : UInt32 {
    RT_HANDLE = 1, // a core-library memory handle (TxPtrToHand / TxDisposeHandle)
    RT_PICHANDLE = 3, // a picture handle made by host code; the library never frees it
    RT_ICON = 9, // an AbstractIcon (see <Velmar/QDIcons.h>)
    RT_QIMAGE = 10, // a heap QImage
};

// A resource as a value: copying copies the pointer, nothing is counted. Every non-empty
// result of a Get... call belongs to the caller until ReleaseResource; other copies of the
// same value dangle after that, as Toolbox handles do.
class VELMAR_EXPORT ResourceHandle {
public:
    ResourceHandle() = default;
    // For host code that wraps its own payloads (RT_PICHANDLE).
    ResourceHandle(void* data, UInt32 type) : m_data(data), m_type(type) {}

    UInt32 getType() const { return m_type; }
    bool isClone() const { return m_isClone; }
    void* data() const { return m_data; }
    // Empties the handle; the clone flag stays.
    void reset()
    {
        m_data = nullptr;
        m_type = 0;
    }
    // Memory never moves: nothing to lock.
    bool lock() { return false; }
    void unlock(bool) {}

    // True without data, and for an icon or picture whose image is null (a missing PNG).
    bool isNull() const;
    // RT_HANDLE: an own copy of the bytes (isClone() true). RT_ICON: a copy of the icon.
    // RT_QIMAGE: the very same image pointer, not a copy, so release only one of the two.
    // Anything else, or a null handle: an empty handle.
    ResourceHandle clone() const;

private:
    void* m_data = nullptr;
    UInt32 m_type = 0;
    bool m_isClone = false;
};

// Raises the assertion "x" when `condition` is false, then returns.
VELMAR_EXPORT void ResAssert(bool condition);

// ---- Getting resources ---------------------------------------------------------------
// Icon types ('ICN#', 'ICON', 'SICN', 'cccn', 'cicn', 'icl8', 'ics#', 'ics8') give RT_ICON,
// 'PICT' gives RT_QIMAGE, every other type the file ":/TYPE/nnnnn" (ID zero-padded to five
// digits) as RT_HANDLE.
VELMAR_EXPORT ResourceHandle GetResource(ResType type, SInt16 id);
VELMAR_EXPORT ResourceHandle Get1Resource(ResType type, SInt16 id);
// 'STR ': the host's text-table string for the name. Any other type: the file ":/TYPE/name"
// as RT_HANDLE (null data when missing, or when the name would leave ":/TYPE/").
VELMAR_EXPORT ResourceHandle GetNamedResource(ResType type, const unsigned char* name);
VELMAR_EXPORT ResourceHandle Get1NamedResource(ResType type, const unsigned char* name);
// Always an empty handle: nothing here can be counted.
VELMAR_EXPORT ResourceHandle GetIndResource(ResType type, SInt16 index);
VELMAR_EXPORT ResourceHandle Get1IndResource(ResType type, SInt16 index);
VELMAR_EXPORT ResourceHandle GetCIcon(SInt16 id); // 'cicn'
VELMAR_EXPORT ResourceHandle GetSIcon(SInt16 id); // 'SICN'
VELMAR_EXPORT ResourceHandle GetIcon(SInt16 id); // 'ICON'
VELMAR_EXPORT ResourceHandle GetPicture(SInt16 id);
// Frees the payload (RT_HANDLE, RT_ICON, RT_QIMAGE); RT_PICHANDLE is left alone.
VELMAR_EXPORT void ReleaseResource(ResourceHandle handle);

// ---- Calls that succeed without effect --------------------------------------------------
VELMAR_EXPORT SInt16 CountResources(ResType type);
VELMAR_EXPORT SInt16 Count1Resources(ResType type);
VELMAR_EXPORT SInt16 CurResFile();
VELMAR_EXPORT SInt16 HomeResFile(ResourceHandle handle);
VELMAR_EXPORT SInt16 GetResAttrs(ResourceHandle handle);
VELMAR_EXPORT SInt32 GetResourceSizeOnDisk(ResourceHandle handle);
VELMAR_EXPORT OSErr ResError();
VELMAR_EXPORT OSErr QDError();
VELMAR_EXPORT void AddResource(
    ResourceHandle handle, ResType type, SInt16 id, const unsigned char* name);
VELMAR_EXPORT void ChangedResource(ResourceHandle handle);
VELMAR_EXPORT void WriteResource(ResourceHandle handle);
VELMAR_EXPORT void RemoveResource(ResourceHandle handle);
VELMAR_EXPORT void DetachResource(ResourceHandle handle);
// Leaves every output as the caller set it.
VELMAR_EXPORT void GetResInfo(
    ResourceHandle handle, SInt16* id, ResType* type, unsigned char* name);
VELMAR_EXPORT void CloseResFile(SInt16 refNum);
VELMAR_EXPORT void SetResLoad(Boolean load);
// There is one resource file, 0; another refNum is logged in the QuickDraw category.
VELMAR_EXPORT void UseResFile(SInt16 refNum);

// ---- Pixmap handles -----------------------------------------------------------------------
// Memory never moves: locking always succeeds and unlocking does nothing.
VELMAR_EXPORT Boolean TxHLock(PixMapPtr* pixmap);
VELMAR_EXPORT void TxHUnLock(PixMapPtr* pixmap, Boolean wasLocked);
// A new pixmap owning a copy of the pixels (dispose of it with DisposePixMap); null for a
// null or disposed pixmap.
VELMAR_EXPORT PixMapPtr* TxCopyHand(PixMapPtr* pixmap);

} // namespace Velmar
