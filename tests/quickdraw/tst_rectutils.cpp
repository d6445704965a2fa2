// Rectangle utilities: the Toolbox field order and the deliberate departures (SectRect leaving
// its result alone for empty inputs, null pointers counting as empty or left out).
#include "ShapeTestWorld.h"

#include <Velmar/Diagnostics.h>

Q_DECLARE_METATYPE(Rect)

using namespace Velmar;
using namespace ShapeTest;

namespace {

bool same(const Rect& a, const Rect& b)
{
    return EqualRect(&a, &b) != 0;
}

QByteArray show(const Rect& r)
{
    return QByteArray::number(r.top) + "," + QByteArray::number(r.left) + ","
        + QByteArray::number(r.bottom) + "," + QByteArray::number(r.right);
}

} // namespace

class TestRectUtils : public QObject {
    Q_OBJECT
private Q_SLOTS:
    void initTestCase() { SetLogCategory(kLogQuickDraw, true); }

    void emptyRect_data()
    {
        QTest::addColumn<Rect>("r");
        QTest::addColumn<bool>("empty");
        QTest::newRow("normal") << R(0, 0, 10, 10) << false;
        QTest::newRow("one pixel") << R(5, 5, 6, 6) << false;
        QTest::newRow("zero height") << R(10, 10, 10, 20) << true;
        QTest::newRow("zero width") << R(10, 20, 30, 20) << true;
        QTest::newRow("inverted") << R(10, 10, 0, 0) << true;
    }
    void emptyRect()
    {
        QFETCH(Rect, r);
        QFETCH(bool, empty);
        QCOMPARE(EmptyRect(&r) != 0, empty);
    }

    // SetRect takes left, top, right, bottom; OffsetRect and InsetRect move and shrink by
    // (dh, dv); an inset that leaves nothing gives the all-zero rectangle.
    void setOffsetInset_data()
    {
        QTest::addColumn<int>("op"); // 0 SetRect(dh, dv, 3, 4), 1 OffsetRect, 2 InsetRect
        QTest::addColumn<Rect>("in");
        QTest::addColumn<int>("dh");
        QTest::addColumn<int>("dv");
        QTest::addColumn<Rect>("out");
        QTest::newRow("set") << 0 << R(9, 9, 9, 9) << 1 << 2 << R(2, 1, 4, 3);
        QTest::newRow("offset") << 1 << R(10, 20, 30, 40) << 5 << -5 << R(5, 25, 25, 45);
        QTest::newRow("shrink") << 2 << R(0, 0, 10, 10) << 2 << 3 << R(3, 2, 7, 8);
        QTest::newRow("grow") << 2 << R(0, 0, 10, 10) << -1 << -2 << R(-2, -1, 12, 11);
        QTest::newRow("width gone") << 2 << R(0, 0, 10, 10) << 5 << 0 << R(0, 0, 0, 0);
        QTest::newRow("height gone") << 2 << R(5, 5, 10, 50) << 0 << 3 << R(0, 0, 0, 0);
        QTest::newRow("one left") << 2 << R(0, 0, 11, 11) << 5 << 5 << R(5, 5, 6, 6);
    }
    void setOffsetInset()
    {
        QFETCH(int, op);
        QFETCH(Rect, in);
        QFETCH(int, dh);
        QFETCH(int, dv);
        QFETCH(Rect, out);
        if (op == 0)
            SetRect(&in, short(dh), short(dv), 3, 4);
        else
            (op == 1 ? OffsetRect : InsetRect)(&in, short(dh), short(dv));
        QVERIFY2(same(in, out), show(in));
    }

