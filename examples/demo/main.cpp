// The demo host: a classic WaitNextEvent application with a menu bar. It opens document,
// floating and movable modal windows and a "Fonts and Icons" window, draws them through
// QuickDraw on update events, and takes its icons, picture and text from its own resource
// file (velmar-demo.rcc, registered at start). Clicks select windows (FindWindow), drag a
// shape (DragGrayRgn), grow windows (GrowWindow) or open a pop-up menu; menu choices and
// command keys (Control plays the command key) drive the demo; idle time (null events)
// animates the front window. With --screenshot PATH it saves the screen after a few
// seconds and quits, for machines without a display.
#include "DemoDesktop.h"
#include "DemoDocuments.h"
#include "DemoEditor.h"
#include "DemoMenus.h"
#include "DemoText.h"

#include <Velmar/Velmar.h>

#include <QDir>
#include <QElapsedTimer>
#include <QGuiApplication>
#include <QResource>
#include <QScreen>

#include <vector>

using namespace Velmar;
using namespace Demo;

namespace {

struct DemoState {
    std::vector<WindowRef> documents;
    WindowRef palette;
    WindowRef dialog;
    bool quit = false;
};
DemoState gDemo;

void openNewDocument()
{
    const SInt16 offset = SInt16(20 * gDemo.documents.size());
    gDemo.documents.push_back(openDocument(
        8, SInt16(80 + offset), SInt16(80 + offset), "New", RGBColor(0xFFFF, 0xFFFF, 0xFFFF)));
}

void closeFront()
{
    WindowRef front = FrontWindow();
    if (!front || front == gDemo.palette)
        return;
    if (isEditorWindow(front)) {
        closeEditorWindow();
        return;
    }
    forgetDocument(front);
    if (front == gDemo.dialog)
        gDemo.dialog = nullptr;
    DisposeWindow(front);
}

void run(Command command)
{
    switch (command) {
    case Command::NewDocument: openNewDocument(); break;
    case Command::FontsWindow: openTextWindow(); break;
    case Command::NotesWindow: openEditorWindow(); break;
    case Command::Close: closeFront(); break;
    case Command::Quit: gDemo.quit = true; break;
    case Command::About: SysBeep(1); break;
    case Command::ShowPalette:
        if (gDemo.palette)
            ShowWindow(gDemo.palette);
        break;
    case Command::None: break;
    }
}

void handleMouseDown(const EventRecord& e)
{
    WindowRef w = nullptr;
    const WindowPartCode part = FindWindow(e.where, &w);
    if (part == inMenuBar) {
        doMenuChoice(MenuSelect(e.where));
        return;
    }
    if (!w)
        return;
    if (w != FrontWindow()) {
        SelectWindow(w);
        return;
    }
    if (isTextWindow(w) && (clickTextWindow(w, e.where) || dragFromBox(w, e)))
        return;
    if (isEditorWindow(w)) {
        clickEditor(e);
        return;
    }
    clickDocument(w, e, part);
}

void handleKeyDown(EventRecord& e)
{
    if (gDemo.dialog) { // any key dismisses the dialog
        forgetDocument(gDemo.dialog);
        DisposeWindow(gDemo.dialog);
        gDemo.dialog = nullptr;
        return;
    }
    if (e.modifiers & cmdKey) {
        doMenuChoice(SInt32(MenuEvent(&e)));
        return;
    }
    if (editorIsFront()) {
        keyEditor(e);
        return;
    }
    const char c = char(e.message & charCodeMask);
    if (c == 'z' && FrontWindow()) {
        static bool out = false;
        out = !out;
        ZoomWindow(FrontWindow(), out ? inZoomOut : inZoomIn, true);
    }
}

void handleEvent(EventRecord& e)
{
    switch (e.what) {
    case updateEvt:
        SetPortWindowPort(e.window);
        BeginUpdate(e.window);
        if (isTextWindow(e.window))
            drawTextWindow(e.window);
        else if (isEditorWindow(e.window))
            drawEditorWindow(e.window);
        else
            drawDocument(e.window, e.window == FrontWindow());
        EndUpdate(e.window);
        break;
    case activateEvt:
        if (isEditorWindow(e.window))
            activateEditor((e.modifiers & activeFlag) != 0);
        if (isDocument(e.window)) { // the shape's colour follows activation
            Rect all;
            GetWindowPortBounds(e.window, &all);
            InvalWindowRect(e.window, &all);
        }
        break;
    case mouseDown:
        if (gDemo.dialog) { // the modal dialog goes away first
            forgetDocument(gDemo.dialog);
            DisposeWindow(gDemo.dialog);
            gDemo.dialog = nullptr;
            break;
        }
        handleMouseDown(e);
        break;
    case keyDown: handleKeyDown(e); break;
    default: break;
    }
}

void openStartWindows()
{
    gDemo.documents.push_back(
        openDocument(8, 60, 40, "Document (zoom box)", RGBColor(0xFFFF, 0xFFFF, 0xF0F0)));
    gDemo.documents.push_back(
        openDocument(0, 330, 40, "Document", RGBColor(0xF0F0, 0xF8F8, 0xFFFF)));
    const WindowRef fonts = openTextWindow();
    const WindowRef notes = openEditorWindow();
    installDesktop(fonts, notes);

    // A floating palette and a movable modal dialog from Carbon classes.
    const Rect paletteBounds{80, 1040, 300, 1180};
    CreateNewWindow(
        kFloatingWindowClass, kWindowStandardFloatingAttributes, &paletteBounds, &gDemo.palette);
    SetWTitle(gDemo.palette, reinterpret_cast<const unsigned char*>("\x07Palette"));
    adoptAsDocument(gDemo.palette, RGBColor(0xE0E0, 0xE0E0, 0xE0E0), Rect{20, 20, 70, 110});
    ShowWindow(gDemo.palette);

    const Rect dialogBounds{560, 820, 660, 1140};
    CreateNewWindow(kMovableModalWindowClass, 0, &dialogBounds, &gDemo.dialog);
    SetWTitle(gDemo.dialog,
        reinterpret_cast<const unsigned char*>("\x17"
                                               "Click or press a key..."));
    adoptAsDocument(gDemo.dialog, RGBColor(0xFFFF, 0xF0F0, 0xD0D0), Rect{20, 20, 60, 60});
    ShowWindow(gDemo.dialog);
    SelectWindow(gDemo.dialog);
}

} // namespace

