// Taps the log for the logger view: a Qt message handler chained in front of whichever was
// installed (the library's, which writes the debugger output), so every line still goes
// where it went, and a copy waits here until the view collects it.
#pragma once

#include <QStringList>

namespace Velmar::Private::Inspector {

// Starts and stops copying. Stopping while another handler has been installed on top leaves
// the tap in that chain, passing lines on without copying them.
void attachLogTap();
void detachLogTap();
bool logTapAttached();

// Hands over the lines copied since the last call (oldest first).
QStringList takeLoggedLines();

} // namespace Velmar::Private::Inspector
