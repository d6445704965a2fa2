// Waiting: what an idle WaitNextEvent costs, GetNextEvent with nothing pending against one
// bare pass of Qt's event processing, the latency from input reaching the application to the
// host holding its record, and posted events through WaitNextEvent per second.
#include "BenchSupport.h"

#include <Velmar/AQtWindow.h>
#include <Velmar/EventWaiting.h>
#include <Velmar/Windows.h>

#include <QElapsedTimer>
#include <QKeyEvent>
#include <QTimer>

#include <ctime>

using namespace Velmar;

namespace {

double processCpuSeconds()
{
    timespec t{};
    clock_gettime(CLOCK_PROCESS_CPUTIME_ID, &t);
    return double(t.tv_sec) + double(t.tv_nsec) / 1e9;
}

// A host blocked in WaitNextEvent with a one-minute sleep for ten seconds of wall time.
void IdleWait(benchmark::State& state)
{
    for (auto _ : state) {
        QTimer::singleShot(10000, [] { PostEvent(kHighLevelEvent, 1); });
        const double cpu = processCpuSeconds();
        QElapsedTimer wall;
        wall.start();
        EventRecord e;
        WaitNextEvent(everyEvent, &e, 3600, nullptr);
        const double used = processCpuSeconds() - cpu;
        state.counters["cpu_percent"] = 100.0 * used / (double(wall.elapsed()) / 1000.0);
    }
}
BENCHMARK(IdleWait)->Name("Waiting/IdleWait10s")->Iterations(1)->Unit(benchmark::kMillisecond);

void QD_GetNextEventEmpty(benchmark::State& state)
{
    EventRecord e;
    for (auto _ : state)
        benchmark::DoNotOptimize(GetNextEvent(everyEvent, &e));
}
BENCHMARK(QD_GetNextEventEmpty)->Name("QD/GetNextEventEmpty");

void Qt_GetNextEventEmpty(benchmark::State& state)
{
    for (auto _ : state)
        QCoreApplication::processEvents();
}
BENCHMARK(Qt_GetNextEventEmpty)->Name("Qt/GetNextEventEmpty");

// A key press posted to a window, as the window system delivers it, to WaitNextEvent's
// record in the host's hands.
void InputLatency(benchmark::State& state)
{
    WindowRef window;
    const Rect bounds{50, 50, 250, 350};
    CreateNewWindow(kDocumentWindowClass, 0, &bounds, &window);
    ShowWindow(window);
    QCoreApplication::processEvents();
    EventRecord e;
    for (auto _ : state) {
        QElapsedTimer clock;
        clock.start();
        QCoreApplication::postEvent(window.get(), new QKeyEvent(QEvent::KeyPress, Qt::Key_A,
                                                                Qt::NoModifier, QStringLiteral("a")));
        if (!WaitNextEvent(keyDownMask, &e, 60, nullptr)) {
            state.SkipWithError("the key never arrived");
            break;
        }
        state.SetIterationTime(double(clock.nsecsElapsed()) / 1e9);
    }
    DisposeWindow(window);
}
BENCHMARK(InputLatency)->Name("Waiting/InputLatency")->UseManualTime()->Unit(benchmark::kMicrosecond);

void PostWaitPairs(benchmark::State& state)
{
    EventRecord e;
    UInt32 n = 0;
    for (auto _ : state) {
        PostEvent(kHighLevelEvent, ++n);
        if (!WaitNextEvent(everyEvent, &e, 60, nullptr) || e.message != n) {
            state.SkipWithError("posted event not received");
            break;
        }
    }
    state.SetItemsProcessed(state.iterations());
}
BENCHMARK(PostWaitPairs)->Name("Waiting/PostWaitPairs");

} // namespace

VELMAR_BENCHMARK_MAIN()
