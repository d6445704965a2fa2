// A second process for the tests that must meet another application on the desktop: it
// reads and writes the clipboard, and acts as a plain Qt drop target or drag source.
// Everything it sees is printed to standard output, one line each, as UTF-8.
//   velmar_peer clip-get              prints "text: <clipboard text>" and ends
//   velmar_peer clip-set TEXT         owns the clipboard until its standard input closes
//   velmar_peer drop-target X Y       a window at (X, Y); prints what a drop brings, ends
//   velmar_peer drag-source X Y TEXT URL   a window that starts a drag on a click, ends
#include <QApplication>
#include <QClipboard>
#include <QDrag>
#include <QDropEvent>
#include <QMimeData>
#include <QMouseEvent>
#include <QSocketNotifier>
#include <QTimer>
#include <QUrl>
#include <QWidget>

#include <cstdio>
#include <unistd.h>

namespace {

void say(const QString& line)
{
    std::printf("%s\n", line.toUtf8().constData());
    std::fflush(stdout);
}

class DropTarget : public QWidget {
protected:
    void dragEnterEvent(QDragEnterEvent* e) override { e->acceptProposedAction(); }
    void dragMoveEvent(QDragMoveEvent* e) override { e->acceptProposedAction(); }
    void dropEvent(QDropEvent* e) override
    {
        const QMimeData* data = e->mimeData();
        say(QStringLiteral("formats: ") + data->formats().join(QLatin1Char(',')));
        for (const QUrl& url : data->urls())
            say(QStringLiteral("url: ") + url.toString());
        if (data->hasText())
            say(QStringLiteral("text: ") + data->text());
        say(QStringLiteral("dropped"));
        e->acceptProposedAction();
        QTimer::singleShot(200, qApp, &QCoreApplication::quit);
    }
};

class DragSource : public QWidget {
public:
    DragSource(QString text, QUrl url) : m_text(std::move(text)), m_url(std::move(url)) {}

protected:
    void mousePressEvent(QMouseEvent*) override
    {
        auto* data = new QMimeData;
        data->setText(m_text);
        data->setUrls({m_url});
        auto* drag = new QDrag(this);
        drag->setMimeData(data);
        const Qt::DropAction action = drag->exec(Qt::CopyAction | Qt::MoveAction, Qt::CopyAction);
        say(QStringLiteral("drag ended %1").arg(int(action)));
        QTimer::singleShot(200, qApp, &QCoreApplication::quit);
    }

private:
    QString m_text;
    QUrl m_url;
};

void placeAndShow(QWidget* w, const QStringList& args)
{
    w->setWindowTitle(QStringLiteral("velmar peer"));
    w->setGeometry(args.value(2).toInt(), args.value(3).toInt(), 200, 150);
    w->show();
}

} // namespace

int main(int argc, char** argv)
{
    QApplication app(argc, argv);
    const QStringList args = app.arguments();
    const QString mode = args.value(1);
    // A safety net: no peer outlives a test that forgot it.
    QTimer::singleShot(20000, &app, &QCoreApplication::quit);
    if (mode == QLatin1String("clip-get")) {
        say(QStringLiteral("text: ") + QGuiApplication::clipboard()->text());
        return 0;
    }
    if (mode == QLatin1String("clip-set")) {
        QGuiApplication::clipboard()->setText(args.value(2));
        auto* input = new QSocketNotifier(STDIN_FILENO, QSocketNotifier::Read, &app);
        QObject::connect(input, &QSocketNotifier::activated, &app, [] {
            char c;
            if (read(STDIN_FILENO, &c, 1) <= 0)
                QCoreApplication::quit();
        });
        say(QStringLiteral("ready"));
        return app.exec();
    }
    QWidget* window = nullptr;
    if (mode == QLatin1String("drop-target")) {
        window = new DropTarget;
        window->setAcceptDrops(true);
    } else if (mode == QLatin1String("drag-source")) {
        window = new DragSource(args.value(4), QUrl(args.value(5)));
    } else {
        std::fprintf(stderr, "velmar_peer: unknown mode\n");
        return 2;
    }
    placeAndShow(window, args);
    QTimer::singleShot(300, &app, [] { say(QStringLiteral("ready")); });
    return app.exec();
}
