// Patterns: bit order and phase, recolouring with the port's colours, pen-mode composition.
#include "QuickDrawTestSupport.h"

#include <cstring>

using namespace Velmar;
using namespace QDTest;

namespace {

const QRgb kInk = qRgb(255, 0, 0);
const QRgb kPaper = qRgb(0, 0, 255);
const QRgb kUnderneath = qRgb(0, 255, 0);

// A current world drawing red ink on blue paper.
struct InkedWorld : World {
    explicit InkedWorld(int size) : World(size)
    {
        const RGBColor ink(65535, 0, 0), paper(0, 0, 65535);
        RGBForeColor(&ink);
        RGBBackColor(&paper);
    }
};

// Fills `local` with the port's fill brush, as the Paint calls do, or with its background
// brush, as the Erase calls do.
void paint(GrafPtr port, const QRect& local, bool erase = false)
{
    MakeQPainter p("test");
    p->fillRect(local, erase ? Private::resolvedBackgroundBrush(port)
                             : Private::resolvedFillBrush(port));
    p |= local;
}

// The world's pixels as rows, '#' ink, '.' paper, '?' anything else: derived from the
// pixels, not the code.
QStringList pixelRows(const World& world)
{
    QStringList rows;
    for (int y = 0; y < world.image().height(); ++y) {
        QString row;
        for (int x = 0; x < world.image().width(); ++x) {
            const QRgb px = world.pixel(x, y);
            row += QLatin1Char(px == kInk ? '#' : px == kPaper ? '.' : '?');
        }
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

// Every pixel of `local` is ink where the rule says so and `paper` elsewhere; `origin` is
// the local point of the image's top-left pixel.
void checkRule(const World& world, const Pattern& p, QRgb paper, const QRect& local,
               QPoint origin = QPoint())
{
    for (int y = local.top(); y <= local.bottom(); ++y)
        for (int x = local.left(); x <= local.right(); ++x)
            QCOMPARE(world.pixel(x - origin.x(), y - origin.y()),
                     ruleSaysInk(p, x, y) ? kInk : paper);
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

    void patternPixels_data()
    {
        QTest::addColumn<int>("standard"); // index into kStandard, or -1 to paint `bytes`
        QTest::addColumn<QByteArray>("bytes");
        QTest::addColumn<QStringList>("rows"); // one 8-pixel tile, top row first
        QTest::newRow("black") << 0 << QByteArray(8, '\xFF') << QStringList{"########"};
        QTest::newRow("white") << 1 << QByteArray(8, '\0') << QStringList{"........"};
        QTest::newRow("gray") << 2 << QByteArray::fromHex("55AA55AA55AA55AA") << QStringList{".#.#.#.#", "#.#.#.#."};
        QTest::newRow("light gray") << 3 << QByteArray::fromHex("2288228822882288") << QStringList{"#.###.##", "###.###."};
        QTest::newRow("dark gray") << 4 << QByteArray::fromHex("DD77DD77DD77DD77") << QStringList{".#...#..", "...#...#"};
        // Bit 0 of a byte is its leftmost pixel, and set bits are paper.
        QTest::newRow("any bytes") << -1 << QByteArray::fromHex("0102800FF03C817E")
            << QStringList{".#######", "#.######", "#######.", "....####", "####....", "##....##", ".######.", "#......#"};
    }
    void patternPixels()
    {
        QFETCH(int, standard);
        QFETCH(QByteArray, bytes);
        QFETCH(QStringList, rows);
        static const PatPtr& (*const kStandard[])(Pattern*) = {GetQDGlobalsBlack, GetQDGlobalsWhite,
            GetQDGlobalsGray, GetQDGlobalsLightGray, GetQDGlobalsDarkGray};
        InkedWorld world(24);
        Pattern p{};
        if (standard < 0)
            std::memcpy(p.pat, bytes.constData(), 8);
        PenPat(standard < 0 ? PatPtr(&p) : kStandard[standard](&p));
        QCOMPARE(QByteArray(reinterpret_cast<const char*>(p.pat), 8), bytes);
        paint(world, QRect(0, 0, 24, 24));
        // Every pixel is ink or paper as the rows say, repeating every 8 pixels.
        QStringList tiled;
        for (int y = 0; y < 24; ++y)
            tiled << rows[y % rows.size()].repeated(3);
        QCOMPARE(pixelRows(world), tiled);
    }

    void phaseIsAnchoredAtLocalZero()
    {
        InkedWorld world(32);
        Pattern bytes;
        PenPat(GetQDGlobalsLightGray(&bytes));
        SetOrigin(3, 5);
        // Painting only part of the port does not shift the pattern either.
        paint(world, QRect(10, 9, 20, 20));
        checkRule(world, bytes, kPaper, QRect(10, 9, 20, 20), QPoint(3, 5));
    }

    void otherBrushes()
    {
        InkedWorld world(4);
        // Solid colours other than black and white are kept; no brush at all paints ink.
        PenPat(PatPtr(QBrush(QColor(10, 20, 30))));
        paint(world, QRect(0, 0, 1, 1));
        QCOMPARE(world.pixel(0, 0), qRgb(10, 20, 30));
        PenPat(PatPtr(QBrush()));
        paint(world, QRect(3, 3, 1, 1));
        QCOMPARE(world.pixel(3, 3), kInk);
    }

    void paperPixelsByPenMode_data()
    {
        QTest::addColumn<int>("mode");
        QTest::addColumn<bool>("erase");
        QTest::addColumn<QRgb>("paper");
        for (const auto& [name, mode, erase, paper] :
             {std::tuple{"patOr leaves paper untouched", int(patOr), false, kUnderneath},
              {"patCopy paints the back colour", patCopy, false, kPaper},
              {"erasing under patOr is opaque", patOr, true, kPaper}})
            QTest::newRow(name) << mode << erase << paper;
    }
    void paperPixelsByPenMode()
    {
        QFETCH(int, mode);
        QFETCH(bool, erase);
        QFETCH(QRgb, paper);
        InkedWorld world(16);
        world.image().fill(kUnderneath);
        Pattern bytes;
        (erase ? BackPat : PenPat)(GetQDGlobalsGray(&bytes));
        PenMode(SInt16(mode));
        paint(world, QRect(0, 0, 16, 16), erase);
        checkRule(world, bytes, paper, QRect(0, 0, 16, 16));
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
        InkedWorld world(16);
        for (int y = 0; y < 16; ++y)
            for (int x = 0; x < 16; ++x)
                world.image().setPixel(x, y, qRgb(x * 16, y * 16, 77));
        const QImage before = world.image().copy();
        PenMode(SInt16(mode));
        paint(world, QRect(2, 2, 10, 10));
        // Not-source-XOR-destination, opaque: each channel becomes ~(ink ^ old).
        for (int y = 0; y < 16; ++y)
            for (int x = 0; x < 16; ++x) {
                const QRgb old = before.pixel(x, y);
                const bool inside = QRect(2, 2, 10, 10).contains(x, y);
                const QRgb expected = inside ? (~(kInk ^ old) & 0x00FFFFFFu) | 0xFF000000u : old;
                QCOMPARE(world.pixel(x, y), expected);
            }
        paint(world, QRect(2, 2, 10, 10));
        QCOMPARE(world.image(), before);
    }

    void directPainterChangesNeedInkChanged()
    {
        InkedWorld world(4);
        paint(world, QRect(0, 0, 1, 1));
        QCOMPARE(world.pixel(0, 0), kInk);
        // Pen colour changed behind the port's back, then announced.
        QPen green = world->painter->pen();
        green.setColor(QColor(kUnderneath));
        world->painter->setPen(green);
        Private::portData(world)->inkChanged();
        paint(world, QRect(1, 0, 1, 1));
        QCOMPARE(world.pixel(1, 0), kUnderneath);
        // Ending and restarting the painter keeps the resolved colours right.
        world->EndPaint();
        paint(world, QRect(2, 0, 1, 1));
        QCOMPARE(world.pixel(2, 0), kUnderneath);
        const RGBColor back(65535, 65535, 0);
        RGBBackColor(&back);
        paint(world, QRect(3, 0, 1, 1), true);
        QCOMPARE(world.pixel(3, 0), qRgb(255, 255, 0));
    }

    void nullPatternChangesNothing()
    {
        const PatPtr none(static_cast<const Pattern*>(nullptr));
        InkedWorld world(4);
        PenPat(none);
        BackPat(none);
        QCOMPARE(world->currentBrush(), QBrush(Qt::black));
        QCOMPARE(world->currentBackground(), QBrush(Qt::white));
    }
};

VELMAR_TEST_MAIN(TestPattern)
#include "tst_pattern.moc"
