// The demo host: draws a scene with classic QuickDraw calls into an offscreen world and
// shows it in a window, redrawing from a Carbon event loop timer. With --screenshot PATH
// it saves the window and quits, for machines without a display.
#include <Velmar/Velmar.h>

#include <QLabel>
#include <QTimer>

using namespace Velmar;

namespace {

struct Scene {
    GrafPtr world = nullptr;
    QLabel* view = nullptr;
    int frame = 0;
};

void drawScene(Scene& scene)
{
    GrafPtr savedPort = nullptr;
    GetPort(&savedPort);
    SetPort(scene.world);

    Rect bounds;
    GetPortBounds(scene.world, &bounds);
    const RGBColor paper(0xFFFF, 0xFFFF, 0xF0F0);
    RGBBackColor(&paper);
    EraseRect(&bounds);

    // A framed panel with a gray pattern fill, the way classic dialogs drew wells.
    Rect panel;
    SetRect(&panel, 20, 20, 220, 140);
    Pattern pat;
    FillRect(&panel, GetQDGlobalsLightGray(&pat));
    PenSize(3, 3);
    FrameRect(&panel);
    PenNormal();

    // Coloured ovals and a round rectangle.
    const RGBColor red(0xDDDD, 0x2222, 0x2222), blue(0x2222, 0x4444, 0xCCCC);
    const RGBColor black(0, 0, 0);
    Rect oval;
    SetRect(&oval, 250, 20, 350, 120);
    OffsetRect(&oval, (scene.frame * 4) % 100, 0);
    RGBForeColor(&red);
    PaintOval(&oval);
    RGBForeColor(&black);
    FrameOval(&oval);

    Rect round;
    SetRect(&round, 20, 170, 220, 290);
    RGBForeColor(&blue);
    PaintRoundRect(&round, 30, 30);
    RGBForeColor(&black);

    // A region made of two overlapping rectangles, painted with a pattern.
    RgnHandle a = NewRgn();
    RgnHandle b = NewRgn();
    RgnHandle both = NewRgn();
    SetRectRgn(a, 260, 160, 360, 260);
    SetRectRgn(b, 310, 200, 440, 300);
    UnionRgn(a, b, both);
    PenPat(GetQDGlobalsDarkGray(&pat));
    PaintRgn(both);
    PenNormal();
    FrameRgn(both);
    DisposeRgn(a);
    DisposeRgn(b);
    DisposeRgn(both);

    // A fan of lines from the pen location.
    for (int i = 0; i <= 8; ++i) {
        MoveTo(240, 150);
        LineTo(static_cast<short>(240 + 30 * (i - 4)), 145 - 2 * i);
    }

    SetPort(savedPort);
    if (scene.view) {
        if (PixMapPtr* pixmap = GetGWorldPixMap(scene.world))
            scene.view->setPixmap(QPixmap::fromImage(*pixmap->image()));
    }
}

void onTimer(EventLoopTimerRef, void* data)
{
    auto* scene = static_cast<Scene*>(data);
    ++scene->frame;
    drawScene(*scene);
}

} // namespace

int main(int argc, char** argv)
{
    AQtApplication app(argc, argv, false);
    QString screenshot;
    const QStringList args = QCoreApplication::arguments();
    const qsizetype at = args.indexOf(QStringLiteral("--screenshot"));
    if (at >= 0 && at + 1 < args.size())
        screenshot = args.at(at + 1);

    Scene scene;
    Rect bounds{0, 0, 320, 480};
    if (NewGWorld(&scene.world, 32, &bounds, nullptr, nullptr, 0) != noErr || !scene.world) {
        qCritical("velmar-demo: could not create the offscreen world");
        return 1;
    }

    QLabel window;
    window.setWindowTitle(QStringLiteral("Velmar demo"));
    window.setFixedSize(480, 320);
    scene.view = &window;
    drawScene(scene);
    window.show();

    EventLoopTimerRef timer = nullptr;
    InstallEventLoopTimer(GetMainEventLoop(), 0.05, 0.05, NewEventLoopTimerUPP(onTimer), &scene,
                          &timer);

    if (!screenshot.isEmpty()) {
        QTimer::singleShot(800, &window, [&] {
            window.grab().save(screenshot);
            QCoreApplication::quit();
        });
    }
    const int result = AQtApplication::exec();
    RemoveEventLoopTimer(timer);
    DisposeGWorld(scene.world);
    return result;
}
