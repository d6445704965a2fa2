// The menus a host would have loaded from 'MENU' resources, and AppendResMenu.
#include "menus/MenuPrivate.h"

#include <Velmar/Diagnostics.h>
#include <Velmar/TextUtils.h>

#include "quickdraw/FontTable.h"

#include <QSet>

namespace Velmar {

using namespace Private;

namespace {

QByteArray pascal(const QString& text)
{
    QByteArray bytes(256, '\0');
    QString2PascalString(text, reinterpret_cast<unsigned char*>(bytes.data()));
    return bytes;
}
const unsigned char* P(const QByteArray& bytes)
{
    return reinterpret_cast<const unsigned char*>(bytes.constData());
}

MenuRef makeMenu(SInt16 id, const QString& title, const QString& items)
{
    MenuRef menu = NewMenu(id, P(pascal(title)));
    if (!items.isEmpty())
        AppendMenu(menu, P(pascal(items)));
    return menu;
}

QString notLoadedItem(SInt16 id)
{
    return QStringLiteral("(We don't yet support loading menus from resources. MenuID: %1").arg(id);
}

void setItemText(MenuRef menu, UInt16 item, const char* text)
{
    SetMenuItemText(menu, item, P(pascal(QString::fromLatin1(text))));
}

bool isGridMenu(SInt16 id)
{
    return (id >= 120 && id <= 128) || id == 168 || id == 251 || id == 252 || id == 19120;
}

} // namespace

namespace Private {

MenuRef CreateUnknownMenu(SInt16 menuID)
{
    const QString title = QStringLiteral("Some kind of unknown menu. Contact Orrin ASAP!!!!! ")
        + QStringLiteral("MenuID#") + QString::number(menuID);
    return makeMenu(menuID, title, notLoadedItem(menuID));
}

} // namespace Private

MenuRef CreateDumbResourceMenu(SInt16 menuID)
{
    switch (menuID) {
    case 136:
        return makeMenu(menuID, QStringLiteral("NTSC Color Framing"), QStringLiteral("Even;Odd"));
    case 137:
        return makeMenu(menuID, QStringLiteral("PAL Color Framing"),
            QStringLiteral("A Standard;A Non-Standard;B Standard;B Non-Standard"));
    case 159: return makeMenu(menuID, QStringLiteral("Undo Stack"), QString());
    case 357: {
        // Item strings cannot carry a slash: the texts are set afterwards.
        MenuRef menu = makeMenu(
            menuID, QStringLiteral("AUDIF_DIGITALFORMAT"), QStringLiteral("AES-EBU;S-PDIF"));
        setItemText(menu, 1, "AES/EBU");
        setItemText(menu, 2, "S/PDIF");
        return menu;
    }
    case 1091: {
        QStringList delays;
        for (int fields = 4; fields <= 40; fields += 2)
            delays << QStringLiteral("%1 fields").arg(fields);
        return makeMenu(menuID, QStringLiteral("Edit Delays"), delays.join(QLatin1Char(';')));
    }
    case 1173: {
        MenuRef menu = makeMenu(menuID, QStringLiteral("File Type"),
            QStringLiteral("QuickTime Movie;Graphic;AIFF Audio;WAVE Audio;"
                           "Plain Text"));
        setItemText(menu, 2, "Graphic/Audio");
        return menu;
    }
    default: break;
    }
    if (isGridMenu(menuID))
        return makeMenu(menuID, QStringLiteral("Grid Menu"), notLoadedItem(menuID));
    const QByteArray message = "Creating menu with unknown ID: " + QByteArray::number(menuID);
    velmar_assert("false", __FILE__, __LINE__, __func__, message.constData());
    return CreateUnknownMenu(menuID);
}

void AppendResMenu(MenuRef menu, ResType type)
{
    if (!VELMAR_ASSERT(menu, "theMenu") || !VELMAR_CHECK_MENU(menu))
        return;
    if (type == FOUR_CHAR_CODE("FONT")) {
        // One item a family, in the font table's order; classic IDs share families.
        QSet<QString> seen;
        for (int i = 0; i < fontRowCount(); ++i) {
            const QString& family = fontRowAt(i).family;
            if (!family.isEmpty() && !seen.contains(family)) {
                seen.insert(family);
                menu->addAction(family);
            }
        }
        return;
    }
    VelmarLog(kLogNotImpl, "[E_NOTIMPL] Velmar::AppendResMenu is not implemented yet!");
    QAction* action = menu->addAction(
        QStringLiteral("We don't yet support loading menus from resources in AppendResMenu for "
                       "ResType: ")
        + FourCharToString(type));
    action->setEnabled(false);
}

} // namespace Velmar
