// Classic masks as (class, kind) lists and the matching rule.
#include "TestSupport.h"
#include "tst_eventqueue_support.h"

#include "events/EventMask.h"

#include <Velmar/Events.h>

using namespace Velmar;
using namespace EventTest;

namespace {

QString pairsText(const Private::EventTypeList& list)
{
    QStringList parts;
    for (UInt32 i = 0; i < list.count; ++i)
        parts << fourChars(list.specs[i].eventClass) + u'/' + QString::number(list.specs[i].eventKind);
    return parts.join(u' ');
}

} // namespace

class tst_EventMask : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void parse_data()
    {
        QTest::addColumn<int>("mask");
        QTest::addColumn<int>("result");
        QTest::addColumn<QString>("pairs");

        QTest::newRow("everyEvent") << int(everyEvent) << 0 << "";
        QTest::newRow("zero") << 0 << 0 << "";
        QTest::newRow("mouse down") << int(mDownMask) << 1 << "mous/1";
        QTest::newRow("mouse up") << int(mUpMask) << 1 << "mous/2";
        QTest::newRow("key down") << int(keyDownMask) << 1 << "keyb/1";
        QTest::newRow("key up") << int(keyUpMask) << 1 << "keyb/3";
        QTest::newRow("auto key") << int(autoKeyMask) << 1 << "keyb/2";
        QTest::newRow("update") << int(updateMask) << 1 << "wind/1";
        QTest::newRow("activate: two kinds") << int(activMask) << 2 << "wind/5 wind/6";
        QTest::newRow("os: two kinds") << int(osMask) << 2 << "appl/1 appl/2";
        QTest::newRow("table order") << int(osMask | keyUpMask | mDownMask) << 4 << "mous/1 keyb/3 appl/1 appl/2";
        QTest::newRow("unknown bits ignored beside a known one") << int(0x0001 | 0x0080 | mUpMask) << 1 << "mous/2";
        QTest::newRow("all known bits") << int(0x817E) << 10
                                        << "mous/1 mous/2 keyb/1 keyb/3 keyb/2 wind/1 wind/5 wind/6 appl/1 appl/2";
        QTest::newRow("everyEvent less one bit") << int(0xFFFE) << 10
                                                 << "mous/1 mous/2 keyb/1 keyb/3 keyb/2 wind/1 wind/5 wind/6 appl/1 appl/2";
        QTest::newRow("null-event bit only") << 1 << -1 << "";
        QTest::newRow("disk and high-level only") << int(diskMask | highLevelEventMask) << -1 << "";
    }

    void parse()
    {
        QFETCH(int, mask);
        QFETCH(int, result);
        QFETCH(QString, pairs);
        VelmarTest::LogCapture capture;
        Private::EventTypeList list;
        QCOMPARE(Private::ParseEventMask(UInt16(mask), list), result);
        QCOMPARE(pairsText(list), pairs);
        QCOMPARE(capture.count(QStringLiteral("Unable to parse eventMask at all.... Returning negative")),
                 result < 0 ? 1 : 0);
    }

    void matching()
    {
        Private::EventTypeList list;
        Private::ParseEventMask(activMask, list);
        EventQueueItemSmartPtr activated = makeItem(kEventClassWindow, kEventWindowActivated);
        EventQueueItemSmartPtr update = makeItem(kEventClassWindow, kEventWindowUpdate);
        QVERIFY(Private::MatchesEventTypes(list, activated.get()));
        QVERIFY(!Private::MatchesEventTypes(list, update.get()));
        QVERIFY(!Private::MatchesEventTypes(list, nullptr));
        // an empty list matches everything, a null list with a count too
        Private::EventTypeList empty;
        QVERIFY(Private::MatchesEventTypes(empty, update.get()));
        QVERIFY(Private::MatchesEventTypes(nullptr, 3, kEventClassMouse, 1));
        const EventTypeSpec one[] = {{kEventClassMouse, kEventMouseDown}};
        QVERIFY(Private::MatchesEventTypes(one, 1, kEventClassMouse, kEventMouseDown));
        QVERIFY(!Private::MatchesEventTypes(one, 1, kEventClassMouse, kEventMouseUp));
    }
};

VELMAR_TEST_MAIN(tst_EventMask)
#include "tst_eventmask.moc"
