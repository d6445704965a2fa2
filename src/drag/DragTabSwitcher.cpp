#include "drag/DragTabSwitcher.h"

#include <QApplication>
#include <QCursor>
#include <QTabBar>
#include <QTabWidget>

namespace Velmar::Private {

namespace {

constexpr int kCheckMs = 100;
constexpr qint64 kRestMs = 301;

QTabBar* barOf(QWidget* w)
{
    for (; w; w = w->parentWidget()) {
        if (auto* bar = qobject_cast<QTabBar*>(w))
            return bar;
        if (w->isWindow())
            break;
    }
    return nullptr;
}

// The drag's own picture floats under the cursor, where the window system finds it first:
// the application's windows are asked directly when it hides what is below.
QTabBar* tabBarAt(const QPoint& global)
{
    if (QTabBar* bar = barOf(QApplication::widgetAt(global)))
        return bar;
    for (QWidget* top : QApplication::topLevelWidgets()) {
        if (top->isVisible() && top->geometry().contains(global))
            if (QTabBar* bar = barOf(top->childAt(top->mapFromGlobal(global))))
                return bar;
    }
    return nullptr;
}

} // namespace

DragTabSwitcher::DragTabSwitcher()
{
    m_timer.setSingleShot(true);
    connect(&m_timer, &QTimer::timeout, this, &DragTabSwitcher::checkDnDTabTimer);
    m_timer.start(kCheckMs);
}

QWidget* DragTabSwitcher::tabWidgetOf(QTabBar* bar) const
{
    QWidget* parent = bar->parentWidget();
    return qobject_cast<QTabWidget*>(parent) ? parent : static_cast<QWidget*>(bar);
}

void DragTabSwitcher::checkDnDTabTimer()
{
    const QPoint at = QCursor::pos();
    // Away from the tab widget that was switched: its first tab comes back.
    if (m_switchedBar) {
        QWidget* owner = tabWidgetOf(m_switchedBar);
        if (!QRect(owner->mapToGlobal(QPoint(0, 0)), owner->size()).contains(at)) {
            m_switchedBar->setCurrentIndex(m_originalTab);
            m_switchedBar = nullptr;
            m_originalTab = -1;
        }
    }
    QTabBar* bar = tabBarAt(at);
    const int tab = bar ? bar->tabAt(bar->mapFromGlobal(at)) : -1;
    if (bar != m_bar || tab != m_tab) {
        m_bar = bar;
        m_tab = tab;
        m_since.start();
    } else if (bar && tab >= 0 && tab != bar->currentIndex() && m_since.elapsed() >= kRestMs) {
        if (m_switchedBar != bar) {
            if (m_switchedBar)
                m_switchedBar->setCurrentIndex(m_originalTab);
            m_switchedBar = bar;
            m_originalTab = bar->currentIndex();
        }
        bar->setCurrentIndex(tab);
    }
    m_timer.start(kCheckMs);
}

} // namespace Velmar::Private
