// A seeded soak: random sequences of valid calls across drawing, regions, the queue, handlers,
// timers and windows for a bounded time (a crash, a sanitizer report or a refused valid call
// is a failure), and resident memory checked to stop growing once the caches are warm. What
// each call answers is the unit tests' and the fuzzers' business.
//     VELMAR_SOAK_SEED=n      replays one run (the seed is printed either way)
//     VELMAR_SOAK_SECONDS=s   how long to run (10 by default)
#include "TestSupport.h"

#include <Velmar/CarbonEventHandlers.h>
#include <Velmar/CarbonEvents.h>
#include <Velmar/EventWaiting.h>
#include <Velmar/Events.h>
#include <Velmar/MacErrors.h>
#include <Velmar/QDRegions.h>
#include <Velmar/QDShapes.h>
#include <Velmar/QtGrafPort.h>
#include <Velmar/QuickDraw.h>
#include <Velmar/Windows.h>

#include <QElapsedTimer>
#include <QFile>
#include <QRandomGenerator>

#include <functional>
#ifdef __GLIBC__
#include <malloc.h>
#endif
#include <vector>

using namespace Velmar;

namespace {

constexpr UInt32 kSoakClass = 0x736F616B; // 'soak'

long residentKiB()
{
    // What the process holds, not what it has freed: the window system answers (released
    // buffers, under Wayland a frame or two late) come in first, and the allocator gives
    // freed pages back.
    QTest::qWait(200);
#ifdef __GLIBC__
    malloc_trim(0);
#endif
    QFile status(QStringLiteral("/proc/self/status"));
    if (!status.open(QIODevice::ReadOnly))
        return -1;
    for (const QByteArray& line : status.readAll().split('\n'))
        if (line.startsWith("VmRSS:"))
            return line.mid(6).trimmed().split(' ').value(0).toLong();
    return -1;
}

// Sanitizer runtimes hold freed memory in quarantine: resident size says nothing there.
constexpr bool kMemoryMeasurable =
#if defined(__SANITIZE_ADDRESS__)
    false;
#elif defined(__has_feature)
#if __has_feature(address_sanitizer)
    false;
#else
    true;
#endif
#else
    true;
#endif

struct Soak {
    QRandomGenerator rng;
    GrafPtr world = nullptr;
    std::vector<RgnHandle> regions;
    std::vector<EventHandlerRef> handlers;
    std::vector<EventLoopTimerRef> timers;
    std::vector<WindowRef> windows;
    UInt32 steps = 0;

    explicit Soak(quint32 seed) : rng(seed) {}

    int pick(int n) { return int(rng.bounded(n)); }
    SInt16 coord(int span = 200) { return SInt16(pick(span) - span / 4); }
    Rect rect()
    {
        const SInt16 top = coord(), left = coord();
        return Rect{top, left, SInt16(top + pick(120)), SInt16(left + pick(120))};
    }
    template <typename T> T& any(std::vector<T>& v) { return v[size_t(pick(int(v.size())))]; }
    template <typename T> T takeAny(std::vector<T>& v)
    {
        const size_t i = size_t(pick(int(v.size())));
        const T taken = v[i];
        v.erase(v.begin() + long(i));
        return taken;
    }

    static OSStatus handler(EventHandlerCallRef call, EventRef event, void*)
    {
        return CallNextEventHandler(call, event);
    }
    static bool isOurs(EventRef event, void*) { return GetEventClass(event) == kSoakClass; }

    void draw()
    {
        const Rect r = rect();
        switch (pick(5)) {
        case 0: FrameRect(&r); break;
        case 1: PaintOval(&r); break;
        case 2: InvertRect(&r); break;
        case 3: MoveTo(r.left, r.top), LineTo(r.right, r.bottom); break;
        default: PenSize(SInt16(pick(6)), SInt16(pick(6))); break;
        }
    }

    void regionStep()
    {
        if (regions.size() < 2 || (regions.size() < 8 && pick(4) == 0))
            return regions.push_back(NewRgn());
        using Call = void (*)(RgnHandle, RgnHandle, RgnHandle);
        static const Call kAlgebra[] = {UnionRgn, SectRgn, DiffRgn, XorRgn};
        const Rect r = rect();
        switch (pick(4)) {
        case 0: RectRgn(any(regions), &r); break;
        case 1: kAlgebra[pick(4)](any(regions), any(regions), any(regions)); break;
        case 2: OffsetRgn(any(regions), SInt16(pick(40) - 20), SInt16(pick(40) - 20)); break;
        default: DisposeRgn(takeAny(regions)); break;
        }
    }

    void queueStep()
    {
        EventRecord record;
        EventRef event = nullptr;
        switch (pick(5)) {
        case 0: PostEvent(keyDown, 0x61); break; // refused when the queue is full
        case 1: GetNextEvent(keyDownMask, &record); break;
        case 2:
            QCOMPARE(MacCreateEvent(nullptr, kSoakClass, UInt32(pick(3)), 0, 0, &event), noErr);
            PostEventToQueue(GetMainEventQueue(), event, 0);
            ReleaseEvent(event);
            break;
        case 3:
            if ((event = FindSpecificEventInQueue(GetMainEventQueue(), isOurs, nullptr)))
                QCOMPARE(RemoveEventFromQueue(GetMainEventQueue(), event), noErr);
            break;
        default: FlushSpecificEventsFromQueue(GetMainEventQueue(), isOurs, nullptr); break;
        }
    }

