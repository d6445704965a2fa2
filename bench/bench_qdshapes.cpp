// Shape and region drawing against raw Qt doing the same work on an image of the same size:
// "QD/<case>" is the QuickDraw call on an 800x600 offscreen world, "Qt/<case>" the QPainter
// baseline in the same process.
#include <Velmar/QDRegions.h>
#include <Velmar/QDShapes.h>
#include <Velmar/QtGrafPort.h>
#include <Velmar/QuickDraw.h>

#include <QGuiApplication>
#include <QImage>
#include <QPainter>
#include <QRegion>

#include <benchmark/benchmark.h>

using namespace Velmar;

namespace {

constexpr int kWidth = 800;
constexpr int kHeight = 600;

// An 800x600 offscreen world, current while it lives.
class BenchWorld {
public:
    BenchWorld()
    {
        const Rect bounds{0, 0, kHeight, kWidth};
        NewGWorld(&m_port, 32, &bounds, nullptr, nullptr, 0);
        SetPort(m_port);
    }
    ~BenchWorld()
    {
        SetPort(nullptr);
        DisposeGWorld(m_port);
    }

private:
    GrafPtr m_port = nullptr;
};

// The raw-Qt side: a painter on an image of the same size and format, with the pen a
// QuickDraw port starts with.
class QtCanvas {
public:
    QtCanvas() : m_image(kWidth, kHeight, QImage::Format_ARGB32_Premultiplied)
    {
        m_image.fill(Qt::white);
        m_painter.begin(&m_image);
        m_painter.setPen(QPen(Qt::black, 1.0, Qt::SolidLine, Qt::SquareCap, Qt::BevelJoin));
        m_painter.setBrush(Qt::NoBrush);
    }
    QPainter& painter() { return m_painter; }

private:
    QImage m_image;
    QPainter m_painter;
};

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

} // namespace

int main(int argc, char** argv)
{
    if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM"))
        qputenv("QT_QPA_PLATFORM", "offscreen");
    QGuiApplication app(argc, argv);
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv))
        return 1;
    benchmark::RunSpecifiedBenchmarks();
    benchmark::Shutdown();
    return 0;
}
