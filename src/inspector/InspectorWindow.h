// The inspector's window: the host's objects, its events and waiters, the log and the
// switches, one tab each. A timer refreshes them while the window is shown and stops with it,
// so a closed inspector costs nothing.
#pragma once

#include <QTimer>
#include <QWidget>

class QTabWidget;

namespace Velmar::Private::Inspector {

class ObjectPane;
class EventPane;
class LogPane;
class SwitchPane;

class InspectorWindow : public QWidget {
public:
    // How often the panes catch up with the host.
    static constexpr int kRefreshMs = 250;

    InspectorWindow();
    ~InspectorWindow() override;
    // Brings every pane up to date now.
    void refresh();

    // The one inspector of the process, made on first use.
    static InspectorWindow* instance(bool create);

protected:
    void showEvent(QShowEvent* e) override;
    void hideEvent(QHideEvent* e) override;

private:
    QTabWidget* m_tabs;
    ObjectPane* m_objects;
    EventPane* m_events;
    LogPane* m_log;
    SwitchPane* m_switches;
    QTimer m_timer;
};

} // namespace Velmar::Private::Inspector
