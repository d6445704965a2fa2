// Where the window system refuses what a call asks (Wayland: placing a top-level window,
// restacking it, keeping a screen strip), the backend does the nearest allowed thing and
// says so once per kind. The platform layer logs nothing itself: diagnostics installs the
// sink (the NotImpl log category) and the text goes there.
#pragma once

namespace Velmar::Private::Platform {

// The sink answers whether the text went anywhere (false while its category is off).
using NoticeSink = bool (*)(const char* text);
// Returns the sink it replaced; null drops the notices.
NoticeSink setNoticeSink(NoticeSink sink);

// Passes `text` (a string literal: its address is the kind) to the sink until the sink has
// taken it once. True once it has been taken (now or before).
bool noticeOnce(const char* text);
// Forgets which notices were given (tests).
void resetNotices();

} // namespace Velmar::Private::Platform
