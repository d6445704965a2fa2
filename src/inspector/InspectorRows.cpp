#include "inspector/InspectorRows.h"

#include <QHeaderView>
#include <QVBoxLayout>

namespace Velmar::Private::Inspector {

RowSync::~RowSync()
{
    while (m_parent->childCount() > m_index)
        delete m_parent->takeChild(m_parent->childCount() - 1);
}

Row* RowSync::next(quintptr key, const RowValues& values, bool* changed)
{
    // Objects keep their order between refreshes, so the row is nearly always the one in
    // place; a moved object's row is fetched from further down with its subtree.
    Row* row = nullptr;
    for (int i = m_index; i < m_parent->childCount(); ++i) {
        auto* candidate = static_cast<Row*>(m_parent->child(i));
        if (candidate->key != key)
            continue;
        row = candidate;
        if (i != m_index) {
            const bool expanded = row->isExpanded();
            m_parent->takeChild(i);
            m_parent->insertChild(m_index, row);
            row->setExpanded(expanded);
        }
        break;
    }
    if (!row) {
        row = new Row;
        row->key = key;
        m_parent->insertChild(m_index, row);
    }
    ++m_index;
    *changed = !row->formatted || row->shown != values;
    if (*changed) {
        row->shown = values;
        row->formatted = true;
    }
    return row;
}

QTreeWidget* makeTree(QWidget* pane, const QString& name, const QString& objectHeader)
{
    auto* tree = new QTreeWidget(pane);
    tree->setObjectName(name);
    tree->setColumnCount(2);
    tree->setHeaderLabels({objectHeader, QStringLiteral("State")});
    tree->setUniformRowHeights(true);
    tree->header()->setSectionResizeMode(kObjectColumn, QHeaderView::ResizeToContents);
    auto* layout = new QVBoxLayout(pane);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(tree);
    return tree;
}

Row* groupRow(RowSync& groups, quintptr key, const char* title)
{
    bool changed = false;
    Row* group = groups.next(key, RowValues(), &changed);
    if (changed) {
        group->setColumn(kObjectColumn, QLatin1String(title));
        group->setExpanded(true);
    }
    return group;
}

void setCount(Row* group, qint64 count)
{
    if (group->summary == count)
        return;
    group->summary = count;
    group->setColumn(kStateColumn, QString::number(count));
}

} // namespace Velmar::Private::Inspector
