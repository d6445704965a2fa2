// Event objects: construction and copying, reference counting misuse, the live-object
// limit, the parameter table's result codes, classic masks and the flattening into classic
// records.
#include "events_support.h"

#include "events/EventMask.h"

#include <Velmar/CarbonEvents.h>
#include <Velmar/Events.h>
#include <Velmar/MacErrors.h>

#include <cstring>
#include <type_traits>

using namespace Velmar;
using namespace EventTest;

// The record keeps the classic widths and order, then the library's extra fields.
static_assert(std::is_same_v<decltype(EventRecord::what), UInt16> && std::is_same_v<decltype(EventRecord::message), UInt32>
              && std::is_same_v<decltype(EventRecord::when), UInt32> && std::is_same_v<decltype(EventRecord::where), Point>
              && std::is_same_v<decltype(EventRecord::modifiers), UInt16> && std::is_same_v<decltype(EventRecord::textUnit), UInt16>);
static_assert(offsetof(EventRecord, message) < offsetof(EventRecord, when) && offsetof(EventRecord, when) < offsetof(EventRecord, where)
              && offsetof(EventRecord, where) < offsetof(EventRecord, modifiers)
              && offsetof(EventRecord, modifiers) < offsetof(EventRecord, window)
              && offsetof(EventRecord, window) < offsetof(EventRecord, textUnit)
              && offsetof(EventRecord, textUnit) < offsetof(EventRecord, qtKey)
              && offsetof(EventRecord, qtKey) < offsetof(EventRecord, qtModifiers));

namespace {

// "what=3 msg=abcd mods=512 unit=97 key=65 qmods=33554432"
QString recordText(const EventRecord& r)
{
    return QStringLiteral("what=%1 msg=%2 mods=%3 unit=%4 key=%5 qmods=%6")
        .arg(r.what).arg(r.message, 0, 16).arg(r.modifiers).arg(r.textUnit).arg(r.qtKey).arg(r.qtModifiers);
}

// What a test sets on the item before asking for one parameter.
enum Setup { Plain, Modifiers, Wheel, WheelZero, MouseDownWheel, KeyDownWheelZero, Window };
struct SetupRow {
    UInt32 cls, kind, modifiers;
    UInt16 wheelAxis;
    SInt32 wheelDelta;
    int window;
};
const SetupRow kSetups[] = {
    {kEventClassKeyboard, kEventRawKeyDown, 0, 0, 0, 0},       {kEventClassKeyboard, kEventRawKeyDown, shiftKey, 0, 0, 0},
    {kEventClassMouse, kEventMouseWheelMoved, 0, kEventMouseWheelAxisY, -2, 0},
    {kEventClassMouse, kEventMouseWheelMoved, 0, 0, 0, 0},     {kEventClassMouse, kEventMouseDown, 0, 0, 0, 0},
    {kEventClassKeyboard, kEventMouseDown, 0, 0, 0, 0},        {kEventClassWindow, kEventWindowActivated, 0, 0, 0, 3},
};

EventQueueItemSmartPtr itemFor(Setup setup)
{
    const SetupRow& row = kSetups[setup];
    EventQueueItemSmartPtr item = makeItem(row.cls, row.kind, row.window ? fakeWindow(row.window) : nullptr);
    item->modifiers = row.modifiers;
    item->wheelAxis = row.wheelAxis;
    item->wheelDelta = row.wheelDelta;
    return item;
}

} // namespace

