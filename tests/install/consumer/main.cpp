// A host that knows only the installed headers and the exported symbols: the README's
// example, checked by reading a pixel back, then a classic window and event loop.
#include <Velmar/Velmar.h>

#include <cstdio>

using namespace Velmar;

int main(int argc, char** argv)
{
    AQtApplication app(argc, argv, false);

    GWorldPtr world = nullptr;
    Rect bounds{0, 0, 100, 200};
    NewGWorld(&world, 32, &bounds, nullptr, nullptr, 0);
    SetGWorld(world, nullptr);
    PenSize(3, 3);
    FrameRect(&bounds);

    RGBColor corner, inside;
    GetCPixel(0, 0, &corner);
    GetCPixel(50, 50, &inside);
    Str255 text;
    NumToString(-42, text);
    DisposeGWorld(world);

    // A window, a key event posted and waited for (a posted key event carries no message:
    // only the queue's private kinds keep it), drawing into the window's port.
    const Rect windowBounds{60, 60, 160, 260};
    WindowRef window =
        NewCWindow(nullptr, &windowBounds, reinterpret_cast<ConstStr255Param>("\x04host"), true, 0,
            reinterpret_cast<AQtWindow*>(-1), true, nullptr);
    PostEvent(keyDown, 0x0061);
    EventRecord event{};
    bool gotPosted = false;
    for (int i = 0; i < 100 && !gotPosted; ++i)
        gotPosted = WaitNextEvent(keyDownMask, &event, 1, nullptr) && event.what == keyDown;
    SetPortWindowPort(window);
    PaintRect(&bounds);
    KeyMap keys;
    GetKeys(keys);
    const bool windowOk =
        window && FrontWindow() == window && GetWindowPort(window) == GetCurrentPort();
    DisposeWindow(window);

    const bool ok = corner.red == 0 && inside.red == 0xFFFF && text[0] == 3 && text[1] == '-'
        && gotPosted && windowOk;
    std::printf("consumer %s (event %d, window %d)\n", ok ? "ok" : "wrong", gotPosted, windowOk);
    return ok ? 0 : 1;
}
