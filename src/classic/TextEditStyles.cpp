// Classic TextEdit styles: style scraps in the 'styl' resource layout (big-endian, 20-byte
// runs) turned into the library's and back, and the style calls of styled records.
#include "classic/TextEditPrivate.h"

#include <Velmar/HostCore.h>

#include <algorithm>
#include <cstdlib>
#include <vector>

namespace {

using namespace VelmarClassic;

constexpr int kRunBytes = 20;

int be16(const QByteArray& b, int at)
{
    return (uchar(b[at]) << 8) | uchar(b[at + 1]);
}
Velmar::SInt32 be32(const QByteArray& b, int at)
{
    return Velmar::SInt32((UInt32(be16(b, at)) << 16) | UInt32(be16(b, at + 2)));
}
void putBe16(QByteArray& b, int v)
{
    b.append(char((v >> 8) & 0xff)).append(char(v & 0xff));
}

// The runs a scrap's bytes hold: as many as the count says and the bytes carry (a truncated
// scrap gives its complete runs; a negative count none).
std::vector<Velmar::ScrpSTElement> runsOf(const QByteArray& bytes)
{
    std::vector<Velmar::ScrpSTElement> runs;
    if (bytes.size() < 2)
        return runs;
    const int count = std::min<qsizetype>(qint16(be16(bytes, 0)), (bytes.size() - 2) / kRunBytes);
    for (int i = 0; i < count; ++i) {
        const int at = 2 + i * kRunBytes;
        Velmar::ScrpSTElement run{};
        run.scrpStartChar = be32(bytes, at);
        run.scrpHeight = Velmar::SInt16(be16(bytes, at + 4));
        run.scrpAscent = Velmar::SInt16(be16(bytes, at + 6));
        run.scrpFont = Velmar::SInt16(be16(bytes, at + 8));
        run.scrpFace = Velmar::Style(uchar(bytes[at + 10]));
        run.scrpSize = Velmar::SInt16(be16(bytes, at + 12));
        run.scrpColor = {Velmar::UInt16(be16(bytes, at + 14)), Velmar::UInt16(be16(bytes, at + 16)),
            Velmar::UInt16(be16(bytes, at + 18))};
        runs.push_back(run);
    }
    // The library takes the runs in text order.
    std::stable_sort(runs.begin(), runs.end(),
        [](const auto& a, const auto& b) { return a.scrpStartChar < b.scrpStartChar; });
    return runs;
}

QByteArray bytesOf(const Velmar::StScrpRec& scrap)
{
    QByteArray out;
    const int count = std::max<int>(0, scrap.scrpNStyles);
    putBe16(out, count);
    for (int i = 0; i < count; ++i) {
        const Velmar::ScrpSTElement& run = scrap.scrpStyleTab[i];
        putBe16(out, int(UInt32(run.scrpStartChar) >> 16));
        putBe16(out, int(run.scrpStartChar & 0xffff));
        putBe16(out, run.scrpHeight);
        putBe16(out, run.scrpAscent);
        putBe16(out, run.scrpFont);
        out.append(char(run.scrpFace)).append('\0');
        putBe16(out, run.scrpSize);
        putBe16(out, run.scrpColor.red);
        putBe16(out, run.scrpColor.green);
        putBe16(out, run.scrpColor.blue);
    }
    return out;
}

Velmar::TextStyle libraryStyle(const TextStyle& s)
{
    return {s.tsFont, s.tsFace, 0, s.tsSize, {s.tsColor.red, s.tsColor.green, s.tsColor.blue}};
}

} // namespace

void TEStyleInsert(const void* text, long length, StScrpHandle hST, TEHandle hTE)
{
    if (length > 0 && !VELMAR_ASSERT(text, "text != NULL"))
        return;
    // A scrap that is no handle of ours is refused; a null one inserts in the current style.
    const Handle styles = reinterpret_cast<Handle>(hST);
    if (styles && !VELMAR_ASSERT(isLiveHandle(styles), "IsValidHandle(hST)"))
        return;
    const std::vector<Velmar::ScrpSTElement> runs =
        styles ? runsOf(handleBytes(styles)) : std::vector<Velmar::ScrpSTElement>{};
    const size_t count = runs.size();
    std::vector<char> storage(offsetof(Velmar::StScrpRec, scrpStyleTab)
        + std::max<size_t>(count, 1) * sizeof(Velmar::ScrpSTElement));
    auto* scrap = reinterpret_cast<Velmar::StScrpRec*>(storage.data());
    scrap->scrpNStyles = Velmar::SInt16(count);
    std::copy(runs.begin(), runs.end(), scrap->scrpStyleTab);
    const long clamped = std::clamp<long>(length, 0, 0x7fffffff);
    teEdit(hTE, [&](Velmar::TEPtr* te) {
        Velmar::TEStyleInsert(text, Velmar::SInt32(clamped), &scrap, te);
    });
}

void TEStylePaste(TEHandle hTE)
{
    teEdit(hTE, [](Velmar::TEPtr* te) { Velmar::TEStylePaste(te); });
}

void TESetStyle(short mode, const TextStyle* newStyle, Boolean fRedraw, TEHandle hTE)
{
    if (!VELMAR_ASSERT(newStyle, "newStyle != NULL"))
        return;
    const Velmar::TextStyle style = libraryStyle(*newStyle);
    teEdit(hTE, [&](Velmar::TEPtr* te) { Velmar::TESetStyle(mode, &style, fRedraw, te); });
}

void TEGetStyle(
    short offset, TextStyle* theStyle, short* lineHeight, short* fontAscent, TEHandle hTE)
{
    teEdit(hTE, [&](Velmar::TEPtr* te) {
        Velmar::TextStyle style{};
        Velmar::TEGetStyle(offset, &style, lineHeight, fontAscent, te);
        if (theStyle) {
            *theStyle = TextStyle{};
            theStyle->tsFont = style.tsFont;
            theStyle->tsFace = style.tsFace;
            theStyle->tsSize = style.tsSize;
            theStyle->tsColor = {style.tsColor.red, style.tsColor.green, style.tsColor.blue};
        }
    });
}

StScrpHandle TEGetStyleScrapHandle(TEHandle hTE)
{
    Handle result = nullptr;
    teEdit(hTE, [&](Velmar::TEPtr* te) {
        Velmar::StScrpHandle scrap = Velmar::TEGetStyleScrapHandle(te);
        if (!scrap)
            return;
        result = newHandleFrom(bytesOf(**scrap));
        Velmar::TxDisposeHandle(reinterpret_cast<Velmar::Handle>(scrap));
    });
    return reinterpret_cast<StScrpHandle>(result);
}
