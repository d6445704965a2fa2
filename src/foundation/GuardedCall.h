// Calls into the host's code (handlers, action procedures) that may throw anything: what
// escapes is logged through LogXError and never unwinds through Qt.
#pragma once

#include <Velmar/HostCore.h>

#include <exception>

namespace Velmar::Private {

// False when the call threw; `unknownText` is logged for what is neither an XError nor a
// std::exception.
template <typename Call>
bool callGuarded(Call&& call, const char* unknownText)
{
    try {
        call();
        return true;
    } catch (const XError& error) {
        LogXError(error);
    } catch (const std::exception& error) {
        LogXError(XError("std::exception", error.what()));
    } catch (...) {
        LogXError(XError("", unknownText));
    }
    return false;
}

} // namespace Velmar::Private
