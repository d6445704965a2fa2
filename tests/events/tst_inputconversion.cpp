// Qt input as Toolbox events: Mac key and character codes, modifiers, mouse buttons and
// parts, wheel steps; the keyboard tables' deliberate odd rows; the polling calls.
#include "events_support.h"

#include "events/EventLoopTimer.h"
#include "events/KeyCodeTables.h"
#include "events/QtInputConversion.h"
#include "platform/InputTracker.h"
#include "platform/Platform.h"

#include <Velmar/Events.h>
#include <Velmar/FeatureFlags.h>
#include <Velmar/HostEncoding.h>
#include <Velmar/HostShell.h>
#include <Velmar/MacErrors.h>

#include <QKeyEvent>
#include <QMouseEvent>
#include <QStyleHints>
#include <QWheelEvent>
#include <QtTest/qtestspontaneevent.h>

using namespace Velmar;
using namespace EventTest;
using Velmar::Private::EventQueueItem;
using VelmarTest::ScopedOverride;

namespace {

QString modifierNames(UInt32 mods)
{
    QString s;
    const std::pair<UInt32, const char*> names[] = {
        {cmdKey, " cmd"}, {shiftKey, " shift"}, {alphaLock, " lock"}, {optionKey, " option"}};
    for (const auto& [bit, name] : names)
        s += (mods & bit) ? name : "";
    return s;
}

QString hex2(int v)
{
    return QStringLiteral("%1").arg(v, 2, 16, QChar(u'0'));
}

// "1 61/00 shift" for keys, "1 b1 p3 cmd" for clicks, "wheel 1 -2" for the wheel, else the
// queue tests' notation.
QString describeInput(EventQueueItem* item)
{
    if (item->eventClass == kEventClassKeyboard)
        return QStringLiteral("%1 %2/%3").arg(item->eventKind).arg(hex2(item->charCode), hex2(item->keyCode))
            + modifierNames(item->modifiers);
    if (item->eventClass == kEventClassMouse && item->eventKind == kEventMouseWheelMoved) {
        UInt16 axis = 99;
        SInt32 steps = 0;
        GetEventParameter(item, kEventParamMouseWheelAxis, typeMouseWheelAxis, nullptr, 2, nullptr, &axis);
        GetEventParameter(item, kEventParamMouseWheelDelta, typeLongInteger, nullptr, 4, nullptr, &steps);
        return QStringLiteral("wheel %1 %2").arg(axis).arg(steps);
    }
    if (item->eventClass == kEventClassMouse)
        return QStringLiteral("%1 b%2 p%3").arg(item->eventKind).arg(item->mouseButton).arg(item->windowPart)
            + modifierNames(item->modifiers);
    return describe(item);
}

// A plain widget standing in for window 1: it converts the input it receives as a window
// does. Events reach it spontaneously through the application, like real input, so Qt's
// modifier and button state and the tracked key state follow them.
class InputSink : public QWidget {
public:
    InputSink() { resize(20, 20); }
    QString deliver(QEvent* e)
    {
        m_last = QStringLiteral("none");
        QSpontaneKeyEvent::setSpontaneous(e);
        QCoreApplication::instance()->notify(this, e);
        return m_last;
    }
    QString key(QEvent::Type type, int key, int mods, const QString& text = {})
    {
        QKeyEvent e(type, key, Qt::KeyboardModifiers(mods), text);
        return deliver(&e);
    }
    QString mouse(QEvent::Type type, int button, int buttons, int mods, QPoint local = {5, 5})
    {
        QMouseEvent e(type, local, QPointF(local + QPoint(100, 200)), Qt::MouseButton(button),
                      Qt::MouseButtons(buttons), Qt::KeyboardModifiers(mods));
        return deliver(&e);
    }

protected:
    bool event(QEvent* e) override
    {
        if (!dynamic_cast<QInputEvent*>(e))
            return QWidget::event(e);
        EventQueueItemSmartPtr item = EventQueueItemSmartPtr::Create();
        if (Private::ConvertVelmarEvent(fakeWindow(1), e, item.get())) {
            m_last = describeInput(item.get());
            if (item->eventClass == kEventClassMouse && item->eventKind != kEventMouseWheelMoved)
                m_last += QStringLiteral(" @%1,%2").arg(item->where.h).arg(item->where.v);
        }
        return true;
    }

private:
    QString m_last;
};

InputSink* gSink = nullptr;
bool gZoomed = false;
QStringList gRepaints;

Private::InputWindowHooks sinkHooks()
{
    Private::InputWindowHooks h;
    h.widget = [](AQtWindow* w) -> QWidget* { return w == fakeWindow(1) ? gSink : nullptr; };
    h.isMinimizeMaximizeChange = [](AQtWindow*) { return gZoomed; };
    return h;
}

QString setBits(const KeyMap keys)
{
    QStringList codes;
    for (int code = 0; code < 128; ++code)
        if ((reinterpret_cast<const UInt8*>(keys)[code / 8] >> (code % 8)) & 1)
            codes << hex2(code);
    return codes.join(u' ');
}

constexpr int kShift = Qt::ShiftModifier, kAlt = Qt::AltModifier, kCtrl = Qt::ControlModifier,
              kMeta = Qt::MetaModifier, kPad = Qt::KeypadModifier;

} // namespace

