// Key and button state: the event-fed tracker, the platform calls on top of it, and the X11
// backend against a real server (keys and buttons pressed through XTEST; run on a display of
// its own).
#include "TestSupport.h"
#include "WindowSystemNeeds.h"
#include "XTestInput.h"

#include "platform/InputTracker.h"
#include "platform/Notices.h"
#include "platform/Platform.h"
#include "platform/VirtualKeys.h"
#include "platform/WindowSystem.h"
#include "platform/x11/XcbKeyboard.h"

#include <Velmar/Events.h>

#include <QGuiApplication>
#include <QKeyEvent>
#include <QMouseEvent>
#include <QWidget>

#include <utility>

using namespace Velmar::Private;
namespace VK = Velmar::Private::VirtualKey;
using Platform::InputTracker;
using Platform::WindowSystem;
using Velmar::UInt8;

namespace {

quint64 gStamp = 1000;

void feedKey(QEvent::Type type, int key, Qt::KeyboardModifiers modifiers = Qt::NoModifier,
             bool autoRepeat = false)
{
    QKeyEvent event(type, key, modifiers, QString(), autoRepeat);
    event.setTimestamp(++gStamp);
    Platform::trackInputEvent(&event);
}

void feedMouse(QEvent::Type type, Qt::MouseButton button, Qt::MouseButtons buttons)
{
    QMouseEvent event(type, QPointF(1, 1), QPointF(1, 1), button, buttons, Qt::NoModifier);
    event.setTimestamp(++gStamp);
    Platform::trackInputEvent(&event);
}

// What reached the notice sink, and whether the sink takes it (its log category is on).
QStringList gNotices;
bool gSinkTakes = true;
bool recordNotice(const char* text)
{
    gNotices << QString::fromLatin1(text);
    return gSinkTakes;
}

const InputTracker& tracker()
{
    return InputTracker::instance();
}

} // namespace

class InputTest : public QObject {
    Q_OBJECT
private Q_SLOTS:
    void init()
    {
        InputTracker::instance().reset();
        Platform::setWindowSystemInputEnabled(false);
    }
    void cleanup()
    {
        releaseRealInput();
        Platform::setWindowSystemInputEnabled(true);
        InputTracker::instance().reset();
    }

    void keysGoDownAndUp()
    {
        feedKey(QEvent::KeyPress, Qt::Key_A);
        feedKey(QEvent::KeyPress, Qt::Key_F5);
        feedKey(QEvent::KeyRelease, Qt::Key_A);
        QVERIFY(!tracker().isDown(VK::A));
        QVERIFY(tracker().isDown(VK::F1 + 4));
        // An auto-repeat release keeps the key down.
        feedKey(QEvent::KeyPress, Qt::Key_B);
        feedKey(QEvent::KeyRelease, Qt::Key_B, Qt::NoModifier, true);
        QVERIFY(tracker().isDown(VK::A + 1));
        // Keypad Enter is reported as Return, as Windows does.
        feedKey(QEvent::KeyPress, Qt::Key_Enter, Qt::KeypadModifier);
        QVERIFY(tracker().isDown(VK::Return));
        QVERIFY(!tracker().isDown(VK::QtEnter));
    }

    void modifiersFollowEvents()
    {
        feedKey(QEvent::KeyPress, Qt::Key_Shift, Qt::ShiftModifier);
        // A key event carrying Control reveals Control even though its press went elsewhere.
        feedKey(QEvent::KeyPress, Qt::Key_C, Qt::ShiftModifier | Qt::ControlModifier);
        QVERIFY(tracker().isDown(VK::Control));
        QVERIFY(tracker().isDown(VK::Shift));
        // And an event without them clears both.
        feedKey(QEvent::KeyRelease, Qt::Key_C, Qt::NoModifier);
        QVERIFY(!tracker().isDown(VK::Control));
        QVERIFY(!tracker().isDown(VK::Shift));
    }

