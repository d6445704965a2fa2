// The window handle. Kept in a header of its own so that the event and QuickDraw headers can
// name windows without pulling in the window class and QWidget.
#pragma once

#include <Velmar/MacTypes.h>

#include <cstddef>

namespace Velmar {

class AQtWindow;

// A pointer to a window that converts to and from the raw pointer, so that host code treats
// it as the Toolbox's WindowPtr. A reference is usable while it is not null and its window is
// not being deleted (DisposeWindow makes it unusable at once; the object goes later).
template <typename Pointer>
class WindowRefTmpl {
public:
    constexpr WindowRefTmpl() = default;
    constexpr WindowRefTmpl(std::nullptr_t) {}                      // NOLINT: as a pointer
    constexpr WindowRefTmpl(Pointer window) : m_window(window) {}    // NOLINT
    constexpr operator Pointer() const { return m_window; }          // NOLINT
    constexpr Pointer operator->() const { return m_window; }
    constexpr Pointer get() const { return m_window; }

    friend constexpr bool operator==(WindowRefTmpl a, WindowRefTmpl b) { return a.m_window == b.m_window; }
    friend constexpr bool operator!=(WindowRefTmpl a, WindowRefTmpl b) { return a.m_window != b.m_window; }
    friend constexpr bool operator==(WindowRefTmpl a, Pointer b) { return a.m_window == b; }
    friend constexpr bool operator!=(WindowRefTmpl a, Pointer b) { return a.m_window != b; }
    friend constexpr bool operator==(Pointer a, WindowRefTmpl b) { return a == b.m_window; }
    friend constexpr bool operator!=(Pointer a, WindowRefTmpl b) { return a != b.m_window; }
    friend constexpr bool operator==(WindowRefTmpl a, std::nullptr_t) { return !a.m_window; }
    friend constexpr bool operator!=(WindowRefTmpl a, std::nullptr_t) { return a.m_window != nullptr; }

private:
    Pointer m_window = nullptr;
};

using WindowRef = WindowRefTmpl<AQtWindow*>;
using WindowPtr = WindowRef;
using CWindowPtr = WindowRef;

} // namespace Velmar
