// Calls that read one resource type: strings, string lists, cursors, patterns, icons and
// pictures (icons are plotted in Icons.cpp). Records programs read field by field (a cursor, a
// picture's frame) are put in the machine's byte order in their handle; the rest stays in the
// file's bytes.
#include "classic/ClassicPrivate.h"

#include "classic/resfile/Decoders.h"
#include "classic/resfile/Picture.h"

#include <QBitmap>
#include <QCursor>
#include <QImage>

#include <cstring>
#include <map>
#include <unordered_set>

namespace {

using namespace VelmarClassic;

// Handles whose leading big-endian words were turned to the machine's order.
std::unordered_set<Handle>& hostOrder()
{
    static auto* set = new std::unordered_set<Handle>;
    return *set;
}

void swapWords(Handle h, int words)
{
    if (!isLiveHandle(h) || hostOrder().count(h) || GetHandleSize(h) < words * 2)
        return;
    auto* bytes = reinterpret_cast<unsigned char*>(*h);
    for (int i = 0; i < words; ++i) {
        const unsigned short value = (unsigned short)(bytes[2 * i] << 8 | bytes[2 * i + 1]);
        std::memcpy(bytes + 2 * i, &value, 2);
    }
    hostOrder().insert(h);
}

} // namespace

StringHandle GetString(short stringID)
{
    return reinterpret_cast<StringHandle>(GetResource('STR ', stringID));
}

void GetIndString(Str255 theString, short strListID, short index)
{
    if (!VELMAR_ASSERT(theString, "theString != NULL"))
        return;
    theString[0] = 0;
    const std::optional<QByteArray> bytes = resourceBytes('STR#', strListID);
    const auto list = bytes ? Velmar::Classic::decodeStringList(*bytes) : std::nullopt;
    if (list && index >= 1 && index <= list->size())
        copyToStr255(list->at(index - 1), theString);
}

StringHandle NewString(ConstStr255Param theString)
{
    return newStringHandle(theString);
}

void SetString(StringHandle h, ConstStr255Param theString)
{
    if (!VELMAR_ASSERT(isLiveHandle(reinterpret_cast<Handle>(h)), "IsValidHandle(h)") || !theString)
        return;
    SetHandleSize(reinterpret_cast<Handle>(h), theString[0] + 1);
    if (MemError() == noErr)
        std::memcpy(*h, theString, size_t(theString[0]) + 1);
}

CursHandle GetCursor(short cursorID)
{
    const Handle h = GetResource('CURS', cursorID);
    swapWords(h, 34); // data, mask, hot spot
    return reinterpret_cast<CursHandle>(h);
}

void InitCursor()
{
    ensureStarted();
    Velmar::InitCursor();
}

void SetCursor(const Cursor* crsr)
{
    if (!VELMAR_ASSERT(crsr, "crsr != NULL"))
        return;
    ensureStarted();
    // One library cursor per picture, made on first use.
    static std::map<QByteArray, Velmar::CursPtr*> made;
    const QByteArray key(reinterpret_cast<const char*>(crsr), sizeof(Cursor));
    Velmar::CursPtr*& cursor = made[key];
    if (!cursor) {
        uchar data[32], mask[32];
        for (int i = 0; i < 16; ++i) {
            data[2 * i] = uchar(crsr->data[i] >> 8);
            data[2 * i + 1] = uchar(crsr->data[i]);
            mask[2 * i] = uchar(crsr->mask[i] >> 8);
            mask[2 * i + 1] = uchar(crsr->mask[i]);
        }
        const QBitmap bits = QBitmap::fromData(QSize(16, 16), data, QImage::Format_Mono);
        const QBitmap maskBits = QBitmap::fromData(QSize(16, 16), mask, QImage::Format_Mono);
        cursor = new Velmar::CursPtr(QCursor(bits, maskBits, crsr->hotSpot.h, crsr->hotSpot.v));
    }
    Velmar::SetCCursor(cursor);
}

void HideCursor()
{
    Velmar::HideCursor();
}
void ShowCursor()
{
    Velmar::ShowCursor();
}
void ObscureCursor()
{
    Velmar::ObscureCursor();
}

PatHandle GetPattern(short patternID)
{
    return reinterpret_cast<PatHandle>(GetResource('PAT ', patternID));
}

void GetIndPattern(Pattern* thePat, short patternListID, short index)
{
    if (!VELMAR_ASSERT(thePat, "thePat != NULL"))
        return;
    const std::optional<QByteArray> bytes = resourceBytes('PAT#', patternListID);
    const auto list = bytes ? Velmar::Classic::decodePatternList(*bytes) : std::nullopt;
    if (list && index >= 1 && index <= list->size())
        std::memcpy(thePat->pat, list->at(index - 1).pat.data(), 8);
}

PicHandle GetPicture(short pictureID)
{
    const Handle h = GetResource('PICT', pictureID);
    swapWords(h, 5); // picSize and picFrame
    return reinterpret_cast<PicHandle>(h);
}

void DrawPicture(PicHandle myPicture, const Rect* dstRect)
{
    const Handle h = reinterpret_cast<Handle>(myPicture);
    if (!VELMAR_ASSERT(isLiveHandle(h), "IsValidHandle(myPicture)")
        || !VELMAR_ASSERT(dstRect, "dstRect != NULL"))
        return;
    QByteArray bytes = handleBytes(h);
    if (hostOrder().count(h) && bytes.size() >= 10)
        for (int i = 0; i < 5; ++i) {
            unsigned short value;
            std::memcpy(&value, bytes.constData() + 2 * i, 2);
            bytes[2 * i] = char(value >> 8);
            bytes[2 * i + 1] = char(value & 0xFF);
        }
    drawInPort([&] { Velmar::Classic::drawPicture(bytes, *dstRect); });
}

void KillPicture(PicHandle myPicture)
{
    const Handle h = reinterpret_cast<Handle>(myPicture);
    hostOrder().erase(h);
    if (HomeResFile(h) >= 0)
        ReleaseResource(h);
    else
        DisposeHandle(h);
}

Handle GetIcon(short iconID)
{
    return GetResource('ICON', iconID);
}
