// The Toolbox icon calls: plotting icons from handles and by family ID, the skinned paint
// calls, icon bounds and the icon-suite calls that have nothing to find.
#include <Velmar/HostShell.h>
#include <Velmar/MacErrors.h>
#include <Velmar/QDIcons.h>

#include "foundation/Conversions.h"
#include "foundation/NotImplemented.h"
#include "resources/ResourceAccess.h"

#include <QtGlobal>

#include <memory>

namespace Velmar {

using namespace Private;

namespace {

// Draws the icon a handle carries; `caller` names the call in its log lines.
void paintIconHandle(const char* caller, const ResourceHandle& handle, const Rect* rect,
    SInt32 transform, float opacity, const RGBColor* ink)
{
    AbstractIcon* icon = resourceIcon(handle);
    if (!icon) {
        qWarning("Velmar::%s: icon is NULL", caller);
        return;
    }
    if (!VELMAR_CHECK_RESOURCE(icon))
        return;
    icon->Draw(toQRect(rect), transform, opacity, ink, caller);
}

constexpr ResType kLargeFamily[] = {FOUR_CHAR_CODE("cicn"), FOUR_CHAR_CODE("icl8"),
    FOUR_CHAR_CODE("icl4"), FOUR_CHAR_CODE("ICON"), FOUR_CHAR_CODE("SICN"), FOUR_CHAR_CODE("ics8"),
    FOUR_CHAR_CODE("ics4"), FOUR_CHAR_CODE("ICN#"), FOUR_CHAR_CODE("cccn"), FOUR_CHAR_CODE("ics#")};
constexpr ResType kSmallFamily[] = {FOUR_CHAR_CODE("ics8"), FOUR_CHAR_CODE("ics4"),
    FOUR_CHAR_CODE("ics#"), FOUR_CHAR_CODE("ICN#"), FOUR_CHAR_CODE("cccn"), FOUR_CHAR_CODE("cicn"),
    FOUR_CHAR_CODE("ICON"), FOUR_CHAR_CODE("SICN")};

// The first member of the family that exists: large icons for a rectangle at least 17
// pixels wide (the height plays no part), small ones otherwise. A NullIcon when none does.
std::unique_ptr<AbstractIcon> familyIcon(const Rect* rect, SInt16 id)
{
    const bool large = rect && rect->right - rect->left >= 17;
    const auto pick = [id](const auto& family) {
        for (ResType type : family) {
            std::unique_ptr<AbstractIcon> icon(LoadIcon(type, id));
            if (!dynamic_cast<NullIcon*>(icon.get()))
                return icon;
        }
        return std::unique_ptr<AbstractIcon>(new NullIcon);
    };
    return large ? pick(kLargeFamily) : pick(kSmallFamily);
}

} // namespace

void PlotIcon(const Rect* rect, ResourceHandle icon)
{
    paintIconHandle("PlotIcon", icon, rect, 0, 1.0f, nullptr);
}

void PlotIcon(const Rect* rect, ResourceHandle icon, float, RGBColor)
{
    PlotCIcon(rect, icon);
}

void PlotCIcon(const Rect* rect, ResourceHandle icon)
{
    paintIconHandle("PlotCIcon", icon, rect, 0, 1.0f, nullptr);
}

void PlotCIcon(const Rect* rect, ResourceHandle icon, float opacity, RGBColor color)
{
    paintIconHandle("PlotCIcon", icon, rect, 0, opacity, &color);
}

SInt16 PlotCIconHandle(const Rect* rect, SInt16, SInt16 transform, ResourceHandle icon)
{
    paintIconHandle("PlotCIconHandle", icon, rect, transform, 1.0f, nullptr);
    return noErr;
}

SInt16 PlotIconID(const Rect* rect, SInt16, SInt16 transform, SInt16 id)
{
    familyIcon(rect, id)->Draw(toQRect(rect), transform, 1.0f, nullptr, "PlotIconID");
    return noErr;
}

SInt16 PlotIconID(
    const Rect* rect, SInt16, SInt16 transform, SInt16 id, float opacity, RGBColor color)
{
    familyIcon(rect, id)->Draw(toQRect(rect), transform, opacity, &color, "PlotIconID");
    return noErr;
}

Rect GetCIconBounds(ResourceHandle handle)
{
    auto* icon = static_cast<AbstractIcon*>(handle.data());
    if (handle.getType() != RT_ICON || !VELMAR_CHECK_RESOURCE(icon))
        return Rect{0, 0, 0, 0};
    return toRect(icon->image().rect());
}

OSErr GetIconSuite(Handle* suite, SInt16, UInt32)
{
    if (suite)
        *suite = nullptr;
    return noErr;
}

OSErr GetIconFromSuite(Handle* icon, Handle, ResType)
{
    if (icon)
        *icon = nullptr;
    return noErr;
}

OSErr PlotIconSuite(const Rect*, SInt16, SInt16, Handle)
{
    return unimpErr;
}

Boolean PtInIconID(Point, const Rect*, SInt16, SInt16)
{
    notImplemented("PtInIconID");
    return false;
}

void PaintSiconIndexed(ResourceHandle icon, const Rect& rect, SInt16 index, SInt16 state)
{
    RGBColor color;
    if (Palette::PaletteManager::Instance()->GetTxRGBColorBasedOnHighlightIndex(
            QStringLiteral("ButtonResourceColor"), color))
        PaintSiconIndexed(icon, rect, index, state, 1.0f, color);
    else // no such palette colour: the foreground colour, as an untinted draw has
        paintIconHandle("PaintSiconIndexed", icon, &rect, 0, 1.0f, nullptr);
}

void PaintSiconIndexed(
    ResourceHandle icon, const Rect& rect, SInt16, SInt16, float opacity, RGBColor color)
{
    paintIconHandle("PaintSiconIndexed", icon, &rect, 0, opacity, &color);
}

void PaintCiconEx(
    ResourceHandle icon, TxRect rect, float opacity, TxRGBColor* firstColor, TxRGBColor*, bool)
{
    paintIconHandle("PaintCiconEx", icon, &rect, 0, opacity, firstColor);
}

void PaintSiconEx(
    ResourceHandle icon, TxRect rect, float opacity, TxRGBColor* firstColor, TxRGBColor*, bool)
{
    paintIconHandle("PaintSiconEx", icon, &rect, 0, opacity, firstColor);
}

} // namespace Velmar
