// Drag and drop on the real desktop, driven by real mouse input through the X server: a drag
// from one library window to another, a cancelled drag, a drag in from another application
// and a drop onto another application (where the host's exporter writes the file), a drag
// disposed of while it runs, and resting over a tab bar's tab.
#include "../windows/WindowTestSupport.h"
#include "XTestInput.h"

#include <Velmar/Drag.h>
#include <Velmar/EventWaiting.h>

#include <QElapsedTimer>
#include <QProcess>
#include <QTabBar>
#include <QTabWidget>
#include <QTemporaryDir>

#include <functional>

using namespace Velmar;
using namespace WindowTest;

namespace {

VelmarTest::SequenceRecorder gSeen;
WindowRef gA, gB;
bool gDisposeOnEnterB = false;

QString nameOf(WindowRef w)
{
    return w == gA ? QStringLiteral("A") : w == gB ? QStringLiteral("B") : QStringLiteral("?");
}

SInt16 tracker(DragTrackingMessage message, WindowRef window, void*, Drag* drag)
{
    gSeen.recordOnce(QStringLiteral("%1:%2").arg(nameOf(window)).arg(message));
    if (gDisposeOnEnterB && window == gB && message == kDragTrackingEnterWindow && drag) {
        gDisposeOnEnterB = false;
        DisposeDrag(drag);
    }
    return noErr;
}

SInt16 receiver(WindowRef window, void*, Drag* drag)
{
    QByteArray text(256, '\0');
    SInt32 size = SInt32(text.size());
    GetFlavorData(drag, 1, kDragFlavorTypeText, text.data(), &size, 0);
    QStringList urls;
    if (const QMimeData* data = GetDragData(drag))
        for (const QUrl& url : data->urls())
            urls << url.toString();
    gSeen.record(QStringLiteral("drop %1 %2 %3")
                     .arg(nameOf(window), QString::fromLatin1(text.left(size).constData()),
                         urls.join(QLatin1Char(','))));
    return noErr;
}

// The classic host: a mouse-down in window A starts TrackDrag with an outline around the
// point; everything else only keeps the loop going.
class Host {
public:
    Host()
    {
        NewDrag(&drag);
        a = std::make_unique<Window>(R(150, 80, 300, 330));
        b = std::make_unique<Window>(R(150, 420, 300, 670));
        gA = *a;
        gB = *b;
        a->show();
        b->show();
        for (WindowRef w : {gA, gB})
            InstallTrackingHandler(tracker, w, nullptr);
        InstallReceiveHandler(receiver, gB, nullptr);
    }
    ~Host()
    {
        for (WindowRef w : {gA, gB})
            RemoveTrackingHandler(tracker, w);
        RemoveReceiveHandler(receiver, gB);
        if (DragInstance())
            DisposeDrag(DragInstance());
    }

    void runUntil(const std::function<bool()>& done, int limitMs = 8000)
    {
        QElapsedTimer clock;
        clock.start();
        while (!done() && clock.elapsed() < limitMs) {
            EventRecord e;
            if (WaitNextEvent(everyEvent, &e, 2, nullptr) && e.what == mouseDown
                && e.window == gA.get()) {
                Drag* current = DragInstance();
                if (!current)
                    NewDrag(&current);
                if (!text.isEmpty())
                    current->mimeData()->setText(text);
                RgnHandle outline = NewRgn();
                SetRectRgn(outline, SInt16(e.where.h - 20), SInt16(e.where.v - 10),
                    SInt16(e.where.h + 20), SInt16(e.where.v + 10));
                QElapsedTimer took;
                took.start();
                results << TrackDrag(current, &e, outline);
                trackMs = took.elapsed();
                DisposeRgn(outline);
            }
        }
    }

    Drag* drag = nullptr;
    std::unique_ptr<Window> a, b;
    QString text;
    QList<OSErr> results;
    qint64 trackMs = 0;
};

} // namespace

