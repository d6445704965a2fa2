// Where the default shell shows the menu bar: a strip across the top of the primary
// screen, or inside a window the host names.
#include <Velmar/HostShell.h>

#include "platform/Platform.h"

#include <QGuiApplication>
#include <QLayout>
#include <QMainWindow>
#include <QMenuBar>
#include <QScreen>

namespace Velmar::Brindle {

namespace {

void showAsStrip(QMenuBar* bar)
{
    QScreen* screen = QGuiApplication::primaryScreen();
    if (!screen)
        return;
    if (bar->parentWidget() || !bar->isWindow()) {
        if (auto* layout = bar->parentWidget() ? bar->parentWidget()->layout() : nullptr;
            layout && layout->menuBar() == bar)
            layout->setMenuBar(nullptr);
        bar->setParent(nullptr);
    }
    // A dock the window manager keeps above the other windows and never activates, so that
    // using the menu bar leaves the host's front window active, as it did on the Mac.
    bar->setWindowFlags(Qt::Window | Qt::FramelessWindowHint | Qt::WindowStaysOnTopHint
        | Qt::WindowDoesNotAcceptFocus);
    bar->setAttribute(Qt::WA_X11NetWmWindowTypeDock);
    bar->setAttribute(Qt::WA_ShowWithoutActivating);
    bar->setWindowTitle(QGuiApplication::applicationDisplayName());
    const QRect area = screen->geometry();
    bar->setGeometry(area.x(), area.y(), area.width(), bar->sizeHint().height());
    bar->show();
    Private::Platform::reserveScreenTop(bar, bar->height());
}

void putIntoWindow(QMenuBar* bar, QWidget* window)
{
    if (auto* main = qobject_cast<QMainWindow*>(window)) {
        if (main->menuBar() != bar)
            main->setMenuBar(bar);
    } else if (QLayout* layout = window->layout()) {
        layout->setMenuBar(bar);
    } else {
        bar->setParent(window);
        bar->setGeometry(0, 0, window->width(), bar->sizeHint().height());
    }
    bar->show();
}

} // namespace

void DecorationManager::PlaceMenuBar(QMenuBar* menuBar, QWidget* window)
{
    if (!menuBar)
        return;
    menuBar->setNativeMenuBar(false);
    if (window)
        putIntoWindow(menuBar, window);
    else
        showAsStrip(menuBar);
}

} // namespace Velmar::Brindle