    void lockKeysToggleOncePerPress()
    {
        QKeyEvent press(QEvent::KeyPress, Qt::Key_CapsLock, Qt::NoModifier);
        press.setTimestamp(++gStamp);
        // One event offered to a widget and then its parent counts once.
        Platform::trackInputEvent(&press);
        Platform::trackInputEvent(&press);
        feedKey(QEvent::KeyRelease, Qt::Key_CapsLock);
        QVERIFY(tracker().isToggled(VK::Capital));
        QVERIFY(!tracker().isDown(VK::Capital));
        feedKey(QEvent::KeyPress, Qt::Key_CapsLock, Qt::NoModifier, true); // auto-repeat: no toggle
        QVERIFY(tracker().isToggled(VK::Capital));
        feedKey(QEvent::KeyPress, Qt::Key_CapsLock);
        QVERIFY(!tracker().isToggled(VK::Capital));
        feedKey(QEvent::KeyPress, Qt::Key_A);
        QVERIFY(!tracker().isToggled(VK::A));
    }

    void mouseButtonsAndDeactivation()
    {
        feedMouse(QEvent::MouseButtonPress, Qt::LeftButton, Qt::LeftButton);
        feedMouse(QEvent::MouseButtonPress, Qt::RightButton, Qt::LeftButton | Qt::RightButton);
        feedMouse(QEvent::MouseButtonRelease, Qt::LeftButton, Qt::RightButton);
        QVERIFY(!tracker().isDown(VK::LButton));
        QVERIFY(tracker().isDown(VK::RButton));
        feedMouse(QEvent::MouseMove, Qt::NoButton, Qt::NoButton);
        QVERIFY(!tracker().isDown(VK::RButton));

        // Leaving the application releases keys and buttons; lock states stay.
        feedKey(QEvent::KeyPress, Qt::Key_CapsLock);
        feedKey(QEvent::KeyPress, Qt::Key_Q);
        feedMouse(QEvent::MouseButtonPress, Qt::LeftButton, Qt::LeftButton);
        QEvent deactivate(QEvent::ApplicationDeactivate);
        Platform::trackInputEvent(&deactivate);
        QVERIFY(!tracker().isDown(VK::A + ('Q' - 'A')));
        QVERIFY(!tracker().isDown(VK::LButton));
        QVERIFY(tracker().isToggled(VK::Capital));
    }

    void platformCallsUseTrackedState()
    {
        Platform::trackInputEvent(nullptr);
        QVERIFY(!Platform::isSystemLeftButtonDown());
        feedKey(QEvent::KeyPress, Qt::Key_A);
        feedKey(QEvent::KeyPress, Qt::Key_CapsLock);
        feedMouse(QEvent::MouseButtonPress, Qt::LeftButton, Qt::LeftButton);
        QVERIFY(Platform::isAsyncKeyDown(VK::A));
        QVERIFY(Platform::isCapsLockToggled());
        QVERIFY(Platform::isSystemLeftButtonDown());
        for (int vk : {0, -1, 256, 100000})
            QVERIFY(!Platform::isAsyncKeyDown(vk));
        UInt8 state[256];
        memset(state, 0xAA, sizeof state);
        Platform::getKeyboardState(state);
        QCOMPARE(int(state[VK::A]), 0x80);
        QCOMPARE(int(state[VK::Capital]), 0x81);
        QCOMPARE(int(state[VK::LButton]), 0x80);
        QCOMPARE(int(state[VK::A + 1]), 0);
        Platform::getKeyboardState(nullptr); // must not crash
    }

    // A press and a Caps Lock toggle Qt delivered but the server never saw show which
    // source answers.
    void windowSystemIsAskedWhenPresent()
    {
        Platform::setWindowSystemInputEnabled(true);
        feedKey(QEvent::KeyPress, Qt::Key_A);
        feedKey(QEvent::KeyPress, Qt::Key_CapsLock);
        const bool onX11 = QGuiApplication::platformName() == QLatin1String("xcb");
#if __has_include(<xcb/xcb.h>)
        QCOMPARE(Platform::XcbKeyboard::get() != nullptr, onX11); // Qt's connection is found
#endif
        if (Platform::XcbKeyboard::get()) {
            QVERIFY(!Platform::isAsyncKeyDown(VK::A));
            QVERIFY(!Platform::isCapsLockToggled());
            QVERIFY(!Platform::isSystemLeftButtonDown());
            UInt8 state[256];
            Platform::getKeyboardState(state);
            for (int vk = VK::A; vk <= VK::Z; ++vk)
                QCOMPARE(int(state[vk] & 0x80), 0);
            return;
        }
        QVERIFY(Platform::isAsyncKeyDown(VK::A));
        QVERIFY(Platform::isCapsLockToggled());
    }

