// Classic regions: a handle to a record with rgnSize and rgnBBox and, for any shape but a
// rectangle, the classic scan-line data after them, kept in step with the library region
// behind it after every call that changes it.
#include "classic/ClassicPrivate.h"

#include <algorithm>
#include <cstdlib>
#include <cstring>

namespace VelmarClassic {

namespace {

struct RegionBlock {
    Region* master = nullptr; // the record, then the scan lines (malloc'd)
    Velmar::RgnHandle region = nullptr;
};

constexpr short kEndMark = 0x7fff;
constexpr size_t kHeaderBytes = 10;

// The classic scan-line data: for each line where the region's extent changes, its v, the h
// of every point where the change begins or ends (in order), and the end mark; then the end
// mark. A point is where membership differs between this line and the one above it: the
// edges of the two lines' spans that do not cancel.
std::vector<short> scanLines(const QRegion& region)
{
    struct Band {
        int top, bottom;
        std::vector<int> edges;
    };
    std::vector<Band> bands;
    for (const QRect& r : region) { // Qt gives the rectangles in bands, top to bottom
        if (bands.empty() || bands.back().top != r.top())
            bands.push_back({r.top(), r.bottom() + 1, {}});
        bands.back().edges.push_back(r.left());
        bands.back().edges.push_back(r.right() + 1);
    }
    std::vector<short> out;
    std::vector<int> above;
    const auto line = [&](int v, const std::vector<int>& now) {
        std::vector<int> all = above;
        all.insert(all.end(), now.begin(), now.end());
        std::sort(all.begin(), all.end());
        std::vector<int> points;
        for (size_t i = 0; i < all.size();) {
            size_t j = i;
            while (j < all.size() && all[j] == all[i])
                ++j;
            if ((j - i) % 2)
                points.push_back(all[i]);
            i = j;
        }
        if (!points.empty()) {
            out.push_back(short(v));
            for (int h : points)
                out.push_back(short(h));
            out.push_back(kEndMark);
        }
        above = now;
    };
    for (size_t i = 0; i < bands.size(); ++i) {
        line(bands[i].top, bands[i].edges);
        // A gap below the band (or the end) brings the line back to nothing.
        if (i + 1 == bands.size() || bands[i + 1].top != bands[i].bottom)
            line(bands[i].bottom, {});
    }
    out.push_back(kEndMark);
    return out;
}

std::unordered_map<::RgnHandle, RegionBlock*>& regions()
{
    static auto* map = new std::unordered_map<::RgnHandle, RegionBlock*>;
    return *map;
}

} // namespace

::RgnHandle newClassicRegion()
{
    auto* block = new RegionBlock;
    block->master = static_cast<Region*>(std::calloc(1, sizeof(Region)));
    block->region = Velmar::NewRgn();
    block->master->rgnSize = 10;
    const ::RgnHandle h = &block->master;
    regions()[h] = block;
    return h;
}

Velmar::RgnHandle libraryRegion(::RgnHandle rgn, const char*)
{
    if (!VELMAR_ASSERT(rgn, "rgn != NULL"))
        return nullptr;
    const auto it = regions().find(rgn);
    if (!VELMAR_ASSERT(it != regions().end(), "IsValidRgnHandle(rgn)"))
        return nullptr;
    return it->second->region;
}

void syncRegion(::RgnHandle rgn)
{
    const auto it = regions().find(rgn);
    if (it == regions().end())
        return;
    RegionBlock* block = it->second;
    const QRect b = block->region->boundingRect();
    Rect box{0, 0, 0, 0};
    if (!b.isEmpty())
        box = Rect{short(b.top()), short(b.left()), short(b.bottom() + 1), short(b.right() + 1)};
    // A rectangle is the bare record; other shapes carry their scan lines after it (all of
    // them, though rgnSize says at most 32766).
    std::vector<short> lines;
    if (block->region->rectCount() > 1)
        lines = scanLines(*block->region);
    const size_t bytes = std::max(sizeof(Region), kHeaderBytes + lines.size() * sizeof(short));
    auto* grown = static_cast<Region*>(std::realloc(block->master, bytes));
    if (!grown)
        return;
    block->master = grown;
    grown->rgnBBox = box;
    grown->rgnSize = (unsigned short)(lines.empty()
            ? 10
            : std::min<size_t>(32766, kHeaderBytes + lines.size() * sizeof(short)));
    if (!lines.empty())
        std::memcpy(reinterpret_cast<char*>(grown) + kHeaderBytes, lines.data(),
            lines.size() * sizeof(short));
}

void setRegion(::RgnHandle rgn, const QRegion& region)
{
    const auto it = regions().find(rgn);
    if (it == regions().end())
        return;
    *it->second->region = region;
    syncRegion(rgn);
}

} // namespace VelmarClassic

using namespace VelmarClassic;

namespace {

// The library call on the regions, then the records of those it changed.
template <typename Call> void changeRegion(::RgnHandle rgn, const char* call, Call&& change)
{
    if (Velmar::RgnHandle r = libraryRegion(rgn, call)) {
        change(r);
        syncRegion(rgn);
    }
}

template <typename Call> void drawRegion(::RgnHandle rgn, const char* call, Call&& draw)
{
    if (Velmar::RgnHandle r = libraryRegion(rgn, call))
        drawInPort([&] { draw(r); });
}

} // namespace

RgnHandle NewRgn()
{
    return newClassicRegion();
}

