// Classic TextEdit: a TERec handle per library record, its fields written back after every
// call and the ones programs set directly (rectangles, alignment, text style) handed over
// before the next.
#include "classic/TextEditPrivate.h"

#include <algorithm>
#include <cstdlib>
#include <cstring>

namespace VelmarClassic {

namespace {

std::unordered_map<TEHandle, TEBlock*>& records()
{
    static auto* map = new std::unordered_map<TEHandle, TEBlock*>;
    return *map;
}

bool sameRect(const Rect& a, const Rect& b)
{
    return a.top == b.top && a.left == b.left && a.bottom == b.bottom && a.right == b.right;
}

TEHandle make(const Rect* destRect, const Rect* viewRect, bool styled)
{
    if (!VELMAR_ASSERT(destRect && viewRect, "destRect && viewRect"))
        return nullptr;
    PortLink* link = currentLink();
    if (!link)
        return nullptr;
    // The record takes the port's text font and size, including those the program wrote
    // into the port record itself.
    pullPort(*link);
    Velmar::TEPtr* te =
        styled ? Velmar::TEStyleNew(destRect, viewRect) : Velmar::TENew(destRect, viewRect);
    if (!te)
        return nullptr;
    static unsigned serials = 0;
    auto* b = new TEBlock;
    b->te = te;
    b->port = link->record;
    b->serial = ++serials;
    b->text = NewHandle(0);
    b->master = static_cast<TERec*>(std::calloc(1, sizeof(TERec) + sizeof(short) * 16));
    b->lineRoom = 17;
    const TEHandle h = &b->master;
    records()[h] = b;
    tePush(b);
    return h;
}

} // namespace

TEBlock* teBlock(TEHandle h)
{
    if (!VELMAR_ASSERT(h, "hTE != NULL"))
        return nullptr;
    const auto it = records().find(h);
    return VELMAR_ASSERT(it != records().end(), "IsValidTEHandle(hTE)") ? it->second : nullptr;
}

TEHandle teHandleOf(Velmar::TEPtr* te)
{
    for (const auto& [h, b] : records())
        if (b->te == te)
            return h;
    return nullptr;
}

bool teStillThere(TEHandle h, unsigned serial)
{
    const auto it = records().find(h);
    return it != records().end() && it->second->serial == serial;
}

void tePull(TEBlock* b)
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
    if (r->clikLoop != s.clikLoop || r->wordBreak != s.wordBreak)
        teSyncHooks(b);
}

void tePush(TEBlock* b)
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

} // namespace VelmarClassic

using namespace VelmarClassic;

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
    TEBlock* b = teBlock(hTE);
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
    teEdit(hTE, [&](Velmar::TEPtr* te) { Velmar::TESetText(text, Velmar::SInt32(length), te); });
}

Handle TEGetText(TEHandle hTE)
{
    TEBlock* b = teBlock(hTE);
    if (!b)
        return nullptr;
    tePush(b);
    return b->text;
}

void TEIdle(TEHandle hTE)
{
    teEdit(hTE, [](Velmar::TEPtr* te) { Velmar::TEIdle(te); });
}

void TESetSelect(long selStart, long selEnd, TEHandle hTE)
{
    teEdit(hTE, [&](Velmar::TEPtr* te) {
        Velmar::TESetSelect(Velmar::SInt32(selStart), Velmar::SInt32(selEnd), te);
    });
}

void TEActivate(TEHandle hTE)
{
    teEdit(hTE, [](Velmar::TEPtr* te) { Velmar::TEActivate(te); });
}
void TEDeactivate(TEHandle hTE)
{
    teEdit(hTE, [](Velmar::TEPtr* te) { Velmar::TEDeactivate(te); });
}

void TEKey(CharParameter key, TEHandle hTE)
{
    teEdit(hTE, [&](Velmar::TEPtr* te) { Velmar::TEKey(char(key), te, lastLibraryEvent()); });
}

void TECut(TEHandle hTE)
{
    teEdit(hTE, [](Velmar::TEPtr* te) { Velmar::TECut(te); });
}
void TECopy(TEHandle hTE)
{
    teEdit(hTE, [](Velmar::TEPtr* te) { Velmar::TECopy(te); });
}
void TEPaste(TEHandle hTE)
{
    teEdit(hTE, [](Velmar::TEPtr* te) { Velmar::TEPaste(te); });
}
void TEDelete(TEHandle hTE)
{
    teEdit(hTE, [](Velmar::TEPtr* te) { Velmar::TEDelete(te); });
}

void TEInsert(const void* text, long length, TEHandle hTE)
{
    if (length > 0 && !VELMAR_ASSERT(text, "text != NULL"))
        return;
    teEdit(hTE, [&](Velmar::TEPtr* te) { Velmar::TEInsert(text, Velmar::SInt32(length), te); });
}

void TESetAlignment(short just, TEHandle hTE)
{
    teEdit(hTE, [&](Velmar::TEPtr* te) { Velmar::TESetAlignment(just, te); });
}

void TEUpdate(const Rect* rUpdate, TEHandle hTE)
{
    if (VELMAR_ASSERT(rUpdate, "rUpdate != NULL"))
        teEdit(hTE, [&](Velmar::TEPtr* te) { Velmar::TEUpdate(rUpdate, te); });
}

void TETextBox(const void* text, long length, const Rect* box, short just)
{
    if (!VELMAR_ASSERT(box, "box != NULL") || (length > 0 && !VELMAR_ASSERT(text, "text != NULL")))
        return;
    drawInPort([&] { Velmar::TETextBox(text, Velmar::SInt32(length), box, just); });
}

void TEScroll(short dh, short dv, TEHandle hTE)
{
    teEdit(hTE, [&](Velmar::TEPtr* te) { Velmar::TEScroll(dh, dv, te); });
}

void TESelView(TEHandle hTE)
{
    teEdit(hTE, [](Velmar::TEPtr* te) { Velmar::TESelView(te); });
}

void TEAutoView(Boolean fAuto, TEHandle hTE)
{
    teEdit(hTE, [&](Velmar::TEPtr* te) { Velmar::TEAutoView(fAuto, te); });
}

void TECalText(TEHandle hTE)
{
    teEdit(hTE, [](Velmar::TEPtr* te) { Velmar::TECalText(te); });
}

short TEGetOffset(Point pt, TEHandle hTE)
{
    short offset = 0;
    teEdit(hTE, [&](Velmar::TEPtr* te) { offset = Velmar::TEGetOffset(pt, te); });
    return offset;
}

Point TEGetPoint(short offset, TEHandle hTE)
{
    Point pt{};
    teEdit(hTE, [&](Velmar::TEPtr* te) { pt = Velmar::TEGetPoint(offset, te); });
    return pt;
}

long TEGetHeight(long endLine, long startLine, TEHandle hTE)
{
    long height = 0;
    const auto line = [](long n) { return Velmar::SInt32(std::clamp<long>(n, -32768, 32767)); };
    teEdit(hTE, [&](Velmar::TEPtr* te) {
        height = Velmar::TEGetHeight(line(endLine), line(startLine), te);
    });
    return height;
}

void TEPinScroll(short dh, short dv, TEHandle hTE)
{
    teEdit(hTE, [&](Velmar::TEPtr* te) { Velmar::TEPinScroll(dh, dv, te); });
}
