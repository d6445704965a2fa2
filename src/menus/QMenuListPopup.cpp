#include "menus/QMenuListPopup.h"

#include "menus/MenuPrivate.h"

#include <QEventLoop>
#include <QKeyEvent>
#include <QListWidget>
#include <QPointer>
#include <QScrollBar>
#include <QVBoxLayout>

namespace Velmar::Private {

QMenuListPopup::QMenuListPopup(QMenu* menu, bool sorted)
    : QFrame(nullptr, Qt::Popup), m_menu(menu), m_list(new QListWidget(this))
{
    setFrameShape(QFrame::StyledPanel);
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->setSpacing(0);
    layout->addWidget(m_list);
    m_list->setFrameShape(QFrame::NoFrame);
    m_list->setFrameShadow(QFrame::Plain);
    m_list->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    m_list->setVerticalScrollBarPolicy(Qt::ScrollBarAsNeeded);
    m_list->setSelectionMode(QAbstractItemView::SingleSelection);
    m_list->setSortingEnabled(sorted);
    connect(m_list, &QListWidget::itemActivated, this, &QMenuListPopup::itemSelected);
    connect(m_list, &QListWidget::itemClicked, this, &QMenuListPopup::itemSelected);
}

void QMenuListPopup::fill()
{
    m_list->clear();
    m_actions.clear();
    if (!m_menu)
        return;
    ApplyMenuFont(m_menu);
    m_list->setFont(m_menu->font());
    QString longest;
    for (QAction* action : m_menu->actions()) {
        if (action->isSeparator())
            continue;
        auto* item = new QListWidgetItem(action->text(), m_list);
        item->setData(Qt::UserRole, int(m_actions.size()));
        m_actions.emplace_back(action);
        if (action->isChecked())
            m_list->setCurrentItem(item);
        if (action->text().size() > longest.size())
            longest = action->text();
    }
    const QFontMetrics metrics(m_list->font());
    setFixedWidth(
        metrics.horizontalAdvance(longest) + 2 * m_list->verticalScrollBar()->sizeHint().width());
    setFixedHeight(30 * metrics.lineSpacing());
}

QAction* QMenuListPopup::run(const QPoint& globalPos)
{
    fill();
    m_chosen = nullptr;
    winId();
    move(globalPos);
    show();
    m_list->setFocus();
    QPointer<QMenuListPopup> guard(this);
    QEventLoop loop;
    m_loop = &loop;
    loop.exec();
    if (!guard)
        return nullptr;
    m_loop = nullptr;
    return m_chosen;
}

void QMenuListPopup::itemSelected()
{
    if (!isVisible())
        return;
    if (QListWidgetItem* item = m_list->currentItem()) {
        const std::size_t row = std::size_t(item->data(Qt::UserRole).toInt());
        m_chosen = row < m_actions.size() ? m_actions[row].data() : nullptr;
    }
    hide();
}

void QMenuListPopup::keyPressEvent(QKeyEvent* event)
{
    switch (event->key()) {
    case Qt::Key_Return:
    case Qt::Key_Enter: itemSelected(); break;
    case Qt::Key_Escape: hide(); break;
    default: break;
    }
}

void QMenuListPopup::hideEvent(QHideEvent* event)
{
    QFrame::hideEvent(event);
    if (m_loop) {
        m_loop->exit(0);
        m_loop = nullptr;
    }
}

} // namespace Velmar::Private
