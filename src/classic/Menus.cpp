// Classic menus: a MenuInfo handle per library menu, menus and menu bars from 'MENU' and
// 'MBAR' resources, item strings with their metacharacters, and choices made in the Qt menu
// bar answered by MenuSelect.
#include "classic/ClassicPrivate.h"

#include "classic/resfile/Decoders.h"

#include <QCoreApplication>
#include <QFileInfo>
#include <QMenu>
#include <QMenuBar>

#include <algorithm>
#include <cstring>
#include <map>

namespace VelmarClassic {

namespace {

struct MenuBlock {
    MenuInfo* master = nullptr;
    MenuInfo record{};
    Velmar::MenuRef menu;
    short resourceID = 0; // the 'MENU' it came from
    bool fromResource = false;
};

std::unordered_map<MenuHandle, MenuBlock*>& menus()
{
    static auto* map = new std::unordered_map<MenuHandle, MenuBlock*>;
    return *map;
}

// The menus of the bar, in order (classic IDs).
std::vector<short>& barMenus()
{
    static auto* list = new std::vector<short>;
    return *list;
}

MenuBlock* blockOf(MenuHandle menu)
{
    if (!VELMAR_ASSERT(menu, "theMenu != NULL"))
        return nullptr;
    const auto it = menus().find(menu);
    return VELMAR_ASSERT(it != menus().end(), "IsValidMenu(theMenu)") ? it->second : nullptr;
}

// The first menu's title is the system logo character: shown as the application's menu.
QByteArray shownTitle(ConstStr255Param title)
{
    const QByteArray t = toQByteArray(title);
    if (t != QByteArray(1, char(appleMark)))
        return t;
    QString name = QCoreApplication::applicationName();
    if (name.isEmpty())
        name = QStringLiteral("Application");
    return name.toLatin1();
}

void setFlag(MenuBlock* block, short item, bool on)
{
    if (item < 0 || item > 31)
        return;
    const long bit = 1L << item;
    block->record.enableFlags =
        on ? (block->record.enableFlags | bit) : (block->record.enableFlags & ~bit);
}

// One classic item with its metacharacters: ( disabled, /x command key, !x mark, <x style,
// ^n icon; a leading - is a separator.
void appendItem(MenuBlock* block, const QByteArray& text)
{
    QByteArray label;
    bool disabled = false;
    char key = 0, mark = 0;
    Style style = 0;
    for (qsizetype i = 0; i < text.size(); ++i) {
        const char c = text[i];
        const bool hasArg = i + 1 < text.size();
        if (c == '(' && !text.startsWith('-'))
            disabled = true;
        else if (c == '/' && hasArg)
            key = text[++i];
        else if (c == '!' && hasArg)
            mark = text[++i];
        else if (c == '<' && hasArg) {
            switch (text[++i]) {
            case 'B': style |= bold; break;
            case 'I': style |= italic; break;
            case 'U': style |= underline; break;
            case 'O': style |= outline; break;
            case 'S': style |= shadow; break;
            default: break;
            }
        } else if (c == '^' && hasArg)
            ++i;
        else
            label.append(c);
    }
    if (label.isEmpty())
        label = " ";
    if (label.startsWith('-'))
        label = "-";
    Str255 item;
    copyToStr255(label, item);
    Velmar::AppendMenu(block->menu, item);
    const auto count = short(Velmar::CountMenuItems(block->menu));
    if (label == "-") {
        setFlag(block, count, false);
        return;
    }
    if (key)
        Velmar::SetItemCmd(block->menu, Velmar::UInt16(count), key);
    if (mark)
        Velmar::SetItemMark(
            block->menu, Velmar::UInt16(count), Velmar::SInt16(Velmar::UInt8(mark)));
    if (style)
        Velmar::SetItemStyle(block->menu, Velmar::UInt16(count), style);
    if (disabled)
        Velmar::DisableMenuItem(block->menu, Velmar::UInt16(count));
    setFlag(block, count, !disabled);
}

// An anchor at the end of the bar, so that InsertMenu(menu, 0) appends instead of asserting.
void ensureAnchor()
{
    static bool made = false;
    auto* app = Velmar::AQtApplication::instance();
    if (made || !app || !app->menuBar())
        return;
    made = true;
    const unsigned char empty[1] = {0};
    Velmar::MenuRef anchor = Velmar::NewMenu(Velmar::kMenuBarAnchorID, empty);
    Velmar::InsertMenu(anchor, -1);
    app->menuBar()->addMenu(anchor.get());
    anchor->menuAction()->setVisible(false);
}

MenuHandle makeMenu(short menuID, ConstStr255Param title)
{
    ensureStarted();
    Str255 shown;
    copyToStr255(shownTitle(title), shown);
    auto* block = new MenuBlock;
    block->menu = Velmar::NewMenu(menuID, shown);
    block->master = &block->record;
    block->record.menuID = menuID;
    block->record.enableFlags = -1;
    std::memcpy(block->record.menuData, title, size_t(title[0]) + 1);
    const auto h = &block->master;
    menus()[h] = block;
    return h;
}

} // namespace

Velmar::MenuRef libraryMenu(MenuHandle menu, const char*)
{
    MenuBlock* block = blockOf(menu);
    return block ? block->menu : Velmar::MenuRef();
}

MenuHandle classicMenu(Velmar::MenuRef menu)
{
    for (const auto& [h, block] : menus())
        if (block->menu.get() == menu.get())
            return h;
    return nullptr;
}

} // namespace VelmarClassic

