// Update regions, update events, the paint event and the back buffer on a real X server:
// what the host draws reaches the screen, invalid areas make exactly one update event, and
// the window's own events take the Toolbox's shape.
#include "WindowTestSupport.h"
#include "WindowSystemNeeds.h"

#include <Velmar/QDBitmaps.h>
#include <Velmar/QDShapes.h>
#include <Velmar/FeatureFlags.h>
#include <Velmar/QuickDraw.h>

#include <QCloseEvent>
#include <QPainter>

using namespace Velmar;
using namespace WindowTest;

namespace {

// Paints a solid colour over what it is asked to paint and counts the calls.
class SolidHandler : public IWindowEventHandler {
public:
    void PaintEventHandler(QPainter* painter, const QRegion& region) override
    {
        ++paints;
        painted += region;
        if (painter && painter->isActive())
            painter->fillRect(region.boundingRect(), Qt::green);
    }
    void ShowEventHandler() override { ++shows; }
    void ResizeEventHandler() override { ++resizes; }
    void GetWindowProperties(Brindle::ManagedWindow::Properties&) override {}
    const Brindle::DecorationState* GetDecorationState() override { return nullptr; }
    int paints = 0, shows = 0, resizes = 0;
    QRegion painted;
};

} // namespace

class tst_WindowUpdate : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void init() { Private::gMainEventQueue.clearAll(); }
    void cleanup() { Private::gMainEventQueue.clearAll(); }

    // Invalid areas accumulate into one pending update event; validating them all drops it.
    void oneUpdateEventPerWindow()
    {
        Window w(R(100, 100, 200, 300));
        const Rect a = R(0, 0, 10, 10);
        QCOMPARE(InvalWindowRect(w, &a), noErr); // hidden: no effect under legacy processing
        QVERIFY(w->updateRegion().isEmpty());
        w.show();
        const int before = AQtWindow::pendingUpdateEventCount();
        ValidWindowRect(w, &a);
        const Rect whole = R(0, 0, 100, 200);
        ValidWindowRect(w, &whole); // showing made the whole window invalid
        QCOMPARE(AQtWindow::pendingUpdateEventCount(), before - 1);
        InvalWindowRect(w, &a);
        InvalWindowRect(w, &a);
        QCOMPARE(AQtWindow::pendingUpdateEventCount(), before);
        QVERIFY(w->pendingUpdateEvent());
        QCOMPARE(GetNumEventsInQueue(GetMainEventQueue()) >= 1, true);
        QVERIFY(IsWindowUpdatePending(w));
        RgnHandle rgn = NewRgn();
        QCOMPARE(GetWindowRegion(w, kWindowUpdateRgn, rgn), noErr);
        const QPoint origin = w->mapToGlobal(QPoint(0, 0));
        QCOMPARE(*rgn, QRegion(QRect(origin, QSize(10, 10))));
        Rect bounds;
        QCOMPARE(GetWindowBounds(w, kWindowUpdateRgn, &bounds), noErr);
        QCOMPARE(bounds.left, SInt16(origin.x()));
        QCOMPARE(ValidWindowRgn(w, rgn == nullptr ? nullptr : rgn), noErr);
        ValidWindowRect(w, &whole);
        QVERIFY(!w->pendingUpdateEvent());
        QCOMPARE(InvalWindowRgn(w, nullptr), OSStatus(errNullWindowArgument));
        QCOMPARE(ValidWindowRect(w, nullptr), OSStatus(errNullWindowArgument));
        DisposeRgn(rgn);
    }

    // A host that draws right after ShowWindow and never waits (it computes, or polls the
    // button) sees what it drew: the window is on the screen when ShowWindow returns.
    void drawingBeforeTheFirstWait()
    {
        VELMAR_REQUIRE_X11("reading the screen back");
        Window w(R(150, 150, 210, 250));
        ShowWindow(w);
        OnPort port(w);
        const RGBColor red(65535, 0, 0);
        RGBForeColor(&red);
        const Rect all = R(0, 0, 60, 100);
        PaintRect(&all);
        QDFlushPortBuffer(GetWindowPort(w), nullptr);
        const QImage shown = screenPixels(QRect(w->mapToGlobal(QPoint(0, 0)), QSize(100, 60)));
        QCOMPARE(shown.pixelColor(50, 30), QColor(Qt::red));
    }

    // The classic cycle: BeginUpdate limits drawing to the invalid area and validates it,
    // EndUpdate puts the whole port back and flushes to the screen.
    void drawingReachesTheScreen()
    {
        VELMAR_REQUIRE_X11("reading the screen back");
        Window w(R(120, 140, 220, 340));
        w.show();
        OnPort port(w);
        BeginUpdate(w);
        QVERIFY(w->updateRegion().isEmpty());
        const RGBColor red(65535, 0, 0);
        RGBForeColor(&red);
        const Rect all = R(0, 0, 100, 200);
        PaintRect(&all);
        EndUpdate(w);
        QTRY_COMPARE(screenPixels(QRect(w->mapToGlobal(QPoint(50, 50)), QSize(1, 1))).pixel(0, 0),
                     qRgb(255, 0, 0));
        // Drawing outside an update is flushed by the repaint of dirty ports.
        const RGBColor blue(0, 0, 65535);
        RGBForeColor(&blue);
        const Rect corner = R(0, 0, 20, 20);
        PaintRect(&corner);
        QVERIFY(w->isGrafPortDirty());
        RepaintDirtyPorts(true);
        QVERIFY(!w->isGrafPortDirty());
        QTRY_COMPARE(screenPixels(QRect(w->mapToGlobal(QPoint(5, 5)), QSize(1, 1))).pixel(0, 0),
                     qRgb(0, 0, 255));
    }

    // A copy is drawing like any other: the window goes dirty and the screen shows it. The
    // strip a scroll uncovers, made invalid, joins what was already invalid.
    void copiesAndScrolls()
    {
        VELMAR_REQUIRE_X11("reading the screen back");
        Window w(R(160, 180, 260, 380));
        w.show();
        GrafPtr world = nullptr;
        const Rect all = R(0, 0, 100, 200);
        QCOMPARE(NewGWorld(&world, 32, &all, nullptr, nullptr, 0), SInt16(noErr));
        world->image()->fill(qRgb(0, 160, 0));
        OnPort port(w);
        RepaintDirtyPorts(true);
        QVERIFY(!w->isGrafPortDirty());
        CopyBits(GetPortBitMapForCopyBits(world), GetPortBitMapForCopyBits(GetWindowPort(w)),
                 &all, &all, srcCopy, nullptr);
        QVERIFY(w->isGrafPortDirty());
        RepaintDirtyPorts(true);
        QTRY_COMPARE(screenPixels(QRect(w->mapToGlobal(QPoint(60, 30)), QSize(1, 1))).pixel(0, 0),
                     qRgb(0, 160, 0));
        DisposeGWorld(world);

        ValidWindowRect(w, &all);
        const Rect early = R(50, 60, 55, 65);
        InvalWindowRect(w, &early);
        RgnHandle uncovered = NewRgn();
        ScrollRect(&all, 0, 20, uncovered);
        QCOMPARE(InvalWindowRgn(w, uncovered), noErr);
        QCOMPARE(w->updateRegion(), QRegion(0, 0, 200, 20) + QRegion(60, 50, 5, 5));
        DisposeRgn(uncovered);
    }

    // A handler paints what is invalid; painting does not validate (BeginUpdate does).
    void handlerPaints()
    {
        SolidHandler handler;
        Window w(kDocumentWindowClass, 0, R(100, 100, 150, 200), &handler);
        QVERIFY(w->isEventHandlingEnabled());
        w.show();
        QCOMPARE(handler.shows, SupportLegacyMacEventProcessing(kFeatureFlagQuery) ? 0 : 1);
        SupportLegacyMacEventProcessing(0);
        const Rect a = R(0, 0, 10, 10);
        InvalWindowRect(w, &a);
        QTRY_VERIFY(handler.paints > 0);
        SupportLegacyMacEventProcessing(1);
        // A window without a handler cannot turn handling on.
        Window bare(R(0, 0, 20, 20));
        bare->enableEventHandling(true);
        QVERIFY(!bare->isEventHandlingEnabled());
    }

    void dynViewWindowsNeverPaint()
    {
        Window w(R(100, 100, 150, 200));
        w->SetDynViewProperty(true);
        w.show();
        const UInt32 calls = w->paintEventCalls();
        w->repaint();
        QCOMPARE(w->paintEventCalls(), calls + 1);
        QVERIFY(w->updateRegion().isEmpty() || w->pendingUpdateEvent());
    }

    // Scrolling in direct mode: invalid areas move with the content, the uncovered strip
    // becomes invalid, and an empty rectangle means the whole window.
    void directScroll()
    {
        Window w(R(100, 100, 200, 200));
        w.show();
        w->enableDirectQtDrawing(true);
        Private::AQtWindowPrivate::updateRegion(w.get()) = QRegion(10, 10, 5, 5);
        w->scrollRect(0, 20, QRect());
        QCOMPARE(w->updateRegion(), QRegion(10, 30, 5, 5) + QRegion(0, 0, 100, 20));
        w->enableDirectQtDrawing(false);
        QVERIFY(w->GetPort()->image());
    }

    // A close request becomes an event; Qt never closes the window by itself.
    void closeRequestIsAnEvent()
    {
        Window w(R(100, 100, 150, 200));
        w.show();
        QCloseEvent close;
        QCoreApplication::sendEvent(w.get(), &close);
        QVERIFY(!close.isAccepted());
        QVERIFY(w->isVisible());
        QVERIFY(queued().contains("vlmr/clos"));
    }

    // A window disposed while its events wait: they never reach anyone.
    void disposedWhileEventsWait()
    {
        WindowRef w;
        const Rect bounds = R(100, 100, 150, 200);
        CreateNewWindow(kDocumentWindowClass, 0, &bounds, &w);
        ShowWindow(w);
        QCloseEvent close;
        QCoreApplication::sendEvent(w.get(), &close);
        QVERIFY(!queued().isEmpty());
        DisposeWindow(w);
        for (const auto& item : Private::gMainEventQueue.items())
            QVERIFY(item->window != w.get());
        QCOMPARE(AQtWindow::pendingUpdateEventCount(), 0);
    }
};

VELMAR_APP_TEST_MAIN(tst_WindowUpdate)
#include "tst_windowupdate.moc"
