// Ports, pens and patterns against raw Qt: each "QD/<case>" does through the Toolbox calls
// what its "Qt/<case>" baseline does with a QPainter on a QImage of the same size.
#include <Velmar/QDShapes.h>
#include <Velmar/QtGrafPort.h>
#include <Velmar/QuickDraw.h>

#include "foundation/Conversions.h"

#include <QGuiApplication>
#include <QImage>
#include <QPainter>
#include <QPixmap>

#include <benchmark/benchmark.h>

#include <cstdlib>

using namespace Velmar;

namespace {

constexpr int kWidth = 800;
constexpr int kHeight = 600;
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

GrafPtr newWorld()
{
    const Rect r = Private::makeRect(0, 0, kWidth, kHeight);
    GrafPtr world = nullptr;
    NewGWorld(&world, 32, &r, nullptr, nullptr, 0);
    SetPort(world);
    const RGBColor ink(0x1000, 0x8000, 0xF000);
    const RGBColor paper(0xFFFF, 0xF000, 0x2000);
    RGBForeColor(&ink);
    RGBBackColor(&paper);
    return world;
}

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
    GrafPtr world = newWorld();
    if (pattern)
        PenPat(GetQDGlobalsGray(nullptr));
    Walk walk;
    for (auto _ : state) {
        const Rect r = Private::toRect(walk.next());
        draw(&r);
    }
    benchmark::DoNotOptimize(world->image()->constBits());
    DisposeGWorld(world);
}

void qtRects(benchmark::State& state, const QBrush& brush)
{
    QImage image(kWidth, kHeight, QImage::Format_ARGB32_Premultiplied);
    image.fill(Qt::white);
    QPainter painter(&image);
    Walk walk;
    for (auto _ : state)
        painter.fillRect(walk.next(), brush);
    painter.end();
    benchmark::DoNotOptimize(image.constBits());
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
    GrafPtr a = newWorld();
    GrafPtr b = newWorld();
    const GrafPtr ports[2] = {a, b};
    int i = 0;
    for (auto _ : state)
        SetPort(ports[++i & 1]);
    DisposeGWorld(a);
    DisposeGWorld(b);
}

void QD_PenSize(benchmark::State& state)
{
    GrafPtr world = newWorld();
    const Rect r = Private::makeRect(0, 0, 1, 1);
    PaintRect(&r);
    SInt16 size = 1;
    for (auto _ : state) {
        size = SInt16(3 - size); // 1, 2, 1, ...: every call changes the pen
        PenSize(size, size);
    }
    DisposeGWorld(world);
}

void QD_RGBForeColor(benchmark::State& state)
{
    GrafPtr world = newWorld();
    const Rect r = Private::makeRect(0, 0, 1, 1);
    PaintRect(&r);
    const RGBColor colours[2] = {RGBColor(0xFFFF, 0, 0), RGBColor(0, 0, 0xFFFF)};
    int i = 0;
    for (auto _ : state)
        RGBForeColor(&colours[++i & 1]);
    DisposeGWorld(world);
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

int main(int argc, char** argv)
{
    if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM") && qEnvironmentVariableIsEmpty("DISPLAY"))
        qputenv("QT_QPA_PLATFORM", "offscreen");
    QGuiApplication app(argc, argv);
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv))
        return 1;
    benchmark::RunSpecifiedBenchmarks();
    benchmark::Shutdown();
    return 0;
}
