// What a hostile host hands the library, one table row per call or rule: null, disposed and
// made-up ports, regions, polygons, events, queues, handler calls and handles. Each call must
// give its neutral answer and exactly the assertions listed (none for a documented quiet
// refusal), never read freed memory (run under the sanitizer build to see the difference).
// Then what is hostile without being invalid: comparators that change the queue they search,
// coordinates at the ends of the 32-bit range and shapes as large as 16 bits allow.
#include "../events/events_support.h"
#include "../quickdraw/QuickDrawTestSupport.h"

#include <Velmar/CarbonEventHandlers.h>
#include <Velmar/CarbonEvents.h>
#include <Velmar/Events.h>
#include <Velmar/HostCore.h>
#include <Velmar/HostEncoding.h>
#include <Velmar/MacErrors.h>
#include <Velmar/QDText.h>

#include "quickdraw/ShapeRegions.h"

#include <QKeyEvent>

#include <climits>
#include <functional>

using namespace Velmar;
using QDTest::World;
using QDTest::rgnOf;
using Velmar::Private::gMainEventQueue;
using Velmar::Private::makeRect;

namespace {

using Call = std::function<QString()>;

// The parts of an answer, evaluated in order (a braced list is; the operands of + are not).
QString seq(std::initializer_list<QString> parts) { return QStringList(parts).join(u' '); }
QString n(qint64 value) { return QString::number(value); }
QString yes(bool value) { return value ? QStringLiteral("yes") : QStringLiteral("no"); }
QString null(const void* p) { return p ? QStringLiteral("set") : QStringLiteral("null"); }
QString text(const Rect& r)
{
    return QStringLiteral("%1,%2,%3,%4").arg(r.top).arg(r.left).arg(r.bottom).arg(r.right);
}
QString text(const QRegion& r)
{
    const QRect b = r.boundingRect();
    return QStringLiteral("%1 rects %2,%3 %4x%5").arg(r.rectCount()).arg(b.x()).arg(b.y()).arg(b.width()).arg(b.height());
}

// Things that were live once, each made just before the call that gets it (so that no
// newer object of its kind can have taken its address), and things never made at all.
QRegion gStackRgn(0, 0, 5, 5); // never made by NewRgn
PolyPtr gMadeUpPoly{nullptr};
EventQueueRef gForeignQueue = reinterpret_cast<EventQueueRef>(&gStackRgn);
EventHandlerCallRef gKeptCallRef = nullptr;

GrafPtr stalePort()
{
    GrafPtr port = nullptr;
    const Rect bounds = makeRect(0, 0, 10, 10);
    NewGWorld(&port, 32, &bounds, nullptr, nullptr, 0);
    DisposeGWorld(port);
    return port;
}
RgnHandle staleRgn()
{
    RgnHandle rgn = NewRgn();
    DisposeRgn(rgn);
    return rgn;
}
PolyPtr* stalePoly()
{
    PolyPtr* poly = QDTest::recordPoly({QPoint(0, 0), QPoint(5, 0), QPoint(0, 5)});
    KillPoly(poly);
    return poly;
}
OSStatus keepingHandler(EventHandlerCallRef call, EventRef, void*)
{
    gKeptCallRef = call;
    return eventNotHandledErr;
}
// An event freed after a handler kept its call reference.
EventRef freedEvent()
{
    EventRef event = nullptr;
    MacCreateEvent(nullptr, kEventClassMouse, kEventMouseDown, 0, 0, &event);
    EventHandlerRef handler = nullptr;
    InstallEventHandler(GetApplicationEventTarget(), keepingHandler, 0, nullptr, nullptr, &handler);
    SendEventToEventTarget(event, GetApplicationEventTarget());
    RemoveEventHandler(handler);
    ReleaseEvent(event);
    return event;
}

// What a port call may write into, made before the stale port.
struct Scratch {
    Rect rect = makeRect(1, 2, 3, 4);
    RGBColor colour{1, 2, 3};
    Point point{5, 6};
    QDTest::Rgn rgn = rgnOf(QRegion(1, 1, 2, 2));
};
using PortCall = std::function<QString(GrafPtr, Scratch&)>;
using StaleCall = std::function<QString(RgnHandle, PolyPtr*)>;

bool matchAll(EventRef, void*) { return true; }

// What the comparator under test does to the queue when it is shown an item.
std::function<bool(EventRef)> gComparatorAction;
int gShown = 0;
bool actingComparator(EventRef event, void*)
{
    ++gShown;
    return gComparatorAction(event);
}

void postThree()
{
    for (UInt32 msg = 1; msg <= 3; ++msg)
        PostEvent(12, msg);
}

const Rect kFull16 = makeRect(-32768, -32768, 32767, 32767);
const QStringList kPort{QStringLiteral("IsValidPort(port)")};
const QStringList kEvent{QStringLiteral("IsValidEvent(event)")};
const QStringList kForeign{QStringLiteral("inQueue == Velmar::GetMainEventQueue()")};

} // namespace

