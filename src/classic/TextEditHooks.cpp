// Classic TextEdit clicks and the hooks programs install: the click loop (called while a click
// is tracked) and the word-break procedure (which words a double click selects). Every call
// into the program is followed by a check that the record is still there: the program may
// dispose of it from its hook.
#include "classic/TextEditPrivate.h"

#include <QDateTime>
#include <QGuiApplication>
#include <QStyleHints>

namespace {

using namespace VelmarClassic;

// Procedure pointers of one declared type to another (classic code stores any procedure in a
// ProcPtr field); through void(*)() so that the compiler takes the cast as meant.
template <typename To, typename From> To procAs(From proc)
{
    return reinterpret_cast<To>(reinterpret_cast<void (*)()>(proc));
}

struct LastClick {
    TEHandle record = nullptr;
    unsigned serial = 0;
    qint64 ms = -1;
    Point where{};
};
LastClick gLastClick;

// Called by the library while it tracks a click: the program's loop sees the record as it is
// now, and may change or dispose of it.
Velmar::Boolean classicClickLoop(Velmar::TEPtr* te)
{
    const TEHandle h = teHandleOf(te);
    if (!h)
        return false;
    TEBlock* b = teBlock(h);
    const auto loop = procAs<TEClickLoopProcPtr>(b->master->clikLoop);
    if (!loop)
        return true;
    const unsigned serial = b->serial;
    tePush(b);
    const bool goOn = loop(b->master) != 0;
    if (!teStillThere(h, serial))
        return false;
    tePull(b);
    return goOn;
}

// Whether two clicks make a double click, by the rule the editor counts its own clicks with.
bool isDoubleClick(TEHandle h, unsigned serial, Point where)
{
    const qint64 now = QDateTime::currentMSecsSinceEpoch();
    const LastClick last = gLastClick;
    gLastClick = {h, serial, now, where};
    const int distance = std::abs(where.h - last.where.h) + std::abs(where.v - last.where.v);
    return last.record == h && last.serial == serial && last.ms >= 0
        && now - last.ms <= QGuiApplication::styleHints()->mouseDoubleClickInterval()
        && distance <= QGuiApplication::styleHints()->startDragDistance();
}

struct Span {
    long start = 0, end = 0;
};

// The run around `at` whose characters the program's procedure classes alike. Empty (and the
// record gone) when the program disposed of it meanwhile.
std::optional<Span> wordAround(
    WordBreakProcPtr breaks, QByteArray& text, long at, TEHandle h, unsigned serial)
{
    const long length = text.size();
    if (length == 0)
        return Span{};
    at = std::clamp<long>(at, 0, length - 1);
    const auto isBreak = [&](long i) -> std::optional<bool> {
        const bool b = breaks(text.data(), short(i)) != 0;
        if (!teStillThere(h, serial))
            return std::nullopt;
        return b;
    };
    const std::optional<bool> kind = isBreak(at);
    if (!kind)
        return std::nullopt;
    Span span{at, at + 1};
    for (;;) {
        if (span.start == 0)
            break;
        const std::optional<bool> k = isBreak(span.start - 1);
        if (!k)
            return std::nullopt;
        if (*k != *kind)
            break;
        --span.start;
    }
    for (;;) {
        if (span.end >= length)
            break;
        const std::optional<bool> k = isBreak(span.end);
        if (!k)
            return std::nullopt;
        if (*k != *kind)
            break;
        ++span.end;
    }
    return span;
}

} // namespace

namespace VelmarClassic {

void teSyncHooks(TEBlock* b)
{
    // The word-break procedure is used by TEClick itself; the click loop by the library.
    Velmar::TESetClickLoop(b->master->clikLoop ? classicClickLoop : nullptr, b->te);
}

void teApplyWordBreak(TEHandle h, short clickOffset)
{
    TEBlock* b = teBlock(h);
    if (!b || !b->master->wordBreak)
        return;
    const unsigned serial = b->serial;
    const auto breaks = procAs<WordBreakProcPtr>(b->master->wordBreak);
    // The program sees the text in a copy: whatever it does to the record, the bytes stay.
    QByteArray text = handleBytes(b->text).left(32767);
    // The word clicked and the one where the mouse was let go, and all between.
    Point up{};
    GetMouse(&up);
    if (!teStillThere(h, serial))
        return;
    const long release = Velmar::TEGetOffset(up, b->te);
    const std::optional<Span> first = wordAround(breaks, text, clickOffset, h, serial);
    if (!first)
        return;
    const std::optional<Span> last = wordAround(breaks, text, release, h, serial);
    if (!last)
        return;
    const long start = std::min(first->start, last->start);
    const long end = std::max(first->end, last->end);
    teEdit(h, [&](Velmar::TEPtr* te) {
        Velmar::TESetSelect(Velmar::SInt32(start), Velmar::SInt32(end), te);
    });
}

} // namespace VelmarClassic

using namespace VelmarClassic;

void TEClick(Point pt, Boolean fExtend, TEHandle h)
{
    flushAllPorts();
    TEBlock* b = teBlock(h);
    if (!b)
        return;
    const unsigned serial = b->serial;
    const bool twice = isDoubleClick(h, serial, pt) && !fExtend;
    teEdit(h, [&](Velmar::TEPtr* te) { Velmar::TEClick(pt, fExtend, te); });
    if (!teStillThere(h, serial))
        return;
    const short offset = Velmar::TEGetOffset(pt, b->te);
    b->master->clickTime = long(TickCount());
    b->master->clickLoc = offset;
    b->shadow.clickTime = b->master->clickTime;
    b->shadow.clickLoc = offset;
    if (twice)
        teApplyWordBreak(h, offset);
}

void TESetClickLoop(TEClickLoopUPP clikProc, TEHandle hTE)
{
    if (TEBlock* b = teBlock(hTE)) {
        b->master->clikLoop = procAs<ProcPtr>(clikProc);
        b->shadow.clikLoop = b->master->clikLoop;
        teSyncHooks(b);
    }
}

void SetClikLoop(ProcPtr clikProc, TEHandle hTE)
{
    TESetClickLoop(procAs<TEClickLoopUPP>(clikProc), hTE);
}

void TESetWordBreak(WordBreakUPP wBrkProc, TEHandle hTE)
{
    if (TEBlock* b = teBlock(hTE)) {
        b->master->wordBreak = procAs<ProcPtr>(wBrkProc);
        b->shadow.wordBreak = b->master->wordBreak;
    }
}

void SetWordBreak(ProcPtr wBrkProc, TEHandle hTE)
{
    TESetWordBreak(procAs<WordBreakUPP>(wBrkProc), hTE);
}
