#include "ResourceExport.h"

#include "classic/resfile/Decoders.h"
#include "classic/resfile/Picture.h"

#include <QDir>
#include <QFile>
#include <QImage>

namespace VelmarRez {

using namespace Velmar;
using namespace Velmar::Classic;

namespace {

// A type code or name that is safe as one path segment of the tree.
bool safeSegment(const QString& text)
{
    if (text.isEmpty() || text == QStringLiteral(".") || text == QStringLiteral(".."))
        return false;
    for (const QChar c : text) {
        if (c.unicode() < 0x20 || c.unicode() >= 0x7F || c == u'/' || c == u'\\')
            return false;
    }
    return true;
}

// The image the library draws for an icon or picture resource, or a null image.
QImage imageOf(const ResourceEntry& e, QString* why)
{
    switch (e.type) {
    case FOUR_CHAR_CODE("ICON"):
        if (const auto bits = decodeIcon(e.data))
            return oneBitImage(*bits, 32, 32);
        break;
    case FOUR_CHAR_CODE("ICN#"):
        if (const auto family = decodeIconList(e.data))
            return oneBitImage(family->icon, 32, 32, family->mask);
        break;
    case FOUR_CHAR_CODE("ics#"):
        if (e.data.size() >= 64)
            return oneBitImage(e.data.left(32), 16, 16, e.data.mid(32, 32));
        break;
    case FOUR_CHAR_CODE("SICN"):
        if (const auto icons = decodeSmallIcons(e.data))
            return oneBitImage(icons->first(), 16, 16);
        break;
    case FOUR_CHAR_CODE("PICT"):
        return pictureImage(e.data, why);
    default:
        return {};
    }
    *why = QStringLiteral("too short for its type");
    return {};
}

bool hasImage(UInt32 type)
{
    for (const char* t : {"ICON", "ICN#", "ics#", "SICN", "PICT"}) {
        if (typeFromString(QString::fromLatin1(t)) == type)
            return true;
    }
    return false;
}

bool writeFile(const QString& path, const QByteArray& bytes, QString* error)
{
    QFile file(path);
    if (!QDir().mkpath(QFileInfo(path).path()) || !file.open(QIODevice::WriteOnly)
        || file.write(bytes) != bytes.size()) {
        *error = QStringLiteral("cannot write %1: %2").arg(path, file.errorString());
        return false;
    }
    return true;
}

} // namespace

QString idFileName(SInt16 id)
{
    return QString::asprintf("%05d", int(id));
}

bool exportTree(const ResourceFork& fork, const QString& folder, ExportReport& report, QString* error)
{
    const QDir root(folder);
    if (!QDir().mkpath(folder)) {
        *error = QStringLiteral("cannot make %1").arg(folder);
        return false;
    }
    for (const ResourceEntry& e : fork.entries()) {
        const QString type = typeToString(e.type);
        const QString label = QStringLiteral("'%1' %2").arg(type).arg(e.id);
        if (!safeSegment(type) || typeFromString(type) != e.type) {
            report.skipped.append(label + QStringLiteral(": the type is not a file name"));
            continue;
        }
        QStringList paths{QStringLiteral("%1/%2").arg(type, idFileName(e.id))};
        const QString name = QString::fromLatin1(e.name);
        if (!e.name.isEmpty() && safeSegment(name))
            paths.append(QStringLiteral("%1/%2").arg(type, name));
        for (const QString& path : paths) {
            if (!writeFile(root.filePath(path), e.data, error))
                return false;
            report.written.append(path);
        }
        if (!hasImage(e.type))
            continue;
        QString why;
        const QImage image = imageOf(e, &why);
        if (image.isNull()) {
            report.skipped.append(label + QStringLiteral(": no image (%1)").arg(why));
            continue;
        }
        const QString path = QStringLiteral("images/%1_%2.png").arg(type).arg(e.id);
        QDir().mkpath(root.filePath(QStringLiteral("images")));
        if (!image.save(root.filePath(path), "PNG")) {
            *error = QStringLiteral("cannot write %1").arg(root.filePath(path));
            return false;
        }
        report.written.append(path);
    }
    QByteArray qrc = "<RCC>\n  <qresource prefix=\"/\">\n";
    for (const QString& path : report.written)
        qrc += "    <file>" + path.toHtmlEscaped().toUtf8() + "</file>\n";
    qrc += "  </qresource>\n</RCC>\n";
    return writeFile(root.filePath(QStringLiteral("resources.qrc")), qrc, error);
}

} // namespace VelmarRez
