// Clicks the window manager and Qt take for themselves (a frame's close box, title bar, zoom
// button and edges; the Qt menu bar) handed to the program as the mouse-downs classic
// programs wait for: FindWindow places them (inGoAway, inDrag, inZoomIn/Out, inGrow,
// inMenuBar) and TrackGoAway, DragWindow, TrackBox, GrowWindow and MenuSelect answer them.
#include "classic/ClassicPrivate.h"

#include <QEvent>
#include <QWidget>
#include <QWindowStateChangeEvent>

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

// A frame's changes while the button is held are the user's; others are the program's own or
// the window system placing a new window.
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
        case QEvent::WindowStateChange:
            if (gOwnGeometry == 0) {
                const auto* change = static_cast<QWindowStateChangeEvent*>(e);
                if (window->windowState() & Qt::WindowMaximized)
                    queueFrameClick(inZoomOut, window);
                else if (change->oldState() & Qt::WindowMaximized)
                    queueFrameClick(inZoomIn, window);
            }
            break;
        case QEvent::Move:
        case QEvent::Resize: {
            const short part = e->type() == QEvent::Move ? short(inDrag) : short(inGrow);
            if (gOwnGeometry == 0 && window->isVisible() && Velmar::Button()
                && !pending(window, part))
                queueFrameClick(part, window);
            break;
        }
        default:
            break;
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

OwnGeometryChange::OwnGeometryChange() { ++gOwnGeometry; }
OwnGeometryChange::~OwnGeometryChange() { --gOwnGeometry; }

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
    const Velmar::EventTypeSpec spec{Velmar::kEventClassVelmar, Velmar::kEventVelmarMenuTriggered};
    Velmar::InstallEventHandler(
        Velmar::GetApplicationEventTarget(), menuTriggered, 1, &spec, nullptr, nullptr);
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
