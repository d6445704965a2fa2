// The scrap on the real X clipboard: the calls' answers, text in the host's encoding, a second
// process reading what the library put and putting what the library reads, TextEdit's copy
// read back as scrap, and the picture flavour's fatal end.
#include "TestSupport.h"
#include "WindowSystemNeeds.h"

#include <Velmar/MacErrors.h>
#include <Velmar/Scrap.h>
#include <Velmar/TextEdit.h>
#include <Velmar/Windows.h>

#include <QClipboard>
#include <QProcess>

using namespace Velmar;

namespace {

// The peer asks us for the clipboard's data: our event loop must run while it does.
QString peerRead()
{
    QProcess peer;
    QEventLoop loop;
    QObject::connect(&peer, &QProcess::finished, &loop, &QEventLoop::quit);
    QTimer::singleShot(10000, &loop, &QEventLoop::quit);
    peer.start(QStringLiteral(VELMAR_PEER), {QStringLiteral("clip-get")});
    loop.exec();
    if (peer.state() != QProcess::NotRunning)
        return QStringLiteral("<no answer>");
    const QString out = QString::fromUtf8(peer.readAllStandardOutput()).trimmed();
    return out.startsWith(QLatin1String("text: ")) ? out.mid(6)
                                                   : QStringLiteral("<") + out + QLatin1Char('>');
}

QByteArray scrapBytes(OSStatus* status = nullptr, SInt32 room = 256)
{
    QByteArray buffer(room, '\xEE');
    SInt32 size = room;
    const OSStatus err = GetScrapFlavorData(nullptr, kScrapFlavorTypeText, &size, buffer.data());
    if (status)
        *status = err;
    return buffer.left(size);
}

} // namespace

