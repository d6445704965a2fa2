// Key and button state: the event-fed tracker, and the platform calls on top of it and of
// the X server.
#include "TestSupport.h"

#include "platform/InputTracker.h"
#include "platform/Platform.h"
#include "platform/VirtualKeys.h"
#include "platform/x11/XcbKeyboard.h"

#include <QGuiApplication>
#include <QKeyEvent>
#include <QMouseEvent>

using namespace Velmar::Private;
namespace VK = Velmar::Private::VirtualKey;
using Platform::InputTracker;
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

bool onX11()
{
    return QGuiApplication::platformName() == QLatin1String("xcb");
}

} // namespace

class InputTest : public QObject {
    Q_OBJECT
private Q_SLOTS:
    void init();
    void cleanup();
    void keysGoDownAndUp();
    void autoRepeatKeepsKeyDown();
    void modifiersFollowEvents();
    void lockKeysToggleOncePerPress();
    void mouseButtons();
    void deactivationReleasesKeys();
    void outOfRangeKeysAreUp();
    void platformCallsUseTrackedState();
    void windowSystemIsAskedWhenPresent();
    void characterKeys_data();
    void characterKeys();
};

void InputTest::init()
{
    InputTracker::instance().reset();
    Platform::setWindowSystemInputEnabled(false);
}

void InputTest::cleanup()
{
    Platform::setWindowSystemInputEnabled(true);
    InputTracker::instance().reset();
}

void InputTest::keysGoDownAndUp()
{
    const InputTracker& t = InputTracker::instance();
    QVERIFY(!t.isDown(VK::A));
    feedKey(QEvent::KeyPress, Qt::Key_A);
    QVERIFY(t.isDown(VK::A));
    feedKey(QEvent::KeyPress, Qt::Key_F5);
    QVERIFY(t.isDown(VK::F1 + 4));
    feedKey(QEvent::KeyRelease, Qt::Key_A);
    QVERIFY(!t.isDown(VK::A));
    QVERIFY(t.isDown(VK::F1 + 4));
    // Keypad Enter is reported as Return, as Windows does.
    feedKey(QEvent::KeyPress, Qt::Key_Enter, Qt::KeypadModifier);
    QVERIFY(t.isDown(VK::Return));
    QVERIFY(!t.isDown(VK::QtEnter));
}

void InputTest::autoRepeatKeepsKeyDown()
{
    feedKey(QEvent::KeyPress, Qt::Key_B);
    feedKey(QEvent::KeyRelease, Qt::Key_B, Qt::NoModifier, true);
    QVERIFY(InputTracker::instance().isDown(VK::A + 1));
    feedKey(QEvent::KeyRelease, Qt::Key_B);
    QVERIFY(!InputTracker::instance().isDown(VK::A + 1));
}

void InputTest::modifiersFollowEvents()
{
    const InputTracker& t = InputTracker::instance();
    feedKey(QEvent::KeyPress, Qt::Key_Shift, Qt::ShiftModifier);
    QVERIFY(t.isDown(VK::Shift));
    // A key event carrying Control reveals Control even though its press went elsewhere.
    feedKey(QEvent::KeyPress, Qt::Key_C, Qt::ShiftModifier | Qt::ControlModifier);
    QVERIFY(t.isDown(VK::Control));
    QVERIFY(t.isDown(VK::Shift));
    // And an event without them clears both.
    feedKey(QEvent::KeyRelease, Qt::Key_C, Qt::NoModifier);
    QVERIFY(!t.isDown(VK::Control));
    QVERIFY(!t.isDown(VK::Shift));
}

void InputTest::lockKeysToggleOncePerPress()
{
    const InputTracker& t = InputTracker::instance();
    QKeyEvent press(QEvent::KeyPress, Qt::Key_CapsLock, Qt::NoModifier);
    press.setTimestamp(++gStamp);
    // One event offered to a widget and then its parent counts once.
    Platform::trackInputEvent(&press);
    Platform::trackInputEvent(&press);
    QVERIFY(t.isToggled(VK::Capital));
    QVERIFY(t.isDown(VK::Capital));
    feedKey(QEvent::KeyRelease, Qt::Key_CapsLock);
    QVERIFY(t.isToggled(VK::Capital));
    QVERIFY(!t.isDown(VK::Capital));
    feedKey(QEvent::KeyPress, Qt::Key_CapsLock, Qt::NoModifier, true); // auto-repeat: no toggle
    QVERIFY(t.isToggled(VK::Capital));
    feedKey(QEvent::KeyPress, Qt::Key_CapsLock);
    QVERIFY(!t.isToggled(VK::Capital));
    feedKey(QEvent::KeyPress, Qt::Key_A);
    QVERIFY(!t.isToggled(VK::A));
}

