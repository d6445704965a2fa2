// Classic calls given null, made-up, disposed and extreme arguments: each is refused with the
// library's assertion (answered Ignore here) and its neutral result, and nothing crashes.
// Linked like a classic program (the shared libraries), not the static twin.
#include <Velmar/HostCore.h>

#define VELMAR_CLASSIC_SHARES_RECT 1
#include <ClassicToolbox.h>

#include <QFile>
#include <QTemporaryDir>
#include <QTest>

#include <climits>
#include <functional>

namespace {

class Recorder : public Velmar::AutomationListener {
public:
    QString AnswerDialog(const QString&, const QString& text, const QString&) override
    {
        texts << text.section(QStringLiteral("velmar_assert: "), 1).section(u'\n', 0, 0);
        return QStringLiteral("Ignore");
    }
    QStringList texts;
};

struct Case {
    const char* name;
    std::function<long()> call;
    long result;
    const char* assertion; // empty: none expected
};

} // namespace

class tst_ClassicHostile : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void initTestCase()
    {
        InitGraf(&qd.thePort);
        InitWindows();
        Velmar::AutomationListenerManager::SetListener(&m_recorder);
    }

    void refused()
    {
        static char junk[64];
        auto* madeUp = reinterpret_cast<Handle>(junk);
        RgnHandle gone = NewRgn();
        DisposeRgn(gone);
        Handle goneHandle = NewHandle(4);
        DisposeHandle(goneHandle);
        Rect bounds = {40, 40, 140, 240};
        WindowPtr goneWindow = NewWindow(
            nullptr, &bounds, (const unsigned char*)"\1w", false, 0, (WindowPtr)-1L, true, 0);
        DisposeWindow(goneWindow);
        WindowPtr textWindow = NewWindow(
            nullptr, &bounds, (const unsigned char*)"\1t", false, 0, (WindowPtr)-1L, false, 0);
        SetPort(textWindow);
        TEHandle styled = TEStyleNew(&bounds, &bounds);
        TEHandle goneTE = TENew(&bounds, &bounds);
        TEDispose(goneTE);
        // A 'styl' scrap claiming more runs than it holds, and one with a negative count.
        const auto scrap = [](std::initializer_list<unsigned char> bytes) {
            Handle h = NewHandle(Size(bytes.size()));
            std::copy(bytes.begin(), bytes.end(), reinterpret_cast<unsigned char*>(*h));
            return reinterpret_cast<StScrpHandle>(h);
        };
        StScrpHandle truncated = scrap(
            {0, 9, 0, 0, 0, 0, 0, 16, 0, 12, 0, 0, 1, 0, 0, 12, 0, 0, 0, 0, 0, 0, 0, 0, 0, 3});
        StScrpHandle negative = scrap({0x80, 0});
        QTemporaryDir folder;
        const QByteArray dataFile = folder.filePath(QStringLiteral("data")).toLocal8Bit();
        QFile data(QString::fromLocal8Bit(dataFile));
        data.open(QIODevice::WriteOnly);
        data.write("the program's own data");
        data.close();
        const auto pstr = [](const QByteArray& text) {
            static unsigned char s[256];
            s[0] = (unsigned char)std::min<qsizetype>(text.size(), 255);
            std::memcpy(s + 1, text.constData(), s[0]);
            return s;
        };
        Handle plainHandle = NewHandle(1);
        // Rows that answer ResError, or the text record's length, after the call.
        const auto resError = [](std::function<void()> call) {
            return [call] {
                call();
                return long(ResError());
            };
        };
        const auto teLength = [&](std::function<void()> call) {
            return [call, styled] {
                call();
                return long((**styled).teLength);
            };
        };
        const Case cases[] = {
            {"DisposeRgn made-up",
                [&] {
                    DisposeRgn(reinterpret_cast<RgnHandle>(junk));
                    return 0L;
                },
                0, "IsValidRgnHandle(rgn)"},
            {"DisposeRgn disposed",
                [&] {
                    DisposeRgn(gone);
                    return 0L;
                },
                0, "IsValidRgnHandle(rgn)"},
            {"EmptyRgn null", [] { return long(EmptyRgn(nullptr)); }, 1, "rgn != NULL"},
            {"SetPort made-up",
                [&] {
                    SetPort(reinterpret_cast<GrafPtr>(junk));
                    return 0L;
                },
                0, "IsValidPort(port)"},
            {"SetPort disposed window",
                [&] {
                    SetPort(goneWindow);
                    return 0L;
                },
                0, "IsValidPort(port)"},
            {"DisposeWindow disposed",
                [&] {
                    DisposeWindow(goneWindow);
                    return 0L;
                },
                0, "IsValidWindowPtr(window)"},
            {"FindWindow null out",
                [] {
                    return long(FindWindow(Point{1, 1}, nullptr));
                },
                inDesk, "theWindow != NULL"},
            {"DisposeHandle made-up",
                [&] {
                    DisposeHandle(madeUp);
                    return long(MemError());
                },
                nilHandleErr, "IsValidHandle(h)"},
            {"GetHandleSize disposed", [&] { return long(GetHandleSize(goneHandle)); }, 0,
                "IsValidHandle(h)"},
            {"HLock null",
                [] {
                    HLock(nullptr);
                    return long(MemError());
                },
                nilHandleErr, ""},
            {"NewHandle negative",
                [] { return long(NewHandle(-1) == nullptr) * 1000 + MemError(); },
                1000 + memFullErr, ""},
            {"SetHandleSize huge",
                [] {
                    Handle h = NewHandle(1);
                    SetHandleSize(h, LONG_MAX);
                    const long e = MemError();
                    DisposeHandle(h);
                    return e;
                },
                memFullErr, ""},
            {"DrawPicture made-up",
                [&] {
                    DrawPicture(reinterpret_cast<PicHandle>(junk), &bounds);
                    return 0L;
                },
                0, "IsValidHandle(myPicture)"},
            {"TEDispose made-up",
                [&] {
                    TEDispose(reinterpret_cast<TEHandle>(junk));
                    return 0L;
                },
                0, "IsValidTEHandle(hTE)"},
            {"CheckItem made-up",
                [&] {
                    CheckItem(reinterpret_cast<MenuHandle>(junk), 1, true);
                    return 0L;
                },
                0, "IsValidMenu(theMenu)"},
            {"GetResInfo plain handle",
                [] {
                    Handle h = NewHandle(2);
                    short id = 7;
                    GetResInfo(h, &id, nullptr, nullptr);
                    DisposeHandle(h);
                    return long(ResError()) * 10 + id;
                },
                resNotFound * 10 + 7, ""},
            {"OpenResFile missing",
                [] { return OpenResFile((const unsigned char*)"\7nothing") * 1000L + ResError(); },
                -1000 + fnfErr, ""},
            {"CloseResFile unknown",
                [] {
                    CloseResFile(999);
                    return long(ResError());
                },
                resFNotFound, ""},
            {"GetIndString past end",
                [] {
                    Str255 s = {3, 'a', 'b', 'c'};
                    GetIndString(s, 128, 99);
                    return long(s[0]);
                },
                0, ""},
            {"BitShift far", [] { return BitShift(1, 40); }, 256, ""},
            {"Random from seed 0",
                [] {
                    qd.randSeed = 0;
                    return Random();
                },
                16807, ""},
            {"CopyBits null map",
                [&] {
                    CopyBits(nullptr, &qd.screenBits, &bounds, &bounds, srcCopy, nullptr);
                    return 0L;
                },
                0, "srcBits && dstBits"},
            {"CopyBits made-up and extreme maps",
                [&] {
                    static char bits[8 * 8];
                    BitMap small = {bits, 1, {0, 0, 8, 8}};
                    BitMap thin = {bits, 1, {0, 0, 8, 64}}; // rowBytes too small for 64
                    BitMap huge = {bits, 8, {-32000, -32000, 32000, 32000}};
                    const Rect extreme = {-32768, -32768, 32767, 32767};
                    CopyBits(&small, &thin, &extreme, &extreme, srcXor, nullptr);
                    CopyBits(&huge, &small, &extreme, &bounds, srcCopy, nullptr);
                    CopyBits(&small, &small, &extreme, &bounds, notSrcBic, nullptr);
                    CopyBits(&qd.screenBits, &small, &bounds, &bounds, srcCopy, nullptr);
                    CopyMask(&small, &small, &huge, &extreme, &extreme, &extreme);
                    return long(bits[0] == 0);
                },
                1, ""},
            {"Port on a made-up bitmap draws nowhere",
                [&] {
                    static GrafPort port;
                    static char bits[8];
                    OpenPort(&port);
                    BitMap wide = {bits, 8, {0, 0, 30000, 30000}};
                    SetPortBits(&wide);
                    PaintRect(&bounds);
                    TextMode(srcXor);
                    MoveTo(32000, 32000);
                    DrawString((const unsigned char*)"\1x");
                    SetPortBits(nullptr);
                    ClosePort(&port);
                    return long(bits[0]);
                },
                0, "bm != NULL"},
            {"PlotIconHandle made-up", [&] { return long(PlotIconHandle(&bounds, 0, 0, madeUp)); },
                paramErr, "IsValidHandle(theIcon)"},
            {"TEStyleInsert truncated styl",
                teLength([&] { TEStyleInsert("abcdef", 6, truncated, styled); }), 6, ""},
            {"TEStyleInsert negative count",
                teLength([&] { TEStyleInsert("gh", 2, negative, styled); }), 8, ""},
            {"TEStyleInsert made-up scrap", teLength([&] {
                 TEStyleInsert("x", 1, reinterpret_cast<StScrpHandle>(junk), styled);
             }),
                8, "IsValidHandle(hST)"},
            {"TEGetStyle disposed record",
                [&] {
                    TextStyle style{};
                    TEGetStyle(0, &style, nullptr, nullptr, goneTE);
                    return long(style.tsSize);
                },
                0, "IsValidTEHandle(hTE)"},
            {"TESetStyle null style", teLength([&] { TESetStyle(doFace, nullptr, true, styled); }),
                8, "newStyle != NULL"},
            {"AddResource made-up handle",
                resError([&] { AddResource(madeUp, 'TEXT', 128, nullptr); }), addResFailed, ""},
            {"RemoveResource plain handle", resError([&] { RemoveResource(plainHandle); }),
                rmvResFailed, ""},
            {"ChangedResource disposed", resError([&] { ChangedResource(goneHandle); }),
                resNotFound, ""},
            {"UpdateResFile unknown", resError([] { UpdateResFile(999); }), resFNotFound, ""},
            {"CreateResFile empty name", resError([] { CreateResFile((const unsigned char*)""); }),
                paramErr, ""},
            {"CreateResFile in no folder",
                resError([&] { CreateResFile(pstr("/nonexistent/folder/x")); }), dirNFErr, ""},
            {"CreateResFile over a data file keeps the data",
                [&] {
                    CreateResFile(pstr(dataFile));
                    QFile back(QString::fromLocal8Bit(dataFile));
                    back.open(QIODevice::ReadOnly);
                    return long(ResError()) * 10 + (back.readAll() == "the program's own data")
                        + 2 * QFile::exists(QString::fromLocal8Bit(dataFile + ".rsrc"));
                },
                3, ""},
            {"SetResLoad false gives an empty handle",
                [&] {
                    const short ref = OpenResFile(pstr(dataFile));
                    UseResFile(ref);
                    Handle h = NewHandle(3);
                    AddResource(h, 'DATA', 5, nullptr);
                    UpdateResFile(ref);
                    ReleaseResource(h);
                    SetResLoad(false);
                    h = Get1Resource('DATA', 5);
                    SetResLoad(true);
                    const long empty = h && *h == nullptr;
                    LoadResource(h);
                    const long loaded = h && *h && GetHandleSize(h) == 3;
                    CloseResFile(ref);
                    return empty * 10 + loaded;
                },
                11, ""},
            {"DrawString without port",
                [] {
                    DrawString((const unsigned char*)"\1x");
                    return 0L;
                },
                0, ""},
        };
        for (const Case& c : cases) {
            m_recorder.texts.clear();
            QCOMPARE_EQ(c.call(), c.result);
            const QStringList expected = *c.assertion ? QStringList{c.assertion} : QStringList{};
            QVERIFY2(m_recorder.texts == expected,
                qPrintable(QStringLiteral("%1: %2").arg(
                    QLatin1String(c.name), m_recorder.texts.join(u'|'))));
        }
    }

private:
    Recorder m_recorder;
};

QTEST_APPLESS_MAIN(tst_ClassicHostile)
#include "hostile.moc"
