// Writing classic resource files: new files, resources added, changed, renamed and removed in
// the current file, and the file written back whole into a temporary file renamed over the
// old one, so that a failed write leaves the old file as it was.
#include "classic/ResourceState.h"

#include <QFileInfo>
#include <QSaveFile>

#include <cstring>

namespace VelmarClassic {

using Velmar::Classic::kResChanged;
using Velmar::Classic::kResProtected;
using Velmar::Classic::ResourceEntry;
using Velmar::Classic::ResourceFork;

OSErr writeResourceFile(OpenFile& file)
{
    State& s = resourceState();
    // A file the program may not write stays as it is (QSaveFile would replace it all the same).
    const QFileInfo info(file.forkPath);
    if (!file.writable || (info.exists() && !info.isWritable()))
        return wrPermErr;
    // The bytes of each changed resource come from its handle, as the program left them.
    ResourceFork fork = file.fork;
    for (const ResourceEntry& entry : file.fork.entries()) {
        if (!(entry.attributes & kResChanged))
            continue;
        ResourceEntry* copy = fork.find(entry.type, entry.id);
        const auto it = s.byKey.find(std::make_tuple(file.refNum, ResType(entry.type), entry.id));
        if (it != s.byKey.end() && *it->second) // an unloaded handle keeps the file's bytes
            copy->data = handleBytes(it->second);
        copy->attributes = UInt8(copy->attributes & ~kResChanged);
    }
    QSaveFile out(file.forkPath);
    if (!out.open(QIODevice::WriteOnly))
        return QFileInfo::exists(file.forkPath) ? wrPermErr : ioErr;
    const QByteArray bytes = fork.serialize();
    if (out.write(bytes) != bytes.size() || !out.commit())
        return ioErr;
    file.fork = std::move(fork);
    file.mapChanged = false;
    return noErr;
}

} // namespace VelmarClassic

using namespace VelmarClassic;

namespace {

State& state()
{
    return resourceState();
}

// The file and entry behind a resource handle; null with ResError `failure` for a handle that
// is no resource (or whose file is gone).
struct Found {
    OpenFile* file = nullptr;
    ResourceEntry* entry = nullptr;
    Loaded where;
};
Found resourceOf(Handle h, OSErr failure)
{
    State& s = state();
    const auto it = h ? s.loaded.find(h) : s.loaded.end();
    const int i = it == s.loaded.end() ? -1 : resourceFileIndex(it->second.file);
    ResourceEntry* entry =
        i < 0 ? nullptr : s.files[size_t(i)].fork.find(UInt32(it->second.type), it->second.id);
    if (!entry) {
        s.error = failure;
        return {};
    }
    return {&s.files[size_t(i)], entry, it->second};
}

// A change to a file: refused (wrPermErr) for one that is not written back.
bool mayChange(OpenFile* file)
{
    if (!file->writable) {
        state().error = wrPermErr;
        return false;
    }
    file->mapChanged = true;
    state().error = noErr;
    return true;
}

OpenFile* currentFile()
{
    const int i = resourceFileIndex(state().current);
    return i < 0 ? nullptr : &state().files[size_t(i)];
}

short uniqueID(ResType type, bool onlyCurrent)
{
    ensureStarted();
    // The classic Resource Manager answered a random free ID; the lowest free one from 128 up
    // (below are the system's) is as good and repeatable.
    for (int id = 128; id <= 32767; ++id) {
        bool used = false;
        const int current = resourceFileIndex(state().current);
        for (int i = current; i >= 0 && !used; --i) {
            used = state().files[size_t(i)].fork.find(UInt32(type), short(id)) != nullptr;
            if (onlyCurrent)
                break;
        }
        if (!used)
            return short(id);
    }
    return 0;
}

} // namespace

void CreateResFile(ConstStr255Param fileName)
{
    ensureStarted();
    State& s = state();
    if (!VELMAR_ASSERT(fileName, "fileName != NULL"))
        return;
    if (fileName[0] == 0) {
        s.error = paramErr;
        return;
    }
    QString path = QString::fromLatin1(toQByteArray(fileName)).replace(u':', u'/');
    // A file that already has a fork is left alone; a file of other data keeps its data and
    // gets its fork beside it ("name.rsrc", which OpenResFile finds).
    if (ResourceFork::load(path)) {
        s.error = dupFNErr;
        return;
    }
    if (QFileInfo::exists(path))
        path += QStringLiteral(".rsrc");
    if (QFileInfo::exists(path)) {
        s.error = dupFNErr;
        return;
    }
    QSaveFile out(path);
    const QByteArray empty = ResourceFork().serialize();
    const bool ok =
        out.open(QIODevice::WriteOnly) && out.write(empty) == empty.size() && out.commit();
    s.error =
        ok ? noErr : (QFileInfo(QFileInfo(path).absolutePath()).isDir() ? wrPermErr : dirNFErr);
}