class tst_InputConversion : public QObject {
    Q_OBJECT

    InputSink m_sink;
    std::unique_ptr<ScopedOverride<Private::InputWindowHooks, const Private::InputWindowHooks&>> m_hooks;

private Q_SLOTS:
    void initTestCase()
    {
        gSink = &m_sink;
        m_hooks = std::make_unique<ScopedOverride<Private::InputWindowHooks, const Private::InputWindowHooks&>>(
            &Private::SetInputWindowHooks, sinkHooks());
        // Key state from the events delivered here only, whatever the X server holds.
        Private::Platform::setWindowSystemInputEnabled(false);
    }
    void init()
    {
        Private::Platform::InputTracker::instance().reset();
        Private::gMainEventQueue.clearAll();
        EnableLooperFiltering(1);
        gZoomed = false;
    }
    void cleanupTestCase()
    {
        Private::Platform::setWindowSystemInputEnabled(true);
        m_hooks.reset();
    }

    void keys_data()
    {
        QTest::addColumn<int>("key");
        QTest::addColumn<int>("mods");
        QTest::addColumn<QString>("text");
        QTest::addColumn<QString>("expected");
        QTest::newRow("a") << int(Qt::Key_A) << 0 << "a" << "1 61/00";
        QTest::newRow("A") << int(Qt::Key_A) << kShift << "A" << "1 41/00 shift";
        QTest::newRow("digit 7") << int(Qt::Key_7) << 0 << "7" << "1 37/1a";
        QTest::newRow("keypad 7") << int(Qt::Key_7) << kPad << "7" << "1 37/59";
        QTest::newRow("keypad point") << int(Qt::Key_Period) << kPad << "." << "1 2e/41";
        QTest::newRow("keypad enter") << int(Qt::Key_Enter) << kPad << "\r" << "1 03/4c";
        QTest::newRow("!") << int(Qt::Key_Exclam) << kShift << "!" << "1 21/12 shift";
        QTest::newRow("F5 has no text") << int(Qt::Key_F5) << 0 << "" << "1 10/60";
        QTest::newRow("F15") << int(Qt::Key_F15) << 0 << "" << "1 10/71";
        QTest::newRow("left arrow") << int(Qt::Key_Left) << 0 << "" << "1 1c/7b";
        QTest::newRow("return") << int(Qt::Key_Return) << 0 << "\r" << "1 0d/24";
        QTest::newRow("backspace") << int(Qt::Key_Backspace) << 0 << "\b" << "1 08/33";
        QTest::newRow("shift-tab") << int(Qt::Key_Backtab) << kShift << "" << "1 09/30 shift";
        QTest::newRow("escape") << int(Qt::Key_Escape) << 0 << "\x1b" << "1 1b/35";
        QTest::newRow("forward delete") << int(Qt::Key_Delete) << 0 << "\x7f" << "1 7f/75";
        // Qt's mapper gives Clear to VK_OEM_CLEAR too, and the later key wins: an empty row.
        QTest::newRow("clear") << int(Qt::Key_Clear) << kPad << "" << "1 00/00";
        QTest::newRow("option-g") << int(Qt::Key_G) << kAlt << "\u00a9" << "1 a9/05 option";
        QTest::newRow("em dash") << int(Qt::Key_Minus) << (kAlt | kShift) << "\u2014" << "1 d1/1b shift option";
        QTest::newRow("no-break space") << int(Qt::Key_Space) << kAlt << "\u00a0" << "1 ca/31 option";
        QTest::newRow("e acute is not one key") << int(Qt::Key_E) << 0 << "\u00e9" << "1 45/0e";
        // Control-typed letters are control characters: the Qt key decides.
        QTest::newRow("command-c") << int(Qt::Key_C) << kCtrl << "\x03" << "1 43/08 cmd";
        QTest::newRow("command-shift-z") << int(Qt::Key_Z) << (kCtrl | kShift) << "\x1a" << "1 5a/06 cmd shift";
        // Both Windows keys are Qt's Meta, whose index entry is the right Windows key.
        QTest::newRow("meta") << int(Qt::Key_Meta) << kMeta << "" << "1 00/3c cmd";
        QTest::newRow("shift alone") << int(Qt::Key_Shift) << kShift << "" << "none";
        QTest::newRow("caps lock alone") << int(Qt::Key_CapsLock) << 0 << "" << "none";
    }
    void keys()
    {
        QFETCH(int, key);
        QFETCH(int, mods);
        QFETCH(QString, text);
        QFETCH(QString, expected);
        QCOMPARE(m_sink.key(QEvent::KeyPress, key, mods, text), expected);
        const QString released = expected == QLatin1String("none") ? expected : QString(expected).replace(0, 1, u'3');
        QCOMPARE(m_sink.key(QEvent::KeyRelease, key, mods, text), released);
    }