void InputTest::mouseButtons()
{
    const InputTracker& t = InputTracker::instance();
    feedMouse(QEvent::MouseButtonPress, Qt::LeftButton, Qt::LeftButton);
    QVERIFY(t.isDown(VK::LButton));
    feedMouse(QEvent::MouseButtonPress, Qt::RightButton, Qt::LeftButton | Qt::RightButton);
    QVERIFY(t.isDown(VK::RButton));
    feedMouse(QEvent::MouseButtonRelease, Qt::LeftButton, Qt::RightButton);
    QVERIFY(!t.isDown(VK::LButton));
    QVERIFY(t.isDown(VK::RButton));
    feedMouse(QEvent::MouseMove, Qt::NoButton, Qt::NoButton);
    QVERIFY(!t.isDown(VK::RButton));
}

void InputTest::deactivationReleasesKeys()
{
    feedKey(QEvent::KeyPress, Qt::Key_CapsLock);
    feedKey(QEvent::KeyPress, Qt::Key_Q);
    feedMouse(QEvent::MouseButtonPress, Qt::LeftButton, Qt::LeftButton);
    QEvent deactivate(QEvent::ApplicationDeactivate);
    Platform::trackInputEvent(&deactivate);
    const InputTracker& t = InputTracker::instance();
    QVERIFY(!t.isDown(VK::A + ('Q' - 'A')));
    QVERIFY(!t.isDown(VK::LButton));
    QVERIFY(t.isToggled(VK::Capital));
}

void InputTest::outOfRangeKeysAreUp()
{
    Platform::trackInputEvent(nullptr);
    feedKey(QEvent::KeyPress, Qt::Key_A);
    for (int vk : {0, -1, 256, 100000})
        QVERIFY(!Platform::isAsyncKeyDown(vk));
    Platform::getKeyboardState(nullptr); // must not crash
}

void InputTest::platformCallsUseTrackedState()
{
    QVERIFY(!Platform::isAsyncKeyDown(VK::A));
    QVERIFY(!Platform::isSystemLeftButtonDown());
    feedKey(QEvent::KeyPress, Qt::Key_A);
    feedKey(QEvent::KeyPress, Qt::Key_CapsLock);
    feedMouse(QEvent::MouseButtonPress, Qt::LeftButton, Qt::LeftButton);
    QVERIFY(Platform::isAsyncKeyDown(VK::A));
    QVERIFY(Platform::isCapsLockToggled());
    QVERIFY(Platform::isSystemLeftButtonDown());
    UInt8 state[256];
    memset(state, 0xAA, sizeof state);
    Platform::getKeyboardState(state);
    QCOMPARE(int(state[VK::A]), 0x80);
    QCOMPARE(int(state[VK::Capital]), 0x81);
    QCOMPARE(int(state[VK::LButton]), 0x80);
    QCOMPARE(int(state[VK::A + 1]), 0);
}

void InputTest::windowSystemIsAskedWhenPresent()
{
    Platform::setWindowSystemInputEnabled(true);
    // Nothing is pressed on the test display, whichever source answers.
    QVERIFY(!Platform::isAsyncKeyDown(VK::A));
    QVERIFY(!Platform::isAsyncKeyDown(VK::Shift));
    QVERIFY(!Platform::isSystemLeftButtonDown());

    // A press Qt delivered but the server never saw shows which source answers.
    feedKey(QEvent::KeyPress, Qt::Key_A);
#if __has_include(<xcb/xcb.h>)
    if (onX11())
        QVERIFY(Platform::XcbKeyboard::get() != nullptr); // Qt's connection is found
#endif
    if (Platform::XcbKeyboard::get()) {
        QVERIFY(onX11());
        QVERIFY(!Platform::isAsyncKeyDown(VK::A));
        UInt8 state[256];
        Platform::getKeyboardState(state);
        for (int vk = VK::A; vk <= VK::Z; ++vk)
            QCOMPARE(int(state[vk] & 0x80), 0);
        return;
    }
    QVERIFY(Platform::isAsyncKeyDown(VK::A));
}

void InputTest::characterKeys_data()
{
    QTest::addColumn<char>("character");
    QTest::addColumn<int>("vk");
    QTest::newRow("a") << 'a' << 0x41;
    QTest::newRow("Z") << 'Z' << 0x5A;
    QTest::newRow("1") << '1' << 0x31;
    QTest::newRow(".") << '.' << 0xBE;
    QTest::newRow(";") << ';' << 0xBA;
    QTest::newRow("control character") << '\x01' << 0;
}

// The test display and the fallback both use the US layout.
void InputTest::characterKeys()
{
    QFETCH(char, character);
    QFETCH(int, vk);
    for (bool windowSystem : {false, true}) {
        Platform::setWindowSystemInputEnabled(windowSystem);
        QCOMPARE(Platform::virtualKeyForCharacter(character), vk);
    }
}

VELMAR_TEST_MAIN(InputTest)
#include "tst_input.moc"
