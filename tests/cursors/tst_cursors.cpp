// Cursors: records and the table, the library's own pictures, theme cursors, and the pushes
// and pops that setting, hiding and obscuring make on Qt's override-cursor stack.
#include "TestSupport.h"

#include <Velmar/Cursors.h>

#include "cursors/CursorPrivate.h"
#include "foundation/ApplicationPrivate.h"

#include <QGuiApplication>
#include <QWidget>

#include <initializer_list>

using namespace Velmar;

namespace {

QString shapeName(Qt::CursorShape shape)
{
    switch (shape) {
    case Qt::ArrowCursor: return QStringLiteral("arrow");
    case Qt::IBeamCursor: return QStringLiteral("ibeam");
    case Qt::CrossCursor: return QStringLiteral("cross");
    case Qt::WaitCursor: return QStringLiteral("wait");
    case Qt::BlankCursor: return QStringLiteral("blank");
    case Qt::BitmapCursor: return QStringLiteral("picture");
    default: return QString::number(int(shape));
    }
}

// Qt's override stack, top first. Empties it and clears the hidden and obscured states.
QString drainOverrideStack()
{
    QStringList shapes;
    while (const QCursor* cursor = QGuiApplication::overrideCursor()) {
        shapes << shapeName(cursor->shape());
        QGuiApplication::restoreOverrideCursor();
    }
    InitCursor();
    return shapes.join(QLatin1Char(' '));
}

Qt::CursorShape overrideShape()
{
    const QCursor* cursor = QGuiApplication::overrideCursor();
    return cursor ? cursor->shape() : Qt::CustomCursor;
}

// Runs "hide obscure show restore init remove set:ID" in order.
void run(const QString& script)
{
    for (const QString& step : script.split(QLatin1Char(' '), Qt::SkipEmptyParts)) {
        if (step == QLatin1String("hide"))
            HideCursor();
        else if (step == QLatin1String("obscure"))
            ObscureCursor();
        else if (step == QLatin1String("show"))
            ShowCursor();
        else if (step == QLatin1String("restore"))
            RestoreObscuredCursor();
        else if (step == QLatin1String("init"))
            InitCursor();
        else if (step == QLatin1String("remove"))
            RemoveOverrideCursor();
        else if (step.startsWith(QLatin1String("set:")))
            SetCCursor(GetCCursor(SInt16(step.mid(4).toInt())));
        else
            QFAIL(qPrintable(QStringLiteral("unknown step ") + step));
    }
}

QImage pictureOf(const QCursor& cursor)
{
    return cursor.pixmap().toImage().convertToFormat(QImage::Format_ARGB32);
}

} // namespace

