// The window object: construction and deletion, its port and drawing mode, title, Toolbox
// properties, drag handler lists and the managed-window operations that are plain state.
#include <Velmar/AQtWindow.h>

#include <Velmar/FeatureFlags.h>
#include <Velmar/QtGrafPort.h>

#include "events/EventQueue.h"
#include "quickdraw/GrafPortPrivate.h"
#include "windows/WindowPorts.h"
#include "windows/WindowPrivate.h"

#include <algorithm>
#include <cstring>

namespace Velmar {

using namespace Private;

namespace {

int gNextSerial = 0;
bool gDefaultDirectQtDrawing = false;

AQtWindow::TrackingHandlers& globalTracking()
{
    static auto* sHandlers = new AQtWindow::TrackingHandlers;
    return *sHandlers;
}

AQtWindow::ReceiveHandlers& globalReceive()
{
    static auto* sHandlers = new AQtWindow::ReceiveHandlers;
    return *sHandlers;
}

template <typename List, typename Handler>
bool addHandler(List& list, Handler handler, void* refCon)
{
    if (!handler)
        return false;
    list.emplace_back(handler, refCon);
    return true;
}

template <typename List, typename Handler>
bool removeHandler(List& list, Handler handler)
{
    auto it = std::find_if(list.begin(), list.end(),
                           [handler](const auto& entry) { return entry.first == handler; });
    if (it == list.end())
        return false;
    list.erase(it);
    return true;
}

} // namespace

// ---- IWindowEventHandler defaults ----------------------------------------------------------

IWindowEventHandler::~IWindowEventHandler() = default;
void IWindowEventHandler::DrawOverlays(QPainter&, const QRegion&) {}
void IWindowEventHandler::UpdateSizeLimits() {}
void IWindowEventHandler::ZoomEventHandler() {}
bool IWindowEventHandler::GrowEventHandler(SInt32, SInt32, SInt32, SInt32)
{
    return false;
}
bool IWindowEventHandler::DropOnWindowTabHandler(SInt16)
{
    return false;
}
void IWindowEventHandler::SetInResizeState(bool) {}

// ---- Construction and deletion ---------------------------------------------------------------

AQtWindow::AQtWindow(IWindowEventHandler* handler, UInt32 windowClass)
    : QWidget(Brindle::DecorationManager::GetHiddenDefaultParent()),
      m_serial(gNextSerial++),
      m_windowClass(windowClass),
      m_eventHandler(handler),
      m_enableDirectQtDrawing(gDefaultDirectQtDrawing)
{
    ensureWindowHooks();
    registerWindow(this);
    setFocusPolicy(Qt::StrongFocus);
    setAttribute(Qt::WA_OpaquePaintEvent);
    setAttribute(Qt::WA_NoSystemBackground);
    setAcceptDrops(true);
    m_port = makeWindowPort(this);
}

AQtWindow::~AQtWindow()
{
    // Windows go through DisposeWindow; one deleted any other way is reported and still
    // taken out of everything that could reach it.
    VELMAR_ASSERT(m_deletePending, "m_deletePending");
    if (!m_deletePending) {
        m_deletePending = true;
        m_eventHandler = nullptr;
        FlushEventReferences(this);
    }
    clearPendingUpdateEvent();
    DelayedDecoration::removeWindow(this);
    delete m_port;
    m_port = nullptr;
    unregisterWindow(this);
}

void AQtWindow::Dispose()
{
    if (m_deletePending)
        return;
    m_eventHandler = nullptr;
    m_deletePending = true;
    m_enableEventHandling = false;
    ManagedWindow::CloseWindow();
    FlushEventReferences(this);
    clearPendingUpdateEvent();
    dirtyPortSetRemove(this);
    delete m_port;
    m_port = nullptr;
    deleteWhenFree(this);
}

// ---- Port and drawing mode ---------------------------------------------------------------------

void AQtWindow::recreatePort()
{
    const bool wasCurrent = m_port && currentGrafPort() == m_port;
    delete m_port;
    m_port = makeWindowPort(this);
    if (wasCurrent)
        gCurrentGrafPort = m_port;
}

bool AQtWindow::enableDirectQtDrawing(bool on)
{
    const bool previous = m_enableDirectQtDrawing;
    if (on == previous)
        return previous;
    m_enableDirectQtDrawing = on;
    recreatePort();
    if (isVisible()) {
        if (on)
            dirtyPortSetRemove(this);
        else
            dirtyPortSetAdd(this);
        syncUpdateEvent(2);
    }
    return previous;
}

bool AQtWindow::enableEventHandling(bool on)
{
    const bool previous = m_enableEventHandling;
    // Painting through a handler needs one.
    m_enableEventHandling = on && m_eventHandler;
    return previous;
}

bool AQtWindow::enablePaintEventPropagation(bool on)
{
    const bool previous = m_paintEventPropagation;
    m_paintEventPropagation = on;
    return previous;
}

void AQtWindow::SetDynViewProperty(bool on)
{
    m_dynView = on;
}

bool AQtWindow::defaultDirectQtDrawing()
{
    return gDefaultDirectQtDrawing;
}

void AQtWindow::setDefaultDirectQtDrawing(bool on)
{
    gDefaultDirectQtDrawing = on;
}

bool AQtWindow::supportLegacyMacEventProcessing() const
{
    if (m_enableDirectQtDrawing)
        return false;
    return SupportLegacyMacEventProcessing(kFeatureFlagQuery) != 0;
}

// ---- Title and properties ---------------------------------------------------------------------

void AQtWindow::setWindowTitle(const QString& title)
{
    QWidget::setWindowTitle(title);
    m_title = title.toLocal8Bit().toStdString();
    if (Brindle::Decorator* decorator = GetDecorator())
        decorator->SetTitle(title);
}

void AQtWindow::setProperty(UInt32 creator, UInt32 tag, const void* data, UInt32 size)
{
    std::vector<UInt8>& bytes = m_properties[{creator, tag}];
    bytes.assign(size, 0);
    if (data && size)
        std::memcpy(bytes.data(), data, size);
}

const std::vector<UInt8>* AQtWindow::property(UInt32 creator, UInt32 tag) const
{
    auto it = m_properties.find({creator, tag});
    return it == m_properties.end() ? nullptr : &it->second;
}

bool AQtWindow::removeProperty(UInt32 creator, UInt32 tag)
{
    return m_properties.erase({creator, tag}) != 0;
}

// ---- Drag handler lists -----------------------------------------------------------------------

bool AQtWindow::setTrackingHandler(DragTrackingHandlerUPP handler, void* refCon)
{
    return addHandler(m_trackingHandlers, handler, refCon);
}

bool AQtWindow::removeTrackingHandler(DragTrackingHandlerUPP handler)
{
    return removeHandler(m_trackingHandlers, handler);
}

bool AQtWindow::setReceiveHandler(DragReceiveHandlerUPP handler, void* refCon)
{
    return addHandler(m_receiveHandlers, handler, refCon);
}

bool AQtWindow::removeReceiveHandler(DragReceiveHandlerUPP handler)
{
    return removeHandler(m_receiveHandlers, handler);
}

bool AQtWindow::setGlobalTrackingHandler(DragTrackingHandlerUPP handler, void* refCon)
{
    return addHandler(globalTracking(), handler, refCon);
}

bool AQtWindow::removeGlobalTrackingHandler(DragTrackingHandlerUPP handler)
{
    return removeHandler(globalTracking(), handler);
}

bool AQtWindow::setGlobalReceiveHandler(DragReceiveHandlerUPP handler, void* refCon)
{
    return addHandler(globalReceive(), handler, refCon);
}

bool AQtWindow::removeGlobalReceiveHandler(DragReceiveHandlerUPP handler)
{
    return removeHandler(globalReceive(), handler);
}

const AQtWindow::TrackingHandlers& AQtWindow::globalTrackingHandlers()
{
    return globalTracking();
}

const AQtWindow::ReceiveHandlers& AQtWindow::globalReceiveHandlers()
{
    return globalReceive();
}

// ---- Managed-window state ----------------------------------------------------------------------

void AQtWindow::GetWindowProperties(Properties& properties)
{
    if (!m_resizeable)
        properties.clear(kPropertyResizable);
    if (windowModality() == Qt::ApplicationModal) {
        properties.clear(kPropertyCloseBox);
        properties.set(kPropertyModal | kPropertyDocument);
    }
    if (m_eventHandler) {
        m_eventHandler->GetWindowProperties(properties);
    } else {
        properties.set(kPropertyDocument);
        properties.clear(0xFE);
    }
}

const Brindle::DecorationState* AQtWindow::GetDecorationState()
{
    return m_eventHandler ? m_eventHandler->GetDecorationState() : nullptr;
}

void AQtWindow::SetWindowActivated(bool activated)
{
    m_activated = activated;
    ManagedWindow::SetWindowActivated(activated);
}

void AQtWindow::CloseWindow()
{
    ManagedWindow::CloseWindow();
}

bool AQtWindow::IsGrowBoxIconDrawnByDecorator()
{
    return m_dynView || ManagedWindow::IsGrowBoxIconDrawnByDecorator();
}

void AQtWindow::UpdateSizeLimits()
{
    if (m_enableEventHandling && m_eventHandler)
        callWindowHandler(this, [this] { m_eventHandler->UpdateSizeLimits(); });
}

bool AQtWindow::GrowEvent(SInt32 left, SInt32 top, SInt32 right, SInt32 bottom)
{
    if (!m_enableEventHandling || !m_eventHandler)
        return false;
    bool grown = false;
    return callWindowHandler(this, [&] { grown = m_eventHandler->GrowEventHandler(left, top, right, bottom); })
        && grown;
}

void AQtWindow::SetInHighlightState(bool inHighlight)
{
    m_inHighlightState = inHighlight;
    update();
}

bool AQtWindow::IsMinimizeMaximizeEvent()
{
    constexpr Qt::WindowStates kSizeStates = Qt::WindowMinimized | Qt::WindowMaximized
        | Qt::WindowFullScreen;
    const Qt::WindowStates now = window()->windowState();
    const bool changed = (now & kSizeStates) != (m_lastWindowState & kSizeStates);
    m_lastWindowState = now;
    return changed;
}

// ---- DelayedDecoration ---------------------------------------------------------------------------

namespace {
DelayedDecoration* gDelayedTop = nullptr;
}

DelayedDecoration::DelayedDecoration(IWindowEventHandler* handler)
    : m_handler(handler), m_older(gDelayedTop)
{
    VELMAR_ASSERT(handler, "pHandler");
    gDelayedTop = this;
}

DelayedDecoration::~DelayedDecoration()
{
    if (m_window) {
        if (Brindle::DecorationManager* manager = Brindle::DecorationManager::Instance())
            manager->Decorate(m_window);
    }
    // Scopes end in order; should one outlive a younger one, it still leaves the stack.
    for (DelayedDecoration** link = &gDelayedTop; *link; link = &(*link)->m_older) {
        if (*link == this) {
            *link = m_older;
            break;
        }
    }
}

DelayedDecoration* DelayedDecoration::instance()
{
    return gDelayedTop;
}

bool DelayedDecoration::checkWindow(Brindle::ManagedWindow* window, IWindowEventHandler* handler)
{
    VELMAR_ASSERT(window, "window");
    for (DelayedDecoration* d = gDelayedTop; d; d = d->m_older) {
        if (d->m_handler == handler) {
            d->m_window = window;
            return true;
        }
    }
    return false;
}

void DelayedDecoration::removeWindow(Brindle::ManagedWindow* window)
{
    for (DelayedDecoration* d = gDelayedTop; d; d = d->m_older) {
        if (d->m_window == window) {
            d->m_window = nullptr;
            return;
        }
    }
}

// ---- SuspendUpdateEvents -----------------------------------------------------------------------

namespace {
QPointer<AQtWindow>& suspendedFor()
{
    static auto* sWindow = new QPointer<AQtWindow>;
    return *sWindow;
}
} // namespace

SuspendUpdateEvents::SuspendUpdateEvents(AQtWindow* window, bool suspend)
    : m_saved(suspendedFor())
{
    if (suspend)
        suspendedFor() = window;
}

SuspendUpdateEvents::~SuspendUpdateEvents()
{
    suspendedFor() = m_saved;
}

bool SuspendUpdateEvents::checkFor(const AQtWindow* window)
{
    const QPointer<AQtWindow>& named = suspendedFor();
    return named && named.data() != window;
}

} // namespace Velmar
