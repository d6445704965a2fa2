// TextEdit against the Qt widget it sits on: TESetText of 100 KB, TEKey of 1,000 characters
// into a 10 KB record, TEGetOffset on a 1,000-line record. The Qt side does the same directly
// on a QPlainTextEdit of the same size in the same kind of window.
#include "BenchSupport.h"

#include <Velmar/AQtWindow.h>
#include <Velmar/TextEdit.h>
#include <Velmar/Windows.h>

#include <QClipboard>
#include <QGuiApplication>
#include <QKeyEvent>
#include <QPlainTextEdit>

using namespace Velmar;

namespace {

const Rect kView{10, 10, 410, 610};

// A shown window with a record on its port, and a bare QPlainTextEdit beside it.
struct Setup {
    Setup()
    {
        const Rect bounds{50, 50, 500, 700};
        CreateNewWindow(kDocumentWindowClass, 0, &bounds, &window);
        ShowWindow(window);
        SetPortWindowPort(window);
        te = TENew(&kView, &kView);
        plain = new QPlainTextEdit(window.get());
        plain->setGeometry(10, 10, 600, 400);
        plain->setFrameShape(QFrame::NoFrame);
        plain->document()->setDocumentMargin(0);
        plain->show();
        QCoreApplication::processEvents();
    }
    ~Setup()
    {
        TEDispose(te);
        DisposeWindow(window);
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    }
    WindowRef window;
    TEPtr* te = nullptr;
    QPlainTextEdit* plain = nullptr;
};

QByteArray lines(int count, int width)
{
    QByteArray text;
    for (int i = 0; i < count; ++i)
        text += QByteArray(width - 1, char('a' + i % 26)) + '\r';
    return text;
}

void QD_SetText100K(benchmark::State& state)
{
    Setup s;
    const QByteArray text = lines(1600, 64); // 100 KB
    for (auto _ : state)
        TESetText(text.constData(), SInt32(text.size()), s.te);
}

void Qt_SetText100K(benchmark::State& state)
{
    Setup s;
    QByteArray text = lines(1600, 64);
    text.replace('\r', '\n');
    const QString unicode = QString::fromLatin1(text);
    for (auto _ : state)
        s.plain->setPlainText(unicode);
}

void QD_Key1000(benchmark::State& state)
{
    Setup s;
    const QByteArray text = lines(160, 64); // 10 KB
    for (auto _ : state) {
        state.PauseTiming();
        TESetText(text.constData(), SInt32(text.size()), s.te);
        TESetSelect(5000, 5000, s.te);
        state.ResumeTiming();
        for (int i = 0; i < 1000; ++i) {
            const char c = char('a' + i % 26);
            EventRecord e{};
            e.what = keyDown;
            e.message = UInt32(UInt8(c));
            e.textUnit = UInt16(UInt8(c));
            e.qtKey = UInt32(Qt::Key_A + i % 26);
            TEKey(c, s.te, &e);
        }
    }
}

// The Qt side types through the widget's own key handling, as TEKey does.
struct KeyedEdit : QPlainTextEdit {
    using QPlainTextEdit::keyPressEvent;
};

void Qt_Key1000(benchmark::State& state)
{
    Setup s;
    QByteArray text = lines(160, 64);
    text.replace('\r', '\n');
    const QString unicode = QString::fromLatin1(text);
    for (auto _ : state) {
        state.PauseTiming();
        s.plain->setPlainText(unicode);
        QTextCursor at(s.plain->document());
        at.setPosition(5000);
        s.plain->setTextCursor(at);
        state.ResumeTiming();
        for (int i = 0; i < 1000; ++i) {
            QKeyEvent e(
                QEvent::KeyPress, Qt::Key_A + i % 26, Qt::NoModifier, QString(QChar('a' + i % 26)));
            static_cast<KeyedEdit*>(s.plain)->keyPressEvent(&e);
        }
    }
}

void QD_GetOffset1000Lines(benchmark::State& state)
{
    Setup s;
    const QByteArray text = lines(1000, 40);
    TESetText(text.constData(), SInt32(text.size()), s.te);
    int i = 0;
    for (auto _ : state) {
        const Point p{SInt16(10 + (i * 7) % 400), SInt16(10 + (i * 13) % 600)};
        benchmark::DoNotOptimize(TEGetOffset(p, s.te));
        ++i;
    }
}

void Qt_GetOffset1000Lines(benchmark::State& state)
{
    Setup s;
    QByteArray text = lines(1000, 40);
    text.replace('\r', '\n');
    s.plain->setPlainText(QString::fromLatin1(text));
    int i = 0;
    for (auto _ : state) {
        const QPoint p((i * 13) % 600, (i * 7) % 400);
        benchmark::DoNotOptimize(s.plain->cursorForPosition(p).position());
        ++i;
    }
}

// A paste of `state.range(0)` KB of 64-character lines into each kind of record: plain,
// single-line (lines joined into one), no-wrap, and styled.
enum PasteKind { kPlain, kSingleLine, kNoWrap, kStyled };

void QD_Paste(benchmark::State& state)
{
    Setup s;
    const auto kind = PasteKind(state.range(1));
    TEPtr* te = kind == kStyled ? TEStyleNew(&kView, &kView) : TENew(&kView, &kView);
    if (kind == kSingleLine)
        te->setAllowMultipleBlocks(false);
    if (kind == kNoWrap)
        te->SetLineNoWrapMode();
    QByteArray text = lines(int(state.range(0) * 1024 / 64), 64);
    text.replace('\r', '\n');
    QGuiApplication::clipboard()->setText(QString::fromLatin1(text));
    for (auto _ : state) {
        state.PauseTiming();
        TESetText("", 0, te);
        state.ResumeTiming();
        TEPaste(te);
        QCoreApplication::processEvents(); // the layout and the first paint
    }
    TEDispose(te);
}

} // namespace

BENCHMARK(QD_SetText100K)->Name("QD/TESetText100K")->Unit(benchmark::kMicrosecond);
BENCHMARK(Qt_SetText100K)->Name("Qt/TESetText100K")->Unit(benchmark::kMicrosecond);
BENCHMARK(QD_Key1000)->Name("QD/TEKey1000")->Unit(benchmark::kMicrosecond);
BENCHMARK(Qt_Key1000)->Name("Qt/TEKey1000")->Unit(benchmark::kMicrosecond);
BENCHMARK(QD_GetOffset1000Lines)->Name("QD/TEGetOffset1000Lines");
BENCHMARK(Qt_GetOffset1000Lines)->Name("Qt/TEGetOffset1000Lines");

BENCHMARK(QD_Paste)
    ->Name("TEPaste")
    ->ArgsProduct({{1024, 4096}, {kPlain, kSingleLine, kNoWrap, kStyled}})
    ->ArgNames({"KB", "kind"})
    ->Unit(benchmark::kMillisecond)
    ->Iterations(1);

VELMAR_BENCHMARK_MAIN()
