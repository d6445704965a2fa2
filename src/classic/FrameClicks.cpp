// Clicks the window manager and Qt take for themselves (a frame's close box, title bar, zoom
// button and edges; the Qt menu bar) handed to the program as the mouse-downs classic
// programs wait for: FindWindow places them (inGoAway, inDrag, inZoomIn/Out, inGrow,
// inMenuBar) and TrackGoAway, DragWindow, TrackBox, GrowWindow and MenuSelect answer them.
#include "classic/ClassicPrivate.h"

#include <QElapsedTimer>
#include <QEvent>
#include <QTimer>
#include <QWidget>

#include <deque>

namespace VelmarClassic {

namespace {

std::deque<FrameClick>& clicks()
{
    static auto* queue = new std::deque<FrameClick>;
    return *queue;
}
FrameClick gAnswering;
bool gHaveAnswering = false;
int gOwnGeometry = 0;

bool pending(Velmar::AQtWindow* window, short part)
{
    for (const FrameClick& c : clicks())
        if (c.window == window && c.part == part)
            return true;
    return false;
}

// What the window manager did to a window is read once its events have settled: a change of
// the maximised state is a zoom, of the size a grow, of the place a drag. Changes the program
// made itself, and the window manager placing a window it has just shown, are no clicks.
struct Seen {
    QRect geometry;
    bool maximized = false;
    bool scheduled = false;
    QElapsedTimer shown;
};

std::unordered_map<Velmar::AQtWindow*, Seen>& seen()
{
    static auto* map = new std::unordered_map<Velmar::AQtWindow*, Seen>;
    return *map;
}

QElapsedTimer gOwnChangeEnded;
constexpr qint64 kSettleMs = 120;
constexpr qint64 kPlacementMs = 600;

void record(Velmar::AQtWindow* window, Seen& s)
{
    s.geometry = window->geometry();
    s.maximized = (window->windowState() & Qt::WindowMaximized) != 0;
}

void decide(QPointer<Velmar::AQtWindow> window)
{
    if (!window || !windowLink(window))
        return;
    Seen& s = seen()[window];
    s.scheduled = false;
    const bool maximized = (window->windowState() & Qt::WindowMaximized) != 0;
    const QRect now = window->geometry();
    const bool own =
        gOwnGeometry > 0 || (gOwnChangeEnded.isValid() && gOwnChangeEnded.elapsed() < kPlacementMs);
    const bool placing = !s.shown.isValid() || s.shown.elapsed() < kPlacementMs;
    if (!own && window->isVisible()) {
        if (maximized != s.maximized)
            queueFrameClick(maximized ? short(inZoomOut) : short(inZoomIn), window);
        else if (now.size() != s.geometry.size())
            queueFrameClick(inGrow, window);
        else if (now.topLeft() != s.geometry.topLeft() && !placing)
            queueFrameClick(inDrag, window);
    }
    record(window, s);
}

class WindowWatcher : public QObject {
public:
    bool eventFilter(QObject* watched, QEvent* e) override
    {
        auto* window = qobject_cast<Velmar::AQtWindow*>(watched);
        if (!window || !windowLink(window))
            return false;
        switch (e->type()) {
        case QEvent::Close:
            if (!pending(window, inGoAway))
                queueFrameClick(inGoAway, window);
            break;
        case QEvent::Show: {
            Seen& s = seen()[window];
            s.shown.start();
            record(window, s);
            break;
        }
        case QEvent::WindowStateChange:
        case QEvent::Move:
        case QEvent::Resize: {
            Seen& s = seen()[window];
            if (!s.scheduled) {
                s.scheduled = true;
                QTimer::singleShot(
                    kSettleMs, this, [w = QPointer<Velmar::AQtWindow>(window)] { decide(w); });
            }
            break;
        }
        case QEvent::Destroy: seen().erase(window); break;
        default: break;
        }
        return false;
    }
};

WindowWatcher* watcher()
{
    static auto* w = new WindowWatcher;
    return w;
}

Velmar::OSStatus menuTriggered(Velmar::EventHandlerCallRef, Velmar::EventRef, void*)
{
    queueFrameClick(inMenuBar, nullptr);
    return Velmar::eventNotHandledErr;
}

Point clickPoint(short part, Velmar::AQtWindow* window)
{
    if (part == inMenuBar || !window)
        return Point{1, 1};
    Rect content{};
    Velmar::GetWindowBounds(window, Velmar::kWindowContentRgn, &content);
    if (part == inGrow)
        return Point{short(content.bottom - 1), short(content.right - 1)};
    // Just above the content: where the title bar is.
    return Point{short(content.top - 4), short(content.left + 4)};
}

} // namespace

OwnGeometryChange::OwnGeometryChange()
{
    ++gOwnGeometry;
}
OwnGeometryChange::~OwnGeometryChange()
{
    if (--gOwnGeometry == 0)
        gOwnChangeEnded.start();
}

void watchWindow(Velmar::AQtWindow* window)
{
    window->installEventFilter(watcher());
}

void watchMenuBar()
{
    static bool installed = false;
    if (installed)
        return;
    installed = true;
    const Velmar::EventTypeSpec menuChoice{Velmar::kEventClassVelmar,
                                           Velmar::kEventVelmarMenuTriggered};
    Velmar::InstallEventHandler(
        Velmar::GetApplicationEventTarget(), menuTriggered, 1, &menuChoice, nullptr, nullptr);
}

void queueFrameClick(short part, Velmar::AQtWindow* window)
{
    FrameClick click;
    click.part = part;
    click.window = window;
    click.where = clickPoint(part, window);
    clicks().push_back(click);
}

bool frameClickWaiting()
{
    return !clicks().empty();
}

bool takeFrameClick(EventRecord* event, short mask)
{
    if (!(mask & mDownMask))
        return false;
    while (!clicks().empty()) {
        FrameClick click = clicks().front();
        clicks().pop_front();
        if (click.part != inMenuBar && !click.window)
            continue; // its window went meanwhile
        gAnswering = click;
        gHaveAnswering = true;
        event->what = mouseDown;
        event->message = 0;
        event->when = Velmar::TickCount();
        event->where = click.where;
        event->modifiers = EventModifiers(Velmar::GetCurrentKeyModifiers() & 0xFF00);
        return true;
    }
    return false;
}

const FrameClick* answeringClick(Point where)
{
    if (!gHaveAnswering || gAnswering.where.h != where.h || gAnswering.where.v != where.v)
        return nullptr;
    return &gAnswering;
}

FrameClick* answeringClickFor(Velmar::AQtWindow* window, short part)
{
    if (!gHaveAnswering || gAnswering.window != window || gAnswering.part != part)
        return nullptr;
    return &gAnswering;
}

void finishClick()
{
    gHaveAnswering = false;
}

} // namespace VelmarClassic
