// velmar-rez: what a classic resource file holds, and the same resources as the library's
// resource tree.
//
//   velmar-rez list FILE          type, ID, name, size and attributes of every resource
//   velmar-rez export FILE DIR    DIR/TYPE/nnnnn files, DIR/images/TYPE_ID.png for icons and
//                                 pictures, and DIR/resources.qrc listing them
//
// FILE may be a raw resource fork, a MacBinary file, an AppleSingle or AppleDouble file, or
// a file whose fork sits beside it ("FILE.rsrc", "._FILE") or in "FILE/..namedfork/rsrc".
#include "ResourceExport.h"

#include "classic/resfile/ResourceFork.h"

#include <QApplication>

#include <cstdio>

using namespace Velmar;
using namespace Velmar::Classic;

namespace {

int usage()
{
    std::fprintf(stderr, "usage: velmar-rez list FILE\n"
                         "       velmar-rez export FILE DIR\n");
    return 2;
}

QString attributeNames(UInt8 a)
{
    QStringList names;
    const std::pair<UInt8, const char*> bits[] = {{kResSysHeap, "sysheap"}, {kResPurgeable, "purgeable"},
        {kResLocked, "locked"}, {kResProtected, "protected"}, {kResPreload, "preload"}, {kResChanged, "changed"}};
    for (const auto& [bit, name] : bits) {
        if (a & bit)
            names.append(QString::fromLatin1(name));
    }
    return QStringLiteral("0x%1 %2").arg(uint(a), 2, 16, QLatin1Char('0')).arg(names.join(u',')).trimmed();
}

// Names are Mac Roman; bytes outside ASCII print as \xNN so the listing stays one line each.
QString printable(const QByteArray& name)
{
    QString out;
    for (const char c : name) {
        const UInt8 u = UInt8(c);
        out += (u >= 0x20 && u < 0x7F && u != '"' && u != '\\') ? QString(QChar(u)) : QString::asprintf("\\x%02X", u);
    }
    return out;
}

int list(const ResourceFork& fork)
{
    std::printf("%-6s %6s %-24s %8s %s\n", "type", "id", "name", "size", "attributes");
    for (const ResourceEntry& e : fork.entries()) {
        const QByteArray name = e.name.isEmpty() ? QByteArray("-") : ('"' + printable(e.name) + '"').toUtf8();
        std::printf("'%s' %6d %-24s %8lld %s\n", qPrintable(typeToString(e.type)), int(e.id), name.constData(),
                    static_cast<long long>(e.data.size()), qPrintable(attributeNames(e.attributes)));
    }
    return 0;
}

} // namespace

int main(int argc, char** argv)
{
    const QStringList args = [&] {
        QStringList out;
        for (int i = 1; i < argc; ++i)
            out.append(QString::fromLocal8Bit(argv[i]));
        return out;
    }();
    const bool listing = args.size() == 2 && args[0] == QStringLiteral("list");
    const bool exporting = args.size() == 3 && args[0] == QStringLiteral("export");
    if (!listing && !exporting)
        return usage();

    QString error;
    const auto fork = ResourceFork::load(args[1], &error);
    if (!fork) {
        std::fprintf(stderr, "velmar-rez: %s\n", qPrintable(error));
        return 1;
    }
    if (listing)
        return list(*fork);

    // Pictures are drawn with the library's QuickDraw, which needs a GUI application; no
    // display is needed.
    if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM"))
        qputenv("QT_QPA_PLATFORM", "offscreen");
    QApplication app(argc, argv);
    VelmarRez::ExportReport report;
    if (!VelmarRez::exportTree(*fork, args[2], report, &error)) {
        std::fprintf(stderr, "velmar-rez: %s\n", qPrintable(error));
        return 1;
    }
    for (const QString& skipped : report.skipped)
        std::fprintf(stderr, "velmar-rez: skipped %s\n", qPrintable(skipped));
    std::printf("%lld files and resources.qrc written to %s\n", static_cast<long long>(report.written.size()),
                qPrintable(args[2]));
    return 0;
}
