// The inspector as a widget: its trees follow what the host does, its switches and category
// boxes change the library's state (and the library's state changes them), the shortcut
// works only when allowed, and a closed inspector has nothing running.
#include "../windows/WindowTestSupport.h"

#include <Velmar/Events.h>
#include <Velmar/Inspector.h>
#include <Velmar/Menus.h>

#include "events/EventWaiter.h"
#include "foundation/ApplicationPrivate.h"
#include "inspector/InspectorWindow.h"
#include "inspector/LogTap.h"
#include "windows/WindowPaintOverlay.h"

#include <QCheckBox>
#include <QKeyEvent>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QSettings>
#include <QTreeWidget>

using namespace Velmar;
using namespace WindowTest;
using Velmar::Private::Inspector::InspectorWindow;

namespace {

InspectorWindow* inspector()
{
    return InspectorWindow::instance(false);
}

// Every "object | state" line of a tree, depth first.
QStringList treeLines(const char* name)
{
    QStringList lines;
    const auto* tree = inspector()->findChild<QTreeWidget*>(QLatin1String(name));
    for (QTreeWidgetItemIterator it(const_cast<QTreeWidget*>(tree)); *it; ++it)
        lines << (*it)->text(0) + QLatin1String(" | ") + (*it)->text(1);
    return lines;
}

bool anyLine(const QStringList& lines, const QString& fragment)
{
    return std::any_of(lines.begin(), lines.end(),
                       [&](const QString& l) { return l.contains(fragment); });
}

QCheckBox* box(const char* name)
{
    return inspector()->findChild<QCheckBox*>(QLatin1String(name));
}

void pressChord(QWidget* target)
{
    QKeyEvent press(QEvent::KeyPress, Qt::Key_I,
                    Qt::ControlModifier | Qt::AltModifier | Qt::ShiftModifier);
    QCoreApplication::sendEvent(target, &press);
}

} // namespace

class tst_Inspector : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void initTestCase()
    {
        QVERIFY(!IsVelmarInspectorVisible());
        ToggleVelmarInspector();
        QVERIFY(IsVelmarInspectorVisible());
    }

    void cleanupTestCase()
    {
        if (IsVelmarInspectorVisible())
            ToggleVelmarInspector();
    }

    void objectTreeFollowsTheHost()
    {
        const unsigned char title[] = "\x05" "Tools";
        MenuRef menu = NewMenu(4242, title);
        AppendMenu(menu, reinterpret_cast<const unsigned char*>("\x07" "Sharpen"));
        SetItemCmd(menu, 1, 'K');
        SetItemMark(menu, 1, 0x12); // the check mark character
        // Hosts keep an anchor menu at the end of the bar for InsertMenu(m, 0) to go before.
        const unsigned char anchorTitle[] = "\x06" "Window";
        InsertMenu(NewMenu(kMenuBarAnchorID, anchorTitle), kMenuBarAnchorID);
        InsertMenu(menu, 0);
        {
            Window w(R(100, 100, 160, 260));
            SetWTitle(w, reinterpret_cast<const unsigned char*>("\x05" "Probe"));
            w.show();
            inspector()->refresh();
            const QStringList lines = treeLines("objectTree");
            QVERIFY2(anyLine(lines, "\"Probe\" | document"), qPrintable(lines.join('\n')));
            QVERIFY(anyLine(lines, "update region | "));
            QVERIFY(anyLine(lines, "\"Tools\" | ID 4242, 1 items"));
            QVERIFY2(anyLine(lines, "1  Sharpen | command ID 0x10920001, key "),
                     qPrintable(lines.join(QLatin1Char('\n'))));
            QVERIFY(anyLine(lines, ", mark checkMark"));
        }
        DeleteMenu(4242);
        DisposeMenu(menu);
        inspector()->refresh();
        const QStringList after = treeLines("objectTree");
        QVERIFY(!anyLine(after, "\"Probe\""));
        QVERIFY(!anyLine(after, "\"Tools\""));
    }

    void eventTreeShowsTheQueue()
    {
        Private::gMainEventQueue.clearAll();
        PostEvent(keyDown, 'a');
        PostEvent(keyDown, 'b');
        inspector()->refresh();
        QVERIFY(anyLine(treeLines("eventTree"), "Event queue | 2"));
        Private::gMainEventQueue.clearAll();
        inspector()->refresh();
        QVERIFY(anyLine(treeLines("eventTree"), "Event queue | 0"));
    }

    // Each switch moves the library's state; the library's state moves the box back.
    void switchesAndSettings()
    {
        QCheckBox* nullEvents = box("Null events");
        QVERIFY(nullEvents->isChecked());
        nullEvents->click();
        QVERIFY(!Private::VelmarEventWaiter::nullEventTimerEnabled());
        Private::VelmarEventWaiter::setNullEventTimerEnabled(true);
        inspector()->refresh();
        QVERIFY(nullEvents->isChecked());

        box("copyBitsToScreen")->click();
        QVERIFY(Private::inspectorCopyBitsToScreen());
        QCOMPARE(QSettings(QStringLiteral("Tessel Technology"), QStringLiteral("Velmar"))
                     .value(QStringLiteral("copyBitsToScreen")).toBool(), true);
        box("copyBitsToScreen")->click();
        QVERIFY(!Private::inspectorCopyBitsToScreen());

        box("Outline clip region")->click();
        QVERIFY(Private::paintOverlayHook());
        box("Outline clip region")->click();
        QVERIFY(!Private::paintOverlayHook());
    }

    // The shortcut opens and closes only once "enabled" is on.
    void shortcutNeedsEnabling()
    {
        Window w(R(100, 100, 160, 260));
        w.show();
        QVERIFY(!Private::inspectorEnabled());
        pressChord(w.get());
        QVERIFY(IsVelmarInspectorVisible());
        box("enabled")->click();
        pressChord(w.get());
        QVERIFY(!IsVelmarInspectorVisible());
        QVERIFY(!Private::Inspector::logTapAttached()); // closed: nothing copies the log
        pressChord(w.get());
        QVERIFY(IsVelmarInspectorVisible());
        box("enabled")->click();
        QVERIFY(!QSettings(QStringLiteral("Tessel Technology"), QStringLiteral("Velmar"))
                     .value(QStringLiteral("enabled")).toBool());
    }

    // A category box decides what is logged; the view shows the lines and forgets them on Clear.
    void categoriesDecideWhatIsLogged()
    {
        QCheckBox* quickDraw = box(LogCategoryName(kLogQuickDraw));
        QVERIFY(quickDraw);
        const bool was = LogCategoryEnabled(kLogQuickDraw);
        if (!was)
            quickDraw->click();
        VelmarLog(kLogQuickDraw, "probe one");
        quickDraw->click();
        QVERIFY(!LogCategoryEnabled(kLogQuickDraw));
        VelmarLog(kLogQuickDraw, "probe two");
        inspector()->refresh();
        auto* text = inspector()->findChild<QPlainTextEdit*>(QStringLiteral("logText"));
        QVERIFY(text->toPlainText().contains(QLatin1String("probe one")));
        QVERIFY(!text->toPlainText().contains(QLatin1String("probe two")));
        inspector()->findChild<QPushButton*>(QStringLiteral("Clear"))->click();
        QVERIFY(text->toPlainText().isEmpty());
        SetLogCategory(kLogQuickDraw, was);
        inspector()->refresh();
        QCOMPARE(quickDraw->isChecked(), was);
    }
};

VELMAR_APP_TEST_MAIN(tst_Inspector)
#include "tst_inspector.moc"
