#include "platform/x11/XcbConnection.h"

#if defined(VELMAR_HAVE_XCB)

#include <QGuiApplication>

#include <xcb/xcb.h>

namespace Velmar::Private::Platform {

xcb_connection_t* xcbConnection()
{
#if QT_CONFIG(xcb)
    auto* app = qobject_cast<QGuiApplication*>(QCoreApplication::instance());
    if (!app)
        return nullptr;
    auto* x11 = app->nativeInterface<QNativeInterface::QX11Application>();
    xcb_connection_t* connection = x11 ? x11->connection() : nullptr;
    return (connection && !xcb_connection_has_error(connection)) ? connection : nullptr;
#else
    return nullptr;
#endif
}

} // namespace Velmar::Private::Platform

#else

namespace Velmar::Private::Platform {

xcb_connection_t* xcbConnection()
{
    return nullptr;
}

} // namespace Velmar::Private::Platform

#endif
