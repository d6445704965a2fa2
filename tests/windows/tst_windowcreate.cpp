// Making windows: classic definition IDs and Carbon classes and attributes, what the window
// reports back, its Toolbox state, and what a hostile host can hand the calls.
#include "WindowTestSupport.h"

#include "windows/WindowVariants.h"

using namespace Velmar;
using namespace WindowTest;

using Asserts = VelmarTest::IgnoredAssertions;

class tst_WindowCreate : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void initTestCase() { SetLogCategory(kLogNotImpl | kLogWindowManagement, true); }

    void newCWindowProcIds_data()
    {
        QTest::addColumn<int>("procID");
        QTest::addColumn<bool>("goAway");
        QTest::addColumn<UInt32>("windowClass");
        QTest::addColumn<int>("variant");
        QTest::addColumn<bool>("closeButton");
        QTest::addColumn<bool>("modal");
        QTest::newRow("0 document") << 0 << true << UInt32(6) << 1 << true << false;
        QTest::newRow("1 modal") << 1 << false << UInt32(3) << 2 << false << true;
        // The first row for 5 wins: a movable modal, not the later document row.
        QTest::newRow("5 movable modal") << 5 << false << UInt32(4) << 3 << false << true;
        QTest::newRow("8 zoom document, no close box") << 8 << false << UInt32(6) << 7 << false << false;
        QTest::newRow("2 floating is a document") << 2 << true << UInt32(6) << 0 << true << false;
        QTest::newRow("1031 unknown: plain document") << 1031 << false << UInt32(6) << 7 << false << false;
        QTest::newRow("999 unknown") << 999 << false << UInt32(6) << 0 << false << false;
    }
    void newCWindowProcIds()
    {
        QFETCH(int, procID);
        QFETCH(bool, goAway);
        QFETCH(UInt32, windowClass);
        QFETCH(int, variant);
        QFETCH(bool, closeButton);
        QFETCH(bool, modal);
        const Rect bounds = R(100, 100, 160, 220);
        const unsigned char title[] = "\x05Hello";
        int refCon = 0;
        WindowRef w = NewCWindow(nullptr, &bounds, title, false, SInt16(procID), nullptr, goAway, &refCon);
        QVERIFY(w);
        UInt32 cls = 0;
        QCOMPARE(GetWindowClass(w, &cls), noErr);
        QCOMPARE(cls, windowClass);
        QCOMPARE(int(GetWVariant(w)), variant);
        QCOMPARE(w->windowFlags().testFlag(Qt::WindowCloseButtonHint), closeButton);
        QCOMPARE(w->windowModality() == Qt::ApplicationModal, modal);
        QCOMPARE(GetWRefCon(w), static_cast<void*>(&refCon));
        Str255 back;
        GetWTitle(w, back);
        QCOMPARE(QByteArray(reinterpret_cast<const char*>(back + 1), back[0]), QByteArray("Hello"));
        QVERIFY(!IsWindowVisible(w));
        QCOMPARE(FrontWindow(), w);
        DisposeWindow(w);
    }

    // The variant is that of the window definition a class and attribute set select; the
    // unsupported attributes never change it, unknown ones match no definition.
    void classAttributeVariants()
    {
        using Private::classAttributesVariant;
        const UInt32 unsupported = kWindowHideOnSuspendAttribute | kWindowNoShadowAttribute;
        const struct {
            UInt32 cls, attributes;
            int variant;
        } rows[] = {
            {1, 0, 4}, {2, 0, 5}, {3, 0, 2}, {16, 0, 1}, {13, 0, 0}, {4, 0, 3},
            {4, kWindowResizableAttribute, 6},
            {6, kWindowStandardDocumentAttributes, 7},
            {6, kWindowStandardDocumentAttributes | unsupported, 7},
            {6, kWindowCloseBoxAttribute | kWindowVerticalZoomAttribute, 2},
            {5, kWindowStandardFloatingAttributes, 1},
            {5, kWindowStandardFloatingAttributes | kWindowResizableAttribute | kWindowFullZoomAttribute, 15},
            {8, kWindowStandardDocumentAttributes, 15},
            {8, kWindowCloseBoxAttribute | kWindowVerticalZoomAttribute, 0}, // utility: full zoom only
            {6, kWindowNoTitleBarAttribute, 0},
            {3, kWindowCloseBoxAttribute, 0},
            {9, 0, 0},
        };
        for (const auto& row : rows) {
            QVERIFY2(classAttributesVariant(row.cls, row.attributes) == row.variant,
                     qPrintable(QStringLiteral("class %1 attributes %2").arg(row.cls).arg(row.attributes, 0, 16)));
        }
    }

    void classesAndAttributes()
    {
        VelmarTest::LogCapture log;
        Window floating(kFloatingWindowClass, kWindowSideTitlebarAttribute | kWindowNoShadowAttribute,
                        R(0, 0, 50, 50));
        UInt32 cls = 0;
        GetWindowClass(floating, &cls);
        QCOMPARE(cls, UInt32(kDocumentWindowClass));
        QVERIFY(log.contains("CreateNewWindow: kWindowSideTitlebarAttribute is not implemented"));
        QVERIFY(log.contains("CreateNewWindow: kWindowNoShadowAttribute is not implemented"));
        Window plain(kPlainWindowClass, kWindowResizableAttribute, R(0, 0, 50, 50));
        QVERIFY(!plain->IsResizeable());
        QVERIFY(plain->windowFlags().testFlag(Qt::MSWindowsFixedSizeDialogHint));
        QVERIFY(!plain->windowFlags().testFlag(Qt::WindowTitleHint));
        Window document(kDocumentWindowClass, kWindowStandardDocumentAttributes, R(0, 0, 50, 50));
        QVERIFY(document->IsResizeable());
        const Qt::WindowFlags f = document->windowFlags();
        QVERIFY(f.testFlag(Qt::WindowMaximizeButtonHint) && f.testFlag(Qt::WindowMinimizeButtonHint)
                && f.testFlag(Qt::WindowCloseButtonHint));
        Window frameless(kDocumentWindowClass, kWindowNoTitleBarAttribute, R(0, 0, 50, 50));
        QVERIFY(frameless->windowFlags().testFlag(Qt::FramelessWindowHint));
        QVERIFY(!frameless->windowFlags().testFlag(Qt::WindowTitleHint));
    }

    // Empty, negative and huge bounds give a usable window, with a log line.
    void sizesAreClamped()
    {
        VelmarTest::LogCapture log;
        Window empty(R(10, 10, 10, 10));
        QCOMPARE(empty->size(), QSize(1, 1));
        Window huge(R(-32768, -32768, 32767, 32767));
        QCOMPARE(huge->size(), QSize(Private::kMaxWindowSide, Private::kMaxWindowSide));
        QVERIFY(huge->GetPort()->image());
        SizeWindow(huge, -5, 20, true);
        QCOMPARE(huge->size(), QSize(1, 20));
        QCOMPARE(log.count("window size"), 3);
    }

    void propertiesAndStates()
    {
        Window w(R(0, 0, 40, 40));
        const char value[] = "abcdef";
        QCOMPARE(SetWindowProperty(w, FOUR_CHAR_CODE("Velm"), FOUR_CHAR_CODE("test"), 6, value), noErr);
        char buffer[4] = {};
        UInt32 size = 0;
        QCOMPARE(GetWindowProperty(w, FOUR_CHAR_CODE("Velm"), FOUR_CHAR_CODE("test"), 3, &size, buffer), noErr);
        QCOMPARE(QByteArray(buffer, 3), QByteArray("abc"));
        QCOMPARE(size, 6u);
        QCOMPARE(GetWindowProperty(w, FOUR_CHAR_CODE("Velm"), FOUR_CHAR_CODE("none"), 3, &size, buffer), OSStatus(errWindowPropertyNotFound));
        const Rect zoom = R(10, 20, 110, 220);
        SetWindowStandardState(w, &zoom);
        SetWindowUserState(w, nullptr);
        Rect back;
        QVERIFY(Private::sameRect(*GetWindowStandardState(w, &back), zoom));
        QVERIFY(Private::sameRect(*GetWindowUserState(w, &back), R(0, 0, 0, 0)));
        SetWindowKind(w, 8);
        QCOMPARE(GetWindowKind(w), SInt16(8));
        QCOMPARE(GetWindowFromPort(GetWindowPort(w)), WindowRef(w));
    }

    // Null and disposed references are answered -5600 (or nothing), silently; a pointer that
    // never was a window, or was deleted, is also an assertion.
    void unusableReferences()
    {
        WindowRef disposed;
        const Rect bounds = R(0, 0, 30, 30);
        CreateNewWindow(kDocumentWindowClass, 0, &bounds, &disposed);
        DisposeWindow(disposed);
        QVERIFY(disposed->IsDeletePending());
        int notAWindow = 0;
        const WindowRef madeUp(reinterpret_cast<AQtWindow*>(&notAWindow));
        for (const WindowRef& w : {WindowRef(), disposed, madeUp}) {
            Asserts asserts;
            Rect r = bounds;
            UInt32 cls = 0;
            RgnHandle rgn = NewRgn();
            QCOMPARE(InvalWindowRect(w, &r), OSStatus(errInvalidWindowPtr));
            QCOMPARE(ValidWindowRgn(w, rgn), OSStatus(errInvalidWindowPtr));
            QCOMPARE(GetWindowBounds(w, kWindowContentRgn, &r), OSStatus(errInvalidWindowPtr));
            QCOMPARE(GetWindowRegion(w, kWindowUpdateRgn, rgn), OSStatus(errInvalidWindowPtr));
            QCOMPARE(GetWindowClass(w, &cls), OSStatus(errInvalidWindowPtr));
            QCOMPARE(SetWindowProperty(w, 1, 2, 0, nullptr), OSStatus(errInvalidWindowPtr));
            QCOMPARE(ActivateWindow(w, true), OSStatus(errInvalidWindowPtr));
            ShowWindow(w);
            MoveWindow(w, 5, 5, true);
            SizeWindow(w, 5, 5, true);
            BeginUpdate(w);
            EndUpdate(w);
            SelectWindow(w);
            SendBehind(w, nullptr);
            DisposeWindow(w);
            QCOMPARE(GetWindowPort(w), nullptr);
            QCOMPARE(GetNextWindow(w), nullptr);
            QCOMPARE(GetWVariant(w), SInt16(0));
            DisposeRgn(rgn);
            const QStringList texts = asserts.texts();
            if (w == madeUp)
                QVERIFY(!texts.isEmpty() && QSet<QString>(texts.begin(), texts.end()) == QSet<QString>{"IsValidWindow(window)"});
            else
                QCOMPARE(asserts.count(), 0);
        }
        QTRY_VERIFY(!Private::isLive(disposed.get()));
    }

    // A window deleted behind the library's back is reported, and nothing keeps its events.
    void deletingWithoutDispose()
    {
        Asserts asserts;
        WindowRef w;
        const Rect bounds = R(0, 0, 30, 30);
        CreateNewWindow(kDocumentWindowClass, 0, &bounds, &w);
        PostEvent(12, 1);
        Private::gMainEventQueue.items().back()->window = w;
        delete w.get();
        QCOMPARE(asserts.texts(), QStringList{"m_deletePending"});
        QCOMPARE(Private::gMainEventQueue.count(), 0u);
        QCOMPARE(FrontWindow(), nullptr);
    }
};

VELMAR_APP_TEST_MAIN(tst_WindowCreate)
#include "tst_windowcreate.moc"
