// Qt input as Toolbox events: Mac key and character codes, modifiers, mouse buttons and
// parts, wheel steps; the keyboard tables' deliberate odd rows; the polling calls.
#include "events_support.h"

#include "events/KeyCodeTables.h"
#include "events/QtInputConversion.h"
#include "platform/Platform.h"
#include "platform/VirtualKeys.h"

#include <Velmar/Events.h>
#include <Velmar/FeatureFlags.h>
#include <Velmar/MacErrors.h>

#include <QKeyEvent>
#include <QMouseEvent>
#include <QWheelEvent>

using namespace Velmar;
using namespace EventTest;
using Velmar::Private::EventQueueItem;

namespace {

// "kind char/key" of a key event as converted; "none" when nothing is posted.
QString convertKey(QEvent::Type type, int key, Qt::KeyboardModifiers modifiers, const QString& text,
                   bool autoRepeat = false)
{
    QKeyEvent e(type, key, modifiers, text, autoRepeat);
    EventQueueItemSmartPtr item = EventQueueItemSmartPtr::Create();
    if (!Private::ConvertVelmarEvent(nullptr, &e, item.get()))
        return QStringLiteral("none");
    return QStringLiteral("%1 %2/%3").arg(item->eventKind).arg(item->charCode, 2, 16, QChar(u'0'))
        .arg(item->keyCode, 2, 16, QChar(u'0'));
}

} // namespace

