#include "DemoMenus.h"

#include "DemoEditor.h"
#include "DemoText.h"

using namespace Velmar;

namespace Demo {

namespace {

enum : SInt16 {
    kAppMenu = 128,
    kFileMenu = 129,
    kEditMenu = 130,
    kFontMenu = 131,
    kStyleMenu = 132,
    kSizeMenu = 133,
};

std::function<void(Command)> gRun;

const unsigned char* P(const char* text)
{
    static Str255 buffer;
    QString2PascalString(QString::fromLatin1(text), buffer);
    return buffer;
}

MenuRef makeMenu(SInt16 id, const char* title, const char* items)
{
    MenuRef menu = NewMenu(id, P(title));
    if (items)
        AppendMenu(menu, P(items));
    return menu;
}

QString itemText(MenuRef menu, UInt16 item)
{
    Str255 text;
    GetMenuItemText(menu, item, text);
    return PascalString2QString(text);
}

// Check marks follow the sample before a menu shows.
void updateMenus()
{
    const TextSample& s = textSample();
    MenuRef font = GetMenuHandle(kFontMenu);
    for (UInt16 i = 1; i <= CountMenuItems(font); ++i) {
        SInt16 id = 0;
        Str255 name;
        GetMenuItemText(font, i, name);
        GetFNum(name, &id);
        CheckMenuItem(font, SInt16(i), id == s.font);
    }
    MenuRef style = GetMenuHandle(kStyleMenu);
    CheckMenuItem(style, 1, s.face == normal);
    CheckMenuItem(style, 2, (s.face & bold) != 0);
    CheckMenuItem(style, 3, (s.face & italic) != 0);
    CheckMenuItem(style, 4, (s.face & underline) != 0);
    // The Edit menu serves the Notes window.
    MenuRef edit = GetMenuHandle(kEditMenu);
    const bool notes = editorIsFront();
    (notes && editorCanUndo() ? EnableMenuItem : DisableMenuItem)(edit, 1);
    for (UInt16 item : {3, 4, 6})
        (notes && editorHasSelection() ? EnableMenuItem : DisableMenuItem)(edit, item);
    (notes ? EnableMenuItem : DisableMenuItem)(edit, 5);
    MenuRef size = GetMenuHandle(kSizeMenu);
    for (UInt16 i = 1; i <= CountMenuItems(size); ++i)
        CheckMenuItem(size, SInt16(i), itemText(size, i).toInt() == s.size);
}

OSStatus menuEvents(EventHandlerCallRef, EventRef event, void*)
{
    if (GetEventKind(event) == kEventVelmarUpdateMenus)
        updateMenus();
    else
        doMenuChoice(MenuSelect(Point{}));
    return noErr;
}

} // namespace

void installMenus(std::function<void(Command)> run)
{
    gRun = std::move(run);
    // The Window menu is the anchor: menus appended with beforeID 0 go in front of it.
    InsertMenu(makeMenu(kMenuBarAnchorID, "Window", "Show Palette;Velmar Inspector"), kMenuBarAnchorID);
    InsertMenu(makeMenu(kAppMenu, "Velmar", "About the Velmar Demo"), 0);
    MenuRef file = makeMenu(kFileMenu, "File", "New Document;Fonts and Icons;Notes;-;Close;-;Quit");
    SetItemCmd(file, 1, 'N');
    SetItemCmd(file, 2, 'T');
    SetItemCmd(file, 3, 'E');
    SetItemCmd(file, 5, 'W');
    SetItemCmd(file, 7, 'Q');
    InsertMenu(file, 0);
    MenuRef edit = makeMenu(kEditMenu, "Edit", "Undo;-;Cut;Copy;Paste;Clear");
    SetItemCmd(edit, 1, 'Z');
    SetItemCmd(edit, 3, 'X');
    SetItemCmd(edit, 4, 'C');
    SetItemCmd(edit, 5, 'V');
    InsertMenu(edit, 0);
    MenuRef font = makeMenu(kFontMenu, "Font", nullptr);
    AppendResMenu(font, FOUR_CHAR_CODE("FONT"));
    InsertMenu(font, 0);
    MenuRef style = makeMenu(kStyleMenu, "Style", "Plain;Bold;Italic;Underline;-;Size");
    SetItemCmd(style, 2, 'B');
    SetItemCmd(style, 3, 'I');
    SetItemCmd(style, 4, 'U');
    InsertMenu(makeMenu(kSizeMenu, "Size", "9;10;12;14;18;24;36"), -1);
    SetItemMark(style, 6, kSizeMenu); // command 27: the mark names the submenu
    SetItemCmd(style, 6, hMenuCmd);
    InsertMenu(style, 0);

    const EventTypeSpec kinds[] = {{kEventClassVelmar, kEventVelmarMenuTriggered},
        {kEventClassVelmar, kEventVelmarUpdateMenus}};
    InstallEventHandler(GetApplicationEventTarget(), menuEvents, 2, kinds, nullptr, nullptr);
}

void doMenuChoice(SInt32 choice)
{
    const SInt16 menu = SInt16(choice >> 16);
    const UInt16 item = UInt16(choice & 0xFFFF);
    TextSample& s = textSample();
    switch (menu) {
    case kAppMenu: gRun(Command::About); return;
    case kFileMenu: {
        static const Command kFile[] = {Command::None, Command::NewDocument, Command::FontsWindow,
            Command::None, Command::Close, Command::None, Command::Quit};
        if (item < std::size(kFile))
            gRun(kFile[item]);
        return;
    }
    case kEditMenu: {
        static const EditCommand kEdit[] = {EditCommand::Undo, EditCommand::Undo, EditCommand::Undo,
            EditCommand::Cut, EditCommand::Copy, EditCommand::Paste, EditCommand::Clear};
        if (item >= 1 && item < std::size(kEdit) && item != 2 && editorIsFront())
            editCommand(kEdit[item]);
        return;
    }
    case kMenuBarAnchorID:
        if (item == 2)
            ToggleVelmarInspector(); // the library's debugging window, for a look inside
        else
            gRun(Command::ShowPalette);
        return;
    case kFontMenu: {
        Str255 name;
        GetMenuItemText(GetMenuHandle(kFontMenu), item, name);
        GetFNum(name, &s.font);
        break;
    }
    case kStyleMenu: {
        static const SInt16 kFaces[] = {0, normal, bold, italic, underline};
        if (item == 1)
            s.face = normal;
        else if (item < std::size(kFaces))
            s.face = SInt16(s.face ^ kFaces[item]);
        break;
    }
    case kSizeMenu: s.size = SInt16(itemText(GetMenuHandle(kSizeMenu), item).toInt()); break;
    default: return;
    }
    gRun(Command::FontsWindow);
    invalidateTextWindow();
}

} // namespace Demo