    // The test display and the fallback both use the US layout.
    void characterKeys()
    {
        const std::pair<char, int> rows[] = {{'a', 0x41}, {'Z', 0x5A}, {'1', 0x31},
                                             {'.', 0xBE}, {';', 0xBA}, {'\x01', 0}};
        for (bool windowSystem : {false, true}) {
            Platform::setWindowSystemInputEnabled(windowSystem);
            for (const auto& [character, vk] : rows)
                QCOMPARE(Platform::virtualKeyForCharacter(character), vk);
        }
    }

    // The backend follows the name of Qt's plugin: the X server is asked only on "xcb".
    void windowSystemFromPlatformName_data()
    {
        QTest::addColumn<QString>("name");
        QTest::addColumn<int>("system");
        QTest::newRow("xcb") << QString("xcb") << int(WindowSystem::X11);
        QTest::newRow("wayland") << QString("wayland") << int(WindowSystem::Wayland);
        QTest::newRow("wayland-egl") << QString("wayland-egl") << int(WindowSystem::Wayland);
        QTest::newRow("offscreen") << QString("offscreen") << int(WindowSystem::Other);
        QTest::newRow("windows") << QString("windows") << int(WindowSystem::Windows);
        QTest::newRow("none") << QString("") << int(WindowSystem::None);
    }
    void windowSystemFromPlatformName()
    {
        QFETCH(QString, name);
        QFETCH(int, system);
        QCOMPARE(int(Platform::windowSystemForPlatformName(name)), system);
    }

    // Without the window system, the pointer is where the last mouse event put it.
    void pointerFollowsMouseEvents()
    {
        QMouseEvent move(QEvent::MouseMove, QPointF(3, 4), QPointF(130, 240), Qt::NoButton,
                         Qt::NoButton, Qt::NoModifier);
        Platform::trackInputEvent(&move);
        QCOMPARE(Platform::pointerPosition(), QPoint(130, 240));
    }

    // A refused request is told until the sink takes it (its category may be off), then never.
    void noticesAreGivenOnce()
    {
        static const char kKind[] = "kind";
        VelmarTest::ScopedOverride sink(&Platform::setNoticeSink, &recordNotice);
        Platform::resetNotices();
        gNotices.clear();
        gSinkTakes = false;
        QVERIFY(!Platform::noticeOnce(kKind));
        gSinkTakes = true;
        QVERIFY(Platform::noticeOnce(kKind));
        QVERIFY(Platform::noticeOnce(kKind));
        QVERIFY(!Platform::noticeOnce(nullptr));
        QCOMPARE(gNotices, QStringList({"kind", "kind"}));
    }

    // Under a compositor: no query may reach Qt's input context before a keyboard has shown
    // itself (Qt 6.4 crashes there without a seat), and the first placed window is noticed.
    void waylandBackend()
    {
        if (Platform::windowSystem() != WindowSystem::Wayland)
            QSKIP("runs under Wayland (VELMAR_TEST_PLATFORM=wayland)");
        VelmarTest::ScopedOverride sink(&Platform::setNoticeSink, &recordNotice);
        Platform::resetNotices();
        gNotices.clear();
        gSinkTakes = true;
        QVERIFY(Platform::keyboardLanguageId() > 0);
        feedMouse(QEvent::MouseMove, Qt::NoButton, Qt::NoButton); // the backend starts watching
        QWidget first, second;
        first.move(40, 50);
        second.move(60, 70);
        first.show();
        second.show();
        QCoreApplication::processEvents();
        QCOMPARE(gNotices.size(), 1);
        QVERIFY(gNotices.first().startsWith("Velmar::MoveWindow: "));
    }

