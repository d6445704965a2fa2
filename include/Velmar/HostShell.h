// Default host UI-shell services: managed windows, decorations and the palette.
//
// A host with its own UI shell replaces these at run time (DecorationManager::SetFactory,
// PaletteManager::SetInstance, SetLeftButtonSource); the library only goes through them.
// Without a shell, windows keep the window system's own frames and the palette is empty.
#pragma once

#include <Velmar/MacTypes.h>

#include <QPoint>
#include <QRect>
#include <QSize>
#include <QString>
#include <QtCore/qnamespace.h>

class QMenuBar;
class QWidget;

namespace Velmar {

namespace Brindle {

class ManagedWindow;

// How the shell currently shows a window (title bar state, tab state ...). The library only
// passes it through from the window's event handler to the shell.
struct VELMAR_EXPORT DecorationState {
    bool active = false;
    bool highlighted = false;
};

// The shell's frame around a managed window. Geometry is in the shell's placement area,
// whose top-left corner in global coordinates is ReferenceOrigin().
class VELMAR_EXPORT Decorator {
public:
    virtual ~Decorator();
    virtual QPoint ReferenceOrigin() const = 0;
    virtual QRect FrameGeometry() const = 0;
    virtual QRect ContentGeometry() const = 0;
    virtual void SetFrameGeometry(const QRect& frame) = 0;
    virtual void SetContentGeometry(const QRect& content) = 0;
    virtual void MoveContent(const QPoint& topLeft) = 0;
    virtual void SetContentSize(const QSize& size) = 0;
    virtual void SetTitle(const QString& title) = 0;
    virtual void SelectWindow() = 0;
};

// The UI shell's view of a window. The virtual operations keep their order: a shell built
// against this layout calls them by slot.
class VELMAR_EXPORT ManagedWindow {
public:
    // Window property bits (a document window: 0x1; resizable: 0x200; modal: 0x100).
    struct Properties {
        UInt32 bits = 0;
        bool test(UInt32 mask) const { return (bits & mask) != 0; }
        void set(UInt32 mask) { bits |= mask; }
        void clear(UInt32 mask) { bits &= ~mask; }
    };
    enum : UInt32 {
        kPropertyDocument = 0x001,
        kPropertyCloseBox = 0x008,
        kPropertyModal = 0x100,
        kPropertyResizable = 0x200,
    };
    using MovedHandler = void (*)(ManagedWindow* window, void* context);

    ManagedWindow();
    ManagedWindow(const ManagedWindow&) = delete;
    ManagedWindow& operator=(const ManagedWindow&) = delete;
    virtual ~ManagedWindow();

    virtual QWidget* GetWidget() = 0;
    virtual void SkinChangedHandle();
    virtual void GetWindowProperties(Properties& properties) = 0;
    virtual const DecorationState* GetDecorationState() = 0;
    virtual void SetContentSize(const QSize& size);
    virtual void MoveWindow(const QPoint& contentTopLeft);
    virtual QWidget* GetTopWindow();
    virtual void ActivateWindow(bool activate);
    virtual bool IsWindowActivated();
    virtual void SetWindowActivated(bool activated);
    virtual void SelectWindow();
    virtual void CloseWindow();
    virtual void SelectAndShow();
    virtual void SetWindowVisible(bool visible);
    virtual bool IsGrowBoxIconDrawnByDecorator();
    virtual void UpdateSizeLimits();
    virtual bool ZoomEvent();
    virtual bool GrowEvent(SInt32 left, SInt32 top, SInt32 right, SInt32 bottom);
    virtual void SetInResizeState(bool inResize);
    virtual void SetInHighlightState(bool inHighlight);
    virtual void InstallManagedWindowHasMovedHandler(MovedHandler handler, void* context);
    virtual void InformHandlerManagedWindowHasMoved();
    virtual bool AcceptDropOnWindowTab(Qt::KeyboardModifiers modifiers);

    // The shell's frame, null while the window system's own frame is used. Not owned.
    Decorator* GetDecorator() const { return m_decorator; }
    void SetDecorator(Decorator* decorator) { m_decorator = decorator; }

