// What the classic Resource Manager's files share: the open resource files (each a fork held
// in memory, where it came from and whether it may be written), the current file, and which
// handle is which resource.
#pragma once

#include "classic/ClassicPrivate.h"
#include "classic/resfile/ResourceFork.h"

#include <map>
#include <tuple>

namespace VelmarClassic {

struct OpenFile {
    short refNum = 0;
    Velmar::Classic::ResourceFork fork;
    QString path; // the name it was opened by (absolute)
    QString forkPath; // the file the fork is in
    bool writable = false; // a raw fork opened for writing
    bool mapChanged = false;
};

struct Loaded {
    short file = 0;
    ResType type = 0;
    short id = 0;
};

struct State {
    std::vector<OpenFile> files; // in opening order: the search goes from the current down
    short current = 0;
    short nextRef = 1;
    OSErr error = noErr;
    bool load = true;
    QString programFile;
    std::unordered_map<Handle, Loaded> loaded;
    std::map<std::tuple<short, ResType, short>, Handle> byKey;
};

State& resourceState();
// The file a classic name means: colons become slashes; a name without a folder is looked for
// in the working folder, then beside the program.
QString resourceFilePath(ConstStr255Param fileName);
int resourceFileIndex(short refNum);
// Opens (or finds open) the file at `path`; read-only unless `write` and the fork is a raw
// fork file that can be replaced. -1 and ResError when there is no fork.
short openResourceFile(const QString& path, bool write);
// The changed resources of the file written into its fork and the fork onto disk (a new file
// renamed over the old one). noErr, or why not; nothing is lost on failure.
OSErr writeResourceFile(OpenFile& file);

} // namespace VelmarClassic
