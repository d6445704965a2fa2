#include "inspector/InspectorRows.h"

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

} // namespace Velmar::Private::Inspector
