// The window object: at once a Toolbox window (a WindowRef points to one), the Qt widget the
// user sees, and a managed window of the host's UI shell. QuickDraw draws into its port's
// back buffer; the paint event copies what was drawn to the screen.
#pragma once

#include <Velmar/HostShell.h>
#include <Velmar/MacTypes.h>
#include <Velmar/QDTypes.h>
#include <Velmar/WindowRef.h>

#include <QObject>
#include <QPointer>
#include <QRect>
#include <QRegion>
#include <QSize>
#include <QWidget>

#include <map>
#include <string>
#include <utility>
#include <vector>

namespace Velmar {
class CommonTextEditAPI;
class Drag;
namespace Private {
class EventQueueItem;
struct AQtWindowPrivate;
} // namespace Private
} // namespace Velmar

// Lets qobject_cast and qt_metacast find the shell's interface on a window.
Q_DECLARE_INTERFACE(Velmar::Brindle::ManagedWindow, "Brindle::ManagedWindow")

namespace Velmar {

// What the host supplies to paint a window and answer for it when it does not want update
// events. The virtual operations keep their order.
class VELMAR_EXPORT IWindowEventHandler {
public:
    virtual ~IWindowEventHandler();
    virtual void PaintEventHandler(QPainter* painter, const QRegion& updateRegion) = 0;
    virtual void DrawOverlays(QPainter& painter, const QRegion& region);
    virtual void ShowEventHandler() = 0;
    virtual void ResizeEventHandler() = 0;
    virtual void GetWindowProperties(Brindle::ManagedWindow::Properties& properties) = 0;
    virtual const Brindle::DecorationState* GetDecorationState() = 0;
    virtual void UpdateSizeLimits();
    virtual void ZoomEventHandler();
    virtual bool GrowEventHandler(SInt32 left, SInt32 top, SInt32 right, SInt32 bottom);
    virtual bool DropOnWindowTabHandler(SInt16 modifiers);
    virtual void SetInResizeState(bool inResize);
};

// Drag handlers a window or the application installs; the drag manager calls them with
// the tracking messages 1 enter application, 2 enter window, 3 in window, 4 leave window,
// 5 leave application.
using DragTrackingMessage = SInt16;
using DragTrackingHandlerUPP = SInt16 (*)(DragTrackingMessage message, WindowRef window,
                                          void* refCon, Drag* drag);
using DragReceiveHandlerUPP = SInt16 (*)(WindowRef window, void* refCon, Drag* drag);

class VELMAR_EXPORT AQtWindow : public QWidget, public Brindle::ManagedWindow {
    Q_OBJECT
    Q_INTERFACES(Velmar::Brindle::ManagedWindow)
    Q_PROPERTY(bool DynViewWindow READ isDynViewWindow WRITE SetDynViewProperty)
    Q_PROPERTY(bool DirectQtDrawing READ isDirectQtDrawing WRITE setDirectQtDrawingProperty)
    Q_PROPERTY(bool EventHandling READ isEventHandlingEnabled WRITE setEventHandlingProperty)

public:
    AQtWindow(IWindowEventHandler* handler, UInt32 windowClass);
    ~AQtWindow() override;

    // ---- Port and widget --------------------------------------------------------------
    GrafPtr GetPort() const { return m_port; }
    QWidget* GetWidget() override { return this; }
    int serial() const { return m_serial; }
    UInt32 windowClass() const { return m_windowClass; }
    void setWindowClass(UInt32 windowClass) { m_windowClass = windowClass; }
    SInt16 variant() const { return m_wVariant; }
    void setVariant(SInt16 variant) { m_wVariant = variant; }
    SInt16 kind() const { return m_kind; }
    void setKind(SInt16 kind) { m_kind = kind; }
    void* refCon() const { return m_refCon; }
    void setRefCon(void* refCon) { m_refCon = refCon; }
    IWindowEventHandler* eventHandler() const { return m_eventHandler; }
    CommonTextEditAPI* focusProxyTextEdit() const { return m_focusProxyTextEdit; }
    void setFocusProxyTextEdit(CommonTextEditAPI* edit) { m_focusProxyTextEdit = edit; }
    const std::string& titleText() const { return m_title; }
    void setWindowTitle(const QString& title);