class tst_DragHost : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void initTestCase()
    {
        if (QGuiApplication::platformName() != QLatin1String("xcb") || !m_x.load())
            QSKIP("needs an X display with XTEST");
    }
    void init() { gSeen.clear(); }

    void betweenTwoWindows()
    {
        Host host;
        host.text = QStringLiteral("dragged");
        const QPoint from = host.a->get()->mapToGlobal(QPoint(100, 70));
        const QPoint over = host.b->get()->mapToGlobal(QPoint(100, 70));
        press(from);
        // The drag starts by moving; it rests over B a while, then drops there.
        steps({{200, [&] { m_x.moveTo(from + QPoint(30, 0)); }},
            {400, [&] { m_x.moveTo(over - QPoint(10, 0)); }}, {500, [&] { m_x.moveTo(over); }},
            {1000, [&] { m_x.button(1, false); }}});
        host.runUntil([&] { return !host.results.isEmpty(); });
        QCOMPARE(host.results, QList<OSErr>{dragNotAcceptedErr}); // a drop is -1857 too
        VELMAR_COMPARE_SEQUENCE(gSeen, "A to B",
            {"A:1", "A:2", "*", "A:4", "A:5", "B:1", "B:2", "B:3", "*", "drop B dragged ", "B:4",
                "B:5"});
    }

    void releasedBeforeTheDragStarts()
    {
        Host host;
        press(host.a->get()->mapToGlobal(QPoint(100, 70)));
        m_x.button(1, false);
        host.runUntil([&] { return !host.results.isEmpty(); });
        QCOMPARE(host.results, QList<OSErr>{dragNotAcceptedErr});
        QVERIFY(host.trackMs < QApplication::startDragTime());
        QVERIFY(gSeen.entries().isEmpty());
    }

    // A handler disposes of the drag while it runs over B: the drag ends without harm.
    void disposedWhileTracking()
    {
        Host host;
        gDisposeOnEnterB = true;
        const QPoint from = host.a->get()->mapToGlobal(QPoint(100, 70));
        press(from);
        steps({{200, [&] { m_x.moveTo(from + QPoint(30, 0)); }},
            {400, [&] { m_x.moveTo(host.b->get()->mapToGlobal(QPoint(100, 70))); }},
            {700, [&] { m_x.button(1, false); }}});
        host.runUntil([&] { return !host.results.isEmpty(); });
        QCOMPARE(host.results, QList<OSErr>{dragNotAcceptedErr});
        QVERIFY(!DragInstance());
        QVERIFY(gSeen.entries().contains(QStringLiteral("B:2")));
    }

    // Another application's plain Qt drag brings text and URLs.
    void fromAnotherApplication()
    {
        Host host;
        QProcess peer;
        peer.start(QStringLiteral(VELMAR_PEER),
            {QStringLiteral("drag-source"), QStringLiteral("800"), QStringLiteral("500"),
                QStringLiteral("peer text"), QStringLiteral("file:///tmp/peer.txt")});
        QVERIFY(waitForLine(peer, "ready"));
        const QPoint in = host.b->get()->mapToGlobal(QPoint(100, 70));
        press(QPoint(900, 570));
        steps({{200, [&] { m_x.moveTo(QPoint(960, 590)); }},
            {500, [&] { m_x.moveTo(in - QPoint(10, 0)); }}, {700, [&] { m_x.moveTo(in); }},
            {1000, [&] { m_x.button(1, false); }}});
        host.runUntil([] { return gSeen.entries().filter(QStringLiteral("drop")).size() == 1; });
        VELMAR_COMPARE_SEQUENCE(gSeen, "from the peer",
            {"*", "B:1", "B:2", "*", "drop B peer text file:///tmp/peer.txt", "B:4", "B:5"});
        peer.waitForFinished(5000);
    }

    // A drop onto another application: the host's exporter runs once and writes the file
    // whose URL the other application receives.
    void ontoAnotherApplication()
    {
        Host host;
        QTemporaryDir dir;
        const QString exported = dir.filePath(QStringLiteral("exported.txt"));
        int runs = 0;
        const auto connection = QObject::connect(DragExportTransmitter::Instance(),
            &DragExportTransmitter::runExport, [&](QMimeData* data) {
                ++runs;
                QFile file(exported);
                if (file.open(QIODevice::WriteOnly))
                    file.write("exported by the host");
                data->setUrls({QUrl::fromLocalFile(exported)});
            });
        QProcess peer;
        peer.start(QStringLiteral(VELMAR_PEER),
            {QStringLiteral("drop-target"), QStringLiteral("800"), QStringLiteral("500")});
        QVERIFY(waitForLine(peer, "ready"));
        const QPoint from = host.a->get()->mapToGlobal(QPoint(100, 70));
        press(from);
        steps({{200, [&] { m_x.moveTo(from + QPoint(30, 0)); }},
            {500, [&] { m_x.moveTo(QPoint(880, 560)); }},
            {800, [&] { m_x.moveTo(QPoint(900, 570)); }}, {1200, [&] { m_x.button(1, false); }}});
        QString lines;
        host.runUntil([&] {
            lines += QString::fromUtf8(peer.readAllStandardOutput());
            return lines.contains(QLatin1String("dropped")) && !host.results.isEmpty();
        });
        QObject::disconnect(connection);
        QVERIFY2(runs == 1,
            qPrintable(QStringLiteral("%1 runs; the peer said: %2").arg(runs).arg(lines)));
        QVERIFY2(lines.contains(QUrl::fromLocalFile(exported).toString()), qPrintable(lines));
        QVERIFY(QFile::exists(exported));
        peer.waitForFinished(5000);
    }

    // Resting over another tab selects it; leaving the tab widget selects the first again.
    void restingOverATab()
    {
        Host host;
        QTabWidget tabs;
        tabs.addTab(new QWidget, QStringLiteral("One"));
        tabs.addTab(new QWidget, QStringLiteral("Two"));
        tabs.setGeometry(750, 450, 300, 200);
        tabs.show();
        QVERIFY(QTest::qWaitForWindowExposed(&tabs));
        const QPoint second = tabs.tabBar()->mapToGlobal(tabs.tabBar()->tabRect(1).center());
        const QPoint from = host.a->get()->mapToGlobal(QPoint(100, 70));
        int during = -1;
        press(from);
        steps({{200, [&] { m_x.moveTo(from + QPoint(30, 0)); }}, {400, [&] { m_x.moveTo(second); }},
            {1000, [&] { during = tabs.currentIndex(); }}, {1100, [&] { m_x.moveTo(from); }},
            {1500, [&] { m_x.button(1, false); }}});
        host.runUntil([&] { return !host.results.isEmpty(); });
        QCOMPARE(during, 1);
        QCOMPARE(tabs.currentIndex(), 0);
    }

private:
    void press(const QPoint& at)
    {
        m_x.moveTo(at);
        QTest::qWait(50);
        m_x.button(1, true);
    }
    void steps(const std::vector<std::pair<int, std::function<void()>>>& plan)
    {
        for (const auto& [ms, step] : plan)
            QTimer::singleShot(ms, step);
    }
    static bool waitForLine(QProcess& process, const char* line)
    {
        QElapsedTimer clock;
        clock.start();
        QByteArray seen;
        while (clock.elapsed() < 10000) {
            QCoreApplication::processEvents();
            if (process.waitForReadyRead(50))
                seen += process.readAllStandardOutput();
            if (seen.contains(line))
                return true;
        }
        return false;
    }

    VelmarTest::XTestInput m_x;
};

VELMAR_APP_TEST_MAIN(tst_DragHost)
#include "tst_draghost.moc"
