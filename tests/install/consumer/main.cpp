// A host that knows only the installed headers and the exported symbols: the README's
// example, checked by reading a pixel back.
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

    const bool ok = corner.red == 0 && inside.red == 0xFFFF && text[0] == 3 && text[1] == '-';
    std::printf("consumer %s\n", ok ? "ok" : "wrong");
    return ok ? 0 : 1;
}
