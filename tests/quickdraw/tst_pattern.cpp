// Patterns: bit order and phase, recolouring with the port's colours, pen-mode composition,
// brush caching and the PatPtr value semantics.
#include <Velmar/Diagnostics.h>
#include <Velmar/QtGrafPort.h>
#include <Velmar/QuickDraw.h>

#include "TestSupport.h"
#include "foundation/Conversions.h"
#include "quickdraw/PortPainter.h"

#include <QImage>

using namespace Velmar;
using Velmar::Private::makeRect;

namespace {

const QRgb kInk = qRgb(255, 0, 0);
const QRgb kPaper = qRgb(0, 0, 255);
const QRgb kUnderneath = qRgb(0, 255, 0);

GrafPtr newInkedWorld(int size)
{
    const Rect r = makeRect(0, 0, size, size);
    GrafPtr world = nullptr;
    NewGWorld(&world, 32, &r, nullptr, nullptr, 0);
    SetPort(world);
    const RGBColor ink(65535, 0, 0);
    const RGBColor paper(0, 0, 65535);
    RGBForeColor(&ink);
    RGBBackColor(&paper);
    return world;
}

// Paints `local` with the port's fill brush, as the Paint calls do.
void paint(GrafPtr port, const QRect& local)
{
    MakeQPainter p("test");
    p->fillRect(local, Private::resolvedFillBrush(port));
    p |= local;
}

// Row masks as text, '#' for a foreground pixel: derived from the pixels, not the code.
QStringList inkRows(GrafPtr port, QPoint deviceOrigin = QPoint())
{
    QStringList rows;
    for (int y = 0; y < 8; ++y) {
        QString row;
        for (int x = 0; x < 8; ++x)
            row += port->image()->pixel(deviceOrigin + QPoint(x, y)) == kInk ? QLatin1Char('#')
                                                                                : QLatin1Char('.');
        rows << row;
    }
    return rows;
}

// The documented rule: the pixel at (x, y) takes the ink when bit (x mod 8) of the
// complement of row (y mod 8) is set.
bool ruleSaysInk(const Pattern& p, int x, int y)
{
    return ((~p.pat[y & 7]) >> (x & 7)) & 1;
}

} // namespace

