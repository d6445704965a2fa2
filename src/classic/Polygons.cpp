// Classic polygons: a Polygon handle (polySize, polyBBox, the points) per library polygon,
// written after every call that changes it.
#include "classic/ClassicPrivate.h"

#include <QPolygon>

#include <cstdlib>

namespace {

using namespace VelmarClassic;

struct PolyBlock {
    Polygon* master = nullptr;
    Velmar::PolyPtr* poly = nullptr;
};

std::unordered_map<PolyHandle, PolyBlock*>& polygons()
{
    static auto* map = new std::unordered_map<PolyHandle, PolyBlock*>;
    return *map;
}

PolyHandle gOpen = nullptr;

void sync(PolyBlock* b)
{
    const QPolygon points = b->poly && b->poly->qPoly ? *b->poly->qPoly : QPolygon();
    const int n = int(points.size());
    auto* grown = static_cast<Polygon*>(
        std::realloc(b->master, sizeof(Polygon) + sizeof(Point) * size_t(n > 0 ? n - 1 : 0)));
    if (!grown)
        return;
    b->master = grown;
    grown->polySize = (unsigned short)std::min(65535, 10 + 4 * n);
    const QRect r = points.boundingRect();
    grown->polyBBox = n
        ? Rect{short(r.top()), short(r.left()), short(r.bottom() + 1), short(r.right() + 1)}
        : Rect{0, 0, 0, 0};
    for (int i = 0; i < n; ++i)
        grown->polyPoints[i] = Point{short(points[i].y()), short(points[i].x())};
}

PolyBlock* blockOf(PolyHandle h)
{
    if (!VELMAR_ASSERT(h, "poly != NULL"))
        return nullptr;
    const auto it = polygons().find(h);
    return VELMAR_ASSERT(it != polygons().end(), "IsValidPolyHandle(poly)") ? it->second : nullptr;
}

template <typename Call> void draw(PolyHandle h, Call&& call)
{
    if (PolyBlock* b = blockOf(h))
        drawInPort([&] { call(b->poly); });
}

} // namespace

PolyHandle OpenPoly()
{
    PortLink* link = currentLink();
    if (!link)
        return nullptr;
    pullPort(*link);
    auto* b = new PolyBlock;
    b->poly = Velmar::OpenPoly();
    b->master = static_cast<Polygon*>(std::calloc(1, sizeof(Polygon)));
    b->master->polySize = 10;
    const PolyHandle h = &b->master;
    polygons()[h] = b;
    gOpen = h;
    return h;
}

void ClosePoly()
{
    if (!currentLink())
        return;
    Velmar::ClosePoly();
    const auto it = polygons().find(gOpen);
    if (it != polygons().end())
        sync(it->second);
    gOpen = nullptr;
}

void KillPoly(PolyHandle poly)
{
    PolyBlock* b = blockOf(poly);
    if (!b)
        return;
    if (gOpen == poly)
        ClosePoly();
    polygons().erase(poly);
    Velmar::KillPoly(b->poly);
    std::free(b->master);
    delete b;
}

void OffsetPoly(PolyHandle poly, short dh, short dv)
{
    if (PolyBlock* b = blockOf(poly)) {
        Velmar::OffsetPoly(b->poly, dh, dv);
        sync(b);
    }
}

void FramePoly(PolyHandle poly)
{
    draw(poly, [](Velmar::PolyPtr* p) { Velmar::FramePoly(p); });
}
void PaintPoly(PolyHandle poly)
{
    draw(poly, [](Velmar::PolyPtr* p) { Velmar::PaintPoly(p); });
}
void ErasePoly(PolyHandle poly)
{
    draw(poly, [](Velmar::PolyPtr* p) { Velmar::ErasePoly(p); });
}
void InvertPoly(PolyHandle poly)
{
    draw(poly, [](Velmar::PolyPtr* p) { Velmar::InvertPoly(p); });
}

void FillPoly(PolyHandle poly, const Pattern* pat)
{
    if (!VELMAR_ASSERT(pat, "pat != NULL"))
        return;
    const Velmar::Pattern p = libraryPattern(pat);
    draw(poly, [&](Velmar::PolyPtr* q) { Velmar::FillPoly(q, &p); });
}