class tst_EventItem : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void init() { log().clear(); }

    void smartPointerHoldsOneReference()
    {
        EventQueueItemSmartPtr a = EventQueueItemSmartPtr::Create();
        EventQueueItem* raw = a.get();
        {
            EventQueueItemSmartPtr b = a, c(raw);
            c = b;
            EventQueueItemSmartPtr d = std::move(c);
            QVERIFY(!c);
            EventQueueItemSmartPtr& alias = d;
            d = alias; // self-assignment keeps the count
            QCOMPARE(raw->refCount, SInt16(3));
        }
        QCOMPARE(raw->refCount, SInt16(1));
    }

    // The host gives back only the references it holds: releasing once too often while the
    // queue holds the event is refused and frees nothing, and a freed event is refused
    // before a byte of it is read.
    void releasingTooOftenAssertsWithoutFreeing()
    {
        AssertRecorder asserts;
        const int live = EventQueueItem::LiveCount();
        EventRef event = nullptr;
        QCOMPARE(MacCreateEvent(nullptr, kEventClassMouse, kEventMouseDown, 12.0, 0, &event), noErr);
        RetainEvent(event);
        ReleaseEvent(event);
        QCOMPARE(PostEventToQueue(GetMainEventQueue(), event, kEventPriorityStandard), noErr);
        ReleaseEvent(event); // the host's own reference
        ReleaseEvent(event); // the queue's: refused
        QCOMPARE(GetNumEventsInQueue(GetMainEventQueue()), 1u);
        QCOMPARE(EventQueueItem::LiveCount(), live + 1);
        Private::gMainEventQueue.clearAll();
        QCOMPARE(EventQueueItem::LiveCount(), live);
        ReleaseEvent(event);
        QCOMPARE(GetEventClass(event), 0u);
        RetainEvent(nullptr);
        ReleaseEvent(nullptr);
        // Inside the library a count below zero is reported and frees nothing.
        EventQueueItem* raw = EventQueueItem::Create();
        raw->refCount = 0;
        raw->Release();
        QCOMPARE(raw->refCount, SInt16(-1));
        raw->refCount = 1;
        raw->Release();
        QCOMPARE(EventQueueItem::LiveCount(), live);
        QCOMPARE(log(), (QStringList{"assert: event->hostRefCount > 0", "assert: IsValidEvent(event)",
                                     "assert: IsValidEvent(event)", "assert: refCount >= 0"}));
    }

    void macCreateEventIgnoresWhen()
    {
        AssertRecorder asserts;
        EventRef event = nullptr;
        QCOMPARE(MacCreateEvent(nullptr, kEventClassMouse, kEventMouseUp, 99.0, kEventAttributeUserEvent, nullptr),
                 eventInternalErr);
        QCOMPARE(MacCreateEvent(nullptr, kEventClassMouse, kEventMouseUp, 99.0, kEventAttributeUserEvent, &event),
                 noErr);
        QCOMPARE(GetEventClass(event), UInt32(kEventClassMouse));
        QCOMPARE(GetEventKind(event), UInt32(kEventMouseUp));
        QCOMPARE(GetEventTime(event), 0.0);
        QCOMPARE(event->attributes, UInt32(kEventAttributeUserEvent));
        event->when = 90;
        QCOMPARE(GetEventTime(event), 1.5);
        ReleaseEvent(event);
        QCOMPARE(GetEventClass(nullptr) + GetEventKind(nullptr), 0u);
        QCOMPARE(GetEventTime(nullptr), 0.0);
    }

    // The 5000th simultaneous item warns once and the limit doubles; the next warning
    // waits for 10000.
    void liveObjectLimit()
    {
        AssertRecorder asserts;
        QCOMPARE(EventQueueItem::LiveLimit(), 5000);
        std::vector<EventQueueItemSmartPtr> held;
        while (EventQueueItem::LiveCount() < 4999)
            held.push_back(EventQueueItemSmartPtr::Create());
        QCOMPARE(log(), QStringList());
        held.push_back(EventQueueItemSmartPtr::Create()); // the 5000th
        QCOMPARE(EventQueueItem::LiveLimit(), 10000);
        while (EventQueueItem::LiveCount() < 9999)
            held.push_back(EventQueueItemSmartPtr::Create());
        QCOMPARE(log(), QStringList{QStringLiteral("assert: Too many events were created")});
        held.push_back(EventQueueItemSmartPtr::Create()); // the 10000th
        QCOMPARE(EventQueueItem::LiveLimit(), 20000);
        QCOMPARE(log().size(), 2);
        const int before = EventQueueItem::LiveCount();
        const int heldCount = int(held.size());
        held.clear();
        QCOMPARE(EventQueueItem::LiveCount(), before - heldCount);
    }

    // A null expected `data` means no output buffer is passed.
    void getEventParameter_data()
    {
        QTest::addColumn<int>("setup");
        QTest::addColumn<UInt32>("name");
        QTest::addColumn<UInt32>("desiredType");
        QTest::addColumn<UInt32>("bufferSize");
        QTest::addColumn<int>("result");
        QTest::addColumn<UInt32>("actualType");
        QTest::addColumn<UInt32>("actualSize");
        QTest::addColumn<QByteArray>("data");

        auto le = [](qint64 v, int n) { return QByteArray(reinterpret_cast<const char*>(&v), n); };
        auto row = [](const char* name, Setup setup, UInt32 param, UInt32 type, UInt32 size, OSStatus result,
                      UInt32 actualType, UInt32 actualSize, const QByteArray& data) {
            QTest::newRow(name) << int(setup) << param << type << size << int(result) << actualType << actualSize << data;
        };
        const UInt32 mods = kEventParamKeyModifiers, delta = kEventParamMouseWheelDelta;
        const UInt32 axis = kEventParamMouseWheelAxis;
        row("modifiers present", Modifiers, mods, typeUInt32, 4, noErr, typeUInt32, 4, le(shiftKey, 4));
        row("zero modifiers count as absent", Plain, mods, typeUInt32, 4, eventParameterNotFoundErr, typeUInt32, 4,
            QByteArray(4, 0));
        row("no data: type and size only", Plain, mods, typeUInt32, 0, noErr, typeUInt32, 4, QByteArray());
        row("no coercion", Modifiers, mods, typeSInt32, 4, errAECoercionFail, typeUInt32, 4, QByteArray(4, 0));
        row("buffer too small", Modifiers, mods, typeUInt32, 2, errAECoercionFail, typeUInt32, 4, QByteArray(2, 0));
        row("unknown name", Plain, FOUR_CHAR_CODE("zzzz"), typeUInt32, 4, eventParameterNotFoundErr, 0, 0,
            QByteArray(4, 0));
        row("wheel axis 1", Wheel, axis, typeMouseWheelAxis, 2, noErr, typeMouseWheelAxis, 2, le(1, 2));
        row("wheel delta -2", Wheel, delta, typeLongInteger, 4, noErr, typeLongInteger, 4, le(-2, 4));
        row("zero wheel axis of a wheel event is present", WheelZero, axis, typeMouseWheelAxis, 2, noErr,
            typeMouseWheelAxis, 2, QByteArray(2, 0));
        row("mouse down may carry a zero wheel delta", MouseDownWheel, delta, typeLongInteger, 4, noErr,
            typeLongInteger, 4, QByteArray(4, 0));
        row("zero wheel delta of a key event is absent", KeyDownWheelZero, delta, typeLongInteger, 4,
            eventParameterNotFoundErr, typeLongInteger, 4, QByteArray(4, 0));
        row("window", Window, kEventParamWindowRef, typeWindowRef, 8, noErr, typeWindowRef, sizeof(void*),
            le(qint64(quintptr(fakeWindow(3))), 8));
        row("larger buffer is zero-filled past the value", Modifiers, mods, typeUInt32, 8, noErr, typeUInt32, 4,
            le(shiftKey, 8));
        row("direct object keeps its 6 bytes", Plain, kEventParamDirectObject, typeFSVolumeRefNum, 6, noErr,
            typeFSVolumeRefNum, 6, QByteArray());
    }

    void getEventParameter()
    {
        QFETCH(int, setup);
        QFETCH(UInt32, name);
        QFETCH(UInt32, desiredType);
        QFETCH(UInt32, bufferSize);
        QFETCH(int, result);
        QFETCH(UInt32, actualType);
        QFETCH(UInt32, actualSize);
        QFETCH(QByteArray, data);

        EventQueueItemSmartPtr item = itemFor(Setup(setup));
        QByteArray buffer(int(bufferSize), char(0x5A)); // stale bytes must be zeroed
        EventParamType gotType = 0;
        ByteCount gotSize = 0;
        QCOMPARE(GetEventParameter(item.get(), name, desiredType, &gotType, bufferSize, &gotSize,
                                   data.isNull() ? nullptr : buffer.data()),
                 OSStatus(result));
        QCOMPARE(gotType, actualType);
        QCOMPARE(gotSize, actualSize);
        if (!data.isNull())
            QCOMPARE(buffer.toHex(), data.toHex());
    }

    // A null output pointer is allowed.
    void getEventParameterNullOutput()
    {
        EventQueueItemSmartPtr item = itemFor(Modifiers);
        QCOMPARE(GetEventParameter(item.get(), kEventParamKeyModifiers, typeUInt32, nullptr, 4, nullptr, nullptr),
                 OSStatus(noErr));
    }

    void setEventParameterOrder()
    {
        // Whole sequence in call order, asserts included.
        AssertRecorder asserts;
        EventQueueItemSmartPtr item = itemFor(Plain);
        const UInt32 mods = optionKey;
        const SInt16 shortValue = 0x0102;
        const UInt8 bytes[8] = {1, 2, 3, 4, 5, 6, 7, 8};
        auto note = [](auto v, int base = 10) { log() << QString::number(v, base); };
        note(SetEventParameter(nullptr, kEventParamKeyModifiers, typeUInt32, 4, &mods));
        note(SetEventParameter(item.get(), FOUR_CHAR_CODE("zzzz"), typeUInt32, 4, &mods));
        note(SetEventParameter(item.get(), kEventParamKeyModifiers, typeUInt32, 4, &mods));
        note(item->modifiers);
        note(SetEventParameter(item.get(), kEventParamKeyCode, typeSInt32, 4, &mods));
        note(item->keyCode);
        note(SetEventParameter(item.get(), kEventParamKeyCode, typeUInt32, 2, &shortValue));
        note(item->keyCode, 16);
        note(SetEventParameter(item.get(), kEventParamDirectObject, typeFSVolumeRefNum, 8, bytes));
        log() << QString::fromLatin1(QByteArray(reinterpret_cast<const char*>(item->directObject), 6).toHex());
        note(SetEventParameter(item.get(), kEventParamMouseButton, typeMouseButton, 2, nullptr));
        QCOMPARE(log(), (QStringList{"-9868", "assert: false", "-4", "0", "2048",
                                     "assert: kEventParameterList[idx].type == inType", "0", "2048",
                                     "assert: kEventParameterList[idx].size == inSize", "0", "102",
                                     "assert: kEventParameterList[idx].size == inSize", "0", "010203040506", "-50"}));
    }

    // Deliberate oddities: a mouse down counts as a wheel event, a mouse move is no mouse
    // event. And the exact debugging text of a class and kind.
    void predicateOdditiesAndDebuggingText()
    {
        QVERIFY(makeItem(kEventClassMouse, kEventMouseDown)->isMouseWheelEvent());
        QVERIFY(!makeItem(kEventClassMouse, kEventMouseMoved)->isMouseEvent());
        QCOMPARE(EventQueueItem::EventClassAndKindToString(kEventClassMouse, kEventMouseDown),
                 QStringLiteral(", class=mous [1836021107], kind=.... [       1]"));
    }

    void parse_data()
    {
        QTest::addColumn<int>("mask");
        QTest::addColumn<int>("result");
        QTest::addColumn<QString>("pairs");

        const char* all = "mous/1 mous/2 keyb/1 keyb/3 keyb/2 wind/1 wind/5 wind/6 appl/1 appl/2";
        QTest::newRow("everyEvent") << int(everyEvent) << 0 << "";
        QTest::newRow("activate: two kinds") << int(activMask) << 2 << "wind/5 wind/6";
        QTest::newRow("table order") << int(osMask | keyUpMask | mDownMask) << 4 << "mous/1 keyb/3 appl/1 appl/2";
        QTest::newRow("unknown bits ignored beside a known one") << int(0x0001 | 0x0080 | mUpMask) << 1 << "mous/2";
        QTest::newRow("all known bits, in bit order") << int(0x817E) << 10 << all;
        QTest::newRow("everyEvent less one bit") << int(0xFFFE) << 10 << all;
        QTest::newRow("null-event bit only") << 1 << -1 << "";
        QTest::newRow("disk and high-level only") << int(diskMask | highLevelEventMask) << -1 << "";
    }

    void parse()
    {
        QFETCH(int, mask);
        QFETCH(int, result);
        QFETCH(QString, pairs);
        VelmarTest::LogCapture capture;
        Private::EventTypeList list;
        QCOMPARE(Private::ParseEventMask(UInt16(mask), list), result);
        QStringList parts;
        for (UInt32 i = 0; i < list.count; ++i)
            parts << fourChars(list.specs[i].eventClass) + u'/' + QString::number(list.specs[i].eventKind);
        QCOMPARE(parts.join(u' '), pairs);
        QCOMPARE(capture.count(QStringLiteral("Unable to parse eventMask at all.... Returning negative")),
                 result < 0 ? 1 : 0);
    }

    void toEventRecord_data()
    {
        QTest::addColumn<UInt32>("cls");
        QTest::addColumn<UInt32>("kind");
        QTest::addColumn<QString>("record");
        QTest::addColumn<QString>("assertion");

        // Every item carries message 0x1234, key message 0xABCD, modifiers shift|cmd, text
        // unit 97, Qt key 65 and Qt modifiers 0x2000000: the rows show which survive.
        auto row = [](const char* name, UInt32 cls, UInt32 kind, const char* what, const char* rest,
                      const char* assertion = "") {
            QTest::newRow(name) << cls << kind << QStringLiteral("what=%1 msg=%2").arg(what, rest) << assertion;
        };
        const char* none = "0 mods=0 unit=0 key=0 qmods=0";
        const char* all = "1234 mods=768 unit=97 key=65 qmods=33554432";
        const char* key = "abcd mods=768 unit=97 key=65 qmods=33554432";
        const UInt32 classic = Private::kEventClassVelmarClassic;
        row("null", 0, 0, "0", none);
        row("classic 12", classic, 12, "12", all);
        row("classic 0: a null what that keeps its message", classic, 0, "0", all);
        row("classic low 16 bits", classic, 0x10017, "23", all);
        row("mouse down", kEventClassMouse, kEventMouseDown, "1", "0 mods=768 unit=0 key=0 qmods=0");
        row("mouse up", kEventClassMouse, kEventMouseUp, "2", "0 mods=768 unit=0 key=0 qmods=0");
        row("key down", kEventClassKeyboard, kEventRawKeyDown, "3", key);
        row("key repeat", kEventClassKeyboard, kEventRawKeyRepeat, "5", key);
        row("key up", kEventClassKeyboard, kEventRawKeyUp, "4", key);
        row("update", kEventClassWindow, kEventWindowUpdate, "6", none);
        row("activated", kEventClassWindow, kEventWindowActivated, "8", "0 mods=1 unit=0 key=0 qmods=0");
        row("deactivated", kEventClassWindow, kEventWindowDeactivated, "8", none);
        row("resume", kEventClassApplication, kEventAppActivated, "15", "1000001 mods=0 unit=0 key=0 qmods=0");
        row("suspend", kEventClassApplication, kEventAppDeactivated, "15", "1000000 mods=0 unit=0 key=0 qmods=0");
        row("mouse moved", kEventClassMouse, kEventMouseMoved, "0", none, "false");
        row("wheel", kEventClassMouse, kEventMouseWheelMoved, "0", none, "false");
        row("window shown", kEventClassWindow, kEventWindowShown, "0", none, "false");
        row("app kind 3", kEventClassApplication, 3, "0", none, "false");
        row("null class, kind 1", 0, 1, "0", none, "false");
        row("library class", Private::kEventClassVelmar, Private::kEventVelmarMenuTriggered, "0", none, "FALSE");
        row("foreign class", FOUR_CHAR_CODE("cmds"), 1, "0", none, "FALSE");
    }

    void toEventRecord()
    {
        QFETCH(UInt32, cls);
        QFETCH(UInt32, kind);
        QFETCH(QString, record);
        QFETCH(QString, assertion);
        const bool compatible = assertion.isEmpty();

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
        QCOMPARE(assertsIn(log()), compatible ? QStringList() : QStringList{"assert: " + assertion});
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

};

VELMAR_TEST_MAIN(tst_EventItem)
#include "tst_eventitem.moc"
