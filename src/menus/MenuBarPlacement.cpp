// When and where the menu bar is shown.
#include "menus/MenuPrivate.h"

#include <Velmar/Application.h>
#include <Velmar/HostShell.h>

#include <QEvent>
#include <QMenuBar>
#include <QPointer>

namespace Velmar {

using namespace Private;

namespace {

void place(QWidget* window);

// Takes the bar out of the host's window it was shown in.
void detachMenuBar()
{
    if (QMenuBar* bar = applicationMenuBar(); bar && bar->parentWidget()) {
        bar->hide();
        bar->setParent(nullptr);
    }
}

// Keeps the bar inside the host's window only while that window shows, so that closing or
// deleting the window never takes the application's menu bar with it.
class WindowWatcher : public QObject {
public:
    bool eventFilter(QObject* watched, QEvent* event) override
    {
        if (watched != window)
            return false;
        if (event->type() == QEvent::Show) {
            place(window);
        } else if (event->type() == QEvent::Hide) {
            detachMenuBar();
        }
        return false;
    }
    QPointer<QWidget> window;
};

struct Placement {
    bool placed = false;
    WindowWatcher* watcher = nullptr;
};
Placement gPlacement;

void place(QWidget* window)
{
    QMenuBar* bar = applicationMenuBar();
    Brindle::DecorationManager* shell = Brindle::DecorationManager::Instance();
    if (!bar || !shell)
        return;
    gPlacement.placed = true;
    if (window && !window->isVisible())
        return; // it goes in when the window shows
    shell->PlaceMenuBar(bar, window);
}

} // namespace

namespace Private {

void placeMenuBarOnce()
{
    if (!gPlacement.placed)
        place(gPlacement.watcher ? gPlacement.watcher->window.data() : nullptr);
}

} // namespace Private

void SetMenuBarWindow(QWidget* window)
{
    if (window)
        window = window->window();
    if (!gPlacement.watcher)
        gPlacement.watcher = new WindowWatcher;
    WindowWatcher* watcher = gPlacement.watcher;
    if (watcher->window)
        watcher->window->removeEventFilter(watcher);
    watcher->window = window;
    if (window)
        window->installEventFilter(watcher);
    if (!window)
        detachMenuBar();
    place(window);
}

} // namespace Velmar