void DisposeRgn(RgnHandle rgn)
{
    if (!rgn)
        return;
    const auto it = regions().find(rgn);
    if (!VELMAR_ASSERT(it != regions().end(), "IsValidRgnHandle(rgn)"))
        return;
    Velmar::DisposeRgn(it->second->region);
    std::free(it->second->master);
    delete it->second;
    regions().erase(it);
}

void CopyRgn(RgnHandle src, RgnHandle dst)
{
    if (Velmar::RgnHandle s = libraryRegion(src, "CopyRgn"))
        changeRegion(dst, "CopyRgn", [&](Velmar::RgnHandle d) { Velmar::CopyRgn(s, d); });
}

void SetEmptyRgn(RgnHandle rgn)
{
    changeRegion(rgn, "SetEmptyRgn", [](Velmar::RgnHandle r) { Velmar::SetEmptyRgn(r); });
}

void SetRectRgn(RgnHandle rgn, short left, short top, short right, short bottom)
{
    changeRegion(rgn, "SetRectRgn",
        [&](Velmar::RgnHandle r) { Velmar::SetRectRgn(r, left, top, right, bottom); });
}

void RectRgn(RgnHandle rgn, const Rect* r)
{
    if (VELMAR_ASSERT(r, "r != NULL"))
        changeRegion(rgn, "RectRgn", [&](Velmar::RgnHandle d) { Velmar::RectRgn(d, r); });
}

void OpenRgn()
{
    drawInPort([] { Velmar::OpenRgn(); });
}

void CloseRgn(RgnHandle dst)
{
    changeRegion(dst, "CloseRgn", [](Velmar::RgnHandle d) { Velmar::CloseRgn(d); });
}

void OffsetRgn(RgnHandle rgn, short dh, short dv)
{
    changeRegion(rgn, "OffsetRgn", [&](Velmar::RgnHandle r) { Velmar::OffsetRgn(r, dh, dv); });
}

void InsetRgn(RgnHandle rgn, short dh, short dv)
{
    changeRegion(rgn, "InsetRgn", [&](Velmar::RgnHandle r) { Velmar::InsetRgn(r, dh, dv); });
}

namespace {
using RegionOp = void (*)(Velmar::RgnHandle, Velmar::RgnHandle, Velmar::RgnHandle);
void combine(RgnHandle a, RgnHandle b, RgnHandle dst, const char* call, RegionOp op)
{
    Velmar::RgnHandle ra = libraryRegion(a, call);
    Velmar::RgnHandle rb = ra ? libraryRegion(b, call) : nullptr;
    if (rb)
        changeRegion(dst, call, [&](Velmar::RgnHandle d) { op(ra, rb, d); });
}
} // namespace

void SectRgn(RgnHandle a, RgnHandle b, RgnHandle dst)
{
    combine(a, b, dst, "SectRgn", Velmar::SectRgn);
}
void UnionRgn(RgnHandle a, RgnHandle b, RgnHandle dst)
{
    combine(a, b, dst, "UnionRgn", Velmar::UnionRgn);
}
void DiffRgn(RgnHandle a, RgnHandle b, RgnHandle dst)
{
    combine(a, b, dst, "DiffRgn", Velmar::DiffRgn);
}
void XorRgn(RgnHandle a, RgnHandle b, RgnHandle dst)
{
    combine(a, b, dst, "XorRgn", Velmar::XorRgn);
}

Boolean PtInRgn(Point pt, RgnHandle rgn)
{
    Velmar::RgnHandle r = libraryRegion(rgn, "PtInRgn");
    return r ? Velmar::PtInRgn(pt, r) : false;
}

Boolean RectInRgn(const Rect* rect, RgnHandle rgn)
{
    Velmar::RgnHandle r = libraryRegion(rgn, "RectInRgn");
    return r && VELMAR_ASSERT(rect, "r != NULL") ? Velmar::RectInRgn(rect, r) : false;
}

Boolean EqualRgn(RgnHandle a, RgnHandle b)
{
    Velmar::RgnHandle ra = libraryRegion(a, "EqualRgn");
    Velmar::RgnHandle rb = ra ? libraryRegion(b, "EqualRgn") : nullptr;
    return rb ? Velmar::EqualRgn(ra, rb) : false;
}

Boolean EmptyRgn(RgnHandle rgn)
{
    Velmar::RgnHandle r = libraryRegion(rgn, "EmptyRgn");
    return r ? Velmar::EmptyRgn(r) : true;
}

void FrameRgn(RgnHandle rgn)
{
    drawRegion(rgn, "FrameRgn", [](Velmar::RgnHandle r) { Velmar::FrameRgn(r); });
}
void PaintRgn(RgnHandle rgn)
{
    drawRegion(rgn, "PaintRgn", [](Velmar::RgnHandle r) { Velmar::PaintRgn(r); });
}
void EraseRgn(RgnHandle rgn)
{
    drawRegion(rgn, "EraseRgn", [](Velmar::RgnHandle r) { Velmar::EraseRgn(r); });
}
void InvertRgn(RgnHandle rgn)
{
    drawRegion(rgn, "InvertRgn", [](Velmar::RgnHandle r) { Velmar::InvertRgn(r); });
}

void FillRgn(RgnHandle rgn, const Pattern* pat)
{
    if (!VELMAR_ASSERT(pat, "pat != NULL"))
        return;
    const Velmar::Pattern p = libraryPattern(pat);
    drawRegion(rgn, "FillRgn", [&](Velmar::RgnHandle r) { Velmar::FillRgn(r, &p); });
}
