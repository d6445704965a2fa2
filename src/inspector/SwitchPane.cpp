#include "inspector/SwitchPane.h"

#include "inspector/Switches.h"

#include <QCheckBox>
#include <QVBoxLayout>

namespace Velmar::Private::Inspector {

SwitchPane::SwitchPane(QWidget* parent) : QWidget(parent)
{
    auto* layout = new QVBoxLayout(this);
    for (const Switch& row : switches()) {
        auto* box = new QCheckBox(QLatin1String(row.label), this);
        box->setObjectName(QLatin1String(row.label));
        box->setToolTip(QLatin1String(row.toolTip));
        box->setChecked(row.get());
        connect(box, &QCheckBox::toggled, this, [&row](bool on) { applySwitch(row, on); });
        layout->addWidget(box);
    }
    layout->addStretch(1);
}

void SwitchPane::refresh()
{
    const auto rows = switches();
    const QList<QCheckBox*> boxes = findChildren<QCheckBox*>(Qt::FindDirectChildrenOnly);
    for (int i = 0; i < boxes.size() && i < int(rows.size()); ++i) {
        const bool on = rows[std::size_t(i)].get();
        if (boxes[i]->isChecked() != on) {
            const QSignalBlocker quiet(boxes[i]);
            boxes[i]->setChecked(on);
        }
    }
}

} // namespace Velmar::Private::Inspector
