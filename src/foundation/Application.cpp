// Construction, shutdown, accessors and the menu slots of the application object.
#include <Velmar/Application.h>

#include <Velmar/Diagnostics.h>
#include <Velmar/Events.h>
#include <Velmar/HostShell.h>

#include "events/AppActivation.h"
#include "host/Replaceable.h"
#include "events/EventQueue.h"
#include "foundation/ApplicationPrivate.h"
#include "foundation/MessageHandler.h"
#include "inspector/InspectorShortcut.h"

#include <QAction>
#include <QIcon>
#include <QMenu>
#include <QMenuBar>
#include <QSettings>
#include <QStyle>
#include <QStyleFactory>

namespace Velmar {

namespace Private {

namespace {
Replaceable<ApplicationHooks> gApplicationHooks;
bool gInspectorEnabled = false;
bool gInspectorCopyBitsToScreen = false;

void scheduleMenuEvent(UInt32 kind, bool withModifiers)
{
    EventQueueItemSmartPtr item = EventQueueItemSmartPtr::Create();
    item->eventClass = kEventClassVelmar;
    item->eventKind = kind;
    item->when = TickCount();
    if (withModifiers)
        item->modifiers = GetCurrentKeyModifiers();
    ScheduleEvent(item, EventQueueItem::GuessMerge);
}

QMenu* runningPopupMenu(const QObject* app)
{
    return qobject_cast<QMenu*>(app->property(PopupMenuIsExecuting).value<QObject*>());
}
} // namespace

const ApplicationHooks& applicationHooks()
{
    return gApplicationHooks.get();
}

ApplicationHooks SetApplicationHooks(const ApplicationHooks& hooks)
{
    return gApplicationHooks.set(hooks);
}

bool inspectorEnabled()
{
    return gInspectorEnabled;
}

bool inspectorCopyBitsToScreen()
{
    return gInspectorCopyBitsToScreen;
}

void setInspectorEnabled(bool on)
{
    gInspectorEnabled = on;
}

void setInspectorCopyBitsToScreen(bool on)
{
    gInspectorCopyBitsToScreen = on;
}

} // namespace Private

AQtApplication::AQtApplication(int& argc, char** argv, bool decorationFlag)
    : QApplication(argc, argv)
    , d(new Private::AQtApplicationPrivate)
{
    d->decorationFlag = decorationFlag;

    Private::installMessageHandler();

    {
        QSettings inspector(QStringLiteral("Tessel Technology"), QStringLiteral("Velmar"));
        Private::gInspectorEnabled = inspector.value(QStringLiteral("enabled"), false).toBool();
        Private::gInspectorCopyBitsToScreen =
            inspector.value(QStringLiteral("copyBitsToScreen"), false).toBool();
    }
    // The application is where the managers are put together, the inspector among them.
    if (Private::gInspectorEnabled)
        Private::Inspector::installInspectorShortcut();

    if (QStyle* style = QStyleFactory::create(QStringLiteral("Windows")))
        setStyle(style);

    d->menuBar = new QMenuBar(nullptr);
    d->decorationManager = Brindle::DecorationManager::Create(
        d->menuBar,
        decorationFlag ? Brindle::DecorationManager::kMdiDecorated
                       : Brindle::DecorationManager::kMdiNative);

    // The bare resource root gives an empty icon: windows carry no default icon.
    setWindowIcon(QIcon(QStringLiteral(":/")));

    m_nativeEventFilter = new Private::NativeEventFilter(this);
    installNativeEventFilter(m_nativeEventFilter);
}

AQtApplication::~AQtApplication()
{
    removeNativeEventFilter(m_nativeEventFilter);
    delete m_nativeEventFilter;
    // Widgets must go before the QApplication base does.
    delete d->decorationManager;
    delete d->menuBar;
    delete d;
}

AQtApplication* AQtApplication::instance()
{
    return qobject_cast<AQtApplication*>(QCoreApplication::instance());
}

int AQtApplication::exec()
{
    VELMAR_ASSERT(instance(), "NULL != app");
    return QApplication::exec();
}

QMenuBar* AQtApplication::menuBar() const
{
    return d->menuBar;
}

void AQtApplication::ShutdownApp()
{
    delete d->decorationManager;
    d->decorationManager = nullptr;
    QCoreApplication::quit();
}

void AQtApplication::SetWinEventHandler(WinEventHandler handler)
{
    m_winEventHandler = handler;
}

bool AQtApplication::winEventFilter(void* message, SInt32* result)
{
    return m_winEventHandler && m_winEventHandler(message, result);
}

bool AQtApplication::event(QEvent* e)
{
    if (e->type() == QEvent::ApplicationActivate || e->type() == QEvent::ApplicationDeactivate) {
        d->applicationActive = e->type() == QEvent::ApplicationActivate;
        Private::EventQueueItemSmartPtr item = Private::EventQueueItemSmartPtr::Create();
        if (Private::ConvertApplicationActivation(e, item.get()))
            Private::ScheduleEvent(item, Private::EventQueueItem::GuessMerge);
    }
    return QApplication::event(e);
}

bool AQtApplication::LeftButtonStillDown() const
{
    return mouseButtons().testFlag(Qt::LeftButton);
}

bool AQtApplication::RightButtonStillDown() const
{
    return mouseButtons().testFlag(Qt::RightButton);
}

bool AQtApplication::MiddleButtonStillDown() const
{
    return mouseButtons().testFlag(Qt::MiddleButton);
}

bool AQtApplication::AnyButtonStillDown() const
{
    return mouseButtons() != Qt::NoButton;
}

bool AQtApplication::hasReceivedApplicationActivate() const
{
    return d->applicationActive;
}

bool AQtApplication::CheckAppleEventHandlersDisabled() const
{
    return Private::MainEventQueue()->CheckCarbonEventsDisabled();
}

void AQtApplication::onMenuBarTriggered(QAction* action)
{
    // A running pop-up menu reports its own choice.
    if (Private::runningPopupMenu(this))
        return;
    if (auto record = Private::applicationHooks().recordMenuChoice)
        record(action);
    Private::scheduleMenuEvent(Private::kEventVelmarMenuTriggered, true);
}

void AQtApplication::onMenuItemTriggered()
{
    auto* action = qobject_cast<QAction*>(sender());
    if (!VELMAR_ASSERT(action, "action"))
        return;
    onMenuBarTriggered(action);
}

void AQtApplication::onMenuAboutToShow()
{
    menuAboutToShow(qobject_cast<QMenu*>(sender()));
}

void AQtApplication::menuAboutToShow(QMenu* menu)
{
    if (menu) {
        const Private::ApplicationHooks& hooks = Private::applicationHooks();
        if (hooks.refreshMenu)
            hooks.refreshMenu(menu);
        if (hooks.applyMenuFont)
            hooks.applyMenuFont(menu);
    }
    if (QMenu* popup = Private::runningPopupMenu(this)) {
        const bool menuBarMenu = menu && d->menuBar && d->menuBar->actions().contains(menu->menuAction());
        if (menu && !(menuBarMenu && menu != popup))
            return; // a submenu of the pop-up, or the pop-up itself, is opening
        popup->close();
        setProperty(PopupMenuIsExecuting, QVariant());
    }
    Private::scheduleMenuEvent(Private::kEventVelmarUpdateMenus, false);
}

} // namespace Velmar
