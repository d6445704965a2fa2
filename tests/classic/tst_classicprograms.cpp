// Classic C programs of our own (tests/classic/programs), built unchanged against the classic
// headers, run each in a child process on this test's display and driven with real X input.
// Each prints what its events became; the test checks that and the pixels on the screen.
#include "TestSupport.h"
#include "XTestInput.h"

#include <QElapsedTimer>
#include <QGuiApplication>
#include <QImage>
#include <QProcess>
#include <QScreen>
#include <QTemporaryDir>
#include <QTest>

#include <memory>

namespace {

// Keysyms used below.
constexpr unsigned long kKeyQ = 0x71, kKeyN = 0x6e, kControl = 0xffe3;

class Program {
public:
    explicit Program(const QString& name, const QString& folder = QString())
    {
        m_process.setProgram(QStringLiteral(CLASSIC_PROGRAM_DIR "/classic_") + name);
        m_process.setWorkingDirectory(folder);
        m_process.setProcessChannelMode(QProcess::ForwardedErrorChannel);
        m_process.start();
    }
    ~Program()
    {
        if (m_process.state() != QProcess::NotRunning) {
            m_process.kill();
            m_process.waitForFinished(3000);
        }
    }
    // The next line the program prints that starts with `prefix`; empty after 10 s.
    QString waitFor(const QString& prefix)
    {
        QElapsedTimer clock;
        clock.start();
        while (clock.elapsed() < 10000) {
            while (m_process.canReadLine()) {
                const QString line = QString::fromLatin1(m_process.readLine()).trimmed();
                m_seen << line;
                if (line.startsWith(prefix))
                    return line;
            }
            if (!m_process.waitForReadyRead(100) && m_process.state() == QProcess::NotRunning
                && !m_process.canReadLine())
                break;
        }
        return QString();
    }
    QList<int> numbers(const QString& line) const
    {
        QList<int> result;
        for (const QString& word : line.split(QLatin1Char(' ')).mid(1))
            result << word.toInt();
        return result;
    }
    // The window's screen origin from the program's "ready x y" line.
    bool readyOrigin(QPoint* origin)
    {
        const QList<int> o = numbers(waitFor(QStringLiteral("ready")));
        if (o.size() != 2)
            return false;
        *origin = QPoint(o[0], o[1]);
        return true;
    }
    bool finished(int* code)
    {
        // waitForFinished answers false for a process that has already ended.
        if (m_process.state() != QProcess::NotRunning && !m_process.waitForFinished(10000))
            return false;
        *code = m_process.exitCode();
        return m_process.exitStatus() == QProcess::NormalExit;
    }
    const QStringList& seen() const { return m_seen; }
    // The last line starting with `prefix` printed since line `from`, waiting for one if none.
    QString since(qsizetype from, const QString& prefix)
    {
        for (qsizetype i = m_seen.size() - 1; i >= from; --i)
            if (m_seen[i].startsWith(prefix))
                return m_seen[i];
        return waitFor(prefix);
    }

private:
    QProcess m_process;
    QStringList m_seen;
};

QImage screen()
{
    QTest::qWait(150);
    return QGuiApplication::primaryScreen()->grabWindow(0).toImage();
}

// The share of dark pixels in a rectangle of the screen.
double darkShare(const QImage& image, const QRect& area)
{
    int dark = 0, all = 0;
    for (int y = area.top(); y <= area.bottom(); ++y)
        for (int x = area.left(); x <= area.right(); ++x, ++all)
            dark += qGray(image.pixel(x, y)) < 128;
    return all ? double(dark) / all : 0;
}

// An area of a program's window (in its local coordinates) and the share of dark pixels
// it must show.
struct DarkCase {
    const char* what;
    QRect local;
    double minDark, maxDark;
};

void checkDarkness(const QImage& shot, const QPoint& origin, std::initializer_list<DarkCase> cases)
{
    for (const DarkCase& c : cases) {
        const double share = darkShare(shot, c.local.translated(origin));
        QVERIFY2(share >= c.minDark && share <= c.maxDark,
            qPrintable(QStringLiteral("%1: %2").arg(QLatin1String(c.what)).arg(share)));
    }
}

bool windowManagerRuns()
{
    QProcess xprop;
    xprop.start(QStringLiteral("xprop"),
        {QStringLiteral("-root"), QStringLiteral("_NET_SUPPORTING_WM_CHECK")});
    return xprop.waitForFinished(3000) && xprop.readAll().contains("window id");
}

} // namespace

