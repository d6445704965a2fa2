// Classic resource files: forks built in memory and by hand, the MacBinary and AppleDouble
// wrappers, hostile maps, the decoders on hand-assembled bytes and PICT playback read back
// with the pixel oracle.
#include "../quickdraw/QuickDrawTestSupport.h"

#include "classic/resfile/Decoders.h"
#include "classic/resfile/Picture.h"
#include "classic/resfile/ResourceFork.h"

#include <QTemporaryDir>
#include <QtTest>

using namespace Velmar;
using namespace Velmar::Classic;
using namespace QDTest;

namespace {

QByteArray hex(const char* text) { return QByteArray::fromHex(QByteArray(text).replace(' ', "")); }
constexpr UInt32 T(const char (&s)[5]) { return FOUR_CHAR_CODE(s); }

// One 'STR ' 128 named "Greet" holding "Hi!", assembled by hand: header, 240 reserved bytes,
// the data, then the map (header copy, next map, file ref, attributes, list offsets 28 and
// 50, one type, its reference list 10 bytes into the type list, the name list).
QByteArray handFork()
{
    return hex("00000100 00000107 00000007 00000038") + QByteArray(240, '\0') + hex("00000003 486921")
        + hex("00000100 00000107 00000007 00000038 00000000 0000 0000 001C 0032")
        + hex("0000 53545220 0000 000A") + hex("0080 0000 20 000000 00000000") + hex("05") + "Greet";
}

void put32(QByteArray& b, int at, UInt32 v)
{
    for (int i = 0; i < 4; ++i)
        b[at + i] = char(v >> (24 - 8 * i));
}

} // namespace

class TestResFile : public QObject {
    Q_OBJECT
private Q_SLOTS:
    // Built with add(), written and read back: order, replacement, lookups by ID, name
    // (Mac Roman, case-insensitive) and index.
    void forkRoundTrip()
    {
        ResourceFork fork;
        fork.add({T("MENU"), 128, kResPurgeable, "File", hex("0080")});
        fork.add({T("STR#"), 200, 0, {}, hex("0001 0161")});
        fork.add({T("MENU"), 129, 0, "\x83" "dition", QByteArray(70000, 'x')}); // "Édition"
        fork.add({T("MENU"), 128, kResLocked, "File", hex("0081")});            // replaces
        const auto back = ResourceFork::parse(fork.serialize());
        QVERIFY(back);
        QCOMPARE(back->types(), (QList<UInt32>{T("MENU"), T("STR#")}));
        QCOMPARE(back->count(T("MENU")), 2);
        QCOMPARE(back->find(T("MENU"), 128)->data, hex("0081"));
        QCOMPARE(back->find(T("MENU"), 128)->attributes, UInt8(kResLocked));
        QCOMPARE(back->findNamed(T("MENU"), "\x8E" "DITION")->id, SInt16(129)); // "éDITION"
        QCOMPARE(back->findNamed(T("MENU"), "file")->id, SInt16(128));
        QCOMPARE(back->indexed(T("MENU"), 2)->data.size(), 70000);
        QVERIFY(!back->indexed(T("MENU"), 3) && !back->indexed(T("MENU"), 0) && !back->find(T("STR#"), 201));
        QVERIFY(ResourceFork::parse(ResourceFork().serialize())); // no types at all
    }

    // The same fork by hand, raw and in each wrapper, directly and through the companion
    // files load() tries.
    void wrappers_data()
    {
        QTest::addColumn<QByteArray>("file");
        QTest::addColumn<QString>("name");
        QTest::newRow("raw") << handFork() << "x.rsrc";
        // MacBinary II: name "Test", 'TEXT'/'ttxt', no data fork, 319-byte resource fork,
        // versions 129/129 and the header CRC (CRC-16/XMODEM of bytes 0-123).
        QByteArray mb(128, '\0');
        mb[1] = 4;
        mb.replace(2, 4, "Test").replace(65, 8, "TEXTttxt");
        put32(mb, 87, 319);
        mb[122] = mb[123] = char(0x81);
        mb[124] = char(0x95), mb[125] = char(0x41);
        QTest::newRow("macbinary") << mb + handFork() << "x";
        // AppleDouble: Finder info (entry 9) at 50, then the resource fork (entry 2) at 82.
        const QByteArray ad = hex("00051607 00020000") + QByteArray(16, '\0')
            + hex("0002 00000009 00000032 00000020 00000002 00000052 0000013F") + QByteArray(32, '\0');
        QTest::newRow("appledouble") << ad + handFork() << "._x";
        QByteArray as = ad;
        as[3] = 0x00; // AppleSingle
        QTest::newRow("applesingle") << as + handFork() << "x";
    }
    void wrappers()
    {
        QFETCH(QByteArray, file);
        QFETCH(QString, name);
        QTemporaryDir dir;
        QFile out(dir.filePath(name));
        QVERIFY(out.open(QIODevice::WriteOnly) && out.write(file) == file.size());
        out.close();
        QString why;
        const auto fork = ResourceFork::load(dir.filePath(QStringLiteral("x")), &why);
        QVERIFY2(fork, qPrintable(why));
        const ResourceEntry* e = fork->find(T("STR "), 128);
        QVERIFY(e);
        QCOMPARE(e->name, QByteArray("Greet"));
        QCOMPARE(e->data, QByteArray("Hi!"));
    }

