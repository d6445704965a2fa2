// The window list and its order, the user focus window, and geometry and hit testing with the
// window system's frame and with the shell's own frame (the decorated mode).
#include "WindowTestSupport.h"
#include "WindowSystemNeeds.h"

#include "host/FrameDecorator.h"

#include <memory>

using namespace Velmar;
using namespace WindowTest;

namespace {

QStringList order()
{
    QStringList out;
    for (WindowRef w = FrontWindow(); w; w = GetNextWindow(w))
        out << w->windowTitle();
    return out;
}

void name(WindowRef w, const char* title)
{
    w->setWindowTitle(QString::fromLatin1(title));
}

} // namespace

class tst_WindowList : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void init() { Private::gMainEventQueue.clearAll(); }

    // New windows open in front; SendBehind moves in the list, including its deliberate cases.
    void listOrder()
    {
        Window a(R(0, 0, 30, 30)), b(R(0, 0, 30, 30)), c(R(0, 0, 30, 30));
        name(a, "a"), name(b, "b"), name(c, "c");
        QCOMPARE(order(), (QStringList{"c", "b", "a"}));
        SendBehind(c, nullptr); // not last: to the back
        QCOMPARE(order(), (QStringList{"b", "a", "c"}));
        SendBehind(c, nullptr); // already last: to the front, deliberately
        QCOMPARE(order(), (QStringList{"c", "b", "a"}));
        SendBehind(c, b);
        QCOMPARE(order(), (QStringList{"b", "c", "a"}));
        b.show();
        SendBehind(b, a); // a visible window behind a hidden one: the list only
        QCOMPARE(order(), (QStringList{"c", "a", "b"}));
        QVERIFY(b->isVisible());
        QCOMPARE(GetNextWindow(b), nullptr);
        QCOMPARE(GetWindowList(), FrontWindow());
    }

    // A modal window keeps the user focus from non-modal ones; modal windows take it from
    // each other.
    void userFocusModalRules()
    {
        Window doc(R(100, 100, 150, 150)), modal1(kMovableModalWindowClass, 0, R(100, 100, 150, 150)),
            modal2(kMovableModalWindowClass, 0, R(100, 100, 150, 150));
        doc.show(), modal1.show(), modal2.show();
        QCOMPARE(SetUserFocusWindow(modal1), noErr);
        QCOMPARE(GetUserFocusWindow(), WindowRef(modal1));
        QCOMPARE(SetUserFocusWindow(doc), noErr);
        QCOMPARE(GetUserFocusWindow(), WindowRef(modal1));
        SetUserFocusWindow(modal2);
        QCOMPARE(GetUserFocusWindow(), WindowRef(modal2));
        HideWindow(modal2);
        HideWindow(modal1);
        SetUserFocusWindow(doc);
        QCOMPARE(GetUserFocusWindow(), WindowRef(doc));
        int notAWindow = 0;
        VelmarTest::ScriptedAutomationListener ignore({}, QStringLiteral("Ignore"));
        QCOMPARE(SetUserFocusWindow(WindowRef(reinterpret_cast<AQtWindow*>(&notAWindow))),
                 OSStatus(errInvalidWindowPtr));
        bool dynView = false;
        QWidget plain;
        QCOMPARE(GetWindowRefFromWidget(&plain, &dynView), nullptr);
        doc->SetDynViewProperty(true);
        QCOMPARE(GetWindowRefFromWidget(doc.get(), &dynView), WindowRef(doc));
        QVERIFY(dynView);
        QCOMPARE(GetWindowRefFromNative(GetNativeWindowFromWidget(doc.get())), WindowRef(doc));
    }

    // Geometry and hit testing, with the window system's frame and with the shell's.
    void geometryAndFindWindow_data()
    {
        QTest::addColumn<bool>("decorated");
        QTest::newRow("window system frame") << false;
        QTest::newRow("shell frame") << true;
    }
    void geometryAndFindWindow()
    {
        VELMAR_REQUIRE_X11("windows at screen positions");
        QFETCH(bool, decorated);
        std::unique_ptr<Brindle::DecorationManager> shell;
        if (decorated)
            shell = std::make_unique<Brindle::DecorationManager>(nullptr, Brindle::DecorationManager::kMdiDecorated);
        Window w(kDocumentWindowClass, kWindowStandardDocumentAttributes, R(200, 150, 300, 350));
        w.show();
        QCOMPARE(w->GetDecorator() != nullptr, decorated);
        Rect content, frame;
        QCOMPARE(GetWindowBounds(w, kWindowContentRgn, &content), noErr);
        QCOMPARE(GetWindowBounds(w, kWindowStructureRgn, &frame), noErr);
        QCOMPARE(Private::rectWidth(content), 200);
        QCOMPARE(Private::rectHeight(content), 100);
        const QPoint onScreen = w->mapToGlobal(QPoint(0, 0));
        QCOMPARE(QPoint(content.left, content.top), onScreen);
        QVERIFY(frame.top <= content.top && frame.left <= content.left);

        WindowRef hit = nullptr;
        const auto at = [](int h, int v) { return Point{SInt16(v), SInt16(h)}; };
        QCOMPARE(FindWindow(at(content.left + 10, content.top + 10), &hit), WindowPartCode(inContent));
        QCOMPARE(hit, WindowRef(w));
        QCOMPARE(FindWindow(at(content.right - 2, content.bottom - 2), &hit), WindowPartCode(inGrow));
        if (frame.top < content.top) {
            hit = nullptr;
            QCOMPARE(FindWindow(at(content.left + 10, frame.top + 1), &hit), WindowPartCode(inDesk));
            QCOMPARE(hit, WindowRef(w)); // the title bar answers 0 but names the window
        }
        hit = nullptr;
        QCOMPARE(FindWindow(at(5, 790), &hit), WindowPartCode(inDesk));
        QCOMPARE(hit, nullptr);

        // MoveWindow places the content; with the shell's frame the top stays reachable.
        MoveWindow(w, 40, 60, false);
        QTRY_COMPARE(w->mapToGlobal(QPoint(0, 0)), QPoint(40, 60));
        MoveWindow(w, -20, -300, false);
        GetWindowBounds(w, kWindowContentRgn, &content);
        QCOMPARE(content.left, SInt16(-20));
        if (decorated) {
            GetWindowBounds(w, kWindowStructureRgn, &frame);
            QCOMPARE(int(frame.top), w->ReferenceOrigin().y());
        }
        // Zooming to the standard state and back.
        const Rect standard = R(100, 100, 300, 500);
        SetWindowStandardState(w, &standard);
        ZoomWindow(w, inZoomOut, false);
        GetWindowBounds(w, kWindowContentRgn, &content);
        QVERIFY(Private::sameRect(content, standard));
        QCOMPARE(SetWindowBounds(w, 99, &standard), OSStatus(unimpErr));
        RgnHandle rgn = NewRgn();
        QCOMPARE(GetWindowRegion(w, 99, rgn), OSStatus(errNullWindowArgument));
        DisposeRgn(rgn);
    }
};

VELMAR_APP_TEST_MAIN(tst_WindowList)
#include "tst_windowlist.moc"
