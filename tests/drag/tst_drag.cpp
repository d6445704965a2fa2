// The Drag Manager's calls and the receiving side, with drags delivered to windows as Qt
// delivers them: codes and assertions, flavours, handler order and repeats, handlers that
// throw or change the lists, and hostile drags.
#include "../windows/WindowTestSupport.h"

#include <Velmar/Drag.h>

#include <QDragEnterEvent>
#include <QDropEvent>
#include <QMimeData>

#include <stdexcept>

using namespace Velmar;
using namespace WindowTest;

namespace {

using Asserts = VelmarTest::IgnoredAssertions;

VelmarTest::SequenceRecorder gSeen;
WindowRef gA, gB;

QString nameOf(WindowRef w)
{
    return w == gA ? QStringLiteral("A") : w == gB ? QStringLiteral("B") : QStringLiteral("?");
}

SInt16 tracker(DragTrackingMessage message, WindowRef window, void*, Drag*)
{
    gSeen.record(QStringLiteral("%1:%2").arg(nameOf(window)).arg(message));
    return noErr;
}

SInt16 globalTracker(DragTrackingMessage message, WindowRef window, void*, Drag*)
{
    gSeen.record(QStringLiteral("app %1:%2").arg(nameOf(window)).arg(message));
    return noErr;
}

SInt16 receiver(WindowRef window, void*, Drag* drag)
{
    char text[64] = {};
    SInt32 size = sizeof text;
    const OSErr err = GetFlavorData(drag, 1, kDragFlavorTypeText, text, &size, 0);
    gSeen.record(QStringLiteral("drop %1 %2 %3")
                     .arg(nameOf(window))
                     .arg(err)
                     .arg(QString::fromLatin1(text)));
    return noErr;
}

// Qt's own drag events, as a drag from another application brings them.
void deliver(QEvent::Type type, WindowRef window, const QMimeData* data)
{
    const QPoint at(10, 10);
    if (type == QEvent::DragLeave) {
        QDragLeaveEvent leave;
        QCoreApplication::sendEvent(window.get(), &leave);
    } else if (type == QEvent::DragEnter) {
        QDragEnterEvent enter(at, Qt::CopyAction, data, Qt::LeftButton, Qt::NoModifier);
        QCoreApplication::sendEvent(window.get(), &enter);
    } else if (type == QEvent::DragMove) {
        QDragMoveEvent move(at, Qt::CopyAction, data, Qt::LeftButton, Qt::NoModifier);
        QCoreApplication::sendEvent(window.get(), &move);
    } else {
        QDropEvent drop(QPointF(at), Qt::CopyAction, data, Qt::LeftButton,
                        Qt::ShiftModifier | Qt::MetaModifier);
        QCoreApplication::sendEvent(window.get(), &drop);
    }
}

} // namespace

