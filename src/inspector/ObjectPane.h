// The tree of the host's objects: windows front to back with their ports and regions, the
// offscreen ports, and the menu bar's menus with their items.
#pragma once

#include <QWidget>

class QTreeWidget;
class QTreeWidgetItem;

namespace Velmar {
class AQtWindow;
}

namespace Velmar::Private::Inspector {

class Row;

class ObjectPane : public QWidget {
public:
    explicit ObjectPane(QWidget* parent = nullptr);
    void refresh();

private:
    void refreshWindows(Row* group);
    void refreshWindowPort(Row* windowRow, AQtWindow* window);
    void refreshOffscreenPorts(Row* group);
    void refreshMenus(Row* group);

    QTreeWidget* m_tree;
};

} // namespace Velmar::Private::Inspector
