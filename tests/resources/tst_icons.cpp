// Icons and pictures drawn into offscreen worlds and read back: mask rules by type, the
// family a rectangle's width picks, opacity, tinting by the paint calls, picture scaling,
// dirty rectangles, and what wrong or stale handles give.
#include "../quickdraw/QuickDrawTestSupport.h"
#include "Fixtures.h"

#include <Velmar/HostShell.h>
#include <Velmar/MacErrors.h>
#include <Velmar/QDIcons.h>
#include <Velmar/Resources.h>
#include <Velmar/TextUtils.h>

#include <QResource>

#include <cmath>
#include <functional>
#include <limits>

using namespace Velmar;
using namespace QDTest;

namespace {

constexpr QRgb kWhite = 0xFFFFFFFF, kBlack = 0xFF000000, kRed = 0xFFFF0000, kGreen = 0xFF00FF00,
               kBlue = 0xFF0000FF, kYellow = 0xFFFFFF00;

void setForeColor(QRgb rgb)
{
    const RGBColor c{QColor::fromRgb(rgb)};
    RGBForeColor(&c);
}

QPoint centreOf(const Rect& r)
{
    return Private::toQRect(r).center();
}

QByteArray hex(QRgb rgb)
{
    return QByteArray::number(rgb, 16);
}

} // namespace

