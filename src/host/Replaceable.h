// A service or a set of hooks that another part of the program may replace. The default
// serves until a replacement is set; the setter hands back what was in use, so that whoever
// replaced it can put it back. For a pointer, setting null brings the default back; for a
// set of hooks (a struct of function pointers), the default is the empty set.
#pragma once

#include <type_traits>

namespace Velmar::Private {

template <typename T>
class Replaceable {
public:
    constexpr Replaceable() : m_default(), m_current() {}
    constexpr explicit Replaceable(T fallback) : m_default(fallback), m_current(fallback) {}

    const T& get() const { return m_current; }
    T set(const T& replacement)
    {
        T previous = m_current;
        if constexpr (std::is_pointer_v<T>)
            m_current = replacement ? replacement : m_default;
        else
            m_current = replacement;
        return previous;
    }

private:
    T m_default;
    T m_current;
};

// The replaceable instance of a service object whose default is made on first use and
// never destroyed, so that it stays usable until the process ends.
template <typename Service, typename Default = Service>
Replaceable<Service*>& replaceableInstance()
{
    static Replaceable<Service*> instance(new Default);
    return instance;
}

} // namespace Velmar::Private
