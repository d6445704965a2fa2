// Font ID, size and face to QFont, with the host's application-font overrides.
#include "quickdraw/FontSelection.h"

#include <Velmar/Diagnostics.h>
#include <Velmar/HostShell.h>
#include <Velmar/QDText.h>

#include "quickdraw/FontTable.h"

#include <QGuiApplication>

namespace Velmar::Private {

namespace {

// Pixels at 96 per inch to points.
constexpr qreal kPointsPerPixel = 0.75;

struct SizeSetting {
    SInt16 size;
    const char* key;
};

constexpr SizeSetting kSizeSettings[] = {
    {6, "AppFontSizeItsyBitsy"},
    {7, "AppFontSizeTiny"},
    {9, "AppFontSizeVerySmall"},
    {10, "AppFontSizeSmall"},
    {11, "AppFontSizeMedium"},
    {12, "AppFontSizeLarge"},
    {18, "AppFontSizeVeryLarge"},
    {64, "AppFontSizeHumongous"},
};

// The ID of the family the host configured as its application font, or -1 when it
// configured none.
SInt16 configuredAppFontId()
{
    QString name;
    const Palette::PaletteManager* palette = Palette::PaletteManager::Instance();
    if (!palette || !palette->GetString(QStringLiteral("AppFontNameWin"), name))
        return -1;
    SInt16 id = fontIdByFamily(name);
    if (id < 0)
        id = fontIdByToolboxName(name);
    return id < 0 ? SInt16(applFont) : id;
}

qreal applicationPointSize()
{
    const QFont app = QGuiApplication::font();
    if (app.pointSizeF() > 0)
        return app.pointSizeF();
    if (app.pixelSize() > 0)
        return app.pixelSize() * kPointsPerPixel;
    return 9.0;
}

} // namespace

SInt16 applyFontFamily(QFont& font, SInt16 id, bool appFont)
{
    if (appFont) {
        const SInt16 configured = configuredAppFontId();
        if (configured >= 0)
            id = configured;
    }
    const FontRow* row = fontRowById(id);
    if (!row) {
        VelmarLog(kLogQuickDraw, "getFontStyle(): Unknown font ID - %d", id);
        row = findFontRow(applFont);
    }
    font.setFamily(row->family);
    // An outline face set before keeps its strategy; the rest is the default strategy.
    const auto strategy =
        font.styleStrategy() & QFont::PreferOutline ? QFont::PreferOutline : QFont::PreferDefault;
    font.setStyleHint(row->hint, strategy);
    return row->id;
}

void applyFontSize(QFont& font, SInt16 size, bool appFont)
{
    if (size < 0) {
        VelmarLog(kLogQuickDraw,
            "warning: TextSize: size %d is negative; the application "
            "font's size is used",
            size);
        size = 0;
    }
    if (size == 0) {
        font.setPointSizeF(applicationPointSize());
        return;
    }
    if (appFont) {
        const Palette::PaletteManager* palette = Palette::PaletteManager::Instance();
        for (const SizeSetting& s : kSizeSettings) {
            UInt16 configured = 0;
            if (s.size == size && palette
                && palette->GetUint16(QString::fromLatin1(s.key), configured) && configured > 0) {
                size = SInt16(std::min<UInt16>(configured, INT16_MAX));
                break;
            }
        }
    }
    font.setPointSizeF(size * kPointsPerPixel);
}

void applyFontFace(QFont& font, SInt16 face)
{
    const UInt8 bits = UInt8(face);
    font.setWeight(bits & bold ? QFont::Bold : QFont::Normal);
    font.setItalic(bits & italic);
    font.setUnderline(bits & underline);
    const int strategy = font.styleStrategy() & ~QFont::PreferOutline;
    font.setStyleStrategy(
        QFont::StyleStrategy(bits & outline ? strategy | QFont::PreferOutline : strategy));
    font.setStretch(bits & condense ? 75 : QFont::AnyStretch);
}

} // namespace Velmar::Private
