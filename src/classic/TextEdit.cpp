// Classic TextEdit: a TERec handle per library record, its fields written back after every
// call and the ones programs set directly (rectangles, alignment, text style) handed over
// before the next.
#include "classic/ClassicPrivate.h"

#include <cstdlib>
#include <cstring>

namespace {

using namespace VelmarClassic;

struct TEBlock {
    TERec* master = nullptr; // grows with the line starts
    Velmar::TEPtr* te = nullptr;
    Handle text = nullptr;
    GrafPtr port = nullptr;
    int lineRoom = 0;
    TERec shadow{};
};

std::unordered_map<TEHandle, TEBlock*>& records()
{
    static auto* map = new std::unordered_map<TEHandle, TEBlock*>;
    return *map;
}

bool sameRect(const Rect& a, const Rect& b)
{
    return a.top == b.top && a.left == b.left && a.bottom == b.bottom && a.right == b.right;
}

TEBlock* blockOf(TEHandle h)
{
    if (!VELMAR_ASSERT(h, "hTE != NULL"))
        return nullptr;
    const auto it = records().find(h);
    return VELMAR_ASSERT(it != records().end(), "IsValidTEHandle(hTE)") ? it->second : nullptr;
}

void pull(TEBlock* b)
{
    TERec* r = b->master;
    TERec& s = b->shadow;
    if (!sameRect(r->destRect, s.destRect))
        b->te->setDestRect(r->destRect);
    if (!sameRect(r->viewRect, s.viewRect))
        b->te->setViewRect(r->viewRect);
    if (r->just != s.just)
        b->te->setJust(r->just);
    if (r->crOnly != s.crOnly)
        b->te->setCrOnly(r->crOnly);
    if (r->txFont != s.txFont)
        b->te->setTxFont(r->txFont);
    if (r->txSize != s.txSize)
        b->te->setTxSize(r->txSize);
    if (r->txFace != s.txFace)
        b->te->setTxFace(r->txFace);
}

void push(TEBlock* b)
{
    Velmar::TEPtr* te = b->te;
    const int lines = std::max<int>(0, te->nLines());
    if (lines + 1 > b->lineRoom) {
        const int room = lines + 16;
        auto* grown = static_cast<TERec*>(
            std::realloc(b->master, sizeof(TERec) + sizeof(short) * size_t(room)));
        if (!grown)
            return;
        b->master = grown;
        b->lineRoom = room;
    }
    TERec* r = b->master;
    r->destRect = te->destRect();
    r->viewRect = te->viewRect();
    r->lineHeight = te->lineHeight();
    r->fontAscent = te->fontAscent();
    r->selStart = te->selStart();
    r->selEnd = te->selEnd();
    r->just = te->just();
    r->crOnly = te->crOnly();
    r->txFont = te->txFont();
    r->txSize = te->txSize();
    r->txFace = Style(te->txFace());
    r->teLength = te->teLength();
    r->nLines = short(lines);
    r->inPort = b->port;
    const Velmar::SInt16* starts = te->lineStarts();
    for (int i = 0; i <= lines; ++i)
        r->lineStarts[i] = starts ? starts[i] : 0;
    // The text as the program reads it through hText.
    Velmar::Handle text = Velmar::TEGetText(te);
    const Velmar::Size size = text ? Velmar::TxGetHandleSize(text) : 0;
    SetHandleSize(b->text, size > 0 ? size : 0);
    if (size > 0 && *b->text && *text)
        std::memcpy(*b->text, *text, size_t(size));
    r->hText = b->text;
    b->shadow = *r;
}

// The library call between handing the record's fields over and writing them back.
template <typename Call> void edit(TEHandle h, Call&& call)
{
    TEBlock* b = blockOf(h);
    if (!b)
        return;
    pull(b);
    call(b->te);
    if (records().count(h))
        push(b);
}

TEHandle make(const Rect* destRect, const Rect* viewRect, bool styled)
{
    if (!VELMAR_ASSERT(destRect && viewRect, "destRect && viewRect"))
        return nullptr;
    PortLink* link = currentLink();
    if (!link)
        return nullptr;
    Velmar::TEPtr* te =
        styled ? Velmar::TEStyleNew(destRect, viewRect) : Velmar::TENew(destRect, viewRect);
    if (!te)
        return nullptr;
    auto* b = new TEBlock;
    b->te = te;
    b->port = link->record;
    b->text = NewHandle(0);
    b->master = static_cast<TERec*>(std::calloc(1, sizeof(TERec) + sizeof(short) * 16));
    b->lineRoom = 17;
    const TEHandle h = &b->master;
    records()[h] = b;
    push(b);
    return h;
}

} // namespace

