// A classic resource fork held in memory: parsed from its raw bytes (or from a file in one of
// the wrappers that carried forks off the Mac), searched by type, ID, name or index, and
// written back as a raw fork. Private to the classic layer; nothing here is installed.
#pragma once

#include <Velmar/MacTypes.h>

#include <QByteArray>
#include <QList>
#include <QString>

#include <optional>

namespace Velmar::Classic {

// The attribute bits of a resource as the map keeps them.
enum : UInt8 {
    kResSysHeap = 0x40,
    kResPurgeable = 0x20,
    kResLocked = 0x10,
    kResProtected = 0x08,
    kResPreload = 0x04,
    kResChanged = 0x02,
};

struct ResourceEntry {
    UInt32 type = 0;
    SInt16 id = 0;
    UInt8 attributes = 0;
    QByteArray name; // Mac Roman bytes, empty if none
    QByteArray data;
};

// Where load() found a fork: the file, and whether that file is the raw fork itself (which can
// be written back in place) or a container or companion holding other data too.
struct ForkOrigin {
    QString path;
    bool raw = false;
};

class ResourceFork {
public:
    // Raw resource fork bytes. Refuses anything inconsistent (offsets past the end, overlapping
    // lists, impossible counts, truncated data) with nullopt and, if asked, a one-line reason.
    static std::optional<ResourceFork> parse(const QByteArray& fork, QString* error = nullptr);
    // A file holding a raw fork, a MacBinary I/II/III file, an AppleSingle or AppleDouble file.
    // For a path "x" that is none of these (or absent) also tries "x.rsrc", "._x" and
    // "x/..namedfork/rsrc", in that order.
    static std::optional<ResourceFork> load(
        const QString& path, QString* error = nullptr, ForkOrigin* origin = nullptr);
    // The fork inside one file's bytes, unwrapped as load() does (no companion files).
    // *wrapped says whether it came out of a container.
    static std::optional<ResourceFork> unwrap(
        const QByteArray& file, QString* error = nullptr, bool* wrapped = nullptr);

    QList<UInt32> types() const; // in file order
    int count(UInt32 type) const;
    const ResourceEntry* find(UInt32 type, SInt16 id) const;
    const ResourceEntry* findNamed(UInt32 type, const QByteArray& name) const; // case-insensitive, Mac Roman
    const ResourceEntry* indexed(UInt32 type, int oneBasedIndex) const;
    const QList<ResourceEntry>& entries() const { return m_entries; }

    QByteArray serialize() const; // a valid raw fork
    void add(ResourceEntry e);    // replaces the entry with the same type and ID
    ResourceEntry* find(UInt32 type, SInt16 id);
    bool remove(UInt32 type, SInt16 id);

private:
    QList<ResourceEntry> m_entries; // grouped by type, types in file order
};

// "STR#" from a four-character code, and back (for messages and file names).
QString typeToString(UInt32 type);
UInt32 typeFromString(const QString& text);

} // namespace Velmar::Classic
