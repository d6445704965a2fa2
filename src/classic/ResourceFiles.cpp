// The Resource Manager over classic resource files: the program's own file (opened at start),
// the files it opens, the current file and the search down the chain, and one handle per
// resource holding its raw bytes.
#include "classic/ClassicPrivate.h"

#include "classic/ResourceState.h"

#include <QCoreApplication>
#include <QDir>
#include <QFileInfo>

#include <algorithm>
#include <cstdlib>
#include <cstring>
#include <map>
#include <tuple>

namespace VelmarClassic {

using Velmar::Classic::ResourceEntry;
using Velmar::Classic::ResourceFork;

State& resourceState()
{
    static auto* s = new State;
    return *s;
}

int resourceFileIndex(short refNum)
{
    const auto& files = resourceState().files;
    for (size_t i = 0; i < files.size(); ++i)
        if (files[i].refNum == refNum)
            return int(i);
    return -1;
}

namespace {

State& state()
{
    return resourceState();
}

int indexOf(short refNum)
{
    return resourceFileIndex(refNum);
}

// The files a search sees: the current one and those opened before it, newest first.
std::vector<OpenFile*> chain(bool onlyCurrent)
{
    std::vector<OpenFile*> result;
    const int current = indexOf(state().current);
    for (int i = current; i >= 0; --i) {
        result.push_back(&state().files[size_t(i)]);
        if (onlyCurrent)
            break;
    }
    return result;
}

Handle handleFor(OpenFile& file, const ResourceEntry& entry)
{
    State& s = state();
    const auto key = std::make_tuple(file.refNum, ResType(entry.type), entry.id);
    const auto it = s.byKey.find(key);
    if (it != s.byKey.end())
        return it->second;
    // With SetResLoad(false) the handle is made empty: LoadResource reads it.
    const Handle h = s.load ? newHandleFrom(entry.data) : NewEmptyHandle();
    if (!h)
        return nullptr;
    markResourceHandle(h, true);
    s.byKey[key] = h;
    s.loaded[h] = Loaded{file.refNum, ResType(entry.type), entry.id};
    return h;
}

template <typename Find> Handle search(bool onlyCurrent, Find&& find)
{
    ensureStarted();
    for (OpenFile* file : chain(onlyCurrent))
        if (const ResourceEntry* entry = find(file->fork)) {
            state().error = noErr;
            return handleFor(*file, *entry);
        }
    state().error = resNotFound;
    return nullptr;
}

const ResourceEntry* entryOf(Handle h, Loaded* where = nullptr)
{
    const auto it = state().loaded.find(h);
    if (it == state().loaded.end()) {
        state().error = resNotFound;
        return nullptr;
    }
    const int i = indexOf(it->second.file);
    if (i < 0)
        return nullptr;
    if (where)
        *where = it->second;
    state().error = noErr;
    return state().files[size_t(i)].fork.find(UInt32(it->second.type), it->second.id);
}

} // namespace

short openResourceFile(const QString& path, bool write)
{
    State& s = state();
    const QString absolute = QFileInfo(path).absoluteFilePath();
    for (const OpenFile& f : s.files)
        if (f.path == absolute) {
            s.current = f.refNum;
            s.error = noErr;
            return f.refNum;
        }
    Velmar::Classic::ForkOrigin origin;
    std::optional<ResourceFork> fork = ResourceFork::load(path, nullptr, &origin);
    if (!fork) {
        // A file that is there but holds no fork is one the Resource Manager cannot read.
        s.error = QFileInfo::exists(path) ? mapReadErr : fnfErr;
        return -1;
    }
    OpenFile file;
    file.refNum = s.nextRef++;
    file.fork = std::move(*fork);
    file.path = absolute;
    file.forkPath = QFileInfo(origin.path).absoluteFilePath();
    // Only a file that is the raw fork itself is written back: a container's other data (and
    // a companion file's) would be lost.
    file.writable = write && origin.raw && QFileInfo(file.forkPath).isWritable();
    s.files.push_back(std::move(file));
    s.current = s.files.back().refNum;
    s.error = noErr;
    return s.current;
}

void openProgramResources()
{
    State& s = state();
    QString path = s.programFile;
    if (path.isEmpty())
        path = QString::fromLocal8Bit(qgetenv("VELMAR_CLASSIC_RESOURCES"));
    if (path.isEmpty())
        path = QCoreApplication::applicationFilePath(); // load() tries "x.rsrc" and "._x" too
    if (!path.isEmpty())
        openResourceFile(path, true);
    s.error = noErr;
}

std::optional<QByteArray> resourceBytes(ResType type, short id)
{
    ensureStarted();
    for (OpenFile* file : chain(false))
        if (const ResourceEntry* entry = file->fork.find(UInt32(type), id)) {
            state().error = noErr;
            return entry->data;
        }
    state().error = resNotFound;
    return std::nullopt;
}

void forgetResourceHandle(Handle h)
{
    State& s = state();
    const auto it = s.loaded.find(h);
    if (it == s.loaded.end())
        return;
    // A changed resource keeps the handle's bytes for the next write: releasing, detaching or
    // disposing of its handle first loses nothing.
    const int i = indexOf(it->second.file);
    ResourceEntry* entry =
        i < 0 ? nullptr : s.files[size_t(i)].fork.find(UInt32(it->second.type), it->second.id);
    if (entry && (entry->attributes & Velmar::Classic::kResChanged) && *h)
        entry->data = handleBytes(h);
    s.byKey.erase(std::make_tuple(it->second.file, it->second.type, it->second.id));
    s.loaded.erase(it);
    markResourceHandle(h, false);
}

QByteArray toQByteArray(ConstStr255Param s)
{
    return s ? QByteArray(reinterpret_cast<const char*>(s + 1), s[0]) : QByteArray();
}

void copyToStr255(const QByteArray& bytes, unsigned char* out)
{
    const int n = int(std::min<qsizetype>(bytes.size(), 255));
    out[0] = (unsigned char)n;
    std::memcpy(out + 1, bytes.constData(), size_t(n));
}

} // namespace VelmarClassic

