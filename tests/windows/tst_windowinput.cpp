// A user's keys and clicks, pressed through the X server, reach the queue as the Toolbox's
// key and mouse events: Mac codes, modifiers, global points, and FindWindow agrees with where
// the click landed. Run on a display of its own, with and without a window manager.
#include "WindowTestSupport.h"
#include "XTestInput.h"

#include <Velmar/Events.h>

#include <QElapsedTimer>

using namespace Velmar;
using namespace WindowTest;

namespace {

// "char/key mods" of the first queued item of a class and kind, waiting up to a second.
QString waitFor(UInt32 eventClass, UInt32 eventKind)
{
    QElapsedTimer clock;
    clock.start();
    while (clock.elapsed() < 2000) {
        QCoreApplication::processEvents(QEventLoop::AllEvents, 20);
        for (const auto& item : Private::gMainEventQueue.items()) {
            if (item->eventClass == eventClass && item->eventKind == eventKind)
                return QStringLiteral("%1/%2 %3").arg(item->charCode, 2, 16, QChar(u'0'))
                    .arg(item->keyCode, 2, 16, QChar(u'0')).arg(item->modifiers, 0, 16);
        }
    }
    return QStringLiteral("nothing");
}

constexpr unsigned long kShift = 0xffe1, kControl = 0xffe3, kAlt = 0xffe9;

} // namespace

class tst_WindowInput : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void initTestCase()
    {
        if (QGuiApplication::platformName() != QLatin1String("xcb"))
            QSKIP("needs an X display");
        if (!m_x.load())
            QSKIP("XTEST not available");
        const Rect bounds = R(120, 160, 320, 460);
        CreateNewWindow(kDocumentWindowClass, kWindowStandardDocumentAttributes, &bounds, &m_window);
        ShowWindow(m_window);
        SelectWindow(m_window);
        m_window->activateWindow();
        QVERIFY(QTest::qWaitForWindowActive(m_window->window()));
        QTRY_VERIFY(m_window->hasFocus());
    }
    void cleanupTestCase()
    {
        if (m_window)
            DisposeWindow(m_window);
    }
    void init() { Private::gMainEventQueue.clearAll(); }
    void cleanup()
    {
        for (unsigned long keysym : {kShift, kControl, kAlt})
            m_x.key(keysym, false);
        m_x.button(1, false);
    }

    // What the real path adds to the conversion tst_inputconversion checks row by row:
    // modifiers, punctuation and the keypad as the X server reports them.
    void keys_data()
    {
        QTest::addColumn<qulonglong>("keysym");
        QTest::addColumn<qulonglong>("modifier");
        QTest::addColumn<QString>("expected");
        QTest::newRow("shift-a") << 0x61ull << qulonglong(kShift) << "41/00 200";
        QTest::newRow("comma") << 0x2cull << 0ull << "2c/2b 0";
        QTest::newRow("keypad *") << 0xffaaull << 0ull << "2a/43 0";
        QTest::newRow("command-c") << 0x63ull << qulonglong(kControl) << "43/08 100";
        QTest::newRow("option-return") << 0xff0dull << qulonglong(kAlt) << "0d/24 800";
    }
    void keys()
    {
        QFETCH(qulonglong, keysym);
        QFETCH(qulonglong, modifier);
        QFETCH(QString, expected);
        if (modifier)
            m_x.key(modifier, true);
        m_x.key(keysym, true);
        const QString down = waitFor(kEventClassKeyboard, kEventRawKeyDown);
        m_x.key(keysym, false);
        if (modifier)
            m_x.key(modifier, false);
        QCOMPARE(down, expected);
        QCOMPARE(waitFor(kEventClassKeyboard, kEventRawKeyUp).section(u' ', 0, 0), expected.section(u' ', 0, 0));
    }

    void clicks()
    {
        const QPoint target = m_window->mapToGlobal(QPoint(50, 40));
        m_x.moveTo(target);
        m_x.button(1, true);
        QCOMPARE(waitFor(kEventClassMouse, kEventMouseDown).isEmpty(), false);
        m_x.button(1, false);
        waitFor(kEventClassMouse, kEventMouseUp);
        const EventTypeSpec mouseDown{kEventClassMouse, kEventMouseDown};
        const Private::EventQueueItemSmartPtr down = Private::gMainEventQueue.findFirstMatching(&mouseDown, 1);
        QVERIFY(down);
        QCOMPARE(down->mouseButton, UInt16(1));
        QCOMPARE(down->windowPart, UInt16(3));
        QCOMPARE(QPoint(down->where.h, down->where.v), target);
        QCOMPARE(down->window, m_window.get());
        WindowRef hit = nullptr;
        QCOMPARE(FindWindow(down->where, &hit), WindowPartCode(inContent));
        QCOMPARE(hit, m_window);
        Point local = down->where;
        {
            OnPort port(m_window);
            GlobalToLocal(&local);
        }
        QCOMPARE(QPoint(local.h, local.v), QPoint(50, 40));
    }

private:
    VelmarTest::XTestInput m_x;
    WindowRef m_window;
};

VELMAR_APP_TEST_MAIN(tst_WindowInput)
#include "tst_windowinput.moc"