void HCreateResFile(short, long, ConstStr255Param fileName)
{
    CreateResFile(fileName);
}

void AddResource(Handle theData, ResType theType, short theID, ConstStr255Param name)
{
    State& s = state();
    OpenFile* file = currentFile();
    // The data must be a handle of the program's that is no resource yet.
    if (!file || !theData || !isLiveHandle(theData) || s.loaded.count(theData)) {
        s.error = addResFailed;
        return;
    }
    if (!file->writable) {
        s.error = addResFailed;
        return;
    }
    // A resource of the same type and ID in this file is replaced; its old handle is no
    // resource any more.
    const auto key = std::make_tuple(file->refNum, theType, theID);
    if (const auto old = s.byKey.find(key); old != s.byKey.end())
        forgetResourceHandle(old->second);
    ResourceEntry entry;
    entry.type = UInt32(theType);
    entry.id = theID;
    entry.attributes = kResChanged;
    entry.name = toQByteArray(name);
    entry.data = handleBytes(theData);
    file->fork.add(std::move(entry));
    markResourceHandle(theData, true);
    s.byKey[key] = theData;
    s.loaded[theData] = Loaded{file->refNum, theType, theID};
    file->mapChanged = true;
    s.error = noErr;
}

void ChangedResource(Handle theResource)
{
    const Found found = resourceOf(theResource, resNotFound);
    if (!found.entry)
        return;
    if (found.entry->attributes & kResProtected) {
        state().error = resAttrErr;
        return;
    }
    if (mayChange(found.file))
        found.entry->attributes = UInt8(found.entry->attributes | kResChanged);
}

void WriteResource(Handle theResource)
{
    const Found found = resourceOf(theResource, resNotFound);
    if (!found.entry)
        return;
    if (!(found.entry->attributes & kResChanged)) {
        state().error = noErr;
        return;
    }
    state().error = writeResourceFile(*found.file);
}

void UpdateResFile(short refNum)
{
    const int i = resourceFileIndex(refNum);
    if (i < 0) {
        state().error = resFNotFound;
        return;
    }
    OpenFile& file = state().files[size_t(i)];
    state().error = file.mapChanged ? writeResourceFile(file) : OSErr(noErr);
}

void RemoveResource(Handle theResource)
{
    const Found found = resourceOf(theResource, rmvResFailed);
    if (!found.entry)
        return;
    if ((found.entry->attributes & kResProtected) || !found.file->writable) {
        state().error = rmvResFailed;
        return;
    }
    // The handle stays the program's, as a plain handle.
    found.file->fork.remove(UInt32(found.where.type), found.where.id);
    forgetResourceHandle(theResource);
    found.file->mapChanged = true;
    state().error = noErr;
}

void SetResInfo(Handle theResource, short theID, ConstStr255Param name)
{
    State& s = state();
    const Found found = resourceOf(theResource, resNotFound);
    if (!found.entry)
        return;
    if (found.entry->attributes & kResProtected) {
        s.error = resAttrErr;
        return;
    }
    OpenFile* file = found.file;
    const auto newKey = std::make_tuple(file->refNum, found.where.type, theID);
    if (theID != found.where.id && file->fork.find(UInt32(found.where.type), theID)) {
        s.error = addResFailed; // the ID is taken in this file
        return;
    }
    if (!mayChange(file))
        return;
    ResourceEntry entry = *found.entry;
    file->fork.remove(entry.type, entry.id);
    entry.id = theID;
    if (name)
        entry.name = toQByteArray(name);
    file->fork.add(std::move(entry));
    s.byKey.erase(std::make_tuple(file->refNum, found.where.type, found.where.id));
    s.byKey[newKey] = theResource;
    s.loaded[theResource].id = theID;
}

void SetResAttrs(Handle theResource, short attrs)
{
    const Found found = resourceOf(theResource, resNotFound);
    if (!found.entry || !mayChange(found.file))
        return;
    // The changed bit is the Resource Manager's own: it stays as it was.
    found.entry->attributes =
        UInt8((attrs & ~kResChanged & 0xff) | (found.entry->attributes & kResChanged));
}

void SetResPurge(Boolean)
{
    // Nothing is purged, so nothing needs writing first.
}

short UniqueID(ResType theType)
{
    return uniqueID(theType, false);
}

short Unique1ID(ResType theType)
{
    return uniqueID(theType, true);
}