    // ---- Update region and update events -----------------------------------------------
    const QRegion& updateRegion() const { return m_updateRegion; }
    void addUpdateRegion(const QRect& rect);
    void addUpdateRegion(const QRegion& region);
    void removeUpdateRegion(const QRegion& region);
    void beginUpdate();
    void endUpdate();
    bool isUpdateStarted() const { return m_updateStarted; }
    Private::EventQueueItem* pendingUpdateEvent() const { return m_pendingUpdateEvent; }
    void clearPendingUpdateEvent();
    static void clearAllPendingUpdateEvents();
    static int pendingUpdateEventCount();
    bool supportLegacyMacEventProcessing() const;

    // ---- Back buffer and dirty area ----------------------------------------------------
    void markGrafPortDirty(const QRect& rect);
    bool isGrafPortDirty() const { return !m_dirtyPortRect.isNull(); }
    const QRect& dirtyPortRegion() const { return m_dirtyPortRect; }
    bool flushDirtyPort(bool immediately);
    static bool RepaintDirtyPorts(bool immediately);
    void scrollRect(SInt32 dx, SInt32 dy, const QRect& rect);
    void scaleGrafPortToWindow(const QSize& size);
    void syncUpdateEvent(int mode);
    UInt32 paintEventCalls() const { return m_paintEventCalls; }
    bool isInPaintEvent() const { return m_inPaintEvent; }

    // ---- Modes ------------------------------------------------------------------------
    bool enableDirectQtDrawing(bool on);
    bool isDirectQtDrawing() const { return m_enableDirectQtDrawing; }
    bool enableEventHandling(bool on);
    bool isEventHandlingEnabled() const { return m_enableEventHandling; }
    bool enablePaintEventPropagation(bool on);
    bool isDynViewWindow() const { return m_dynView; }
    void SetDynViewProperty(bool on);
    // The drawing mode new windows start in (the inspector changes it).
    static bool defaultDirectQtDrawing();
    static void setDefaultDirectQtDrawing(bool on);

    // ---- Toolbox state ------------------------------------------------------------------
    const QRect& zoomRect() const { return m_zoomRect; }
    const QRect& userRect() const { return m_userRect; }
    void setZoomRect(const QRect& rect) { m_zoomRect = rect; }
    void setUserRect(const QRect& rect) { m_userRect = rect; }
    bool IsResizeable() const { return m_resizeable; }
    void SetIsResizeable(bool on) { m_resizeable = on; }
    QSize sizeHint() const override { return m_contentSize; }
    void setProperty(UInt32 creator, UInt32 tag, const void* data, UInt32 size);
    // The stored bytes, or null when absent.
    const std::vector<UInt8>* property(UInt32 creator, UInt32 tag) const;
    bool removeProperty(UInt32 creator, UInt32 tag);

    // ---- Life ---------------------------------------------------------------------------
    // Starts the deletion: the window is hidden, forgotten by the queue and deleted later.
    void Dispose();
    bool IsDeletePending() const { return m_deletePending; }

    // ---- Drag handlers --------------------------------------------------------------------
    bool setTrackingHandler(DragTrackingHandlerUPP handler, void* refCon);
    bool removeTrackingHandler(DragTrackingHandlerUPP handler);
    bool setReceiveHandler(DragReceiveHandlerUPP handler, void* refCon);
    bool removeReceiveHandler(DragReceiveHandlerUPP handler);
    static bool setGlobalTrackingHandler(DragTrackingHandlerUPP handler, void* refCon);
    static bool removeGlobalTrackingHandler(DragTrackingHandlerUPP handler);
    static bool setGlobalReceiveHandler(DragReceiveHandlerUPP handler, void* refCon);
    static bool removeGlobalReceiveHandler(DragReceiveHandlerUPP handler);
    using TrackingHandlers = std::vector<std::pair<DragTrackingHandlerUPP, void*>>;
    using ReceiveHandlers = std::vector<std::pair<DragReceiveHandlerUPP, void*>>;
    const TrackingHandlers& trackingHandlers() const { return m_trackingHandlers; }
    const ReceiveHandlers& receiveHandlers() const { return m_receiveHandlers; }
    static const TrackingHandlers& globalTrackingHandlers();
    static const ReceiveHandlers& globalReceiveHandlers();

    // ---- Managed window -------------------------------------------------------------------
    void GetWindowProperties(Properties& properties) override;
    const Brindle::DecorationState* GetDecorationState() override;
    void SetContentSize(const QSize& size) override;
    void ActivateWindow(bool activate) override;
    bool IsWindowActivated() override { return m_activated; }
    void SetWindowActivated(bool activated) override;
    void SelectWindow() override;
    void CloseWindow() override;
    bool IsGrowBoxIconDrawnByDecorator() override;
    void UpdateSizeLimits() override;
    bool ZoomEvent() override;
    bool GrowEvent(SInt32 left, SInt32 top, SInt32 right, SInt32 bottom) override;
    void SetInResizeState(bool inResize) override;
    void SetInHighlightState(bool inHighlight) override;
    bool AcceptDropOnWindowTab(Qt::KeyboardModifiers modifiers) override;

