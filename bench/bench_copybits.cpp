// CopyBits per call between two offscreen worlds, against QPainter::drawImage of the same
// rectangle; a copy scaled twice as large; the region of a 256x256 map's marked pixels.
#include "BenchSupport.h"

#include <Velmar/QDBitmaps.h>
#include <Velmar/QDRegions.h>

#include <QRandomGenerator>

using namespace Velmar;

namespace {

constexpr SInt16 kSide = 256;

// A world of `side` pixels square filled with noise, so that no copy can take a shortcut.
GrafPtr noiseWorld(SInt16 side)
{
    GrafPtr world = nullptr;
    const Rect bounds{0, 0, side, side};
    NewGWorld(&world, 32, &bounds, nullptr, nullptr, 0);
    QImage* image = world->image();
    QRandomGenerator random(7);
    for (int y = 0; y < image->height(); ++y) {
        auto* row = reinterpret_cast<QRgb*>(image->scanLine(y));
        for (int x = 0; x < image->width(); ++x)
            row[x] = random.generate() | 0xFF000000u;
    }
    return world;
}

void QD_CopyBits256(benchmark::State& state)
{
    GrafPtr src = noiseWorld(kSide);
    VelmarBench::BenchWorld dst;
    const Rect r{0, 0, kSide, kSide};
    for (auto _ : state)
        CopyBits(GetPortBitMapForCopyBits(src), GetPortBitMapForCopyBits(dst.port()), &r, &r,
                 srcCopy, nullptr);
    DisposeGWorld(src);
}

void Qt_DrawImage256(benchmark::State& state)
{
    GrafPtr src = noiseWorld(kSide);
    const QImage image = *src->image();
    VelmarBench::QtCanvas canvas;
    canvas.painter().setCompositionMode(QPainter::CompositionMode_Source);
    for (auto _ : state)
        canvas.painter().drawImage(QPoint(0, 0), image);
    DisposeGWorld(src);
}

void QD_CopyBitsScaled2x(benchmark::State& state)
{
    GrafPtr src = noiseWorld(kSide);
    VelmarBench::BenchWorld dst;
    const Rect from{0, 0, kSide, kSide}, to{0, 0, 2 * kSide, 2 * kSide};
    for (auto _ : state)
        CopyBits(GetPortBitMapForCopyBits(src), GetPortBitMapForCopyBits(dst.port()), &from,
                 &to, srcCopy, nullptr);
    DisposeGWorld(src);
}

void Qt_DrawImageScaled2x(benchmark::State& state)
{
    GrafPtr src = noiseWorld(kSide);
    const QImage image = *src->image();
    VelmarBench::QtCanvas canvas;
    canvas.painter().setCompositionMode(QPainter::CompositionMode_Source);
    for (auto _ : state)
        canvas.painter().drawImage(QRect(0, 0, 2 * kSide, 2 * kSide), image);
    DisposeGWorld(src);
}

// A one-bit map of scattered blobs: many runs per row, bands that change every few rows.
void QD_BitMapToRegion256(benchmark::State& state)
{
    constexpr int kRowBytes = kSide / 8;
    std::vector<UInt8> bits(std::size_t(kRowBytes) * kSide);
    QRandomGenerator random(3);
    for (int blob = 0; blob < 200; ++blob) {
        const int x0 = int(random.bounded(kSide - 16)), y0 = int(random.bounded(kSide - 16));
        for (int y = y0; y < y0 + 12; ++y)
            for (int x = x0; x < x0 + 12; ++x)
                bits[std::size_t(y * kRowBytes + x / 8)] |= UInt8(0x80 >> (x % 8));
    }
    const BitMap map{reinterpret_cast<Ptr>(bits.data()), kRowBytes, Rect{0, 0, kSide, kSide}};
    RgnHandle region = NewRgn();
    for (auto _ : state) {
        BitMapToRegion(region, &map);
        benchmark::DoNotOptimize(region);
    }
    DisposeRgn(region);
}

} // namespace

BENCHMARK(QD_CopyBits256)->Name("QD/CopyBits256");
BENCHMARK(Qt_DrawImage256)->Name("Qt/CopyBits256");
// Qt's raster engine spreads a large scaled draw over its thread pool: the CPU time that
// counts is the whole process's, not the calling thread's.
BENCHMARK(QD_CopyBitsScaled2x)->Name("QD/CopyBitsScaled2x")->MeasureProcessCPUTime();
BENCHMARK(Qt_DrawImageScaled2x)->Name("Qt/CopyBitsScaled2x")->MeasureProcessCPUTime();
BENCHMARK(QD_BitMapToRegion256)->Name("QD/BitMapToRegion256");

VELMAR_BENCHMARK_MAIN()
