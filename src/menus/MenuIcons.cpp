// Item icons from icon resources.
#include "menus/MenuPrivate.h"

#include <Velmar/QDIcons.h>
#include <Velmar/Resources.h>

#include "resources/ResourceAccess.h"

#include <QIcon>
#include <QPixmap>

namespace Velmar {

using namespace Private;

namespace {

// Resource icons of items are numbered from 256.
constexpr SInt16 kItemIconBase = 256;

ResourceHandle loadItemIcon(const QAction* action, SInt16 id)
{
    if (itemCmd(action) == kMenuSmallIconCmd)
        return GetSIcon(id);
    ResourceHandle colour = GetCIcon(id);
    if (!colour.isNull())
        return colour;
    ReleaseResource(colour);
    return GetIcon(id);
}

} // namespace

void GetItemIcon(MenuRef menu, UInt16 item, SInt16* icon)
{
    QAction* action = itemOf(menu, item);
    if (action && icon)
        *icon = shortProperty(action, kItemIconProperty);
}

void SetItemIcon(MenuRef menu, UInt16 item, SInt16 icon)
{
    QAction* action = itemOf(menu, item);
    if (!action)
        return;
    action->setProperty(kItemIconProperty, icon);
    if (icon == 0) {
        action->setIcon(QIcon());
        return;
    }
    ResourceHandle resource = loadItemIcon(action, SInt16(icon + kItemIconBase));
    if (!resource.isNull()) {
        if (AbstractIcon* loaded = resourceIcon(resource))
            action->setIcon(QIcon(QPixmap::fromImage(loaded->image())));
    }
    ReleaseResource(resource);
}

} // namespace Velmar
