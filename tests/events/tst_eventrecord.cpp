// Flattening events into classic records: one row per class and kind.
#include "TestSupport.h"
#include "tst_eventqueue_support.h"

#include <Velmar/CarbonEvents.h>
#include <Velmar/Events.h>

#include <type_traits>

using namespace Velmar;
using namespace EventTest;

// The record keeps the classic widths, then the library's extra fields.
static_assert(std::is_same_v<decltype(EventRecord::what), UInt16>);
static_assert(std::is_same_v<decltype(EventRecord::message), UInt32>);
static_assert(std::is_same_v<decltype(EventRecord::when), UInt32>);
static_assert(std::is_same_v<decltype(EventRecord::where), Point>);
static_assert(std::is_same_v<decltype(EventRecord::modifiers), UInt16>);
static_assert(std::is_same_v<decltype(EventRecord::textUnit), UInt16>);
static_assert(offsetof(EventRecord, message) < offsetof(EventRecord, when)
              && offsetof(EventRecord, when) < offsetof(EventRecord, where)
              && offsetof(EventRecord, where) < offsetof(EventRecord, modifiers)
              && offsetof(EventRecord, modifiers) < offsetof(EventRecord, window)
              && offsetof(EventRecord, window) < offsetof(EventRecord, textUnit)
              && offsetof(EventRecord, textUnit) < offsetof(EventRecord, qtKey)
              && offsetof(EventRecord, qtKey) < offsetof(EventRecord, qtModifiers));

namespace {

// "what=3 msg=4660 mods=512 unit=97 key=65 qmods=33554432" (time, place and window are
// checked separately: every row copies them).
QString recordText(const EventRecord& r)
{
    return QStringLiteral("what=%1 msg=%2 mods=%3 unit=%4 key=%5 qmods=%6")
        .arg(r.what).arg(r.message, 0, 16).arg(r.modifiers).arg(r.textUnit).arg(r.qtKey).arg(r.qtModifiers);
}

} // namespace