    void handlerStep()
    {
        if (handlers.empty() || (handlers.size() < 6 && pick(2) == 0)) {
            const EventTypeSpec type{kSoakClass, 7};
            EventHandlerRef ref = nullptr;
            QCOMPARE(InstallEventHandler(GetApplicationEventTarget(), handler, 1, &type, nullptr, &ref), noErr);
            handlers.push_back(ref);
        } else if (pick(3) == 0) {
            QCOMPARE(RemoveEventHandler(takeAny(handlers)), noErr);
        }
        EventRef event = nullptr;
        MacCreateEvent(nullptr, kSoakClass, 7, 0, 0, &event);
        SendEventToEventTarget(event, GetApplicationEventTarget());
        ReleaseEvent(event);
    }

    void timerStep()
    {
        if (timers.size() < 4 && pick(2) == 0) {
            EventLoopTimerRef timer = nullptr;
            QCOMPARE(InstallEventLoopTimer(GetMainEventLoop(), pick(3) * 0.001, pick(2) * 0.002,
                         [](EventLoopTimerRef, void*) {}, nullptr, &timer), noErr);
            timers.push_back(timer);
        } else if (!timers.empty()) {
            QCOMPARE(RemoveEventLoopTimer(takeAny(timers)), noErr);
        }
        QCoreApplication::processEvents();
    }

    // Windows come and go, move, grow and redraw.
    void windowStep()
    {
        if (windows.size() < 4 && (windows.empty() || pick(3) == 0)) {
            static const SInt16 kProcIds[] = {0, 1, 2, 3, 4, 5, 8, 16};
            const Rect bounds{SInt16(60 + pick(200)), SInt16(pick(300)), SInt16(60 + pick(500)), SInt16(pick(600))};
            windows.push_back(NewCWindow(nullptr, &bounds, VelmarTest::P("\x04soak"), Boolean(pick(4) != 0),
                kProcIds[pick(8)], reinterpret_cast<AQtWindow*>(-1), true, nullptr));
            QVERIFY(windows.back());
            return;
        }
        if (pick(4) == 0)
            return DisposeWindow(takeAny(windows));
        WindowRef w = any(windows);
        const Rect r = rect();
        EventRecord update;
        switch (pick(5)) {
        case 0: SelectWindow(w); break;
        case 1: SizeWindow(w, SInt16(pick(1200) - 100), SInt16(pick(1200) - 100), true); break;
        case 2: MoveWindow(w, coord(2000), coord(2000), Boolean(pick(2))); break;
        case 3:
            InvalWindowRect(w, &r);
            if (GetNextEvent(updateMask, &update))
                BeginUpdate(update.window), EndUpdate(update.window);
            break;
        default: SetPortWindowPort(w), PaintRect(&r), SetPort(world); break;
        }
    }

    void step()
    {
        ++steps;
        const std::function<void()> kinds[] = {[this] { draw(); }, [this] { regionStep(); },
            [this] { queueStep(); }, [this] { handlerStep(); }, [this] { timerStep(); },
            [this] { windowStep(); }};
        kinds[pick(6)]();
    }

    void disposeWindows()
    {
        for (WindowRef w : windows)
            DisposeWindow(w);
        windows.clear();
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    }

    void tearDown()
    {
        disposeWindows();
        for (RgnHandle r : regions)
            DisposeRgn(r);
        for (EventHandlerRef ref : handlers)
            RemoveEventHandler(ref);
        for (EventLoopTimerRef timer : timers)
            RemoveEventLoopTimer(timer);
        FlushEvents(everyEvent, 0);
    }
};

} // namespace

class tst_Soak : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void randomCalls()
    {
        const quint32 seed = qEnvironmentVariableIsSet("VELMAR_SOAK_SEED")
            ? qEnvironmentVariable("VELMAR_SOAK_SEED").toUInt()
            : QRandomGenerator::global()->generate();
        const int seconds = qEnvironmentVariableIsSet("VELMAR_SOAK_SECONDS")
            ? qEnvironmentVariableIntValue("VELMAR_SOAK_SECONDS")
            : 10;
        qInfo("soak seed %u for %d s (replay with VELMAR_SOAK_SEED=%u)", seed, seconds, seed);

        Soak soak(seed);
        const Rect bounds{0, 0, 128, 128};
        QCOMPARE(NewGWorld(&soak.world, 32, &bounds, nullptr, nullptr, 0), SInt16(noErr));
        SetPort(soak.world);

        QElapsedTimer clock;
        clock.start();
        const qint64 total = qint64(seconds) * 1000;
        long warm = -1;
        while (clock.elapsed() < total) {
            soak.step();
            if (QTest::currentTestFailed()) {
                qWarning("failed at step %u of seed %u", soak.steps, seed);
                break;
            }
            // Measured with no window open: their back buffers come and go in megabytes. Half
            // way, not sooner: on a loaded machine the first third runs too few steps to warm
            // the font and image caches.
            if (warm < 0 && clock.elapsed() > total / 2) {
                soak.disposeWindows();
                warm = residentKiB();
            }
        }
        soak.tearDown();
        const long end = residentKiB();
        SetPort(nullptr);
        DisposeGWorld(soak.world);
        qInfo(
            "%u steps; resident %ld KiB after warm-up, %ld KiB at the end", soak.steps, warm, end);
        // Every handle is reused, so after warm-up memory may wobble but must not climb.
        if (kMemoryMeasurable && warm > 0 && end > 0)
            QVERIFY2(end - warm < 8 * 1024,
                qPrintable(QStringLiteral("grew %1 KiB after warm-up").arg(end - warm)));
    }
};

VELMAR_TEST_MAIN(tst_Soak)
#include "tst_soak.moc"
