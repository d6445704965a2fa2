// Cost of running the Carbon handler chain for one event.
#include "events/EventDispatch.h"
#include "events/EventQueueItem.h"

#include <Velmar/CarbonEventHandlers.h>
#include <Velmar/MacErrors.h>

#include <benchmark/benchmark.h>

#include <vector>

using namespace Velmar;

namespace {

OSStatus declining(EventHandlerCallRef, EventRef, void* counter)
{
    ++*static_cast<int*>(counter);
    return eventNotHandledErr;
}

OSStatus taking(EventHandlerCallRef, EventRef, void* counter)
{
    ++*static_cast<int*>(counter);
    return noErr;
}

// Ten dispatcher handlers: nine decline, the oldest takes the event, so every one runs.
void DispatchChain10(benchmark::State& state)
{
    int calls = 0;
    std::vector<EventHandlerRef> refs;
    const EventTypeSpec types[] = {{kEventClassMouse, kEventMouseDown}, {kEventClassMouse, kEventMouseUp}};
    for (int i = 0; i < 10; ++i) {
        EventHandlerRef ref = nullptr;
        InstallEventHandler(GetEventDispatcherTarget(), i == 0 ? taking : declining, 2, types, &calls, &ref);
        refs.push_back(ref);
    }
    Private::EventQueueItemSmartPtr item = Private::EventQueueItemSmartPtr::Create();
    item->eventClass = kEventClassMouse;
    item->eventKind = kEventMouseUp;

    for (auto _ : state)
        benchmark::DoNotOptimize(Private::DispatchEventToCallbacks(item));

    if (calls != 10 * int(state.iterations()))
        state.SkipWithError("chain did not run every handler");
    for (EventHandlerRef ref : refs)
        RemoveEventHandler(ref);
}

} // namespace

BENCHMARK(DispatchChain10)->Name("Events/DispatchChain10");

BENCHMARK_MAIN();
