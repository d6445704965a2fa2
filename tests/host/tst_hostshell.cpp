// Default UI-shell services: palette, decoration manager, managed windows, left button.
#include "TestSupport.h"

#include <Velmar/HostShell.h>

#include <QWidget>

#include <memory>

using namespace Velmar;
using Brindle::DecorationManager;
using Brindle::ManagedWindow;
using Palette::PaletteManager;

namespace {

class TestWindow : public ManagedWindow {
public:
    explicit TestWindow(QWidget* widget) : m_widget(widget) {}
    QWidget* GetWidget() override { return m_widget; }
    void GetWindowProperties(Properties& p) override { p.set(kPropertyDocument); }
    const Brindle::DecorationState* GetDecorationState() override { return &m_state; }

private:
    QWidget* m_widget;
    Brindle::DecorationState m_state;
};

// A shell frame 20 pixels high above the content, in an area starting at (100, 50).
class TestDecorator : public Brindle::Decorator {
public:
    QPoint ReferenceOrigin() const override { return QPoint(100, 50); }
    QRect FrameGeometry() const override { return content.adjusted(0, -20, 0, 0); }
    QRect ContentGeometry() const override { return content; }
    void SetFrameGeometry(const QRect& f) override { content = f.adjusted(0, 20, 0, 0); }
    void SetContentGeometry(const QRect& c) override { content = c; }
    void MoveContent(const QPoint& p) override { content.moveTopLeft(p); }
    void SetContentSize(const QSize& s) override { content.setSize(s); }
    void SetTitle(const QString& t) override { title = t; }
    void SelectWindow() override { ++selections; }
    QRect content = QRect(0, 20, 200, 100);
    QString title;
    int selections = 0;
};

class RecordingManager : public DecorationManager {
public:
    RecordingManager(QMenuBar* bar, int mode) : DecorationManager(bar, mode) {}
    void Decorate(ManagedWindow* w) override { decorated.append(w); }
    void Undecorate(ManagedWindow* w) override { undecorated.append(w); }
    QWidget* HiddenDefaultParent() const override { return parent; }
    QList<ManagedWindow*> decorated, undecorated;
    QWidget* parent = nullptr;
};

DecorationManager* recordingFactory(QMenuBar* bar, int mode) { return new RecordingManager(bar, mode); }

bool buttonHeld() { return true; }
void countMove(ManagedWindow*, void* context) { ++*static_cast<int*>(context); }

} // namespace

class HostShellTest : public QObject {
    Q_OBJECT
private Q_SLOTS:
    void palette()
    {
        // Empty by default: callers keep their defaults.
        UInt16 number = 77;
        QString text = QStringLiteral("mine");
        QVERIFY(!PaletteManager::Instance()->GetUint16(QStringLiteral("WindowHighlightFrameWidth"), number));
        QVERIFY(!PaletteManager::Instance()->GetString(QStringLiteral("AppFontNameWin"), text));
        QCOMPARE(number, UInt16(77));
        QCOMPARE(text, QStringLiteral("mine"));

        PaletteManager mine;
        mine.SetColor(QStringLiteral("Frame"), RGBColor(65535, 32768, 1));
        mine.SetUint16(QStringLiteral("Width"), 3);
        mine.SetSInt32(QStringLiteral("Offset"), -4);
        mine.SetString(QStringLiteral("AppFontNameWin"), QStringLiteral("Tahoma"));
        PaletteManager* previous = PaletteManager::SetInstance(&mine);
        const PaletteManager* palette = PaletteManager::Instance();
        RGBColor colour;
        QVERIFY(palette->GetTxRGBColorBasedOnHighlightIndex(QStringLiteral("Frame"), colour));
        QCOMPARE(colour.red, (unsigned short)65535);
        QCOMPARE(colour.green, (unsigned short)32768);
        QCOMPARE(colour.blue, (unsigned short)1);
        UInt16 width = 0;
        QVERIFY(palette->GetUint16(QStringLiteral("Width"), width));
        QCOMPARE(width, UInt16(3));
        SInt32 offset = 0;
        QVERIFY(palette->GetSInt32(QStringLiteral("Offset"), offset));
        QCOMPARE(offset, SInt32(-4));
        QVERIFY(palette->GetString(QStringLiteral("AppFontNameWin"), text));
        QCOMPARE(text, QStringLiteral("Tahoma"));

        // A value is only found as what it is.
        UInt16 u = 9;
        QVERIFY(!palette->GetUint16(QStringLiteral("Offset"), u)); // negative: no 16-bit reading
        QVERIFY(!palette->GetUint16(QStringLiteral("AppFontNameWin"), u));
        QVERIFY(!palette->GetString(QStringLiteral("Width"), text));
        QVERIFY(!palette->GetTxRGBColorBasedOnHighlightIndex(QStringLiteral("Width"), colour));
        QCOMPARE(u, UInt16(9));
        mine.Remove(QStringLiteral("Width"));
        QVERIFY(!palette->GetUint16(QStringLiteral("Width"), width));

        QCOMPARE(PaletteManager::SetInstance(nullptr), &mine);
        QCOMPARE(PaletteManager::Instance(), previous);
        QVERIFY(!PaletteManager::Instance()->GetString(QStringLiteral("AppFontNameWin"), text));
    }