    // Inconsistent maps are refused with a reason, never read out of bounds.
    void hostileForks_data()
    {
        QTest::addColumn<QByteArray>("fork");
        const QByteArray good = handFork();
        auto patched = [&good](int at, const char* bytes) { return QByteArray(good).replace(at, hex(bytes).size(), hex(bytes)); };
        const int map = 0x107;
        QTest::newRow("short header") << good.left(15);
        QTest::newRow("truncated map") << good.left(good.size() - 1);
        QTest::newRow("data past end") << patched(8, "00010000");
        QTest::newRow("map overlaps data") << patched(4, "00000100");
        QTest::newRow("type list outside map") << patched(map + 24, "7FF0");
        QTest::newRow("huge type count") << patched(map + 28, "7FFF");
        QTest::newRow("reference list outside map") << patched(map + 36, "0FF0");
        QTest::newRow("huge resource count") << patched(map + 34, "7FFF");
        QTest::newRow("name outside map") << patched(map + 40, "00F0");
        QTest::newRow("data offset past data") << patched(map + 43, "000010");
        QTest::newRow("data length past data") << patched(0x100, "00000008");
        QTest::newRow("wrapper without fork") << hex("00051607 00020000") + QByteArray(16, '\0') + hex("0000");
        // Two types sharing one reference list: a small file claiming many resources.
        QByteArray shared = good;
        shared.replace(map + 28, 2, hex("0001")).insert(map + 38, hex("53545223 0000 000A"));
        for (int at : {12, map + 12})
            put32(shared, at, 0x40);
        shared.replace(map + 26, 2, hex("003A"));
        QTest::newRow("shared reference list") << shared;
    }
    void hostileForks()
    {
        QFETCH(QByteArray, fork);
        QString why;
        QVERIFY(!ResourceFork::unwrap(fork, &why));
        QVERIFY(!why.isEmpty());
    }

