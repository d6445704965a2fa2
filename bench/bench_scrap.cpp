// The scrap against the clipboard it sits on: PutScrapFlavor + GetScrapFlavorData of 1 KB and
// 1 MB of text against QClipboard::setText + text() (the encoding conversions included).
#include "BenchSupport.h"

#include <Velmar/Scrap.h>

#include <QClipboard>

using namespace Velmar;

namespace {

QByteArray text(int size)
{
    QByteArray bytes(size, 'a');
    for (int i = 0; i < size; i += 61)
        bytes[i] = '\r';
    return bytes;
}

void QD_ScrapRoundTrip(benchmark::State& state)
{
    const QByteArray put = text(int(state.range(0)));
    QByteArray got(put.size(), '\0');
    for (auto _ : state) {
        PutScrapFlavor(nullptr, kScrapFlavorTypeText, 0, SInt32(put.size()), put.constData());
        SInt32 size = SInt32(got.size());
        GetScrapFlavorData(nullptr, kScrapFlavorTypeText, &size, got.data());
        benchmark::DoNotOptimize(size);
    }
}

void Qt_ScrapRoundTrip(benchmark::State& state)
{
    const QString put = QString::fromLatin1(text(int(state.range(0))));
    for (auto _ : state) {
        QGuiApplication::clipboard()->setText(put);
        benchmark::DoNotOptimize(QGuiApplication::clipboard()->text().size());
    }
}

} // namespace

BENCHMARK(QD_ScrapRoundTrip)->Name("QD/ScrapRoundTrip")->Arg(1024)->Arg(1 << 20);
BENCHMARK(Qt_ScrapRoundTrip)->Name("Qt/ScrapRoundTrip")->Arg(1024)->Arg(1 << 20);

VELMAR_BENCHMARK_MAIN()