    // True once for a resize that minimised, maximised or restored the window; remembers the
    // window's state for the next one.
    bool IsMinimizeMaximizeEvent();

protected:
    bool event(QEvent* e) override;
    void paintEvent(QPaintEvent* e) override;
    void resizeEvent(QResizeEvent* e) override;
    void inputMethodEvent(QInputMethodEvent* e) override;

private:
    void setDirectQtDrawingProperty(bool on) { enableDirectQtDrawing(on); }
    void setEventHandlingProperty(bool on) { enableEventHandling(on); }
    void MakeUpdateEventIfNecessary();
    void invalidateWholeWidget();
    void recreatePort();
    void paintBackBuffer(QPainter& painter, const QRegion& region);
    void paintHighlightFrame(QPainter& painter);
    void consumeUpdateRegion(QPainter* painter, const QRegion& eventRegion, bool fillBackground);
    bool handleShowHide(QEvent* e);
    bool postConverted(QEvent* e);

    std::string m_title;
    int m_serial;
    GrafPtr m_port = nullptr;
    UInt32 m_windowClass;
    CommonTextEditAPI* m_focusProxyTextEdit = nullptr;
    SInt16 m_wVariant = 0;
    QRect m_dirtyPortRect;
    QRegion m_updateRegion;
    Private::EventQueueItem* m_pendingUpdateEvent = nullptr;
    QRect m_zoomRect;
    QRect m_userRect;
    QSize m_contentSize{-1, -1};
    bool m_updateStarted = false;
    bool m_updateRegionChanged = false;
    bool m_dynView = false;
    bool m_resizeable = false;
    SInt16 m_kind = 0;
    void* m_refCon = nullptr;
    std::map<std::pair<UInt32, UInt32>, std::vector<UInt8>> m_properties;
    IWindowEventHandler* m_eventHandler;
    bool m_paintEventPropagation = true;
    bool m_enableDirectQtDrawing;
    bool m_enableEventHandling = false;
    bool m_activated = false;
    bool m_deletePending = false;
    bool m_inPaintEvent = false;
    bool m_inSyncUpdate = false;
    bool m_inFlush = false;
    bool m_inResizeState = false;
    TrackingHandlers m_trackingHandlers;
    ReceiveHandlers m_receiveHandlers;
    bool m_inHighlightState = false;
    UInt32 m_paintEventCalls = 0;
    // Re-entry guards of SelectWindow, ActivateWindow and SetContentSize.
    bool m_inSelectWindow = false;
    bool m_inActivateWindow = false;
    bool m_inSetContentSize = false;
    Qt::WindowStates m_lastWindowState = Qt::WindowNoState;

    friend struct Private::AQtWindowPrivate;
};

// Holds back the shell's decoration of the window made for `handler` until it goes out of
// scope, so that the window is decorated once, fully set up.
class VELMAR_EXPORT DelayedDecoration {
public:
    explicit DelayedDecoration(IWindowEventHandler* handler);
    ~DelayedDecoration();
    DelayedDecoration(const DelayedDecoration&) = delete;
    DelayedDecoration& operator=(const DelayedDecoration&) = delete;

    static DelayedDecoration* instance();
    // Records `window` with the innermost instance waiting for `handler`; false when none is.
    static bool checkWindow(Brindle::ManagedWindow* window, IWindowEventHandler* handler);
    static void removeWindow(Brindle::ManagedWindow* window);

private:
    IWindowEventHandler* m_handler;
    Brindle::ManagedWindow* m_window = nullptr;
    DelayedDecoration* m_older;
};

// Names the one window whose paint events may still consume update regions while it lives.
class VELMAR_EXPORT SuspendUpdateEvents {
public:
    SuspendUpdateEvents(AQtWindow* window, bool suspend);
    ~SuspendUpdateEvents();
    SuspendUpdateEvents(const SuspendUpdateEvents&) = delete;
    SuspendUpdateEvents& operator=(const SuspendUpdateEvents&) = delete;

    // True when a window is named and it is not `window`.
    static bool checkFor(const AQtWindow* window);

private:
    QPointer<AQtWindow> m_saved;
};

} // namespace Velmar