class tst_ClassicPrograms : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void initTestCase()
    {
        if (!m_x.load())
            QSKIP("no X display with the XTEST extension");
    }

    void recordFields()
    {
        Program p(QStringLiteral("records"));
        QVERIFY2(!p.waitFor(QStringLiteral("done=")).isEmpty(), qPrintable(p.seen().join('\n')));
        // What a classic program reads straight from the records and globals.
        const QStringList expected = {"black0=255", "gray01=43605", "screenPositive=1",
            "storageUsed=1", "thePort=1", "portRect=300200", "portBitsOrigin=1", "windowKind=8",
            "visible=1", "goAwayFlag=1", "refCon=42", "titleLength=7", "secondBehindFirst=1",
            "contRgnWidth=300", "GetWRefCon=99", "pnLocAfterMove=35045", "txSize=18",
            "rgnRect=1011070", "rgnOvalComplex=1", "rgnScanLines=1", "random1=16807",
            "seedAfter=16807", "randomPlainGlobal=1", "dateRoundTrip=1", "epoch=19040101",
            "shortDateLength=6", "stringToNum=-1234567", "hiword=4660", "bitTst=10", "bitShift=1",
            "locked=1", "grown=1000000", "oneHandlePerResource=1", "strLength=5", "resInfo=1281",
            "countMenus=3", "indString2=5", "missing=1", "homeFile=1", "teLength=13", "teLines=3",
            "teTextSize=13", "teSel=407", "updateEvent=1", "trapAvailable=1", "gestalt=1",
            "polygon=265141", "pictFrame=3232", "pictDrawn=10", "cursorHotSpot=35",
            "polyPoint2=3040", "done=1"};
        QStringList missing;
        for (const QString& line : expected)
            if (!p.seen().contains(line))
                missing << line;
        QVERIFY2(missing.isEmpty(),
            qPrintable("missing: " + missing.join(' ') + "\nseen: " + p.seen().join(' ')));
        int code = -1;
        QVERIFY(p.finished(&code));
        QCOMPARE(code, 0);
    }

    void styledTextResourceFilesAndHooks()
    {
        QTemporaryDir folder; // where the program writes its resource file
        Program p(QStringLiteral("textres"), folder.path());
        QPoint origin;
        QVERIFY(p.readyOrigin(&origin));
        // Runs from 'styl' (bold, then red from offset 8), a scrap of two 20-byte runs, and a
        // file written, closed, reopened read-only and read back.
        const QStringList expected = {"teLength=16", "face0=1", "red0=0", "face9=0", "red9=65535",
            "scrapRuns=1", "created=0", "createdAgain=-48", "opened=1", "added=0",
            "addedTwice=-194", "updated=0", "closed=0", "readBack=1", "readBackInfo=1",
            "oldIdGone=1", "readOnlyChange=-61", "readOnlyAdd=-194", "readOnlyRemove=-196",
            "roundTripFace=1"};
        QStringList missing;
        for (const QString& line : expected)
            if (!p.seen().contains(line))
                missing << line;
        QVERIFY2(missing.isEmpty(),
            qPrintable("missing: " + missing.join(' ') + "\nseen: " + p.seen().join(' ')));

        // The red run is drawn red, the bold one is not.
        m_x.moveTo(origin + QPoint(300, 170));
        const QImage shot = screen();
        const auto reds = [&](const QRect& local) {
            int n = 0;
            const QRect area = local.translated(origin);
            for (int y = area.top(); y <= area.bottom(); ++y)
                for (int x = area.left(); x <= area.right(); ++x) {
                    const QColor c = shot.pixelColor(x, y);
                    n += c.red() > 160 && c.green() < 100 && c.blue() < 100;
                }
            return n;
        };
        QVERIFY2(reds(QRect(10, 10, 290, 30)) > 10, qPrintable(p.seen().join(' ')));
        QCOMPARE(reds(QRect(10, 10, 30, 30)), 0);

        // A double click selects by the program's word breaks: "foo-bar" whole.
        click(origin + QPoint(14, 18));
        click(origin + QPoint(14, 18));
        QCOMPARE(p.waitFor(QStringLiteral("selected")), QStringLiteral("selected 0 7"));
        // The click loop runs while the button is held and may dispose of its own record.
        m_x.moveTo(origin + QPoint(40, 80));
        m_x.button(1, true);
        QTest::qWait(400);
        m_x.button(1, false);
        QCOMPARE(p.waitFor(QStringLiteral("loop")), QStringLiteral("loop 3 1"));
        int code = -1;
        QVERIFY(p.finished(&code));
        QCOMPARE(code, 0);
    }

    void documentWindow()
    {
        Program p(QStringLiteral("docwin"));
        const QList<int> r = p.numbers(p.waitFor(QStringLiteral("ready")));
        QCOMPARE(r.size(), 4);
        QCOMPARE(r[2] - r[0], 360); // from its 'WIND'
        QCOMPARE(r[3] - r[1], 240);

        click(QPoint(r[0] + 50, r[1] + 40));
        QCOMPARE(p.waitFor(QStringLiteral("content")), QStringLiteral("content 50 40"));

        // Control plays the command key: the item's shortcut, or MenuKey on the key-down.
        m_x.moveTo(QPoint(r[0] + 100, r[1] + 100));
        m_x.key(kControl, true);
        m_x.tap(kKeyN);
        m_x.key(kControl, false);
        const QString key = p.waitFor(QStringLiteral("menu"));
        QVERIFY2(key == "menu 129 1" || key == "menukey 129 1", qPrintable(key));

        // The first menu (the logo's, shown as the program's own) and its first item.
        click(QPoint(12, 8));
        QTest::qWait(300);
        click(QPoint(40, 32));
        QCOMPARE(p.waitFor(QStringLiteral("menu ")), QStringLiteral("menu 128 1"));

        if (!windowManagerRuns())
            return; // no frames without a window manager
        // A title-bar drag, then the maximise button: mouse-downs after the window manager
        // acted, in inDrag and inZoomOut.
        m_x.moveTo(QPoint(r[0] + 100, r[1] - 13));
        m_x.button(1, true);
        for (int d = 5; d <= 40; d += 5) {
            m_x.moveTo(QPoint(r[0] + 100 + d, r[1] - 13 + d));
            QTest::qWait(20);
        }
        m_x.button(1, false);
        QCOMPARE(p.waitFor(QStringLiteral("part")), QStringLiteral("part 4 1"));
        const qsizetype beforeZoom = p.seen().size();
        click(QPoint(r[2] + 40 - 23, r[1] + 40 - 13));
        QCOMPARE(p.waitFor(QStringLiteral("part")), QStringLiteral("part 8 1"));
        const QList<int> z = p.numbers(p.since(beforeZoom, QStringLiteral("geometry")));
        QCOMPARE(z.size(), 4);
        QVERIFY2(z[2] - z[0] > 360, qPrintable(p.seen().join('\n')));
        // The close button, at the right of the title bar.
        click(QPoint(z[2] - 7, z[1] - 13));
        QCOMPARE(p.waitFor(QStringLiteral("close")), QStringLiteral("close 0 0"));
        int code = -1;
        QVERIFY(p.finished(&code));
        QCOMPARE(code, 0);
    }

    void trackingLoopAndModes()
    {
        Program p(QStringLiteral("tracker"));
        QPoint origin;
        QVERIFY(p.readyOrigin(&origin));
        m_x.moveTo(origin + QPoint(300, 250)); // out of the way
        // Patterns paint set bits in ink; srcBic text clears its pixels; patXor inverts.
        checkDarkness(screen(), origin,
            {
                {"ltGray is light", QRect(12, 12, 96, 46), 0.15, 0.35},
                {"dkGray is dark", QRect(122, 12, 96, 46), 0.65, 0.85},
                {"srcBic text clears", QRect(12, 72, 96, 46), 0.4, 0.95},
                {"patXor inverts black", QRect(122, 72, 46, 46), 0.0, 0.05},
                {"black beside it", QRect(172, 72, 46, 46), 0.95, 1.0},
            });

        // While the button is held, the loop's lines reach the screen.
        m_x.moveTo(origin + QPoint(40, 200));
        m_x.button(1, true);
        for (int x = 40; x <= 240; x += 20) {
            m_x.moveTo(origin + QPoint(x, 200));
            QTest::qWait(30);
        }
        QTest::qWait(300);
        const QImage during = screen();
        const double line = darkShare(during, QRect(origin + QPoint(60, 199), QSize(160, 2)));
        m_x.button(1, false);
        QVERIFY2(line > 0.9, qPrintable(QString::number(line)));
        QCOMPARE(p.waitFor(QStringLiteral("tracked")), QStringLiteral("tracked 240 200"));
    }

    void offscreenBitsAndIcons()
    {
        Program p(QStringLiteral("offscreen"));
        // From the program's own memory: drawing landed as bits, its own writes survived a
        // drawing call, text drew, and the window's pixels copied back into a bitmap.
        QCOMPARE(p.waitFor(QStringLiteral("row10")), QStringLiteral("row10 ffff 0000 1"));
        QCOMPARE(p.waitFor(QStringLiteral("direct")), QStringLiteral("direct 1 text 1"));
        QCOMPARE(p.waitFor(QStringLiteral("back")), QStringLiteral("back 2048"));
        QPoint origin;
        QVERIFY(p.readyOrigin(&origin));
        m_x.moveTo(origin + QPoint(390, 290));
        // The bitmap is black on its left half; each copy shows it through its mode.
        checkDarkness(screen(), origin,
            {
                {"srcCopy", QRect(12, 12, 28, 60), 0.99, 1.0},
                {"srcCopy right", QRect(44, 12, 28, 60), 0.0, 0.01},
                {"scaled", QRect(92, 12, 60, 124), 0.99, 1.0},
                {"scaled right", QRect(156, 12, 60, 124), 0.0, 0.01},
                {"srcXor on black", QRect(232, 12, 28, 60), 0.0, 0.01},
                {"srcXor beside", QRect(264, 12, 28, 60), 0.99, 1.0},
                {"srcBic", QRect(312, 12, 28, 60), 0.0, 0.01},
                {"srcBic beside", QRect(344, 12, 28, 60), 0.99, 1.0},
                {"notSrcCopy", QRect(12, 152, 28, 60), 0.0, 0.01},
                {"notSrcCopy right", QRect(44, 152, 28, 60), 0.99, 1.0},
                {"icon over mask", QRect(91, 151, 14, 14), 0.99, 1.0},
                {"mask without icon", QRect(91, 167, 14, 14), 0.0, 0.01},
                {"outside the mask", QRect(107, 151, 14, 30), 0.99, 1.0},
                {"srcXor text twice", QRect(148, 215, 80, 32), 0.0, 0.0},
                {"srcXor text once", QRect(248, 215, 80, 32), 0.05, 0.6},
            });
        m_x.tap(kKeyQ);
        int code = -1;
        QVERIFY(p.finished(&code));
        QCOMPARE(code, 0);
    }

    void gameLoop()
    {
        Program p(QStringLiteral("gameloop"));
        QVERIFY(!p.waitFor(QStringLiteral("ready")).isEmpty());
        QTest::qWait(1000);
        m_x.moveTo(QPoint(200, 150));
        m_x.tap(kKeyQ);
        const QList<int> n = p.numbers(p.waitFor(QStringLiteral("key"))
                                           .remove(QStringLiteral("frames "))
                                           .remove(QStringLiteral("ticks ")));
        QCOMPARE(n.size(), 3);
        // A frame for most ticks: the loop never slept.
        QVERIFY2(n[2] >= 40 && n[1] >= n[2] / 2, qPrintable(p.seen().join('\n')));
    }

private:
    void click(const QPoint& at)
    {
        m_x.moveTo(at);
        QTest::qWait(50);
        m_x.button(1, true);
        QTest::qWait(50);
        m_x.button(1, false);
    }

    VelmarTest::XTestInput m_x;
};

VELMAR_TEST_MAIN(tst_ClassicPrograms)
#include "tst_classicprograms.moc"
