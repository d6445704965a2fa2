// The one place that talks to the operating system or the window system directly.
// Windows virtual-key codes stay the library's key vocabulary on every platform: the codes
// are named in platform/VirtualKeys.h, and platform/KeyTables.h turns Qt keys into them.
// Backends: platform/windows (Win32); off Windows, platform/unix picks at run time from Qt's
// platform name (platform/WindowSystem.h): platform/x11 (the X server through Qt's xcb
// connection), platform/wayland (what the compositor lets a client do), or Qt's own events
// alone (offscreen, no application).
#pragma once

#include <Velmar/MacTypes.h>

#include <QImage>
#include <QPoint>
#include <QString>

class QEvent;
class QWidget;

namespace Velmar::Private::Platform {

// Keyboard, by Windows virtual-key code (VK_SHIFT 0x10, VK_CONTROL 0x11, VK_MENU 0x12 ...).
bool isAsyncKeyDown(int virtualKey);
bool isCapsLockToggled();
// 256 entries: bit 0x80 set while the key is down, bit 0x01 for a toggled key.
void getKeyboardState(UInt8 state[256]);

// The system's left mouse button, asked of the window system where there is one.
bool isSystemLeftButtonDown();

// The pointer in global coordinates: asked of the window system where it can be (X11,
// Windows), else where Qt's last mouse event put it (Wayland tells a client only while the
// pointer is over one of its windows).
QPoint pointerPosition();

// The virtual key of the key that types `character` on the current layout (VkKeyScanA's low
// byte); 0 when no key does. Without a window system to ask, the US layout.
int virtualKeyForCharacter(char character);
// The Windows language identifier of the keyboard layout (0x0409 US English, 0x040C French).
// Off Windows it follows the input method's locale (on Wayland only once a keyboard has sent
// this process a key: Qt 6.4 crashes asking a compositor without a seat), else the system's.
int keyboardLanguageId();

// Feeds Qt's own key and mouse events to the fallback state used where the window system
// cannot be asked (offscreen, Wayland). Cheap; called from the application's event filter.
void trackInputEvent(const QEvent* event);
// Off: answer every key and button query from the tracked events even where the window
// system could be asked (tests, and hosts that want only their own input counted).
void setWindowSystemInputEnabled(bool enabled);

// Writes one finished line to the debugger output channel (standard error off Windows).
void debugOutput(const char* line);

// True when native input is waiting that Qt has not yet seen. Always false off Windows.
bool isNativeInputPending();

// Native window handle of a top-level widget, and native z-order placement: put `window`
// directly behind `behind` (null: to the back). The library's window list is the order that
// counts; X11 restacks sibling child widgets only and leaves top-level stacking to the
// window manager, Windows makes the historical SetWindowPos call.
void* nativeWindowHandle(QWidget* window);
void placeNativeWindowBehind(QWidget* window, QWidget* behind);
// Asks the window manager to keep the top `height` pixels of the screen for `window` (the
// menu-bar strip), so that other windows are placed below it. Nothing where it cannot.
void reserveScreenTop(QWidget* window, int height);

// An image for a window back buffer: DIB-backed on Windows, a plain QImage elsewhere. 32 bits
// a pixel (premultiplied ARGB), or 5-6-5 for QImage::Format_RGB16.
QImage createWindowImage(int width, int height,
                         QImage::Format format = QImage::Format_ARGB32_Premultiplied);
// The native drawing context behind such an image; null off Windows or for other images.
void* windowImageDeviceContext(const QImage& image);

// Optional diagnostic libraries.
QString executableDirectory();
QString sharedLibraryFileName(const QString& baseName); // "X.dll", "libX.so"
void* loadLibrary(const QString& path);
void* resolveSymbol(void* library, const char* name);

void debugBreak();
bool isApplicationInForeground();

} // namespace Velmar::Private::Platform
