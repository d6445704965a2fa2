// While a drag runs: resting over another tab of a tab bar selects that tab; leaving the tab
// widget selects the first one again.
#pragma once

#include <QElapsedTimer>
#include <QObject>
#include <QPointer>
#include <QTimer>

class QTabBar;

namespace Velmar::Private {

class DragTabSwitcher : public QObject {
    Q_OBJECT

public:
    DragTabSwitcher();

public Q_SLOTS:
    void checkDnDTabTimer();

private:
    QWidget* tabWidgetOf(QTabBar* bar) const;

    QTimer m_timer;
    QPointer<QTabBar> m_bar; // the bar and tab the cursor rests over, since when
    int m_tab = -1;
    QElapsedTimer m_since;
    QPointer<QTabBar> m_switchedBar; // the bar switched, and its tab before
    int m_originalTab = -1;
};

} // namespace Velmar::Private
