// Named resources: 'STR ' from the host's text table, every other type from the file
// ":/TYPE/name" of the resource tree.
#include <Velmar/HostCore.h>
#include <Velmar/Resources.h>
#include <Velmar/TextUtils.h>

#include "resources/ResourceAccess.h"

#include <QFile>
#include <QFileInfo>
#include <QtGlobal>

namespace Velmar {

using namespace Private;

namespace {

// The name's bytes for a log line: printable ASCII as it is, anything else as \xNN.
QByteArray printableName(const unsigned char* name)
{
    QByteArray out;
    for (int i = 1; i <= name[0]; ++i) {
        const unsigned char c = name[i];
        if (c >= 0x20 && c < 0x7F)
            out += char(c);
        else
            out += "\\x" + QByteArray::number(c, 16).rightJustified(2, '0');
    }
    return out;
}

// A NUL inside the length would cut the name short: the host asked for something else.
bool hasNul(const unsigned char* name)
{
    for (int i = 1; i <= name[0]; ++i)
        if (name[i] == 0)
            return true;
    return false;
}

// A path segment of the name or type that could lead out of ":/TYPE/".
bool leavesFolder(const QString& segment)
{
    return segment.contains(QLatin1Char('/')) || segment.contains(QLatin1Char('\\'))
        || segment == QLatin1String("..");
}

ResourceHandle refused(const char* call, ResType type, const unsigned char* name)
{
    const QByteArray typeText = FourCharToString(type).toLatin1();
    if (name)
        qWarning("Velmar::%s: refused resource name \"%s\" of type '%s'", call,
            printableName(name).constData(), typeText.constData());
    else
        qWarning("Velmar::%s: resource name is NULL (type '%s')", call, typeText.constData());
    return ResourceHandle(nullptr, RT_HANDLE);
}

// The translation of `key` as a Pascal string, length byte included, in a new handle.
ResourceHandle textTableString(const QString& key)
{
    const TxText text = stx_func(key.toUtf8().constData());
    unsigned char pascal[256];
    QString2PascalString(QString::fromUtf8(text.c_str()), pascal);
    return ResourceHandle(TxPtrToHand(pascal, Size(pascal[0]) + 1), RT_HANDLE);
}

// The whole file at `path` in a new handle of its size; null data when there is no such file.
ResourceHandle fileResource(const QString& path)
{
    QFile file(path);
    if (!QFileInfo(file).isFile() || !file.open(QIODevice::ReadOnly))
        return ResourceHandle(nullptr, RT_HANDLE);
    const QByteArray bytes = file.readAll();
    return ResourceHandle(TxPtrToHand(bytes.constData(), Size(bytes.size())), RT_HANDLE);
}

} // namespace

namespace Private {

ResourceHandle namedResource(const char* call, ResType type, const unsigned char* name)
{
    if (!name || hasNul(name))
        return refused(call, type, name);
    const QString text = PascalString2QString(name);
    if (type == FOUR_CHAR_CODE("STR "))
        return textTableString(text);
    const QString folder = FourCharToString(type);
    if (leavesFolder(text) || leavesFolder(folder))
        return refused(call, type, name);
    return fileResource(QStringLiteral(":/%1/%2").arg(folder, text));
}

} // namespace Private

ResourceHandle GetNamedResource(ResType type, const unsigned char* name)
{
    return namedResource("GetNamedResource", type, name);
}

ResourceHandle Get1NamedResource(ResType type, const unsigned char* name)
{
    return namedResource("Get1NamedResource", type, name);
}

} // namespace Velmar