using namespace VelmarClassic;

MenuHandle NewMenu(short menuID, ConstStr255Param menuTitle)
{
    const unsigned char empty[1] = {0};
    return makeMenu(menuID, menuTitle ? menuTitle : empty);
}

MenuHandle GetMenu(short resourceID)
{
    ensureStarted();
    for (const auto& [h, block] : menus())
        if (block->fromResource && block->resourceID == resourceID)
            return h;
    const std::optional<QByteArray> bytes = resourceBytes('MENU', resourceID);
    const auto t = bytes ? Velmar::Classic::decodeMenu(*bytes) : std::nullopt;
    if (!t)
        return nullptr;
    Str255 title;
    copyToStr255(t->title, title);
    MenuHandle h = makeMenu(t->menuID, title);
    MenuBlock* block = menus()[h];
    block->resourceID = resourceID;
    block->fromResource = true;
    for (const Velmar::Classic::MenuItemTemplate& item : t->items) {
        appendItem(block, item.text);
        const auto n = Velmar::UInt16(Velmar::CountMenuItems(block->menu));
        if (item.keyEquivalent && item.keyEquivalent != 0x1B)
            Velmar::SetItemCmd(block->menu, n, Velmar::SInt16(item.keyEquivalent));
        if (item.mark && item.keyEquivalent != 0x1B)
            Velmar::SetItemMark(block->menu, n, Velmar::SInt16(item.mark));
        if (item.style)
            Velmar::SetItemStyle(block->menu, n, item.style);
    }
    // The file's enable flags: bit 0 the whole menu, bit n item n.
    const short count = short(Velmar::CountMenuItems(block->menu));
    for (short i = 1; i <= std::min<short>(count, 31); ++i)
        if (!(t->enableFlags & (1u << i)))
            DisableItem(h, i);
    if (!(t->enableFlags & 1u))
        DisableItem(h, 0);
    return h;
}

void DisposeMenu(MenuHandle theMenu)
{
    if (!theMenu)
        return;
    MenuBlock* block = blockOf(theMenu);
    if (!block)
        return;
    menus().erase(theMenu);
    Velmar::DisposeMenu(block->menu);
    delete block;
}

void InsertMenu(MenuHandle theMenu, short beforeID)
{
    MenuBlock* block = blockOf(theMenu);
    if (!block)
        return;
    if (beforeID == hierMenu) {
        Velmar::InsertMenu(block->menu, -1);
        return;
    }
    auto& bar = barMenus();
    if (std::find(bar.begin(), bar.end(), block->record.menuID) != bar.end())
        return; // already in the bar
    ensureAnchor();
    const auto before = std::find(bar.begin(), bar.end(), beforeID);
    if (beforeID == 0 || before == bar.end()) {
        Velmar::InsertMenu(block->menu, 0);
        bar.push_back(block->record.menuID);
    } else {
        Velmar::InsertMenu(block->menu, beforeID);
        bar.insert(before, block->record.menuID);
    }
}