    // Each decoder on hand-assembled bytes; each refuses its fixed part cut by one byte.
    void decoders()
    {
        const auto w = decodeWindow(hex("0028 0014 00C8 0190 0004 0100 0000 12345678 05") + "Hello" + hex("300A"));
        QVERIFY(w && w->visible && !w->goAwayFlag);
        QCOMPARE(w->bounds.right, SInt16(400));
        QCOMPARE(w->refCon, SInt32(0x12345678));
        QCOMPARE(w->title, QByteArray("Hello"));
        QCOMPARE(w->positioning, std::optional<UInt16>(0x300A));

        const auto m = decodeMenu(hex("0080 0000 0000 0000 0000 FFFFFFFB 0114") + "\x04Open" + hex("00 4F 00 00")
                                  + "\x01-" + hex("00000000") + "\x04Quit" + hex("01 51 12 01") + hex("00"));
        QVERIFY(m);
        QCOMPARE(m->menuID, SInt16(128));
        QCOMPARE(m->enableFlags, 0xFFFFFFFBu);
        QCOMPARE(m->title, QByteArray("\x14"));
        QCOMPARE(m->items.size(), 3);
        QCOMPARE(m->items[0].keyEquivalent, UInt8('O'));
        QCOMPARE(m->items[2].icon, UInt8(1));
        QCOMPARE(m->items[2].mark, UInt8(0x12));
        QCOMPARE(m->items[2].style, UInt8(1));

        QCOMPARE(decodeStringList(hex("0003 0161 00 026263")), (std::optional<QList<QByteArray>>({"a", "", "bc"})));
        QCOMPARE(decodeMenuBar(hex("0002 0080 0081")), (std::optional<QList<SInt16>>({128, 129})));

        const auto styles = decodeStyles(hex("0001 00000005 000C 0009 0015 03 00 0012 FFFF 0000 8000"));
        QVERIFY(styles && styles->size() == 1);
        QCOMPARE(styles->at(0).startChar, 5);
        QCOMPARE(styles->at(0).fontID, SInt16(21));
        QCOMPARE(styles->at(0).face, UInt8(3));
        QCOMPARE(styles->at(0).size, SInt16(18));
        QCOMPARE(styles->at(0).color.blue, UInt16(0x8000));

        const auto a = decodeAlert(hex("0028 0028 0096 0190 0081 CC54"));
        QVERIFY(a && a->itemsID == 129);
        QVERIFY(a->stage(1).drawn && !a->stage(1).boldItem2 && a->stage(1).sound == 0);
        QVERIFY(a->stage(4).boldItem2 && a->stage(4).drawn && a->stage(3).sound == 0);
        QCOMPARE(a->stage(2).sound, UInt8(1));

        const auto d = decodeDialog(hex("0028 0028 0096 0190 0001 0000 0001 00000000 0081 00"));
        QVERIFY(d && d->itemsID == 129 && !d->visible && d->goAwayFlag && !d->positioning);

        // OK button, an odd-length static text (padded), an icon and a disabled user item.
        const auto items = decodeDialogItems(hex("0003 00000000 0050 00A0 0064 00DC 04 02") + "OK"
                                             + hex("00000000 000A 000A 0040 0100 88 03") + "Hi!" + hex("00")
                                             + hex("00000000 000A 000A 002A 002A 20 02 0080")
                                             + hex("00000000 0000 0000 0010 0010 80 00"));
        QVERIFY(items && items->size() == 4);
        QCOMPARE(items->at(0).kind(), kDialogItemButton);
        QCOMPARE(items->at(1).data, QByteArray("Hi!"));
        QVERIFY(!items->at(1).enabled() && items->at(1).kind() == kDialogItemStaticText);
        QCOMPARE(items->at(2).resourceID, SInt16(128));
        QCOMPARE(items->at(3).kind(), kDialogItemUser);

        const auto c = decodeControl(hex("000A 000A 0020 0064 0005 0001 000A 0000 0010 00000007 03") + "Bar");
        QVERIFY(c && c->value == 5 && c->max == 10 && c->procID == 16 && c->refCon == 7 && c->title == "Bar");

        QByteArray curs = QByteArray(64, '\0') + hex("0003 0004");
        curs[0] = char(0x80);
        const auto k = decodeCursor(curs);
        QVERIFY(k && k->data[0] == 0x8000 && k->hotSpot.v == 3 && k->hotSpot.h == 4);

        QVERIFY(!decodeWindow(hex("0028 0014 00C8 0190 0004 0100 0000 12345678")));
        QVERIFY(!decodeMenu(hex("0080 0000 0000 0000 0000 FFFFFFFB")));
        QVERIFY(!decodeCursor(curs.left(67)));
        QVERIFY(!decodeAlert(hex("0028 0028 0096 0190 0081 CC")));
        QVERIFY(!decodeControl(hex("000A 000A 0020 0064 0005 0001 000A 0000 0010 00000007")));
        QVERIFY(!decodeIconList(QByteArray(255, '\0')));
        QVERIFY(!decodeString({}));
    }

    // Set bits black, clear mask bits transparent.
    void oneBitImages()
    {
        QByteArray bits(32, '\0'), mask(32, '\0');
        bits[0] = char(0x80);
        mask[0] = char(0xC0);
        const QImage image = oneBitImage(bits, 16, 16, mask);
        QCOMPARE(image.pixel(0, 0), qRgb(0, 0, 0));
        QCOMPARE(image.pixel(1, 0), qRgb(255, 255, 255));
        QCOMPARE(qAlpha(image.pixel(2, 0)), 0);
        QVERIFY(oneBitImage(bits.left(31), 16, 16).isNull());
    }

