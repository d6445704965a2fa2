#include "classic/resfile/ResourceFork.h"

#include "classic/resfile/BigEndian.h"
#include "classic/resfile/ForkWrappers.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>

#include <algorithm>
#include <utility>

namespace Velmar::Classic {

namespace {

// Fixed sizes of the fork's parts.
constexpr qsizetype kHeaderSize = 16;
constexpr qsizetype kReservedEnd = 256;        // header, then system and application data
constexpr qsizetype kMapFixedSize = 28;        // header copy, next map, file ref, attributes, 2 offsets
constexpr qsizetype kTypeEntrySize = 8;
constexpr qsizetype kRefEntrySize = 12;
constexpr qint64 kMaxDataOffset = 0xFFFFFF;    // the reference's data offset is 24 bits

bool refuse(QString* error, const QString& why)
{
    if (error)
        *error = why;
    return false;
}

struct Span {
    qint64 begin;
    qint64 end;
};

// True when no two non-empty spans share a byte.
bool disjoint(std::vector<Span> spans)
{
    std::sort(spans.begin(), spans.end(), [](const Span& a, const Span& b) { return a.begin < b.begin; });
    for (size_t i = 1; i < spans.size(); ++i) {
        if (spans[i].begin < spans[i - 1].end)
            return false;
    }
    return true;
}

// Upper case of a Mac Roman byte: ASCII and the accented letters that have a capital.
UInt8 macRomanUpper(UInt8 c)
{
    if (c >= 'a' && c <= 'z')
        return UInt8(c - 'a' + 'A');
    static constexpr std::pair<UInt8, UInt8> kPairs[] = {
        {0x87, 0xE7}, {0x88, 0xCB}, {0x89, 0xE5}, {0x8A, 0x80}, {0x8B, 0xCC}, {0x8C, 0x81},
        {0x8D, 0x82}, {0x8E, 0x83}, {0x8F, 0xE9}, {0x90, 0xE6}, {0x91, 0xE8}, {0x92, 0xEA},
        {0x93, 0xED}, {0x94, 0xEB}, {0x95, 0xEC}, {0x96, 0x84}, {0x97, 0xEE}, {0x98, 0xF1},
        {0x99, 0xEF}, {0x9A, 0x85}, {0x9B, 0xCD}, {0x9C, 0xF2}, {0x9D, 0xF4}, {0x9E, 0xF3},
        {0x9F, 0x86}, {0xBE, 0xAE}, {0xBF, 0xAF}, {0xCF, 0xCE}, {0xD8, 0xD9},
    };
    for (const auto& [lower, upper] : kPairs) {
        if (c == lower)
            return upper;
    }
    return c;
}

bool equalIgnoringCase(const QByteArray& a, const QByteArray& b)
{
    if (a.size() != b.size())
        return false;
    for (qsizetype i = 0; i < a.size(); ++i) {
        if (macRomanUpper(UInt8(a[i])) != macRomanUpper(UInt8(b[i])))
            return false;
    }
    return true;
}

bool parseInto(const QByteArray& fork, QList<ResourceEntry>& out, QString* error)
{
    const qint64 size = fork.size();
    if (size < kHeaderSize)
        return refuse(error, QStringLiteral("too short for a resource fork header (%1 bytes)").arg(size));
    const qint64 dataOffset = beAt(fork, 0, 4);
    const qint64 mapOffset = beAt(fork, 4, 4);
    const qint64 dataLength = beAt(fork, 8, 4);
    const qint64 mapLength = beAt(fork, 12, 4);
    if (dataOffset + dataLength > size)
        return refuse(error, QStringLiteral("resource data runs past the end of the fork"));
    if (mapOffset + mapLength > size)
        return refuse(error, QStringLiteral("resource map runs past the end of the fork"));
    if (mapLength < kMapFixedSize + 2)
        return refuse(error, QStringLiteral("resource map too short (%1 bytes)").arg(mapLength));
    if (dataLength > 0 && dataOffset < mapOffset + mapLength && mapOffset < dataOffset + dataLength)
        return refuse(error, QStringLiteral("resource data and map overlap"));

    // Everything below reads inside the map only.
    const QByteArray map = fork.mid(mapOffset, mapLength);
    const qint64 typeList = beAt(map, 24, 2);
    const qint64 nameList = beAt(map, 26, 2);
    if (typeList < kMapFixedSize || typeList + 2 > mapLength)
        return refuse(error, QStringLiteral("type list outside the resource map"));
    const qint64 typeCount = qint64(SInt16(beAt(map, typeList, 2))) + 1;
    if (typeCount < 0)
        return refuse(error, QStringLiteral("negative type count"));
    if (typeList + 2 + typeCount * kTypeEntrySize > mapLength)
        return refuse(error, QStringLiteral("type list of %1 types runs past the map").arg(typeCount));

    std::vector<Span> refSpans;
    std::vector<Span> dataSpans;
    QList<ResourceEntry> entries;
    // Running totals: shared lists or data would let a small file claim billions of resources
    // or gigabytes of data, so each is bounded by its area before anything is copied.
    qint64 totalRefs = 0;
    qint64 totalData = 0;
    for (qint64 t = 0; t < typeCount; ++t) {
        const qint64 at = typeList + 2 + t * kTypeEntrySize;
        const UInt32 type = beAt(map, at, 4);
        const qint64 refCount = qint64(SInt16(beAt(map, at + 4, 2))) + 1;
        const qint64 refList = typeList + qint64(beAt(map, at + 6, 2));
        if (refCount < 0)
            return refuse(error, QStringLiteral("negative resource count for '%1'").arg(typeToString(type)));
        if (refList < typeList + 2 || refList + refCount * kRefEntrySize > mapLength)
            return refuse(error, QStringLiteral("reference list of '%1' outside the map").arg(typeToString(type)));
        totalRefs += refCount;
        if (totalRefs * kRefEntrySize > mapLength)
            return refuse(error, QStringLiteral("more references than the map can hold"));
        refSpans.push_back({refList, refList + refCount * kRefEntrySize});
        for (qint64 r = 0; r < refCount; ++r) {
            const qint64 ref = refList + r * kRefEntrySize;
            ResourceEntry e;
            e.type = type;
            e.id = SInt16(beAt(map, ref, 2));
            const UInt32 nameOffset = beAt(map, ref + 2, 2);
            e.attributes = UInt8(beAt(map, ref + 4, 1));
            const qint64 offset = beAt(map, ref + 5, 3);
            if (nameOffset != 0xFFFF) {
                const qint64 name = nameList + nameOffset;
                if (name >= mapLength || name + 1 + qint64(UInt8(map[name])) > mapLength)
                    return refuse(error, QStringLiteral("name of '%1' %2 outside the map").arg(typeToString(type)).arg(e.id));
                e.name = map.mid(name + 1, UInt8(map[name]));
            }
            if (offset + 4 > dataLength)
                return refuse(error, QStringLiteral("data of '%1' %2 outside the data area").arg(typeToString(type)).arg(e.id));
            const qint64 length = beAt(fork, dataOffset + offset, 4);
            if (length > dataLength - offset - 4)
                return refuse(error, QStringLiteral("data of '%1' %2 runs past the data area").arg(typeToString(type)).arg(e.id));
            totalData += 4 + length;
            if (totalData > dataLength)
                return refuse(error, QStringLiteral("resource data blocks overlap"));
            dataSpans.push_back({offset, offset + 4 + length});
            e.data = fork.mid(dataOffset + offset + 4, length);
            entries.append(std::move(e));
        }
    }
    if (!disjoint(std::move(refSpans)))
        return refuse(error, QStringLiteral("reference lists overlap"));
    if (!disjoint(std::move(dataSpans)))
        return refuse(error, QStringLiteral("resource data blocks overlap"));
    out = std::move(entries);
    return true;
}

// A fork's data and map offsets are 32 bits and its data offsets 24: no file that holds one
// needs more than this.
constexpr qint64 kMaxFileSize = qint64(1) << 30;

std::optional<QByteArray> readFile(const QString& path, QString* why)
{
    QFile file(path);
    if (!QFileInfo(path).isFile() || !file.open(QIODevice::ReadOnly))
        return std::nullopt;
    if (file.size() > kMaxFileSize) {
        *why = QStringLiteral("file too large for a resource file (%1 bytes)").arg(file.size());
        return QByteArray();
    }
    return file.readAll();
}

} // namespace

QString typeToString(UInt32 type)
{
    QString out;
    for (int shift = 24; shift >= 0; shift -= 8) {
        const UInt8 c = UInt8(type >> shift);
        out.append(c >= 0x20 && c < 0x7F ? QChar(c) : QChar(u'?'));
    }
    return out;
}

UInt32 typeFromString(const QString& text)
{
    UInt32 type = 0;
    for (int i = 0; i < 4; ++i)
        type = (type << 8) | (i < text.size() && text[i].unicode() < 0x100 ? UInt8(text[i].unicode()) : ' ');
    return type;
}

std::optional<ResourceFork> ResourceFork::parse(const QByteArray& fork, QString* error)
{
    ResourceFork result;
    if (!parseInto(fork, result.m_entries, error))
        return std::nullopt;
    return result;
}

std::optional<ResourceFork> ResourceFork::unwrap(
    const QByteArray& file, QString* error, bool* isWrapped)
{
    QString why;
    if (isWrapped)
        *isWrapped = false;
    const auto wrapped = Wrappers::unwrap(file, &why);
    if (wrapped && wrapped->kind != Wrappers::Kind::None) {
        if (!wrapped->resourceFork.isEmpty()) {
            if (auto fork = parse(wrapped->resourceFork, &why)) {
                if (isWrapped)
                    *isWrapped = true;
                return fork;
            }
        } else if (why.isEmpty()) {
            why = QStringLiteral("the resource fork is empty");
        }
        // A MacBinary I header is recognised by a few zero bytes only: the file may be a raw
        // fork after all. Any other container's verdict stands.
        if (wrapped->certain) {
            refuse(error, why);
            return std::nullopt;
        }
    }
    return parse(file, error);
}

std::optional<ResourceFork> ResourceFork::load(
    const QString& path, QString* error, ForkOrigin* origin)
{
    QStringList reasons;
    const QFileInfo info(path);
    const QString companions[] = {
        path,
        path + QStringLiteral(".rsrc"),
        info.dir().filePath(QStringLiteral("._") + info.fileName()),
        path + QStringLiteral("/..namedfork/rsrc"),
    };
    for (const QString& candidate : companions) {
        QString why;
        const auto bytes = readFile(candidate, &why);
        if (!bytes)
            continue;
        if (!why.isEmpty()) {
            reasons.append(QStringLiteral("%1: %2").arg(candidate, why));
            continue;
        }
        bool wrapped = false;
        if (auto fork = unwrap(*bytes, &why, &wrapped)) {
            if (origin)
                *origin = {candidate, !wrapped && !candidate.endsWith(QStringLiteral("/rsrc"))};
            return fork;
        }
        reasons.append(QStringLiteral("%1: %2").arg(candidate, why));
    }
    if (reasons.isEmpty())
        reasons.append(QStringLiteral("%1: no such file, and no resource fork beside it").arg(path));
    refuse(error, reasons.join(QStringLiteral("; ")));
    return std::nullopt;
}

QList<UInt32> ResourceFork::types() const
{
    QList<UInt32> out;
    for (const ResourceEntry& e : m_entries) {
        if (!out.contains(e.type))
            out.append(e.type);
    }
    return out;
}

int ResourceFork::count(UInt32 type) const
{
    return int(std::count_if(m_entries.begin(), m_entries.end(),
                             [type](const ResourceEntry& e) { return e.type == type; }));
}

const ResourceEntry* ResourceFork::find(UInt32 type, SInt16 id) const
{
    for (const ResourceEntry& e : m_entries) {
        if (e.type == type && e.id == id)
            return &e;
    }
    return nullptr;
}

ResourceEntry* ResourceFork::find(UInt32 type, SInt16 id)
{
    return const_cast<ResourceEntry*>(std::as_const(*this).find(type, id));
}

bool ResourceFork::remove(UInt32 type, SInt16 id)
{
    for (qsizetype i = 0; i < m_entries.size(); ++i) {
        if (m_entries[i].type == type && m_entries[i].id == id) {
            m_entries.removeAt(i);
            return true;
        }
    }
    return false;
}

const ResourceEntry* ResourceFork::findNamed(UInt32 type, const QByteArray& name) const
{
    for (const ResourceEntry& e : m_entries) {
        if (e.type == type && !e.name.isEmpty() && equalIgnoringCase(e.name, name))
            return &e;
    }
    return nullptr;
}

const ResourceEntry* ResourceFork::indexed(UInt32 type, int oneBasedIndex) const
{
    if (oneBasedIndex < 1)
        return nullptr;
    for (const ResourceEntry& e : m_entries) {
        if (e.type == type && --oneBasedIndex == 0)
            return &e;
    }
    return nullptr;
}

void ResourceFork::add(ResourceEntry e)
{
    qsizetype lastOfType = -1;
    for (qsizetype i = 0; i < m_entries.size(); ++i) {
        if (m_entries[i].type != e.type)
            continue;
        if (m_entries[i].id == e.id) {
            m_entries[i] = std::move(e);
            return;
        }
        lastOfType = i;
    }
    if (e.name.size() > 255)
        e.name.truncate(255);
    if (lastOfType < 0)
        m_entries.append(std::move(e));
    else
        m_entries.insert(lastOfType + 1, std::move(e));
}

QByteArray ResourceFork::serialize() const
{
    const QList<UInt32> order = types();
    QByteArray data;
    QByteArray names;
    QByteArray typeList;
    QByteArray refs;
    putBE(typeList, UInt32(order.size() - 1), 2);
    const qsizetype refsStart = 2 + order.size() * kTypeEntrySize;
    for (UInt32 type : order) {
        const int n = count(type);
        putBE(typeList, type, 4);
        putBE(typeList, UInt32(n - 1), 2);
        putBE(typeList, UInt32(refsStart + refs.size()), 2);
        for (const ResourceEntry& e : m_entries) {
            if (e.type != type)
                continue;
            if (data.size() > kMaxDataOffset)
                return {};
            putBE(refs, UInt16(e.id), 2);
            if (e.name.isEmpty()) {
                putBE(refs, 0xFFFF, 2);
            } else {
                putBE(refs, UInt32(names.size()), 2);
                const QByteArray name = e.name.left(255);
                names.append(char(name.size())).append(name);
            }
            putBE(refs, e.attributes, 1);
            putBE(refs, UInt32(data.size()), 3);
            putBE(refs, 0, 4);
            putBE(data, UInt32(e.data.size()), 4);
            data.append(e.data);
        }
    }
    const qint64 nameListOffset = kMapFixedSize + typeList.size() + refs.size();
    if (nameListOffset > 0xFFFF || names.size() > 0xFFFF)
        return {};
    const qint64 mapLength = nameListOffset + names.size();
    const qint64 mapOffset = kReservedEnd + data.size();
    if (mapOffset + mapLength > 0xFFFFFFFFll)
        return {};

    QByteArray header;
    putBE(header, UInt32(kReservedEnd), 4);
    putBE(header, UInt32(mapOffset), 4);
    putBE(header, UInt32(data.size()), 4);
    putBE(header, UInt32(mapLength), 4);

    QByteArray fork = header;
    fork.append(QByteArray(kReservedEnd - kHeaderSize, '\0'));
    fork.append(data);
    fork.append(header);
    putBE(fork, 0, 4); // next map
    putBE(fork, 0, 2); // file reference
    putBE(fork, 0, 2); // fork attributes
    putBE(fork, UInt32(kMapFixedSize), 2);
    putBE(fork, UInt32(nameListOffset), 2);
    fork.append(typeList).append(refs).append(names);
    return fork;
}

} // namespace Velmar::Classic