class tst_EventRecord : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void init() { log().clear(); }

    void toEventRecord_data()
    {
        QTest::addColumn<UInt32>("cls");
        QTest::addColumn<UInt32>("kind");
        QTest::addColumn<QString>("record");
        QTest::addColumn<QString>("assertion");
        QTest::addColumn<bool>("compatible");

        auto row = [](const char* name, UInt32 cls, UInt32 kind, const char* record, const char* assertion = "") {
            QTest::newRow(name) << cls << kind << QString::fromLatin1(record) << QString::fromLatin1(assertion)
                                << !*assertion;
        };
        // Every item carries message 0x1234, key message 0xABCD, modifiers shift|cmd,
        // text unit 97, Qt key 65 and Qt modifiers 0x2000000: the rows show which survive.
        row("null", 0, 0, "what=0 msg=0 mods=0 unit=0 key=0 qmods=0");
        row("classic 12", Private::kEventClassVelmarClassic, 12,
            "what=12 msg=1234 mods=768 unit=97 key=65 qmods=33554432");
        row("classic low 16 bits", Private::kEventClassVelmarClassic, 0x10017,
            "what=23 msg=1234 mods=768 unit=97 key=65 qmods=33554432");
        row("mouse down", kEventClassMouse, kEventMouseDown, "what=1 msg=0 mods=768 unit=0 key=0 qmods=0");
        row("mouse up", kEventClassMouse, kEventMouseUp, "what=2 msg=0 mods=768 unit=0 key=0 qmods=0");
        row("key down", kEventClassKeyboard, kEventRawKeyDown,
            "what=3 msg=abcd mods=768 unit=97 key=65 qmods=33554432");
        row("key repeat", kEventClassKeyboard, kEventRawKeyRepeat,
            "what=5 msg=abcd mods=768 unit=97 key=65 qmods=33554432");
        row("key up", kEventClassKeyboard, kEventRawKeyUp,
            "what=4 msg=abcd mods=768 unit=97 key=65 qmods=33554432");
        row("update", kEventClassWindow, kEventWindowUpdate, "what=6 msg=0 mods=0 unit=0 key=0 qmods=0");
        row("activated", kEventClassWindow, kEventWindowActivated, "what=8 msg=0 mods=1 unit=0 key=0 qmods=0");
        row("deactivated", kEventClassWindow, kEventWindowDeactivated, "what=8 msg=0 mods=0 unit=0 key=0 qmods=0");
        row("resume", kEventClassApplication, kEventAppActivated, "what=15 msg=1000001 mods=0 unit=0 key=0 qmods=0");
        row("suspend", kEventClassApplication, kEventAppDeactivated,
            "what=15 msg=1000000 mods=0 unit=0 key=0 qmods=0");
        row("mouse moved", kEventClassMouse, kEventMouseMoved, "what=0 msg=0 mods=0 unit=0 key=0 qmods=0", "false");
        row("wheel", kEventClassMouse, kEventMouseWheelMoved, "what=0 msg=0 mods=0 unit=0 key=0 qmods=0", "false");
        row("window shown", kEventClassWindow, kEventWindowShown, "what=0 msg=0 mods=0 unit=0 key=0 qmods=0",
            "false");
        row("app kind 3", kEventClassApplication, 3, "what=0 msg=0 mods=0 unit=0 key=0 qmods=0", "false");
        row("null class, kind 1", 0, 1, "what=0 msg=0 mods=0 unit=0 key=0 qmods=0", "false");
        row("library class", Private::kEventClassVelmar, Private::kEventVelmarMenuTriggered,
            "what=0 msg=0 mods=0 unit=0 key=0 qmods=0", "FALSE");
        row("foreign class", FOUR_CHAR_CODE("cmds"), 1, "what=0 msg=0 mods=0 unit=0 key=0 qmods=0", "FALSE");
    }

    void toEventRecord()
    {
        QFETCH(UInt32, cls);
        QFETCH(UInt32, kind);
        QFETCH(QString, record);
        QFETCH(QString, assertion);
        QFETCH(bool, compatible);

        AssertRecorder asserts;
        EventQueueItemSmartPtr item = makeItem(cls, kind, fakeWindow(4), 0x1234);
        item->keyMessage = 0xABCD;
        item->modifiers = shiftKey | cmdKey;
        item->textUnit = 97;
        item->qtKey = 65;
        item->qtModifiers = 0x2000000;
        item->when = 600;
        item->where = Point{-5, 300};

        const EventRecord r = item->toEventRecord();
        QCOMPARE(recordText(r), record);
        QCOMPARE(assertsIn(log()), assertion.isEmpty() ? QStringList() : QStringList{"assert: " + assertion});
        // time, place and window are copied whatever the row
        QCOMPARE(r.when, 600u);
        QCOMPARE(r.where.v, SInt16(-5));
        QCOMPARE(r.where.h, SInt16(300));
        QCOMPARE(r.window, fakeWindow(4));

        QCOMPARE(item->isEventRecordCompatible(), compatible);
        EventRecord converted;
        std::memset(&converted, 0x77, sizeof converted);
        QCOMPARE(ConvertEventRefToEventRecord(item.get(), &converted), compatible);
        if (compatible)
            QCOMPARE(recordText(converted), record);
        else
            QCOMPARE(converted.what, UInt16(0x7777)); // untouched
    }

    void convertBadInput()
    {
        EventQueueItemSmartPtr item = makeItem(kEventClassMouse, kEventMouseDown);
        EventRecord r{};
        QVERIFY(!ConvertEventRefToEventRecord(nullptr, &r));
        QVERIFY(!ConvertEventRefToEventRecord(item.get(), nullptr));
    }

    void postEventZeroBecomesNullWhatWithMessage()
    {
        EventQueueItemSmartPtr item = makeItem(Private::kEventClassVelmarClassic, 0, nullptr, 0xBEEF);
        QCOMPARE(recordText(item->toEventRecord()), QStringLiteral("what=0 msg=beef mods=0 unit=0 key=0 qmods=0"));
    }
};

VELMAR_TEST_MAIN(tst_EventRecord)
#include "tst_eventrecord.moc"
