// The registry of live library objects. Every handle type a host holds (ports, regions,
// polygons, events, and later windows, menus, TextEdit records and cursors) registers its
// objects here when they are made and leaves when they are freed, so that a call given a
// disposed or made-up handle can refuse it before reading a byte of it.
#pragma once

#include <Velmar/Diagnostics.h>

#include <cstddef>
#include <cstdint>
#include <vector>

namespace Velmar::Private {

// A set of addresses: open addressing with linear probing, so that adding, removing and
// looking up cost a few nanoseconds and allocate nothing in the steady state.
class PointerSet {
public:
    void insert(const void* p);
    bool erase(const void* p);
    bool contains(const void* p) const
    {
        if (!p || m_count == 0)
            return false;
        for (std::size_t i = slotOf(p);; i = (i + 1) & m_mask) {
            const void* s = m_slots[i];
            if (s == p)
                return true;
            if (!s)
                return false;
        }
    }
    std::size_t size() const { return m_count; }

private:
    std::size_t slotOf(const void* p) const
    {
        // Fibonacci hashing: allocations are 16-byte aligned, so the low bits carry nothing.
        const std::uint64_t x = std::uint64_t(reinterpret_cast<std::uintptr_t>(p));
        return std::size_t((x * 0x9E3779B97F4A7C15ull) >> m_shift);
    }
    void grow();

    std::vector<const void*> m_slots;
    std::size_t m_count = 0;
    std::size_t m_mask = 0;
    unsigned m_shift = 64;
};

// The live objects of one handle type. The instance is made on first use and never
// destroyed, so objects freed during static destruction can still leave it.
template <typename T>
class LiveHandles {
public:
    static LiveHandles& instance()
    {
        static auto* sInstance = new LiveHandles;
        return *sInstance;
    }
    void add(const T* p) { m_set.insert(p); }
    bool remove(const T* p) { return m_set.erase(p); }
    bool contains(const T* p) const { return m_set.contains(p); }
    std::size_t count() const { return m_set.size(); }

private:
    LiveHandles() = default;
    PointerSet m_set;
};

template <typename T>
bool isLive(const T* p)
{
    return LiveHandles<T>::instance().contains(p);
}

// Raises the assertion `text` for a handle that is neither null nor live. Kept out of line.
void refuseStaleHandle(const char* text, const char* file, int line, const char* function);

// A live handle: true. A null handle: false, nothing said (each call decides what null
// means). Anything else: the assertion `text`, false.
template <typename T>
bool checkLive(const T* p, const char* text, const char* file, int line, const char* function)
{
    if (isLive(p))
        return true;
    if (p)
        refuseStaleHandle(text, file, line, function);
    return false;
}

} // namespace Velmar::Private

// True for a live handle; a stale or made-up one raises the assertion `text`.
#define VELMAR_LIVE(handle, text)                                                           \
    ::Velmar::Private::checkLive((handle), (text), __FILE__, __LINE__, __func__)
