// A classic host with a menu bar, driven by real clicks and keys through the X server: the
// menu bar strip, a choice reaching the host's handler and MenuSelect once, the update-menus
// event before a menu shows, command keys through MenuEvent, and pop-up menus (the keyboard,
// Escape, and the scrolling list for long menus).
#include "TestSupport.h"
#include "XTestInput.h"

#include <Velmar/CarbonEventHandlers.h>
#include <Velmar/EventWaiting.h>
#include <Velmar/Menus.h>
#include <Velmar/TextUtils.h>
#include <Velmar/Windows.h>

#include "events/EventQueue.h"
#include "menus/QMenuListPopup.h"

#include <Velmar/AQtWindow.h>

#include <QElapsedTimer>
#include <QListWidget>
#include <QMenuBar>
#include <QRegularExpression>

#include <functional>

using namespace Velmar;

namespace {

using VelmarTest::P;
using VelmarTest::pascal;

constexpr unsigned long kDown = 0xff54, kReturn = 0xff0d, kEscape = 0xff1b, kControl = 0xffe3;

VelmarTest::SequenceRecorder gSeen;

OSStatus menuHandler(EventHandlerCallRef, EventRef event, void*)
{
    if (GetEventKind(event) == kEventVelmarUpdateMenus) {
        gSeen.recordOnce(QStringLiteral("update menus"));
    } else {
        const SInt32 choice = MenuSelect(Point{});
        gSeen.record(QStringLiteral("chosen %1/%2").arg(choice >> 16).arg(choice & 0xFFFF));
        gSeen.record(QStringLiteral("again %1").arg(MenuSelect(Point{})));
    }
    return noErr;
}

// The host's loop: key-downs go to MenuEvent as a classic host does with command keys.
void runLoop(const std::function<bool()>& done, int limitMs = 5000)
{
    QElapsedTimer clock;
    clock.start();
    while (!done() && clock.elapsed() < limitMs) {
        EventRecord e;
        if (!WaitNextEvent(everyEvent, &e, 2, nullptr))
            continue;
        if (e.what == keyDown && (e.modifiers & cmdKey)) {
            const UInt32 choice = MenuEvent(&e);
            gSeen.record(
                QStringLiteral("command key %1/%2").arg(choice >> 16).arg(choice & 0xFFFF));
        }
    }
}

bool seen(const QString& entry)
{
    return gSeen.entries().contains(entry);
}

// Runs `act` once the application shows a pop-up of the given kind.
template <typename Popup> void whenPopupShows(std::function<void(Popup*)> act)
{
    auto* timer = new QTimer;
    QObject::connect(timer, &QTimer::timeout, [timer, act] {
        if (auto* popup = qobject_cast<Popup*>(QApplication::activePopupWidget());
            popup && popup->isVisible()) {
            timer->stop();
            timer->deleteLater();
            QTimer::singleShot(100, [act, popup] { act(popup); });
        }
    });
    timer->start(20);
}

} // namespace