void DeleteMenu(short menuID)
{
    auto& bar = barMenus();
    bar.erase(std::remove(bar.begin(), bar.end(), menuID), bar.end());
    Velmar::DeleteMenu(menuID);
}

void ClearMenuBar()
{
    const std::vector<short> ids = barMenus();
    for (short id : ids)
        DeleteMenu(id);
}

void DrawMenuBar()
{}
void InvalMenuBar()
{}
void FlashMenuBar(short)
{}

Handle GetNewMBar(short menuBarID)
{
    ensureStarted();
    const std::optional<QByteArray> bytes = resourceBytes('MBAR', menuBarID);
    const auto ids = bytes ? Velmar::Classic::decodeMenuBar(*bytes) : std::nullopt;
    if (!ids)
        return nullptr;
    // The list holds menu IDs; each menu is read from the 'MENU' of the same ID.
    QByteArray list;
    for (short id : *ids)
        if (MenuHandle m = GetMenu(id)) {
            const short menuID = (**m).menuID;
            list.append(char(menuID >> 8)).append(char(menuID & 0xFF));
        }
    const short count = short(list.size() / 2);
    list.prepend(char(count & 0xFF)).prepend(char(count >> 8));
    return newHandleFrom(list);
}

Handle GetMenuBar()
{
    QByteArray list;
    const short count = short(barMenus().size());
    list.append(char(count >> 8)).append(char(count & 0xFF));
    for (short id : barMenus())
        list.append(char(id >> 8)).append(char(id & 0xFF));
    return newHandleFrom(list);
}

void SetMenuBar(Handle menuList)
{
    if (!VELMAR_ASSERT(isLiveHandle(menuList), "IsValidHandle(menuList)"))
        return;
    const QByteArray list = handleBytes(menuList);
    ClearMenuBar();
    const int count = list.size() >= 2 ? (Velmar::UInt8(list[0]) << 8 | Velmar::UInt8(list[1])) : 0;
    for (int i = 0; i < count && 2 + 2 * i + 1 < list.size(); ++i) {
        const short id =
            short(Velmar::UInt8(list[2 + 2 * i]) << 8 | Velmar::UInt8(list[3 + 2 * i]));
        if (MenuHandle m = GetMHandle(id))
            InsertMenu(m, 0);
    }
}

MenuHandle GetMHandle(short menuID)
{
    for (const auto& [h, block] : menus())
        if (block->record.menuID == menuID)
            return h;
    return nullptr;
}

MenuHandle GetMenuHandle(short menuID)
{
    return GetMHandle(menuID);
}

void AppendMenu(MenuHandle menu, ConstStr255Param data)
{
    MenuBlock* block = blockOf(menu);
    if (!block || !VELMAR_ASSERT(data, "data != NULL"))
        return;
    // Items end at ';' or a return.
    for (const QByteArray& item : toQByteArray(data).replace('\r', ';').split(';'))
        if (!item.isEmpty())
            appendItem(block, item);
}

void InsMenuItem(MenuHandle theMenu, ConstStr255Param itemString, short afterItem)
{
    MenuBlock* block = blockOf(theMenu);
    if (!block || !VELMAR_ASSERT(itemString, "itemString != NULL"))
        return;
    Velmar::InsertMenuItem(block->menu, itemString, afterItem);
}

void DelMenuItem(MenuHandle theMenu, short item)
{
    if (MenuBlock* block = blockOf(theMenu))
        Velmar::DeleteMenuItem(block->menu, Velmar::UInt16(item));
}

