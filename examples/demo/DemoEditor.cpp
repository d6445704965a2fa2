#include "DemoEditor.h"

using namespace Velmar;

namespace Demo {

namespace {

WindowRef gEditorWindow;
TEPtr* gRecord = nullptr;
const Rect kView{30, 12, 228, 348};

const char kWelcome[] =
    "This is a TextEdit record on a QPlainTextEdit. Type, select with the mouse (double-click "
    "a word), and use the Edit menu or Control+X, C, V and Z.\r\rThe host gets every key and "
    "click as an event and hands it to TEKey and TEClick.";

void drawHeader()
{
    TextFont(geneva, false);
    TextSize(12, false);
    TextFace(bold, false);
    const RGBColor black(0, 0, 0);
    RGBForeColor(&black);
    MoveTo(12, 20);
    DrawString(reinterpret_cast<const unsigned char*>("\x05Notes"));
    TextFace(normal, false);
}

} // namespace

WindowRef openEditorWindow()
{
    if (gEditorWindow && IsValidWindowPtr(gEditorWindow)) {
        SelectWindow(gEditorWindow);
        return gEditorWindow;
    }
    const Rect bounds{550, 420, 790, 780};
    gEditorWindow = NewCWindow(nullptr, &bounds,
        reinterpret_cast<const unsigned char*>("\x05Notes"), true, 0, nullptr, true, nullptr);
    SetPortWindowPort(gEditorWindow);
    TextFont(newYork, false);
    TextSize(14, false);
    gRecord = TENew(&kView, &kView);
    TESetText(kWelcome, SInt32(sizeof kWelcome - 1), gRecord);
    return gEditorWindow;
}

bool isEditorWindow(WindowRef window)
{
    return window && window == gEditorWindow;
}

void drawEditorWindow(WindowRef window)
{
    Rect all;
    GetWindowPortBounds(window, &all);
    const RGBColor paper(0xF4F4, 0xF4F4, 0xECEC);
    RGBBackColor(&paper);
    EraseRect(&all);
    drawHeader();
    Rect frame = kView;
    InsetRect(&frame, -2, -2);
    FrameRect(&frame);
    TEUpdate(&kView, gRecord);
}

void activateEditor(bool active)
{
    if (!gRecord)
        return;
    if (active)
        TEActivateEx(gRecord, gEditorWindow);
    else
        TEDeactivate(gRecord);
}

void clickEditor(const EventRecord& e)
{
    SetPortWindowPort(gEditorWindow);
    Point local = e.where;
    GlobalToLocal(&local);
    if (PtInRect(local, &kView))
        TEClick(local, (e.modifiers & shiftKey) != 0, gRecord);
}

void keyEditor(EventRecord& e)
{
    TEKey(char(e.message & charCodeMask), gRecord, &e);
}

void editCommand(EditCommand command)
{
    if (!gRecord)
        return;
    switch (command) {
    case EditCommand::Undo: gRecord->undo(); break;
    case EditCommand::Cut: TECut(gRecord); break;
    case EditCommand::Copy: TECopy(gRecord); break;
    case EditCommand::Paste: TEPaste(gRecord); break;
    case EditCommand::Clear: TEDelete(gRecord); break;
    }
}

bool editorIsFront()
{
    return gEditorWindow && FrontWindow() == gEditorWindow;
}

bool editorHasSelection()
{
    return gRecord && gRecord->selStart() != gRecord->selEnd();
}

bool editorCanUndo()
{
    return gRecord && gRecord->canUndo();
}

void insertIntoEditor(const char* text, SInt32 length)
{
    if (gRecord)
        TEInsert(text, length, gRecord);
}

void closeEditorWindow()
{
    if (gRecord)
        TEDispose(gRecord);
    gRecord = nullptr;
    if (gEditorWindow)
        DisposeWindow(gEditorWindow);
    gEditorWindow = nullptr;
}

} // namespace Demo
