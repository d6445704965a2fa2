// Menu fonts: a menu's own font, or the application font with the global menu family and
// size, applied before each showing.
#include "menus/MenuPrivate.h"

#include <Velmar/MacErrors.h>
#include <Velmar/QDText.h>

#include "quickdraw/FontSelection.h"

#include <QGuiApplication>

namespace Velmar {

using namespace Private;

namespace {

struct GlobalMenuFont {
    SInt16 family = 0; // 0: the application font's
    SInt16 size = 0;
};
GlobalMenuFont gMenuFont;

} // namespace

namespace Private {

void ApplyMenuFont(QMenu* menu)
{
    if (!menu)
        return;
    const QVariant custom = menu->property(kMenuCustomFontProperty);
    if (custom.isValid() && custom.canConvert<QFont>()) {
        menu->setFont(custom.value<QFont>());
        return;
    }
    QFont font = QGuiApplication::font();
    if (gMenuFont.size)
        applyFontSize(font, gMenuFont.size, false);
    if (gMenuFont.family)
        applyFontFamily(font, gMenuFont.family, false);
    menu->setFont(font);
}

} // namespace Private

OSStatus SetMenuFont(MenuRef menu, SInt16 fontID, UInt16 size)
{
    if (!VELMAR_ASSERT(menu, "menu") || !VELMAR_CHECK_MENU(menu))
        return menuInvalidErr;
    menu->setProperty(kMenuCustomFontProperty,
        TxFontSizeFaceToQFont(fontID, SInt16(std::min<UInt16>(size, INT16_MAX)), normal, false));
    return noErr;
}

void SetGlobalMenuFontSize(SInt16 size)
{
    gMenuFont.size = size;
}

SInt16 GetGlobalMenuFontSize()
{
    return gMenuFont.size;
}

void SetGlobalMenuFontFamily(SInt16 fontID)
{
    gMenuFont.family = fontID;
}

SInt16 GetGlobalMenuFontFamily()
{
    return gMenuFont.family;
}

} // namespace Velmar