    // Real keys through the X server: the key, its generic modifier and nothing else are down.
    void realKeys_data()
    {
        QTest::addColumn<qulonglong>("keysym");
        QTest::addColumn<int>("vk");
        QTest::addColumn<int>("genericVk");
        QTest::newRow("a") << 0x61ull << int(VK::A) << 0;
        QTest::newRow("F2") << 0xffbfull << VK::F1 + 1 << 0;
        QTest::newRow("Up") << 0xff52ull << int(VK::Up) << 0;
        QTest::newRow("Shift_L") << 0xffe1ull << int(VK::LShift) << int(VK::Shift);
        QTest::newRow("Control_R") << 0xffe4ull << int(VK::RControl) << int(VK::Control);
    }
    void realKeys()
    {
        QFETCH(qulonglong, keysym);
        QFETCH(int, vk);
        QFETCH(int, genericVk);
        // In the test itself: a skip inside a helper would only leave the helper.
        VELMAR_REQUIRE_X11("XTEST input");
        if (!startRealInput())
            QSKIP("XTEST (libXtst.so.6) not available");
        QVERIFY(!Platform::isAsyncKeyDown(vk));
        m_xtest.key(keysym, true);
        QVERIFY(Platform::isAsyncKeyDown(vk));
        QVERIFY(!genericVk || Platform::isAsyncKeyDown(genericVk));
        UInt8 state[256];
        Platform::getKeyboardState(state);
        int down = 0;
        for (int i = 0; i < 256; ++i)
            down += (state[i] & 0x80) ? 1 : 0;
        QCOMPARE(int(state[vk] & 0x80), 0x80);
        QCOMPARE(down, genericVk ? 2 : 1);
        m_xtest.key(keysym, false);
        QVERIFY(!Platform::isAsyncKeyDown(vk));
    }

    // Caps Lock toggles in every call that reports it; the keypad's 7 is Home with Num Lock
    // off and VK_NUMPAD7 with it on, as on Windows; the left button is the server's.
    void realLocksAndButton()
    {
        // In the test itself: a skip inside a helper would only leave the helper.
        VELMAR_REQUIRE_X11("XTEST input");
        if (!startRealInput())
            QSKIP("XTEST (libXtst.so.6) not available");
        const bool caps = Platform::isCapsLockToggled();
        m_xtest.tap(0xffe5);
        QCOMPARE(Platform::isCapsLockToggled(), !caps);
        QCOMPARE((Velmar::GetCurrentKeyModifiers() & Velmar::alphaLock) != 0, !caps);
        UInt8 state[256];
        Platform::getKeyboardState(state);
        QCOMPARE(int(state[VK::Capital] & 0x01), caps ? 0 : 1);
        m_xtest.tap(0xffe5);
        QCOMPARE(Platform::isCapsLockToggled(), caps);

        const bool numLock = state[VK::NumLock] & 0x01;
        for (bool on : {false, true}) {
            Platform::getKeyboardState(state);
            if (bool(state[VK::NumLock] & 0x01) != on)
                m_xtest.tap(0xff7f);
            m_xtest.key(0xff95, true); // the key of KP_Home / KP_7
            QCOMPARE(Platform::isAsyncKeyDown(VK::Home), !on);
            QCOMPARE(Platform::isAsyncKeyDown(VK::Numpad0 + 7), on);
            m_xtest.key(0xff95, false);
        }
        if (!numLock)
            m_xtest.tap(0xff7f);

        QVERIFY(!Platform::isSystemLeftButtonDown());
        m_xtest.button(1, true);
        QVERIFY(Platform::isSystemLeftButtonDown());
        QVERIFY(Platform::isAsyncKeyDown(VK::LButton));
        QVERIFY(!Platform::isAsyncKeyDown(VK::RButton));
        m_xtest.button(1, false);
        QVERIFY(!Platform::isSystemLeftButtonDown());
    }

private:
    bool startRealInput()
    {
        if (!m_xtest.load())
            return false;
        Platform::setWindowSystemInputEnabled(true);
        m_realInput = true;
        return true;
    }
    // Never leaves a key or button held on the display, whatever failed.
    void releaseRealInput()
    {
        if (!std::exchange(m_realInput, false))
            return;
        for (unsigned long keysym : {0x61ul, 0xffe1ul, 0xffe4ul, 0xffbful, 0xff52ul, 0xff95ul})
            m_xtest.key(keysym, false);
        m_xtest.button(1, false);
    }

    VelmarTest::XTestInput m_xtest;
    bool m_realInput = false;
};

VELMAR_TEST_MAIN(InputTest)
#include "tst_input.moc"

