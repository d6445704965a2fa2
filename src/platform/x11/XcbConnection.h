// The X connection Qt already has, for the few requests Qt has no API for.
#pragma once

struct xcb_connection_t;

namespace Velmar::Private::Platform {

// Null without one (offscreen, Wayland, no application) or when it has failed.
xcb_connection_t* xcbConnection();

} // namespace Velmar::Private::Platform
