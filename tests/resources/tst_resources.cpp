// The Resource Manager over the test resource tree: which route each type takes, what a
// handle owns and shares, 'STR ' from the text table, hostile names and stale handles.
#include "Fixtures.h"
#include "TestSupport.h"

#include <Velmar/Diagnostics.h>
#include <Velmar/HostCore.h>
#include <Velmar/QDIcons.h>
#include <Velmar/QtGrafPort.h>
#include <Velmar/Resources.h>
#include <Velmar/TextUtils.h>

#include <QResource>

using namespace Velmar;

namespace {

using VelmarTest::P;
using VelmarTest::pascal;

// The bytes of an RT_HANDLE handle, checked against the handle's own size.
QByteArray bytesOf(const ResourceHandle& h)
{
    auto handle = static_cast<Handle>(h.data());
    return QByteArray(*handle, TxGetHandleSize(handle));
}

} // namespace

class TestResources : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void initTestCase()
    {
        QVERIFY2(Fixtures::registerTree(),
                 "no fixture tree: add add_subdirectory(resources) to tests/CMakeLists.txt");
    }

    // Icon types load icons, 'PICT' pictures, everything else ('icl4' included) the file
    // ":/TYPE/nnnnn"; a missing file or PNG still has its type but is null.
    void routesByType()
    {
        struct Case {
            ResType type;
            SInt16 id;
            UInt32 payload;
            bool null;
            const char* bytes;
        };
        const Case cases[] = {
            {FOUR_CHAR_CODE("TEXT"), 128, RT_HANDLE, false, "Velmar test text"},
            {FOUR_CHAR_CODE("TEXT"), -5, RT_HANDLE, false, "negative"},
            {FOUR_CHAR_CODE("TEXT"), 129, RT_HANDLE, true, nullptr},
            {FOUR_CHAR_CODE("icl4"), 128, RT_HANDLE, false, "raw icl4 bytes"},
            {FOUR_CHAR_CODE("icl8"), 128, RT_ICON, false, nullptr},
            {FOUR_CHAR_CODE("ICN#"), 999, RT_ICON, true, nullptr},
            {FOUR_CHAR_CODE("PICT"), 200, RT_QIMAGE, false, nullptr},
            {FOUR_CHAR_CODE("PICT"), 999, RT_QIMAGE, true, nullptr},
        };
        for (auto get : {GetResource, Get1Resource}) {
            for (const Case& c : cases) {
                const QByteArray what =
                    (FourCharToString(c.type) + QString::number(c.id)).toLatin1();
                const ResourceHandle h = get(c.type, c.id);
                QVERIFY2(h.getType() == c.payload, what);
                QVERIFY2(h.isNull() == c.null, what);
                if (c.bytes)
                    QCOMPARE(bytesOf(h), QByteArray(c.bytes));
                ReleaseResource(h);
            }
        }
    }

    // The translation as a Pascal string in a handle exactly one byte longer than the text,
    // cut at 255 bytes; an untranslated key stands for itself.
    void stringsFromTextTable()
    {
        TextTable* table = TextTable::Get();
        table->Insert(QStringLiteral("greeting"), QStringLiteral("Hallo Welt"));
        table->Insert(QStringLiteral("long"), QString(300, QLatin1Char('w')));
        const std::pair<const char*, QByteArray> cases[] = {{"greeting", "Hallo Welt"},
            {"long", QByteArray(255, 'w')}, {"untranslated", "untranslated"}};
        for (const auto& [key, text] : cases) {
            const ResourceHandle h = GetNamedResource(FOUR_CHAR_CODE("STR "), P(pascal(key)));
            QCOMPARE(h.getType(), UInt32(RT_HANDLE));
            QCOMPARE(bytesOf(h), pascal(text));
            ReleaseResource(h);
        }
        table->Clear();
    }

    // An RT_HANDLE clone owns its bytes; a picture clone is the same image; an icon clone a
    // new icon of the same image. Neither of the last two counts as a clone.
    void cloneSemantics()
    {
        const ResourceHandle text = GetResource(FOUR_CHAR_CODE("TEXT"), 128);
        ResourceHandle copy = text.clone();
        QVERIFY(copy.isClone());
        QVERIFY(copy.data() != text.data());
        (*static_cast<Handle>(text.data()))[0] = 'v';
        QCOMPARE(bytesOf(copy), QByteArray("Velmar test text"));
        ReleaseResource(text);
        QCOMPARE(bytesOf(copy), QByteArray("Velmar test text"));
        ReleaseResource(copy);
        copy.reset();
        QVERIFY(copy.isClone() && copy.isNull() && copy.getType() == 0);

        const ResourceHandle picture = GetPicture(Fixtures::kPictureId);
        const ResourceHandle shared = picture.clone();
        QVERIFY(!shared.isClone());
        QCOMPARE(shared.data(), picture.data());
        QCOMPARE(shared.getType(), UInt32(RT_QIMAGE));
        ReleaseResource(picture);

        const ResourceHandle icon = GetCIcon(Fixtures::kMaskId);
        const ResourceHandle twin = icon.clone();
        QVERIFY(!twin.isClone() && twin.data() != icon.data());
        QCOMPARE(static_cast<AbstractIcon*>(twin.data())->image(),
            static_cast<AbstractIcon*>(icon.data())->image());
        ReleaseResource(icon);
        QVERIFY(!twin.isNull());
        ReleaseResource(twin);

        for (const ResourceHandle& empty :
            {ResourceHandle(), GetResource(FOUR_CHAR_CODE("TEXT"), 129), GetPicture(999)}) {
            const ResourceHandle c = empty.clone();
            QVERIFY(c.getType() == 0 && !c.data() && !c.isClone());
            ReleaseResource(empty);
        }
    }

    // A released icon or picture (or a second copy of a shared picture) is refused with one
    // assertion each and never freed twice; a released memory handle is refused by the
    // allocator. Empty and missing handles release silently.
    void releasedPayloadsAreRefused()
    {
        ReleaseResource(ResourceHandle());
        ReleaseResource(GetResource(FOUR_CHAR_CODE("TEXT"), 129));
        ReleaseResource(ResourceHandle(reinterpret_cast<void*>(0x40), RT_PICHANDLE));

        VelmarTest::IgnoredAssertions ignored;
        const ResourceHandle picture = GetPicture(Fixtures::kPictureId);
        const ResourceHandle shared = picture.clone();
        ReleaseResource(picture);
        ReleaseResource(shared);
        QCOMPARE(ignored.texts(), QStringList{QStringLiteral("IsValidResource(handle)")});

        const ResourceHandle icon = GetCIcon(Fixtures::kMaskId);
        ReleaseResource(icon);
        QVERIFY(icon.isNull());
        ReleaseResource(icon);
        QCOMPARE(ignored.texts().count(QStringLiteral("IsValidResource(handle)")), 3);

        VelmarTest::LogCapture log;
        const ResourceHandle text = GetResource(FOUR_CHAR_CODE("TEXT"), 128);
        ReleaseResource(text);
        ReleaseResource(text);
        QVERIFY(log.contains(QStringLiteral("TxDisposeHandle: not a live handle")));
        QCOMPARE(ignored.count(), 3);
    }

    // Names that would leave ":/TYPE/" (or that a NUL would cut short into another name) are
    // refused with a warning and give the missing-file handle.
    void hostileNamesAreRefused()
    {
        const QByteArray notes = pascal("notes");
        const ResourceHandle good = GetNamedResource(FOUR_CHAR_CODE("TEXT"), P(notes));
        QCOMPARE(bytesOf(good), QByteArray("notes"));
        ReleaseResource(good);

        const std::pair<ResType, QByteArray> cases[] = {
            {FOUR_CHAR_CODE("TEXT"), pascal("../icl4/00128")},
            {FOUR_CHAR_CODE("TEXT"), pascal("..")},
            {FOUR_CHAR_CODE("TEXT"), pascal("sub/notes")},
            {FOUR_CHAR_CODE("TEXT"), pascal("..\\icl4\\00128")},
            {FOUR_CHAR_CODE("TEXT"), pascal(QByteArray("notes\0x", 7))},
            {FOUR_CHAR_CODE("STR "), pascal(QByteArray("greeting\0", 9))},
            {FOUR_CHAR_CODE("TE/T"), notes},
        };
        for (const auto& [type, name] : cases) {
            VelmarTest::LogCapture log;
            for (auto get : {GetNamedResource, Get1NamedResource}) {
                const ResourceHandle h = get(type, P(name));
                QVERIFY2(h.getType() == RT_HANDLE && h.isNull(), name.constData() + 1);
            }
            QVERIFY2(
                log.contains(QStringLiteral("Velmar::GetNamedResource: refused resource name")),
                name.constData() + 1);
            QVERIFY(log.contains(QStringLiteral("Velmar::Get1NamedResource: refused")));
        }
        VelmarTest::LogCapture log;
        const ResourceHandle none = GetNamedResource(FOUR_CHAR_CODE("TEXT"), nullptr);
        QVERIFY(none.getType() == RT_HANDLE && none.isNull());
        QVERIFY(log.contains(QStringLiteral("Velmar::GetNamedResource: resource name is NULL")));
    }

    // There is nothing to index, and one resource file: 0. Only another refNum is logged.
    void indexedAndFileCalls()
    {
        for (auto get : {GetIndResource, Get1IndResource})
            for (ResType type : {FOUR_CHAR_CODE("TEXT"), FOUR_CHAR_CODE("cicn")})
                QCOMPARE(get(type, 1).getType(), UInt32(0));
        SetLogCategory(kLogQuickDraw, true);
        VelmarTest::LogCapture log;
        UseResFile(0);
        QVERIFY(log.lines().isEmpty());
        UseResFile(3);
        QCOMPARE(log.count(QStringLiteral("warning: refNum is not 0")), 1);
        QCOMPARE(CurResFile(), SInt16(0));
        SetLogCategory(kLogQuickDraw, false);
    }

    // A copied pixmap owns its own pixels; nothing is ever locked.
    void pixmapHandles()
    {
        GrafPtr world = nullptr;
        const Rect bounds{0, 0, 4, 4};
        NewGWorld(&world, 32, &bounds, nullptr, nullptr, 0);
        PixMapPtr* original = GetGWorldPixMap(world);
        original->image()->fill(Qt::red);
        PixMapPtr* copy = TxCopyHand(original);
        QVERIFY(copy && copy->ownsImage() && copy->image() != original->image());
        original->image()->fill(Qt::blue);
        QCOMPARE(copy->image()->pixel(1, 1), qRgb(255, 0, 0));
        QCOMPARE(TxHLock(copy), Boolean(1));
        TxHUnLock(copy, 1);
        PixMapPtr::destroyPixMap(copy);
        QCOMPARE(TxCopyHand(static_cast<PixMapPtr*>(nullptr)), nullptr);
        VelmarTest::IgnoredAssertions asserts;
        QCOMPARE(TxCopyHand(copy), nullptr);
        QCOMPARE(asserts.texts(), QStringList{"IsValidPixMap(pixmap)"});
        DisposeGWorld(world);
    }
};

VELMAR_TEST_MAIN(TestResources)
#include "tst_resources.moc"