    void keyKindsAndFields()
    {
        QCOMPARE(m_sink.key(QEvent::KeyPress, Qt::Key_CapsLock, 0), QStringLiteral("none"));
        QCOMPARE(m_sink.key(QEvent::KeyPress, Qt::Key_A, 0, "A"), QStringLiteral("1 41/00 lock"));
        QKeyEvent repeat(QEvent::KeyPress, Qt::Key_A, {}, "a", true);
        QCOMPARE(m_sink.deliver(&repeat), QStringLiteral("2 61/00 lock"));
        QKeyEvent repeatUp(QEvent::KeyRelease, Qt::Key_A, {}, "a", true);
        QCOMPARE(m_sink.deliver(&repeatUp), QStringLiteral("none"));

        QKeyEvent e(QEvent::KeyPress, Qt::Key_B, Qt::ShiftModifier, 0x38, 0, 0, QStringLiteral("B"));
        EventQueueItemSmartPtr item = EventQueueItemSmartPtr::Create();
        QVERIFY(Private::ConvertKeyEvent(&e, item.get()));
        QCOMPARE(item->keyMessage, UInt32(0x380B42)); // the native scan code from bit 16 up
        QCOMPARE(item->textUnit, UInt16('B'));
        QCOMPARE(item->qtKey, UInt32(Qt::Key_B));
        QCOMPARE(item->qtModifiers, UInt32(Qt::ShiftModifier));
        QCOMPARE(item->attributes, UInt32(kEventAttributeUserEvent));
        QCOMPARE(GetUTF16Char(&e), UInt16('B'));
        QCOMPARE(GetUTF16Char(nullptr), UInt16(0));
    }

    // The characters that are not ASCII must carry their own Mac OS Roman codes.
    void characterTable()
    {
        QVERIFY(SetCurrentMacEncoding(nullptr));
        int ascii = 0, roman = 0;
        for (int byte = 0x20; byte < 0x100; ++byte) {
            const char b = char(byte);
            unsigned short unit = 0;
            QCOMPARE(CurrentMacMBCSEncodingToUTF16(&b, 1, &unit, 1), 1);
            Private::MacKeyPair pair;
            if (!Private::macKeyForCharacter(char16_t(unit), &pair))
                continue;
            QCOMPARE(hex2(pair.charCode), hex2(byte));
            (byte < 0x80 ? ascii : roman)++;
        }
        QCOMPARE(ascii, 95);
        QCOMPARE(roman, 85);
        QCOMPARE(Private::characterTableSize(), 180);
    }

