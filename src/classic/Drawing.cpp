// Lines, shapes and rectangle arithmetic through the classic interface: the record's pen is
// handed to the library before each call and its location written back after.
#include "classic/ClassicPrivate.h"

using namespace VelmarClassic;

namespace {

// One shape drawn four ways and filled with a pattern.
template <typename Call> void shape(const Rect* r, Call&& call)
{
    if (VELMAR_ASSERT(r, "r != NULL"))
        drawInPort([&] { call(); });
}

template <typename Call> void filled(const Rect* r, const Pattern* pat, Call&& call)
{
    if (!VELMAR_ASSERT(r, "r != NULL") || !VELMAR_ASSERT(pat, "pat != NULL"))
        return;
    const Velmar::Pattern p = libraryPattern(pat);
    drawInPort([&] { call(&p); });
}

} // namespace

void MoveTo(short h, short v)
{
    drawInPort([&] { Velmar::MoveTo(h, v); });
}
void Move(short dh, short dv)
{
    drawInPort([&] { Velmar::Move(dh, dv); });
}
void LineTo(short h, short v)
{
    drawInPort([&] { Velmar::LineTo(h, v); });
}
void Line(short dh, short dv)
{
    drawInPort([&] { Velmar::Line(dh, dv); });
}

void FrameRect(const Rect* r)
{
    shape(r, [&] { Velmar::FrameRect(r); });
}
void PaintRect(const Rect* r)
{
    shape(r, [&] { Velmar::PaintRect(r); });
}
void EraseRect(const Rect* r)
{
    shape(r, [&] { Velmar::EraseRect(r); });
}
void InvertRect(const Rect* r)
{
    shape(r, [&] { Velmar::InvertRect(r); });
}
void FillRect(const Rect* r, const Pattern* pat)
{
    filled(r, pat, [&](const Velmar::Pattern* p) { Velmar::FillRect(r, p); });
}

void FrameOval(const Rect* r)
{
    shape(r, [&] { Velmar::FrameOval(r); });
}
void PaintOval(const Rect* r)
{
    shape(r, [&] { Velmar::PaintOval(r); });
}
void EraseOval(const Rect* r)
{
    shape(r, [&] { Velmar::EraseOval(r); });
}
void InvertOval(const Rect* r)
{
    shape(r, [&] { Velmar::InvertOval(r); });
}
void FillOval(const Rect* r, const Pattern* pat)
{
    filled(r, pat, [&](const Velmar::Pattern* p) { Velmar::FillOval(r, p); });
}

void FrameRoundRect(const Rect* r, short w, short h)
{
    shape(r, [&] { Velmar::FrameRoundRect(r, w, h); });
}
void PaintRoundRect(const Rect* r, short w, short h)
{
    shape(r, [&] { Velmar::PaintRoundRect(r, w, h); });
}
void EraseRoundRect(const Rect* r, short w, short h)
{
    shape(r, [&] { Velmar::EraseRoundRect(r, w, h); });
}
void InvertRoundRect(const Rect* r, short w, short h)
{
    shape(r, [&] { Velmar::InvertRoundRect(r, w, h); });
}
void FillRoundRect(const Rect* r, short w, short h, const Pattern* pat)
{
    filled(r, pat, [&](const Velmar::Pattern* p) { Velmar::FillRoundRect(r, w, h, p); });
}

void FrameArc(const Rect* r, short a, short b)
{
    shape(r, [&] { Velmar::FrameArc(r, a, b); });
}
void PaintArc(const Rect* r, short a, short b)
{
    shape(r, [&] { Velmar::PaintArc(r, a, b); });
}
void EraseArc(const Rect* r, short a, short b)
{
    shape(r, [&] { Velmar::EraseArc(r, a, b); });
}
void InvertArc(const Rect* r, short a, short b)
{
    shape(r, [&] { Velmar::InvertArc(r, a, b); });
}
void FillArc(const Rect* r, short a, short b, const Pattern* pat)
{
    filled(r, pat, [&](const Velmar::Pattern* p) { Velmar::FillArc(r, a, b, p); });
}

void ScrollRect(const Rect* r, short dh, short dv, RgnHandle updateRgn)
{
    if (!VELMAR_ASSERT(r, "r != NULL"))
        return;
    Velmar::RgnHandle update = updateRgn ? libraryRegion(updateRgn, "ScrollRect") : nullptr;
    if (updateRgn && !update)
        return;
    drawInPort([&] { Velmar::ScrollRect(r, dh, dv, update); });
    if (updateRgn)
        syncRegion(updateRgn);
}

// ---- Rectangles and points (no port needed) -------------------------------------------------

void SetRect(Rect* r, short left, short top, short right, short bottom)
{
    if (VELMAR_ASSERT(r, "r != NULL"))
        Velmar::SetRect(r, left, top, right, bottom);
}
void OffsetRect(Rect* r, short dh, short dv)
{
    if (VELMAR_ASSERT(r, "r != NULL"))
        Velmar::OffsetRect(r, dh, dv);
}
void InsetRect(Rect* r, short dh, short dv)
{
    if (VELMAR_ASSERT(r, "r != NULL"))
        Velmar::InsetRect(r, dh, dv);
}
Boolean SectRect(const Rect* a, const Rect* b, Rect* dst)
{
    return VELMAR_ASSERT(a && b && dst, "a && b && dst") ? Velmar::SectRect(a, b, dst) : false;
}
void UnionRect(const Rect* a, const Rect* b, Rect* dst)
{
    if (VELMAR_ASSERT(a && b && dst, "a && b && dst"))
        Velmar::UnionRect(a, b, dst);
}
Boolean PtInRect(Point pt, const Rect* r)
{
    return VELMAR_ASSERT(r, "r != NULL") ? Velmar::PtInRect(pt, r) : false;
}
Boolean EqualRect(const Rect* a, const Rect* b)
{
    return VELMAR_ASSERT(a && b, "a && b") ? Velmar::EqualRect(a, b) : false;
}
Boolean EmptyRect(const Rect* r)
{
    return VELMAR_ASSERT(r, "r != NULL") ? Velmar::EmptyRect(r) : true;
}
void Pt2Rect(Point a, Point b, Rect* dst)
{
    if (VELMAR_ASSERT(dst, "dst != NULL"))
        Velmar::Pt2Rect(a, b, dst);
}
void SetPt(Point* pt, short h, short v)
{
    if (VELMAR_ASSERT(pt, "pt != NULL"))
        Velmar::SetPt(pt, h, v);
}
Boolean EqualPt(Point a, Point b)
{
    return Velmar::EqualPt(a, b);
}
void AddPt(Point src, Point* dst)
{
    if (VELMAR_ASSERT(dst, "dst != NULL"))
        Velmar::AddPt(src, dst);
}
void SubPt(Point src, Point* dst)
{
    if (VELMAR_ASSERT(dst, "dst != NULL"))
        Velmar::SubPt(src, dst);
}
