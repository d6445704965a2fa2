// Making windows from Toolbox classes and attributes, and disposing of them.
#include <Velmar/AQtWindow.h>
#include <Velmar/Diagnostics.h>
#include <Velmar/TextUtils.h>
#include <Velmar/Windows.h>

#include "foundation/Conversions.h"
#include "foundation/Lifetime.h"
#include "windows/WindowPrivate.h"
#include "windows/WindowVariants.h"

#include <QSizePolicy>

namespace Velmar {

using namespace Private;

namespace {

struct QtWindowSetup {
    Qt::WindowFlags flags;
    Qt::WindowModality modality = Qt::NonModal;
    bool resizable = false;
    WindowClass storedClass;
};

struct UnsupportedAttribute {
    WindowAttributes bit;
    const char* log;
};

constexpr UnsupportedAttribute kUnsupportedAttributes[] = {
    {kWindowSideTitlebarAttribute, "CreateNewWindow: kWindowSideTitlebarAttribute is not implemented"},
    {kWindowHideOnSuspendAttribute, "CreateNewWindow: kWindowHideOnSuspendAttribute is not implemented"},
    {kWindowNoShadowAttribute, "CreateNewWindow: kWindowNoShadowAttribute is not implemented"},
};

QtWindowSetup setupFor(WindowClass windowClass, WindowAttributes attributes)
{
    QtWindowSetup setup;
    setup.storedClass = windowClass;
    // Top-level windows whose title bar buttons follow the attributes.
    setup.flags = Qt::Window | Qt::CustomizeWindowHint | Qt::WindowTitleHint;
    const bool closeBox = attributes & kWindowCloseBoxAttribute;
    if (closeBox)
        setup.flags |= Qt::WindowCloseButtonHint;
    if (attributes & kWindowFullZoomAttribute)
        setup.flags |= Qt::WindowMaximizeButtonHint;
    if (attributes & kWindowCollapseBoxAttribute)
        setup.flags |= Qt::WindowMinimizeButtonHint;
    if (attributes & kWindowNoTitleBarAttribute) {
        if (!closeBox)
            setup.flags &= ~Qt::WindowTitleHint;
        setup.flags |= Qt::FramelessWindowHint;
    }
    switch (windowClass) {
    case kModalWindowClass:
        setup.modality = Qt::ApplicationModal;
        setup.flags &= ~Qt::WindowTitleHint;
        break;
    case kMovableModalWindowClass:
        setup.modality = Qt::ApplicationModal;
        break;
    case kFloatingWindowClass:
        setup.storedClass = kDocumentWindowClass; // deliberately: floating windows are documents here
        break;
    case kPlainWindowClass:
        setup.flags &= ~Qt::WindowTitleHint;
        break;
    default:
        break;
    }
    for (const UnsupportedAttribute& u : kUnsupportedAttributes) {
        if (attributes & u.bit)
            VelmarLog(kLogNotImpl, "%s", u.log);
    }
    setup.resizable = (attributes & kWindowResizableAttribute) && windowClass != kPlainWindowClass;
    if (!setup.resizable)
        setup.flags |= Qt::MSWindowsFixedSizeDialogHint;
    return setup;
}

// Empty, negative and huge bounds give a window a back buffer can hold, with a log line.
QRect contentGeometry(const Rect* bounds)
{
    const QRect r = toQRect(bounds);
    return QRect(r.topLeft(), clampedWindowSize(r.size(), "CreateNewWindow"));
}

// A decorated window's frame never starts above or left of the placement area.
void keepFrameReachable(AQtWindow* window)
{
    if (!window->GetDecorator())
        return;
    const QRect frame = window->FrameGeometry();
    const QPoint clamped(qMax(0, frame.left()), qMax(0, frame.top()));
    if (clamped != frame.topLeft())
        window->SetContentGeometry(window->ContentGeometry().translated(clamped - frame.topLeft()));
}

} // namespace

OSStatus CreateNewWindowEx(void* handler, WindowClass windowClass, WindowAttributes attributes,
                           const Rect* bounds, WindowRef* outWindow)
{
    if (!VELMAR_ASSERT(outWindow, "outWindow"))
        return paramErr;
    *outWindow = nullptr;
    const QtWindowSetup setup = setupFor(windowClass, attributes);
    auto* eventHandler = static_cast<IWindowEventHandler*>(handler);

    auto* window = new AQtWindow(eventHandler, setup.storedClass);
    window->setWindowModality(setup.modality);
    window->setWindowFlags(setup.flags);
    window->SetIsResizeable(setup.resizable);
    listInsertFront(window);
    window->setVariant(classAttributesVariant(windowClass, attributes));

    if (bounds) {
        window->setSizePolicy(QSizePolicy::Ignored, QSizePolicy::Ignored);
        window->setGeometry(contentGeometry(bounds));
        window->scaleGrafPortToWindow(window->size());
    }
    if (!(DelayedDecoration::instance() && DelayedDecoration::checkWindow(window, eventHandler))) {
        if (Brindle::DecorationManager* manager = Brindle::DecorationManager::Instance())
            manager->Decorate(window);
    }
    if (bounds)
        keepFrameReachable(window);

    *outWindow = window;
    window->enableEventHandling(true);
    return noErr;
}

OSStatus CreateNewWindow(WindowClass windowClass, WindowAttributes attributes, const Rect* bounds,
                         WindowRef* outWindow)
{
    return CreateNewWindowEx(nullptr, windowClass, attributes, bounds, outWindow);
}

WindowRef NewCWindow(void* handler, const Rect* bounds, ConstStr255Param title, Boolean visible,
                     SInt16 procID, WindowRef /*behind*/, Boolean goAwayFlag, void* refCon)
{
    WindowClass windowClass;
    WindowAttributes attributes;
    procIdClassAndAttributes(procID, &windowClass, &attributes);
    if (goAwayFlag)
        attributes |= kWindowCloseBoxAttribute;
    else
        attributes &= ~WindowAttributes(kWindowCloseBoxAttribute);
    WindowRef window;
    const OSStatus result = CreateNewWindowEx(handler, windowClass, attributes, bounds, &window);
    VELMAR_ASSERT(result != noErr || window, "res != noErr || !!outRef");
    if (result != noErr || !window)
        return nullptr;
    window->setRefCon(refCon);
    SetWTitle(window, title);
    window->setVariant(procIdVariant(procID));
    if (visible)
        ShowWindow(window);
    return window;
}

void DisposeWindow(WindowRef window)
{
    if (!VELMAR_CHECK_WINDOW(window))
        return;
    if (window->isVisible()) {
        const KeepAlive hold(window);
        HideWindow(window);
        if (!hold.alive() || window->IsDeletePending())
            return; // the host disposed it while the hide waited
    }
    if (userFocusRecord().data() == window.get())
        SetUserFocusWindow(nullptr);
    DelayedDecoration::removeWindow(window);
    listRemove(window);
    window->Dispose();
}

} // namespace Velmar
