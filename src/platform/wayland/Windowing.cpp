// The Wayland backend's window requests. A client may not place its top-level windows,
// restack them among other clients' windows or keep a strip of the screen for itself: the
// compositor decides. Each of these does the nearest thing allowed and says so once.
#include "platform/Backends.h"
#include "platform/Notices.h"

#include <QCoreApplication>
#include <QEvent>
#include <QWidget>

namespace Velmar::Private::Platform::Wayland {

namespace {

constexpr const char* kPlacementNotice =
    "Velmar::MoveWindow: the Wayland compositor places top-level windows; a window's position "
    "is kept as asked for only in the library's own coordinates (QT_QPA_PLATFORM=xcb places it)";
constexpr const char* kStackingNotice =
    "Velmar::SendBehind: the Wayland compositor stacks top-level windows; the library's window "
    "list keeps the order asked for";
constexpr const char* kScreenStripNotice =
    "Velmar::MenuBar: the Wayland compositor keeps no screen strip for the menu bar; it is an "
    "ordinary window";

bool isPlacedTopLevel(const QWidget* widget)
{
    if (!widget->isWindow())
        return false;
    // Pop-ups, menus and tool tips are placed relative to their parent: Wayland allows that.
    const Qt::WindowType type = widget->windowType();
    if (type == Qt::Popup || type == Qt::ToolTip || type == Qt::SplashScreen)
        return false;
    return widget->testAttribute(Qt::WA_Moved);
}

// Sees the first top-level window a program places, then leaves; it stays while the notice
// finds its log category off, so that switching the category on later still shows it.
class PlacementWatcher : public QObject {
public:
    using QObject::QObject;

protected:
    bool eventFilter(QObject* watched, QEvent* event) override
    {
        const QEvent::Type type = event->type();
        if ((type == QEvent::Show || type == QEvent::Move) && watched->isWidgetType()
            && isPlacedTopLevel(static_cast<QWidget*>(watched)) && noticeOnce(kPlacementNotice))
            deleteLater();
        return false;
    }
};

} // namespace

void watchWindows()
{
    static QCoreApplication* sWatched = nullptr;
    QCoreApplication* app = QCoreApplication::instance();
    if (!app || app == sWatched)
        return;
    sWatched = app;
    app->installEventFilter(new PlacementWatcher(app));
}

void placeWindowBehind(QWidget* window, QWidget* behind)
{
    if (!window)
        return;
    if (window->isWindow()) {
        noticeOnce(kStackingNotice);
        return;
    }
    // Children of one window are this process's own surfaces: restacked as anywhere else.
    if (window != behind) {
        if (!behind)
            window->lower();
        else if (window->parentWidget() == behind->parentWidget())
            window->stackUnder(behind);
    }
}

void reserveScreenTop(QWidget* window, int height)
{
    if (window && height > 0)
        noticeOnce(kScreenStripNotice);
}

} // namespace Velmar::Private::Platform::Wayland
