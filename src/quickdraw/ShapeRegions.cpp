#include "quickdraw/ShapeRegions.h"

#include <algorithm>
#include <cmath>
#include <utility>
#include <vector>

namespace Velmar::Private {

namespace {

// Rows and columns beyond these are left out of scan-converted shapes: no Toolbox rectangle
// reaches them, and the work stays bounded whatever offsets a polygon has been through.
constexpr int kScanLimit = 65536;

using Spans = std::vector<std::pair<int, int>>; // inclusive [first, last] pixel columns

// Builds a region from one row of spans at a time, merging runs of identical rows into one
// band: the banded form QRegion keeps, so that equal areas compare equal.
class BandBuilder {
public:
    void row(int y, Spans spans)
    {
        if (m_haveBand && spans == m_spans && y == m_top + m_height) {
            ++m_height;
            return;
        }
        flush();
        m_spans = std::move(spans);
        m_top = y;
        m_height = 1;
        m_haveBand = !m_spans.empty();
    }
    QRegion finish()
    {
        flush();
        QRegion region;
        if (!m_rects.empty())
            region.setRects(m_rects.data(), int(m_rects.size()));
        return region;
    }

private:
    void flush()
    {
        if (!m_haveBand)
            return;
        for (const auto& [first, last] : m_spans)
            m_rects.emplace_back(QPoint(first, m_top), QPoint(last, m_top + m_height - 1));
        m_haveBand = false;
    }

    std::vector<QRect> m_rects;
    Spans m_spans;
    int m_top = 0;
    int m_height = 0;
    bool m_haveBand = false;
};

int clampScan(double v)
{
    return int(std::clamp(v, double(-kScanLimit), double(kScanLimit)));
}

// Pixels whose centres lie in [from, to).
std::pair<int, int> centresIn(double from, double to)
{
    return {clampScan(std::ceil(from - 0.5)), clampScan(std::ceil(to - 0.5)) - 1};
}

QRegion scanEllipse(const QRect& r)
{
    const double a = r.width() / 2.0, b = r.height() / 2.0;
    const double cx = r.left() + a, cy = r.top() + b;
    const int top = std::max(r.top(), -kScanLimit), bottom = std::min(r.bottom(), kScanLimit);
    BandBuilder bands;
    for (int y = top; y <= bottom; ++y) {
        const double dy = (y + 0.5 - cy) / b;
        Spans spans;
        if (dy > -1.0 && dy < 1.0) {
            const double half = a * std::sqrt(1.0 - dy * dy);
            const auto span = centresIn(cx - half, cx + half);
            if (span.first <= span.second)
                spans.push_back(span);
        }
        bands.row(y, std::move(spans));
    }
    return bands.finish();
}

struct Edge {
    double top, bottom; // y of its ends, top < bottom
    double x0, slope;   // x at y = top, and dx/dy
};

QRegion scanPolygon(const QPolygon& polygon)
{
    std::vector<Edge> edges;
    for (qsizetype i = 0; i < polygon.size(); ++i) {
        QPointF p = polygon[i], q = polygon[(i + 1) % polygon.size()];
        if (p.y() == q.y())
            continue;
        if (p.y() > q.y())
            std::swap(p, q);
        edges.push_back({p.y(), q.y(), p.x(), (q.x() - p.x()) / (q.y() - p.y())});
    }
    std::sort(edges.begin(), edges.end(), [](const Edge& l, const Edge& r) { return l.top < r.top; });
    const QRect box = polygon.boundingRect();
    const int top = std::max(box.top(), -kScanLimit), bottom = std::min(box.bottom(), kScanLimit);

    BandBuilder bands;
    std::vector<const Edge*> active;
    std::size_t next = 0;
    std::vector<double> xs;
    for (int y = top; y <= bottom; ++y) {
        const double centre = y + 0.5;
        while (next < edges.size() && edges[next].top <= centre)
            active.push_back(&edges[next++]);
        active.erase(std::remove_if(active.begin(), active.end(),
                                    [centre](const Edge* e) { return e->bottom <= centre; }),
                     active.end());
        xs.clear();
        for (const Edge* e : active) {
            if (e->top <= centre)
                xs.push_back(e->x0 + (centre - e->top) * e->slope);
        }
        std::sort(xs.begin(), xs.end());
        Spans spans;
        for (std::size_t i = 0; i + 1 < xs.size(); i += 2) {
            const auto span = centresIn(xs[i], xs[i + 1]);
            if (span.first > span.second)
                continue;
            if (!spans.empty() && span.first <= spans.back().second + 1)
                spans.back().second = std::max(spans.back().second, span.second);
            else
                spans.push_back(span);
        }
        bands.row(y, std::move(spans));
    }
    return bands.finish();
}

bool smallEnough(const QRect& box)
{
    return qint64(box.right()) - box.left() < kQtShapeRegionLimit
        && qint64(box.bottom()) - box.top() < kQtShapeRegionLimit;
}

} // namespace

QRegion ellipseRegion(const QRect& rect)
{
    if (rect.isEmpty())
        return QRegion();
    return smallEnough(rect) ? QRegion(rect, QRegion::Ellipse) : scanEllipse(rect);
}

QRegion polygonRegion(const QPolygon& polygon)
{
    if (polygon.size() < 3)
        return QRegion();
    return smallEnough(polygon.boundingRect()) ? QRegion(polygon, Qt::OddEvenFill)
                                               : scanPolygon(polygon);
}

} // namespace Velmar::Private
