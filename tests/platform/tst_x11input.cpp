// The X11 backend against a real server: keys and buttons pressed through the XTEST
// extension (libXtst is loaded at run time when present; no build dependency).
#include "TestSupport.h"
#include "XTestInput.h"

#include <Velmar/Events.h>

#include "platform/Platform.h"
#include "platform/VirtualKeys.h"

#include <QGuiApplication>


using namespace Velmar::Private;
namespace VK = Velmar::Private::VirtualKey;

using XTest = VelmarTest::XTestInput;

class X11InputTest : public QObject {
    Q_OBJECT
private Q_SLOTS:
    void initTestCase();
    void cleanup();
    void keys_data();
    void keys();
    void capsLockToggles();
    void keypadFollowsNumLock();
    void leftButton();

private:
    XTest m_xtest;
};

void X11InputTest::initTestCase()
{
    if (QGuiApplication::platformName() != QLatin1String("xcb"))
        QSKIP("needs an X display");
    if (!m_xtest.load())
        QSKIP("XTEST (libXtst.so.6) not available");
    Platform::setWindowSystemInputEnabled(true);
}

void X11InputTest::cleanup()
{
    // Never leave a key or button held on the display, whatever failed.
    for (unsigned long keysym : {0x61ul, 0x35ul, 0xffe1ul, 0xffe4ul, 0xffbful, 0xff52ul, 0xff95ul})
        m_xtest.key(keysym, false);
    m_xtest.button(1, false);
}

void X11InputTest::keys_data()
{
    QTest::addColumn<qulonglong>("keysym");
    QTest::addColumn<int>("vk");
    QTest::addColumn<int>("genericVk");
    QTest::newRow("a") << 0x61ull << int(VK::A) << 0;
    QTest::newRow("5") << 0x35ull << VK::Digit0 + 5 << 0;
    QTest::newRow("F2") << 0xffbfull << VK::F1 + 1 << 0;
    QTest::newRow("Up") << 0xff52ull << int(VK::Up) << 0;
    QTest::newRow("Shift_L") << 0xffe1ull << int(VK::LShift) << int(VK::Shift);
    QTest::newRow("Control_R") << 0xffe4ull << int(VK::RControl) << int(VK::Control);
}

void X11InputTest::keys()
{
    QFETCH(qulonglong, keysym);
    QFETCH(int, vk);
    QFETCH(int, genericVk);
    QVERIFY(!Platform::isAsyncKeyDown(vk));
    m_xtest.key(keysym, true);
    QVERIFY(Platform::isAsyncKeyDown(vk));
    if (genericVk)
        QVERIFY(Platform::isAsyncKeyDown(genericVk));
    Velmar::UInt8 state[256];
    Platform::getKeyboardState(state);
    QCOMPARE(int(state[vk] & 0x80), 0x80);
    int down = 0;
    for (int i = 0; i < 256; ++i)
        down += (state[i] & 0x80) ? 1 : 0;
    QCOMPARE(down, genericVk ? 2 : 1);
    m_xtest.key(keysym, false);
    QVERIFY(!Platform::isAsyncKeyDown(vk));
}

void X11InputTest::capsLockToggles()
{
    const bool before = Platform::isCapsLockToggled();
    m_xtest.tap(0xffe5);
    QCOMPARE(Platform::isCapsLockToggled(), !before);
    QCOMPARE((Velmar::GetCurrentKeyModifiers() & Velmar::alphaLock) != 0, !before);
    Velmar::UInt8 state[256];
    Platform::getKeyboardState(state);
    QCOMPARE(int(state[VK::Capital] & 0x01), before ? 0 : 1);
    m_xtest.tap(0xffe5);
    QCOMPARE(Platform::isCapsLockToggled(), before);
}

// The keypad's 7 is Home with Num Lock off and VK_NUMPAD7 with it on, as on Windows.
void X11InputTest::keypadFollowsNumLock()
{
    auto toggleNumLock = [this] { m_xtest.tap(0xff7f); };
    Velmar::UInt8 state[256];
    Platform::getKeyboardState(state);
    const bool numLockWasOn = state[VK::NumLock] & 0x01;
    if (numLockWasOn)
        toggleNumLock();

    m_xtest.key(0xff95, true); // the key of KP_Home / KP_7
    QVERIFY(Platform::isAsyncKeyDown(VK::Home));
    QVERIFY(!Platform::isAsyncKeyDown(VK::Numpad0 + 7));
    m_xtest.key(0xff95, false);

    toggleNumLock();
    Platform::getKeyboardState(state);
    QCOMPARE(int(state[VK::NumLock] & 0x01), 1);
    m_xtest.key(0xff95, true);
    QVERIFY(Platform::isAsyncKeyDown(VK::Numpad0 + 7));
    QVERIFY(!Platform::isAsyncKeyDown(VK::Home));
    m_xtest.key(0xff95, false);

    if (!numLockWasOn)
        toggleNumLock();
}

void X11InputTest::leftButton()
{
    QVERIFY(!Platform::isSystemLeftButtonDown());
    m_xtest.button(1, true);
    QVERIFY(Platform::isSystemLeftButtonDown());
    QVERIFY(Platform::isAsyncKeyDown(VK::LButton));
    QVERIFY(!Platform::isAsyncKeyDown(VK::RButton));
    m_xtest.button(1, false);
    QVERIFY(!Platform::isSystemLeftButtonDown());
}

VELMAR_TEST_MAIN(X11InputTest)
#include "tst_x11input.moc"
