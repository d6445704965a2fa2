// The Memory Manager: relocatable blocks behind master pointers, non-relocatable blocks, and
// the error of the last call. Blocks never move unless their size changes.
#include "classic/ClassicPrivate.h"

#include <cstdlib>
#include <cstring>
#include <limits>
#include <unordered_map>

namespace VelmarClassic {

namespace {

constexpr SignedByte kLocked = SignedByte(0x80);
constexpr SignedByte kPurgeable = 0x40;
constexpr SignedByte kResource = 0x20;

struct Block {
    Ptr master = nullptr; // the handle points here
    Size size = 0;
    SignedByte state = 0;
};

// Handles by address; the blocks stay where they are for the handle's life.
std::unordered_map<Handle, Block*>& handles()
{
    static auto* map = new std::unordered_map<Handle, Block*>;
    return *map;
}
std::unordered_map<Ptr, Size>& pointers()
{
    static auto* map = new std::unordered_map<Ptr, Size>;
    return *map;
}

OSErr gMemError = noErr;

// A zero-byte block still has an address, as a master pointer to nothing would not.
Ptr allocate(Size size, bool clear)
{
    const size_t bytes = size_t(size > 0 ? size : 1);
    return static_cast<Ptr>(clear ? std::calloc(bytes, 1) : std::malloc(bytes));
}

Block* blockOf(Handle h, const char* text)
{
    if (!h) {
        gMemError = nilHandleErr;
        return nullptr;
    }
    const auto it = handles().find(h);
    if (!VELMAR_ASSERT(it != handles().end(), text)) {
        gMemError = nilHandleErr;
        return nullptr;
    }
    gMemError = noErr;
    return it->second;
}

// Sizes a program can ask for: negative and absurd ones fail as a full memory would.
bool sane(Size size)
{
    return size >= 0 && size <= Size(std::numeric_limits<int>::max());
}

Handle newHandle(Size size, bool clear)
{
    if (!sane(size)) {
        gMemError = memFullErr;
        return nullptr;
    }
    auto* block = new Block;
    block->master = allocate(size, clear);
    block->size = size;
    const Handle h = &block->master;
    handles()[h] = block;
    gMemError = noErr;
    return h;
}

} // namespace

bool isLiveHandle(Handle h)
{
    return h && handles().count(h) != 0;
}

void setMemError(OSErr err)
{
    gMemError = err;
}

Handle newHandleFrom(const QByteArray& bytes)
{
    const Handle h = newHandle(bytes.size(), false);
    if (h && !bytes.isEmpty())
        std::memcpy(*h, bytes.constData(), size_t(bytes.size()));
    return h;
}

QByteArray handleBytes(Handle h)
{
    if (!isLiveHandle(h) || !*h)
        return {};
    return QByteArray(*h, qsizetype(handles()[h]->size));
}

StringHandle newStringHandle(ConstStr255Param s)
{
    const QByteArray bytes =
        s ? QByteArray(reinterpret_cast<const char*>(s), s[0] + 1) : QByteArray(1, '\0');
    return reinterpret_cast<StringHandle>(newHandleFrom(bytes));
}

void markResourceHandle(Handle h, bool resource)
{
    if (Block* block = isLiveHandle(h) ? handles()[h] : nullptr)
        block->state =
            resource ? SignedByte(block->state | kResource) : SignedByte(block->state & ~kResource);
}

} // namespace VelmarClassic

using namespace VelmarClassic;

Handle NewHandle(Size byteCount)
{
    return newHandle(byteCount, false);
}
Handle NewHandleClear(Size byteCount)
{
    return newHandle(byteCount, true);
}
Handle NewHandleSys(Size byteCount)
{
    return newHandle(byteCount, false);
}
Handle NewHandleSysClear(Size byteCount)
{
    return newHandle(byteCount, true);
}

Handle NewEmptyHandle()
{
    auto* block = new Block;
    const Handle h = &block->master;
    handles()[h] = block;
    gMemError = noErr;
    return h;
}

void DisposeHandle(Handle h)
{
    Block* block = blockOf(h, "IsValidHandle(h)");
    if (!block)
        return;
    forgetResourceHandle(h);
    handles().erase(h);
    std::free(block->master);
    delete block;
}

Size GetHandleSize(Handle h)
{
    Block* block = blockOf(h, "IsValidHandle(h)");
    return block ? block->size : 0;
}

void SetHandleSize(Handle h, Size newSize)
{
    Block* block = blockOf(h, "IsValidHandle(h)");
    if (!block)
        return;
    if (!sane(newSize)) {
        gMemError = memFullErr;
        return;
    }
    Ptr grown = static_cast<Ptr>(std::realloc(block->master, size_t(newSize > 0 ? newSize : 1)));
    if (!grown) {
        gMemError = memFullErr;
        return;
    }
    if (newSize > block->size && block->master)
        std::memset(grown + block->size, 0, size_t(newSize - block->size));
    else if (newSize > block->size)
        std::memset(grown, 0, size_t(newSize));
    block->master = grown;
    block->size = newSize;
}

void EmptyHandle(Handle h)
{
    if (Block* block = blockOf(h, "IsValidHandle(h)")) {
        std::free(block->master);
        block->master = nullptr;
        block->size = 0;
    }
}

void ReallocateHandle(Handle h, Size byteCount)
{
    if (Block* block = blockOf(h, "IsValidHandle(h)")) {
        if (!sane(byteCount)) {
            gMemError = memFullErr;
            return;
        }
        std::free(block->master);
        block->master = allocate(byteCount, false);
        block->size = byteCount;
    }
}

