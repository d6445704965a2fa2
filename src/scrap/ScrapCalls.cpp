// The scrap calls: the clipboard's text in the host's encoding, with the Toolbox's answers
// for missing arguments and text-less clipboards.
#include <Velmar/Diagnostics.h>
#include <Velmar/MacErrors.h>
#include <Velmar/Scrap.h>
#include <Velmar/TextUtils.h>

#include "host/MacEncodingAscii.h"

#include <QClipboard>
#include <QGuiApplication>

#include <cstring>

namespace Velmar {

namespace {

// Every flavour call first asks for a flavour the scrap knows.
void checkFlavour(ScrapFlavorType flavorType)
{
    VELMAR_ASSERT(flavorType == kScrapFlavorTypeText || flavorType == kScrapFlavorTypePicture,
        "kScrapFlavorTypeText == flavorType || kScrapFlavorTypePicture == flavorType");
}

// After the arguments: only text is served. Pictures never were, so reaching one is the end
// of the process, as it always was.
void serveTextOnly(ScrapFlavorType flavorType, const char* call)
{
    if (flavorType != kScrapFlavorTypeText)
        qFatal("velmar_assert: FALSE\nLocation: %s:%d %s", __FILE__, __LINE__, call);
}

QClipboard* clipboard()
{
    return qobject_cast<QGuiApplication*>(QCoreApplication::instance())
        ? QGuiApplication::clipboard()
        : nullptr;
}

QString clipboardText()
{
    QClipboard* board = clipboard();
    return board ? board->text(QClipboard::Clipboard) : QString();
}

// The text as a block in the host's encoding; the block ends with a zero that no size counts.
QByteArray scrapText(const QString& text)
{
    return MakeLocal8Bit(text);
}

} // namespace

OSStatus GetCurrentScrap(ScrapRef* scrap)
{
    if (scrap)
        *scrap = nullptr;
    return noErr;
}

OSStatus ClearCurrentScrap()
{
    if (QClipboard* board = clipboard())
        board->clear(QClipboard::Clipboard);
    return noErr;
}

OSStatus GetScrapFlavorSize(ScrapRef, ScrapFlavorType flavorType, SInt32* size)
{
    checkFlavour(flavorType);
    if (!size)
        return kScrapMissingArgument;
    serveTextOnly(flavorType, "GetScrapFlavorSize");
    const QString text = clipboardText();
    if (text.isEmpty()) {
        *size = 0;
        return noTypeErr;
    }
    *size = SInt32(scrapText(text).size() - 1);
    return noErr;
}

OSStatus GetScrapFlavorFlags(ScrapRef, ScrapFlavorType flavorType, ScrapFlavorFlags* flags)
{
    checkFlavour(flavorType);
    if (flags)
        *flags = kScrapFlavorMaskNone;
    serveTextOnly(flavorType, "GetScrapFlavorFlags");
    return clipboardText().isEmpty() ? OSStatus(noTypeErr) : OSStatus(noErr);
}

OSStatus PutScrapFlavor(ScrapRef, ScrapFlavorType flavorType, ScrapFlavorFlags flavorFlags,
    SInt32 size, const void* data)
{
    checkFlavour(flavorType);
    VELMAR_ASSERT(flavorFlags == kScrapFlavorMaskNone, "kScrapFlavorMaskNone == flavorFlags");
    if (size <= 0 || !data)
        return kScrapMissingArgument;
    serveTextOnly(flavorType, "PutScrapFlavor");
    if (QClipboard* board = clipboard())
        board->setText(MakeQString(static_cast<const char*>(data), size), QClipboard::Clipboard);
    return noErr;
}

OSStatus GetScrapFlavorData(ScrapRef, ScrapFlavorType flavorType, SInt32* size, void* data)
{
    checkFlavour(flavorType);
    if (!size || !data)
        return kScrapMissingArgument;
    if (*size <= 0)
        return noTypeErr;
    serveTextOnly(flavorType, "GetScrapFlavorData");
    const QString text = clipboardText();
    if (text.isEmpty()) {
        *size = 0;
        return noTypeErr;
    }
    // Plain ASCII goes straight into the host's block.
    const qsizetype direct = Private::asciiToHostBytes(text, static_cast<char*>(data), *size);
    if (direct >= 0) {
        *size = SInt32(direct);
        return noErr;
    }
    const QByteArray bytes = scrapText(text);
    const SInt32 count = std::min(*size, SInt32(bytes.size() - 1));
    if (count > 0)
        std::memcpy(data, bytes.constData(), size_t(count));
    *size = std::max<SInt32>(count, 0);
    return noErr;
}

} // namespace Velmar
