// A window's Toolbox state read and written through a WindowRef: title, reference constant,
// kind, variant, class, port, properties, content colour, highlighting and activation.
#include <Velmar/AQtWindow.h>
#include <Velmar/Application.h>
#include <Velmar/QtGrafPort.h>
#include <Velmar/TextUtils.h>
#include <Velmar/Windows.h>

#include "foundation/Conversions.h"
#include "quickdraw/GrafPortPrivate.h"
#include "windows/WindowPorts.h"
#include "windows/WindowPrivate.h"

#include <QCursor>
#include <QGuiApplication>

#include <algorithm>
#include <cstring>

namespace Velmar {

using namespace Private;

void SetWTitle(WindowRef window, ConstStr255Param title)
{
    if (VELMAR_CHECK_WINDOW(window))
        window->setWindowTitle(title ? PascalString2QString(title) : QString());
}

void GetWTitle(WindowRef window, Str255 title)
{
    if (!title)
        return;
    title[0] = 0;
    if (VELMAR_CHECK_WINDOW(window))
        QString2PascalString(window->windowTitle(), title);
}

void SetWRefCon(WindowRef window, void* refCon)
{
    if (VELMAR_CHECK_WINDOW(window))
        window->setRefCon(refCon);
}

void* GetWRefCon(WindowRef window)
{
    return VELMAR_CHECK_WINDOW(window) ? window->refCon() : nullptr;
}

void SetWindowKind(WindowRef window, SInt16 kind)
{
    if (VELMAR_CHECK_WINDOW(window))
        window->setKind(kind);
}

SInt16 GetWindowKind(WindowRef window)
{
    return VELMAR_CHECK_WINDOW(window) ? window->kind() : SInt16(0);
}

SInt16 GetWVariant(WindowRef window)
{
    return VELMAR_CHECK_WINDOW(window) ? window->variant() : SInt16(0);
}

OSStatus GetWindowClass(WindowRef window, WindowClass* outClass)
{
    if (!VELMAR_CHECK_WINDOW(window))
        return errInvalidWindowPtr;
    if (!outClass)
        return paramErr;
    *outClass = window->windowClass();
    return noErr;
}

GrafPtr GetWindowPort(WindowRef window)
{
    return VELMAR_CHECK_WINDOW(window) ? window->GetPort() : nullptr;
}

void SetPortWindowPort(WindowRef window)
{
    if (VELMAR_CHECK_WINDOW(window))
        SetPort(window->GetPort());
}

Rect* GetWindowPortBounds(WindowRef window, Rect* bounds)
{
    if (!bounds)
        return nullptr;
    *bounds = Rect{0, 0, 0, 0};
    if (VELMAR_CHECK_WINDOW(window))
        GetPortBounds(window->GetPort(), bounds);
    return bounds;
}

OSStatus SetWindowProperty(WindowRef window, PropertyCreator creator, PropertyTag tag, UInt32 size,
                           const void* data)
{
    if (!VELMAR_CHECK_WINDOW(window))
        return errInvalidWindowPtr;
    if (!data && size)
        return paramErr;
    window->setProperty(creator, tag, data, size);
    return noErr;
}

OSStatus GetWindowProperty(WindowRef window, PropertyCreator creator, PropertyTag tag,
                           UInt32 bufferSize, UInt32* actualSize, void* buffer)
{
    if (!VELMAR_CHECK_WINDOW(window))
        return errInvalidWindowPtr;
    const std::vector<UInt8>* bytes = window->property(creator, tag);
    if (!bytes)
        return errWindowPropertyNotFound;
    if (buffer)
        std::memcpy(buffer, bytes->data(), std::min<std::size_t>(bufferSize, bytes->size()));
    if (actualSize)
        *actualSize = UInt32(bytes->size());
    return noErr;
}

OSStatus RemoveWindowProperty(WindowRef window, PropertyCreator creator, PropertyTag tag)
{
    if (!VELMAR_CHECK_WINDOW(window))
        return errInvalidWindowPtr;
    return window->removeProperty(creator, tag) ? OSStatus(noErr)
                                                : OSStatus(errWindowPropertyNotFound);
}

OSStatus SetWindowContentColor(WindowRef window, const RGBColor* color)
{
    if (!VELMAR_CHECK_WINDOW(window))
        return errInvalidWindowPtr;
    // The colour erasing paints and the buffer is cleared with.
    if (color && window->GetPort()) {
        window->GetPort()->backColor = static_cast<QColor>(*color);
        window->GetPort()->contentColor = static_cast<QColor>(*color);
        portData(window->GetPort())->inkChanged();
    }
    return noErr;
}

void HiliteWindow(WindowRef window, Boolean hilite)
{
    if (VELMAR_CHECK_WINDOW(window))
        window->SetWindowActivated(hilite != 0);
}

Boolean IsWindowHilited(WindowRef window)
{
    return VELMAR_CHECK_WINDOW(window) && window->IsWindowActivated();
}

OSStatus ActivateWindow(WindowRef window, Boolean activate)
{
    if (!VELMAR_CHECK_WINDOW(window))
        return errInvalidWindowPtr;
    // Until the application has been activated once, windows wait for it.
    AQtApplication* app = AQtApplication::instance();
    if (activate && !(app && app->hasReceivedApplicationActivate()))
        return noErr;
    window->ActivateWindow(activate != 0);
    return noErr;
}

bool RepaintDirtyPorts(bool immediately)
{
    return AQtWindow::RepaintDirtyPorts(immediately);
}

void GetMouse(Point* where)
{
    if (!where)
        return;
    if (!qobject_cast<QGuiApplication*>(QCoreApplication::instance())) {
        *where = Point{0, 0};
        return;
    }
    QPoint p = QCursor::pos();
    QtGrafPort* port = currentGrafPort();
    if (port && port->window && isLive(port->window))
        p = globalToWindow(port->window, p);
    *where = toPoint(p);
}

} // namespace Velmar