    // Geometry in global coordinates less the reference origin (the origin is (0, 0)
    // without a decorator). Content: the widget; frame: the content plus its frame.
    QPoint ReferenceOrigin() const;
    QRect ContentGeometry();
    QRect FrameGeometry();
    void SetContentGeometry(const QRect& content);
    void SetFrameGeometry(const QRect& frame);
    // Shown on screen: the top-level widget is visible and not minimised.
    bool IsCurrentlyVisible();

private:
    Decorator* m_decorator = nullptr;
    MovedHandler m_movedHandler = nullptr;
    void* m_movedContext = nullptr;
    bool m_activated = false;
};

// Decorates managed windows for the application. One instance at a time is current; the
// application creates it through Create() so that a host's factory can supply its own.
class VELMAR_EXPORT DecorationManager {
public:
    enum MdiMode { kMdiDecorated = 0, kMdiNative = 2 };
    using Factory = DecorationManager* (*)(QMenuBar* menuBar, int mdiMode);

    DecorationManager(QMenuBar* menuBar, int mdiMode);
    DecorationManager(const DecorationManager&) = delete;
    DecorationManager& operator=(const DecorationManager&) = delete;
    virtual ~DecorationManager();

    QMenuBar* MenuBar() const { return m_menuBar; }
    int MdiMode() const { return m_mdiMode; }

    // Gives the window its frame; the default leaves the window system's frame.
    virtual void Decorate(ManagedWindow* window);
    virtual void Undecorate(ManagedWindow* window);
    // Parent for new windows while they are not yet decorated; the default has none.
    virtual QWidget* HiddenDefaultParent() const;
    // Puts the application's menu bar where the user sees it: into `window` when one is
    // given (a QMainWindow's menu bar, or the top of its layout), otherwise as a strip
    // across the top of the primary screen, as the classic menu bar was. A shell that
    // places the bar itself overrides this. Called when the bar gets its first menu and
    // whenever the host moves it (SetMenuBarWindow).
    virtual void PlaceMenuBar(QMenuBar* menuBar, QWidget* window);

    static DecorationManager* Instance(); // the current one, null when none exists
    static QWidget* GetHiddenDefaultParent(); // of the current instance; null without one
    static DecorationManager* Create(QMenuBar* menuBar, int mdiMode); // through the factory
    static Factory SetFactory(Factory factory); // null restores the default

private:
    QMenuBar* m_menuBar;
    int m_mdiMode;
    DecorationManager* m_previous;
};

// The system's left mouse button (default: asked of the window system through the
// platform layer, falling back to the state seen in Qt's own events).
using LeftButtonSource = bool (*)();
VELMAR_EXPORT bool isLeftButtonDown_sys();
VELMAR_EXPORT LeftButtonSource SetLeftButtonSource(LeftButtonSource source);

} // namespace Brindle

namespace Palette {

// Look-and-feel values by name. Empty by default: every Get answers false and leaves the
// output alone, so callers keep their own defaults.
class VELMAR_EXPORT PaletteManager {
public:
    PaletteManager();
    PaletteManager(const PaletteManager&) = delete;
    PaletteManager& operator=(const PaletteManager&) = delete;
    virtual ~PaletteManager();

    virtual bool GetTxRGBColorBasedOnHighlightIndex(const QString& key, RGBColor& color) const;
    virtual bool GetUint16(const QString& key, UInt16& value) const;
    virtual bool GetSInt32(const QString& key, SInt32& value) const;
    virtual bool GetString(const QString& key, QString& value) const;

    void SetColor(const QString& key, const RGBColor& color);
    void SetUint16(const QString& key, UInt16 value);
    void SetSInt32(const QString& key, SInt32 value);
    void SetString(const QString& key, const QString& value);
    void Remove(const QString& key);
    void Clear();

    static PaletteManager* Instance();
    static PaletteManager* SetInstance(PaletteManager* manager); // not owned; null: default

private:
    struct Values;
    Values* m_values;
};

} // namespace Palette

} // namespace Velmar
