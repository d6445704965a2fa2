// What every benchmark program shares: the application it runs under, the offscreen world and
// the raw-Qt canvas the "QD/<case>" and "Qt/<case>" pairs draw on.
#pragma once

#include <Velmar/HostCore.h>
#include <Velmar/QtGrafPort.h>
#include <Velmar/QuickDraw.h>

#include <QApplication>
#include <QImage>
#include <QPainter>

#include <benchmark/benchmark.h>

namespace VelmarBench {

constexpr int kWidth = 800;
constexpr int kHeight = 600;

// A kWidth x kHeight 32-bit offscreen world, current while it lives.
class BenchWorld {
public:
    BenchWorld()
    {
        const Rect bounds{0, 0, kHeight, kWidth};
        Velmar::NewGWorld(&m_port, 32, &bounds, nullptr, nullptr, 0);
        Velmar::SetPort(m_port);
    }
    ~BenchWorld()
    {
        Velmar::SetPort(nullptr);
        Velmar::DisposeGWorld(m_port);
    }
    BenchWorld(const BenchWorld&) = delete;
    BenchWorld& operator=(const BenchWorld&) = delete;

    Velmar::GrafPtr port() const { return m_port; }

private:
    Velmar::GrafPtr m_port = nullptr;
};

// The raw-Qt side: a painter on a white image of the same size and format, with the pen a
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
    const QImage& image() const { return m_image; }

private:
    QImage m_image;
    QPainter m_painter;
};

// Calls that warn through an assertion dialog (ten thousand live events, say) get
// "Ignore All", so that no benchmark ever waits on a box.
class IgnoreAssertions : public Velmar::AutomationListener {
public:
    QString AnswerDialog(const QString&, const QString&, const QString&) override
    {
        return QStringLiteral("Ignore All");
    }
};

// Runs the registered benchmarks under a QApplication (event calls ask it for the mouse and
// the modifiers). Without a display and a chosen platform, the offscreen one is used.
inline int runBenchmarks(int argc, char** argv)
{
    if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM") && qEnvironmentVariableIsEmpty("DISPLAY"))
        qputenv("QT_QPA_PLATFORM", "offscreen");
    QApplication app(argc, argv);
    // Kept to the very end of the process: warnings may come while statics are torn down.
    Velmar::AutomationListenerManager::SetListener(new IgnoreAssertions);
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv))
        return 1;
    benchmark::RunSpecifiedBenchmarks();
    benchmark::Shutdown();
    return 0;
}

} // namespace VelmarBench

#define VELMAR_BENCHMARK_MAIN()                                                             \
    int main(int argc, char** argv)                                                         \
    {                                                                                       \
        return VelmarBench::runBenchmarks(argc, argv);                                      \
    }