    void decorationManagers()
    {
        QVERIFY(!DecorationManager::Instance());
        {
            DecorationManager outer(nullptr, DecorationManager::kMdiNative);
            QCOMPARE(DecorationManager::Instance(), &outer);
            QVERIFY(!DecorationManager::GetHiddenDefaultParent());
            {
                RecordingManager inner(nullptr, 0);
                QWidget hidden;
                inner.parent = &hidden;
                QCOMPARE(DecorationManager::Instance(), static_cast<DecorationManager*>(&inner));
                QCOMPARE(DecorationManager::GetHiddenDefaultParent(), &hidden);
            }
            QCOMPARE(DecorationManager::Instance(), &outer);
        }
        QVERIFY(!DecorationManager::Instance());

        // The factory: replaced, handed back, and null restores the default.
        QVERIFY(DecorationManager::SetFactory(recordingFactory) != recordingFactory);
        std::unique_ptr<DecorationManager> made(DecorationManager::Create(nullptr, 0));
        QVERIFY(dynamic_cast<RecordingManager*>(made.get()));
        made.reset();
        QVERIFY(DecorationManager::SetFactory(nullptr) == recordingFactory);
        made.reset(DecorationManager::Create(nullptr, 2));
        QVERIFY(!dynamic_cast<RecordingManager*>(made.get()));
        QCOMPARE(made->MdiMode(), 2);
    }

    void windowWithoutDecorator()
    {
        QWidget widget;
        widget.setGeometry(10, 20, 120, 80);
        TestWindow window(&widget);
        int moves = 0;
        window.InstallManagedWindowHasMovedHandler(countMove, &moves);

        QCOMPARE(window.GetTopWindow(), &widget);
        QCOMPARE(window.ReferenceOrigin(), QPoint(0, 0));
        QCOMPARE(window.ContentGeometry(), QRect(10, 20, 120, 80));
        QVERIFY(!window.IsGrowBoxIconDrawnByDecorator());
        window.MoveWindow(QPoint(200, 150));
        QCOMPARE(window.ContentGeometry().topLeft(), QPoint(200, 150));
        window.SetContentSize(QSize(300, 40));
        QCOMPARE(widget.size(), QSize(300, 40));
        window.SetContentGeometry(QRect(5, 6, 70, 80));
        QCOMPARE(window.ContentGeometry(), QRect(5, 6, 70, 80));
        QCOMPARE(moves, 2);
    }

    void windowWithDecorator()
    {
        QWidget widget;
        TestWindow window(&widget);
        TestDecorator decorator;
        window.SetDecorator(&decorator);
        int moves = 0;
        window.InstallManagedWindowHasMovedHandler(countMove, &moves);

        QCOMPARE(window.ReferenceOrigin(), QPoint(100, 50));
        QVERIFY(window.IsGrowBoxIconDrawnByDecorator());
        window.MoveWindow(QPoint(30, 40));
        QCOMPARE(window.FrameGeometry(), QRect(30, 20, 200, 120));
        window.SetFrameGeometry(QRect(0, 0, 50, 60));
        QCOMPARE(window.ContentGeometry(), QRect(0, 20, 50, 40));
        window.SetContentSize(QSize(11, 12));
        QCOMPARE(decorator.content.size(), QSize(11, 12));
        window.SelectWindow();
        QCOMPARE(decorator.selections, 1);
        QCOMPARE(moves, 2);
    }

    void childWidgetWindow()
    {
        QWidget top;
        top.setGeometry(300, 200, 400, 300);
        auto* child = new QWidget(&top);
        child->setGeometry(10, 30, 100, 50);
        TestWindow window(child);
        QCOMPARE(window.GetTopWindow(), &top);
        QCOMPARE(window.ContentGeometry(), QRect(310, 230, 100, 50));
        // Moving the content moves the whole top-level window with it.
        window.MoveWindow(QPoint(320, 260));
        QCOMPARE(window.ContentGeometry().topLeft(), QPoint(320, 260));
        QCOMPARE(child->pos(), QPoint(10, 30));
    }

    void visibilityAndClosing()
    {
        RecordingManager manager(nullptr, 0);
        QWidget widget;
        widget.resize(50, 50);
        TestWindow window(&widget);
        TestDecorator decorator;
        window.SetDecorator(&decorator);
        QVERIFY(!window.IsCurrentlyVisible());
        window.SetWindowVisible(true);
        QVERIFY(window.IsCurrentlyVisible());
        window.CloseWindow();
        QVERIFY(!window.IsCurrentlyVisible());
        QVERIFY(!window.GetDecorator());
        QCOMPARE(manager.undecorated, QList<ManagedWindow*>{&window});

        TestWindow orphan(nullptr); // a window whose widget is gone answers safely
        QVERIFY(!orphan.GetTopWindow());
        QVERIFY(orphan.ContentGeometry().isNull());
        orphan.MoveWindow(QPoint(1, 1));
        orphan.SetFrameGeometry(QRect(0, 0, 5, 5));
        orphan.SelectAndShow();
        QVERIFY(!orphan.IsCurrentlyVisible());
    }

    void leftButtonSource()
    {
        QVERIFY(!Brindle::isLeftButtonDown_sys()); // nobody holds a button on the test display
        Brindle::SetLeftButtonSource(buttonHeld);
        QVERIFY(Brindle::isLeftButtonDown_sys());
        QVERIFY(Brindle::SetLeftButtonSource(nullptr) == buttonHeld);
        QVERIFY(!Brindle::isLeftButtonDown_sys());
    }
};

VELMAR_TEST_MAIN(HostShellTest)
#include "tst_hostshell.moc"
