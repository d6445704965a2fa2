// Shape and region drawing against raw Qt doing the same work on an image of the same size:
// "QD/<case>" is the QuickDraw call on an 800x600 offscreen world, "Qt/<case>" the QPainter
// baseline in the same process.
#include "BenchSupport.h"

#include <Velmar/QDRegions.h>
#include <Velmar/QDShapes.h>

#include <QRegion>

using namespace Velmar;
using VelmarBench::BenchWorld;
using VelmarBench::QtCanvas;

namespace {

// Fifty disjoint 30x30 squares in a 10x5 grid.
QRegion fiftyRects()
{
    QRegion r;
    for (int i = 0; i < 50; ++i)
        r += QRect(20 + (i % 10) * 75, 20 + (i / 10) * 110, 30, 30);
    return r;
}

const Rect kFrame{100, 100, 300, 400};

void QD_FrameRect1px(benchmark::State& state)
{
    BenchWorld world;
    for (auto _ : state)
        FrameRect(&kFrame);
}
BENCHMARK(QD_FrameRect1px)->Name("QD/FrameRect1px");

void Qt_FrameRect1px(benchmark::State& state)
{
    QtCanvas canvas;
    const QRect r(QPoint(kFrame.left, kFrame.top), QPoint(kFrame.right - 2, kFrame.bottom - 2));
    for (auto _ : state)
        canvas.painter().drawRect(r);
}
BENCHMARK(Qt_FrameRect1px)->Name("Qt/FrameRect1px");

// Two segments per iteration, so that the pen ends where it started.
void QD_LineTo(benchmark::State& state)
{
    BenchWorld world;
    MoveTo(10, 10);
    for (auto _ : state) {
        LineTo(700, 500);
        LineTo(10, 10);
    }
}
BENCHMARK(QD_LineTo)->Name("QD/LineTo");

void Qt_LineTo(benchmark::State& state)
{
    QtCanvas canvas;
    for (auto _ : state) {
        canvas.painter().drawLine(10, 10, 700, 500);
        canvas.painter().drawLine(700, 500, 10, 10);
    }
}
BENCHMARK(Qt_LineTo)->Name("Qt/LineTo");

void QD_PaintRgn50(benchmark::State& state)
{
    BenchWorld world;
    RgnHandle rgn = NewRgn();
    *rgn = fiftyRects();
    for (auto _ : state)
        PaintRgn(rgn);
    DisposeRgn(rgn);
}
BENCHMARK(QD_PaintRgn50)->Name("QD/PaintRgn50");

void Qt_PaintRgn50(benchmark::State& state)
{
    QtCanvas canvas;
    const QRegion rgn = fiftyRects();
    const QRect bounds = rgn.boundingRect();
    for (auto _ : state) {
        canvas.painter().setClipRegion(rgn);
        canvas.painter().fillRect(bounds, Qt::black);
    }
}
BENCHMARK(Qt_PaintRgn50)->Name("Qt/PaintRgn50");

// Region algebra on two small regions: where checking the handles would show if it cost.
const QRegion kSmallA = QRegion(10, 10, 40, 40) + QRegion(60, 10, 20, 20);
const QRegion kSmallB = QRegion(30, 30, 40, 40);

void QD_UnionRgn(benchmark::State& state)
{
    RgnHandle a = NewRgn(), b = NewRgn(), sum = NewRgn();
    *a = kSmallA;
    *b = kSmallB;
    for (auto _ : state)
        UnionRgn(a, b, sum);
    DisposeRgn(a);
    DisposeRgn(b);
    DisposeRgn(sum);
}
BENCHMARK(QD_UnionRgn)->Name("QD/UnionRgn");

void Qt_UnionRgn(benchmark::State& state)
{
    QRegion sum;
    for (auto _ : state)
        benchmark::DoNotOptimize(sum = kSmallA.united(kSmallB));
}
BENCHMARK(Qt_UnionRgn)->Name("Qt/UnionRgn");

// Recording the largest oval the 16-bit plane holds (65535 rows).
void RecordFullPlaneOval(benchmark::State& state)
{
    BenchWorld world;
    const Rect full{-32768, -32768, 32767, 32767};
    RgnHandle rgn = NewRgn();
    for (auto _ : state) {
        OpenRgn();
        FrameOval(&full);
        CloseRgn(rgn);
    }
    DisposeRgn(rgn);
}
BENCHMARK(RecordFullPlaneOval)->Name("Regions/RecordFullPlaneOval")->Unit(benchmark::kMillisecond);

} // namespace

VELMAR_BENCHMARK_MAIN()
