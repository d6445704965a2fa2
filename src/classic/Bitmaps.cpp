// CopyBits and CopyMask between the maps classic programs name: a port's portBits (a
// window's, or one drawing into the program's own bitmap), the screen (qd.screenBits, or a
// copy of a window's portBits: baseAddr null, as the layer hands them out) and bitmaps over
// the program's own memory. Each becomes the library's map plus the shift from the map's
// coordinates to the library's; the library copies, scales and applies the transfer mode.
#include "classic/ClassicPrivate.h"

#include <algorithm>

using namespace VelmarClassic;

namespace {

// Larger than any bitmap of the time: a bigger one is a made-up record.
constexpr int kMaxSide = 16384;

struct MapArg {
    Velmar::BitMap own{}; // a bitmap of the program's memory
    const Velmar::BitMapPtr* portMap = nullptr; // or a port's pixels
    PortLink* port = nullptr; // that port
    short dh = 0, dv = 0; // map coordinates to the library's

    Velmar::BitMapView view() const
    {
        return portMap ? Velmar::BitMapView(portMap) : Velmar::BitMapView(&own);
    }
};

bool refuse(const char* call, const BitMap* bits, const char* why)
{
    Velmar::VelmarLog(Velmar::kLogQuickDraw, "%s: BitMap %p refused: %s", call,
        static_cast<const void*>(bits), why);
    return false;
}

bool resolve(const BitMap* bits, MapArg* out, const char* call)
{
    if (PortLink* link = portOfBits(bits)) {
        if (!link->port())
            return refuse(call, bits, "the port has no pixels");
        if (!link->window)
            loadProgramBits(*link);
        out->portMap = &Velmar::GetPortBitMapForCopyBits(link->port());
        out->port = link;
        return true;
    }
    if (!bits->baseAddr) {
        // The screen: what the current window shows of it, in the bitmap's coordinates.
        PortLink* link = currentLink();
        if (!link || !link->window)
            return refuse(call, bits, "the screen is reached through a window only");
        const Rect& screen = link->record->portBits.bounds;
        out->dh = short(std::clamp(screen.left - bits->bounds.left, -32767, 32767));
        out->dv = short(std::clamp(screen.top - bits->bounds.top, -32767, 32767));
        out->portMap = &Velmar::GetPortBitMapForCopyBits(link->port());
        out->port = link;
        return true;
    }
    if (bits->rowBytes & 0x8000)
        return refuse(call, bits, "a pixel map the layer did not make");
    if (bits->bounds.right - bits->bounds.left > kMaxSide
        || bits->bounds.bottom - bits->bounds.top > kMaxSide)
        return refuse(call, bits, "bounds too large");
    out->own = Velmar::BitMap{bits->baseAddr, bits->rowBytes, bits->bounds};
    return true;
}

Rect shifted(const Rect& r, const MapArg& map)
{
    auto s = [](int value) { return short(std::clamp(value, -32767, 32767)); };
    return Rect{s(r.top + map.dv), s(r.left + map.dh), s(r.bottom + map.dv), s(r.right + map.dh)};
}

// The copy's destination written back into the program's bitmap when it was a port's.
void finish(const MapArg& dst)
{
    if (dst.port && !dst.port->window)
        storeProgramBits(*dst.port);
}

// maskRgn in the library's coordinates of the destination; a temporary when it had to move.
class ShiftedMask {
public:
    ShiftedMask(RgnHandle rgn, const MapArg& dst, const char* call)
    {
        if (!rgn)
            return;
        m_region = libraryRegion(rgn, call);
        m_ok = m_region != nullptr;
        if (m_ok && (dst.dh || dst.dv)) {
            m_temporary = Velmar::NewRgn();
            Velmar::CopyRgn(m_region, m_temporary);
            Velmar::OffsetRgn(m_temporary, dst.dh, dst.dv);
            m_region = m_temporary;
        }
    }
    ~ShiftedMask()
    {
        if (m_temporary)
            Velmar::DisposeRgn(m_temporary);
    }
    ShiftedMask(const ShiftedMask&) = delete;
    ShiftedMask& operator=(const ShiftedMask&) = delete;
    bool ok() const { return m_ok; }
    Velmar::RgnHandle region() const { return m_region; }

private:
    Velmar::RgnHandle m_region = nullptr;
    Velmar::RgnHandle m_temporary = nullptr;
    bool m_ok = true;
};

// The current port's colours tint the boolean modes, as the classic calls did.
void followCurrentPort()
{
    if (PortLink* link = currentLink())
        pullPort(*link);
}

} // namespace

void CopyBits(const BitMap* srcBits, const BitMap* dstBits, const Rect* srcRect,
    const Rect* dstRect, short mode, RgnHandle maskRgn)
{
    if (!VELMAR_ASSERT(srcBits && dstBits, "srcBits && dstBits")
        || !VELMAR_ASSERT(srcRect && dstRect, "srcRect && dstRect"))
        return;
    ensureStarted();
    followCurrentPort();
    MapArg src, dst;
    if (!resolve(srcBits, &src, "CopyBits") || !resolve(dstBits, &dst, "CopyBits"))
        return;
    const ShiftedMask mask(maskRgn, dst, "CopyBits");
    if (!mask.ok())
        return;
    const Rect s = shifted(*srcRect, src), d = shifted(*dstRect, dst);
    Velmar::CopyBits(src.view(), dst.view(), &s, &d, mode, mask.region());
    finish(dst);
}

void CopyMask(const BitMap* srcBits, const BitMap* maskBits, const BitMap* dstBits,
    const Rect* srcRect, const Rect* maskRect, const Rect* dstRect)
{
    if (!VELMAR_ASSERT(srcBits && maskBits && dstBits, "srcBits && maskBits && dstBits")
        || !VELMAR_ASSERT(srcRect && maskRect && dstRect, "srcRect && maskRect && dstRect"))
        return;
    ensureStarted();
    followCurrentPort();
    MapArg src, mask, dst;
    if (!resolve(srcBits, &src, "CopyMask") || !resolve(maskBits, &mask, "CopyMask")
        || !resolve(dstBits, &dst, "CopyMask"))
        return;
    const Rect s = shifted(*srcRect, src), m = shifted(*maskRect, mask), d = shifted(*dstRect, dst);
    Velmar::CopyMask(src.view(), mask.view(), dst.view(), &s, &m, &d);
    finish(dst);
}

namespace VelmarClassic {

void copyIntoCurrentPort(const Velmar::BitMap& bits, const Rect& dstRect, short mode)
{
    PortLink* link = currentLink();
    if (!link)
        return;
    pullPort(*link);
    Velmar::CopyBits(&bits, Velmar::GetPortBitMapForCopyBits(link->port()), &bits.bounds, &dstRect,
        mode, nullptr);
    storeProgramBits(*link);
}

} // namespace VelmarClassic
