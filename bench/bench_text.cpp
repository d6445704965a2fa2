// Text against raw Qt: DrawString of a 20-character Pascal string (encoding conversion
// included) against QPainter::drawText of the same QString, StringWidth against
// QFontMetrics::horizontalAdvance, and the cost of switching fonts.
#include "BenchSupport.h"

#include <Velmar/QDShapes.h>
#include <Velmar/QDText.h>

#include <QFontMetrics>

#include <vector>

using namespace Velmar;
using VelmarBench::BenchWorld;

namespace {

const unsigned char kPascal[] = "\x14Twenty characters ab";
const QString kText = QStringLiteral("Twenty characters ab");

// The font the port draws with after TextFont(geneva) / TextSize(12) / TextFace(0).
QFont genevaFont()
{
    return TxFontSizeFaceToQFont(geneva, 12, 0, false);
}

struct TextWorld : BenchWorld {
    TextWorld()
    {
        TextFont(geneva, false);
        TextSize(12, false);
        TextFace(0, false);
    }
};

// Lines walk down and across the world so that neither side profits from one hot spot.
QPoint walk(int i)
{
    return QPoint(10 + (i * 37) % 500, 20 + (i * 23) % 560);
}

void QD_DrawString20(benchmark::State& state)
{
    TextWorld world;
    int i = 0;
    for (auto _ : state) {
        const QPoint at = walk(++i);
        MoveTo(SInt16(at.x()), SInt16(at.y()));
        DrawString(kPascal);
    }
    benchmark::DoNotOptimize(world.port()->image()->constBits());
}

void Qt_DrawString20(benchmark::State& state)
{
    VelmarBench::QtCanvas canvas;
    canvas.painter().setFont(genevaFont());
    int i = 0;
    for (auto _ : state)
        canvas.painter().drawText(walk(++i), kText);
    canvas.painter().end();
    benchmark::DoNotOptimize(canvas.image().constBits());
}

void QD_StringWidth20(benchmark::State& state)
{
    TextWorld world;
    for (auto _ : state)
        benchmark::DoNotOptimize(StringWidth(kPascal));
}

void Qt_StringWidth20(benchmark::State& state)
{
    const QFontMetrics metrics(genevaFont());
    for (auto _ : state)
        benchmark::DoNotOptimize(metrics.horizontalAdvance(kText));
}

// Texts never measured before (more of them than the width cache keeps): the shaping
// itself, with the encoding conversion on the Toolbox side.
constexpr int kFreshTexts = 20000;

QByteArray freshPascal(int i)
{
    const QByteArray text =
        QByteArray("Fresh characters ") + QByteArray::number(100 + i % kFreshTexts);
    return char(text.size()) + text;
}

void QD_StringWidthFresh20(benchmark::State& state)
{
    TextWorld world;
    std::vector<QByteArray> texts;
    for (int i = 0; i < kFreshTexts; ++i)
        texts.push_back(freshPascal(i));
    int i = 0;
    for (auto _ : state)
        benchmark::DoNotOptimize(StringWidth(
            reinterpret_cast<const unsigned char*>(texts[size_t(++i % kFreshTexts)].constData())));
}

void Qt_StringWidthFresh20(benchmark::State& state)
{
    const QFontMetrics metrics(genevaFont());
    std::vector<QString> texts;
    for (int i = 0; i < kFreshTexts; ++i)
        texts.push_back(QString::fromLatin1(freshPascal(i).mid(1)));
    int i = 0;
    for (auto _ : state)
        benchmark::DoNotOptimize(metrics.horizontalAdvance(texts[size_t(++i % kFreshTexts)]));
}

// Two fonts in turn, as a host drawing labels and values does.
void QD_FontSwitch(benchmark::State& state)
{
    TextWorld world;
    DrawString(kPascal); // the painter runs, as it does between drawing calls
    int i = 0;
    for (auto _ : state) {
        const bool odd = ++i & 1;
        TextFont(odd ? monaco : geneva, false);
        TextSize(odd ? 10 : 12, false);
        TextFace(odd ? bold : normal, false);
    }
}

} // namespace

BENCHMARK(QD_DrawString20)->Name("QD/DrawString20");
BENCHMARK(Qt_DrawString20)->Name("Qt/DrawString20");
BENCHMARK(QD_StringWidth20)->Name("QD/StringWidth20");
BENCHMARK(Qt_StringWidth20)->Name("Qt/StringWidth20");
BENCHMARK(QD_StringWidthFresh20)->Name("QD/StringWidthFresh20");
BENCHMARK(Qt_StringWidthFresh20)->Name("Qt/StringWidthFresh20");
BENCHMARK(QD_FontSwitch)->Name("Text/FontSwitch");

VELMAR_BENCHMARK_MAIN()