class tst_Cursors : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void init() { drainOverrideStack(); }

    void overrideStack_data()
    {
        QTest::addColumn<QString>("script");
        QTest::addColumn<QString>("stack"); // what is left, top first
        QTest::addColumn<bool>("obscured");

        const struct {
            const char* name;
            const char* script;
            const char* stack;
            bool obscured;
        } rows[] = {
            {"hide twice, show once", "hide hide show", "", false},
            {"hide again after show", "hide show hide", "blank", false},
            {"obscure twice, show pops one", "obscure obscure show", "blank", false},
            {"obscure twice, init clears all", "obscure obscure init", "", false},
            {"obscured", "obscure", "blank", true},
            {"restore when obscured", "obscure restore", "", false},
            {"restore when hidden only", "hide restore", "blank", false},
            {"show without hide", "set:1 show show", "ibeam", false},
            {"show pops the hide, not the cursor", "set:4 hide show", "wait", false},
            {"same shape once", "set:1 set:1", "ibeam", false},
            {"two IDs, one shape", "set:2 set:3", "cross", false},
            {"another shape replaces the last set", "set:1 set:0", "arrow", false},
            {"pictures replace too", "set:6608 set:6608", "picture", false},
            {"a set after a hide pushes", "set:1 hide show set:4", "wait ibeam", false},
            {"remove pops all", "set:1 set:4 set:0 remove", "", false},
            {"init after set", "set:4 init", "", false},
        };
        for (const auto& row : rows)
            QTest::newRow(row.name) << QString::fromLatin1(row.script)
                                    << QString::fromLatin1(row.stack) << row.obscured;
    }
    void overrideStack()
    {
        QFETCH(QString, script);
        QFETCH(QString, stack);
        QFETCH(bool, obscured);
        run(script);
        QCOMPARE(bool(CursorObscured()), obscured);
        QCOMPARE(drainOverrideStack(), stack);
    }

    void autoRestore()
    {
        SetThemeCursor(kThemeIBeamCursor);
        {
            AutoRestoreCursor restore;
            SetThemeCursor(kThemeWatchCursor);
            QCOMPARE(overrideShape(), Qt::WaitCursor);
        }
        QCOMPARE(drainOverrideStack(), QStringLiteral("ibeam"));
        {
            AutoRestoreCursor nothingPushed; // an empty stack stays empty
        }
    }

    // Activating or deactivating any window resets the cursor once a cursor call was made.
    void activationResetsCursor()
    {
        SetThemeCursor(kThemeWatchCursor);
        QVERIFY(Private::applicationHooks().initCursor == &InitCursor);
        QWidget widget;
        QEvent activate(QEvent::WindowActivate);
        QCoreApplication::sendEvent(&widget, &activate);
        QVERIFY(!QGuiApplication::overrideCursor());
    }

    void themeCursors_data()
    {
        QTest::addColumn<ThemeCursor>("theme");
        QTest::addColumn<int>("id");
        QTest::addColumn<Qt::CursorShape>("shape");

        // One row per rule; the theme-to-ID list itself is a table, not a rule to restate.
        QTest::newRow("a shape of Qt's") << ThemeCursor(4) << 1 << Qt::IBeamCursor;
        QTest::newRow("a picture of ours") << ThemeCursor(2) << 6609 << Qt::BitmapCursor;
        QTest::newRow("several themes, one cursor") << ThemeCursor(16) << 17 << Qt::SizeHorCursor;
        QTest::newRow("beyond the list: the arrow") << ThemeCursor(0xFFFFFFFFu) << 0 << Qt::ArrowCursor;
    }
    void themeCursors()
    {
        QFETCH(ThemeCursor, theme);
        QFETCH(int, id);
        QFETCH(Qt::CursorShape, shape);
        QCOMPARE(SetThemeCursor(theme), OSStatus(noErr));
        const QCursor* shown = QGuiApplication::overrideCursor();
        QVERIFY(shown);
        QCOMPARE(shown->shape(), shape);
        if (shape == Qt::BitmapCursor) {
            QCOMPARE(pictureOf(*shown), pictureOf(GetCCursor(SInt16(id))->getCursor()));
            QCOMPARE(shown->hotSpot(), QPoint(8, 8));
        }
        QCOMPARE(drainOverrideStack(), shapeName(shape));
    }

    void cursorsById_data()
    {
        QTest::addColumn<int>("id");
        QTest::addColumn<Qt::CursorShape>("shape");
        QTest::newRow("3 cross") << 3 << Qt::CrossCursor;
        QTest::newRow("2010 diagonal size") << 2010 << Qt::SizeFDiagCursor;
        QTest::newRow("13 picture") << 13 << Qt::BitmapCursor;
        QTest::newRow("no picture") << 12345 << Qt::ArrowCursor;
        QTest::newRow("negative ID") << -6608 << Qt::ArrowCursor;
    }
    void cursorsById()
    {
        QFETCH(int, id);
        QFETCH(Qt::CursorShape, shape);
        CursPtr* blackAndWhite = GetCursor(SInt16(id));
        CursPtr* colour = GetCCursor(SInt16(id));
        QVERIFY(blackAndWhite && colour && blackAndWhite != colour);
        QCOMPARE(blackAndWhite->getCursor().shape(), shape);
        QCOMPARE(colour->getCursor().shape(), shape);
        QCOMPARE(GetCursor(SInt16(id)), blackAndWhite);
        QCOMPARE(GetCCursor(SInt16(id)), colour);
    }

    // Every picture the library ships, both kinds, at both densities: 16x16 device-independent
    // pixels with the hot spot in the middle, the double-density one the same picture doubled.
    void shippedPictures_data()
    {
        QTest::addColumn<QString>("prefix");
        QTest::addColumn<int>("id");
        for (const char* prefix : {"crsr", "CURS"})
            for (int id : {13, 6608, 6609, 6610})
                QTest::addRow("%s_%d", prefix, id) << QString::fromLatin1(prefix) << id;
    }
    void shippedPictures()
    {
        QFETCH(QString, prefix);
        QFETCH(int, id);
        const QByteArray latin1 = prefix.toLatin1();
        const QLatin1String kind(latin1);
        const QCursor single = Private::loadCursorPicture(kind, SInt16(id), 1);
        const QCursor doubled = Private::loadCursorPicture(kind, SInt16(id), 2);
        for (const QCursor& cursor : {single, doubled}) {
            QCOMPARE(cursor.shape(), Qt::BitmapCursor);
            QCOMPARE(cursor.pixmap().deviceIndependentSize(), QSizeF(16, 16));
            QCOMPARE(cursor.hotSpot(), QPoint(8, 8));
        }
        const QImage picture = pictureOf(single);
        QVERIFY(picture.pixel(8, 8) != 0); // the point is drawn
        QImage twice = picture.scaled(32, 32);
        twice.setDevicePixelRatio(2);
        QCOMPARE(pictureOf(doubled), twice);
        QCOMPARE(Private::loadCursorPicture(kind, 12345, 2).shape(), Qt::ArrowCursor);
    }

    void records()
    {
        auto* mine = new CursPtr(QCursor(Qt::CrossCursor));
        QCOMPARE(mine->AddRef(), 2);
        QCOMPARE(mine->Release(), 1);
        mine->setCursor(QCursor(Qt::WaitCursor));
        SetCCursor(mine);
        QCOMPARE(overrideShape(), Qt::WaitCursor);
        DisposeCCursor(mine);
        QVERIFY(!Private::isLive(mine));

        // The table's records outlive any number of disposals.
        CursPtr* arrow = GetCCursor(0);
        DisposeCCursor(arrow);
        DisposeCCursor(arrow);
        QCOMPARE(arrow->Release(), 1);
        QVERIFY(Private::isLive(arrow));
        QCOMPARE(GetCCursor(0), arrow);
        QCOMPARE(arrow->getCursor().shape(), Qt::ArrowCursor);

        // Gone and made-up records are refused before they are read; null is ignored.
        VelmarTest::IgnoredAssertions asserts;
        int notACursor = 0;
        SetCCursor(mine);
        DisposeCCursor(mine);
        SetCCursor(reinterpret_cast<CursPtr*>(&notACursor));
        SetCCursor(nullptr);
        DisposeCCursor(nullptr);
        QCOMPARE(asserts.texts(), QStringList(3, QStringLiteral("IsValidCursor(cursor)")));
        QCOMPARE(drainOverrideStack(), QStringLiteral("wait"));
    }
};

VELMAR_APP_TEST_MAIN(tst_Cursors)
#include "tst_cursors.moc"
