// velmar-classic-mkres OUT.rsrc RESOURCE [-- RESOURCE ...]
//
// Each RESOURCE is a type and ID and its fields:
//   STR  id text                  STR# id text ...
//   MBAR id menuID ...            WIND id title top left bottom right procID visible goAway
//   MENU id title item ...        (items as AppendMenu writes them: "(" disables, "/K" is the
//                                  command key, "-" a separator; the title "@" is the logo)
//   TEXT id text                  HEX  type id hexbytes   (any other type, raw)
#include "classic/resfile/ResourceFork.h"

#include <QByteArray>
#include <QFile>
#include <QList>
#include <QString>

#include <cstdio>

using namespace Velmar;

namespace {

void word(QByteArray& out, int value)
{
    out.append(char((value >> 8) & 0xFF)).append(char(value & 0xFF));
}

void pascal(QByteArray& out, const QByteArray& text)
{
    out.append(char(qMin<qsizetype>(text.size(), 255))).append(text.left(255));
}

QByteArray latin1(const char* s)
{
    return QString::fromUtf8(s).toLatin1();
}

// One resource from its words; false with a message when they do not fit its type.
bool build(const QList<const char*>& a, Classic::ResourceEntry* e)
{
    if (a.size() < 2)
        return false;
    const QByteArray type = a[0];
    e->id = SInt16(atoi(a[1]));
    QByteArray& d = e->data;
    if (type == "STR" && a.size() == 3) {
        e->type = 'STR ';
        pascal(d, latin1(a[2]));
    } else if (type == "STR#") {
        e->type = 'STR#';
        word(d, int(a.size() - 2));
        for (qsizetype i = 2; i < a.size(); ++i)
            pascal(d, latin1(a[i]));
    } else if (type == "TEXT" && a.size() == 3) {
        e->type = 'TEXT';
        d = latin1(a[2]);
    } else if (type == "MBAR") {
        e->type = 'MBAR';
        word(d, int(a.size() - 2));
        for (qsizetype i = 2; i < a.size(); ++i)
            word(d, atoi(a[i]));
    } else if (type == "WIND" && a.size() == 10) {
        e->type = 'WIND';
        for (int i = 3; i <= 6; ++i)
            word(d, atoi(a[i]));
        word(d, atoi(a[7])); // procID
        word(d, atoi(a[8]) ? 0x0100 : 0); // visible (a Boolean in the high byte)
        word(d, atoi(a[9]) ? 0x0100 : 0); // goAwayFlag
        d.append(QByteArray(4, '\0')); // refCon
        pascal(d, latin1(a[2]));
    } else if (type == "MENU" && a.size() >= 3) {
        e->type = 'MENU';
        word(d, e->id);
        word(d, 0);
        word(d, 0);
        word(d, 0); // procID
        word(d, 0); // filler
        UInt32 enable = 1;
        QByteArray items;
        for (qsizetype i = 3; i < a.size() && i < 34; ++i) {
            QByteArray text = latin1(a[i]);
            char key = 0;
            const qsizetype slash = text.indexOf('/');
            if (slash >= 0 && slash + 1 < text.size()) {
                key = text[slash + 1];
                text.remove(slash, 2);
            }
            if (!text.startsWith('(') && !text.startsWith('-'))
                enable |= 1u << (i - 2);
            if (text.startsWith('('))
                text.remove(0, 1);
            pascal(items, text);
            items.append('\0').append(key).append('\0').append('\0');
        }
        d.append(char(enable >> 24))
            .append(char(enable >> 16))
            .append(char(enable >> 8))
            .append(char(enable));
        const QByteArray title = latin1(a[2]);
        pascal(d, title == "@" ? QByteArray(1, '\x14') : title);
        d.append(items).append('\0');
    } else if (type == "HEX" && a.size() == 4 && qstrlen(a[1]) == 4) {
        const QByteArray t = a[1];
        e->type = UInt32(UInt8(t[0])) << 24 | UInt32(UInt8(t[1])) << 16 | UInt32(UInt8(t[2])) << 8
            | UInt8(t[3]);
        e->id = SInt16(atoi(a[2]));
        d = QByteArray::fromHex(a[3]);
    } else {
        return false;
    }
    return true;
}

} // namespace

int main(int argc, char** argv)
{
    if (argc < 3) {
        std::fprintf(stderr,
            "usage: velmar-classic-mkres OUT.rsrc TYPE ID FIELDS... [-- TYPE ID FIELDS...]\n");
        return 2;
    }
    Classic::ResourceFork fork;
    QList<const char*> words;
    for (int i = 2; i <= argc; ++i) {
        if (i == argc || QByteArray(argv[i]) == "--") {
            Classic::ResourceEntry e;
            if (!build(words, &e)) {
                std::fprintf(stderr, "velmar-classic-mkres: cannot make a resource of \"%s\"\n",
                    words.isEmpty() ? "" : words[0]);
                return 1;
            }
            fork.add(e);
            words.clear();
            continue;
        }
        words.append(argv[i]);
    }
    QFile out(QString::fromLocal8Bit(argv[1]));
    if (!out.open(QIODevice::WriteOnly) || out.write(fork.serialize()) < 0) {
        std::fprintf(stderr, "velmar-classic-mkres: cannot write %s\n", argv[1]);
        return 1;
    }
    return 0;
}