class tst_InputConversion : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void keys_data()
    {
        QTest::addColumn<int>("key");
        QTest::addColumn<int>("modifiers");
        QTest::addColumn<QString>("text");
        QTest::addColumn<QString>("expected");
        QTest::newRow("a") << int(Qt::Key_A) << 0 << "a" << "1 61/00";
        QTest::newRow("A") << int(Qt::Key_A) << int(Qt::ShiftModifier) << "A" << "1 41/00";
        QTest::newRow("digit 7") << int(Qt::Key_7) << 0 << "7" << "1 37/1a";
        QTest::newRow("keypad 7") << int(Qt::Key_7) << int(Qt::KeypadModifier) << "7" << "1 37/59";
        QTest::newRow("!") << int(Qt::Key_Exclam) << int(Qt::ShiftModifier) << "!" << "1 21/12";
        QTest::newRow("~") << int(Qt::Key_AsciiTilde) << int(Qt::ShiftModifier) << "~" << "1 7e/32";
        QTest::newRow("F5 has no text") << int(Qt::Key_F5) << 0 << "" << "1 10/60";
        QTest::newRow("F15") << int(Qt::Key_F15) << 0 << "" << "1 10/71";
        QTest::newRow("left arrow") << int(Qt::Key_Left) << 0 << "" << "1 1c/7b";
        QTest::newRow("page down") << int(Qt::Key_PageDown) << 0 << "" << "1 0c/79";
        QTest::newRow("return") << int(Qt::Key_Return) << 0 << "\r" << "1 0d/24";
        QTest::newRow("keypad enter") << int(Qt::Key_Enter) << int(Qt::KeypadModifier) << "\r" << "1 03/4c";
        QTest::newRow("escape") << int(Qt::Key_Escape) << 0 << "\x1b" << "1 1b/35";
        QTest::newRow("forward delete") << int(Qt::Key_Delete) << 0 << "\x7f" << "1 7f/75";
        QTest::newRow("option-g") << int(Qt::Key_G) << int(Qt::AltModifier) << "\u00a9" << "1 a9/05";
        QTest::newRow("euro") << int(Qt::Key_2) << int(Qt::AltModifier | Qt::ShiftModifier) << "\u20ac" << "1 db/13";
        QTest::newRow("apple") << int(Qt::Key_K) << int(Qt::AltModifier | Qt::ShiftModifier) << "\uf8ff" << "1 f0/28";
        QTest::newRow("en dash") << int(Qt::Key_Minus) << int(Qt::AltModifier) << "\u2013" << "1 d0/1b";
        QTest::newRow("right quote") << int(Qt::Key_BracketRight) << int(Qt::AltModifier | Qt::ShiftModifier) << "\u2019" << "1 d5/1e";
        // Control-typed letters are control characters: the Qt key decides.
        QTest::newRow("command-c") << int(Qt::Key_C) << int(Qt::ControlModifier) << "\x03" << "1 43/08";
        // Both Windows keys are Qt's Meta, whose index entry is the right Windows key.
        QTest::newRow("meta") << int(Qt::Key_Meta) << int(Qt::MetaModifier) << "" << "1 00/3c";
        QTest::newRow("shift alone") << int(Qt::Key_Shift) << int(Qt::ShiftModifier) << "" << "none";
        QTest::newRow("caps lock alone") << int(Qt::Key_CapsLock) << 0 << "" << "none";
    }
    void keys()
    {
        QFETCH(int, key);
        QFETCH(int, modifiers);
        QFETCH(QString, text);
        QFETCH(QString, expected);
        QCOMPARE(convertKey(QEvent::KeyPress, key, Qt::KeyboardModifiers(modifiers), text), expected);
    }

    void keyKinds()
    {
        QCOMPARE(convertKey(QEvent::KeyPress, Qt::Key_A, {}, "a", true), QStringLiteral("2 61/00"));
        QCOMPARE(convertKey(QEvent::KeyRelease, Qt::Key_A, {}, "a"), QStringLiteral("3 61/00"));
        QCOMPARE(convertKey(QEvent::KeyRelease, Qt::Key_A, {}, "a", true), QStringLiteral("none"));
        QKeyEvent e(QEvent::KeyPress, Qt::Key_B, Qt::ShiftModifier, QStringLiteral("B"));
        EventQueueItemSmartPtr item = EventQueueItemSmartPtr::Create();
        QVERIFY(Private::ConvertKeyEvent(&e, item.get()));
        QCOMPARE(item->textUnit, UInt16('B'));
        QCOMPARE(item->qtKey, UInt32(Qt::Key_B));
        QCOMPARE(item->keyMessage & 0xFFFF, UInt32(0x0B42));
        QCOMPARE(item->attributes, UInt32(kEventAttributeUserEvent));
        QCOMPARE(GetUTF16Char(&e), UInt16('B'));
    }

    void tables()
    {
        using namespace Private;
        QCOMPARE(characterTableSize(), 180);
        QCOMPARE(int(macKeyForVirtualKey(0x2C).keyCode), 0x2B); // Print Screen on the comma key
        QCOMPARE(int(macKeyForVirtualKey(0x5B).keyCode), 0x21); // left Windows key on "["
        QCOMPARE(int(macKeyForVirtualKey(0x13).keyCode), 0x71); // Pause on F15
        QCOMPARE(virtualKeyForQtKey(Qt::Key_Backtab), 0x09);
        QCOMPARE(virtualKeyForMacKey(0), 0); // the A key's code means "none"
        QCOMPARE(virtualKeyForMacKey(0x72), 0x2F); // insert and help share a key; help wins
    }

    void mouse_data()
    {
        QTest::addColumn<int>("type");
        QTest::addColumn<int>("button");
        QTest::addColumn<int>("buttons");
        QTest::addColumn<QPoint>("local");
        QTest::addColumn<QString>("expected");
        const int left = Qt::LeftButton;
        QTest::newRow("press inside") << int(QEvent::MouseButtonPress) << left << left << QPoint(5, 5) << "1 b1 p3";
        QTest::newRow("double click is a down") << int(QEvent::MouseButtonDblClick) << left << left << QPoint(5, 5) << "1 b1 p3";
        QTest::newRow("release outside") << int(QEvent::MouseButtonRelease) << left << 0 << QPoint(50, 5) << "2 b1 p0";
        QTest::newRow("right") << int(QEvent::MouseButtonPress) << int(Qt::RightButton) << int(Qt::RightButton) << QPoint(1, 1) << "1 b2 p3";
        QTest::newRow("x2") << int(QEvent::MouseButtonPress) << int(Qt::XButton2) << int(Qt::XButton2) << QPoint(1, 1) << "1 b5 p3";
        QTest::newRow("plain move") << int(QEvent::MouseMove) << 0 << 0 << QPoint(1, 1) << "none";
        QTest::newRow("drag") << int(QEvent::MouseMove) << 0 << left << QPoint(1, 1) << "6 b1 p3";
    }
    void mouse()
    {
        QFETCH(int, type);
        QFETCH(int, button);
        QFETCH(int, buttons);
        QFETCH(QPoint, local);
        QFETCH(QString, expected);
        QWidget widget;
        widget.resize(20, 20);
        QMouseEvent e(QEvent::Type(type), local, QPointF(local + QPoint(100, 200)), Qt::MouseButton(button),
                      Qt::MouseButtons(buttons), Qt::NoModifier);
        EventQueueItemSmartPtr item = EventQueueItemSmartPtr::Create();
        QString got = QStringLiteral("none");
        if (Private::ConvertMouseEvent(&e, item.get(), &widget)) {
            got = QStringLiteral("%1 b%2 p%3").arg(item->eventKind).arg(item->mouseButton).arg(item->windowPart);
            QCOMPARE(item->where.h, SInt16(local.x() + 100));
        }
        QCOMPARE(got, expected);
    }

    void wheel_data()
    {
        QTest::addColumn<QPoint>("angle");
        QTest::addColumn<int>("axis");
        QTest::addColumn<int>("steps");
        QTest::newRow("half a notch") << QPoint(0, 60) << 1 << 1;
        QTest::newRow("two notches back") << QPoint(0, -240) << 1 << -2;
        QTest::newRow("nothing") << QPoint(0, 0) << 1 << -1;
        QTest::newRow("sideways") << QPoint(360, 10) << 0 << 3;
    }
    void wheel()
    {
        QFETCH(QPoint, angle);
        QFETCH(int, axis);
        QFETCH(int, steps);
        QWheelEvent e(QPointF(1, 1), QPointF(1, 1), QPoint(), angle, Qt::NoButton, Qt::NoModifier,
                      Qt::NoScrollPhase, false);
        EventQueueItemSmartPtr item = EventQueueItemSmartPtr::Create();
        QVERIFY(Private::ConvertVelmarEvent(nullptr, &e, item.get()));
        UInt16 gotAxis = 99;
        SInt32 gotSteps = 0;
        QCOMPARE(GetEventParameter(item.get(), kEventParamMouseWheelAxis, typeMouseWheelAxis, nullptr, 2, nullptr, &gotAxis), noErr);
        QCOMPARE(GetEventParameter(item.get(), kEventParamMouseWheelDelta, typeLongInteger, nullptr, 4, nullptr, &gotSteps), noErr);
        QCOMPARE(int(gotAxis), axis);
        QCOMPARE(int(gotSteps), steps);
    }

    void windowAndApplicationEvents()
    {
        const struct {
            QEvent::Type type;
            const char* expected;
        } rows[] = {
            {QEvent::Close, "vlmr/clos"}, {QEvent::Move, "vlmr/move"}, {QEvent::Resize, "vlmr/size"},
            {QEvent::Show, "wind/24"}, {QEvent::WindowActivate, "wind/5"},
            {QEvent::ApplicationDeactivate, "appl/2"}, {QEvent::FocusIn, "<null>"},
        };
        for (const auto& row : rows) {
            QEvent e(row.type);
            EventQueueItemSmartPtr item = EventQueueItemSmartPtr::Create();
            const bool converted = Private::ConvertVelmarEvent(nullptr, &e, item.get());
            QCOMPARE(converted ? describe(item.get()) : QStringLiteral("<null>"), QString::fromLatin1(row.expected));
        }
        EventQueueItemSmartPtr item = EventQueueItemSmartPtr::Create();
        QVERIFY(Private::ConvertVelmarEvent(nullptr, nullptr, item.get())); // a null event
        QVERIFY(item->isNullEvent());
        QEvent paint(QEvent::Paint);
        QVERIFY(!Private::ConvertVelmarEvent(nullptr, &paint, item.get())); // needs a window
    }

    // Key state as the tracked fallback sees it, so that the check is the same everywhere.
    void polling()
    {
        namespace VK = Private::VirtualKey;
        Private::Platform::setWindowSystemInputEnabled(false);
        QKeyEvent shiftDown(QEvent::KeyPress, Qt::Key_Shift, Qt::ShiftModifier);
        QKeyEvent sDown(QEvent::KeyPress, Qt::Key_S, Qt::ShiftModifier, QStringLiteral("S"));
        Private::Platform::trackInputEvent(&shiftDown);
        Private::Platform::trackInputEvent(&sDown);
        KeyMap keys;
        GetKeys(keys);
        const auto bit = [&keys](int code) {
            return (reinterpret_cast<const UInt8*>(keys)[code / 8] >> (code % 8)) & 1;
        };
        QCOMPARE(bit(0x38), 1); // shift
        QCOMPARE(bit(0x01), 1); // S
        QCOMPARE(bit(0x00), 0); // A
        QVERIFY(IsKeyPressed(0x01));
        QVERIFY(!IsKeyPressed(0)); // the A key's code never answers
        QKeyEvent sUp(QEvent::KeyRelease, Qt::Key_S, Qt::ShiftModifier, QStringLiteral("S"));
        Private::Platform::trackInputEvent(&sUp);
        QVERIFY(!IsKeyPressed(0x01));
        Private::Platform::setWindowSystemInputEnabled(true);
        QCOMPARE(GetDblTime(), UInt32(QApplication::doubleClickInterval() * 60 / 1000));
        QCOMPARE(LMGetKeyThresh(), SInt16(24));
    }
};

VELMAR_APP_TEST_MAIN(tst_InputConversion)
#include "tst_inputconversion.moc"