TEHandle TENew(const Rect* destRect, const Rect* viewRect)
{
    return make(destRect, viewRect, false);
}
TEHandle TEStyleNew(const Rect* destRect, const Rect* viewRect)
{
    return make(destRect, viewRect, true);
}

void TEDispose(TEHandle hTE)
{
    TEBlock* b = blockOf(hTE);
    if (!b)
        return;
    records().erase(hTE);
    Velmar::TEDispose(b->te);
    DisposeHandle(b->text);
    std::free(b->master);
    delete b;
}

void TESetText(const void* text, long length, TEHandle hTE)
{
    if (length > 0 && !VELMAR_ASSERT(text, "text != NULL"))
        return;
    edit(hTE, [&](Velmar::TEPtr* te) { Velmar::TESetText(text, Velmar::SInt32(length), te); });
}

Handle TEGetText(TEHandle hTE)
{
    TEBlock* b = blockOf(hTE);
    if (!b)
        return nullptr;
    push(b);
    return b->text;
}

void TEIdle(TEHandle hTE)
{
    edit(hTE, [](Velmar::TEPtr* te) { Velmar::TEIdle(te); });
}

void TEClick(Point pt, Boolean fExtend, TEHandle h)
{
    flushAllPorts();
    edit(h, [&](Velmar::TEPtr* te) { Velmar::TEClick(pt, fExtend, te); });
}

void TESetSelect(long selStart, long selEnd, TEHandle hTE)
{
    edit(hTE, [&](Velmar::TEPtr* te) {
        Velmar::TESetSelect(Velmar::SInt32(selStart), Velmar::SInt32(selEnd), te);
    });
}

void TEActivate(TEHandle hTE)
{
    edit(hTE, [](Velmar::TEPtr* te) { Velmar::TEActivate(te); });
}
void TEDeactivate(TEHandle hTE)
{
    edit(hTE, [](Velmar::TEPtr* te) { Velmar::TEDeactivate(te); });
}

void TEKey(CharParameter key, TEHandle hTE)
{
    edit(hTE, [&](Velmar::TEPtr* te) { Velmar::TEKey(char(key), te, lastLibraryEvent()); });
}

void TECut(TEHandle hTE)
{
    edit(hTE, [](Velmar::TEPtr* te) { Velmar::TECut(te); });
}
void TECopy(TEHandle hTE)
{
    edit(hTE, [](Velmar::TEPtr* te) { Velmar::TECopy(te); });
}
void TEPaste(TEHandle hTE)
{
    edit(hTE, [](Velmar::TEPtr* te) { Velmar::TEPaste(te); });
}
void TEDelete(TEHandle hTE)
{
    edit(hTE, [](Velmar::TEPtr* te) { Velmar::TEDelete(te); });
}

void TEInsert(const void* text, long length, TEHandle hTE)
{
    if (length > 0 && !VELMAR_ASSERT(text, "text != NULL"))
        return;
    edit(hTE, [&](Velmar::TEPtr* te) { Velmar::TEInsert(text, Velmar::SInt32(length), te); });
}

void TESetAlignment(short just, TEHandle hTE)
{
    edit(hTE, [&](Velmar::TEPtr* te) { Velmar::TESetAlignment(just, te); });
}

void TEUpdate(const Rect* rUpdate, TEHandle hTE)
{
    if (VELMAR_ASSERT(rUpdate, "rUpdate != NULL"))
        edit(hTE, [&](Velmar::TEPtr* te) { Velmar::TEUpdate(rUpdate, te); });
}

void TETextBox(const void* text, long length, const Rect* box, short just)
{
    if (!VELMAR_ASSERT(box, "box != NULL") || (length > 0 && !VELMAR_ASSERT(text, "text != NULL")))
        return;
    drawInPort([&] { Velmar::TETextBox(text, Velmar::SInt32(length), box, just); });
}

void TEScroll(short dh, short dv, TEHandle hTE)
{
    edit(hTE, [&](Velmar::TEPtr* te) { Velmar::TEScroll(dh, dv, te); });
}

void TESelView(TEHandle hTE)
{
    edit(hTE, [](Velmar::TEPtr* te) { Velmar::TESelView(te); });
}

void TEAutoView(Boolean fAuto, TEHandle hTE)
{
    edit(hTE, [&](Velmar::TEPtr* te) { Velmar::TEAutoView(fAuto, te); });
}

void TECalText(TEHandle hTE)
{
    edit(hTE, [](Velmar::TEPtr* te) { Velmar::TECalText(te); });
}

short TEGetOffset(Point pt, TEHandle hTE)
{
    short offset = 0;
    edit(hTE, [&](Velmar::TEPtr* te) { offset = Velmar::TEGetOffset(pt, te); });
    return offset;
}