// Desk accessories do not exist: their menu gets nothing. Fonts are listed.
void AppendResMenu(MenuHandle theMenu, ResType theType)
{
    MenuBlock* block = blockOf(theMenu);
    if (block && theType == 'FONT')
        Velmar::AppendResMenu(block->menu, Velmar::ResType(theType));
}
void AddResMenu(MenuHandle theMenu, ResType theType)
{
    AppendResMenu(theMenu, theType);
}
void InsertResMenu(MenuHandle theMenu, ResType theType, short)
{
    AppendResMenu(theMenu, theType);
}

void GetItem(MenuHandle theMenu, short item, Str255 itemString)
{
    MenuBlock* block = blockOf(theMenu);
    if (block && VELMAR_ASSERT(itemString, "itemString != NULL"))
        Velmar::GetMenuItemText(block->menu, Velmar::UInt16(item), itemString);
}

void SetItem(MenuHandle theMenu, short item, ConstStr255Param itemString)
{
    MenuBlock* block = blockOf(theMenu);
    if (block && VELMAR_ASSERT(itemString, "itemString != NULL"))
        Velmar::SetMenuItemText(block->menu, Velmar::UInt16(item), itemString);
}

void EnableItem(MenuHandle theMenu, short item)
{
    MenuBlock* block = blockOf(theMenu);
    if (!block)
        return;
    if (item == 0)
        block->menu->menuAction()->setEnabled(true);
    else
        Velmar::EnableMenuItem(block->menu, Velmar::UInt16(item));
    setFlag(block, item, true);
}

void DisableItem(MenuHandle theMenu, short item)
{
    MenuBlock* block = blockOf(theMenu);
    if (!block)
        return;
    if (item == 0)
        block->menu->menuAction()->setEnabled(false);
    else
        Velmar::DisableMenuItem(block->menu, Velmar::UInt16(item));
    setFlag(block, item, false);
}

void CheckItem(MenuHandle theMenu, short item, Boolean checked)
{
    if (MenuBlock* block = blockOf(theMenu))
        Velmar::CheckMenuItem(block->menu, item, checked);
}

void SetItemMark(MenuHandle theMenu, short item, CharParameter markChar)
{
    if (MenuBlock* block = blockOf(theMenu))
        Velmar::SetItemMark(block->menu, Velmar::UInt16(item), markChar);
}

void GetItemMark(MenuHandle theMenu, short item, CharParameter* markChar)
{
    MenuBlock* block = blockOf(theMenu);
    if (block && VELMAR_ASSERT(markChar, "markChar != NULL"))
        Velmar::GetItemMark(block->menu, Velmar::UInt16(item), markChar);
}

void SetItemCmd(MenuHandle theMenu, short item, CharParameter cmdChar)
{
    if (MenuBlock* block = blockOf(theMenu))
        Velmar::SetItemCmd(block->menu, Velmar::UInt16(item), cmdChar);
}

void GetItemCmd(MenuHandle theMenu, short item, CharParameter* cmdChar)
{
    MenuBlock* block = blockOf(theMenu);
    if (block && VELMAR_ASSERT(cmdChar, "cmdChar != NULL"))
        Velmar::GetItemCmd(block->menu, Velmar::UInt16(item), cmdChar);
}

void SetItemStyle(MenuHandle theMenu, short item, StyleParameter chStyle)
{
    if (MenuBlock* block = blockOf(theMenu))
        Velmar::SetItemStyle(block->menu, Velmar::UInt16(item), chStyle);
}

short CountMItems(MenuHandle theMenu)
{
    MenuBlock* block = blockOf(theMenu);
    return block ? short(Velmar::CountMenuItems(block->menu)) : 0;
}

long MenuSelect(Point startPt)
{
    ensureStarted();
    finishClick();
    flushAllPorts();
    return long(Velmar::MenuSelect(startPt));
}

long MenuKey(CharParameter ch)
{
    ensureStarted();
    return long(Velmar::MenuKey(ch));
}

void HiliteMenu(short menuID)
{
    Velmar::HiliteMenu(menuID);
}

short OpenDeskAcc(ConstStr255Param)
{
    return 0;
}
void CloseDeskAcc(short)
{}
Boolean SystemEdit(short)
{
    return false;
}
