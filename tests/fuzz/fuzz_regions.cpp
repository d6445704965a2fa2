// Regions as a hostile host uses them: set algebra, offsets, insets and maps with any 16-bit
// arguments, recording from frames and lines, drawing, and handles disposed twice or never
// made. The algebra is checked against its laws and against QRegion itself.
#include "FuzzSupport.h"

#include <Velmar/QDRegions.h>
#include <Velmar/QDShapes.h>
#include <Velmar/QtGrafPort.h>

#include <QRegion>

using namespace Velmar;
using VelmarFuzz::Bytes;

namespace {

Rect readRect(Bytes& in)
{
    Rect r;
    r.top = in.s16();
    r.left = in.s16();
    r.bottom = in.s16();
    r.right = in.s16();
    return r;
}

// Small coordinates most of the time, so that shapes overlap and the laws have work to do.
Rect readNearRect(Bytes& in)
{
    Rect r;
    r.top = SInt16(int8_t(in.u8()));
    r.left = SInt16(int8_t(in.u8()));
    r.bottom = SInt16(r.top + in.u8() % 64);
    r.right = SInt16(r.left + in.u8() % 64);
    return r;
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    VelmarFuzz::ensureApplication();
    Bytes in(data, size);
    GrafPtr world = nullptr;
    const Rect bounds{0, 0, 64, 64};
    NewGWorld(&world, 32, &bounds, nullptr, nullptr, 0);
    SetPort(world);

    RgnHandle slots[4];
    for (RgnHandle& r : slots)
        r = NewRgn();
    RgnHandle disposed = NewRgn();
    DisposeRgn(disposed);

    for (int steps = 0; !in.empty() && steps < 64; ++steps) {
        RgnHandle a = slots[in.u8() % 4], b = slots[in.u8() % 4], d = slots[in.u8() % 4];
        const QRegion qa = *a, qb = *b;
        switch (in.u8() % 14) {
        case 0: {
            const Rect r = (in.u8() & 1) ? readRect(in) : readNearRect(in);
            RectRgn(a, &r);
            break;
        }
        case 1:
            UnionRgn(a, b, d);
            FUZZ_CHECK(*d == qa.united(qb));
            FUZZ_CHECK(d->united(qa) == *d);
            break;
        case 2:
            SectRgn(a, b, d);
            FUZZ_CHECK(*d == qa.intersected(qb));
            FUZZ_CHECK(d->subtracted(qa).isEmpty());
            break;
        case 3:
            DiffRgn(a, b, d);
            FUZZ_CHECK(d->intersected(qb).isEmpty());
            break;
        case 4:
            XorRgn(a, b, d);
            FUZZ_CHECK(*d == qa.united(qb).subtracted(qa.intersected(qb)));
            break;
        case 5: OffsetRgn(a, in.s16(), in.s16()); break;
        case 6: {
            const SInt16 dh = SInt16(int8_t(in.u8())), dv = SInt16(int8_t(in.u8()));
            InsetRgn(a, dh, dv);
            // Insetting never grows a region; outsetting never shrinks one.
            if (dh >= 0 && dv >= 0)
                FUZZ_CHECK(a->subtracted(qa).isEmpty());
            if (dh <= 0 && dv <= 0)
                FUZZ_CHECK(qa.subtracted(*a).isEmpty());
            break;
        }
        case 7: {
            const Rect src = readRect(in), dst = readRect(in);
            MapRgn(a, &src, &dst);
            break;
        }
        case 8: {
            OpenRgn();
            for (int i = in.u8() % 5; i > 0; --i) {
                const Rect r = (in.u8() & 1) ? readRect(in) : readNearRect(in);
                switch (in.u8() % 4) {
                case 0: FrameRect(&r); break;
                case 1: FrameOval(&r); break;
                case 2: MoveTo(r.left, r.top); break;
                default: LineTo(r.right, r.bottom); break;
                }
            }
            CloseRgn(a);
            break;
        }
        case 9: {
            const Point p{in.s16(), in.s16()};
            FUZZ_CHECK(PtInRgn(p, a) == (a->contains(QPoint(p.h, p.v)) ? 1 : 0));
            Rect box;
            GetRegionBounds(a, &box);
            FUZZ_CHECK(EqualRgn(a, b) == (*a == *b ? 1 : 0));
            break;
        }
        case 10:
            switch (in.u8() % 4) {
            case 0: PaintRgn(a); break;
            case 1: FrameRgn(a); break;
            case 2: InvertRgn(a); break;
            default: EraseRgn(a); break;
            }
            break;
        case 11:
            // Stale and made-up handles are refused, the live ones untouched.
            UnionRgn(disposed, a, b);
            FUZZ_CHECK(*b == qb);
            DisposeRgn(disposed);
            break;
        case 12: {
            PolyPtr* poly = OpenPoly();
            for (int i = in.u8() % 6; i > 0; --i)
                (i % 2 ? MoveTo : LineTo)(in.s16(), in.s16());
            ClosePoly();
            OffsetPoly(poly, in.s16(), in.s16());
            if (in.u8() & 1)
                PaintPoly(poly);
            KillPoly(poly);
            KillPoly(poly); // twice: refused
            break;
        }
        default: SetClip(a); break;
        }
    }
    for (RgnHandle r : slots)
        DisposeRgn(r);
    SetPort(nullptr);
    DisposeGWorld(world);
    return 0;
}