Handle RecoverHandle(Ptr p)
{
    for (const auto& [h, block] : handles())
        if (block->master == p && p) {
            gMemError = noErr;
            return h;
        }
    gMemError = nilHandleErr;
    return nullptr;
}

void HLock(Handle h)
{
    if (Block* block = blockOf(h, "IsValidHandle(h)"))
        block->state = SignedByte(block->state | kLocked);
}
void HUnlock(Handle h)
{
    if (Block* block = blockOf(h, "IsValidHandle(h)"))
        block->state = SignedByte(block->state & ~kLocked);
}
void HPurge(Handle h)
{
    if (Block* block = blockOf(h, "IsValidHandle(h)"))
        block->state = SignedByte(block->state | kPurgeable);
}
void HNoPurge(Handle h)
{
    if (Block* block = blockOf(h, "IsValidHandle(h)"))
        block->state = SignedByte(block->state & ~kPurgeable);
}
void HLockHi(Handle h)
{
    HLock(h);
}
void MoveHHi(Handle h)
{
    blockOf(h, "IsValidHandle(h)");
}

SignedByte HGetState(Handle h)
{
    Block* block = blockOf(h, "IsValidHandle(h)");
    return block ? block->state : SignedByte(0);
}

void HSetState(Handle h, SignedByte flags)
{
    if (Block* block = blockOf(h, "IsValidHandle(h)"))
        block->state = SignedByte((flags & (kLocked | kPurgeable)) | (block->state & kResource));
}

Ptr NewPtr(Size byteCount)
{
    if (!sane(byteCount)) {
        gMemError = memFullErr;
        return nullptr;
    }
    Ptr p = allocate(byteCount, false);
    pointers()[p] = byteCount;
    gMemError = noErr;
    return p;
}

Ptr NewPtrClear(Size byteCount)
{
    Ptr p = NewPtr(byteCount);
    if (p)
        std::memset(p, 0, size_t(byteCount > 0 ? byteCount : 1));
    return p;
}
Ptr NewPtrSys(Size byteCount)
{
    return NewPtr(byteCount);
}
Ptr NewPtrSysClear(Size byteCount)
{
    return NewPtrClear(byteCount);
}

void DisposePtr(Ptr p)
{
    if (!p)
        return;
    const auto it = pointers().find(p);
    if (!VELMAR_ASSERT(it != pointers().end(), "IsValidPtr(p)")) {
        gMemError = memWZErr;
        return;
    }
    pointers().erase(it);
    std::free(p);
    gMemError = noErr;
}

Size GetPtrSize(Ptr p)
{
    const auto it = pointers().find(p);
    return it == pointers().end() ? 0 : it->second;
}

void SetPtrSize(Ptr p, Size newSize)
{
    // A non-relocatable block cannot move: it only shrinks in place.
    const auto it = pointers().find(p);
    if (it == pointers().end() || !sane(newSize) || newSize > it->second) {
        gMemError = memFullErr;
        return;
    }
    it->second = newSize;
    gMemError = noErr;
}

void BlockMove(const void* src, void* dst, Size byteCount)
{
    if (src && dst && byteCount > 0)
        std::memmove(dst, src, size_t(byteCount));
}
void BlockMoveData(const void* src, void* dst, Size byteCount)
{
    BlockMove(src, dst, byteCount);
}

OSErr MemError()
{
    return gMemError;
}

OSErr HandToHand(Handle* h)
{
    if (!h || !blockOf(*h, "IsValidHandle(h)"))
        return gMemError = nilHandleErr;
    const Handle copy = newHandleFrom(handleBytes(*h));
    if (!copy)
        return gMemError;
    *h = copy;
    return noErr;
}

OSErr PtrToHand(const void* src, Handle* dst, long size)
{
    if (!dst || (!src && size > 0))
        return gMemError = paramErr;
    *dst = newHandle(size, false);
    if (*dst && size > 0)
        std::memcpy(**dst, src, size_t(size));
    return gMemError;
}

OSErr PtrToXHand(const void* src, Handle dst, long size)
{
    if (!src && size > 0)
        return gMemError = paramErr;
    SetHandleSize(dst, size);
    if (gMemError == noErr && size > 0)
        std::memcpy(*dst, src, size_t(size));
    return gMemError;
}

OSErr PtrAndHand(const void* p, Handle h, long size)
{
    const Size old = GetHandleSize(h);
    if (gMemError != noErr || (!p && size > 0) || size < 0)
        return gMemError = (gMemError != noErr ? gMemError : OSErr(paramErr));
    SetHandleSize(h, old + size);
    if (gMemError == noErr && size > 0)
        std::memcpy(*h + old, p, size_t(size));
    return gMemError;
}

OSErr HandAndHand(Handle a, Handle b)
{
    const QByteArray bytes = handleBytes(a);
    if (!isLiveHandle(a))
        return gMemError = nilHandleErr;
    return PtrAndHand(bytes.constData(), b, long(bytes.size()));
}

// Memory is plentiful: the figures programs check before large allocations.
long FreeMem()
{
    return 64L * 1024 * 1024;
}
long MaxBlock()
{
    return 64L * 1024 * 1024;
}
Size MaxMem(Size* grow)
{
    if (grow)
        *grow = 0;
    return 64L * 1024 * 1024;
}
Size CompactMem(Size)
{
    return 64L * 1024 * 1024;
}
void PurgeMem(Size)
{}
