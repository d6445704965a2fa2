// Hosts written the classic way and the Carbon way, driven by real input through the X server:
// a WaitNextEvent loop with FindWindow, update events redrawn through QuickDraw between
// BeginUpdate and EndUpdate, activation, keys, posted events and timers; and a Carbon host
// whose handlers and timer run under RunApplicationEventLoop until a handler quits it.
#include "WindowTestSupport.h"
#include "XTestInput.h"

#include <Velmar/CarbonEventHandlers.h>
#include <Velmar/EventWaiting.h>
#include <Velmar/QDShapes.h>
#include <Velmar/QuickDraw.h>

#include <QElapsedTimer>
#include <QRegularExpression>

#include <functional>
#include <map>

using namespace Velmar;
using namespace WindowTest;

namespace {

// The classic host: one loop, each window painted in its own colour on update events.
class ClassicHost {
public:
    std::map<AQtWindow*, QString> names;
    std::map<AQtWindow*, RGBColor> colours;
    VelmarTest::SequenceRecorder seen;
    int nullEvents = 0;

    QString nameOf(AQtWindow* w) const
    {
        auto it = names.find(w);
        return it == names.end() ? QStringLiteral("?") : it->second;
    }

    // Runs the loop until `done` says so or `limitMs` pass.
    void runUntil(const std::function<bool()>& done, int limitMs = 5000)
    {
        QElapsedTimer clock;
        clock.start();
        while (!done() && clock.elapsed() < limitMs) {
            EventRecord e;
            if (!WaitNextEvent(everyEvent, &e, 3, nullptr)) {
                ++nullEvents;
                continue;
            }
            handle(e);
        }
    }

    void handle(const EventRecord& e)
    {
        switch (e.what) {
        case mouseDown: {
            WindowRef w = nullptr;
            const WindowPartCode part = FindWindow(e.where, &w);
            seen.record(QStringLiteral("mouseDown %1 in %2").arg(part).arg(nameOf(w)));
            if (part == inContent && w != FrontWindow())
                SelectWindow(w);
            break;
        }
        case keyDown:
            seen.record(QStringLiteral("keyDown %1").arg(QChar(char(e.message & charCodeMask))));
            break;
        case updateEvt: {
            AQtWindow* w = e.window;
            seen.recordOnce(QStringLiteral("update %1").arg(nameOf(w)));
            GrafPtr saved;
            GetPort(&saved);
            SetPortWindowPort(w);
            BeginUpdate(w);
            RGBForeColor(&colours[w]);
            Rect all;
            GetWindowPortBounds(w, &all);
            PaintRect(&all);
            EndUpdate(w);
            SetPort(saved);
            break;
        }
        case activateEvt:
            seen.recordOnce(QStringLiteral("%1 %2").arg(e.modifiers & activeFlag ? "activate" : "deactivate",
                                                       nameOf(e.window)));
            break;
        case kHighLevelEvent:
            seen.record(QStringLiteral("posted %1").arg(e.message));
            break;
        default:
            break;
        }
    }
};

void postFromTimer(EventLoopTimerRef timer, void*)
{
    PostEvent(kHighLevelEvent, 77);
    RemoveEventLoopTimer(timer);
}

WindowRef makeWindow(ClassicHost& host, const char* name, int left, const RGBColor& colour)
{
    const Rect bounds = R(150, left, 300, left + 200);
    const unsigned char title[] = "\x01W";
    WindowRef w = NewCWindow(nullptr, &bounds, title, true, 0, nullptr, true, nullptr);
    host.names[w.get()] = QString::fromLatin1(name);
    host.colours[w.get()] = colour;
    return w;
}

// The Carbon host's handlers and what they saw.
VelmarTest::SequenceRecorder gCarbonSeen;

OSStatus windowHandler(EventHandlerCallRef call, EventRef event, void*)
{
    gCarbonSeen.record(QStringLiteral("window handler %1/%2").arg(GetEventClass(event) == kEventClassMouse ? "mous" : "other")
                           .arg(GetEventKind(event)));
    return CallNextEventHandler(call, event);
}

OSStatus applicationHandler(EventHandlerCallRef, EventRef event, void*)
{
    if (GetEventClass(event) == kEventClassMouse) {
        gCarbonSeen.record(QStringLiteral("application handler mous/%1").arg(GetEventKind(event)));
        if (GetEventKind(event) == kEventMouseUp)
            QuitApplicationEventLoop();
        return noErr;
    }
    return eventNotHandledErr;
}

} // namespace