Q_DECLARE_METATYPE(Call)

class TestHostileInput : public QObject {
    Q_OBJECT

    std::unique_ptr<World> m_world;

    static void portRow(const char* name, PortCall call, const QString& answer, const QStringList& asserts = kPort)
    {
        row(name, [call] { Scratch scratch; return call(stalePort(), scratch); }, answer, asserts);
    }
    static void staleRow(const char* name, StaleCall call, const QString& answer, const QStringList& asserts)
    {
        row(name, [call] { return call(staleRgn(), stalePoly()); }, answer, asserts);
    }
    static void row(const char* name, Call call, const QString& answer, const QStringList& asserts = {},
                    const QString& logged = {})
    {
        QTest::newRow(name) << call << answer << asserts << logged;
    }

private Q_SLOTS:
    void initTestCase()
    {
        SetLogCategory(kLogQuickDraw | kLogGrafPort, true);
        m_world = std::make_unique<World>(20);
    }
    void cleanupTestCase() { m_world.reset(); }
    void init()
    {
        if (m_world)
            SetPort(m_world->port());
        gMainEventQueue.clearAll();
        gShown = 0;
    }
    void cleanup() { gMainEventQueue.clearAll(); }

    void refused_data()
    {
        QTest::addColumn<Call>("call");
        QTest::addColumn<QString>("answer");
        QTest::addColumn<QStringList>("asserts");
        QTest::addColumn<QString>("logged");

        // A disposed port: one assertion each, the neutral answer, nothing written.
        using S = Scratch&;
        portRow("GetPortBounds", [](GrafPtr p, S s) { return n(GetPortBounds(p, &s.rect)->right); }, "0");
        portRow("SetPortBounds", [](GrafPtr p, S s) { SetPortBounds(p, &s.rect); return text(s.rect); }, "2,1,4,3");
        portRow("GetPortBackColor", [](GrafPtr p, S s) { GetPortBackColor(p, &s.colour); return n(s.colour.red); }, "1");
        portRow("GetPortForeColor", [](GrafPtr p, S s) { GetPortForeColor(p, &s.colour); return n(s.colour.red); }, "1");
        portRow("GetPortHiliteColor", [](GrafPtr p, S s) { GetPortHiliteColor(p, &s.colour); return n(s.colour.red); }, "1");
        portRow("SetPortOpColor", [](GrafPtr p, S s) { SetPortOpColor(p, &s.colour); return n(s.colour.red); }, "1");
        portRow("GetPortPenLocation", [](GrafPtr p, S s) { return null(GetPortPenLocation(p, &s.point)); }, "null");
        portRow("GetPortPenMode", [](GrafPtr p, S) { return n(GetPortPenMode(p)); }, "0");
        portRow("GetPortTextFont", [](GrafPtr p, S) { return n(GetPortTextFont(p)); }, "0");
        portRow("GetPortTextSize", [](GrafPtr p, S) { return n(GetPortTextSize(p)); }, "0");
        portRow("GetPortTextFace", [](GrafPtr p, S) { return n(GetPortTextFace(p)); }, "0");
        portRow("GetPortTextMode", [](GrafPtr p, S) { return n(GetPortTextMode(p)); }, "0");
        portRow("GetPortPixMap", [](GrafPtr p, S) { return null(GetPortPixMap(p)); }, "null");
        portRow("GetPortBitMapForCopyBits", [](GrafPtr p, S) { return null(GetPortBitMapForCopyBits(p).image()); }, "null");
        portRow("SetPortClipRegion", [](GrafPtr p, S s) { SetPortClipRegion(p, s.rgn.get()); return text(*s.rgn); }, "1 rects 1,1 2x2");
        portRow("SetPortVisibleRegion", [](GrafPtr p, S s) { SetPortVisibleRegion(p, s.rgn.get()); return text(*s.rgn); }, "1 rects 1,1 2x2");
        portRow("GetPortVisibleRegion", [](GrafPtr p, S s) { GetPortVisibleRegion(p, s.rgn.get()); return text(*s.rgn); }, "1 rects 1,1 2x2");
        portRow("GetPortClipRegion", [](GrafPtr p, S s) { GetPortClipRegion(p, s.rgn.get()); return text(*s.rgn); }, "1 rects 1,1 2x2");
        portRow("QDLocalToGlobalRect", [](GrafPtr p, S s) { QDLocalToGlobalRect(p, &s.rect); return text(s.rect); }, "2,1,4,3");
        portRow("QDGlobalToLocalPoint", [](GrafPtr p, S s) { QDGlobalToLocalPoint(p, &s.point); return n(s.point.h); }, "6");
        portRow("QDFlushPortBuffer", [](GrafPtr p, S s) { QDFlushPortBuffer(p, s.rgn.get()); return QString(); }, "");
        portRow("MakeQPainter", [](GrafPtr p, S) { return null(MakeQPainter(p, "test")); }, "null");
        portRow("DisposePort", [](GrafPtr p, S) { DisposePort(p); return QString(); }, "");
        portRow("DisposeGWorld", [](GrafPtr p, S) { DisposeGWorld(p); return QString(); }, "", {"IsValidPort(offscreenGWorld)"});
        portRow("SetPort", [](GrafPtr p, S) { SetPort(p); return null(GetCurrentPort()); }, "null", {});

        // Null ports and worlds.
        row("DisposeGWorld null", [] { DisposeGWorld(nullptr); return QString(); }, "",
            {"offscreenGWorld != NULL && offscreenGWorld->window == NULL"});
        row("NewGWorld nowhere to put it", [] {
            const auto before = Private::livePorts().size();
            return seq({n(NewGWorld(nullptr, 0, nullptr, nullptr, nullptr, 0)), n(Private::livePorts().size() - before)});
        }, "0 0");
        row("GetPortBounds null", [] {
            Rect r = makeRect(1, 2, 3, 4);
            return seq({yes(GetPortBounds(nullptr, &r) == &r), text(r), null(GetPortBounds(nullptr, nullptr))});
        }, "yes 0,0,0,0 null");
        row("GetPortPixMap null", [] { return null(GetPortPixMap(nullptr)); }, "null", {"port != NULL"});

        // Disposed twice, killed twice, or never made: one assertion, nothing freed twice.
                const QStringList rgnA{"IsValidRgn(rgn)"}, polyA{"IsValidPoly(poly)"};
        const RgnHandle onStack = &gStackRgn;
        static const Rect r = makeRect(0, 0, 5, 5);
        staleRow("DisposeRgn twice", [](RgnHandle rgn, PolyPtr*) { DisposeRgn(rgn); return QString(); }, "", rgnA);
        staleRow("CopyRgn made-up", [=](RgnHandle rgn, PolyPtr*) { CopyRgn(rgn, onStack); return QString(); }, "", rgnA);
        staleRow("SetEmptyRgn made-up", [=](RgnHandle, PolyPtr*) { SetEmptyRgn(onStack); return QString(); }, "", rgnA);
        staleRow("RectRgn", [](RgnHandle rgn, PolyPtr*) { RectRgn(rgn, &r); return QString(); }, "", rgnA);
        staleRow("UnionRgn", [](RgnHandle rgn, PolyPtr*) { UnionRgn(rgn, rgn, rgn); return QString(); }, "", rgnA);
        staleRow("OffsetRgn made-up", [=](RgnHandle, PolyPtr*) { OffsetRgn(onStack, 1, 1); return QString(); }, "", rgnA);
        staleRow("InsetRgn", [](RgnHandle rgn, PolyPtr*) { InsetRgn(rgn, 1, 1); return QString(); }, "", rgnA);
        staleRow("MapRgn", [](RgnHandle rgn, PolyPtr*) { MapRgn(rgn, &r, &r); return QString(); }, "", rgnA);
        staleRow("PtInRgn made-up", [=](RgnHandle, PolyPtr*) { return n(PtInRgn(Point{1, 1}, onStack)); }, "0", rgnA);
        staleRow("EmptyRgn", [](RgnHandle rgn, PolyPtr*) { return n(EmptyRgn(rgn)); }, "1", rgnA);
        staleRow("PaintRgn", [](RgnHandle rgn, PolyPtr*) { PaintRgn(rgn); return QString(); }, "", rgnA);
        staleRow("FrameRgn made-up", [=](RgnHandle, PolyPtr*) { FrameRgn(onStack); return QString(); }, "", rgnA);
        staleRow("InvertRgn", [](RgnHandle rgn, PolyPtr*) { InvertRgn(rgn); return QString(); }, "", rgnA);
        staleRow("SetClip", [](RgnHandle rgn, PolyPtr*) { SetClip(rgn); return QString(); }, "", rgnA);
        staleRow("CloseRgn", [](RgnHandle rgn, PolyPtr*) { OpenRgn(); CloseRgn(rgn); CleanupOpenRgn cleanup; return QString(); }, "", rgnA);
        staleRow("KillPoly twice", [](RgnHandle, PolyPtr* poly) { KillPoly(poly); return QString(); }, "", polyA);
        staleRow("OffsetPoly", [](RgnHandle, PolyPtr* poly) { OffsetPoly(poly, 1, 1); return QString(); }, "", polyA);
        staleRow("PaintPoly made-up", [](RgnHandle, PolyPtr*) { PaintPoly(&gMadeUpPoly); return QString(); }, "", polyA);
        staleRow("FramePoly", [](RgnHandle, PolyPtr* poly) { FramePoly(poly); return QString(); }, "", polyA);

        // Null regions, polygons and rectangles are quiet: a log line, the neutral answer.
        row("region calls with null", [] {
            QDTest::Rgn a = rgnOf(QRegion(0, 0, 10, 10)), dst = rgnOf(QRegion(50, 50, 10, 10));
            UnionRgn(a.get(), nullptr, dst.get());
            SectRgn(nullptr, a.get(), dst.get());
            DiffRgn(a.get(), nullptr, dst.get());
            XorRgn(nullptr, nullptr, dst.get());
            UnionRgn(a.get(), a.get(), nullptr);
            DisposeRgn(nullptr);
            CopyRgn(nullptr, dst.get());
            CopyRgn(a.get(), nullptr);
            SetEmptyRgn(nullptr);
            RectRgn(nullptr, nullptr);
            OffsetRgn(nullptr, 1, 1);
            InsetRgn(nullptr, 1, 1);
            MapRgn(nullptr, nullptr, nullptr);
            const Rect box{0, 0, 5, 5};
            Rect b{1, 1, 1, 1};
            return seq({text(*dst), n(PtInRgn(Point{1, 1}, nullptr)), n(RectInRgn(&box, nullptr)), n(RectInRgn(nullptr, a.get())),
                n(EmptyRgn(nullptr)), n(EqualRgn(nullptr, nullptr)), n(EqualRgn(a.get(), nullptr)),
                null(GetRegionBounds(a.get(), nullptr)), yes(GetRegionBounds(nullptr, &b) == &b), text(b)});
        }, "1 rects 50,50 10x10 0 0 0 1 1 0 null yes 0,0,0,0", {}, "CopyRgn");
        row("polygon calls with null", [] {
            KillPoly(nullptr);
            OffsetPoly(nullptr, 1, 1);
            for (auto call : {FramePoly, PaintPoly, ErasePoly, InvertPoly})
                call(nullptr);
            FillPoly(nullptr, GetQDGlobalsBlack(nullptr));
            GetPolyRect(nullptr, nullptr);
            PolyPtr* const none = nullptr;
            return text(GetPolyBBox(none));
        }, "0,0,0,0", {}, "PaintPoly");
        row("rectangle calls with null", [] {
            SetRect(nullptr, 1, 2, 3, 4);
            OffsetRect(nullptr, 1, 1);
            InsetRect(nullptr, 1, 1);
            const Rect a = makeRect(0, 0, 10, 10);
            UnionRect(&a, &a, nullptr);
            Pt2Rect(Point{1, 1}, Point{2, 2}, nullptr);
            return seq({n(EmptyRect(nullptr)), n(PtInRect(Point{15, 15}, nullptr))});
        }, "1 0", {}, "OffsetRect");

        // Queue references that are not the main queue are refused before they are read.
        const EventQueueRef foreign = gForeignQueue;
        row("GetNumEventsInQueue foreign", [=] { return n(GetNumEventsInQueue(foreign)); }, "0", kForeign);
        row("FlushSpecificEventsFromQueue foreign", [=] {
            PostEvent(12, 1);
            return seq({n(FlushSpecificEventsFromQueue(foreign, matchAll, nullptr)), n(gMainEventQueue.count())});
        }, n(eventInternalErr) + " 1", kForeign);
        row("FindSpecificEventInQueue foreign", [=] { return null(FindSpecificEventInQueue(foreign, matchAll, nullptr)); },
            "null", kForeign);
        row("RemoveEventFromQueue foreign", [=] {
            PostEvent(12, 1);
            return seq({n(RemoveEventFromQueue(foreign, gMainEventQueue.items().front().get())), n(gMainEventQueue.count())});
        }, n(eventInternalErr) + " 1", kForeign);
        row("ScopedCarbonEventsBlocker foreign", [=] {
            ScopedCarbonEventsBlocker blocker(foreign, "foreign");
            return seq({yes(blocker.isBlocked()), yes(gMainEventQueue.CheckCarbonEventsDisabled())});
        }, "no no", kForeign);
        row("queue calls with null", [] {
            return seq({n(FlushSpecificEventsFromQueue(nullptr, matchAll, nullptr)),
                n(FlushSpecificEventsFromQueue(GetMainEventQueue(), nullptr, nullptr)),
                null(FindSpecificEventInQueue(nullptr, matchAll, nullptr)),
                null(FindSpecificEventInQueue(GetMainEventQueue(), nullptr, nullptr)), n(GetNumEventsInQueue(nullptr))});
        }, n(eventInternalErr) + " " + n(eventInternalErr) + " null null 0");

        // A freed event and a handler call kept past its handler: refused, unread.
        row("GetEventParameter freed", [] {
            const EventRef freed = freedEvent();
            UInt32 modifiers = 7;
            return seq({n(GetEventParameter(freed, kEventParamKeyModifiers, typeUInt32, nullptr, 4, nullptr, &modifiers)), n(modifiers)});
        }, n(paramErr) + " 7", kEvent);
        row("SetEventParameter freed", [] {
            const EventRef freed = freedEvent();
            UInt32 modifiers = 7;
            return n(SetEventParameter(freed, kEventParamKeyModifiers, typeUInt32, 4, &modifiers));
        }, n(eventInternalErr), kEvent);
        row("ConvertEventRefToEventRecord freed", [] { EventRecord r{}; return yes(ConvertEventRefToEventRecord(freedEvent(), &r)); },
            "no", kEvent);
        row("PostEventToQueue freed", [] {
            return seq({n(PostEventToQueue(GetMainEventQueue(), freedEvent(), kEventPriorityStandard)), n(gMainEventQueue.count())});
        }, n(eventInternalErr) + " 0", kEvent);
        row("SendEventToEventTarget freed", [] { return n(SendEventToEventTarget(freedEvent(), GetApplicationEventTarget())); },
            n(eventInternalErr), kEvent);
        row("RetainEvent freed", [] { RetainEvent(freedEvent()); return QString(); }, "", kEvent);
        row("CallNextEventHandler kept", [] { const EventRef freed = freedEvent(); return n(CallNextEventHandler(gKeptCallRef, freed)); }, n(paramErr),
            {"IsValidEventHandlerCall(inCallRef)"});
        row("ConvertVelmarEvent freed", [] {
            const EventRef freed = freedEvent();
            QKeyEvent key(QEvent::KeyPress, Qt::Key_A, Qt::NoModifier, QStringLiteral("a"));
            return seq({yes(ConvertVelmarEvent(nullptr, &key, freed)), yes(ConvertKeyEvent(&key, freed))});
        }, "no no", {"IsValidEvent(event)", "IsValidEvent(event)"});
        row("event calls with null", [] {
            UInt32 value = 0xFFFF;
            EventRecord r{};
            const auto item = EventTest::makeItem(kEventClassMouse, kEventMouseDown);
            return seq({n(GetEventParameter(nullptr, kEventParamKeyModifiers, typeUInt32, nullptr, 4, nullptr, &value)),
                n(value), yes(ConvertEventRefToEventRecord(nullptr, &r)), yes(ConvertEventRefToEventRecord(item.get(), nullptr)),
                yes(ConvertKeyEvent(nullptr, nullptr)), yes(ConvertMouseEvent(nullptr, nullptr, nullptr))});
        }, n(paramErr) + " 65535 no no no no");
        row("InstallEventHandler bad arguments", [] {
            EventHandlerRef ref = reinterpret_cast<EventHandlerRef>(0x1);
            const EventTypeSpec mouseDown{kEventClassMouse, kEventMouseDown};
            const EventTargetRef app = GetApplicationEventTarget();
            return seq({n(InstallEventHandler(app, nullptr, 0, nullptr, nullptr, &ref)), null(ref),
                n(InstallEventHandler(GetWindowEventTarget(nullptr), keepingHandler, 1, &mouseDown, nullptr, nullptr)),
                n(InstallEventHandler(EventTargetRef{}, keepingHandler, 0, nullptr, nullptr, nullptr)),
                n(InstallEventHandler(app, keepingHandler, 2, nullptr, nullptr, nullptr)), n(CallNextEventHandler(nullptr, nullptr))});
        }, n(paramErr) + " null " + QStringList(4, n(paramErr)).join(u' '));

        // Handles: null, freed twice, foreign master pointers, absurd sizes.
        row("handle calls with null", [] {
            TxDisposeHandle(nullptr);
            return seq({null(TxCopyHand(nullptr)), n(TxGetHandleSize(nullptr))});
        }, "null -1");
        row("TxDisposeHandle twice", [] {
            Handle h = TxPtrToHand("abc", 3);
            TxDisposeHandle(h);
            TxDisposeHandle(h);
            return seq({null(TxCopyHand(h)), n(TxGetHandleSize(h))});
        }, "null -1", {}, "TxDisposeHandle: not a live handle");
        row("foreign master pointer", [] {
            char block[16] = {};
            Ptr master = block;
            TxDisposeHandle(&master);
            return yes(TxIsValidHandle(&master));
        }, "no");
        row("TxPtrToHand refused sizes", [] { return seq({null(TxPtrToHand("x", -1)), null(TxPtrToHand(nullptr, 0x7fffffff))}); },
            "null null", {}, "TxPtrToHand: refused size");
        row("XError with nulls", [] {
            const XError empty(nullptr, nullptr);
            return seq({QString::fromLatin1(empty.GetErrorMessage()), QString::fromLatin1(empty.GetFile()), n(empty.GetLine())});
        }, "  0");

        // The encoding calls' buffer contracts: null or no room writes nothing, and says so.
        row("to UTF-16 bad buffers", [] {
            unsigned short units[4] = {9, 9, 9, 9};
            return seq({n(CurrentMacMBCSEncodingToUTF16(nullptr, 5, units, 4)), n(units[0]),
                n(CurrentMacMBCSEncodingToUTF16("abc", 0, units, 4)), n(CurrentMacMBCSEncodingToUTF16("abc", 3, nullptr, 10)),
                n(CurrentMacMBCSEncodingToUTF16("abc", 3, units, -5))});
        }, "0 0 0 3 3");
        row("from UTF-16 bad buffers", [] {
            char bytes[4] = {9, 9, 9, 9};
            bool lossyNull = true, lossyNowhere = false;
            const unsigned short abc[] = {'a', 'b', 'c', 0};
            return seq({n(UTF16ToCurrentMacMBCSEncoding(nullptr, 3, bytes, 4, &lossyNull)), n(bytes[0]), yes(lossyNull),
                n(UTF16ToCurrentMacMBCSEncoding(abc, 3, nullptr, 4, &lossyNowhere)), yes(lossyNowhere),
                n(UTF16ToCurrentMacMBCSEncoding(abc, 3, bytes, 0, nullptr)), n(UTF16ToCurrentMacMBCSEncoding(abc, -1, bytes, 4, nullptr)),
                QString::fromLatin1(bytes)});
        }, "0 0 no 0 yes 0 3 abc");
    }
    void refused()
    {
        QFETCH(Call, call);
        QFETCH(QString, answer);
        QFETCH(QStringList, asserts);
        QFETCH(QString, logged);
        VelmarTest::LogCapture log;
        VelmarTest::IgnoredAssertions raised;
        QCOMPARE(call(), answer);
        QCOMPARE(raised.texts(), asserts);
        if (!logged.isEmpty())
            QVERIFY2(log.contains(logged), qPrintable(log.lines().join(u'\n')));
        QCOMPARE(gStackRgn, QRegion(0, 0, 5, 5));
    }

