// Region handles and arithmetic as exact pixel sets: which pixels a rectangle, an inset, a map
// and the edge tests give. The set laws for any input are fuzz_regions' (its corpus replays
// with the suite).
#include "QuickDrawTestSupport.h"

#include <QRandomGenerator>

using namespace Velmar;
using namespace QDTest;

namespace {

Rgn rectRgn(int left, int top, int right, int bottom)
{
    Rgn r = rgnOf();
    SetRectRgn(r.get(), short(left), short(top), short(right), short(bottom));
    return r;
}

// A region made of a few random rectangles inside a 40x40 box.
Rgn randomRgn(QRandomGenerator& gen)
{
    Rgn r = rgnOf();
    const int n = 1 + gen.bounded(5);
    for (int i = 0; i < n; ++i) {
        const int l = gen.bounded(40), t = gen.bounded(40);
        Rgn part = rectRgn(l, t, l + 1 + gen.bounded(15), t + 1 + gen.bounded(15));
        UnionRgn(r.get(), part.get(), r.get());
    }
    return r;
}

// InsetRgn by its definition: |d| one-pixel steps, each intersecting (shrink) or uniting
// (grow) the region with itself moved a pixel either way.
QRegion insetByDefinition(QRegion r, int dh, int dv)
{
    for (int i = 0; i < std::abs(dh); ++i) {
        const QRegion a = r.translated(-1, 0), b = r.translated(1, 0);
        r = dh > 0 ? (r & a & b) : (r | a | b);
    }
    for (int i = 0; i < std::abs(dv); ++i) {
        const QRegion a = r.translated(0, -1), b = r.translated(0, 1);
        r = dv > 0 ? (r & a & b) : (r | a | b);
    }
    return r;
}

} // namespace

class TestRegionAlgebra : public QObject {
    Q_OBJECT
private Q_SLOTS:
    void initTestCase() { SetLogCategory(kLogQuickDraw, true); }

    void lifetimeAndContent()
    {
        Rgn r = rgnOf(), copy = rgnOf();
        QVERIFY(EmptyRgn(r.get()));
        const Rect rect{10, 20, 30, 60};
        RectRgn(r.get(), &rect);
        QCOMPARE(*r, QRegion(20, 10, 40, 20)); // exactly the Toolbox pixels
        Rect b{};
        GetRegionBounds(r.get(), &b);
        QVERIFY(b.top == 10 && b.left == 20 && b.bottom == 30 && b.right == 60);
        CopyRgn(r.get(), copy.get());
        SetEmptyRgn(r.get());
        QVERIFY(EmptyRgn(r.get()) && !EqualRgn(r.get(), copy.get()));
        RectRgn(copy.get(), nullptr); // null rectangle: empty region
        QVERIFY(EmptyRgn(copy.get()));
        SetRectRgn(copy.get(), 10, 10, 5, 20); // inverted: empty
        QVERIFY(EmptyRgn(copy.get()));
        // Right and bottom edges are outside; RectInRgn means "intersects".
        r = rectRgn(10, 10, 20, 20);
        const Rect touching{0, 0, 10, 10}, corner{19, 19, 30, 30}, around{0, 0, 50, 50}, empty{15, 15, 15, 15};
        QCOMPARE(RectInRgn(&touching, r.get()), 0);
        QCOMPARE(RectInRgn(&corner, r.get()), 1);
        QCOMPARE(RectInRgn(&around, r.get()), 1);
        QCOMPARE(RectInRgn(&empty, r.get()), 0);
        QCOMPARE(PtInRgn(P(19, 19), r.get()), 1);
        QCOMPARE(PtInRgn(P(20, 19), r.get()), 0);
    }

    // Explicitly on a rectangle, then against the step-by-step definition: rectangles by
    // small and absurd amounts, an L shape (its inner corner, growth far past its size, the
    // fast path) and random regions of many rectangles and far-apart pieces.
    void insetRgn()
    {
        Rgn r = rectRgn(0, 0, 10, 10);
        InsetRgn(r.get(), 2, 2);
        QCOMPARE(*r, QRegion(2, 2, 6, 6));
        InsetRgn(r.get(), 0, -3);
        QCOMPARE(*r, QRegion(2, -1, 6, 12));
        InsetRgn(r.get(), 3, 0);
        QVERIFY(EmptyRgn(r.get()));
        const QRegion rect(0, 0, 10, 10), lShape = QRegion(0, 0, 30, 8).united(QRegion(0, 0, 8, 30));
        QList<std::tuple<QRegion, int, int>> cases = {{rect, -1, 0}, {rect, 4, 4}, {rect, 0, 0}, {rect, 3000, 0},
            {lShape, 1, 1}, {lShape, -1, -1}, {lShape, -100, -100}, {lShape, -3000, -3000}, {lShape, 3, -2},
            {lShape.united(QRegion(80, 80, 20, 18)), -12, 6}};
        QRandomGenerator gen(99);
        for (int round = 0; round < 40; ++round) {
            Rgn random = randomRgn(gen);
            cases.append({*random, gen.bounded(-9, 10), gen.bounded(-9, 10)});
        }
        for (const auto& [region, dh, dv] : cases) {
            r = rgnOf(region);
            InsetRgn(r.get(), short(dh), short(dv));
            QVERIFY2(*r == insetByDefinition(region, dh, dv),
                     QByteArray::number(dh) + "," + QByteArray::number(dv));
        }
    }

    void mapRgn()
    {
        Rgn r = rectRgn(10, 10, 20, 20);
        const Rect src{0, 0, 100, 100}, dst{50, 50, 150, 250}; // x2 horizontally, +50 both ways
        MapRgn(r.get(), &src, &dst);
        QCOMPARE(r->boundingRect(), QRect(70, 60, 20, 10));
        // Mapping back restores the region.
        MapRgn(r.get(), &dst, &src);
        Rgn original = rectRgn(10, 10, 20, 20);
        QVERIFY(EqualRgn(r.get(), original.get()));
        // An empty source is refused with a log line and leaves the region alone.
        VelmarTest::LogCapture log;
        const Rect empty{0, 0, 0, 10};
        MapRgn(r.get(), &empty, &dst);
        QVERIFY(EqualRgn(r.get(), original.get()));
        QVERIFY(log.contains("MapRgn"));
    }

};

VELMAR_TEST_MAIN(TestRegionAlgebra)
#include "tst_regionalgebra.moc"
