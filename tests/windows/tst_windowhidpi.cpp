// On a screen scaled by two, hosts keep working in Toolbox (logical) coordinates: bounds,
// FindWindow and GlobalToLocal agree with what is on screen, and what the host draws appears
// at the right place and size.
#include "WindowTestSupport.h"
#include "WindowSystemNeeds.h"

#include <Velmar/QDShapes.h>
#include <Velmar/QuickDraw.h>

using namespace Velmar;
using namespace WindowTest;

class tst_WindowHiDpi : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void scaledScreen()
    {
        VELMAR_REQUIRE_X11("a screen scaled by two, read back through X");
        QCOMPARE(QGuiApplication::primaryScreen()->devicePixelRatio(), 2.0);
        Window w(R(60, 50, 210, 250)); // 200 x 150 at (50, 60)
        w.show();
        Rect content;
        QCOMPARE(GetWindowBounds(w, kWindowContentRgn, &content), noErr);
        const QPoint topLeft = w->mapToGlobal(QPoint(0, 0));
        QCOMPARE(QPoint(content.left, content.top), topLeft);
        QCOMPARE(Private::rectWidth(content), 200);
        Rect port;
        GetWindowPortBounds(w, &port);
        QCOMPARE(Private::rectWidth(port), 200); // the back buffer is in logical pixels

        WindowRef hit = nullptr;
        const Point inside{SInt16(topLeft.y() + 20), SInt16(topLeft.x() + 30)};
        QCOMPARE(FindWindow(inside, &hit), WindowPartCode(inContent));
        QCOMPARE(hit, WindowRef(w));
        OnPort current(w);
        Point local = inside;
        GlobalToLocal(&local);
        QCOMPARE(QPoint(local.h, local.v), QPoint(30, 20));

        BeginUpdate(w);
        const RGBColor red(65535, 0, 0);
        RGBForeColor(&red);
        const Rect square = R(10, 10, 30, 30);
        PaintRect(&square);
        EndUpdate(w);
        // The square covers logical 10-29: on the screen that is device pixels 20-59.
        const auto at = [&](int x, int y) {
            const QImage shot = screenPixels(QRect(topLeft + QPoint(x, y), QSize(1, 1)));
            return shot.pixel(0, 0);
        };
        QTRY_COMPARE(at(20, 20), qRgb(255, 0, 0));
        QCOMPARE(at(29, 29), qRgb(255, 0, 0));
        QVERIFY(at(31, 31) != qRgb(255, 0, 0));
    }
};

int main(int argc, char** argv)
{
    qputenv("QT_SCALE_FACTOR", "2");
    VelmarTest::isolateSettings();
    AQtApplication app(argc, argv, false);
    VelmarTest::installUnexpectedAssertionGuard();
    tst_WindowHiDpi tc;
    return QTest::qExec(&tc, argc, argv);
}

#include "tst_windowhidpi.moc"
