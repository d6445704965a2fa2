// Rectangle utilities: the Toolbox field order and the deliberate departures (SectRect leaving
// its result alone for empty inputs, null pointers counting as empty or left out).
#include "QuickDrawTestSupport.h"

using namespace Velmar;
using namespace QDTest;

static bool same(const Rect& a, const Rect& b)
{
    return EqualRect(&a, &b) != 0;
}
static QByteArray show(const Rect& r)
{
    return QStringLiteral("%1,%2,%3,%4").arg(r.top).arg(r.left).arg(r.bottom).arg(r.right).toLatin1();
}

class TestRectUtils : public QObject {
    Q_OBJECT
private Q_SLOTS:
    void initTestCase() { SetLogCategory(kLogQuickDraw, true); }

    void emptyRect()
    {
        for (const auto& [r, empty] : {std::pair{R(0, 0, 10, 10), false}, {R(5, 5, 6, 6), false},
                                       {R(10, 10, 10, 20), true}, {R(10, 20, 30, 20), true}, {R(10, 10, 0, 0), true}})
            QVERIFY2((EmptyRect(&r) != 0) == empty, show(r));
    }

    // SetRect takes left, top, right, bottom; OffsetRect and InsetRect move and shrink by
    // (dh, dv); an inset that leaves nothing gives the all-zero rectangle.
    void setOffsetInset()
    {
        struct Case {
            int op; // 0 SetRect(dh, dv, 3, 4), 1 OffsetRect, 2 InsetRect
            Rect in;
            int dh, dv;
            Rect out;
        };
        for (Case c : {Case{0, R(9, 9, 9, 9), 1, 2, R(2, 1, 4, 3)}, {1, R(10, 20, 30, 40), 5, -5, R(5, 25, 25, 45)},
                       {2, R(0, 0, 10, 10), 2, 3, R(3, 2, 7, 8)}, {2, R(0, 0, 10, 10), -1, -2, R(-2, -1, 12, 11)},
                       {2, R(0, 0, 10, 10), 5, 0, R(0, 0, 0, 0)}, {2, R(5, 5, 10, 50), 0, 3, R(0, 0, 0, 0)},
                       {2, R(0, 0, 11, 11), 5, 5, R(5, 5, 6, 6)}}) {
            if (c.op == 0)
                SetRect(&c.in, short(c.dh), short(c.dv), 3, 4);
            else
                (c.op == 1 ? OffsetRect : InsetRect)(&c.in, short(c.dh), short(c.dv));
            QVERIFY2(same(c.in, c.out), show(c.in));
        }
    }

    // Symmetric; an empty answer clears the result, except that an empty or null input
    // leaves it alone; the result may alias an input.
    void sectRect()
    {
        for (const auto& [a, b, result, out] :
             {std::tuple{R(0, 0, 10, 10), R(5, 5, 20, 20), 1, R(5, 5, 10, 10)}, {R(0, 0, 10, 10), R(2, 3, 4, 5), 1, R(2, 3, 4, 5)},
              {R(0, 0, 10, 10), R(20, 20, 30, 30), 0, R(0, 0, 0, 0)}, {R(0, 0, 10, 10), R(0, 10, 10, 20), 0, R(0, 0, 0, 0)}}) {
            Rect got = R(-7, -7, -7, -7);
            QCOMPARE(int(SectRect(&a, &b, &got)), result);
            QVERIFY2(same(got, out), show(got));
            got = R(-7, -7, -7, -7);
            QCOMPARE(int(SectRect(&b, &a, &got)), result);
            QVERIFY2(same(got, out), show(got));
        }
        const Rect sentinel = R(1, 2, 3, 4), empty = R(10, 10, 10, 20), full = R(0, 0, 50, 50);
        Rect out = sentinel;
        QCOMPARE(SectRect(&empty, &full, &out), 0);
        QVERIFY(same(out, sentinel));
        QCOMPARE(SectRect(&full, &empty, &out), 0);
        QCOMPARE(SectRect(nullptr, &full, &out), 0);
        QCOMPARE(SectRect(&full, nullptr, &out), 0);
        QVERIFY(same(out, sentinel));
        QCOMPARE(SectRect(&full, &full, nullptr), 1); // no result slot: answer only
        Rect a = R(0, 0, 10, 10);
        const Rect b = R(5, 5, 20, 20);
        QCOMPARE(SectRect(&a, &b, &a), 1);
        QVERIFY(same(a, R(5, 5, 10, 10)));
    }

    void unionPt2RectAndPtInRect()
    {
        const Rect a = R(0, 0, 10, 10), b = R(20, 30, 25, 35);
        Rect out{};
        UnionRect(&a, &b, &out);
        QVERIFY2(same(out, R(0, 0, 25, 35)), show(out));
        UnionRect(&a, nullptr, &out); // null is left out
        QVERIFY(same(out, a));
        UnionRect(nullptr, &b, &out);
        QVERIFY(same(out, b));
        Pt2Rect(P(30, 5), P(10, 25), &out); // any two corners, in any order
        QVERIFY2(same(out, R(5, 10, 25, 30)), show(out));
        const Rect r = R(10, 10, 20, 20); // right and bottom edges are outside
        for (const auto& [h, v, in] : {std::tuple{10, 10, 1}, {19, 19, 1}, {20, 15, 0}, {15, 20, 0}, {9, 15, 0}})
            QVERIFY2(PtInRect(P(h, v), &r) == in, QByteArray::number(h) + "," + QByteArray::number(v));
    }

};

VELMAR_TEST_MAIN(TestRectUtils)
#include "tst_rectutils.moc"
