// Black-and-white icons plotted through CopyBits, as the classic calls did: an 'ICON' copied
// in srcCopy, an icon with a mask ('ICN#', a 'SICN' pair) by clearing the mask's pixels to
// the background and then laying the icon's black pixels over them. The icon is scaled to
// the largest square that fits the rectangle, placed by the alignment.
#include "classic/ClassicPrivate.h"

#include "classic/resfile/Decoders.h"

#include <algorithm>

using namespace VelmarClassic;

namespace {

Rect placed(const Rect& r, IconAlignmentType align)
{
    const int width = r.right - r.left, height = r.bottom - r.top;
    const int side = std::max(0, std::min(width, height));
    int left = r.left + (width - side) / 2, top = r.top + (height - side) / 2;
    switch (align & 0x0C) {
    case kAlignLeft: left = r.left; break;
    case kAlignRight: left = r.right - side; break;
    default: break;
    }
    switch (align & 0x03) {
    case kAlignTop: top = r.top; break;
    case kAlignBottom: top = r.bottom - side; break;
    default: break;
    }
    return Rect{short(top), short(left), short(top + side), short(left + side)};
}

// `icon` and `mask` (empty for none) are square bitmaps of `side` pixels.
OSErr plot(const Rect* theRect, IconAlignmentType align, IconTransformType transform,
    QByteArray icon, QByteArray mask, int side)
{
    if (!VELMAR_ASSERT(theRect, "theRect != NULL"))
        return paramErr;
    const Rect dst = placed(*theRect, align);
    const short rowBytes = short(side / 8);
    const Rect bounds{0, 0, short(side), short(side)};
    const Velmar::BitMap iconBits{icon.data(), rowBytes, bounds};
    if (mask.isEmpty()) {
        copyIntoCurrentPort(iconBits, dst, srcCopy);
        return noErr;
    }
    const Velmar::BitMap maskBits{mask.data(), rowBytes, bounds};
    // Selected: the mask's pixels dark and the icon's bits light, as a selected icon showed.
    const bool selected = (transform & kTransformSelected) != 0;
    copyIntoCurrentPort(maskBits, dst, selected ? srcOr : srcBic);
    copyIntoCurrentPort(iconBits, dst, selected ? srcBic : srcOr);
    return noErr;
}

OSErr plotBytes(const Rect* theRect, IconAlignmentType align, IconTransformType transform,
    const QByteArray& bytes)
{
    if (const auto family = Velmar::Classic::decodeIconList(bytes))
        return plot(theRect, align, transform, family->icon, family->mask, 32);
    if (const auto icon = Velmar::Classic::decodeIcon(bytes))
        return plot(theRect, align, transform, *icon, QByteArray(), 32);
    return paramErr;
}

} // namespace

void PlotIcon(const Rect* theRect, Handle theIcon)
{
    if (!VELMAR_ASSERT(theRect, "theRect != NULL")
        || !VELMAR_ASSERT(isLiveHandle(theIcon), "IsValidHandle(theIcon)"))
        return;
    const QByteArray bytes = handleBytes(theIcon);
    if (bytes.size() >= 128)
        plot(theRect, kAlignNone, kTransformNone, bytes.left(128), QByteArray(), 32);
}

OSErr PlotIconID(
    const Rect* theRect, IconAlignmentType align, IconTransformType transform, short theResID)
{
    if (!VELMAR_ASSERT(theRect, "theRect != NULL"))
        return paramErr;
    ensureStarted();
    if (const auto family = resourceBytes('ICN#', theResID))
        return plotBytes(theRect, align, transform, *family);
    if (const auto icon = resourceBytes('ICON', theResID))
        return plotBytes(theRect, align, transform, *icon);
    return resNotFound;
}

OSErr PlotIconHandle(
    const Rect* theRect, IconAlignmentType align, IconTransformType transform, Handle theIcon)
{
    if (!VELMAR_ASSERT(theRect, "theRect != NULL")
        || !VELMAR_ASSERT(isLiveHandle(theIcon), "IsValidHandle(theIcon)"))
        return paramErr;
    return plotBytes(theRect, align, transform, handleBytes(theIcon));
}

OSErr PlotSICNHandle(
    const Rect* theRect, IconAlignmentType align, IconTransformType transform, Handle theSICN)
{
    if (!VELMAR_ASSERT(theRect, "theRect != NULL")
        || !VELMAR_ASSERT(isLiveHandle(theSICN), "IsValidHandle(theSICN)"))
        return paramErr;
    const auto icons = Velmar::Classic::decodeSmallIcons(handleBytes(theSICN));
    if (!icons)
        return paramErr;
    return plot(theRect, align, transform, icons->at(0),
        icons->size() > 1 ? icons->at(1) : QByteArray(), 16);
}