    // Pictures played into a white world: the pixels each one touches. Frame (0,0)-(20,20).
    void pictures_data()
    {
        QTest::addColumn<QByteArray>("pict");
        QTest::addColumn<int>("scale");
        QTest::addColumn<QRegion>("expected");
        const QByteArray v1 = hex("0000 0000 0000 0014 0014 1101");
        const QByteArray v2 = hex("0000 0000 0000 0014 0014 0011 02FF 0C00 FFFE 0000 00480000 00480000 0000 0000 0014 0014 00000000");
        const QRegion rect(3, 2, 7, 6);
        QTest::newRow("v2 paintRect") << v2 + hex("0031 0002 0003 0008 000A 00FF") << 1 << rect;
        QTest::newRow("v2 scaled twice") << v2 + hex("0031 0002 0003 0008 000A 00FF") << 2 << QRegion(6, 4, 14, 12);
        QTest::newRow("v1 frameRect, pen 2") << v1 + hex("07 0002 0002 30 0002 0003 0008 000A FF") << 1
                                             << rect - QRegion(5, 4, 3, 2);
        QTest::newRow("v1 paintSameRect after origin") << v1 + hex("30 0002 0003 0008 000A 0C FFFF FFFE 39 FF") << 1
                                                       << rect - QRegion(4, 3, 5, 4) + QRegion(4, 4, 7, 6);
        QTest::newRow("clip") << v2 + hex("0001 000A 0000 0000 0005 0014 0031 0002 0003 0008 000A 00FF") << 1
                              << QRegion(3, 2, 7, 3);
        QTest::newRow("v1 line") << v1 + hex("20 0001 0001 0001 0005 FF") << 1 << QRegion(1, 1, 5, 1);
        // 16 x 2 one-bit map, rows stored as they are (rowBytes 2 < 8), copied to (4,4).
        QTest::newRow("v2 packBitsRect") << v2 + hex("0098 0002 0000 0000 0002 0010 0000 0000 0002 0010 0004 0004 0006 0014 0000 F00F 0000 00FF")
                                         << 1 << QRegion(4, 4, 4, 1) + QRegion(16, 4, 4, 1);
        // 4 x 1 direct pixels, rowBytes 16, PackBits over the planes (packType 4): red, black,
        // white, white; one row of 12 component bytes packed as one literal run.
        QTest::newRow("v2 directBitsRect") << v2 + hex("009A 000000FF 8010 0000 0000 0001 0004 0000 0004 00000000 00480000 00480000 0010 0020 0003 0008 00000000 00000000 00000000 0000 0000 0001 0004 000A 0000 000B 0004 0000 0D0B FF00FFFF 0000FFFF 0000FFFF 00FF")
                                           << 1 << QRegion(0, 10, 2, 1);
        QTest::newRow("truncated: what came before") << v2 + hex("0031 0002 0003 0008 000A 0031 0002") << 1 << rect;
        QTest::newRow("unknown opcode with a length") << v2 + hex("00A5 0003 010203 00 0031 0002 0003 0008 000A 00FF") << 1 << rect;
        QTest::newRow("reserved opcode without data") << v2 + hex("8001 0031 0002 0003 0008 000A 00FF") << 1 << rect;
    }
    void pictures()
    {
        QFETCH(QByteArray, pict);
        QFETCH(int, scale);
        QFETCH(QRegion, expected);
        World world(48);
        const Rect dst = R(0, 0, 20 * scale, 20 * scale);
        QVERIFY(drawPicture(pict, dst));
        const QSet<QPoint> got = world.touched();
        QVERIFY2(got == regionPixels(expected), describe(got) + " / " + describe(regionPixels(expected)));
        QCOMPARE(pictureFrame(pict).right, SInt16(20));
    }

    // The port's state is put back; nothing is drawn without a port or a picture.
    void pictureLeavesPortAsItWas()
    {
        World world(48);
        const QByteArray pict = hex("0000 0000 0000 0014 0014 1101 07 0003 0003 0D 0030 0E 000000CD 31 0000 0000 0005 0005 FF");
        QVERIFY(drawPicture(pict, R(0, 0, 20, 20)));
        PenState pen;
        GetPenState(&pen);
        QCOMPARE(pen.penSize(), 1);
        RGBColor fore;
        GetForeColor(&fore);
        QCOMPARE(fore.red, UInt16(0));
        QVERIFY(!drawPicture(QByteArray("junk"), R(0, 0, 20, 20)));
        QVERIFY(pictureImage(pict).size() == QSize(20, 20));
    }
};

VELMAR_TEST_MAIN(TestResFile)
#include "tst_resfile.moc"
