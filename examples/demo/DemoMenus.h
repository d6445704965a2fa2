// The demo's menu bar: Velmar, File, Edit, Font (AppendResMenu 'FONT'), Style with a
// hierarchical Size menu (command 27), and Window. Choices arrive as menu events (the menu
// bar) or through MenuEvent (command keys) and drive the demo.
#pragma once

#include <Velmar/Velmar.h>

#include <functional>

namespace Demo {

enum class Command { None, NewDocument, FontsWindow, NotesWindow, Close, Quit, About, ShowPalette };

// Builds the menus; `run` carries out the commands that are not about text.
void installMenus(std::function<void(Command)> run);
// A choice value (MenuSelect, MenuKey, MenuEvent) carried out.
void doMenuChoice(Velmar::SInt32 choice);

} // namespace Demo