using namespace VelmarClassic;

void VelmarClassicSetResourceFile(const char* path)
{
    state().programFile = path ? QString::fromLocal8Bit(path) : QString();
}

QString VelmarClassic::resourceFilePath(ConstStr255Param fileName)
{
    const QString name =
        QString::fromLatin1(toQByteArray(fileName)).replace(QLatin1Char(':'), QLatin1Char('/'));
    // A name without a folder is looked for where the program is run, then beside the program.
    if (!QFileInfo::exists(name) && QFileInfo(name).isRelative()) {
        const QString beside = QDir(QCoreApplication::applicationDirPath()).filePath(name);
        if (QFileInfo::exists(beside) || QFileInfo::exists(beside + QStringLiteral(".rsrc")))
            return beside;
    }
    return name;
}

short OpenRFPerm(ConstStr255Param fileName, short, SignedByte permission)
{
    ensureStarted();
    if (!VELMAR_ASSERT(fileName, "fileName != NULL"))
        return -1;
    if (fileName[0] == 0) {
        state().error = fnfErr;
        return -1;
    }
    return openResourceFile(resourceFilePath(fileName), permission != fsRdPerm);
}

short OpenResFile(ConstStr255Param fileName)
{
    return OpenRFPerm(fileName, 0, fsCurPerm);
}

short HOpenResFile(short vRefNum, long, ConstStr255Param fileName, SignedByte permission)
{
    return OpenRFPerm(fileName, vRefNum, permission);
}

void CloseResFile(short refNum)
{
    State& s = state();
    const int i = indexOf(refNum);
    if (i < 0) {
        s.error = resFNotFound;
        return;
    }
    // Changes are written first; a file that cannot be written is closed all the same (the
    // program was told by ResError), as the classic Resource Manager did.
    OSErr written = noErr;
    if (s.files[size_t(i)].mapChanged)
        written = writeResourceFile(s.files[size_t(i)]);
    // Its resources go with it; if their changes could not be written, the program keeps
    // them as plain handles rather than losing them.
    std::vector<Handle> gone;
    for (const auto& [h, where] : s.loaded)
        if (where.file == refNum)
            gone.push_back(h);
    for (Handle h : gone) {
        if (written == noErr)
            DisposeHandle(h);
        else
            forgetResourceHandle(h);
    }
    s.files.erase(s.files.begin() + i);
    if (s.current == refNum)
        s.current =
            i > 0 ? s.files[size_t(i - 1)].refNum : (s.files.empty() ? 0 : s.files.back().refNum);
    s.error = written;
}

void UseResFile(short refNum)
{
    State& s = state();
    if (indexOf(refNum) < 0) {
        s.error = resFNotFound;
        return;
    }
    s.current = refNum;
    s.error = noErr;
}