class TestIcons : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void initTestCase()
    {
        QVERIFY2(Fixtures::registerTree(),
                 "no fixture tree: add add_subdirectory(resources) to tests/CMakeLists.txt");
    }

    void imagePaths()
    {
        const std::tuple<ResType, SInt16, const char*> cases[] = {
            {FOUR_CHAR_CODE("icl8"), 128, ":/images/icl8_128.png"},
            {FOUR_CHAR_CODE("ICN#"), -3, ":/images/ICN#_-3.png"},
            {FOUR_CHAR_CODE("ics4"), 7, ":/images/ics4_7.png"},
            {FOUR_CHAR_CODE("abcd"), 7, ":/images/cicn_7.png"},
            {FOUR_CHAR_CODE("PICT"), 200, ":/images/cicn_200.png"},
        };
        for (const auto& [type, id, path] : cases)
            QCOMPARE(MakeImageResourceName(type, id), QString::fromLatin1(path));
    }

    // Real alpha wins over every type's rule; black-and-white images of mask types become
    // monochrome; a missing PNG is a NullIcon.
    void iconClassByImage()
    {
        enum Kind { Color, Mono, Null };
        const std::tuple<ResType, SInt16, Kind, bool> cases[] = {
            {FOUR_CHAR_CODE("ICN#"), Fixtures::kMaskId, Mono, false},
            {FOUR_CHAR_CODE("icl8"), Fixtures::kMaskId, Color, false},
            {FOUR_CHAR_CODE("cicn"), Fixtures::kMaskId, Color, false},
            {FOUR_CHAR_CODE("ICON"), Fixtures::kColourIconId, Color, false},
            {FOUR_CHAR_CODE("ICN#"), Fixtures::kAlphaIconId, Color, true},
            {FOUR_CHAR_CODE("cicn"), 999, Null, true},
        };
        for (const auto& [type, id, kind, partialAlpha] : cases) {
            std::unique_ptr<AbstractIcon> icon(LoadIcon(type, id));
            const QByteArray what = FourCharToString(type).toLatin1();
            QVERIFY2(bool(dynamic_cast<MonochromeIcon*>(icon.get())) == (kind == Mono), what);
            QVERIFY2(bool(dynamic_cast<NullIcon*>(icon.get())) == (kind == Null), what);
            QVERIFY2(icon->hasPartialAlpha() == partialAlpha, what);
            QCOMPARE(icon->id(), kind == Null ? -1 : SInt32(id));
        }
    }

    // IDs 0, 1 and 2 are the style's three icons at 32x32 for any type, never the tree's
    // 'cicn' 0 (a magenta decoy).
    void standardIconsComeFromTheStyle()
    {
        QList<QImage> seen;
        for (SInt16 id : {0, 1, 2}) {
            const ResourceHandle h = GetCIcon(id);
            const QImage image = static_cast<AbstractIcon*>(h.data())->image();
            QCOMPARE(image.size(), QSize(32, 32));
            QVERIFY(image.pixel(16, 16) != Fixtures::kStopDecoy);
            QVERIFY(!seen.contains(image));
            seen << image;
            std::unique_ptr<AbstractIcon> other(LoadIcon(FOUR_CHAR_CODE("ICN#"), id));
            QCOMPARE(other->image(), image);
            ReleaseResource(h);
        }
    }

    // Drawn over green with a yellow pen: which pixels change, and to what.
    void maskRulesByType()
    {
        const QSet<QPoint> square = regionPixels(QRegion(Fixtures::kSquare));
        const QSet<QPoint> whole = rectPixels(0, 0, 32, 32);
        const std::tuple<ResType, SInt16, QRgb, QSet<QPoint>> cases[] = {
            {FOUR_CHAR_CODE("ICN#"), Fixtures::kMaskId, kYellow, square}, // tinted, white clear
            {FOUR_CHAR_CODE("icl8"), Fixtures::kMaskId, kRed, square}, // white clear
            {FOUR_CHAR_CODE("cicn"), Fixtures::kMaskId, kRed, whole}, // no mask
            {FOUR_CHAR_CODE("ICN#"), Fixtures::kAlphaIconId, kBlue, square}, // as it is
        };
        for (const auto& [type, id, ink, changed] : cases) {
            World world(40);
            setForeColor(kGreen);
            const Rect all = R(0, 0, 40, 40), target = R(0, 0, 32, 32);
            PaintRect(&all);
            setForeColor(kYellow);
            const ResourceHandle h = GetResource(type, id);
            PlotIcon(&target, h);
            ReleaseResource(h);
            const QSet<QPoint> got = world.touched(kGreen);
            QVERIFY2(got == changed, FourCharToString(type).toLatin1() + ' ' + describe(got));
            QVERIFY2(world.pixel(16, 16) == ink, hex(world.pixel(16, 16)));
        }
    }

    // 17 pixels wide and up takes the large family ('cicn' first), narrower the small one
    // ('ics8' first) however tall; 'icl8' and 'icl4' are never small.
    void familyChoiceByWidth()
    {
        using Fixtures::familyColour;
        const std::tuple<int, int, int, QRgb> cases[] = {
            {Fixtures::kFullFamily, 32, 32, familyColour("cicn")},
            {Fixtures::kFullFamily, 17, 17, familyColour("cicn")},
            {Fixtures::kFullFamily, 16, 16, familyColour("ics8")},
            {Fixtures::kFullFamily, 16, 64, familyColour("ics8")},
            {Fixtures::kPartFamily, 16, 64, familyColour("SICN")},
            {Fixtures::kPartFamily, 32, 32, familyColour("icl8")},
            {Fixtures::kNoFamily, 32, 32, kWhite},
        };
        for (const auto& [id, width, height, colour] : cases) {
            World world(70);
            const Rect r = R(0, 0, height, width);
            QCOMPARE(PlotIconID(&r, 0, 0, SInt16(id)), SInt16(0));
            const QPoint centre = centreOf(r);
            QVERIFY2(world.pixel(centre.x(), centre.y()) == colour,
                QByteArray::number(id) + ' ' + QByteArray::number(width) + ' '
                    + hex(world.pixel(centre.x(), centre.y())));
        }
    }

    // Alpha is scaled by floor(opacity * 256), opacity clamped to [0, 1].
    void opacityScalesAlphaBy256()
    {
        std::unique_ptr<AbstractIcon> icon(LoadIcon(FOUR_CHAR_CODE("cicn"), Fixtures::kMaskId));
        const std::pair<float, int> cases[] = {{0.5f, 128}, {0.75f, 192}, {0.25f, 64}, {1.0f, 255},
            {2.0f, 255}, {-1.0f, 0}, {std::numeric_limits<float>::quiet_NaN(), 0}};
        for (const auto& [opacity, alpha] : cases) {
            const QImage prepared = icon->prepare(0, opacity, false, nullptr, nullptr);
            QVERIFY2(qAlpha(prepared.pixel(16, 16)) == alpha, QByteArray::number(opacity));
        }
    }

    // The colour-taking calls tint a monochrome icon with their colour (null: the pen's)
    // and apply their opacity; PlotIcon's colour overload uses neither.
    void paintCallsTintMonochromeIcons()
    {
        const Rect r = R(0, 0, 32, 32);
        const RGBColor red{QColor(Qt::red)}, blue{QColor(Qt::blue)};
        RGBColor blueCopy = blue;
        const std::tuple<const char*, std::function<void(ResourceHandle)>, QRgb> cases[] = {
            {"PlotIcon", [&](ResourceHandle h) { PlotIcon(&r, h); }, kBlack},
            {"PlotIcon colour", [&](ResourceHandle h) { PlotIcon(&r, h, 0.5f, red); }, kBlack},
            {"PlotCIcon", [&](ResourceHandle h) { PlotCIcon(&r, h, 1.0f, red); }, kRed},
            {"PlotCIcon half", [&](ResourceHandle h) { PlotCIcon(&r, h, 0.5f, red); }, 0xFFFF7F7F},
            {"PaintCiconEx",
                [&](ResourceHandle h) { PaintCiconEx(h, r, 1.0f, &blueCopy, nullptr, false); },
                kBlue},
            {"PaintCiconEx pen",
                [&](ResourceHandle h) { PaintCiconEx(h, r, 1.0f, nullptr, nullptr, true); },
                kBlack},
            {"PaintSiconIndexed palette", [&](ResourceHandle h) { PaintSiconIndexed(h, r, 1, 1); },
                kBlue},
        };
        Palette::PaletteManager::Instance()->SetColor(QStringLiteral("ButtonResourceColor"), blue);
        for (const auto& [name, paint, expected] : cases) {
            World world(40);
            const ResourceHandle h = GetResource(FOUR_CHAR_CODE("ICN#"), Fixtures::kMaskId);
            paint(h);
            ReleaseResource(h);
            QVERIFY2(near(world.pixel(16, 16), expected),
                QByteArray(name) + ' ' + hex(world.pixel(16, 16)));
            QVERIFY2(world.pixel(2, 2) == kWhite, name);
        }
        Palette::PaletteManager::Instance()->Remove(QStringLiteral("ButtonResourceColor"));
    }

    // A 10x10 picture fills exactly the 40x40 target, each source pixel four by four.
    void drawPictureScalesIntoTarget()
    {
        World world(60);
        const ResourceHandle picture = GetPicture(Fixtures::kPictureId);
        const Rect target = R(10, 10, 50, 50);
        DrawPicture(picture, &target);
        QCOMPARE(world.touched(), rectPixels(10, 10, 50, 50));
        QCOMPARE(world.pixel(29, 30), kRed);
        QCOMPARE(world.pixel(30, 30), kBlue);
        Rect bounds = R(1, 1, 1, 1);
        QCOMPARE(QDGetPictureBounds(picture, &bounds), &bounds);
        QVERIFY(Private::sameRect(bounds, R(0, 0, 10, 10)));
        QVERIFY(!QDGetPictureBounds(picture, nullptr));
        ReleaseResource(picture);
    }

    // An icon marks the rectangle it was drawn in; a missing picture draws nothing but
    // marks its whole target.
    void dirtyRectangles()
    {
        World world(60);
        {
            DirtyRecorder recorder(world);
            const ResourceHandle icon = GetResource(FOUR_CHAR_CODE("icl8"), Fixtures::kMaskId);
            const Rect r = R(0, 0, 40, 40);
            PlotIcon(&r, icon);
            ReleaseResource(icon);
            QCOMPARE(recorder.dirty(), QRect(4, 4, 32, 32));
        }
        world.touched(); // ends the painter
        world.image().fill(Qt::white);
        DirtyRecorder recorder(world);
        const ResourceHandle missing = GetPicture(999);
        QVERIFY(missing.isNull());
        const Rect target = R(5, 5, 25, 45);
        DrawPicture(missing, &target);
        ReleaseResource(missing);
        QCOMPARE(recorder.dirty(), QRect(5, 5, 40, 20));
        QVERIFY(world.touched().isEmpty());
    }

    void pictureHandlesOfTheWrongKind()
    {
        const char* const wrongKind =
            "Velmar::DrawPicture: Resource handle has type RT_HANDLE or "
            "RT_PICHANDLE, which should not happen in USE_BRINDLE version";
        const ResourceHandle icon = GetCIcon(Fixtures::kMaskId);
        const std::pair<ResourceHandle, const char*> cases[] = {
            {ResourceHandle(), "Velmar::DrawPicture: Unknown picture type"},
            {icon, "Velmar::DrawPicture: Unknown picture type"},
            {ResourceHandle(nullptr, RT_HANDLE), wrongKind},
            {ResourceHandle(reinterpret_cast<void*>(0x40), RT_PICHANDLE), wrongKind},
            {ResourceHandle(nullptr, RT_QIMAGE),
                "Velmar::DrawPicture: RT_QIMAGE handle contains NULL QImage"},
        };
        World world(40);
        const Rect r = R(0, 0, 40, 40);
        for (const auto& [handle, warning] : cases) {
            VelmarTest::LogCapture log;
            DrawPicture(handle, &r);
            QVERIFY2(log.contains(QString::fromLatin1(warning)), warning);
        }
        QVERIFY(world.touched().isEmpty());
        ReleaseResource(icon);
    }

    // Empty, released and wrong handles, null rectangles, no port, and the suite calls:
    // assertions and log lines, never a crash or a stray pixel.
    void hostileIconCalls()
    {
        SetLogCategory(kLogQuickDraw | kLogNotImpl, true);
        World world(40);
        const Rect r = R(0, 0, 32, 32);
        VelmarTest::IgnoredAssertions ignored;
        VelmarTest::LogCapture log;

        PlotIcon(&r, ResourceHandle()); // ResAssert: not empty, and an icon type
        QVERIFY(log.contains(QStringLiteral("Velmar::PlotIcon: icon is NULL")));
        QCOMPARE(ignored.texts(), (QStringList{QStringLiteral("x"), QStringLiteral("x")}));
        QVERIFY(ignored.questions().first().text.contains(QStringLiteral("QtResources.cpp")));

        const ResourceHandle icon = GetCIcon(Fixtures::kMaskId);
        QVERIFY(Private::sameRect(GetCIconBounds(icon), R(0, 0, 32, 32)));
        const ResourceHandle picture = GetPicture(Fixtures::kPictureId);
        ReleaseResource(icon);
        ReleaseResource(picture);
        // Each of these refuses the released payload.
        PlotIcon(&r, icon);
        QVERIFY(Private::sameRect(GetCIconBounds(icon), R(0, 0, 0, 0)));
        DrawPicture(picture, &r);
        QCOMPARE(ignored.texts().count(QStringLiteral("IsValidResource(handle)")), 3);
        QVERIFY(Private::sameRect(GetCIconBounds(ResourceHandle()), R(0, 0, 0, 0)));

        Handle suite = reinterpret_cast<Handle>(0x40), member = suite;
        QCOMPARE(GetIconSuite(&suite, 128, 0xFFFFFFFF), OSErr(0));
        QCOMPARE(GetIconFromSuite(&member, suite, FOUR_CHAR_CODE("icl8")), OSErr(0));
        QVERIFY(!suite && !member);
        QCOMPARE(PlotIconSuite(&r, 0, 0, nullptr), OSErr(unimpErr));
        QVERIFY(!log.contains(QStringLiteral("PlotIconSuite")));
        const Point inside = P(10, 10);
        QCOMPARE(PtInIconID(inside, &r, 0, 128), Boolean(0));
        QVERIFY(log.contains(QStringLiteral("Velmar::PtInIconID")));
        QVERIFY(world.touched().isEmpty());

        // Null rectangles are empty targets: nothing to check but that nothing breaks.
        const ResourceHandle live = GetCIcon(Fixtures::kMaskId);
        const ResourceHandle pict = GetPicture(Fixtures::kPictureId);
        PlotIcon(nullptr, live);
        PlotIconID(nullptr, 0, 0, Fixtures::kFullFamily);
        DrawPicture(pict, nullptr);

        SetPort(nullptr);
        log.clear();
        PlotIcon(&r, live);
        DrawPicture(pict, &r);
        QVERIFY(log.contains(QStringLiteral("warning: PlotIcon: Can't get current port!")));
        QVERIFY(log.contains(QStringLiteral("warning: DrawPicture: Can't get current port!")));
        ReleaseResource(live);
        ReleaseResource(pict);
        QCOMPARE(ignored.count(), 5);
        SetLogCategory(kLogQuickDraw | kLogNotImpl, false);
    }
};

VELMAR_TEST_MAIN(TestIcons)
#include "tst_icons.moc"
