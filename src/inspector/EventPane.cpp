#include "inspector/EventPane.h"

#include "events/EventQueue.h"
#include "events/EventQueueItem.h"
#include "events/EventWaiter.h"
#include "inspector/InspectorRows.h"


namespace Velmar::Private::Inspector {

namespace {

// A host that floods the queue must not flood the tree: beyond this, one row says how many
// more there are.
constexpr int kMaxQueueRows = 500;

constexpr const char* kWaiterModes[] = {"plain", "classic", "application"};

} // namespace

EventPane::EventPane(QWidget* parent)
    : QWidget(parent), m_tree(makeTree(this, QStringLiteral("eventTree"), QStringLiteral("Item")))
{}

void EventPane::refresh()
{
    RowSync groups(m_tree->invisibleRootItem());
    refreshQueue(groupRow(groups, 1, "Event queue"));
    refreshWaiters(groupRow(groups, 2, "Waiters"));
}

void EventPane::refreshQueue(Row* group)
{
    RowSync rows(group);
    const std::vector<EventQueueItemSmartPtr> items = gMainEventQueue.items();
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