class TestDrag : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void initTestCase()
    {
        m_a = std::make_unique<Window>(R(100, 100, 200, 300));
        m_b = std::make_unique<Window>(R(100, 400, 200, 600));
        gA = *m_a;
        gB = *m_b;
        NewDrag(&m_drag);
    }
    void cleanupTestCase()
    {
        DisposeDrag(m_drag);
        m_a.reset();
        m_b.reset();
    }
    void init() { gSeen.clear(); }

    void codesAndAssertions()
    {
        Drag* again = nullptr;
        QCOMPARE(NewDrag(&again), OSErr(noErr));
        QCOMPARE(again, m_drag); // one drag at a time
        QCOMPARE(NewDrag(nullptr), OSErr(noErr));
        QCOMPARE(DragInstance(), m_drag);

        Asserts asserts;
        SInt32 size = 10;
        UInt16 items = 0;
        SInt16 mods = 0;
        char byte = 0;
        QCOMPARE(
            AddDragItemFlavor(nullptr, 1, kDragFlavorTypeText, "x", 1, 0), OSErr(badDragRefErr));
        QCOMPARE(GetFlavorDataSize(nullptr, 1, kDragFlavorTypeText, &size), OSErr(badDragRefErr));
        QCOMPARE(
            GetFlavorData(nullptr, 1, kDragFlavorTypeText, &byte, &size, 0), OSErr(badDragRefErr));
        QCOMPARE(GetDragModifiers(nullptr, &mods, &mods, &mods), OSErr(badDragRefErr));
        QCOMPARE(CountDragItems(m_drag, nullptr), OSErr(paramErr));
        QCOMPARE(TrackDrag(m_drag, nullptr, nullptr), OSErr(paramErr));
        QCOMPARE(TrackDrag(nullptr, &m_event, nullptr), OSErr(badDragRefErr));
        Drag other;
        QCOMPARE(DisposeDrag(&other), OSErr(noErr)); // not the instance: refused
        QCOMPARE(
            GetFlavorDataSize(m_drag, 1, kDragFlavorTypeText, nullptr), OSErr(cantGetFlavorErr));
        QCOMPARE(asserts.texts(),
            (QStringList{"theDrag", "theDrag", "numItems", "theEvent", "theDrag == DragInstance()",
                "dataSize"}));
        QCOMPARE(CountDragItems(m_drag, &items), OSErr(noErr));
    }

    void outgoingBytes()
    {
        AddDragItemFlavor(m_drag, 1, kDragFlavorTypeText, "first", 5, 0);
        AddDragItemFlavor(m_drag, 2, kDragFlavorTypeText, "second", 6, 0);
        QCOMPARE(m_drag->mimeData()->data(QStringLiteral("application/x-dnditemdata")),
            QByteArray("second"));
        QVERIFY(m_drag->mimeData()->formats().contains(QStringLiteral("text/uri-list")));
    }

    // Handlers of the window first, then the application's, in the documented order; the
    // drop's text is read in the host's encoding.
    void receivingOrder()
    {
        InstallTrackingHandler(tracker, gB, nullptr);
        InstallTrackingHandler(globalTracker, nullptr, nullptr);
        InstallReceiveHandler(receiver, gB, nullptr);
        QMimeData data;
        data.setText(QString::fromUtf8("caf\u00e9"));
        deliver(QEvent::DragEnter, gB, &data);
        deliver(QEvent::DragMove, gB, &data);
        deliver(QEvent::Drop, gB, &data);
        VELMAR_COMPARE_SEQUENCE(gSeen, "receiving",
            {"B:1", "app B:1", "B:2", "app B:2", "B:3", "app B:3",
                QString::fromLatin1("drop B 0 caf\x8E"), // Mac OS Roman
                "B:4", "app B:4", "B:5", "app B:5"});
        SInt16 up = 0;
        GetDragModifiers(m_drag, nullptr, nullptr, &up);
        QCOMPARE(up, SInt16(shiftKey | cmdKey)); // Meta is the command key here too

        // Flavours of the data over the window.
        SInt32 size = 0;
        QCOMPARE(GetFlavorDataSize(m_drag, 1, kDragFlavorTypeText, &size), OSErr(noErr));
        QCOMPARE(size, SInt32(4));
        char buffer[8] = "zzzzzzz";
        size = 8;
        QCOMPARE(GetFlavorData(m_drag, 1, kDragFlavorTypeText, buffer, &size, 2), OSErr(noErr));
        QCOMPARE(size, SInt32(3)); // "f\xE9" and the zero: the whole block counts here
        size = 8;
        QCOMPARE(GetFlavorData(m_drag, 1, kDragFlavorTypeText, buffer, &size, 9), OSErr(noErr));
        QCOMPARE(size, SInt32(0));
        QCOMPARE(
            GetFlavorDataSize(m_drag, 1, FOUR_CHAR_CODE("PICT"), &size), OSErr(badDragFlavorErr));
        UInt16 items = 0;
        CountDragItems(m_drag, &items);
        QCOMPARE(items, UInt16(1));
        RemoveTrackingHandler(tracker, gB);
        RemoveTrackingHandler(globalTracker, nullptr);
        RemoveReceiveHandler(receiver, gB);
        QCOMPARE(RemoveReceiveHandler(receiver, gB), OSErr(handlerNotFoundErr));
    }

    // Holding still over a window repeats the in-window call every 100 ms; data nobody can
    // read is refused.
    void hoverRepeatsAndRefusals()
    {
        InstallTrackingHandler(tracker, gA, nullptr);
        QMimeData data;
        data.setUrls(
            {QUrl(QStringLiteral("file:///tmp/a")), QUrl(QStringLiteral("file:///tmp/b"))});
        deliver(QEvent::DragEnter, gA, &data);
        QTest::qWait(450);
        QVERIFY(gSeen.entries().count(QStringLiteral("A:3")) >= 3);
        UInt16 items = 0;
        CountDragItems(m_drag, &items);
        QCOMPARE(items, UInt16(2));
        deliver(QEvent::DragLeave, gA, &data);
        gSeen.clear();
        QTest::qWait(250);
        QVERIFY(gSeen.entries().isEmpty()); // the repeat stopped with the leave

        QMimeData image;
        image.setImageData(QImage(2, 2, QImage::Format_RGB32));
        deliver(QEvent::DragEnter, gA, &image);
        QVERIFY(gSeen.entries().isEmpty());
        RemoveTrackingHandler(tracker, gA);
    }

    // A handler that throws ends the dispatch and the drag's target; handlers may change the
    // lists while they are called.
    void handlersThatMisbehave()
    {
        static auto thrower = [](DragTrackingMessage message, WindowRef, void*, Drag*) -> SInt16 {
            gSeen.record(QStringLiteral("thrower:%1").arg(message));
            throw std::runtime_error("handler failed");
        };
        static auto remover = [](DragTrackingMessage message, WindowRef window, void*,
                                  Drag*) -> SInt16 {
            gSeen.record(QStringLiteral("remover:%1").arg(message));
            RemoveTrackingHandler(tracker, window);
            InstallTrackingHandler(tracker, window, nullptr);
            return noErr;
        };
        InstallTrackingHandler(remover, gA, nullptr);
        InstallTrackingHandler(tracker, gA, nullptr);
        InstallTrackingHandler(thrower, gA, nullptr);
        QMimeData data;
        data.setText(QStringLiteral("x"));
        VelmarTest::LogCapture log;
        deliver(QEvent::DragEnter, gA, &data);
        QVERIFY(log.contains("handler failed"));
        QVERIFY(!m_drag->targetWindow());
        // The second message sees the list as the first left it: the tracker moved to the end.
        VELMAR_COMPARE_SEQUENCE(
            gSeen, "misbehaving", {"remover:1", "A:1", "thrower:1", "remover:2", "thrower:2"});
        deliver(QEvent::DragLeave, gA, &data);
        RemoveTrackingHandler(remover, gA);
        RemoveTrackingHandler(tracker, gA);
        RemoveTrackingHandler(thrower, gA);
        RemoveTrackingHandler(tracker, gA);
    }

    // A drag that is gone, and a window that goes while the drag is over it.
    void hostileDrags()
    {
        Drag* stale = nullptr;
        {
            Drag* made = nullptr;
            DisposeDrag(m_drag);
            NewDrag(&made);
            stale = made;
            DisposeDrag(made);
        }
        Asserts asserts;
        SInt32 size = 4;
        char byte;
        QCOMPARE(
            GetFlavorData(stale, 1, kDragFlavorTypeText, &byte, &size, 0), OSErr(badDragRefErr));
        QCOMPARE(IsDragTracking(stale), Boolean(0));
        QCOMPARE(asserts.texts(), (QStringList{"IsValidDrag(drag)", "IsValidDrag(drag)"}));
        NewDrag(&m_drag);

        Window doomed(R(300, 100, 400, 300));
        InstallTrackingHandler(tracker, doomed, nullptr);
        QMimeData data;
        data.setText(QStringLiteral("x"));
        deliver(QEvent::DragEnter, doomed, &data);
        DisposeWindow(doomed);
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
        gSeen.clear();
        QTest::qWait(250); // the repeat finds the window gone
        QVERIFY(gSeen.entries().isEmpty());
        QCOMPARE(InstallTrackingHandler(tracker, doomed, nullptr), OSErr(paramErr));
    }

private:
    std::unique_ptr<Window> m_a, m_b;
    Drag* m_drag = nullptr;
    EventRecord m_event{};
};

VELMAR_APP_TEST_MAIN(TestDrag)
#include "tst_drag.moc"
