// A long menu shown as a scrolling list instead of a QMenu running off the screen.
#pragma once

#include <QFrame>
#include <QPointer>

#include <vector>

class QAction;
class QEventLoop;
class QListWidget;
class QMenu;

namespace Velmar::Private {

class QMenuListPopup : public QFrame {
    Q_OBJECT

public:
    QMenuListPopup(QMenu* menu, bool sorted);

    // Shows the list at `globalPos` and waits: the chosen action, or null when the user
    // dismissed the list (Escape, a click elsewhere) or the pop-up was destroyed meanwhile.
    QAction* run(const QPoint& globalPos);

    QListWidget* list() const { return m_list; }

public Q_SLOTS:
    void itemSelected();

protected:
    void keyPressEvent(QKeyEvent* event) override;
    void hideEvent(QHideEvent* event) override;

private:
    void fill();

    QPointer<QMenu> m_menu;
    // The listed items, by row: the host may delete any of them while the list shows.
    std::vector<QPointer<QAction>> m_actions;
    QPointer<QAction> m_chosen;
    QListWidget* m_list;
    QEventLoop* m_loop = nullptr;
};

} // namespace Velmar::Private