class TestPattern : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void init()
    {
        SetLogCategory(kLogQuickDraw | kLogGrafPort, true);
        SetPort(nullptr);
    }

    void standardPatternPixels_data()
    {
        QTest::addColumn<int>("which");
        QTest::addColumn<QStringList>("rows");
        const QString grayEven = QStringLiteral(".#.#.#.#");
        const QString grayOdd = QStringLiteral("#.#.#.#.");
        const QString lightEven = QStringLiteral("#.###.##");
        const QString lightOdd = QStringLiteral("###.###.");
        const QString darkEven = QStringLiteral(".#...#..");
        const QString darkOdd = QStringLiteral("...#...#");
        QTest::newRow("gray") << 0
                              << QStringList{grayEven, grayOdd, grayEven, grayOdd,
                                             grayEven, grayOdd, grayEven, grayOdd};
        QTest::newRow("light gray") << 1
                                    << QStringList{lightEven, lightOdd, lightEven, lightOdd,
                                                   lightEven, lightOdd, lightEven, lightOdd};
        QTest::newRow("dark gray") << 2
                                   << QStringList{darkEven, darkOdd, darkEven, darkOdd,
                                                  darkEven, darkOdd, darkEven, darkOdd};
    }
    void standardPatternPixels()
    {
        QFETCH(int, which);
        QFETCH(QStringList, rows);
        GrafPtr world = newInkedWorld(24);
        Pattern bytes;
        const PatPtr& pattern = which == 0   ? GetQDGlobalsGray(&bytes)
                                : which == 1 ? GetQDGlobalsLightGray(&bytes)
                                             : GetQDGlobalsDarkGray(&bytes);
        PenPat(pattern);
        paint(world, QRect(0, 0, 24, 24));
        QCOMPARE(inkRows(world), rows);
        // Every pixel is ink or paper, the pattern repeats every 8 pixels, and it follows
        // the rule for the bytes.
        for (int y = 0; y < 24; ++y)
            for (int x = 0; x < 24; ++x) {
                const QRgb px = world->image()->pixel(x, y);
                QCOMPARE(px, ruleSaysInk(bytes, x, y) ? kInk : kPaper);
            }
        DisposeGWorld(world);
    }

    void anyPatternFollowsTheBitRule()
    {
        GrafPtr world = newInkedWorld(8);
        const Pattern p{{0x01, 0x02, 0x80, 0x0F, 0xF0, 0x3C, 0x81, 0x7E}};
        PenPat(&p);
        paint(world, QRect(0, 0, 8, 8));
        for (int y = 0; y < 8; ++y)
            for (int x = 0; x < 8; ++x)
                QCOMPARE(world->image()->pixel(x, y), ruleSaysInk(p, x, y) ? kInk : kPaper);
        // Bit 0 of 0x01 is set, so the complement clears it: the leftmost pixel is paper.
        QCOMPARE(world->image()->pixel(0, 0), kPaper);
        QCOMPARE(world->image()->pixel(1, 0), kInk);
        DisposeGWorld(world);
    }

    void phaseIsAnchoredAtLocalZero()
    {
        GrafPtr world = newInkedWorld(32);
        Pattern bytes;
        PenPat(GetQDGlobalsLightGray(&bytes));
        SetOrigin(3, 5);
        // Painting only part of the port does not shift the pattern either.
        paint(world, QRect(10, 9, 20, 20));
        for (int y = 9; y < 29; ++y)
            for (int x = 10; x < 30; ++x)
                QCOMPARE(world->image()->pixel(x - 3, y - 5),
                         ruleSaysInk(bytes, x, y) ? kInk : kPaper);
        DisposeGWorld(world);
    }

    void solidPatterns()
    {
        GrafPtr world = newInkedWorld(4);
        PenPat(GetQDGlobalsBlack(nullptr));
        paint(world, QRect(0, 0, 2, 4));
        PenPat(GetQDGlobalsWhite(nullptr));
        paint(world, QRect(2, 0, 2, 4));
        QCOMPARE(world->image()->pixel(0, 0), kInk);
        QCOMPARE(world->image()->pixel(3, 3), kPaper);
        // Other solid colours are kept as they are.
        PenPat(PatPtr(QBrush(QColor(10, 20, 30))));
        paint(world, QRect(0, 0, 1, 1));
        QCOMPARE(world->image()->pixel(0, 0), qRgb(10, 20, 30));
        Pattern bytes;
        GetQDGlobalsBlack(&bytes);
        QCOMPARE(QByteArray(reinterpret_cast<const char*>(bytes.pat), 8), QByteArray(8, '\xFF'));
        GetQDGlobalsWhite(&bytes);
        QCOMPARE(QByteArray(reinterpret_cast<const char*>(bytes.pat), 8), QByteArray(8, '\0'));
        GetQDGlobalsDarkGray(&bytes);
        QCOMPARE(bytes.pat[0], UInt8(0xDD));
        QCOMPARE(bytes.pat[1], UInt8(0x77));
        QCOMPARE(GetQDGlobalsBlack(nullptr).brush()->style(), Qt::SolidPattern);
        QCOMPARE(GetQDGlobalsBlack(nullptr).brush()->color(), QColor(Qt::black));
        QCOMPARE(GetQDGlobalsWhite(nullptr).brush()->color(), QColor(Qt::white));
        DisposeGWorld(world);
    }

    void patOrLeavesPaperUntouched()
    {
        GrafPtr world = newInkedWorld(16);
        world->image()->fill(kUnderneath);
        Pattern bytes;
        PenPat(GetQDGlobalsGray(&bytes));
        PenMode(patOr);
        paint(world, QRect(0, 0, 16, 16));
        for (int y = 0; y < 16; ++y)
            for (int x = 0; x < 16; ++x)
                QCOMPARE(world->image()->pixel(x, y), ruleSaysInk(bytes, x, y) ? kInk : kUnderneath);
        // patCopy gives the paper the back colour.
        world->image()->fill(kUnderneath);
        PenMode(patCopy);
        paint(world, QRect(0, 0, 16, 16));
        for (int y = 0; y < 16; ++y)
            for (int x = 0; x < 16; ++x)
                QCOMPARE(world->image()->pixel(x, y), ruleSaysInk(bytes, x, y) ? kInk : kPaper);
        DisposeGWorld(world);
    }

    void xorModesUndoThemselves_data()
    {
        QTest::addColumn<int>("mode");
        QTest::newRow("patXor") << int(patXor);
        QTest::newRow("srcXor") << int(srcXor);
    }
    void xorModesUndoThemselves()
    {
        QFETCH(int, mode);
        GrafPtr world = newInkedWorld(16);
        for (int y = 0; y < 16; ++y)
            for (int x = 0; x < 16; ++x)
                world->image()->setPixel(x, y, qRgb(x * 16, y * 16, 77));
        const QImage before = world->image()->copy();
        PenMode(SInt16(mode));
        paint(world, QRect(2, 2, 10, 10));
        // Not-source-XOR-destination, opaque: each channel becomes ~(ink ^ old).
        for (int y = 0; y < 16; ++y)
            for (int x = 0; x < 16; ++x) {
                const QRgb old = before.pixel(x, y);
                const bool inside = QRect(2, 2, 10, 10).contains(x, y);
                const QRgb expected = inside ? (~(kInk ^ old) & 0x00FFFFFFu) | 0xFF000000u : old;
                QCOMPARE(world->image()->pixel(x, y), expected);
            }
        paint(world, QRect(2, 2, 10, 10));
        QCOMPARE(*world->image(), before);
        DisposeGWorld(world);
    }

    void patBicDrawsBehindOpaquePixels()
    {
        GrafPtr world = newInkedWorld(8);
        world->image()->fill(kUnderneath);
        PenMode(patBic);
        paint(world, QRect(0, 0, 8, 8));
        QCOMPARE(world->image()->pixel(4, 4), kUnderneath);
        // Where the image is transparent the ink shows.
        world->image()->setPixel(1, 1, 0);
        paint(world, QRect(0, 0, 8, 8));
        QCOMPARE(world->image()->pixel(1, 1), kInk);
        DisposeGWorld(world);
    }

    void backgroundBrush()
    {
        GrafPtr world = newInkedWorld(16);
        {
            MakeQPainter p("test");
            p->fillRect(QRect(0, 0, 16, 16), Private::resolvedBackgroundBrush(world));
        }
        QCOMPARE(world->image()->pixel(5, 5), kPaper); // solid white -> back colour
        Pattern bytes;
        BackPat(GetQDGlobalsDarkGray(&bytes));
        PenMode(patOr); // erasing never leaves paper transparent
        world->image()->fill(kUnderneath);
        {
            MakeQPainter p("test");
            p->fillRect(QRect(0, 0, 16, 16), Private::resolvedBackgroundBrush(world));
        }
        for (int y = 0; y < 16; ++y)
            for (int x = 0; x < 16; ++x)
                QCOMPARE(world->image()->pixel(x, y), ruleSaysInk(bytes, x, y) ? kInk : kPaper);
        DisposeGWorld(world);
    }

    void recolouredBrushesAreCached()
    {
        GrafPtr world = newInkedWorld(8);
        PenPat(GetQDGlobalsGray(nullptr));
        const qint64 first = Private::resolvedFillBrush(world).texture().cacheKey();
        QCOMPARE(Private::resolvedFillBrush(world).texture().cacheKey(), first);
        const RGBColor other(0, 65535, 0);
        RGBForeColor(&other);
        const qint64 second = Private::resolvedFillBrush(world).texture().cacheKey();
        QVERIFY(second != first);
        const RGBColor ink(65535, 0, 0);
        RGBForeColor(&ink);
        // Back to the first colours: the process-wide cache gives the same texture again.
        QCOMPARE(Private::resolvedFillBrush(world).texture().cacheKey(), first);
        // A second port with the same pattern and colours shares it as well.
        GrafPtr world2 = newInkedWorld(8);
        PenPat(GetQDGlobalsGray(nullptr));
        QCOMPARE(Private::resolvedFillBrush(world2).texture().cacheKey(), first);
        DisposeGWorld(world2);
        DisposeGWorld(world);
    }

    void directPainterChangesNeedInkChanged()
    {
        GrafPtr world = newInkedWorld(4);
        paint(world, QRect(0, 0, 1, 1));
        QCOMPARE(world->image()->pixel(0, 0), kInk);
        // Pen colour changed behind the port's back, then announced.
        QPen green = world->painter->pen();
        green.setColor(QColor(kUnderneath));
        world->painter->setPen(green);
        world->inkChanged();
        paint(world, QRect(1, 0, 1, 1));
        QCOMPARE(world->image()->pixel(1, 0), kUnderneath);
        // Ending and restarting the painter keeps the resolved colours right.
        world->EndPaint();
        paint(world, QRect(2, 0, 1, 1));
        QCOMPARE(world->image()->pixel(2, 0), kUnderneath);
        const RGBColor back(65535, 65535, 0);
        RGBBackColor(&back);
        {
            MakeQPainter p("test");
            p->fillRect(QRect(3, 0, 1, 1), Private::resolvedBackgroundBrush(world));
        }
        QCOMPARE(world->image()->pixel(3, 0), qRgb(255, 255, 0));
        DisposeGWorld(world);
    }

    void recolourRules()
    {
        const QColor ink(Qt::red);
        const QColor paper(Qt::blue);
        using Private::recolourBrush;
        QCOMPARE(recolourBrush(QBrush(), ink, paper, false).style(), Qt::SolidPattern);
        QCOMPARE(recolourBrush(QBrush(), ink, paper, false).color(), ink);
        QCOMPARE(recolourBrush(QBrush(Qt::black), ink, paper, false).color(), ink);
        QCOMPARE(recolourBrush(QBrush(Qt::white), ink, paper, true).color(), paper);
        QCOMPARE(recolourBrush(QBrush(Qt::yellow), ink, paper, false).color(), QColor(Qt::yellow));
        const QBrush gray = *GetQDGlobalsGray(nullptr).brush();
        const QBrush transparent = recolourBrush(gray, ink, paper, true);
        QCOMPARE(transparent.texture().cacheKey(), gray.texture().cacheKey());
        QCOMPARE(transparent.color(), ink);
        const QBrush opaque = recolourBrush(gray, ink, paper, false);
        QCOMPARE(opaque.style(), Qt::TexturePattern);
        QCOMPARE(opaque.texture().size(), QSize(8, 8));
        QVERIFY(!opaque.texture().hasAlphaChannel() || opaque.texture().toImage().pixel(0, 0) == paper.rgb());
    }

    void patPtrValueSemantics()
    {
        const PatPtr none(static_cast<const Pattern*>(nullptr));
        QVERIFY(none == nullptr);
        PatPtr copy(none);
        QVERIFY(copy == nullptr);
        const Pattern bytes{{0x55, 0xAA, 0x55, 0xAA, 0x55, 0xAA, 0x55, 0xAA}};
        PatPtr gray(&bytes);
        QVERIFY(gray != nullptr);
        PatPtr other(gray);
        QVERIFY(other.brush() != gray.brush());
        QCOMPARE(*other.brush(), *gray.brush());
        other = none;
        QVERIFY(other == nullptr);
        other = gray;
        other = other; // self-assignment keeps the brush
        QCOMPARE(*other.brush(), *gray.brush());
        // The same bytes give the same brush as the standard gray.
        QCOMPARE(gray.brush()->texture().cacheKey(),
                 GetQDGlobalsGray(nullptr).brush()->texture().cacheKey());
        // A null pattern changes nothing.
        GrafPtr world = newInkedWorld(4);
        PenPat(none);
        BackPat(none);
        QCOMPARE(world->currentBrush(), QBrush(Qt::black));
        QCOMPARE(world->currentBackground(), QBrush(Qt::white));
        DisposeGWorld(world);
    }
};

VELMAR_TEST_MAIN(TestPattern)
#include "tst_pattern.moc"
