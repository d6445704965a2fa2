// Icons per call as a host draws them: GetCIcon of an icon whose PNG is cached, PlotCIcon and
// ReleaseResource, against QPainter::drawImage of the same image.
#include "BenchSupport.h"

#include <Velmar/QDIcons.h>
#include <Velmar/Resources.h>

#include <QResource>

using namespace Velmar;

namespace {

constexpr SInt16 kIcon = 128; // a 32x32 'cicn' of the fixture tree

bool registerFixtures()
{
    static const bool sOk = QResource::registerResource(QStringLiteral(VELMAR_RESOURCE_FIXTURES));
    return sOk;
}

Rect walk(int i)
{
    const SInt16 x = SInt16((i * 37) % 700), y = SInt16((i * 23) % 500);
    return Rect{y, x, SInt16(y + 32), SInt16(x + 32)};
}

void QD_IconPlot(benchmark::State& state)
{
    if (!registerFixtures()) {
        state.SkipWithError("no resource fixtures");
        return;
    }
    VelmarBench::BenchWorld world;
    ReleaseResource(GetCIcon(kIcon)); // the PNG is now in the cache
    int i = 0;
    for (auto _ : state) {
        const Rect r = walk(++i);
        ResourceHandle icon = GetCIcon(kIcon);
        PlotCIcon(&r, icon);
        ReleaseResource(icon);
    }
}

void Qt_IconPlot(benchmark::State& state)
{
    if (!registerFixtures()) {
        state.SkipWithError("no resource fixtures");
        return;
    }
    const QImage image(MakeImageResourceName(FOUR_CHAR_CODE("cicn"), kIcon));
    VelmarBench::QtCanvas canvas;
    int i = 0;
    for (auto _ : state) {
        const Rect r = walk(++i);
        canvas.painter().drawImage(QPoint(r.left, r.top), image);
    }
}

} // namespace

BENCHMARK(QD_IconPlot)->Name("QD/IconGetPlotRelease");
BENCHMARK(Qt_IconPlot)->Name("Qt/IconGetPlotRelease");

VELMAR_BENCHMARK_MAIN()
