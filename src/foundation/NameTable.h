// Small constant tables that give a value its printable name.
#pragma once

#include <cstddef>

namespace Velmar::Private {

template <typename Key>
struct NamedValue {
    Key key;
    const char* name;
};

// The name listed for `key`, or `fallback` when the table has none.
template <typename Key, std::size_t N>
constexpr const char* nameOf(const NamedValue<Key> (&table)[N], Key key, const char* fallback)
{
    for (const NamedValue<Key>& entry : table) {
        if (entry.key == key)
            return entry.name;
    }
    return fallback;
}

} // namespace Velmar::Private
