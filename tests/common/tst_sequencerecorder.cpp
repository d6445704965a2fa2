// The matcher every sequence comparison relies on: optional entries and wildcards.
#include "TestSupport.h"

class tst_SequenceRecorder : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void fits_data()
    {
        QTest::addColumn<QStringList>("expected");
        QTest::addColumn<QStringList>("actual");
        QTest::addColumn<bool>("fits");
        QTest::newRow("equal") << QStringList{"a", "b"} << QStringList{"a", "b"} << true;
        QTest::newRow("missing entry") << QStringList{"a", "b"} << QStringList{"a"} << false;
        QTest::newRow("extra entry") << QStringList{"a"} << QStringList{"a", "b"} << false;
        QTest::newRow("order matters") << QStringList{"a", "b"} << QStringList{"b", "a"} << false;
        QTest::newRow("optional absent") << QStringList{"a", "?x", "b"} << QStringList{"a", "b"} << true;
        QTest::newRow("optional present") << QStringList{"a", "?x", "b"} << QStringList{"a", "x", "b"} << true;
        QTest::newRow("optional is one entry") << QStringList{"?x"} << QStringList{"x", "x"} << false;
        QTest::newRow("wildcard run") << QStringList{"a", "*", "b"} << QStringList{"a", "p", "q", "b"} << true;
        QTest::newRow("wildcard empty") << QStringList{"*", "b"} << QStringList{"b"} << true;
        QTest::newRow("wildcard needs the tail") << QStringList{"a", "*", "b"} << QStringList{"a", "p"} << false;
    }
    void fits()
    {
        QFETCH(QStringList, expected);
        QFETCH(QStringList, actual);
        QFETCH(bool, fits);
        const QString why = VelmarTest::SequenceRecorder::mismatch("case", expected, actual);
        QCOMPARE(why.isEmpty(), fits);
        if (!fits)
            QVERIFY(why.contains(QStringLiteral("expected:")) && why.contains(QStringLiteral("actual:")));
    }

    void recordOnceCollapsesRepeats()
    {
        VelmarTest::SequenceRecorder seen;
        for (const char* e : {"spin", "spin", "tick", "spin"})
            seen.recordOnce(QString::fromLatin1(e));
        VELMAR_COMPARE_SEQUENCE(seen, "spins", {"spin", "tick", "spin"});
    }
};

VELMAR_TEST_MAIN(tst_SequenceRecorder)
#include "tst_sequencerecorder.moc"
