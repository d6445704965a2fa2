#include "inspector/LogPane.h"

#include <Velmar/Diagnostics.h>

#include "inspector/LogTap.h"

#include <QCheckBox>
#include <QGridLayout>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QVBoxLayout>

namespace Velmar::Private::Inspector {

namespace {

// Every bit that names a category, in bit order.
QList<UInt32> categories()
{
    QList<UInt32> bits;
    for (int i = 0; i < 32; ++i) {
        const UInt32 bit = UInt32(1) << i;
        if (qstrcmp(LogCategoryName(bit), "N/A") != 0)
            bits.append(bit);
    }
    return bits;
}

constexpr const char* kCategoryProperty = "velmarLogCategory";

} // namespace

LogPane::LogPane(QWidget* parent) : QWidget(parent), m_text(new QPlainTextEdit(this))
{
    setWindowTitle(QStringLiteral("Velmar logger"));
    m_text->setObjectName(QStringLiteral("logText"));
    m_text->setReadOnly(true);
    m_text->setMaximumBlockCount(kMaxLines);
    m_text->setLineWrapMode(QPlainTextEdit::NoWrap);
    m_text->setFont(QFont(QStringLiteral("monospace")));

    auto* clear = new QPushButton(QStringLiteral("Clear"), this);
    clear->setObjectName(QStringLiteral("Clear"));
    connect(clear, &QPushButton::clicked, m_text, &QPlainTextEdit::clear);

    auto* boxes = new QGridLayout;
    const QList<UInt32> bits = categories();
    constexpr int kColumns = 5;
    for (int i = 0; i < bits.size(); ++i) {
        const UInt32 bit = bits[i];
        auto* box = new QCheckBox(QLatin1String(LogCategoryName(bit)), this);
        box->setObjectName(QLatin1String(LogCategoryName(bit)));
        box->setProperty(kCategoryProperty, bit);
        box->setChecked(LogCategoryEnabled(bit));
        connect(box, &QCheckBox::toggled, this, [bit](bool on) { SetLogCategory(bit, on); });
        boxes->addWidget(box, i / kColumns, i % kColumns);
    }
    boxes->addWidget(clear, 0, kColumns, Qt::AlignRight);

    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(4, 4, 4, 4);
    layout->addLayout(boxes);
    layout->addWidget(m_text);
}

void LogPane::refresh()
{
    const QStringList lines = takeLoggedLines();
    if (!lines.isEmpty())
        m_text->appendPlainText(lines.join(QLatin1Char('\n')));
    // The host may turn categories on and off itself.
    for (QCheckBox* box : findChildren<QCheckBox*>()) {
        const UInt32 bit = box->property(kCategoryProperty).toUInt();
        const bool on = LogCategoryEnabled(bit);
        if (box->isChecked() != on) {
            const QSignalBlocker quiet(box);
            box->setChecked(on);
        }
    }
}

} // namespace Velmar::Private::Inspector
