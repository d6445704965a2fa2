// Rectangle utilities. They work on the Toolbox form directly and need no port.
#include <Velmar/QDShapes.h>

#include "foundation/Conversions.h"
#include "quickdraw/ShapeLog.h"

#include <algorithm>

namespace Velmar {

using Private::isEmptyRect;
using Private::makeRect;
using Private::sameRect;
using Private::shapeWarning;
using Private::toQRect;
using Private::toRect;

void SetRect(Rect* r, short left, short top, short right, short bottom)
{
    if (!r) {
        shapeWarning("warning: SetRect: null rectangle");
        return;
    }
    *r = makeRect(left, top, right, bottom);
}

void OffsetRect(Rect* r, short dh, short dv)
{
    if (!r) {
        shapeWarning("warning: OffsetRect: null rectangle");
        return;
    }
    *r = makeRect(r->left + dh, r->top + dv, r->right + dh, r->bottom + dv);
}

void InsetRect(Rect* r, short dh, short dv)
{
    if (!r)
        return;
    const int left = r->left + dh, right = r->right - dh;
    const int top = r->top + dv, bottom = r->bottom - dv;
    if (right - left < 1 || bottom - top < 1)
        *r = makeRect(0, 0, 0, 0);
    else
        *r = makeRect(left, top, right, bottom);
}

unsigned char EmptyRect(const Rect* r)
{
    return isEmptyRect(r) ? 1 : 0;
}

// Leaves `out` alone for a null or empty input, unlike the classic call that clears it.
unsigned char SectRect(const Rect* a, const Rect* b, Rect* out)
{
    if (!a || !b || EmptyRect(a) || EmptyRect(b))
        return 0;
    const int top = std::max(a->top, b->top), left = std::max(a->left, b->left);
    const int bottom = std::min(a->bottom, b->bottom), right = std::min(a->right, b->right);
    const bool meet = left < right && top < bottom;
    if (!out) {
        shapeWarning("warning: SectRect: null result rectangle");
        return meet ? 1 : 0;
    }
    if (meet)
        *out = makeRect(left, top, right, bottom);
    else
        *out = makeRect(0, 0, 0, 0);
    return meet ? 1 : 0;
}

// A null input counts as Qt's null rectangle, which QRect's union leaves out.
void UnionRect(const Rect* a, const Rect* b, Rect* out)
{
    if (!out) {
        shapeWarning("warning: UnionRect: null result rectangle");
        return;
    }
    *out = toRect(toQRect(a) | toQRect(b));
}

unsigned char PtInRect(Point pt, const Rect* r)
{
    if (!r)
        return 0;
    return (pt.h >= r->left && pt.h < r->right && pt.v >= r->top && pt.v < r->bottom) ? 1 : 0;
}

unsigned char EqualRect(const Rect* a, const Rect* b)
{
    if (!a || !b)
        return (!a && !b) ? 1 : 0;
    return sameRect(*a, *b) ? 1 : 0;
}

void Pt2Rect(Point a, Point b, Rect* out)
{
    if (!out)
        return;
    *out = makeRect(std::min(a.h, b.h), std::min(a.v, b.v), std::max(a.h, b.h),
                    std::max(a.v, b.v));
}

} // namespace Velmar
