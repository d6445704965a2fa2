// Qt key and X keysym translation into Windows virtual-key codes.
#include "TestSupport.h"

#include "platform/KeyTables.h"
#include "platform/VirtualKeys.h"

using namespace Velmar::Private;
namespace VK = Velmar::Private::VirtualKey;

class KeyTablesTest : public QObject {
    Q_OBJECT
private Q_SLOTS:
    void qtKeys()
    {
        struct Row { int key; bool keypad; int vk; };
        const Row rows[] = {
            {Qt::Key_A, false, 0x41}, {Qt::Key_Z, false, 0x5A}, {Qt::Key_0, false, 0x30},
            {Qt::Key_9, false, 0x39}, {Qt::Key_0, true, 0x60}, {Qt::Key_9, true, 0x69},
            {Qt::Key_Asterisk, true, 0x6A}, {Qt::Key_Slash, true, 0x6F},
            {Qt::Key_A, true, 0x41} /* keypad A stays A */, {Qt::Key_F1, false, 0x70},
            {Qt::Key_F24, false, 0x87}, {Qt::Key_F25, false, 0}, {Qt::Key_Shift, false, 0x10},
            {Qt::Key_Control, false, 0x11}, {Qt::Key_Alt, false, 0x12}, {Qt::Key_Meta, false, 0x5C} /* as key events say */,
            {Qt::Key_Clear, false, 0xFE},
            {Qt::Key_CapsLock, false, 0x14}, {Qt::Key_Left, false, 0x25}, {Qt::Key_Down, false, 0x28},
            {Qt::Key_Escape, false, 0x1B}, {Qt::Key_Return, false, 0x0D},
            {Qt::Key_Enter, true, 0x0E} /* Qt's own slot */, {Qt::Key_Space, false, 0x20},
            {Qt::Key_Period, false, 0xBE}, {Qt::Key_Semicolon, false, 0xBA},
            {Qt::Key_Exclam, false, 0x31} /* shifted 1 */, {Qt::Key_ParenRight, false, 0x30},
            {Qt::Key_unknown, false, 0}, {-5, false, 0},
        };
        for (const Row& r : rows)
            QVERIFY2(Platform::virtualKeyFromQtKey(r.key, r.keypad) == r.vk,
                     qPrintable(QString::number(r.key, 16)));
    }

    void keysyms()
    {
        const std::pair<unsigned, int> rows[] = {
            {0x61, 0x41}, {0x41, 0x41}, {0x7a, 0x5A}, {0x30, 0x30}, {0x39, 0x39},
            {0xffbe, 0x70} /* F1 */, {0xffc9, 0x7B} /* F12 */, {0xffe1, 0xA0} /* Shift_L */,
            {0xffe2, 0xA1}, {0xffe3, 0xA2}, {0xffe4, 0xA3}, {0xffe9, 0xA4} /* Alt_L */,
            {0xfe03, 0xA5} /* AltGr */, {0xffe5, 0x14} /* Caps */, {0xffeb, 0x5B} /* Super_L */,
            {0xff51, 0x25} /* Left */, {0xff54, 0x28} /* Down */, {0xff1b, 0x1B},
            {0xff8d, 0x0D} /* KP_Enter is Return */, {0xffb5, 0x65} /* KP_5 */,
            {0xff95, 0x24} /* KP_Home */, {0x2e, 0xBE}, {0x3c, 0xE2} /* ISO extra key */,
            {0, 0}, {0xfc, 0} /* Latin-1 letter */,
        };
        for (const auto& [keysym, vk] : rows)
            QVERIFY2(Platform::virtualKeyFromKeysym(keysym) == vk, qPrintable(QString::number(keysym, 16)));
    }

    void genericModifiers()
    {
        QCOMPARE(Platform::genericModifierKey(VK::LShift), int(VK::Shift));
        QCOMPARE(Platform::genericModifierKey(VK::RShift), int(VK::Shift));
        QCOMPARE(Platform::genericModifierKey(VK::RControl), int(VK::Control));
        QCOMPARE(Platform::genericModifierKey(VK::RMenu), int(VK::Menu));
        QCOMPARE(Platform::genericModifierKey(VK::Shift), 0);
        QCOMPARE(Platform::genericModifierKey(-1), 0);
    }
};

VELMAR_TEST_MAIN(KeyTablesTest)
#include "tst_keytables.moc"
