// Point utilities.
#include <Velmar/QDShapes.h>

#include "foundation/Conversions.h"
#include "quickdraw/ShapeLog.h"

namespace Velmar {

void SetPt(Point* pt, short h, short v)
{
    if (!pt)
        return;
    pt->h = h;
    pt->v = v;
}

unsigned char EqualPt(Point a, Point b)
{
    return Private::samePoint(a, b) ? 1 : 0;
}

void AddPt(Point src, Point* dst)
{
    if (!dst) {
        Private::shapeWarning("warning: AddPt: null point");
        return;
    }
    dst->h = std::int16_t(dst->h + src.h);
    dst->v = std::int16_t(dst->v + src.v);
}

void SubPt(Point src, Point* dst)
{
    if (!dst) {
        Private::shapeWarning("warning: SubPt: null point");
        return;
    }
    dst->h = std::int16_t(dst->h - src.h);
    dst->v = std::int16_t(dst->v - src.v);
}

} // namespace Velmar
