// The inspector's lists are trees of reused rows. Each refresh walks the host's objects once
// and hands every row the values it shows; a row reformats its texts only when those values
// changed, and keeps its place and expansion while its object lives.
#pragma once

#include <QString>
#include <QTreeWidget>
#include <QTreeWidgetItem>

#include <array>

namespace Velmar::Private::Inspector {

// What one row shows, as plain numbers plus at most one string (shared with the object's own
// string, never copied), so that comparing them allocates nothing.
struct RowValues {
    std::array<qint64, 8> n{};
    QString text;

    bool operator==(const RowValues& other) const { return n == other.n && text == other.text; }
    bool operator!=(const RowValues& other) const { return !(*this == other); }
};

class Row : public QTreeWidgetItem {
public:
    // The object the row stands for: an address that is only ever compared, never followed.
    quintptr key = 0;
    RowValues shown;
    bool formatted = false;
    // A figure the row shows about its children (a group's count), -1 until shown.
    qint64 summary = -1;

    // Sets a column's text only when it differs, sparing the view a repaint.
    void setColumn(int column, const QString& value)
    {
        if (text(column) != value)
            setText(column, value);
    }
};

// One pass over the children of `parent`: next() returns the row for each object in turn,
// reusing the row that already stands for it; the rows not visited (objects that went) are
// deleted when the pass ends.
class RowSync {
public:
    explicit RowSync(QTreeWidgetItem* parent) : m_parent(parent) {}
    ~RowSync();
    RowSync(const RowSync&) = delete;
    RowSync& operator=(const RowSync&) = delete;

    // The row for `key`, placed at the next position. `changed` says whether `values` differ
    // from what the row shows (always true for a new row); the row then holds `values`.
    Row* next(quintptr key, const RowValues& values, bool* changed);
    int count() const { return m_index; }

private:
    QTreeWidgetItem* m_parent;
    int m_index = 0;
};

// The two columns every inspector tree has.
enum Column { kObjectColumn = 0, kStateColumn = 1 };

// A two-column tree filling `pane` (its only child), named `name` for tests to find.
QTreeWidget* makeTree(QWidget* pane, const QString& name, const QString& objectHeader);

// The group row at the next position under `root`, titled and expanded when new.
Row* groupRow(RowSync& groups, quintptr key, const char* title);

// Shows a group's count in its state column (reformatted only when it changes).
void setCount(Row* group, qint64 count);

template <typename T>
quintptr keyOf(const T* object)
{
    return reinterpret_cast<quintptr>(object);
}

} // namespace Velmar::Private::Inspector
