// The main event queue, oldest first, and the stack of event waiters, innermost first.
#pragma once

#include <QWidget>

class QTreeWidget;

namespace Velmar::Private::Inspector {

class Row;

class EventPane : public QWidget {
public:
    explicit EventPane(QWidget* parent = nullptr);
    void refresh();

private:
    void refreshQueue(Row* group);
    void refreshWaiters(Row* group);

    QTreeWidget* m_tree;
};

} // namespace Velmar::Private::Inspector
