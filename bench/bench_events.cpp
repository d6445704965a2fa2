// Posting an event and taking it out of the queue again, with a queue already holding N
// other events. The queue is a plain list searched from the front, so the figures show
// how a round trip grows with what waits ahead of it.
#include "BenchSupport.h"

#include "events/EventQueue.h"

#include <Velmar/CarbonEventHandlers.h>
#include <Velmar/Events.h>

using namespace Velmar;
using Private::EventQueueItemSmartPtr;
using Private::gMainEventQueue;

namespace {

constexpr UInt16 kPostedCode = 12; // an application-defined classic code: a 'vlme' event
const EventTypeSpec kPosted[] = {{Private::kEventClassVelmarClassic, kPostedCode}};

// Fills the queue with N mouse-up events that the take has to walk past.
void fillQueue(int n)
{
    gMainEventQueue.clearAll();
    for (int i = 0; i < n; ++i) {
        EventQueueItemSmartPtr item = EventQueueItemSmartPtr::Create();
        item->eventClass = kEventClassMouse;
        item->eventKind = kEventMouseUp;
        Private::ScheduleEvent(item, Private::EventQueueItem::NoMerge);
    }
}

void finish(benchmark::State& state)
{
    state.SetItemsProcessed(state.iterations());
    gMainEventQueue.clearAll();
    QCoreApplication::sendPostedEvents();
}

// PostEvent (time stamp, mouse position, modifiers, schedule) plus the take.
void PostTake(benchmark::State& state)
{
    fillQueue(int(state.range(0)));
    UInt32 message = 0;
    for (auto _ : state) {
        PostEvent(kPostedCode, ++message);
        EventQueueItemSmartPtr taken = gMainEventQueue.takeFirstMatching(kPosted, 1);
        benchmark::DoNotOptimize(taken.get());
        if (!taken || taken->message != message) {
            state.SkipWithError("posted event not taken back");
            break;
        }
    }
    finish(state);
}

// The queue alone: scheduling a ready-made event and taking it back.
void ScheduleTake(benchmark::State& state)
{
    fillQueue(int(state.range(0)));
    EventQueueItemSmartPtr item = EventQueueItemSmartPtr::Create();
    item->eventClass = Private::kEventClassVelmarClassic;
    item->eventKind = kPostedCode;
    for (auto _ : state) {
        Private::ScheduleEvent(item, Private::EventQueueItem::NoMerge);
        EventQueueItemSmartPtr taken = gMainEventQueue.takeFirstMatching(kPosted, 1);
        benchmark::DoNotOptimize(taken.get());
    }
    finish(state);
}

void neverCalled(EventLoopTimerRef, void*) {}

// Installing a timer and removing it again with N other timers pending (an hour away).
void TimerInstallRemove(benchmark::State& state)
{
    std::vector<EventLoopTimerRef> pending(std::size_t(state.range(0)));
    for (EventLoopTimerRef& timer : pending)
        InstallEventLoopTimer(GetMainEventLoop(), 3600, 3600, neverCalled, nullptr, &timer);
    for (auto _ : state) {
        EventLoopTimerRef timer = nullptr;
        InstallEventLoopTimer(GetMainEventLoop(), 3600, 3600, neverCalled, nullptr, &timer);
        RemoveEventLoopTimer(timer);
    }
    for (EventLoopTimerRef timer : pending)
        RemoveEventLoopTimer(timer);
    state.SetItemsProcessed(state.iterations());
}

} // namespace

BENCHMARK(TimerInstallRemove)->Name("Events/TimerInstallRemove")->Arg(0)->Arg(10000);
BENCHMARK(PostTake)->Name("Events/PostTake")->Arg(0)->Arg(100)->Arg(10000);
BENCHMARK(ScheduleTake)->Name("Events/ScheduleTake")->Arg(0)->Arg(100)->Arg(10000);

// Ten thousand queued events pass the live-object warning: the shared main answers it
// without a dialog.
VELMAR_BENCHMARK_MAIN()
