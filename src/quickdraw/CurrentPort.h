// The one way a call reaches the current port. Without one it logs the call's own warning
// (every exact text is in NoPortWarnings.cpp) and converts to null.
#pragma once

#include "quickdraw/GrafPortPrivate.h"

namespace Velmar::Private {

// Logs the warning a call gives when there is no current port, in the QuickDraw category.
void warnNoCurrentPort(const char* call);

class CurrentPort {
public:
    explicit CurrentPort(const char* call) : m_port(gCurrentGrafPort)
    {
        if (!m_port)
            warnNoCurrentPort(call);
    }
    CurrentPort(const CurrentPort&) = delete;
    CurrentPort& operator=(const CurrentPort&) = delete;

    operator QtGrafPort*() const { return m_port; } // NOLINT: used like the port pointer
    QtGrafPort* operator->() const { return m_port; }
    bool operator!() const { return m_port == nullptr; }
    QtGrafPort* get() const { return m_port; }

private:
    QtGrafPort* m_port;
};

} // namespace Velmar::Private