    void sectRect_data()
    {
        QTest::addColumn<Rect>("a");
        QTest::addColumn<Rect>("b");
        QTest::addColumn<int>("result");
        QTest::addColumn<Rect>("out");
        QTest::newRow("overlap") << R(0, 0, 10, 10) << R(5, 5, 20, 20) << 1 << R(5, 5, 10, 10);
        QTest::newRow("inside") << R(0, 0, 10, 10) << R(2, 3, 4, 5) << 1 << R(2, 3, 4, 5);
        QTest::newRow("apart") << R(0, 0, 10, 10) << R(20, 20, 30, 30) << 0 << R(0, 0, 0, 0);
        QTest::newRow("touching") << R(0, 0, 10, 10) << R(0, 10, 10, 20) << 0 << R(0, 0, 0, 0);
    }
    void sectRect()
    {
        QFETCH(Rect, a);
        QFETCH(Rect, b);
        QFETCH(int, result);
        QFETCH(Rect, out);
        Rect got = R(-7, -7, -7, -7);
        QCOMPARE(int(SectRect(&a, &b, &got)), result);
        QVERIFY2(same(got, out), show(got));
        got = R(-7, -7, -7, -7);
        QCOMPARE(int(SectRect(&b, &a, &got)), result); // symmetric
        QVERIFY2(same(got, out), show(got));
    }
    void sectRectLeavesResultForEmptyOrNullInput()
    {
        const Rect sentinel = R(1, 2, 3, 4);
        const Rect empty = R(10, 10, 10, 20), full = R(0, 0, 50, 50);
        Rect out = sentinel;
        QCOMPARE(SectRect(&empty, &full, &out), 0);
        QVERIFY(same(out, sentinel));
        QCOMPARE(SectRect(&full, &empty, &out), 0);
        QCOMPARE(SectRect(nullptr, &full, &out), 0);
        QCOMPARE(SectRect(&full, nullptr, &out), 0);
        QVERIFY(same(out, sentinel));
        QCOMPARE(SectRect(&full, &full, nullptr), 1); // no result slot: answer only
        // The result may alias an input.
        Rect a = R(0, 0, 10, 10);
        const Rect b = R(5, 5, 20, 20);
        QCOMPARE(SectRect(&a, &b, &a), 1);
        QVERIFY(same(a, R(5, 5, 10, 10)));
    }

    void unionRect()
    {
        const Rect a = R(0, 0, 10, 10), b = R(20, 30, 25, 35);
        Rect out{};
        UnionRect(&a, &b, &out);
        QVERIFY2(same(out, R(0, 0, 25, 35)), show(out));
        UnionRect(&a, nullptr, &out); // null is left out
        QVERIFY(same(out, a));
        UnionRect(nullptr, &b, &out);
        QVERIFY(same(out, b));
    }

    void ptInRectExcludesRightAndBottomEdges()
    {
        const Rect r = R(10, 10, 20, 20);
        QCOMPARE(PtInRect(P(10, 10), &r), 1);
        QCOMPARE(PtInRect(P(19, 19), &r), 1);
        QCOMPARE(PtInRect(P(20, 15), &r), 0);
        QCOMPARE(PtInRect(P(15, 20), &r), 0);
        QCOMPARE(PtInRect(P(9, 15), &r), 0);
        Rect out{};
        Pt2Rect(P(30, 5), P(10, 25), &out); // any two corners, in any order
        QVERIFY2(same(out, R(5, 10, 25, 30)), show(out));
    }

    void nullPointersAreSafe()
    {
        VelmarTest::LogCapture log;
        SetRect(nullptr, 1, 2, 3, 4);
        OffsetRect(nullptr, 1, 1);
        QVERIFY(log.contains("OffsetRect"));
        InsetRect(nullptr, 1, 1);
        QCOMPARE(EmptyRect(nullptr), 1);
        const Rect a = R(0, 0, 10, 10);
        UnionRect(&a, &a, nullptr);
        QCOMPARE(PtInRect(P(15, 15), nullptr), 0);
        Pt2Rect(P(1, 1), P(2, 2), nullptr);
    }
};

VELMAR_TEST_MAIN(TestRectUtils)
#include "tst_rectutils.moc"