    // Flushing and finding with comparators that post, remove what they are shown, or flush
    // everything: the walk sees each item that is still queued once, and nothing is freed
    // under it.
    void comparatorsThatChangeTheQueue_data()
    {
        QTest::addColumn<int>("action");
        QTest::addColumn<QStringList>("afterFlush");
        QTest::addColumn<QString>("found");
        QTest::newRow("posts") << 0 << QStringList{"vlme/12 msg=9", "vlme/12 msg=9", "vlme/12 msg=9"}
                               << "vlme/12 msg=1";
        QTest::newRow("removes what it is shown") << 1 << QStringList() << "<null>";
        QTest::newRow("flushes the queue") << 2 << QStringList() << "<null>";
    }
    void comparatorsThatChangeTheQueue()
    {
        QFETCH(int, action);
        QFETCH(QStringList, afterFlush);
        QFETCH(QString, found);
        gComparatorAction = [action](EventRef event) {
            switch (action) {
            case 0:
                PostEvent(12, 9);
                return GetEventKind(event) == 12 && event->message != 9;
            case 1:
                RemoveEventFromQueue(GetMainEventQueue(), event);
                return true;
            default:
                FlushEvents(everyEvent, 0);
                return true;
            }
        };
        postThree();
        QCOMPARE(FlushSpecificEventsFromQueue(GetMainEventQueue(), actingComparator, nullptr), noErr);
        QCOMPARE(EventTest::queueSnapshot(), afterFlush);
        QCOMPARE(gShown, action == 2 ? 1 : 3);
        gMainEventQueue.clearAll();
        postThree();
        QCOMPARE(EventTest::describe(FindSpecificEventInQueue(GetMainEventQueue(), actingComparator, nullptr)), found);
    }

