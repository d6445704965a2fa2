// Event objects: construction and copying, reference counting misuse, the live-object
// limit, the parameter table's result codes, predicates, debugging text, classic masks and
// the flattening into classic records.
#include "events_support.h"

#include "events/EventMask.h"

#include <Velmar/CarbonEvents.h>
#include <Velmar/Events.h>
#include <Velmar/MacErrors.h>

#include <cstring>
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

QString pairsText(const Private::EventTypeList& list)
{
    QStringList parts;
    for (UInt32 i = 0; i < list.count; ++i)
        parts << fourChars(list.specs[i].eventClass) + u'/' + QString::number(list.specs[i].eventKind);
    return parts.join(u' ');
}

// "what=3 msg=4660 mods=512 unit=97 key=65 qmods=33554432" (time, place and window are
// checked separately: every row copies them).
QString recordText(const EventRecord& r)
{
    return QStringLiteral("what=%1 msg=%2 mods=%3 unit=%4 key=%5 qmods=%6")
        .arg(r.what).arg(r.message, 0, 16).arg(r.modifiers).arg(r.textUnit).arg(r.qtKey).arg(r.qtModifiers);
}

// What a test sets on the item before asking for one parameter.
enum class Setup { Plain, Modifiers, Wheel, WheelZero, MouseDownWheel, KeyDownWheelZero, Window };

struct SetupRow {
    UInt32 cls, kind, modifiers;
    UInt16 wheelAxis;
    SInt32 wheelDelta;
    int window;
};

// Indexed by Setup.
const SetupRow kSetups[] = {
    {kEventClassKeyboard, kEventRawKeyDown, 0, 0, 0, 0},
    {kEventClassKeyboard, kEventRawKeyDown, shiftKey, 0, 0, 0},
    {kEventClassMouse, kEventMouseWheelMoved, 0, kEventMouseWheelAxisY, -2, 0},
    {kEventClassMouse, kEventMouseWheelMoved, 0, 0, 0, 0},
    {kEventClassMouse, kEventMouseDown, 0, 0, 0, 0},
    {kEventClassKeyboard, kEventMouseDown, 0, 0, 0, 0},
    {kEventClassWindow, kEventWindowActivated, 0, 0, 0, 3},
};