class TestScrap : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void answers()
    {
        VELMAR_REQUIRE_CLIPBOARD();
        ScrapRef scrap = reinterpret_cast<ScrapRef>(0x1234);
        QCOMPARE(GetCurrentScrap(&scrap), OSStatus(noErr));
        QCOMPARE(scrap, nullptr);
        QCOMPARE(ClearCurrentScrap(), OSStatus(noErr));
        SInt32 size = 77;
        QCOMPARE(GetScrapFlavorSize(nullptr, kScrapFlavorTypeText, &size), OSStatus(noTypeErr));
        QCOMPARE(size, SInt32(0));
        ScrapFlavorFlags flags = 9;
        QCOMPARE(GetScrapFlavorFlags(nullptr, kScrapFlavorTypeText, &flags), OSStatus(noTypeErr));
        QCOMPARE(flags, ScrapFlavorFlags(0));
        OSStatus err = 0;
        QVERIFY(scrapBytes(&err).isEmpty());
        QCOMPARE(err, OSStatus(noTypeErr));

        // Missing arguments are 1, checked before the flavour (a picture would be fatal).
        QCOMPARE(GetScrapFlavorSize(nullptr, kScrapFlavorTypePicture, nullptr), OSStatus(1));
        QCOMPARE(PutScrapFlavor(nullptr, kScrapFlavorTypePicture, 0, 0, "x"), OSStatus(1));
        QCOMPARE(PutScrapFlavor(nullptr, kScrapFlavorTypeText, 0, 3, nullptr), OSStatus(1));
        QCOMPARE(PutScrapFlavor(nullptr, kScrapFlavorTypeText, 0, -3, "abc"), OSStatus(1));
        char byte = 0;
        QCOMPARE(GetScrapFlavorData(nullptr, kScrapFlavorTypePicture, nullptr, &byte), OSStatus(1));
        size = 0;
        QCOMPARE(
            GetScrapFlavorData(nullptr, kScrapFlavorTypeText, &size, &byte), OSStatus(noTypeErr));

        QCOMPARE(PutScrapFlavor(nullptr, kScrapFlavorTypeText, 0, 5, "hello"), OSStatus(noErr));
        QCOMPARE(GetScrapFlavorSize(nullptr, kScrapFlavorTypeText, &size), OSStatus(noErr));
        QCOMPARE(size, SInt32(5));
        QCOMPARE(scrapBytes(&err, 3), QByteArray("hel")); // the buffer's size
        QCOMPARE(err, OSStatus(noErr));
        QCOMPARE(PutScrapFlavor(nullptr, kScrapFlavorTypeText, 0, 0, "gone"), OSStatus(1));
        QCOMPARE(scrapBytes(), QByteArray("hello")); // unchanged

        VelmarTest::IgnoredAssertions asserts;
        PutScrapFlavor(nullptr, kScrapFlavorTypeText, 1, 2, "ab");
        PutScrapFlavor(nullptr, FOUR_CHAR_CODE("snd "), 0, 0, "ab"); // size 0: no further
        QCOMPARE(asserts.texts(),
            (QStringList{"kScrapFlavorMaskNone == flavorFlags",
                "kScrapFlavorTypeText == flavorType || kScrapFlavorTypePicture == flavorType"}));
    }

    // A second application on the same X server reads and writes the clipboard we use.
    void anotherProcess()
    {
        VELMAR_REQUIRE_CLIPBOARD();
        const QByteArray roman = "caf\x8E na\x95ve \xA5"; // café naïve • in Mac OS Roman
        QCOMPARE(PutScrapFlavor(
                     nullptr, kScrapFlavorTypeText, 0, SInt32(roman.size()), roman.constData()),
            OSStatus(noErr));
        QCOMPARE(peerRead(), QString::fromUtf8("café naïve •"));

        QProcess owner;
        owner.start(QStringLiteral(VELMAR_PEER),
            {QStringLiteral("clip-set"), QString::fromUtf8("naïve ✓ 100 KB")});
        QVERIFY(owner.waitForReadyRead(10000));
        QTRY_COMPARE(QGuiApplication::clipboard()->text(), QString::fromUtf8("naïve ✓ 100 KB"));
        // The check mark has no Mac OS Roman byte: it comes as '?'.
        QCOMPARE(scrapBytes(), QByteArray("na\x95ve ? 100 KB"));
        owner.closeWriteChannel();
        QVERIFY(owner.waitForFinished(10000));

        // A large text both ways.
        QByteArray big(1 << 20, 'x');
        QCOMPARE(
            PutScrapFlavor(nullptr, kScrapFlavorTypeText, 0, SInt32(big.size()), big.constData()),
            OSStatus(noErr));
        SInt32 size = 0;
        GetScrapFlavorSize(nullptr, kScrapFlavorTypeText, &size);
        QCOMPARE(size, SInt32(1 << 20));
        QCOMPARE(peerRead().size(), 1 << 20);
    }

    // What a TextEdit record copies is the scrap's text.
    void textEditCopyIsTheScrap()
    {
        VELMAR_REQUIRE_CLIPBOARD();
        const Rect bounds{100, 100, 200, 300}, view{10, 10, 90, 190};
        WindowRef window = NewCWindow(nullptr, &bounds,
            reinterpret_cast<const unsigned char*>("\x01T"), false, 0, nullptr, false, nullptr);
        SetPortWindowPort(window);
        TEPtr* te = TENew(&view, &view);
        TESetText("copy \xA5 me", 9, te);
        TESetSelect(5, 9, te);
        TECopy(te);
        QCOMPARE(scrapBytes(), QByteArray("\xA5 me"));
        QCOMPARE(TEGetScrapLength(), SInt32(4));
        PutScrapFlavor(nullptr, kScrapFlavorTypeText, 0, 3, "new");
        TESetSelect(0, 0, te);
        TEPaste(te);
        Handle text = TEGetText(te);
        QCOMPARE(QByteArray(*text, TxGetHandleSize(text)), QByteArray("newcopy \xA5 me"));
        TEDispose(te);
        DisposeWindow(window);
    }

    // A picture flavour with every argument given ends the process.
    void pictureIsFatal()
    {
        QProcess child;
        child.setProcessChannelMode(QProcess::MergedChannels);
        QProcessEnvironment env = QProcessEnvironment::systemEnvironment();
        env.insert(QStringLiteral("VELMAR_SCRAP_CHILD"), QStringLiteral("1"));
        child.setProcessEnvironment(env);
        child.start(QCoreApplication::applicationFilePath(), {QStringLiteral("pictureChild")});
        QVERIFY(child.waitForFinished(30000));
        QVERIFY(child.exitStatus() == QProcess::CrashExit || child.exitCode() != 0);
        QVERIFY(child.readAll().contains("velmar_assert: FALSE"));
    }
    void pictureChild()
    {
        if (qEnvironmentVariableIsEmpty("VELMAR_SCRAP_CHILD"))
            return;
        SInt32 size = 10;
        char data[10];
        GetScrapFlavorData(nullptr, kScrapFlavorTypePicture, &size, data);
    }
};

VELMAR_APP_TEST_MAIN(TestScrap)
#include "tst_scrap.moc"
