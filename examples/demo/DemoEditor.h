// The "Notes" window: a TextEdit record driven the classic way (TEKey, TEClick, TEUpdate,
// activation), with the Edit menu's Undo, Cut, Copy, Paste and Clear.
#pragma once

#include <Velmar/Velmar.h>

namespace Demo {

enum class EditCommand { Undo, Cut, Copy, Paste, Clear };

Velmar::WindowRef openEditorWindow();
bool isEditorWindow(Velmar::WindowRef window);
void drawEditorWindow(Velmar::WindowRef window);
void activateEditor(bool active);
// A click in the window's content.
void clickEditor(const Velmar::EventRecord& e);
void keyEditor(Velmar::EventRecord& e);
void editCommand(EditCommand command);
// Whether the Edit menu's commands apply (the editor is the front window).
bool editorIsFront();
bool editorHasSelection();
bool editorCanUndo();
void closeEditorWindow();
// Text (in the host's encoding) inserted at the caret.
void insertIntoEditor(const char* text, Velmar::SInt32 length);

} // namespace Demo
