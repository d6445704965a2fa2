// Tool tips: shown only where the user sees the parent window. Another top-level window over
// the parent is known to the X server only, so this runs on a server of its own.
#include "../windows/WindowTestSupport.h"
#include "WindowSystemNeeds.h"

#include <Velmar/Cursors.h>

#include <QApplication>
#include <QToolTip>

using namespace Velmar;
using namespace WindowTest;

namespace {

void activate(WindowRef window)
{
    SelectWindow(window);
    window->activateWindow(); // SelectWindow waits for the application to be in front
    QVERIFY(QTest::qWaitForWindowActive(window->window()));
}

QWidget* tipWindow()
{
    for (QWidget* widget : QApplication::topLevelWidgets())
        if (qstrcmp(widget->metaObject()->className(), "QTipLabel") == 0 && widget->isVisible())
            return widget;
    return nullptr;
}

void resetTips()
{
    HideToolTip(true);
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
}

void show(const QPoint& global, const char* text)
{
    ShowToolTip(global.x(), global.y(), text);
}

} // namespace

class tst_ToolTips : public QObject {
    Q_OBJECT

    // 400 x 200 at (100, 100); the cover hides its right half.
    Window m_parent{R(100, 100, 300, 500)};
    QWidget m_cover{nullptr, Qt::Window | Qt::FramelessWindowHint};

    QPoint at(int h, int v) const { return m_parent->mapToGlobal(QPoint(h, v)); }

private Q_SLOTS:
    void initTestCase()
    {
        VELMAR_REQUIRE_X11("a window placed over another at a screen position");
        m_parent.show();
        activate(m_parent);
        m_cover.setAttribute(Qt::WA_ShowWithoutActivating);
        m_cover.setGeometry(QRect(at(200, -50), QSize(300, 300)));
        m_cover.show();
        m_cover.raise();
        QVERIFY(QTest::qWaitForWindowExposed(&m_cover));
        // Qt alone would show a tip there: the parent's own region knows nothing of the cover.
        QVERIFY(m_parent->visibleRegion().contains(QPoint(300, 100)));
        QCOMPARE(QApplication::topLevelAt(at(300, 100)), &m_cover);
        QCOMPARE(QApplication::activeWindow(), m_parent->window());
        SetToolTipParent(m_parent);
    }
    void init() { resetTips(); }
    void cleanupTestCase() { resetTips(); }

    void visibleParts_data()
    {
        QTest::addColumn<QPoint>("local");
        QTest::addColumn<bool>("shown");
        QTest::newRow("uncovered") << QPoint(20, 20) << true;
        QTest::newRow("covered by another window") << QPoint(300, 100) << false;
        QTest::newRow("outside the parent") << QPoint(-40, 20) << false;
    }
    void visibleParts()
    {
        QFETCH(QPoint, local);
        QFETCH(bool, shown);
        show(at(local.x(), local.y()), "tip");
        QCOMPARE(QToolTip::isVisible(), shown);
        if (shown)
            QCOMPARE(QToolTip::text(), QStringLiteral("tip"));
    }

    // The text is in the host's Mac encoding (Mac OS Roman by default).
    void macEncodedText()
    {
        show(at(20, 20), "caf\x8E");
        QCOMPARE(QToolTip::text(), QStringLiteral("caf\u00E9"));
    }

    // The tip showing does not cover the parent for the next one, even where it lies over the
    // point.
    void nextTipOverTheLast()
    {
        show(at(10, 10), "first");
        QWidget* tip = tipWindow();
        QVERIFY(tip);
        QVERIFY(QTest::qWaitForWindowExposed(tip));
        const QPoint onTip = tip->geometry().center();
        QCOMPARE(QApplication::topLevelAt(onTip), tip);
        show(onTip, "second");
        QCOMPARE(QToolTip::text(), QStringLiteral("second"));
    }

    void hideDestroys()
    {
        show(at(20, 20), "tip");
        QVERIFY(tipWindow());
        resetTips();
        QVERIFY(!tipWindow());
        QVERIFY(!QToolTip::isVisible());
    }

    // A parent that is disposed, then deleted, shows nothing and breaks nothing. A disposed
    // window is not taken as the parent; a freed one is refused.
    void goneParents()
    {
        Window gone(R(400, 100, 500, 300));
        gone.show();
        const QPoint inside = gone->mapToGlobal(QPoint(20, 20));
        SetToolTipParent(gone);
        show(inside, "tip");
        QVERIFY(QToolTip::isVisible());
        resetTips();
        const WindowRef freed = gone;
        DisposeWindow(freed);
        show(inside, "tip");
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
        show(inside, "tip");
        QVERIFY(!QToolTip::isVisible());
        {
            VelmarTest::IgnoredAssertions asserts;
            SetToolTipParent(freed);
            QCOMPARE(asserts.texts(), QStringList{QStringLiteral("IsValidWindow(window)")});
        }

        Window disposed(R(400, 100, 500, 300));
        DisposeWindow(disposed);
        SetToolTipParent(m_parent);
        SetToolTipParent(disposed);
        show(at(20, 20), "tip");
        QVERIFY(!QToolTip::isVisible());

        SetToolTipParent(m_parent);
        ShowToolTip(INT_MIN, INT_MAX, "far away");
        QVERIFY(!QToolTip::isVisible());
    }
};

VELMAR_APP_TEST_MAIN(tst_ToolTips)
#include "tst_tooltips.moc"
