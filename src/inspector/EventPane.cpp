#include "inspector/EventPane.h"

#include "events/EventQueue.h"
#include "events/EventQueueItem.h"
#include "events/EventWaiter.h"
#include "inspector/InspectorRows.h"

#include <QHeaderView>
#include <QTreeWidget>
#include <QVBoxLayout>

namespace Velmar::Private::Inspector {

namespace {

enum Column { kObjectColumn = 0, kStateColumn = 1 };

// A host that floods the queue must not flood the tree: beyond this, one row says how many
// more there are.
constexpr int kMaxQueueRows = 500;

constexpr const char* kWaiterModes[] = {"plain", "classic", "application"};

void setCount(Row* group, qint64 count)
{
    if (group->summary == count)
        return;
    group->summary = count;
    group->setColumn(kStateColumn, QString::number(count));
}

} // namespace

EventPane::EventPane(QWidget* parent) : QWidget(parent), m_tree(new QTreeWidget(this))
{
    m_tree->setObjectName(QStringLiteral("eventTree"));
    m_tree->setColumnCount(2);
    m_tree->setHeaderLabels({QStringLiteral("Item"), QStringLiteral("State")});
    m_tree->setUniformRowHeights(true);
    m_tree->header()->setSectionResizeMode(kObjectColumn, QHeaderView::ResizeToContents);
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(m_tree);
}

void EventPane::refresh()
{
    RowSync groups(m_tree->invisibleRootItem());
    bool changed = false;
    Row* queue = groups.next(1, RowValues(), &changed);
    if (changed) {
        queue->setColumn(kObjectColumn, QStringLiteral("Event queue"));
        queue->setExpanded(true);
    }
    refreshQueue(queue);
    Row* waiters = groups.next(2, RowValues(), &changed);
    if (changed) {
        waiters->setColumn(kObjectColumn, QStringLiteral("Waiters"));
        waiters->setExpanded(true);
    }
    refreshWaiters(waiters);
}

void EventPane::refreshQueue(Row* group)
{
    RowSync rows(group);
    const EventQueue::ItemList& items = gMainEventQueue.items();
    int shown = 0;
    for (const EventQueueItemSmartPtr& item : items) {
        if (shown == kMaxQueueRows)
            break;
        ++shown;
        RowValues v;
        v.n = {item->eventClass, item->eventKind, item->when, 0, 0, 0, 0, 0};
        bool changed = false;
        Row* row = rows.next(keyOf(item.get()), v, &changed);
        if (changed) {
            row->setColumn(kObjectColumn,
                EventQueueItem::EventClassAndKindToString(item->eventClass, item->eventKind));
            row->setColumn(kStateColumn, item->toString());
        }
    }
    const qint64 hidden = qint64(items.size()) - shown;
    if (hidden > 0) {
        RowValues v;
        v.n[0] = hidden;
        bool changed = false;
        Row* row = rows.next(quintptr(-1), v, &changed);
        if (changed)
            row->setColumn(kObjectColumn, QStringLiteral("... %1 more").arg(hidden));
    }
    setCount(group, qint64(items.size()));
}

void EventPane::refreshWaiters(Row* group)
{
    RowSync rows(group);
    int depth = 0;
    for (VelmarEventWaiter* w = VelmarEventWaiter::topMost(); w; w = w->interrupted()) {
        RowValues v;
        v.n = {w->mode(), w->typeCount(), w->isLoopRunning(), ++depth, 0, 0, 0, 0};
        bool changed = false;
        Row* row = rows.next(keyOf(w), v, &changed);
        if (!changed)
            continue;
        const int mode = int(w->mode());
        row->setColumn(kObjectColumn,
            QStringLiteral("%1 waiter").arg(QLatin1String(
                mode >= 0 && mode < 3 ? kWaiterModes[mode] : "unknown")));
        row->setColumn(kStateColumn,
            QStringLiteral("%1, %2")
                .arg(w->typeCount() == 0 ? QStringLiteral("any event")
                                         : QStringLiteral("%1 event types").arg(w->typeCount()))
                .arg(w->isLoopRunning() ? QStringLiteral("waiting") : QStringLiteral("not waiting")));
    }
    setCount(group, depth);
}

} // namespace Velmar::Private::Inspector
