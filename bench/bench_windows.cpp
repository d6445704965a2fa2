// Windows: the classic update cycle against a plain QWidget repaint of the same area, the copy
// from the back buffer to the screen against a memcpy of the same bytes, and what one open
// window costs in memory.
#include "BenchSupport.h"

#include <Velmar/AQtWindow.h>
#include <Velmar/Windows.h>

#include <QPaintEvent>
#include <QWidget>

#include <cstring>
#include <fstream>
#include <vector>

using namespace Velmar;

namespace {

// A window of kWidth x kHeight, shown and current.
class BenchWindow {
public:
    BenchWindow()
    {
        const Rect bounds{50, 50, SInt16(50 + VelmarBench::kHeight), SInt16(50 + VelmarBench::kWidth)};
        CreateNewWindow(kDocumentWindowClass, 0, &bounds, &m_window);
        ShowWindow(m_window);
        QCoreApplication::processEvents();
        SetPortWindowPort(m_window);
    }
    ~BenchWindow() { DisposeWindow(m_window); QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete); }
    WindowRef get() const { return m_window; }

private:
    WindowRef m_window;
};

// What a double-buffered Qt widget does instead: keep an image and copy the asked-for area
// of it to the screen in its paint event.
class BufferedWidget : public QWidget {
public:
    BufferedWidget() : m_buffer(VelmarBench::kWidth, VelmarBench::kHeight, QImage::Format_ARGB32_Premultiplied)
    {
        m_buffer.fill(Qt::white);
        setAttribute(Qt::WA_OpaquePaintEvent);
        resize(VelmarBench::kWidth, VelmarBench::kHeight);
        show();
        QCoreApplication::processEvents();
    }
    void paintEvent(QPaintEvent* e) override
    {
        QPainter p(this);
        p.setCompositionMode(QPainter::CompositionMode_Source);
        p.drawImage(e->rect(), m_buffer, e->rect());
    }

private:
    QImage m_buffer;
};

// The library's part of one classic update: the window is invalidated, the host brackets its
// drawing with BeginUpdate and EndUpdate, and EndUpdate puts the back buffer on the screen.
// The host's own drawing is left out: it costs the same either way.
void updateCycle(benchmark::State& state, const Rect& area)
{
    BenchWindow window;
    for (auto _ : state) {
        InvalWindowRect(window.get(), &area);
        BeginUpdate(window.get());
        window.get()->markGrafPortDirty(QRect(area.left, area.top, area.right - area.left,
                                              area.bottom - area.top));
        EndUpdate(window.get());
    }
}

void QD_UpdateCycle32(benchmark::State& state)
{
    updateCycle(state, Rect{100, 100, 132, 132});
}
BENCHMARK(QD_UpdateCycle32)->Name("QD/UpdateCycle32");

void Qt_UpdateCycle32(benchmark::State& state)
{
    BufferedWidget widget;
    for (auto _ : state)
        widget.repaint(100, 100, 32, 32);
}
BENCHMARK(Qt_UpdateCycle32)->Name("Qt/UpdateCycle32");

void QD_UpdateCycleWindow(benchmark::State& state)
{
    updateCycle(state, Rect{0, 0, SInt16(VelmarBench::kHeight), SInt16(VelmarBench::kWidth)});
}
BENCHMARK(QD_UpdateCycleWindow)->Name("QD/UpdateCycleWindow");

void Qt_UpdateCycleWindow(benchmark::State& state)
{
    BufferedWidget widget;
    for (auto _ : state)
        widget.repaint();
}
BENCHMARK(Qt_UpdateCycleWindow)->Name("Qt/UpdateCycleWindow");

// The copy of the whole back buffer to the screen (a flush of a fully dirty window)...
void QD_FlushWindow(benchmark::State& state)
{
    BenchWindow window;
    for (auto _ : state) {
        window.get()->markGrafPortDirty(QRect(0, 0, VelmarBench::kWidth, VelmarBench::kHeight));
        window.get()->flushDirtyPort(true);
    }
    state.SetBytesProcessed(state.iterations() * VelmarBench::kWidth * VelmarBench::kHeight * 4);
}
BENCHMARK(QD_FlushWindow)->Name("QD/FlushWindow");

// ...against the memory bandwidth of copying the same bytes.
void Qt_FlushWindow(benchmark::State& state)
{
    const std::size_t bytes = std::size_t(VelmarBench::kWidth) * VelmarBench::kHeight * 4;
    std::vector<char> from(bytes, 1), to(bytes);
    for (auto _ : state) {
        std::memcpy(to.data(), from.data(), bytes);
        benchmark::DoNotOptimize(to.data());
    }
    state.SetBytesProcessed(state.iterations() * qint64(bytes));
}
BENCHMARK(Qt_FlushWindow)->Name("Qt/FlushWindow");

long residentKiB()
{
    std::ifstream status("/proc/self/status");
    std::string key;
    while (status >> key) {
        if (key == "VmRSS:") {
            long kib = 0;
            status >> kib;
            return kib;
        }
    }
    return 0;
}

// One hundred open 800x600 windows: widget, port and back buffer each.
void MemoryPerWindow(benchmark::State& state)
{
    for (auto _ : state) {
        const long before = residentKiB();
        std::vector<std::unique_ptr<BenchWindow>> windows;
        for (int i = 0; i < 100; ++i)
            windows.push_back(std::make_unique<BenchWindow>());
        QCoreApplication::processEvents();
        const long after = residentKiB();
        state.counters["KiB_per_window"] = double(after - before) / 100.0;
        state.counters["back_buffer_KiB"] = VelmarBench::kWidth * VelmarBench::kHeight * 4 / 1024.0;
    }
}
BENCHMARK(MemoryPerWindow)->Name("Windows/MemoryPerWindow")->Iterations(1)->Unit(benchmark::kMillisecond);

} // namespace

VELMAR_BENCHMARK_MAIN()