    // Pen locations and point lists at the ends of the 32-bit range: drawing clips, the dirty
    // arithmetic saturates, and relative moves wrap as 16-bit values.
    void extremeCoordinates()
    {
        World world(20);
        const QList<QPoint> far = {QPoint(INT_MAX, INT_MAX), QPoint(INT_MIN, INT_MIN),
                                   QPoint(INT_MIN, INT_MAX), QPoint(5, 5)};
        for (int pen : {1, 40}) {
            PenSize(short(pen), short(pen));
            DrawLinesFromPointPairs(far);
            DrawPolylineFromPoints(far);
        }
        PenNormal();
        PenState state(QPoint(INT_MAX, INT_MIN), 30000, patCopy, QBrush(Qt::black));
        SetPenState(&state);
        LineTo(10, 10);
        SetPenState(&state);
        Move(1, 1);
        Point where;
        GetPen(&where);
        QCOMPARE(where.h, short(0));
        QCOMPARE(where.v, short(1));
        SetPenState(&state);
        Line(-1, -1);
        QVERIFY(!world.touched().isEmpty());
        // Far offsets stop at the edge of the range instead of overflowing.
        const QDTest::Rgn rgn = rgnOf(QRegion(0, 0, 4, 4));
        for (int i = 0; i < 20000; ++i)
            OffsetRgn(rgn.get(), 32767, 32767);
        QVERIFY(rgn->boundingRect().right() > 0);
        PolyPtr* poly = QDTest::recordPoly({QPoint(0, 0), QPoint(5, 0), QPoint(0, 5)});
        for (int i = 0; i < 20000; ++i)
            OffsetPoly(poly, -32768, -32768);
        QVERIFY(GetPolyBBox(poly).left <= 0);
        KillPoly(poly);
        // A steep map keeps the part that lands in range and drops the rest.
        const Rect one = makeRect(0, 0, 1, 1);
        *rgn = QRegion(0, 0, 32767, 1);
        MapRgn(rgn.get(), &one, &kFull16);
        QVERIFY(rgn->contains(QPoint(-32768, -32768)));
        QVERIFY(rgn->boundingRect().right() < INT_MAX / 2);
    }