class tst_MenuHost : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void initTestCase()
    {
        if (QGuiApplication::platformName() != QLatin1String("xcb") || !m_x.load())
            QSKIP("needs an X display with XTEST");
        InsertMenu(NewMenu(kMenuBarAnchorID, P(pascal("Window"))), kMenuBarAnchorID);
        m_file = NewMenu(128, P(pascal("File")));
        AppendMenu(m_file, P(pascal("New;Open;-;Quit")));
        SetItemCmd(m_file, 1, 'N');
        InsertMenu(m_file, 0);
        const EventTypeSpec kinds[] = {{kEventClassVelmar, kEventVelmarMenuTriggered},
            {kEventClassVelmar, kEventVelmarUpdateMenus}};
        InstallEventHandler(
            GetApplicationEventTarget(), menuHandler, 2, kinds, nullptr, &m_handler);
        const Rect bounds{200, 100, 400, 400};
        m_window = NewCWindow(nullptr, &bounds, P(pascal("Host")), true, 0, nullptr, true, nullptr);
        QVERIFY(QTest::qWaitForWindowExposed(m_window->window()));
    }
    void cleanupTestCase() { RemoveEventHandler(m_handler); }
    void init() { gSeen.clear(); }

    void menuBarIsAStripAtTheTop()
    {
        QMenuBar* bar = AQtApplication::instance()->menuBar();
        QVERIFY(QTest::qWaitForWindowExposed(bar));
        QCOMPARE(bar->geometry().top(), QGuiApplication::primaryScreen()->geometry().top());
        QCOMPARE(bar->width(), QGuiApplication::primaryScreen()->geometry().width());
        QVERIFY(bar->actions().indexOf(m_file->menuAction()) < bar->actions().size() - 1);
        QVERIFY(qAbs(GetMBarHeight() - bar->height()) <= 2);
    }

    void choosingWithTheMouse()
    {
        QMenuBar* bar = AQtApplication::instance()->menuBar();
        m_x.click(bar->mapToGlobal(bar->actionGeometry(m_file->menuAction()).center()));
        QTRY_VERIFY(m_file->isVisible());
        m_x.click(m_file->mapToGlobal(m_file->actionGeometry(m_file->actions().at(1)).center()));
        runLoop([] { return seen("again 0"); });
        VELMAR_COMPARE_SEQUENCE(
            gSeen, "menu bar choice", {"update menus", "*", "chosen 128/2", "again 0"});
    }

    // Control plays the command key. Where Qt matches the item's shortcut itself the host
    // gets the choice as a menu event, otherwise as a key-down for MenuEvent: once either way.
    void commandKeys()
    {
        m_x.click(m_window->mapToGlobal(QPoint(50, 50)));
        runLoop([] { return false; }, 300);
        gSeen.clear();
        m_x.chord(kControl, 'n');
        runLoop([] { return seen("command key 128/1") || seen("again 0"); });
        runLoop([] { return false; }, 200);
        const QStringList choices =
            gSeen.entries().filter(QRegularExpression("^(command key|chosen) "));
        QCOMPARE(choices.size(), 1);
        QVERIFY(choices.first().endsWith("128/1"));
    }

    void popUpMenus()
    {
        MenuRef popup = NewMenu(600, P(pascal("Pop")));
        AppendMenu(popup, P(pascal("Red;Green;Blue")));
        whenPopupShows<QMenu>([this](QMenu*) {
            m_x.tap(kDown);
            m_x.tap(kReturn);
        });
        const SInt32 chosen = PopUpMenuSelect(popup, 300, 300, 1);
        QVERIFY((chosen >> 16) == 600 && (chosen & 0xFFFF) >= 1 && (chosen & 0xFFFF) <= 3);
        QVERIFY(AQtApplication::instance()->property(PopupMenuIsExecuting).isNull());
        QCOMPARE(MenuSelect(Point{}), SInt32(0)); // a pop-up's choice is not the menu bar's

        whenPopupShows<QMenu>([this](QMenu*) { m_x.tap(kEscape); });
        QCOMPARE(PopUpMenuSelect(popup, 300, 300, 2), SInt32(0));
        DisposeMenu(popup);
    }

    void longMenusBecomeLists()
    {
        MenuRef longMenu = NewMenu(601, P(pascal("Long")));
        QByteArrayList entries;
        for (int i = 0; i < 120; ++i)
            entries << "Entry " + QByteArray::number(1000 - i); // sorting reverses them
        for (int i = 0; i < 120; i += 20)
            AppendMenu(longMenu, P(pascal(entries.mid(i, 20).join(';'))));
        QCOMPARE(CountMenuItems(longMenu), UInt16(120));
        CheckMenuItem(longMenu, 5, 1); // the checked item is the current one
        int count = 0;
        QString current, first;
        whenPopupShows<Private::QMenuListPopup>([&](Private::QMenuListPopup* list) {
            count = list->list()->count();
            current = list->list()->currentItem() ? list->list()->currentItem()->text() : QString();
            m_x.tap(kDown);
            m_x.tap(kReturn);
        });
        QCOMPARE(PopUpMenuSelect(longMenu, 100, 100, 1, 0, 1), SInt32((601 << 16) | 6));
        QCOMPARE(count, 120);
        QCOMPARE(current, QStringLiteral("Entry 996"));

        whenPopupShows<Private::QMenuListPopup>([&](Private::QMenuListPopup* list) {
            first = list->list()->item(1)->text(); // "Entry 1000" sorts first
            m_x.tap(kEscape);
        });
        QCOMPARE(PopUpMenuSelect(longMenu, 100, 100, 1, 1, 1), SInt32(0));
        QCOMPARE(first, QStringLiteral("Entry 881"));
        DisposeMenu(longMenu);
    }

private:
    VelmarTest::XTestInput m_x;
    MenuRef m_file;
    EventHandlerRef m_handler = nullptr;
    WindowRef m_window;
};

VELMAR_APP_TEST_MAIN(tst_MenuHost)
#include "tst_menuhost.moc"