    void oddRows()
    {
        using namespace Private;
        QCOMPARE(int(macKeyForVirtualKey(0x2C).keyCode), 0x2B); // Print Screen on the comma key
        QCOMPARE(int(macKeyForVirtualKey(0x5B).keyCode), 0x21); // left Windows key on "["
        QCOMPARE(int(macKeyForVirtualKey(0x13).keyCode), 0x71); // Pause on F15
        QCOMPARE(virtualKeyForMacKey(0), 0);                    // the A key's code means "none"
        QCOMPARE(virtualKeyForMacKey(0x72), 0x2F);              // insert and help share a key; help wins
        QCOMPARE(virtualKeyForMacKey(0x71), 0x7E);              // F15 over Pause
    }

    void mouse_data()
    {
        QTest::addColumn<int>("type");
        QTest::addColumn<int>("button");
        QTest::addColumn<int>("buttons");
        QTest::addColumn<int>("mods");
        QTest::addColumn<QPoint>("local");
        QTest::addColumn<QString>("expected");
        const int left = Qt::LeftButton, press = QEvent::MouseButtonPress, move = QEvent::MouseMove;
        QTest::newRow("press inside") << press << left << left << 0 << QPoint(5, 5) << "1 b1 p3 @105,205";
        QTest::newRow("double click is a down") << int(QEvent::MouseButtonDblClick) << left << left << 0 << QPoint(5, 5) << "1 b1 p3 @105,205";
        QTest::newRow("release outside") << int(QEvent::MouseButtonRelease) << left << 0 << 0 << QPoint(50, 5) << "2 b1 p0 @150,205";
        QTest::newRow("right") << press << int(Qt::RightButton) << int(Qt::RightButton) << 0 << QPoint(1, 1) << "1 b2 p3 @101,201";
        QTest::newRow("x2") << press << int(Qt::XButton2) << int(Qt::XButton2) << 0 << QPoint(1, 1) << "1 b5 p3 @101,201";
        QTest::newRow("shift-click") << press << left << left << kShift << QPoint(1, 1) << "1 b1 p3 shift @101,201";
        QTest::newRow("command-click") << press << left << left << kCtrl << QPoint(1, 1) << "1 b1 p3 cmd @101,201";
        QTest::newRow("option-click") << press << left << left << kAlt << QPoint(1, 1) << "1 b1 p3 option @101,201";
        QTest::newRow("plain move") << move << 0 << 0 << 0 << QPoint(1, 1) << "none";
        QTest::newRow("right-button move") << move << 0 << int(Qt::RightButton) << 0 << QPoint(1, 1) << "none";
        QTest::newRow("drag") << move << 0 << left << 0 << QPoint(1, 1) << "6 b1 p3 @101,201";
    }
    void mouse()
    {
        QFETCH(int, type);
        QFETCH(int, button);
        QFETCH(int, buttons);
        QFETCH(int, mods);
        QFETCH(QPoint, local);
        QFETCH(QString, expected);
        QCOMPARE(m_sink.mouse(QEvent::Type(type), button, buttons, mods, local), expected);
        m_sink.mouse(QEvent::MouseButtonRelease, button, 0, 0); // Qt's button state back up
    }

    // Drags are posted only with looper filtering, and under legacy processing only while no
    // other drag waits.
    void drags_data()
    {
        QTest::addColumn<int>("looper");
        QTest::addColumn<bool>("legacy");
        QTest::addColumn<bool>("dragQueued");
        QTest::addColumn<QString>("expected");
        QTest::newRow("filtering off") << 0 << false << false << "none";
        QTest::newRow("first drag") << 1 << true << false << "6 b1 p3 @101,201";
        QTest::newRow("legacy, one waits") << 1 << true << true << "none";
        QTest::newRow("modern, one waits") << 1 << false << true << "6 b1 p3 @101,201";
    }
    void drags()
    {
        QFETCH(int, looper);
        QFETCH(bool, legacy);
        QFETCH(bool, dragQueued);
        QFETCH(QString, expected);
        FakeWindows windows;
        windows.setLegacy(legacy);
        EnableLooperFiltering(UInt32(looper));
        if (dragQueued)
            Private::gMainEventQueue.append(makeItem(kEventClassMouse, kEventMouseDragged));
        QCOMPARE(m_sink.mouse(QEvent::MouseMove, 0, Qt::LeftButton, 0, {1, 1}), expected);
    }

