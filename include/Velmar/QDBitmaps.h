// Bitmaps, pixmaps and the CopyBits family: the pixel maps a host reads and writes, copies
// between them with the classic transfer modes, and regions made from pixels.
//
// Three kinds of map take part:
// - a port's pixmap (GetPortBitMapForCopyBits, GetGWorldPixMap, GetPortPixMap): the port's
//   own pixels, in the port's local coordinates;
// - a host's pixmap (NewPixMap and SetPixBounds, TxCopyHand): pixels of its own;
// - a BitMap record the host fills in by hand over memory it owns: one bit per pixel.
// CopyBits and its relatives accept any of them, as a reference, a pointer or a handle.
//
// Pixels of 32-bit maps are one native-endian 32-bit word each, 0xAARRGGBB, with
// premultiplied alpha; rows are GetPixRowBytes apart. A host that writes whole words, as
// classic code did, sees its colours; code that wrote the bytes A, R, G, B one by one must
// swap them on little-endian machines. The copy calls ignore alpha as classic QuickDraw did:
// what they write is opaque.
#pragma once

#include <Velmar/MacTypes.h>
#include <Velmar/QDTypes.h>

#include <cstddef>

namespace Velmar {

// A one-bit map over the host's own memory: rows of rowBytes bytes from baseAddr, the most
// significant bit leftmost, a set bit black. The library never frees the memory.
struct BitMap {
    Ptr baseAddr;
    SInt16 rowBytes;
    Rect bounds;
};

using PixMapHandle = PixMapPtr*;

// Transfer modes beyond the boolean ones in QDTypes.h. ditherCopy may be added to any mode
// and is ignored (32-bit maps need no dithering).
enum : SInt16 {
    blend = 32,
    addPin = 33,
    addOver = 34,
    transparent = 36,
    adMax = 37,
    subOver = 38,
    adMin = 39,
    ditherCopy = 64,
};

// Any map a copy call takes. Never spelled by hosts: their arguments convert to it.
class VELMAR_EXPORT BitMapView {
public:
    BitMapView(const BitMapPtr& map) : m_map(&map) {}      // NOLINT: converts on purpose
    BitMapView(const BitMapPtr* map) : m_map(map) {}       // NOLINT
    BitMapView(const BitMap* bits) : m_bits(bits) {}       // NOLINT
    BitMapView(std::nullptr_t) {}                          // NOLINT

    const BitMapPtr* map() const { return m_map; }
    const BitMap* bits() const { return m_bits; }

private:
    const BitMapPtr* m_map = nullptr;
    const BitMap* m_bits = nullptr;
};

// ---- Pixmaps ------------------------------------------------------------------------------
// An empty 32-bit pixmap of the host's own (no pixels until SetPixBounds).
VELMAR_EXPORT PixMapHandle NewPixMap();
// Gives a host's pixmap pixels for `bounds` (white, opaque); the old pixels are dropped. A
// port's pixmap is refused: size the port instead (PortSize, UpdateGWorld).
VELMAR_EXPORT OSErr SetPixBounds(PixMapHandle pixmap, const Rect* bounds);
// Frees a host's pixmap and its pixels; ports' pixmaps go with their ports and are refused.
VELMAR_EXPORT void DisposePixMap(PixMapHandle pixmap);
VELMAR_EXPORT Ptr GetPixBaseAddr(PixMapHandle pixmap);
VELMAR_EXPORT SInt32 GetPixRowBytes(PixMapHandle pixmap);
VELMAR_EXPORT Rect* GetPixBounds(PixMapHandle pixmap, Rect* bounds);
// The depth of the stored pixels: 32, whatever depth a world was asked for.
VELMAR_EXPORT SInt16 GetPixDepth(PixMapHandle pixmap);
// Pixels never move, so locking always succeeds and the state is always 0.
VELMAR_EXPORT Boolean LockPixels(PixMapHandle pixmap);
VELMAR_EXPORT void UnlockPixels(PixMapHandle pixmap);
VELMAR_EXPORT GWorldFlags GetPixelsState(PixMapHandle pixmap);
VELMAR_EXPORT void SetPixelsState(PixMapHandle pixmap, GWorldFlags state);
VELMAR_EXPORT void AllowPurgePixels(PixMapHandle pixmap);
VELMAR_EXPORT void NoPurgePixels(PixMapHandle pixmap);

// ---- Copies ------------------------------------------------------------------------------
// Copies srcRect of `src` onto dstRect of `dst`, scaling (nearest pixel) when the two
// differ in size, through `mode`, clipped to the destination's pixels, to its port's visible
// and clip regions when it is a port's map, and to maskRgn (destination coordinates; null
// for none). The boolean modes colourise with the current port's fore and back colours;
// blend and the pin modes take their weight or limit from its OpColor. Copies onto a
// window's port show on the next flush, as other drawing does.
VELMAR_EXPORT void CopyBits(BitMapView src, BitMapView dst, const Rect* srcRect,
                            const Rect* dstRect, SInt16 mode, RgnHandle maskRgn);
// CopyBits, then the destination window's changed pixels go to the screen at once.
VELMAR_EXPORT void CopyBitsToScreen(BitMapView src, BitMapView dst, const Rect* srcRect,
                                    const Rect* dstRect, SInt16 mode, RgnHandle maskRgn);
// CopyBits of one field of an interlaced picture: only the destination rows whose distance
// from dstRect's top has the parity `field` (0 even, 1 odd) are written.
VELMAR_EXPORT void CopyOneField(BitMapView src, BitMapView dst, const Rect* srcRect,
                                const Rect* dstRect, SInt16 mode, RgnHandle maskRgn, SInt16 field);
// Copies through a mask map: each destination pixel takes the copied colour in proportion
// to how dark the mask pixel is (black: all of it, white: none), per colour component.
// maskRect maps onto dstRect as srcRect does.
VELMAR_EXPORT void CopyDeepMask(BitMapView src, BitMapView mask, BitMapView dst,
                                const Rect* srcRect, const Rect* maskRect, const Rect* dstRect,
                                SInt16 mode, RgnHandle maskRgn);
// CopyDeepMask in srcCopy mode without a mask region.
VELMAR_EXPORT void CopyMask(BitMapView src, BitMapView mask, BitMapView dst, const Rect* srcRect,
                            const Rect* maskRect, const Rect* dstRect);

// ---- Regions from pixels -------------------------------------------------------------------
// Sets `region` to the set pixels of a one-bit map, or to the pixels of a deeper map that
// differ from its background (the port's back colour for a port's map, white otherwise), in
// the map's coordinates. paramErr for a missing region or map.
VELMAR_EXPORT OSErr BitMapToRegion(RgnHandle region, BitMapView map);

} // namespace Velmar
