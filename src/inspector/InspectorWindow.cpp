#include "inspector/InspectorWindow.h"

#include "inspector/EventPane.h"
#include "inspector/LogPane.h"
#include "inspector/LogTap.h"
#include "inspector/ObjectPane.h"
#include "inspector/SwitchPane.h"

#include <QPointer>
#include <QTabWidget>
#include <QVBoxLayout>

namespace Velmar::Private::Inspector {

namespace {
QPointer<InspectorWindow> gInspector;
}

InspectorWindow::InspectorWindow()
    : m_tabs(new QTabWidget(this)),
      m_objects(new ObjectPane),
      m_events(new EventPane),
      m_log(new LogPane),
      m_switches(new SwitchPane)
{
    setObjectName(QStringLiteral("VelmarInspector"));
    setWindowTitle(QStringLiteral("Velmar inspector"));
    // A tool window of its own: never one of the host's windows, never in its window list.
    setWindowFlag(Qt::Tool);
    m_tabs->addTab(m_objects, QStringLiteral("Objects"));
    m_tabs->addTab(m_events, QStringLiteral("Events"));
    m_tabs->addTab(m_log, m_log->windowTitle());
    m_tabs->addTab(m_switches, QStringLiteral("Switches"));
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(m_tabs);
    resize(560, 640);

    m_timer.setInterval(kRefreshMs);
    connect(&m_timer, &QTimer::timeout, this, &InspectorWindow::refresh);
}

InspectorWindow::~InspectorWindow()
{
    detachLogTap();
}

void InspectorWindow::refresh()
{
    m_objects->refresh();
    m_events->refresh();
    m_log->refresh();
    m_switches->refresh();
}

InspectorWindow* InspectorWindow::instance(bool create)
{
    if (!gInspector && create)
        gInspector = new InspectorWindow;
    return gInspector;
}

void InspectorWindow::showEvent(QShowEvent* e)
{
    attachLogTap();
    refresh();
    m_timer.start();
    QWidget::showEvent(e);
}

void InspectorWindow::hideEvent(QHideEvent* e)
{
    m_timer.stop();
    detachLogTap();
    takeLoggedLines(); // what came while closing is not kept for the next opening
    QWidget::hideEvent(e);
}

} // namespace Velmar::Private::Inspector