class tst_ClassicHost : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void initTestCase()
    {
        if (QGuiApplication::platformName() != QLatin1String("xcb") || !m_x.load())
            QSKIP("needs an X display with XTEST");
    }
    void init() { Private::gMainEventQueue.clearAll(); }

    void classicLoop()
    {
        ClassicHost host;
        WindowRef a = makeWindow(host, "A", 100, RGBColor(65535, 0, 0));
        WindowRef b = makeWindow(host, "B", 400, RGBColor(0, 0, 65535));
        QVERIFY(QTest::qWaitForWindowExposed(b->window()));
        host.runUntil([&] { return host.seen.entries().contains("update A") && host.seen.entries().contains("update B"); });

        // Click into A (behind B): FindWindow names it, the host selects it, it activates.
        const QPoint inA = a->mapToGlobal(QPoint(20, 20));
        m_x.click(inA, 0);
        // A window manager may hold the click back while it activates the window: wait for
        // both before typing.
        host.runUntil([&] {
            return host.seen.entries().contains("activate A")
                && host.seen.entries().contains("mouseDown 3 in A");
        });
        m_x.tap(0x78); // "x"
        host.runUntil([&] { return host.seen.entries().contains("keyDown x"); });
        EventLoopTimerRef timer = nullptr;
        InstallEventLoopTimer(GetMainEventLoop(), 0.02, 0.02, postFromTimer, nullptr, &timer);
        host.runUntil([&] { return host.seen.entries().contains("posted 77"); });

        VELMAR_COMPARE_SEQUENCE(host.seen, "classic loop",
                                {"*", "mouseDown 3 in A", "*", "keyDown x", "*", "posted 77"});
        // A window manager activates on the click itself, before the host selects: either way
        // A is the active window by the time keys arrive.
        const QStringList before = host.seen.entries().mid(0, host.seen.entries().indexOf("keyDown x"));
        QCOMPARE(before.filter(QRegularExpression("^activate")).last(), QStringLiteral("activate A"));
        QVERIFY(host.seen.entries().contains("update A") && host.seen.entries().contains("update B"));
        // What the host painted on update events is on the screen.
        QTRY_COMPARE(screenPixels(QRect(a->mapToGlobal(QPoint(100, 70)), QSize(1, 1))).pixel(0, 0),
                     qRgb(255, 0, 0));
        QTRY_COMPARE(screenPixels(QRect(b->mapToGlobal(QPoint(100, 70)), QSize(1, 1))).pixel(0, 0),
                     qRgb(0, 0, 255));

        // A window disposed while its update event waits: the host never hears of it.
        const Rect all = R(0, 0, 150, 200);
        InvalWindowRect(b, &all);
        QVERIFY(b->pendingUpdateEvent());
        host.seen.clear();
        DisposeWindow(b);
        host.runUntil([] { return false; }, 300);
        QVERIFY(!host.seen.entries().contains("update B"));
        QVERIFY(host.nullEvents > 0);
        DisposeWindow(a);
    }

    // The Carbon way: the window's handler, then the application's, see the click; a handler
    // ends the application event loop.
    void carbonLoop()
    {
        gCarbonSeen.clear();
        WindowRef w;
        const Rect bounds = R(150, 100, 300, 300);
        CreateNewWindow(kDocumentWindowClass, kWindowStandardDocumentAttributes, &bounds, &w);
        ShowWindow(w);
        QVERIFY(QTest::qWaitForWindowExposed(w->window()));
        const EventTypeSpec mouse[] = {{kEventClassMouse, kEventMouseDown}, {kEventClassMouse, kEventMouseUp}};
        EventHandlerRef onWindow = nullptr, onApplication = nullptr;
        InstallEventHandler(GetWindowEventTarget(w), windowHandler, 2, mouse, nullptr, &onWindow);
        InstallEventHandler(GetApplicationEventTarget(), applicationHandler, 2, mouse, nullptr, &onApplication);
        const QPoint target = w->mapToGlobal(QPoint(30, 30));
        QTimer::singleShot(50, [&] {
            m_x.click(target, 0);
        });
        QTimer::singleShot(5000, [] { QuitApplicationEventLoop(); }); // a safety net only
        RunApplicationEventLoop();
        RemoveEventHandler(onWindow);
        RemoveEventHandler(onApplication);
        VELMAR_COMPARE_SEQUENCE(gCarbonSeen, "carbon loop",
                                {"window handler mous/1", "application handler mous/1",
                                 "window handler mous/2", "application handler mous/2"});
        DisposeWindow(w);
    }

private:
    VelmarTest::XTestInput m_x;
};

VELMAR_APP_TEST_MAIN(tst_ClassicHost)
#include "tst_classichost.moc"
