// Writes the test resource tree into the folder given on the command line: the icon and
// picture PNGs of Fixtures.h, its data files, and fixtures.qrc listing them for rcc.
#include "Fixtures.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QImage>
#include <QPainter>
#include <QStringList>
#include <QTextStream>

#include <cstdio>

namespace {

QStringList gFiles;

bool write(const QDir& dir, const QString& path, const QByteArray& bytes)
{
    dir.mkpath(QFileInfo(dir.filePath(path)).path());
    QFile file(dir.filePath(path));
    gFiles << path;
    return file.open(QIODevice::WriteOnly) && file.write(bytes) == bytes.size();
}

bool save(const QDir& dir, const QString& name, const QImage& image)
{
    dir.mkpath(QStringLiteral("images"));
    gFiles << QStringLiteral("images/") + name;
    return image.save(dir.filePath(QStringLiteral("images/") + name), "PNG");
}

// Opaque (saved without alpha): white with the square in `ink`.
QImage squareOnWhite(QRgb ink)
{
    QImage image(32, 32, QImage::Format_RGB32);
    image.fill(Qt::white);
    QPainter(&image).fillRect(Fixtures::kSquare, QColor::fromRgb(ink));
    return image;
}

// One colour with a transparent top-left pixel.
QImage flatMember(QRgb colour, int size)
{
    QImage image(size, size, QImage::Format_ARGB32);
    image.fill(QColor::fromRgba(colour));
    image.setPixel(0, 0, 0);
    return image;
}

int iconSize(const char* type)
{
    return QByteArray(type).startsWith("ics") ? 16 : 32;
}

} // namespace

int main(int argc, char** argv)
{
    if (argc != 2) {
        std::fprintf(stderr, "usage: make_fixtures OUTPUT_DIR\n");
        return 2;
    }
    using namespace Fixtures;
    QDir dir;
    dir.mkpath(QString::fromLocal8Bit(argv[1]));
    dir.setPath(QString::fromLocal8Bit(argv[1]));
    const QString id128 = QString::number(kMaskId);
    bool ok = save(dir, QStringLiteral("ICN#_%1.png").arg(id128), squareOnWhite(0xFF000000))
        && save(dir, QStringLiteral("icl8_%1.png").arg(id128), squareOnWhite(0xFFFF0000))
        && save(dir, QStringLiteral("cicn_%1.png").arg(id128), squareOnWhite(0xFFFF0000))
        && save(dir, QStringLiteral("ICON_%1.png").arg(kColourIconId), squareOnWhite(0xFFFF0000));

    QImage alpha(32, 32, QImage::Format_ARGB32);
    alpha.fill(Qt::transparent);
    QPainter(&alpha).fillRect(kSquare, QColor::fromRgba(kAlphaBlue));
    ok = ok && save(dir, QStringLiteral("ICN#_%1.png").arg(kAlphaIconId), alpha);

    QImage decoy(32, 32, QImage::Format_RGB32);
    decoy.fill(QColor::fromRgb(kStopDecoy));
    ok = ok && save(dir, QStringLiteral("cicn_0.png"), decoy);

    for (const FamilyMember& m : kFamily)
        ok = ok
            && save(dir, QStringLiteral("%1_%2.png").arg(QLatin1String(m.type)).arg(kFullFamily),
                flatMember(m.colour, iconSize(m.type)));
    for (const char* type : kPartFamilyTypes)
        ok = ok
            && save(dir, QStringLiteral("%1_%2.png").arg(QLatin1String(type)).arg(kPartFamily),
                flatMember(familyColour(type), iconSize(type)));

    QImage picture(10, 10, QImage::Format_RGB32);
    picture.fill(Qt::blue);
    QPainter(&picture).fillRect(QRect(0, 0, 5, 10), Qt::red);
    ok = ok && save(dir, QStringLiteral("PICT_%1.png").arg(kPictureId), picture);

    for (const DataFile& f : kDataFiles)
        ok = ok && write(dir, QString::fromLatin1(f.path), QByteArray(f.bytes));

    QByteArray qrc = "<RCC>\n  <qresource prefix=\"/\">\n";
    for (const QString& file : gFiles)
        qrc += "    <file>" + file.toUtf8() + "</file>\n";
    qrc += "  </qresource>\n</RCC>\n";
    QFile out(dir.filePath(QStringLiteral("fixtures.qrc")));
    ok = ok && out.open(QIODevice::WriteOnly) && out.write(qrc) == qrc.size();
    if (!ok)
        std::fprintf(stderr, "make_fixtures: could not write %s\n", argv[1]);
    return ok ? 0 : 1;
}
