// Real input through the X server (the XTEST extension), for tests that must see what a user's
// keys and clicks do. libXtst and libX11 are loaded at run time: no build dependency.
#pragma once

#include <QGuiApplication>
#include <QPoint>
#include <QTest>

#if defined(Q_OS_UNIX)
#include <dlfcn.h>
#endif

namespace VelmarTest {

struct XDisplay;

class XTestInput {
public:
    // False without an X display or the XTEST library: the caller skips.
    bool load()
    {
#if QT_CONFIG(xcb) && defined(Q_OS_UNIX)
        auto* x11 = qApp->nativeInterface<QNativeInterface::QX11Application>();
        m_display = x11 ? reinterpret_cast<XDisplay*>(x11->display()) : nullptr;
        void* xtst = dlopen("libXtst.so.6", RTLD_NOW | RTLD_LOCAL);
        void* xlib = dlopen("libX11.so.6", RTLD_NOW | RTLD_LOCAL);
        if (!m_display || !xtst || !xlib)
            return false;
        m_fakeKey = reinterpret_cast<decltype(m_fakeKey)>(dlsym(xtst, "XTestFakeKeyEvent"));
        m_fakeButton = reinterpret_cast<decltype(m_fakeButton)>(dlsym(xtst, "XTestFakeButtonEvent"));
        m_fakeMotion = reinterpret_cast<decltype(m_fakeMotion)>(dlsym(xtst, "XTestFakeMotionEvent"));
        m_keysymToKeycode = reinterpret_cast<decltype(m_keysymToKeycode)>(dlsym(xlib, "XKeysymToKeycode"));
        m_sync = reinterpret_cast<decltype(m_sync)>(dlsym(xlib, "XSync"));
        return m_fakeKey && m_fakeButton && m_fakeMotion && m_keysymToKeycode && m_sync;
#else
        return false;
#endif
    }

    void key(unsigned long keysym, bool press)
    {
        m_fakeKey(m_display, m_keysymToKeycode(m_display, keysym), press, 0);
        m_sync(m_display, 0);
    }
    void tap(unsigned long keysym)
    {
        key(keysym, true);
        key(keysym, false);
    }
    void button(unsigned button, bool press)
    {
        m_fakeButton(m_display, button, press, 0);
        m_sync(m_display, 0);
    }
    void moveTo(const QPoint& global)
    {
        m_fakeMotion(m_display, -1, global.x(), global.y(), 0);
        m_sync(m_display, 0);
    }
    // A left click at a global point, once the pointer has had `settleMs` to get there.
    void click(const QPoint& global, int settleMs = 50)
    {
        moveTo(global);
        QTest::qWait(settleMs);
        button(1, true);
        button(1, false);
    }
    // Latin-1 text typed key by key (those characters are their own keysyms).
    void type(const char* text)
    {
        for (const char* c = text; *c; ++c)
            tap(static_cast<unsigned char>(*c));
    }
    // A key tapped while a modifier is held.
    void chord(unsigned long modifier, unsigned long keysym)
    {
        key(modifier, true);
        tap(keysym);
        key(modifier, false);
    }

private:
    XDisplay* m_display = nullptr;
    int (*m_fakeKey)(XDisplay*, unsigned, int, unsigned long) = nullptr;
    int (*m_fakeButton)(XDisplay*, unsigned, int, unsigned long) = nullptr;
    int (*m_fakeMotion)(XDisplay*, int, int, int, unsigned long) = nullptr;
    unsigned char (*m_keysymToKeycode)(XDisplay*, unsigned long) = nullptr;
    int (*m_sync)(XDisplay*, int) = nullptr;
};

} // namespace VelmarTest
