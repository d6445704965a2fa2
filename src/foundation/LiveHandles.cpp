#include "foundation/LiveHandles.h"

namespace Velmar::Private {

void PointerSet::insert(const void* p)
{
    if (!p || contains(p))
        return;
    // At most half full, so that a miss ends within a few slots.
    if ((m_count + 1) * 2 > m_slots.size())
        grow();
    std::size_t i = slotOf(p);
    while (m_slots[i])
        i = (i + 1) & m_mask;
    m_slots[i] = p;
    ++m_count;
}

bool PointerSet::erase(const void* p)
{
    if (!p || m_count == 0)
        return false;
    std::size_t i = slotOf(p);
    while (m_slots[i] != p) {
        if (!m_slots[i])
            return false;
        i = (i + 1) & m_mask;
    }
    // Backward-shift deletion: later entries of the same probe run move up, so no
    // tombstones pile up however often objects come and go.
    std::size_t hole = i;
    for (std::size_t j = (i + 1) & m_mask; m_slots[j]; j = (j + 1) & m_mask) {
        const std::size_t home = slotOf(m_slots[j]);
        // The entry at j may fill the hole unless its home lies cyclically in (hole, j].
        const bool homeBetween = hole <= j ? (hole < home && home <= j) : (hole < home || home <= j);
        if (!homeBetween) {
            m_slots[hole] = m_slots[j];
            hole = j;
        }
    }
    m_slots[hole] = nullptr;
    --m_count;
    return true;
}

void PointerSet::grow()
{
    std::vector<const void*> old;
    old.swap(m_slots);
    const std::size_t size = old.empty() ? 64 : old.size() * 2;
    m_slots.assign(size, nullptr);
    m_mask = size - 1;
    m_shift = 64;
    for (std::size_t s = size; s > 1; s >>= 1)
        --m_shift;
    m_count = 0;
    for (const void* p : old) {
        if (p)
            insert(p);
    }
}

void refuseStaleHandle(const char* text, const char* file, int line, const char* function)
{
    velmar_assert(text, file, line, function, nullptr);
}

} // namespace Velmar::Private
