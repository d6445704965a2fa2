// The demo host: a window driven through the library. With --screenshot PATH it saves
// what it shows and quits, for machines without a display.
#include <Velmar/Velmar.h>

#include <QApplication>
#include <QLabel>
#include <QTimer>

int main(int argc, char** argv)
{
    QApplication app(argc, argv);
    QString screenshot;
    const QStringList args = app.arguments();
    const int at = args.indexOf(QStringLiteral("--screenshot"));
    if (at >= 0 && at + 1 < args.size())
        screenshot = args.at(at + 1);

    QLabel window(QStringLiteral("Velmar demo"));
    window.setWindowTitle(QStringLiteral("Velmar demo"));
    window.resize(480, 320);
    window.show();

    if (!screenshot.isEmpty()) {
        QTimer::singleShot(500, [&] {
            window.grab().save(screenshot);
            app.quit();
        });
    }
    return app.exec();
}
