// A classic host with a TextEdit record, driven by real keys and clicks through the X
// server: WaitNextEvent hands key-downs to TEKey and clicks to TEClick, updates go through
// TEUpdate, and command keys cut, copy, paste and undo. What the record holds and what the
// screen shows must follow.
#include "../windows/WindowTestSupport.h"
#include "XTestInput.h"

#include <Velmar/EventWaiting.h>
#include <Velmar/QDShapes.h>
#include <Velmar/QuickDraw.h>
#include <Velmar/TextEdit.h>

#include <QClipboard>
#include <QElapsedTimer>

#include <functional>

using namespace Velmar;
using namespace WindowTest;

namespace {

constexpr unsigned long kControl = 0xffe3, kBackSpace = 0xff08;
const Rect kView = R(20, 20, 80, 220); // two or three lines high

class Host {
public:
    Host()
    {
        const Rect bounds = R(150, 100, 300, 400);
        window = NewCWindow(nullptr, &bounds, reinterpret_cast<const unsigned char*>("\x04Text"),
            true, 0, nullptr, true, nullptr);
        OnPort on(window);
        te = TENew(&kView, &kView);
        TEActivateEx(te, window);
    }
    ~Host()
    {
        TEDispose(te);
        DisposeWindow(window);
    }

    void runUntil(const std::function<bool()>& done, int limitMs = 5000)
    {
        QElapsedTimer clock;
        clock.start();
        while (!done() && clock.elapsed() < limitMs) {
            EventRecord e;
            if (WaitNextEvent(everyEvent, &e, 2, nullptr))
                handle(e);
            else
                TEIdle(te);
        }
    }
    void settle(int ms = 200)
    {
        runUntil([] { return false; }, ms);
    }

    QString text() const
    {
        Handle h = TEGetText(te);
        return QString::fromLatin1(*h, TxGetHandleSize(h));
    }

    WindowRef window;
    TEPtr* te = nullptr;
    int updates = 0;

private:
    void handle(EventRecord& e)
    {
        switch (e.what) {
        case keyDown:
        case autoKey: // a key typed twice quickly may come as a repeat
            if (e.modifiers & cmdKey) {
                // With Control held the character is the key's capital.
                switch (QChar(char(e.message & charCodeMask)).toLower().toLatin1()) {
                case 'x': TECut(te); break;
                case 'c': TECopy(te); break;
                case 'v': TEPaste(te); break;
                case 'z': te->undo(); break;
                }
            } else {
                TEKey(char(e.message & charCodeMask), te, &e);
            }
            break;
        case mouseDown: {
            OnPort on(window);
            Point local = e.where;
            GlobalToLocal(&local);
            if (PtInRect(local, &kView))
                TEClick(local, (e.modifiers & shiftKey) != 0, te);
            break;
        }
        case updateEvt: {
            OnPort on(window);
            BeginUpdate(window);
            const RGBColor grey(0xC000, 0xC000, 0xC000);
            RGBBackColor(&grey);
            Rect all;
            GetWindowPortBounds(window, &all);
            EraseRect(&all);
            TEUpdate(&kView, te);
            EndUpdate(window);
            ++updates;
            break;
        }
        default: break;
        }
    }
};

int darkPixels(const QImage& image)
{
    int n = 0;
    for (int y = 0; y < image.height(); ++y)
        for (int x = 0; x < image.width(); ++x)
            n += qGray(image.pixel(x, y)) < 100;
    return n;
}

} // namespace

class tst_TextEditHost : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void initTestCase()
    {
        if (QGuiApplication::platformName() != QLatin1String("xcb") || !m_x.load())
            QSKIP("needs an X display with XTEST");
    }

    void typingSelectingCuttingPastingUndoing()
    {
        Host host;
        QVERIFY(QTest::qWaitForWindowExposed(host.window->window()));
        host.runUntil([&] { return host.updates > 0; });
        const QRect viewOnScreen(
            host.window->mapToGlobal(QPoint(kView.left, kView.top)), QSize(200, 60));
        const int empty = darkPixels(screenPixels(viewOnScreen)); // the caret at most
        QVERIFY(empty <= 20);

        m_x.click(pointOf(host, 0), 20);
        host.settle();
        m_x.type("hello world");
        host.runUntil([&] { return host.text() == QLatin1String("hello world"); });
        QCOMPARE(host.text(), QStringLiteral("hello world"));
        QCOMPARE(host.te->selStart(), SInt16(11));
        QCOMPARE(host.te->nLines(), SInt16(1));
        // The text is on the screen, inside the view; the window around it stays grey.
        QTRY_VERIFY(darkPixels(screenPixels(viewOnScreen)) > empty + 30);
        const QRect below(
            host.window->mapToGlobal(QPoint(kView.left, kView.bottom + 2)), QSize(200, 20));
        QCOMPARE(darkPixels(screenPixels(below)), 0);

        // Drag across "world": the move and the release come while TEClick tracks.
        const QPoint to = pointOf(host, 11) + QPoint(3, 0);
        m_x.moveTo(pointOf(host, 6));
        m_x.button(1, true);
        QTimer::singleShot(150, [&] { m_x.moveTo(to); });
        QTimer::singleShot(300, [&] { m_x.button(1, false); });
        host.runUntil([&] { return host.te->selEnd() == 11 && !QGuiApplication::mouseButtons(); });
        host.settle();
        QCOMPARE(host.te->selStart(), SInt16(6));
        QCOMPARE(host.te->selEnd(), SInt16(11));

        m_x.chord(kControl, 'x');
        host.runUntil([&] { return host.text() == QLatin1String("hello "); });
        QCOMPARE(QGuiApplication::clipboard()->text(), QStringLiteral("world"));
        m_x.click(pointOf(host, 0), 20);
        host.settle();
        m_x.chord(kControl, 'v');
        host.runUntil([&] { return host.text() == QLatin1String("worldhello "); });
        QCOMPARE(host.te->selStart(), SInt16(5));
        m_x.chord(kControl, 'z');
        host.runUntil([&] { return host.text() == QLatin1String("hello "); });
        QCOMPARE(host.text(), QStringLiteral("hello "));

        // A double click selects the word.
        m_x.click(pointOf(host, 2), 20);
        m_x.click(pointOf(host, 2), 20);
        host.settle();
        QCOMPARE(host.te->selStart(), SInt16(0));
        QCOMPARE(host.te->selEnd(), SInt16(5));

        // Enough text wraps onto more lines; Backspace takes one character back.
        m_x.click(pointOf(host, 6), 20);
        host.settle();
        m_x.type("the record wraps its lines when they grow long");
        host.runUntil([&] { return host.text().endsWith(QLatin1String("long")); });
        QVERIFY(host.te->nLines() >= 2);
        m_x.tap(kBackSpace);
        host.runUntil([&] { return host.text().endsWith(QLatin1String("lon")); });
        QVERIFY(host.text().endsWith(QLatin1String("lon")));
    }

private:
    QPoint pointOf(Host& host, SInt16 offset)
    {
        const Point p = TEGetPoint(offset, host.te);
        return host.window->mapToGlobal(QPoint(p.h + 1, p.v - 3));
    }
    VelmarTest::XTestInput m_x;
};

VELMAR_APP_TEST_MAIN(tst_TextEditHost)
#include "tst_textedithost.moc"