    void wheel_data()
    {
        QTest::addColumn<QPoint>("angle");
        QTest::addColumn<QString>("expected");
        QTest::newRow("half a notch") << QPoint(0, 60) << "wheel 1 1";
        QTest::newRow("two notches back") << QPoint(0, -240) << "wheel 1 -2";
        QTest::newRow("nothing") << QPoint(0, 0) << "wheel 1 -1";
        QTest::newRow("sideways") << QPoint(360, 10) << "wheel 0 3";
        QTest::newRow("a tie is vertical") << QPoint(-120, 120) << "wheel 1 1";
    }
    void wheel()
    {
        QFETCH(QPoint, angle);
        QFETCH(QString, expected);
        QWheelEvent e(QPointF(1, 1), QPointF(1, 1), QPoint(), angle, Qt::NoButton, Qt::NoModifier,
                      Qt::NoScrollPhase, false);
        QCOMPARE(m_sink.deliver(&e), expected);
    }

    void windowAndApplicationEvents()
    {
        const struct {
            QEvent::Type type;
            AQtWindow* window;
            bool zoomed;
            const char* expected;
        } rows[] = {
            {QEvent::Close, fakeWindow(1), false, "vlmr/clos@w1"},
            {QEvent::Move, fakeWindow(1), false, "vlmr/move@w1"},
            {QEvent::Resize, fakeWindow(1), false, "vlmr/size@w1"},
            {QEvent::Resize, fakeWindow(1), true, "vlmr/zoom@w1"},
            {QEvent::Paint, fakeWindow(1), false, "wind/1@w1"},
            {QEvent::Paint, nullptr, false, "<none>"},
            {QEvent::Show, nullptr, false, "wind/24"},
            {QEvent::Hide, nullptr, false, "wind/25"},
            {QEvent::WindowActivate, fakeWindow(2), false, "wind/5@w2"},
            {QEvent::WindowDeactivate, nullptr, false, "wind/6"},
            {QEvent::ApplicationActivate, nullptr, false, "appl/1"},
            {QEvent::ApplicationDeactivate, nullptr, false, "appl/2"},
            {QEvent::FocusIn, fakeWindow(1), false, "<none>"},
            {QEvent::None, fakeWindow(1), false, "<none>"}, // no Qt event for a window
            {QEvent::None, nullptr, false, "null/0"},       // a null event
        };
        for (const auto& row : rows) {
            gZoomed = row.zoomed;
            QEvent e(row.type);
            EventQueueItemSmartPtr item = EventQueueItemSmartPtr::Create();
            const bool converted = Private::ConvertVelmarEvent(row.window, row.type == QEvent::None ? nullptr : &e, item.get());
            QCOMPARE(converted ? describe(item.get()) : QStringLiteral("<none>"), QString::fromLatin1(row.expected));
        }
    }

    // Keys held as the tracked state sees them: GetKeys sets each key's bit (key code 0 only
    // for A) and a few from the live state; IsKeyPressed goes through the inverse table.
    void keyState_data()
    {
        QTest::addColumn<int>("key");
        QTest::addColumn<int>("mods");
        QTest::addColumn<QString>("keys");
        QTest::addColumn<QString>("pressed");
        QTest::newRow("A") << int(Qt::Key_A) << 0 << "00" << "";
        QTest::newRow("shift-S") << int(Qt::Key_S) << kShift << "01 38" << "01 38";
        QTest::newRow("control is command") << int(Qt::Key_Control) << kCtrl << "37" << "37";
        QTest::newRow("alt is option") << int(Qt::Key_Alt) << kAlt << "3a" << "3a";
        QTest::newRow("F2") << int(Qt::Key_F2) << 0 << "78" << "78";
        // Insert also sets 56 for the host; its own code 72 answers for Help.
        QTest::newRow("insert") << int(Qt::Key_Insert) << 0 << "56 72" << "";
        QTest::newRow("keypad 0") << int(Qt::Key_0) << kPad << "52 56" << "52";
        QTest::newRow("F15 shares Pause's code") << int(Qt::Key_F15) << 0 << "71" << "71";
    }
    void keyState()
    {
        QFETCH(int, key);
        QFETCH(int, mods);
        QFETCH(QString, keys);
        QFETCH(QString, pressed);
        m_sink.key(QEvent::KeyPress, key, mods);
        KeyMap map;
        GetKeys(map);
        QCOMPARE(setBits(map), keys);
        QStringList down;
        for (int code = 0; code < 128; ++code)
            if (IsKeyPressed(code))
                down << hex2(code);
        QCOMPARE(down.join(u' '), pressed);
        m_sink.key(QEvent::KeyRelease, key, mods & kPad); // every modifier up with it
        GetKeys(map);
        QCOMPARE(setBits(map), QString());
    }