EventQueueItemSmartPtr itemFor(Setup setup)
{
    const SetupRow& row = kSetups[int(setup)];
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

    void constructionClearsAllButWheelAndDirectObject()
    {
        AssertRecorder asserts;
        EventQueueItemSmartPtr item = EventQueueItemSmartPtr::Create();
        QCOMPARE(item->refCount, SInt16(1));
        item->eventClass = kEventClassMouse;
        item->eventKind = kEventMouseWheelMoved;
        item->wheelAxis = 1;
        item->wheelDelta = 7;
        item->directObject[0] = 9;
        item->modifiers = cmdKey;
        item->skipFlush = 1;
        item->AddRef();
        item->clear();
        // clear keeps the count and the three fields only converters write
        QCOMPARE(item->refCount, SInt16(2));
        QCOMPARE(item->eventClass, 0u);
        QCOMPARE(item->modifiers, 0u);
        QCOMPARE(item->skipFlush, UInt8(0));
        QCOMPARE(item->wheelAxis, UInt16(1));
        QCOMPARE(item->wheelDelta, 7);
        QCOMPARE(item->directObject[0], UInt8(9));
        item->Release();
        QCOMPARE(log(), QStringList());
    }

    void duplicateAndAssignCopyWholeRecord()
    {
        AssertRecorder asserts;
        const int live = EventQueueItem::LiveCount();
        EventQueueItemSmartPtr a = makeItem(kEventClassKeyboard, kEventRawKeyUp, fakeWindow(1), 77);
        a->AddRef(); // count 2
        EventQueueItemSmartPtr copy = EventQueueItemSmartPtr::Adopt(a->Duplicate());
        QCOMPARE(EventQueueItem::LiveCount(), live + 2);
        QCOMPARE(copy->refCount, SInt16(1));
        QCOMPARE(describe(copy.get()), describe(a.get()));

        EventQueueItemSmartPtr b = EventQueueItemSmartPtr::Create();
        *b = *a; // the count comes along too
        QCOMPARE(b->refCount, SInt16(2));
        QCOMPARE(describe(b.get()), QStringLiteral("keyb/3@w1 msg=77"));
        b->refCount = 1;
        a->Release();
        QCOMPARE(log(), QStringList());
    }

    void releasingTooOftenAssertsWithoutFreeing()
    {
        AssertRecorder asserts;
        const int live = EventQueueItem::LiveCount();
        EventRef event = nullptr;
        QCOMPARE(MacCreateEvent(nullptr, kEventClassMouse, kEventMouseDown, 12.0, 0, &event), noErr);
        RetainEvent(event);
        ReleaseEvent(event);
        event->refCount = 0; // someone released it behind the library's back
        ReleaseEvent(event);
        QCOMPARE(event->refCount, SInt16(-1));
        QCOMPARE(EventQueueItem::LiveCount(), live + 1); // not freed
        event->refCount = 1;
        ReleaseEvent(event);
        QCOMPARE(EventQueueItem::LiveCount(), live);
        // null handles are ignored
        RetainEvent(nullptr);
        ReleaseEvent(nullptr);
        QCOMPARE(log(), QStringList{QStringLiteral("assert: refCount >= 0")});
    }

    void macCreateEventIgnoresWhen()
    {
        AssertRecorder asserts;
        QCOMPARE(MacCreateEvent(nullptr, kEventClassMouse, kEventMouseUp, 99.0, kEventAttributeUserEvent,
                                nullptr),
                 eventInternalErr);
        EventRef event = nullptr;
        QCOMPARE(MacCreateEvent(nullptr, kEventClassMouse, kEventMouseUp, 99.0, kEventAttributeUserEvent,
                                &event),
                 noErr);
        QCOMPARE(GetEventClass(event), UInt32(kEventClassMouse));
        QCOMPARE(GetEventKind(event), UInt32(kEventMouseUp));
        QCOMPARE(GetEventTime(event), 0.0);
        QCOMPARE(event->attributes, UInt32(kEventAttributeUserEvent));
        event->when = 90;
        QCOMPARE(GetEventTime(event), 1.5);
        ReleaseEvent(event);
        QCOMPARE(GetEventClass(nullptr), 0u);
        QCOMPARE(GetEventKind(nullptr), 0u);
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

    void getEventParameter_data()
    {
        QTest::addColumn<int>("setup");
        QTest::addColumn<UInt32>("name");
        QTest::addColumn<UInt32>("desiredType");
        QTest::addColumn<UInt32>("bufferSize");
        QTest::addColumn<bool>("withData");
        QTest::addColumn<int>("result");
        QTest::addColumn<UInt32>("actualType");
        QTest::addColumn<UInt32>("actualSize");
        QTest::addColumn<QByteArray>("data");

        auto le = [](qint64 v, int n) { return QByteArray(reinterpret_cast<const char*>(&v), n); };
        const int plain = int(Setup::Plain);
        QTest::newRow("modifiers present") << int(Setup::Modifiers) << UInt32(kEventParamKeyModifiers)
            << UInt32(typeUInt32) << 4u << true << int(noErr) << UInt32(typeUInt32) << 4u << le(shiftKey, 4);
        QTest::newRow("zero modifiers count as absent") << plain << UInt32(kEventParamKeyModifiers)
            << UInt32(typeUInt32) << 4u << true << int(eventParameterNotFoundErr) << UInt32(typeUInt32) << 4u
            << QByteArray(4, 0);
        QTest::newRow("no data: type and size only") << plain << UInt32(kEventParamKeyModifiers)
            << UInt32(typeUInt32) << 0u << false << int(noErr) << UInt32(typeUInt32) << 4u << QByteArray();
        QTest::newRow("no coercion") << int(Setup::Modifiers) << UInt32(kEventParamKeyModifiers)
            << UInt32(typeSInt32) << 4u << true << int(errAECoercionFail) << UInt32(typeUInt32) << 4u
            << QByteArray(4, 0);
        QTest::newRow("buffer too small") << int(Setup::Modifiers) << UInt32(kEventParamKeyModifiers)
            << UInt32(typeUInt32) << 2u << true << int(errAECoercionFail) << UInt32(typeUInt32) << 4u
            << QByteArray(2, 0);
        QTest::newRow("unknown name") << plain << UInt32(FOUR_CHAR_CODE("zzzz")) << UInt32(typeUInt32) << 4u
            << true << int(eventParameterNotFoundErr) << 0u << 0u << QByteArray(4, 0);
        QTest::newRow("wheel axis 1") << int(Setup::Wheel) << UInt32(kEventParamMouseWheelAxis)
            << UInt32(typeMouseWheelAxis) << 2u << true << int(noErr) << UInt32(typeMouseWheelAxis) << 2u
            << le(1, 2);
        QTest::newRow("wheel delta -2") << int(Setup::Wheel) << UInt32(kEventParamMouseWheelDelta)
            << UInt32(typeLongInteger) << 4u << true << int(noErr) << UInt32(typeLongInteger) << 4u << le(-2, 4);
        QTest::newRow("zero wheel axis of a wheel event is present") << int(Setup::WheelZero)
            << UInt32(kEventParamMouseWheelAxis) << UInt32(typeMouseWheelAxis) << 2u << true << int(noErr)
            << UInt32(typeMouseWheelAxis) << 2u << QByteArray(2, 0);
        QTest::newRow("mouse down may carry a zero wheel delta") << int(Setup::MouseDownWheel)
            << UInt32(kEventParamMouseWheelDelta) << UInt32(typeLongInteger) << 4u << true << int(noErr)
            << UInt32(typeLongInteger) << 4u << QByteArray(4, 0);
        QTest::newRow("zero wheel delta of a key event is absent") << int(Setup::KeyDownWheelZero)
            << UInt32(kEventParamMouseWheelDelta) << UInt32(typeLongInteger) << 4u << true
            << int(eventParameterNotFoundErr) << UInt32(typeLongInteger) << 4u << QByteArray(4, 0);
        QTest::newRow("window") << int(Setup::Window) << UInt32(kEventParamWindowRef) << UInt32(typeWindowRef)
            << 8u << true << int(noErr) << UInt32(typeWindowRef) << UInt32(sizeof(void*))
            << le(qint64(quintptr(fakeWindow(3))), 8);
        QTest::newRow("larger buffer is zero-filled past the value") << int(Setup::Modifiers)
            << UInt32(kEventParamKeyModifiers) << UInt32(typeUInt32) << 8u << true << int(noErr)
            << UInt32(typeUInt32) << 4u << le(shiftKey, 8);
        QTest::newRow("direct object keeps its 6 bytes") << plain << UInt32(kEventParamDirectObject)
            << UInt32(typeFSVolumeRefNum) << 6u << false << int(noErr) << UInt32(typeFSVolumeRefNum) << 6u
            << QByteArray();
    }

    void getEventParameter()
    {
        QFETCH(int, setup);
        QFETCH(UInt32, name);
        QFETCH(UInt32, desiredType);
        QFETCH(UInt32, bufferSize);
        QFETCH(bool, withData);
        QFETCH(int, result);
        QFETCH(UInt32, actualType);
        QFETCH(UInt32, actualSize);
        QFETCH(QByteArray, data);

        EventQueueItemSmartPtr item = itemFor(Setup(setup));
        QByteArray buffer(int(bufferSize), char(0x5A)); // stale bytes must be zeroed
        EventParamType gotType = 0;
        ByteCount gotSize = 0;
        const OSStatus err = GetEventParameter(item.get(), name, desiredType, &gotType, bufferSize, &gotSize,
                                               withData ? buffer.data() : nullptr);
        QCOMPARE(err, OSStatus(result));
        QCOMPARE(gotType, actualType);
        QCOMPARE(gotSize, actualSize);
        if (withData)
            QCOMPARE(buffer.toHex(), data.toHex());
    }

    void getEventParameterBadInput()
    {
        UInt32 value = 0xFFFF;
        QCOMPARE(GetEventParameter(nullptr, kEventParamKeyModifiers, typeUInt32, nullptr, 4, nullptr, &value),
                 OSStatus(paramErr));
        QCOMPARE(value, 0xFFFFu); // untouched for a null event
        EventQueueItemSmartPtr item = itemFor(Setup::Modifiers);
        // no out-pointers at all
        QCOMPARE(GetEventParameter(item.get(), kEventParamKeyModifiers, typeUInt32, nullptr, 4, nullptr, nullptr),
                 OSStatus(noErr));
    }

    void setEventParameterOrder()
    {
        // Whole sequence in call order, asserts included.
        AssertRecorder asserts;
        EventQueueItemSmartPtr item = itemFor(Setup::Plain);
        const UInt32 mods = optionKey;
        const SInt16 shortValue = 0x0102;
        const UInt8 bytes[8] = {1, 2, 3, 4, 5, 6, 7, 8};
        auto note = [](const QString& s) { log() << s; };
        note(QString::number(SetEventParameter(nullptr, kEventParamKeyModifiers, typeUInt32, 4, &mods)));
        note(QString::number(SetEventParameter(item.get(), FOUR_CHAR_CODE("zzzz"), typeUInt32, 4, &mods)));
        note(QString::number(SetEventParameter(item.get(), kEventParamKeyModifiers, typeUInt32, 4, &mods)));
        note(QString::number(item->modifiers));
        note(QString::number(SetEventParameter(item.get(), kEventParamKeyCode, typeSInt32, 4, &mods)));
        note(QString::number(item->keyCode));
        note(QString::number(SetEventParameter(item.get(), kEventParamKeyCode, typeUInt32, 2, &shortValue)));
        note(QString::number(item->keyCode, 16));
        note(QString::number(SetEventParameter(item.get(), kEventParamDirectObject, typeFSVolumeRefNum, 8, bytes)));
        note(QString::fromLatin1(QByteArray(reinterpret_cast<const char*>(item->directObject), 6).toHex()));
        note(QString::number(SetEventParameter(item.get(), kEventParamMouseButton, typeMouseButton, 2, nullptr)));
        QCOMPARE(log(), (QStringList{
                            "-9868",
                            "assert: false", "-4",
                            "0", "2048",
                            "assert: kEventParameterList[idx].type == inType", "0", "2048",
                            "assert: kEventParameterList[idx].size == inSize", "0", "102",
                            "assert: kEventParameterList[idx].size == inSize", "0", "010203040506",
                            "-50"}));
    }

    void predicates_data()
    {
        QTest::addColumn<UInt32>("cls");
        QTest::addColumn<UInt32>("kind");
        QTest::addColumn<QString>("expected"); // null update moveResize activate mouse wheel sync compatible

        auto row = [](const char* name, UInt32 cls, UInt32 kind, const char* expected) {
            QTest::newRow(name) << cls << kind << QString::fromLatin1(expected);
        };
        using namespace Velmar::Private;
        row("null", 0, 0, "N.......C");
        row("mouse kind 0", kEventClassMouse, 0, ".....W...");
        row("mouse down", kEventClassMouse, kEventMouseDown, "....MW..C");
        row("mouse up", kEventClassMouse, kEventMouseUp, "....M...C");
        row("mouse moved", kEventClassMouse, kEventMouseMoved, ".........");
        row("mouse dragged", kEventClassMouse, kEventMouseDragged, "....M.S..");
        row("wheel", kEventClassMouse, kEventMouseWheelMoved, ".....W...");
        row("key down", kEventClassKeyboard, kEventRawKeyDown, "........C");
        row("key repeat", kEventClassKeyboard, kEventRawKeyRepeat, "........C");
        row("key up", kEventClassKeyboard, kEventRawKeyUp, "........C");
        row("update", kEventClassWindow, kEventWindowUpdate, ".U......C");
        row("activated", kEventClassWindow, kEventWindowActivated, "...A....C");
        row("deactivated", kEventClassWindow, kEventWindowDeactivated, "...A....C");
        row("shown", kEventClassWindow, kEventWindowShown, ".........");
        row("bounds changed", kEventClassWindow, kEventWindowBoundsChanged, "..R...S..");
        row("app activated", kEventClassApplication, kEventAppActivated, "........C");
        row("app deactivated", kEventClassApplication, kEventAppDeactivated, "........C");
        row("resized", kEventClassVelmar, kEventVelmarResized, "..R...S..");
        row("moved", kEventClassVelmar, kEventVelmarMoved, "..R...S..");
        row("zoomed", kEventClassVelmar, kEventVelmarZoomed, "......S..");
        row("update menus", kEventClassVelmar, kEventVelmarUpdateMenus, "......S..");
        row("menu triggered", kEventClassVelmar, kEventVelmarMenuTriggered, ".........");
        row("close", kEventClassVelmar, kEventVelmarCloseRequested, ".........");
        row("classic 12", kEventClassVelmarClassic, 12, "........C");
        row("classic 0", kEventClassVelmarClassic, 0, "........C");
        row("foreign", FOUR_CHAR_CODE("cmds"), 1, ".........");
    }

    void predicates()
    {
        QFETCH(UInt32, cls);
        QFETCH(UInt32, kind);
        QFETCH(QString, expected);
        EventQueueItemSmartPtr item = makeItem(cls, kind);
        const bool flags[] = {item->isNullEvent(), item->isUpdateEvent(), item->isMoveResizeEvent(),
                              item->isActivateEvent(), item->isMouseEvent(), item->isMouseWheelEvent(),
                              item->IsSynchronized(), false, item->isEventRecordCompatible()};
        const char letters[] = "NURAMWS.C";
        QString got;
        for (int i = 0; i < 9; ++i)
            got += flags[i] ? QChar::fromLatin1(letters[i]) : QChar(u'.');
        QCOMPARE(got, expected);
        // the not-synchronized mark overrides the kind
        item->notSynchronized = 1;
        QVERIFY(!item->IsSynchronized());
    }

    void debuggingStrings()
    {
        QCOMPARE(EventQueueItem::EventClassAndKindToString(kEventClassMouse, kEventMouseDown),
                 QStringLiteral(", class=mous [1836021107], kind=.... [       1]"));
        QCOMPARE(EventQueueItem::EventClassAndKindToString(0, 0),
                 QStringLiteral(", class=.... [       0], kind=.... [       0]"));
        FakeWindows windows;
        EventQueueItemSmartPtr item = makeItem(Velmar::Private::kEventClassVelmar, Velmar::Private::kEventVelmarMoved, fakeWindow(2));
        const QString text = item->toString();
        QVERIFY2(text.startsWith(QStringLiteral("[ptr=%1, win=Window 2 [2000]").arg(quintptr(item.get()), 0, 16)),
                 qPrintable(text));
        QVERIFY2(text.contains(QStringLiteral(", class=vlmr [1986817394], kind=move [1836021349]")), qPrintable(text));
    }

    void smartPointerHoldsOneReference()
    {
        EventQueueItemSmartPtr a = EventQueueItemSmartPtr::Create();
        EventQueueItem* raw = a.get();
        {
            EventQueueItemSmartPtr b = a;
            EventQueueItemSmartPtr c(raw);
            QCOMPARE(raw->refCount, SInt16(3));
            c = b;
            QCOMPARE(raw->refCount, SInt16(3));
            EventQueueItemSmartPtr d = std::move(c);
            QVERIFY(!c);
            QCOMPARE(raw->refCount, SInt16(3));
            EventQueueItemSmartPtr& alias = d;
            d = alias; // self-assignment keeps the count
            QCOMPARE(raw->refCount, SInt16(3));
        }
        QCOMPARE(raw->refCount, SInt16(1));
    }

    void parse_data()
    {
        QTest::addColumn<int>("mask");
        QTest::addColumn<int>("result");
        QTest::addColumn<QString>("pairs");

        QTest::newRow("everyEvent") << int(everyEvent) << 0 << "";
        QTest::newRow("zero") << 0 << 0 << "";
        QTest::newRow("activate: two kinds") << int(activMask) << 2 << "wind/5 wind/6";
        QTest::newRow("os: two kinds") << int(osMask) << 2 << "appl/1 appl/2";
        QTest::newRow("table order") << int(osMask | keyUpMask | mDownMask) << 4 << "mous/1 keyb/3 appl/1 appl/2";
        QTest::newRow("unknown bits ignored beside a known one") << int(0x0001 | 0x0080 | mUpMask) << 1 << "mous/2";
        // one pair per bit, in bit order: each bit's own mapping shows in its place
        QTest::newRow("all known bits") << int(0x817E) << 10
                                        << "mous/1 mous/2 keyb/1 keyb/3 keyb/2 wind/1 wind/5 wind/6 appl/1 appl/2";
        QTest::newRow("everyEvent less one bit") << int(0xFFFE) << 10
                                                 << "mous/1 mous/2 keyb/1 keyb/3 keyb/2 wind/1 wind/5 wind/6 appl/1 appl/2";
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
        QCOMPARE(pairsText(list), pairs);
        QCOMPARE(capture.count(QStringLiteral("Unable to parse eventMask at all.... Returning negative")),
                 result < 0 ? 1 : 0);
    }

    void matching()
    {
        Private::EventTypeList list;
        Private::ParseEventMask(activMask, list);
        EventQueueItemSmartPtr activated = makeItem(kEventClassWindow, kEventWindowActivated);
        EventQueueItemSmartPtr update = makeItem(kEventClassWindow, kEventWindowUpdate);
        QVERIFY(Private::MatchesEventTypes(list, activated.get()));
        QVERIFY(!Private::MatchesEventTypes(list, update.get()));
        QVERIFY(!Private::MatchesEventTypes(list, nullptr));
        // an empty list matches everything, a null list with a count too
        Private::EventTypeList empty;
        QVERIFY(Private::MatchesEventTypes(empty, update.get()));
        QVERIFY(Private::MatchesEventTypes(nullptr, 3, kEventClassMouse, 1));
        const EventTypeSpec one[] = {{kEventClassMouse, kEventMouseDown}};
        QVERIFY(Private::MatchesEventTypes(one, 1, kEventClassMouse, kEventMouseDown));
        QVERIFY(!Private::MatchesEventTypes(one, 1, kEventClassMouse, kEventMouseUp));
    }

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
        row("classic 0: a null what that keeps its message", Private::kEventClassVelmarClassic, 0,
            "what=0 msg=1234 mods=768 unit=97 key=65 qmods=33554432");
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
};

VELMAR_TEST_MAIN(tst_EventItem)
#include "tst_eventitem.moc"
