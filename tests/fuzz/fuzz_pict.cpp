// Pictures from arbitrary bytes, played into an offscreen world: never a crash, a hang or a
// read outside the data, and the port's pen, colours and clip come back as they were.
#include "FuzzSupport.h"

#include "classic/resfile/Picture.h"

#include <Velmar/Velmar.h>

using namespace Velmar;

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    VelmarFuzz::ensureApplication();
    static GrafPtr world = [] {
        GrafPtr port = nullptr;
        const Rect bounds{0, 0, 64, 64};
        NewGWorld(&port, 32, &bounds, nullptr, nullptr, 0);
        return port;
    }();
    FUZZ_CHECK(world);
    SetPort(world);
    const Rect bounds{0, 0, 64, 64};
    EraseRect(&bounds);

    const QByteArray pict(reinterpret_cast<const char*>(data), qsizetype(size));
    RgnHandle clipBefore = NewRgn();
    GetClip(clipBefore);
    const Rect frame = Classic::pictureFrame(pict);
    // The frame decides the scale: draw once at the frame's own size when it is small, and
    // once into the whole world.
    if (frame.right > frame.left && frame.bottom > frame.top && frame.right - frame.left <= 128
        && frame.bottom - frame.top <= 128)
        Classic::drawPicture(pict, frame);
    Classic::drawPicture(pict, bounds);

    PenState pen;
    GetPenState(&pen);
    FUZZ_CHECK(pen.penSize() == 1 && pen.penMode() == patCopy);
    RgnHandle clipAfter = NewRgn();
    GetClip(clipAfter);
    FUZZ_CHECK(EqualRgn(clipBefore, clipAfter));
    FUZZ_CHECK(GetCurrentPort() == world);
    DisposeRgn(clipBefore);
    DisposeRgn(clipAfter);
    return 0;
}
