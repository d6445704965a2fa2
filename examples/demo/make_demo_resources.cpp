// Draws the demo's own resources (icons, a picture and a text file) and writes the .qrc that
// rcc packs into velmar-demo.rcc, which the demo registers at start as a host would.
#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QImage>
#include <QLinearGradient>
#include <QPainter>
#include <QPainterPath>
#include <QTextStream>

#include <cstdio>

namespace {

QStringList gFiles;
QDir gDir;

bool save(const QString& name, const QImage& image)
{
    gFiles << QStringLiteral("images/") + name;
    return image.save(gDir.filePath(QStringLiteral("images/") + name), "PNG");
}

QImage canvas(int size, const QColor& fill)
{
    QImage image(size, size, QImage::Format_ARGB32);
    image.fill(fill);
    return image;
}

// A colour icon with real transparency: a sun over a hill.
QImage colourIcon(int size)
{
    QImage image = canvas(size, Qt::transparent);
    QPainter p(&image);
    p.setRenderHint(QPainter::Antialiasing);
    const qreal s = size / 32.0;
    p.setBrush(QColor(250, 190, 40));
    p.setPen(Qt::NoPen);
    p.drawEllipse(QPointF(20 * s, 11 * s), 7 * s, 7 * s);
    p.setBrush(QColor(40, 150, 70));
    p.drawEllipse(QRectF(-8 * s, 18 * s, 48 * s, 30 * s));
    return image;
}

// A black-and-white icon without alpha: black is ink, white is transparent once loaded, and
// the port's foreground colour tints it.
QImage monochromeIcon(int size)
{
    QImage image(size, size, QImage::Format_RGB32);
    image.fill(Qt::white);
    QPainter p(&image);
    const qreal s = size / 32.0;
    p.setPen(QPen(Qt::black, 2 * s));
    p.setBrush(Qt::black);
    p.drawRect(QRectF(6 * s, 4 * s, 20 * s, 24 * s).adjusted(0, 0, -1, -1));
    p.setPen(QPen(Qt::white, 2 * s));
    for (int line = 0; line < 4; ++line)
        p.drawLine(QPointF(9 * s, (9 + 5 * line) * s), QPointF(23 * s, (9 + 5 * line) * s));
    return image;
}

// An 8-bit-style icon without alpha: pure white is transparent once loaded.
QImage eightBitIcon(int size)
{
    QImage image(size, size, QImage::Format_RGB32);
    image.fill(Qt::white);
    QPainter p(&image);
    const int cell = size / 4;
    const QColor colours[] = {QColor(220, 60, 60), QColor(60, 120, 220), QColor(240, 200, 40)};
    for (int i = 0; i < 16; ++i)
        if ((i + i / 4) % 2 == 0)
            p.fillRect((i % 4) * cell, (i / 4) * cell, cell, cell, colours[i % 3]);
    return image;
}

QImage picture()
{
    QImage image(240, 120, QImage::Format_RGB32);
    QPainter p(&image);
    p.setRenderHint(QPainter::Antialiasing);
    QLinearGradient sky(0, 0, 0, 120);
    sky.setColorAt(0, QColor(90, 150, 230));
    sky.setColorAt(1, QColor(230, 240, 255));
    p.fillRect(image.rect(), sky);
    QPainterPath hills;
    hills.moveTo(0, 120);
    hills.cubicTo(60, 40, 120, 110, 170, 60);
    hills.cubicTo(200, 35, 230, 70, 240, 60);
    hills.lineTo(240, 120);
    p.fillPath(hills, QColor(60, 140, 80));
    p.setBrush(QColor(255, 220, 80));
    p.setPen(Qt::NoPen);
    p.drawEllipse(QPointF(190, 30), 14, 14);
    return image;
}

bool writeText(const QString& path, const QByteArray& text)
{
    gDir.mkpath(QFileInfo(gDir.filePath(path)).path());
    QFile file(gDir.filePath(path));
    gFiles << path;
    return file.open(QIODevice::WriteOnly) && file.write(text) == text.size();
}

} // namespace

int main(int argc, char** argv)
{
    if (argc != 2) {
        std::fprintf(stderr, "usage: make_demo_resources OUTPUT_DIR\n");
        return 2;
    }
    gDir.mkpath(QString::fromLocal8Bit(argv[1]));
    gDir.setPath(QString::fromLocal8Bit(argv[1]));
    gDir.mkpath(QStringLiteral("images"));
    // Family 128: a colour icon at both sizes, a black-and-white one and an 8-bit one.
    bool ok = save(QStringLiteral("cicn_128.png"), colourIcon(32))
        && save(QStringLiteral("ics8_128.png"), colourIcon(16))
        && save(QStringLiteral("ICN#_129.png"), monochromeIcon(32))
        && save(QStringLiteral("ics#_129.png"), monochromeIcon(16))
        && save(QStringLiteral("icl8_130.png"), eightBitIcon(32))
        && save(QStringLiteral("PICT_128.png"), picture())
        && writeText(QStringLiteral("TEXT/00128"),
            "This text came from the demo's own resource file, ':/TEXT/00128'.");
    QFile qrc(gDir.filePath(QStringLiteral("demo.qrc")));
    ok = ok && qrc.open(QIODevice::WriteOnly);
    QTextStream out(&qrc);
    out << "<RCC>\n  <qresource prefix=\"/\">\n";
    for (const QString& file : gFiles)
        out << "    <file>" << file << "</file>\n";
    out << "  </qresource>\n</RCC>\n";
    return ok ? 0 : 1;
}
