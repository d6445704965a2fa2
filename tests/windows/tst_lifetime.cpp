// Host code that disposes, switches or waits from inside the library's calls into it: every
// callback the library makes, tried the way a hostile host would. Run under the sanitizer
// build, a use after free or a null call here is a report; elsewhere a crash or a hang.
#include "WindowTestSupport.h"
#include "WindowSystemNeeds.h"

#include <Velmar/CarbonEventHandlers.h>
#include <Velmar/Drag.h>
#include <Velmar/EventWaiting.h>
#include <Velmar/FeatureFlags.h>
#include <Velmar/Menus.h>
#include <Velmar/QDShapes.h>

#include "events/EventQueueItem.h"

#include <QApplication>
#include <QMimeData>
#include <QMouseEvent>
#include <QTimer>

#include <functional>

using namespace Velmar;
using namespace WindowTest;

namespace {

// What a handler does to the window it is called for.
enum class Act { Dispose, DisposeAndWait, SwitchMode, HideAndWait, RepaintAndWait };

void waitBriefly()
{
    EventRecord event;
    WaitNextEvent(everyEvent, &event, 0, nullptr);
}

void act(Act what, AQtWindow* window)
{
    switch (what) {
    case Act::SwitchMode: window->enableDirectQtDrawing(!window->isDirectQtDrawing()); return;
    case Act::HideAndWait: HideWindow(window); waitBriefly(); return;
    case Act::RepaintAndWait: window->repaint(); waitBriefly(); return;
    default: break;
    }
    DisposeWindow(window);
    if (what == Act::DisposeAndWait)
        waitBriefly();
}

// Does `what` from one of its entries (the others do nothing).
class HostileHandler : public IWindowEventHandler {
public:
    enum Entry { Paint, Show, Resize };
    HostileHandler(Entry entry, Act what) : m_entry(entry), m_what(what) {}
    AQtWindow* window = nullptr;
    void PaintEventHandler(QPainter*, const QRegion&) override { fire(Paint); }
    void ShowEventHandler() override { fire(Show); }
    void ResizeEventHandler() override { fire(Resize); }
    void GetWindowProperties(Brindle::ManagedWindow::Properties&) override {}
    const Brindle::DecorationState* GetDecorationState() override { return nullptr; }

private:
    void fire(Entry entry)
    {
        if (entry == m_entry && window && std::exchange(m_armed, false))
            act(m_what, window);
    }
    Entry m_entry;
    Act m_what;
    bool m_armed = true;
};

// The window handlers paint and show only without legacy processing.
struct NoLegacyProcessing {
    NoLegacyProcessing() : m_saved(SupportLegacyMacEventProcessing(0)) {}
    ~NoLegacyProcessing() { SupportLegacyMacEventProcessing(m_saved); }
    UInt32 m_saved;
};

void settle()
{
    for (int i = 0; i < 3; ++i)
        waitBriefly();
}

AQtWindow* gWindow = nullptr;
Drag* gDrag = nullptr;
MenuRef gMenu;

} // namespace

