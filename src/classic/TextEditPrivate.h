// What the classic TextEdit files share: the block behind each TEHandle (the record the
// program reads, the library record, the fields as last handed over) and the guarded edit.
#pragma once

#include "classic/ClassicPrivate.h"

namespace VelmarClassic {

struct TEBlock {
    TERec* master = nullptr; // grows with the line starts
    Velmar::TEPtr* te = nullptr;
    Handle text = nullptr;
    GrafPtr port = nullptr;
    int lineRoom = 0;
    unsigned serial = 0; // tells a block from a later one made at the same address
    TERec shadow{};
};

// The block of a live handle, or null after the library's assertion.
TEBlock* teBlock(TEHandle h);
// The handle whose library record is `te`; null if none.
TEHandle teHandleOf(Velmar::TEPtr* te);
// True while `h` is still the record `serial` was read from (the program may dispose of it
// from a hook).
bool teStillThere(TEHandle h, unsigned serial);
// Fields the program set, handed to the library; the library's written back.
void tePull(TEBlock* b);
void tePush(TEBlock* b);

// The library call between handing the record's fields over and writing them back; the
// record is written back only if the call left it alive.
template <typename Call> void teEdit(TEHandle h, Call&& call)
{
    TEBlock* b = teBlock(h);
    if (!b)
        return;
    const unsigned serial = b->serial;
    tePull(b);
    call(b->te);
    if (teStillThere(h, serial))
        tePush(b);
}

// The program's hooks: installed on the library record when the record's fields name them.
void teSyncHooks(TEBlock* b);
// After a click: a double click with a word-break procedure selects by it.
void teApplyWordBreak(TEHandle h, short clickOffset);

} // namespace VelmarClassic
