// A service the host may replace: the default serves until a replacement is set, the setter
// hands back what was in use, and setting null brings the default back.
#pragma once

namespace Velmar::Private {

template <typename T> // a pointer: to a function or to a service object
class Replaceable {
public:
    constexpr explicit Replaceable(T fallback) : m_default(fallback), m_current(fallback) {}

    T get() const { return m_current; }
    T set(T replacement)
    {
        const T previous = m_current;
        m_current = replacement ? replacement : m_default;
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