class tst_Lifetime : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void init() { Private::gMainEventQueue.clearAll(); }

    void windowHandlers_data()
    {
        QTest::addColumn<int>("entry");
        QTest::addColumn<int>("what");
        QTest::addColumn<bool>("direct");
        using H = HostileHandler;
        QTest::newRow("paint disposes, back buffer") << int(H::Paint) << int(Act::Dispose) << false;
        QTest::newRow("paint disposes, direct") << int(H::Paint) << int(Act::Dispose) << true;
        QTest::newRow("paint disposes and waits") << int(H::Paint) << int(Act::DisposeAndWait) << false;
        QTest::newRow("paint switches to direct") << int(H::Paint) << int(Act::SwitchMode) << false;
        QTest::newRow("paint switches to back buffer") << int(H::Paint) << int(Act::SwitchMode) << true;
        QTest::newRow("show disposes and waits") << int(H::Show) << int(Act::DisposeAndWait) << false;
        QTest::newRow("resize disposes and waits") << int(H::Resize) << int(Act::DisposeAndWait) << false;
        QTest::newRow("paint hides and waits") << int(H::Paint) << int(Act::HideAndWait) << false;
        QTest::newRow("paint re-enters, direct") << int(H::Paint) << int(Act::RepaintAndWait) << true;
        QTest::newRow("show hides and waits") << int(H::Show) << int(Act::HideAndWait) << false;
    }
    void windowHandlers()
    {
        QFETCH(int, entry);
        QFETCH(int, what);
        QFETCH(bool, direct);
        NoLegacyProcessing noLegacy;
        HostileHandler handler{HostileHandler::Entry(entry), Act(what)};
        Window w(kDocumentWindowClass, kWindowStandardDocumentAttributes, R(60, 60, 160, 260), &handler);
        handler.window = w.get();
        w->enableDirectQtDrawing(direct);
        const QPointer<AQtWindow> alive(w.get());
        ShowWindow(w);
        if (alive && !alive->IsDeletePending()) {
            alive->repaint();
            SizeWindow(w, 220, 120, true);
        }
        settle();
    }

    // An action procedure that disposes of the window being dragged ends the drag.
    void dragGrayRgnActionDisposes()
    {
        VELMAR_REQUIRE_X11("a mouse grab");
        Window w(R(60, 60, 160, 260));
        w.show();
        gWindow = w.get();
        OnPort port(w);
        RgnHandle region = NewRgn();
        const Rect box = R(10, 10, 40, 40);
        RectRgn(region, &box);
        const Rect limit = R(-1000, -1000, 1000, 1000);
        QTimer::singleShot(0, [target = QPointer<AQtWindow>(w.get())] {
            if (!target)
                return;
            QMouseEvent move(QEvent::MouseMove, QPointF(20, 20), target->mapToGlobal(QPointF(20, 20)),
                             Qt::LeftButton, Qt::LeftButton, Qt::NoModifier);
            QApplication::sendEvent(target, &move);
        });
        const SInt32 moved = DragGrayRgn(region, Point{15, 15}, &limit, &limit, noConstraint,
                                         [] { DisposeWindow(gWindow); });
        QCOMPARE(moved, SInt32(0));
        DisposeRgn(region);
        settle();
    }

    // A drag tracking handler that disposes of its window and waits, inside the drag event.
    void trackingHandlerDisposesAndWaits()
    {
        Window w(R(60, 60, 160, 260));
        w.show();
        gWindow = w.get();
        const auto handler = [](DragTrackingMessage, WindowRef window, void*, Drag*) -> OSErr {
            if (window == gWindow && !window->IsDeletePending()) {
                DisposeWindow(window);
                waitBriefly();
            }
            return noErr;
        };
        QCOMPARE(InstallTrackingHandler(handler, w, nullptr), noErr);
        QMimeData data;
        data.setText(QStringLiteral("dragged"));
        QDragEnterEvent enter(QPoint(20, 20), Qt::CopyAction, &data, Qt::LeftButton, Qt::NoModifier);
        QApplication::sendEvent(w.get(), &enter);
        settle();
    }

    // The host's exporter disposes of the drag before the drag starts.
    void exporterDisposesDrag()
    {
        Window w(R(60, 60, 160, 260));
        w.show();
        QCOMPARE(NewDrag(&gDrag), noErr);
        const auto connection = QObject::connect(DragExportTransmitter::Instance(),
                                                 &DragExportTransmitter::initData,
                                                 [] { DisposeDrag(gDrag); });
        EventRecord down{};
        down.what = mouseDown;
        down.window = w.get();
        QCOMPARE(TrackDrag(gDrag, &down, nullptr), OSErr(dragNotAcceptedErr));
        QObject::disconnect(connection);
        QVERIFY(!DragInstance());
        settle();
    }

    // A timer disposes of the pop-up's menu, or of its items, while the list shows.
    void popUpListLosesItsMenu_data()
    {
        QTest::addColumn<bool>("wholeMenu");
        QTest::newRow("menu disposed") << true;
        QTest::newRow("items deleted") << false;
    }
    void popUpListLosesItsMenu()
    {
        VELMAR_REQUIRE_X11("a pop-up without a parent window");
        QFETCH(bool, wholeMenu);
        gMenu = NewMenu(300, VelmarTest::P(VelmarTest::pascal("Long")));
        for (int i = 0; i < 400; ++i)
            AppendMenu(gMenu, VelmarTest::P(VelmarTest::pascal("Item " + QByteArray::number(i))));
        const auto dispose = [](EventLoopTimerRef timer, void*) {
            RemoveEventLoopTimer(timer);
            DisposeMenu(gMenu);
        };
        const auto deleteItems = [](EventLoopTimerRef timer, void*) {
            RemoveEventLoopTimer(timer);
            while (CountMenuItems(gMenu) > 0)
                DeleteMenuItem(gMenu, 1);
            waitBriefly();
        };
        EventLoopTimerRef timer = nullptr;
        InstallEventLoopTimer(GetMainEventLoop(), 0.05, 0, wholeMenu ? +dispose : +deleteItems,
                              nullptr, &timer);
        // Then the user picks the highlighted row.
        QTimer::singleShot(300, [] {
            if (QWidget* popup = QApplication::activePopupWidget())
                QTest::keyClick(popup, Qt::Key_Return);
        });
        QCOMPARE(PopUpMenuSelect(gMenu, 40, 40, 1, false, true), SInt32(0));
        if (!wholeMenu)
            DisposeMenu(gMenu);
        settle();
    }

    // The classic purge hands events to handlers one at a time: a handler that disposes of
    // a window revokes that window's other purged events before they are delivered.
    void purgeSkipsRevokedEvents()
    {
        Window victim(R(60, 60, 160, 260));
        static int delivered = 0;
        delivered = 0;
        gWindow = victim.get();
        const auto handler = [](EventHandlerCallRef, EventRef event, void*) -> OSStatus {
            if (event->window == gWindow) {
                ++delivered;
                DisposeWindow(gWindow);
                waitBriefly(); // purges the rest itself, from inside the outer purge
            }
            return noErr;
        };
        const EventTypeSpec close{kEventClassVelmar, kEventVelmarCloseRequested};
        EventHandlerRef ref = nullptr;
        InstallEventHandler(GetApplicationEventTarget(), handler, 1, &close, nullptr, &ref);
        for (int i = 0; i < 5; ++i) {
            auto item = Private::EventQueueItemSmartPtr::Create();
            item->eventClass = close.eventClass;
            item->eventKind = close.eventKind;
            item->window = victim.get();
            Private::gMainEventQueue.append(item);
        }
        EventRecord event;
        GetNextEvent(keyDownMask, &event);
        RemoveEventHandler(ref);
        QCOMPARE(delivered, 1);
        settle();
    }

    // A timer that removes itself and waits inside its own procedure.
    void timerRemovesItselfAndWaits()
    {
        static int fired = 0;
        fired = 0;
        const auto proc = [](EventLoopTimerRef timer, void*) {
            ++fired;
            RemoveEventLoopTimer(timer);
            waitBriefly();
        };
        EventLoopTimerRef timer = nullptr;
        InstallEventLoopTimer(GetMainEventLoop(), 0.01, 0.01, proc, nullptr, &timer);
        for (int i = 0; i < 50 && fired == 0; ++i) {
            EventRecord event;
            WaitNextEvent(everyEvent, &event, 1, nullptr);
        }
        QCOMPARE(fired, 1);
        // The timer's deletion waited for its procedure; nothing waits after this test.
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    }
};

VELMAR_APP_TEST_MAIN(tst_Lifetime)
#include "tst_lifetime.moc"
