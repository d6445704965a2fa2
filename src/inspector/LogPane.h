// The log as it is written, with a "Clear" button and one check box per log category that
// turns the category on and off for the whole library.
#pragma once

#include <QWidget>

class QPlainTextEdit;

namespace Velmar::Private::Inspector {

class LogPane : public QWidget {
public:
    // Older lines scroll away beyond this many.
    static constexpr int kMaxLines = 5000;

    explicit LogPane(QWidget* parent = nullptr);
    // Shows the lines logged since the last call and brings the check boxes up to date.
    void refresh();

private:
    QPlainTextEdit* m_text;
};

} // namespace Velmar::Private::Inspector