short CurResFile()
{
    ensureStarted();
    return state().current;
}

short HomeResFile(Handle theResource)
{
    const auto it = state().loaded.find(theResource);
    if (it == state().loaded.end()) {
        state().error = resNotFound;
        return -1;
    }
    state().error = noErr;
    return it->second.file;
}

OSErr ResError()
{
    return state().error;
}

void SetResLoad(Boolean load)
{
    state().load = load;
}

Handle GetResource(ResType theType, short theID)
{
    return search(false, [&](const ResourceFork& f) { return f.find(UInt32(theType), theID); });
}

Handle Get1Resource(ResType theType, short theID)
{
    return search(true, [&](const ResourceFork& f) { return f.find(UInt32(theType), theID); });
}

Handle GetNamedResource(ResType theType, ConstStr255Param name)
{
    const QByteArray n = toQByteArray(name);
    return search(false, [&](const ResourceFork& f) { return f.findNamed(UInt32(theType), n); });
}

Handle Get1NamedResource(ResType theType, ConstStr255Param name)
{
    const QByteArray n = toQByteArray(name);
    return search(true, [&](const ResourceFork& f) { return f.findNamed(UInt32(theType), n); });
}

namespace {
Handle indexed(ResType type, short index, bool onlyCurrent)
{
    int remaining = index;
    return search(onlyCurrent, [&](const ResourceFork& f) -> const ResourceEntry* {
        const int n = f.count(UInt32(type));
        if (remaining >= 1 && remaining <= n)
            return f.indexed(UInt32(type), remaining);
        remaining -= n;
        return nullptr;
    });
}
short counted(ResType type, bool onlyCurrent)
{
    ensureStarted();
    int n = 0;
    for (OpenFile* file : chain(onlyCurrent))
        n += file->fork.count(UInt32(type));
    state().error = noErr;
    return short(std::min(n, 32767));
}
QList<UInt32> allTypes()
{
    ensureStarted();
    QList<UInt32> types;
    for (OpenFile* file : chain(false))
        for (UInt32 t : file->fork.types())
            if (!types.contains(t))
                types.append(t);
    return types;
}
} // namespace

Handle GetIndResource(ResType theType, short index)
{
    return indexed(theType, index, false);
}
Handle Get1IndResource(ResType theType, short index)
{
    return indexed(theType, index, true);
}
short CountResources(ResType theType)
{
    return counted(theType, false);
}
short Count1Resources(ResType theType)
{
    return counted(theType, true);
}
short CountTypes()
{
    return short(allTypes().size());
}

void GetIndType(ResType* theType, short index)
{
    if (!VELMAR_ASSERT(theType, "theType != NULL"))
        return;
    const QList<UInt32> types = allTypes();
    *theType = (index >= 1 && index <= types.size()) ? ResType(types[index - 1]) : 0;
}

void GetResInfo(Handle theResource, short* theID, ResType* theType, Str255 name)
{
    Loaded where;
    const ResourceEntry* entry = entryOf(theResource, &where);
    if (!entry)
        return;
    if (theID)
        *theID = where.id;
    if (theType)
        *theType = where.type;
    if (name)
        copyToStr255(entry->name, name);
}

short GetResAttrs(Handle theResource)
{
    const ResourceEntry* entry = entryOf(theResource);
    return entry ? short(entry->attributes) : 0;
}

long SizeResource(Handle theResource)
{
    const ResourceEntry* entry = entryOf(theResource);
    return entry ? long(entry->data.size()) : -1;
}

long GetMaxResourceSize(Handle theResource)
{
    return SizeResource(theResource);
}

void LoadResource(Handle theResource)
{
    // Resources are read when their handle is made, unless SetResLoad(false) said not to.
    const ResourceEntry* entry = entryOf(theResource);
    if (!entry || *theResource)
        return;
    ReallocateHandle(theResource, Size(entry->data.size()));
    if (*theResource && !entry->data.isEmpty())
        std::memcpy(*theResource, entry->data.constData(), size_t(entry->data.size()));
}

void ReleaseResource(Handle theResource)
{
    if (!theResource || state().loaded.count(theResource) == 0) {
        state().error = resNotFound;
        return;
    }
    DisposeHandle(theResource);
    state().error = noErr;
}

void DetachResource(Handle theResource)
{
    if (!theResource || state().loaded.count(theResource) == 0) {
        state().error = resNotFound;
        return;
    }
    forgetResourceHandle(theResource);
    state().error = noErr;
}