    void capsLockBit()
    {
        KeyMap map;
        m_sink.key(QEvent::KeyPress, Qt::Key_CapsLock, 0);
        m_sink.key(QEvent::KeyRelease, Qt::Key_CapsLock, 0);
        GetKeys(map);
        QCOMPARE(setBits(map), QStringLiteral("39")); // the toggle, not the key
        QVERIFY(!IsKeyPressed(0x39));
        GetKeys(nullptr); // ignored
    }

    // StillDown: Qt's button state (with looper filtering), then the system's, then no
    // click waiting; it repaints dirty ports whenever it looks at the queue or gives up early.
    void stillDown_data()
    {
        QTest::addColumn<int>("looper");
        QTest::addColumn<bool>("qtDown");
        QTest::addColumn<bool>("systemDown");
        QTest::addColumn<QString>("queued");
        QTest::addColumn<QString>("expected");
        QTest::addColumn<QString>("queueAfterWaitMouseUp");
        QTest::newRow("held") << 1 << true << true << "" << "true repaint 1" << "";
        QTest::newRow("held, key waiting") << 1 << true << true << "keyb/1" << "true repaint 1" << "keyb/1";
        QTest::newRow("held, up waiting") << 1 << true << true << "mous/2" << "false repaint 1" << "";
        QTest::newRow("held, down waiting") << 1 << true << true << "mous/1" << "false repaint 1" << "mous/1";
        QTest::newRow("Qt saw it go up") << 1 << false << true << "mous/2" << "false repaint 1" << "";
        QTest::newRow("Qt's state unused") << 0 << false << true << "" << "true repaint 1" << "";
        QTest::newRow("system says up") << 0 << true << false << "mous/2" << "false" << "";
    }
    void stillDown()
    {
        QFETCH(int, looper);
        QFETCH(bool, qtDown);
        QFETCH(bool, systemDown);
        QFETCH(QString, queued);
        QFETCH(QString, expected);
        QFETCH(QString, queueAfterWaitMouseUp);
        EnableLooperFiltering(UInt32(looper));
        if (qtDown)
            m_sink.mouse(QEvent::MouseButtonPress, Qt::LeftButton, Qt::LeftButton, 0);
        static bool sDown;
        sDown = systemDown;
        ScopedOverride button(&Brindle::SetLeftButtonSource, +[] { return sDown; });
        ScopedOverride repaint(&Private::SetRepaintDirtyPortsHook, +[](int flags) { gRepaints << QString::number(flags); });
        if (!queued.isEmpty())
            Private::gMainEventQueue.append(makeItem(queued.startsWith(u'k') ? kEventClassKeyboard : kEventClassMouse,
                                                     queued.back().digitValue()));
        gRepaints.clear();
        const bool still = StillDown();
        QCOMPARE(QString(still ? "true" : "false") + (gRepaints.isEmpty() ? "" : " repaint " + gRepaints.join(u',')), expected);
        QCOMPARE(bool(Button()), systemDown);
        QCOMPARE(bool(WaitMouseUp()), still);
        QCOMPARE(queueSnapshot().join(u' '), queueAfterWaitMouseUp);
        if (qtDown)
            m_sink.mouse(QEvent::MouseButtonRelease, Qt::LeftButton, 0, 0);
    }

    void timing_data()
    {
        QTest::addColumn<int>("ms");
        QTest::addColumn<int>("ticks");
        QTest::newRow("Qt's default") << 400 << 24;
        QTest::newRow("truncated") << 249 << 14;
    }
    void timing()
    {
        QFETCH(int, ms);
        QFETCH(int, ticks);
        QStyleHints* hints = QGuiApplication::styleHints();
        const int previous = hints->mouseDoubleClickInterval();
        hints->setMouseDoubleClickInterval(ms);
        QCOMPARE(GetDblTime(), UInt32(ticks));
        QCOMPARE(LMGetDoubleTime(), UInt32(ticks));
        hints->setMouseDoubleClickInterval(previous);
        QCOMPARE(LMGetKeyThresh(), SInt16(24));
    }
};

VELMAR_APP_TEST_MAIN(tst_InputConversion)
#include "tst_inputconversion.moc"
