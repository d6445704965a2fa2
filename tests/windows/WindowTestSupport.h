// Shared by the window tests: windows that clean up after themselves, what reached the queue,
// and the screen's own pixels.
#pragma once

#include "TestSupport.h"

#include <Velmar/AQtWindow.h>
#include <Velmar/Diagnostics.h>
#include <Velmar/QDRegions.h>
#include <Velmar/QtGrafPort.h>
#include <Velmar/Windows.h>

#include "events/EventQueue.h"
#include "foundation/Conversions.h"
#include "windows/WindowPrivate.h"

#include <QGuiApplication>
#include <QScreen>

namespace WindowTest {

using namespace Velmar;

inline Rect R(int top, int left, int bottom, int right)
{
    return Rect{SInt16(top), SInt16(left), SInt16(bottom), SInt16(right)};
}

// A window made by CreateNewWindow, disposed with the scope unless the test did it.
class Window {
public:
    Window(WindowClass windowClass, WindowAttributes attributes, const Rect& bounds,
           IWindowEventHandler* handler = nullptr)
    {
        CreateNewWindowEx(handler, windowClass, attributes, &bounds, &m_window);
    }
    explicit Window(const Rect& bounds) : Window(kDocumentWindowClass, kWindowStandardDocumentAttributes, bounds) {}
    ~Window()
    {
        if (Private::isLive(m_window.get()) && !m_window->IsDeletePending())
            DisposeWindow(m_window);
    }
    Window(const Window&) = delete;
    Window& operator=(const Window&) = delete;

    operator WindowRef() const { return m_window; }
    AQtWindow* operator->() const { return m_window.get(); }
    AQtWindow* get() const { return m_window.get(); }

    // Shown, and exposed on the X server.
    void show() const
    {
        ShowWindow(m_window);
        QVERIFY(QTest::qWaitForWindowExposed(m_window->window()));
    }

private:
    WindowRef m_window;
};

// The queue as "class/kind@window-serial" entries, oldest first.
inline QStringList queued()
{
    QStringList out;
    for (const auto& item : Private::gMainEventQueue.items()) {
        const UInt32 c = item->eventClass;
        const char cls[5] = {char(c >> 24), char(c >> 16), char(c >> 8), char(c), 0};
        QString kind = QString::number(item->eventKind);
        if (c == Private::kEventClassVelmar) {
            const UInt32 k = item->eventKind;
            const char text[5] = {char(k >> 24), char(k >> 16), char(k >> 8), char(k), 0};
            kind = QString::fromLatin1(text);
        }
        out << QStringLiteral("%1/%2").arg(QString::fromLatin1(cls), kind);
    }
    return out;
}

// What the X server shows in a global rectangle.
inline QImage screenPixels(const QRect& global)
{
    QScreen* screen = QGuiApplication::primaryScreen();
    return screen->grabWindow(0, global.x(), global.y(), global.width(), global.height()).toImage();
}

// The window's port made current for one scope.
class OnPort {
public:
    explicit OnPort(WindowRef window) { GetPort(&m_saved); SetPortWindowPort(window); }
    ~OnPort() { SetPort(m_saved); }
    OnPort(const OnPort&) = delete;
    OnPort& operator=(const OnPort&) = delete;

private:
    GrafPtr m_saved = nullptr;
};

} // namespace WindowTest
