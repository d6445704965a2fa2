// Qt key and X keysym translation into Windows virtual-key codes.
#include "TestSupport.h"

#include "platform/KeyTables.h"
#include "platform/VirtualKeys.h"

using namespace Velmar::Private;
namespace VK = Velmar::Private::VirtualKey;

class KeyTablesTest : public QObject {
    Q_OBJECT
private Q_SLOTS:
    void qtKeys_data();
    void qtKeys();
    void keysyms_data();
    void keysyms();
    void genericModifiers();
};

void KeyTablesTest::qtKeys_data()
{
    QTest::addColumn<int>("key");
    QTest::addColumn<bool>("keypad");
    QTest::addColumn<int>("vk");
    QTest::newRow("A") << int(Qt::Key_A) << false << 0x41;
    QTest::newRow("Z") << int(Qt::Key_Z) << false << 0x5A;
    QTest::newRow("0") << int(Qt::Key_0) << false << 0x30;
    QTest::newRow("9") << int(Qt::Key_9) << false << 0x39;
    QTest::newRow("keypad 0") << int(Qt::Key_0) << true << 0x60;
    QTest::newRow("keypad 9") << int(Qt::Key_9) << true << 0x69;
    QTest::newRow("keypad *") << int(Qt::Key_Asterisk) << true << 0x6A;
    QTest::newRow("keypad /") << int(Qt::Key_Slash) << true << 0x6F;
    QTest::newRow("keypad A stays A") << int(Qt::Key_A) << true << 0x41;
    QTest::newRow("F1") << int(Qt::Key_F1) << false << 0x70;
    QTest::newRow("F12") << int(Qt::Key_F12) << false << 0x7B;
    QTest::newRow("F24") << int(Qt::Key_F24) << false << 0x87;
    QTest::newRow("F25 has none") << int(Qt::Key_F25) << false << 0;
    QTest::newRow("Shift") << int(Qt::Key_Shift) << false << 0x10;
    QTest::newRow("Control") << int(Qt::Key_Control) << false << 0x11;
    QTest::newRow("Alt") << int(Qt::Key_Alt) << false << 0x12;
    QTest::newRow("Meta") << int(Qt::Key_Meta) << false << 0x5B;
    QTest::newRow("Caps Lock") << int(Qt::Key_CapsLock) << false << 0x14;
    QTest::newRow("Left") << int(Qt::Key_Left) << false << 0x25;
    QTest::newRow("Up") << int(Qt::Key_Up) << false << 0x26;
    QTest::newRow("Right") << int(Qt::Key_Right) << false << 0x27;
    QTest::newRow("Down") << int(Qt::Key_Down) << false << 0x28;
    QTest::newRow("Escape") << int(Qt::Key_Escape) << false << 0x1B;
    QTest::newRow("Return") << int(Qt::Key_Return) << false << 0x0D;
    QTest::newRow("Enter is Qt's own slot") << int(Qt::Key_Enter) << true << 0x0E;
    QTest::newRow("Space") << int(Qt::Key_Space) << false << 0x20;
    QTest::newRow("period") << int(Qt::Key_Period) << false << 0xBE;
    QTest::newRow("semicolon") << int(Qt::Key_Semicolon) << false << 0xBA;
    QTest::newRow("shifted 1") << int(Qt::Key_Exclam) << false << 0x31;
    QTest::newRow("shifted 0") << int(Qt::Key_ParenRight) << false << 0x30;
    QTest::newRow("unknown") << int(Qt::Key_unknown) << false << 0;
    QTest::newRow("negative") << -5 << false << 0;
}

void KeyTablesTest::qtKeys()
{
    QFETCH(int, key);
    QFETCH(bool, keypad);
    QFETCH(int, vk);
    QCOMPARE(Platform::virtualKeyFromQtKey(key, keypad), vk);
}

void KeyTablesTest::keysyms_data()
{
    QTest::addColumn<uint>("keysym");
    QTest::addColumn<int>("vk");
    QTest::newRow("a") << 0x61u << 0x41;
    QTest::newRow("A") << 0x41u << 0x41;
    QTest::newRow("z") << 0x7au << 0x5A;
    QTest::newRow("0") << 0x30u << 0x30;
    QTest::newRow("9") << 0x39u << 0x39;
    QTest::newRow("F1") << 0xffbeu << 0x70;
    QTest::newRow("F12") << 0xffc9u << 0x7B;
    QTest::newRow("Shift_L") << 0xffe1u << 0xA0;
    QTest::newRow("Shift_R") << 0xffe2u << 0xA1;
    QTest::newRow("Control_L") << 0xffe3u << 0xA2;
    QTest::newRow("Control_R") << 0xffe4u << 0xA3;
    QTest::newRow("Alt_L") << 0xffe9u << 0xA4;
    QTest::newRow("AltGr") << 0xfe03u << 0xA5;
    QTest::newRow("Caps_Lock") << 0xffe5u << 0x14;
    QTest::newRow("Super_L") << 0xffebu << 0x5B;
    QTest::newRow("Left") << 0xff51u << 0x25;
    QTest::newRow("Up") << 0xff52u << 0x26;
    QTest::newRow("Right") << 0xff53u << 0x27;
    QTest::newRow("Down") << 0xff54u << 0x28;
    QTest::newRow("Escape") << 0xff1bu << 0x1B;
    QTest::newRow("KP_Enter is Return") << 0xff8du << 0x0D;
    QTest::newRow("KP_5") << 0xffb5u << 0x65;
    QTest::newRow("KP_Home") << 0xff95u << 0x24;
    QTest::newRow("period") << 0x2eu << 0xBE;
    QTest::newRow("less: ISO extra key") << 0x3cu << 0xE2;
    QTest::newRow("NoSymbol") << 0u << 0;
    QTest::newRow("Latin-1 letter") << 0xfcu << 0;
}

void KeyTablesTest::keysyms()
{
    QFETCH(uint, keysym);
    QFETCH(int, vk);
    QCOMPARE(Platform::virtualKeyFromKeysym(keysym), vk);
}

void KeyTablesTest::genericModifiers()
{
    QCOMPARE(Platform::genericModifierKey(VK::LShift), int(VK::Shift));
    QCOMPARE(Platform::genericModifierKey(VK::RShift), int(VK::Shift));
    QCOMPARE(Platform::genericModifierKey(VK::RControl), int(VK::Control));
    QCOMPARE(Platform::genericModifierKey(VK::RMenu), int(VK::Menu));
    QCOMPARE(Platform::genericModifierKey(VK::Shift), 0);
    QCOMPARE(Platform::genericModifierKey(VK::A), 0);
    QCOMPARE(Platform::genericModifierKey(-1), 0);
}

VELMAR_TEST_MAIN(KeyTablesTest)
#include "tst_keytables.moc"
