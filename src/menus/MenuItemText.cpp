// Items from item strings, and item texts.
#include "menus/MenuPrivate.h"
#include "foundation/Lifetime.h"

#include <Velmar/TextUtils.h>

#include <QRegularExpression>

namespace Velmar {

using namespace Private;

namespace {

// Marks, styles, command keys and icons have calls of their own: only the meta-character
// itself goes, so "Open/O" becomes "OpenO".
QString withoutMetaCharacters(QString text)
{
    static const QRegularExpression sMeta(QStringLiteral("[!</^]"));
    if (text.contains(sMeta))
        text.remove(sMeta);
    return text;
}

} // namespace

void AppendMenu(MenuRef menu, const unsigned char* data)
{
    if (VELMAR_CHECK_MENU(menu))
        InsertMenuItem(menu, data, SInt16(std::min<qsizetype>(menu->actions().size(), INT16_MAX)));
}

void InsertMenuItem(MenuRef menu, const unsigned char* data, SInt16 afterItem)
{
    if (!VELMAR_CHECK_MENU(menu))
        return;
    const QString text = withoutMetaCharacters(PascalString2QString(data));
    QAction* anchor = GetItemAction(menu, int(afterItem) + 1);
    for (QString part : text.split(QLatin1Char(';'), Qt::SkipEmptyParts)) {
        const bool disabled = part.contains(QLatin1Char('('));
        part.remove(QLatin1Char('('));
        if (part.startsWith(QLatin1Char('-'))) {
            menu->insertSeparator(anchor);
            continue;
        }
        auto* action = new QAction(part, menu.get());
        connectManagedItem(action);
        menu->insertAction(anchor, action);
        if (disabled)
            action->setEnabled(false);
    }
}

void AppendMenuItemText(MenuRef menu, const unsigned char* text)
{
    if (VELMAR_CHECK_MENU(menu))
        menu->addAction(PascalString2QString(text));
}

void DeleteMenuItem(MenuRef menu, UInt16 item)
{
    if (QAction* action = itemOf(menu, item)) {
        menu->removeAction(action);
        deleteWhenFree(action);
    }
}

void GetMenuItemText(MenuRef menu, UInt16 item, unsigned char* text)
{
    if (!text)
        return;
    text[0] = 0;
    if (QAction* action = itemOf(menu, item))
        QString2PascalString(action->isSeparator() ? QStringLiteral("-") : action->text(), text);
}

void SetMenuItemText(MenuRef menu, UInt16 item, const unsigned char* text)
{
    QAction* action = itemOf(menu, item);
    if (!action || !text)
        return;
    const int n = text[0];
    // A leading NUL escapes a leading dash: the item shows the dash and stays an item.
    const bool escapedDash = n >= 2 && text[1] == 0 && text[2] == '-';
    const char* bytes = reinterpret_cast<const char*>(text + 1);
    action->setText(escapedDash ? MakeQString(bytes + 1, n - 1) : MakeQString(bytes, n));
    action->setSeparator(n != 0 && text[1] == '-');
}

} // namespace Velmar
