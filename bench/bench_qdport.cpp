// Ports, pens and patterns against raw Qt: each "QD/<case>" does through the Toolbox calls
// what its "Qt/<case>" baseline does with a QPainter on a QImage of the same size.
#include "BenchSupport.h"

#include <Velmar/QDShapes.h>

#include "foundation/Conversions.h"

#include <QPixmap>

using namespace Velmar;
using VelmarBench::BenchWorld;
using VelmarBench::kHeight;
using VelmarBench::kWidth;

namespace {

constexpr int kSide = 32;

// Rectangles walk over the whole world so that neither side profits from one hot spot.
struct Walk {
    int i = 0;
    QRect next()
    {
        const int x = (i * 37) % (kWidth - kSide);
        const int y = (i * 23) % (kHeight - kSide);
        ++i;
        return QRect(x, y, kSide, kSide);
    }
};

// The world in the colours the Qt side paints with.
struct InkedWorld : BenchWorld {
    InkedWorld()
    {
        const RGBColor ink(0x1000, 0x8000, 0xF000);
        const RGBColor paper(0xFFFF, 0xF000, 0x2000);
        RGBForeColor(&ink);
        RGBBackColor(&paper);
    }
};

// The 8x8 two-colour texture the pattern case paints with on the Qt side.
QPixmap grayTexture()
{
    QImage texture(8, 8, QImage::Format_ARGB32_Premultiplied);
    for (int y = 0; y < 8; ++y)
        for (int x = 0; x < 8; ++x)
            texture.setPixel(x, y, ((x + y) & 1) ? qRgb(16, 128, 240) : qRgb(255, 240, 32));
    return QPixmap::fromImage(texture);
}

void qdRects(benchmark::State& state, void (*draw)(const Rect*), bool pattern)
{
    InkedWorld world;
    if (pattern)
        PenPat(GetQDGlobalsGray(nullptr));
    Walk walk;
    for (auto _ : state) {
        const Rect r = Private::toRect(walk.next());
        draw(&r);
    }
    benchmark::DoNotOptimize(world.port()->image()->constBits());
}

void qtRects(benchmark::State& state, const QBrush& brush)
{
    VelmarBench::QtCanvas canvas;
    Walk walk;
    for (auto _ : state)
        canvas.painter().fillRect(walk.next(), brush);
    canvas.painter().end();
    benchmark::DoNotOptimize(canvas.image().constBits());
}

void QD_PaintRect32(benchmark::State& state)
{
    qdRects(state, PaintRect, false);
}

void Qt_PaintRect32(benchmark::State& state)
{
    qtRects(state, QBrush(QColor(16, 128, 240)));
}

void QD_EraseRect32(benchmark::State& state)
{
    qdRects(state, EraseRect, false);
}

void Qt_EraseRect32(benchmark::State& state)
{
    qtRects(state, QBrush(QColor(255, 240, 32)));
}

void QD_PaintRectPattern32(benchmark::State& state)
{
    qdRects(state, PaintRect, true);
}

void Qt_PaintRectPattern32(benchmark::State& state)
{
    qtRects(state, QBrush(grayTexture()));
}

// State changes run with the painter active, as they do between drawing calls.
void QD_SetPort(benchmark::State& state)
{
    InkedWorld a;
    InkedWorld b;
    const GrafPtr ports[2] = {a.port(), b.port()};
    int i = 0;
    for (auto _ : state)
        SetPort(ports[++i & 1]);
}

void QD_PenSize(benchmark::State& state)
{
    InkedWorld world;
    const Rect r = Private::makeRect(0, 0, 1, 1);
    PaintRect(&r);
    SInt16 size = 1;
    for (auto _ : state) {
        size = SInt16(3 - size); // 1, 2, 1, ...: every call changes the pen
        PenSize(size, size);
    }
}

void QD_RGBForeColor(benchmark::State& state)
{
    InkedWorld world;
    const Rect r = Private::makeRect(0, 0, 1, 1);
    PaintRect(&r);
    const RGBColor colours[2] = {RGBColor(0xFFFF, 0, 0), RGBColor(0, 0, 0xFFFF)};
    int i = 0;
    for (auto _ : state)
        RGBForeColor(&colours[++i & 1]);
}

} // namespace

BENCHMARK(QD_PaintRect32)->Name("QD/PaintRect32");
BENCHMARK(Qt_PaintRect32)->Name("Qt/PaintRect32");
BENCHMARK(QD_EraseRect32)->Name("QD/EraseRect32");
BENCHMARK(Qt_EraseRect32)->Name("Qt/EraseRect32");
BENCHMARK(QD_PaintRectPattern32)->Name("QD/PaintRectPattern32");
BENCHMARK(Qt_PaintRectPattern32)->Name("Qt/PaintRectPattern32");
BENCHMARK(QD_SetPort)->Name("QD/SetPort");
BENCHMARK(QD_PenSize)->Name("QD/PenSize");
BENCHMARK(QD_RGBForeColor)->Name("QD/RGBForeColor");

VELMAR_BENCHMARK_MAIN()
