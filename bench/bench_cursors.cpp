// Cursors per call as a host sets them on mouse moves: GetCCursor of a cached cursor and
// SetCCursor, two cursors in turn (each call changes the override cursor).
#include "BenchSupport.h"

#include <Velmar/Cursors.h>

using namespace Velmar;

namespace {

void Cursors_GetSetAlternating(benchmark::State& state)
{
    const SInt16 ids[2] = {iBeamCursor, watchCursor};
    SetCCursor(GetCCursor(ids[0])); // cached from here on
    SetCCursor(GetCCursor(ids[1]));
    int i = 0;
    for (auto _ : state)
        SetCCursor(GetCCursor(ids[++i & 1]));
    InitCursor();
}

void Cursors_GetSetSame(benchmark::State& state)
{
    for (auto _ : state)
        SetCCursor(GetCCursor(iBeamCursor));
    InitCursor();
}

} // namespace

BENCHMARK(Cursors_GetSetAlternating)->Name("Cursors/GetCCursorSetCCursorAlternating");
BENCHMARK(Cursors_GetSetSame)->Name("Cursors/GetCCursorSetCCursorSame");

VELMAR_BENCHMARK_MAIN()
