// Turns the library's text cursor pictures into PNGs for the resource tree.
//
//     make_cursor_pictures OUTPUT_DIR ID_name.txt...
//
// Each picture is 16 lines of 16 characters: '.' transparent, '#' black, 'o' white. For the
// ID its file name starts with it writes crsr_ID.png and CURS_ID.png (the colour and the
// black-and-white cursor are the same picture) and their @2x variants, the picture doubled,
// for high-density screens; then velmar_cursors.qrc listing them under "/velmar/cursors" (the
// library's fallback: a host's own pictures under "/images/cursors" win).
#include <QByteArray>
#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QImage>
#include <QRegularExpression>
#include <QStringList>

#include <cstdio>
#include <utility>

namespace {

constexpr int kSide = 16;

void complain(const QString& where, const char* what)
{
    std::fprintf(stderr, "make_cursor_pictures: %s: %s\n", qPrintable(where), what);
}

bool readPicture(const QString& path, QImage* out)
{
    QFile file(path);
    if (!file.open(QIODevice::ReadOnly | QIODevice::Text)) {
        complain(path, "cannot read");
        return false;
    }
    const QList<QByteArray> lines = file.readAll().split('\n');
    if (lines.size() < kSide || (lines.size() > kSide && !lines.at(kSide).isEmpty())) {
        complain(path, "want 16 lines");
        return false;
    }
    QImage image(kSide, kSide, QImage::Format_ARGB32);
    for (int y = 0; y < kSide; ++y) {
        const QByteArray& line = lines.at(y);
        const QString where = QStringLiteral("%1:%2").arg(path).arg(y + 1);
        if (line.size() != kSide) {
            complain(where, "want 16 characters");
            return false;
        }
        for (int x = 0; x < kSide; ++x) {
            switch (line.at(x)) {
            case '.': image.setPixel(x, y, 0x00000000); break;
            case '#': image.setPixel(x, y, 0xFF000000); break;
            case 'o': image.setPixel(x, y, 0xFFFFFFFF); break;
            default: complain(where, "want only . # o"); return false;
            }
        }
    }
    *out = image;
    return true;
}

} // namespace

int main(int argc, char** argv)
{
    if (argc < 3) {
        std::fprintf(stderr, "usage: make_cursor_pictures OUTPUT_DIR ID_name.txt...\n");
        return 2;
    }
    const QString outDir = QString::fromLocal8Bit(argv[1]);
    QDir().mkpath(outDir);
    const QDir dir(outDir);
    const QRegularExpression leadingId(QStringLiteral("^(\\d+)_"));
    QStringList files;
    for (int i = 2; i < argc; ++i) {
        const QString path = QString::fromLocal8Bit(argv[i]);
        const QRegularExpressionMatch match = leadingId.match(QFileInfo(path).fileName());
        if (!match.hasMatch()) {
            complain(path, "the name must start with the cursor ID and '_'");
            return 1;
        }
        QImage picture;
        if (!readPicture(path, &picture))
            return 1;
        // Nearest-neighbour scaling by two doubles every pixel.
        const QImage doubled =
            picture.scaled(2 * kSide, 2 * kSide, Qt::IgnoreAspectRatio, Qt::FastTransformation);
        for (const char* kind : {"crsr", "CURS"}) {
            const QString base =
                QStringLiteral("%1_%2").arg(QLatin1String(kind), match.captured(1));
            for (const auto& [name, image] : {std::pair{base + QStringLiteral(".png"), picture},
                     std::pair{base + QStringLiteral("@2x.png"), doubled}}) {
                if (!image.save(dir.filePath(name), "PNG")) {
                    complain(dir.filePath(name), "cannot write");
                    return 1;
                }
                files << name;
            }
        }
    }
    QByteArray qrc = "<RCC>\n  <qresource prefix=\"/velmar/cursors\">\n";
    for (const QString& name : files)
        qrc += "    <file>" + name.toUtf8() + "</file>\n";
    qrc += "  </qresource>\n</RCC>\n";
    QFile out(dir.filePath(QStringLiteral("velmar_cursors.qrc")));
    if (!out.open(QIODevice::WriteOnly) || out.write(qrc) != qrc.size()) {
        complain(out.fileName(), "cannot write");
        return 1;
    }
    return 0;
}
