// One check box per inspector switch, kept in step with the library's own state.
#pragma once

#include <QWidget>

namespace Velmar::Private::Inspector {

class SwitchPane : public QWidget {
public:
    explicit SwitchPane(QWidget* parent = nullptr);
    void refresh();
};

} // namespace Velmar::Private::Inspector