int main(int argc, char** argv)
{
    // Decorated: the library's shell draws the frames and title bars, with or without a
    // window manager.
    AQtApplication app(argc, argv, true);
    // The demo's own resources: an external resource file registered at run time.
    const QString resources =
        QDir(QCoreApplication::applicationDirPath()).filePath("velmar-demo.rcc");
    if (!QResource::registerResource(resources))
        qWarning("velmar-demo: cannot register %s; icons and pictures stay blank",
            qPrintable(resources));
    QString screenshot;
    const QStringList args = QCoreApplication::arguments();
    const qsizetype at = args.indexOf(QStringLiteral("--screenshot"));
    if (at >= 0 && at + 1 < args.size())
        screenshot = args.at(at + 1);

    installMenus(run);
    openStartWindows();

    QElapsedTimer clock;
    clock.start();
    while (!gDemo.quit) {
        EventRecord e;
        if (WaitNextEvent(everyEvent, &e, 2, nullptr)) {
            handleEvent(e);
        } else if (WindowRef front = FrontWindow(); front && isDocument(front)) {
            SetPortWindowPort(front);
            animate(front);
        } else {
            trackMouse();
        }
        if (!screenshot.isEmpty() && clock.elapsed() > 2500) {
            QScreen* screen = QGuiApplication::primaryScreen();
            if (!screen || !screen->grabWindow(0).save(screenshot))
                qWarning("velmar-demo: could not save %s", qPrintable(screenshot));
            gDemo.quit = true;
        }
    }
    return 0;
}
