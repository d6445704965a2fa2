// Memory handles: a master pointer at the head of a block that also records the size.
#include <Velmar/HostCore.h>

#include "host/Replaceable.h"

#include <QtGlobal>

#include <cstddef>
#include <cstdlib>
#include <cstring>
#include <new>
#include <unordered_set>

namespace Velmar {

namespace {

// The handle is the address of `master`; `bytes` follow the header in the same allocation.
struct Block {
    Ptr master;
    Size size;
};

// Well above anything a Toolbox caller may ask for, well below overflow of Size.
constexpr Size kMaxHandleSize = 0x40000000;

class DefaultHandleAllocator final : public HandleAllocator {
public:
    Handle PtrToHand(const void* data, Size size) override
    {
        if (size < 0 || size > kMaxHandleSize) {
            qWarning("TxPtrToHand: refused size %d", int(size));
            return nullptr;
        }
        void* memory = std::malloc(sizeof(Block) + size_t(size) + 1);
        if (!memory)
            return nullptr;
        auto* block = new (memory) Block;
        block->master = static_cast<char*>(memory) + sizeof(Block);
        block->size = size;
        if (data && size > 0)
            std::memcpy(block->master, data, size_t(size));
        else
            std::memset(block->master, 0, size_t(size));
        block->master[size] = 0; // a terminator keeps C-string readers of text handles safe
        const Handle handle = &block->master;
        m_live.insert(handle);
        return handle;
    }

    void DisposeHandle(Handle handle) override
    {
        if (!handle)
            return;
        if (m_live.erase(handle) == 0) {
            qWarning("TxDisposeHandle: not a live handle %p", static_cast<void*>(handle));
            return;
        }
        Block* block = blockOf(handle);
        block->~Block();
        std::free(block);
    }

    Handle CopyHand(Handle handle) override
    {
        if (!IsValidHandle(handle)) {
            if (handle)
                qWarning("TxCopyHand: not a live handle %p", static_cast<void*>(handle));
            return nullptr;
        }
        const Block* block = blockOf(handle);
        return PtrToHand(block->master, block->size);
    }

    Size GetHandleSize(Handle handle) override
    {
        return IsValidHandle(handle) ? blockOf(handle)->size : -1;
    }

    bool IsValidHandle(Handle handle) override
    {
        return handle && m_live.count(handle) != 0;
    }

private:
    static Block* blockOf(Handle handle)
    {
        return reinterpret_cast<Block*>(reinterpret_cast<char*>(handle) - offsetof(Block, master));
    }

    // Lets stale and foreign handles be told apart from live ones without touching them.
    std::unordered_set<Handle> m_live;
};

// Never destroyed: handles may still be disposed by other objects' destructors at exit.
Private::Replaceable<HandleAllocator*>& allocatorSlot()
{
    return Private::replaceableInstance<HandleAllocator, DefaultHandleAllocator>();
}

} // namespace

HandleAllocator::~HandleAllocator() = default;

HandleAllocator* HandleAllocator::Get()
{
    return allocatorSlot().get();
}

HandleAllocator* HandleAllocator::SetInstance(HandleAllocator* allocator)
{
    return allocatorSlot().set(allocator);
}

Handle TxPtrToHand(const void* data, Size size)
{
    return HandleAllocator::Get()->PtrToHand(data, size);
}

void TxDisposeHandle(Handle handle)
{
    HandleAllocator::Get()->DisposeHandle(handle);
}

Handle TxCopyHand(Handle handle)
{
    return HandleAllocator::Get()->CopyHand(handle);
}

Size TxGetHandleSize(Handle handle)
{
    return HandleAllocator::Get()->GetHandleSize(handle);
}

bool TxIsValidHandle(Handle handle)
{
    return HandleAllocator::Get()->IsValidHandle(handle);
}

} // namespace Velmar
