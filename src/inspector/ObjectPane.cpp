#include "inspector/ObjectPane.h"

#include <Velmar/AQtWindow.h>
#include <Velmar/Application.h>
#include <Velmar/QtGrafPort.h>

#include "inspector/InspectorNames.h"
#include "inspector/InspectorRows.h"
#include "menus/MenuPrivate.h"
#include "quickdraw/GrafPortPrivate.h"
#include "windows/WindowPrivate.h"

#include <QMenuBar>
#include <QTreeWidget>

namespace Velmar::Private::Inspector {

namespace {

// A region as the tree shows it: bounding rectangle and rectangle count.
struct RegionSummary {
    QRect bounds;
    int rects = 0;
};

RegionSummary summaryOf(const QRegion& region)
{
    return {region.boundingRect(), region.rectCount()};
}

struct RegionRow {
    const char* name;
    RegionSummary (*summary)(AQtWindow* window, QtGrafPort* port);
};

// Update region and dirty area are the window's (widget coordinates); visible and clip
// region the port's (local coordinates).
const RegionRow kRegionRows[] = {
    {"update region", [](AQtWindow* w, QtGrafPort*) { return summaryOf(w->updateRegion()); }},
    {"visible region", [](AQtWindow*, QtGrafPort* p) { return summaryOf(p->visibleRegion); }},
    {"clip region", [](AQtWindow*, QtGrafPort* p) { return summaryOf(p->clipRegion); }},
    {"dirty area",
     [](AQtWindow* w, QtGrafPort*) {
         const QRect& dirty = w->dirtyPortRegion();
         return RegionSummary{dirty, dirty.isNull() ? 0 : 1};
     }},
};

// Toolbox-style rectangle text: right and bottom are exclusive.
QString boundsText(const QRect& r)
{
    return rectText(r.left(), r.top(), qint64(r.left()) + r.width(), qint64(r.top()) + r.height());
}

QString addressText(const void* p)
{
    return QStringLiteral("0x%1").arg(quintptr(p), 0, 16);
}

RowValues rectValues(const QRect& r, qint64 extra0 = 0, qint64 extra1 = 0, qint64 extra2 = 0)
{
    RowValues v;
    v.n = {r.left(), r.top(), r.width(), r.height(), extra0, extra1, extra2, 0};
    return v;
}

QString commandKeyText(const QAction* action, SInt16 cmd)
{
    if (cmd == hMenuCmd)
        return QStringLiteral("submenu");
    if (cmd == kMenuSmallIconCmd)
        return QStringLiteral("small icon");
    return action->shortcut().toString(QKeySequence::NativeText);
}

// The value a host dispatches an item's choice on: menu ID high, item number low.
UInt32 menuChoice(SInt16 menuID, int item)
{
    return (UInt32(UInt16(menuID)) << 16) | UInt32(UInt16(item));
}

} // namespace

ObjectPane::ObjectPane(QWidget* parent)
    : QWidget(parent),
      m_tree(makeTree(this, QStringLiteral("objectTree"), QStringLiteral("Object")))
{}

void ObjectPane::refresh()
{
    struct GroupRow {
        const char* title;
        void (ObjectPane::*refresh)(Row* group);
    };
    static const GroupRow kGroups[] = {
        {"Windows", &ObjectPane::refreshWindows},
        {"Offscreen ports", &ObjectPane::refreshOffscreenPorts},
        {"Menus", &ObjectPane::refreshMenus},
    };
    RowSync groups(m_tree->invisibleRootItem());
    quintptr key = 0;
    for (const GroupRow& g : kGroups)
        (this->*g.refresh)(groupRow(groups, ++key, g.title));
}

void ObjectPane::refreshWindows(Row* group)
{
    RowSync rows(group);
    for (AQtWindow* window : windowList()) {
        // Only through the registry: a window disposed since the last refresh is skipped
        // here and its row goes with the pass.
        if (!isLive(window) || window->IsDeletePending())
            continue;
        RowValues v;
        v.text = window->windowTitle();
        v.n = {qint64(window->windowClass()), window->kind(), window->isVisible(),
               window->isDirectQtDrawing(), window->width(), window->height(), 0, 0};
        bool changed = false;
        Row* row = rows.next(keyOf(window), v, &changed);
        if (changed) {
            row->setColumn(kObjectColumn, QStringLiteral("\"%1\"").arg(v.text));
            row->setColumn(kStateColumn,
                QStringLiteral("%1, kind %2, %3, %4, %5x%6")
                    .arg(windowClassName(window->windowClass()))
                    .arg(window->kind())
                    .arg(window->isVisible() ? QStringLiteral("visible") : QStringLiteral("hidden"))
                    .arg(window->isDirectQtDrawing() ? QStringLiteral("direct drawing")
                                                     : QStringLiteral("back buffer"))
                    .arg(window->width())
                    .arg(window->height()));
        }
        refreshWindowPort(row, window);
    }
    setCount(group, rows.count());
}

void ObjectPane::refreshWindowPort(Row* windowRow, AQtWindow* window)
{
    RowSync rows(windowRow);
    QtGrafPort* port = window->GetPort();
    if (!isLivePort(port))
        return;
    bool changed = false;
    Row* portRow = rows.next(keyOf(port), rectValues(port->bounds), &changed);
    if (changed) {
        portRow->setColumn(kObjectColumn, QStringLiteral("port ") + addressText(port));
        portRow->setColumn(kStateColumn, QStringLiteral("bounds ") + boundsText(port->bounds));
    }
    RowSync regions(portRow);
    quintptr key = 0;
    for (const RegionRow& r : kRegionRows) {
        const RegionSummary s = r.summary(window, port);
        Row* row = regions.next(++key, rectValues(s.bounds, s.rects), &changed);
        if (changed) {
            row->setColumn(kObjectColumn, QLatin1String(r.name));
            row->setColumn(kStateColumn,
                s.rects == 0 ? QStringLiteral("empty")
                             : QStringLiteral("%1, %2 rect%3")
                                   .arg(boundsText(s.bounds))
                                   .arg(s.rects)
                                   .arg(s.rects == 1 ? QString() : QStringLiteral("s")));
        }
    }
}

void ObjectPane::refreshOffscreenPorts(Row* group)
{
    RowSync rows(group);
    for (QtGrafPort* port : livePorts()) {
        if (!isLivePort(port) || port->window)
            continue;
        const SInt16 depth = port->pixmap ? port->pixmap->pixelDepth() : 0;
        bool changed = false;
        Row* row = rows.next(keyOf(port), rectValues(port->bounds, depth, port->image() != nullptr),
                             &changed);
        if (changed) {
            row->setColumn(kObjectColumn, QStringLiteral("port ") + addressText(port));
            row->setColumn(kStateColumn,
                QStringLiteral("bounds %1, depth %2%3")
                    .arg(boundsText(port->bounds))
                    .arg(depth)
                    .arg(port->image() ? QString() : QStringLiteral(", no pixels")));
        }
    }
    setCount(group, rows.count());
}

void ObjectPane::refreshMenus(Row* group)
{
    RowSync rows(group);
    if (QMenuBar* bar = applicationMenuBar()) {
        for (QAction* barAction : bar->actions()) {
            QMenu* menu = barAction->menu();
            if (!isLive(menu))
                continue; // a menu the library does not manage
            const SInt16 menuID = shortProperty(menu, kMenuIdProperty);
            const QList<QAction*> items = menu->actions();
            RowValues v;
            v.text = menu->title();
            v.n = {menuID, items.size(), menu->isEnabled(), 0, 0, 0, 0, 0};
            bool changed = false;
            Row* menuRow = rows.next(keyOf(menu), v, &changed);
            if (changed) {
                menuRow->setColumn(kObjectColumn, QStringLiteral("\"%1\"").arg(v.text));
                menuRow->setColumn(kStateColumn,
                    QStringLiteral("ID %1, %2 items%3")
                        .arg(menuID)
                        .arg(items.size())
                        .arg(menu->isEnabled() ? QString() : QStringLiteral(", disabled")));
            }
            RowSync itemRows(menuRow);
            int number = 0;
            for (QAction* action : items) {
                ++number;
                const SInt16 cmd = itemCmd(action);
                const SInt16 mark = itemMark(action);
                RowValues iv;
                iv.text = action->text();
                iv.n = {number, cmd, mark, shortProperty(action, kItemModifiersProperty),
                        action->isEnabled(), action->isSeparator(), menuID, 0};
                Row* itemRow = itemRows.next(keyOf(action), iv, &changed);
                if (!changed)
                    continue;
                itemRow->setColumn(kObjectColumn,
                    QStringLiteral("%1  %2").arg(number).arg(
                        action->isSeparator() ? QStringLiteral("-") : iv.text));
                QString state = QStringLiteral("command ID 0x%1")
                                    .arg(menuChoice(menuID, number), 8, 16, QLatin1Char('0'));
                if (const QString key = commandKeyText(action, cmd); !key.isEmpty())
                    state += QStringLiteral(", key ") + key;
                if (cmd == hMenuCmd)
                    state += QStringLiteral(", submenu ID %1").arg(mark);
                else if (const QString m = markName(mark); !m.isEmpty())
                    state += QStringLiteral(", mark ") + m;
                if (!action->isEnabled())
                    state += QStringLiteral(", disabled");
                itemRow->setColumn(kStateColumn, state);
            }
        }
    }
    setCount(group, rows.count());
}

} // namespace Velmar::Private::Inspector
