// The X11 backend's window requests: the menu-bar strip is reserved with the EWMH strut
// properties on the window, over Qt's own connection.
#include "platform/Backends.h"

#include <QWidget>

#if defined(VELMAR_HAVE_XCB)

#include "platform/x11/XcbConnection.h"

#include <xcb/xcb.h>

#include <cstring>

namespace Velmar::Private::Platform::X11 {

namespace {

xcb_atom_t internAtom(xcb_connection_t* connection, const char* name)
{
    xcb_intern_atom_reply_t* reply = xcb_intern_atom_reply(
        connection, xcb_intern_atom(connection, 0, UInt16(std::strlen(name)), name), nullptr);
    const xcb_atom_t atom = reply ? reply->atom : xcb_atom_t(XCB_ATOM_NONE);
    std::free(reply);
    return atom;
}

} // namespace

void reserveScreenTop(QWidget* window, int height)
{
    xcb_connection_t* connection = xcbConnection();
    if (!connection || !window || height <= 0)
        return;
    const auto id = xcb_window_t(window->winId());
    // left, right, top, bottom, then the start and end of each edge's span.
    const UInt32 partial[12] = {0, 0, UInt32(height), 0, 0, 0, 0, 0,
                                UInt32(window->x()), UInt32(window->x() + window->width() - 1),
                                0, 0};
    const xcb_atom_t cardinal = XCB_ATOM_CARDINAL;
    xcb_change_property(connection, XCB_PROP_MODE_REPLACE, id,
                        internAtom(connection, "_NET_WM_STRUT_PARTIAL"), cardinal, 32, 12, partial);
    xcb_change_property(connection, XCB_PROP_MODE_REPLACE, id, internAtom(connection, "_NET_WM_STRUT"),
                        cardinal, 32, 4, partial);
    xcb_flush(connection);
}

} // namespace Velmar::Private::Platform::X11

#else

namespace Velmar::Private::Platform::X11 {

void reserveScreenTop(QWidget*, int) {}

} // namespace Velmar::Private::Platform::X11

#endif