    // The whole 16-bit plane scrolled on a small port: only the port's pixels move.
    void scrollRectOfTheWholePlane()
    {
        World world(100);
        PaintRect(&kFull16);
        const QDTest::Rgn update = rgnOf();
        ScrollRect(&kFull16, 0, 10, update.get());
        QCOMPARE(*update, QRegion(0, 0, 100, 10));
        QCOMPARE(world.pixel(50, 5), qRgb(255, 255, 255));
        QCOMPARE(world.pixel(50, 50), qRgb(0, 0, 0));
    }

    // Recording the largest oval and polygon: the region is the shape, built row by row.
    void recordingHugeShapes()
    {
        World world(50);
        const QDTest::Rgn rgn = rgnOf();
        OpenRgn();
        FrameOval(&kFull16);
        CloseRgn(rgn.get());
        QCOMPARE(rgn->boundingRect(), Private::toQRect(kFull16));
        QVERIFY(rgn->contains(QPoint(0, 0)));
        QVERIFY(!rgn->contains(QPoint(-30000, -30000)));
        OpenRgn();
        MoveTo(-32768, -32768);
        LineTo(32767, -32768);
        LineTo(-32768, 32767);
        CloseRgn(rgn.get());
        QVERIFY(rgn->contains(QPoint(-32000, 30000)));
        QVERIFY(!rgn->contains(QPoint(32000, 30000)));
        // Just above the size Qt builds itself, the two ways differ by edge pixels only.
        const int n = Private::kQtShapeRegionLimit + 100;
        const QRect box(0, 0, n, n / 2);
        const QRegion ours = Private::ellipseRegion(box), qts(box, QRegion::Ellipse);
        QVERIFY(!ours.isEmpty());
        QVERIFY(QDTest::regionPixels(ours ^ qts).size() < 4 * box.height());
        const QPolygon triangle({QPoint(0, 0), QPoint(n, n / 3), QPoint(n / 5, n)});
        const QRegion ourTriangle = Private::polygonRegion(triangle);
        QVERIFY(QDTest::regionPixels(ourTriangle ^ QRegion(triangle, Qt::OddEvenFill)).size() < 4 * n);
        // Banded as Qt bands: equal areas compare equal.
        QCOMPARE(ourTriangle, ourTriangle.united(ourTriangle.translated(0, 0)));
    }
};

VELMAR_APP_TEST_MAIN(TestHostileInput)
#include "tst_hostileinput.moc"
