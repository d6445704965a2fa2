// Transfer modes on colour words. The boolean modes work on how dark each source component
// is: srcCopy gives the fore colour in proportion to the source's darkness and the back
// colour in proportion to its lightness, srcOr lays the fore colour over the destination in
// proportion to darkness, srcBic the back colour; the not- modes darken by the inverted
// source. Fore black and back white make all of these the plain 1-bit rules. srcXor inverts
// the destination under dark source bits. The arithmetic modes do not tint.
#include "quickdraw/TransferModes.h"

#include <Velmar/Diagnostics.h>
#include <Velmar/QDBitmaps.h>

#include <algorithm>
#include <iterator>


namespace Velmar::Private {

namespace {

constexpr QRgb kOpaque = 0xFF000000u;

inline int channel(QRgb w, int shift)
{
    return int((w >> shift) & 0xFF);
}

// Applies `f(source, destination, component)` to red, green and blue of every word.
template <typename F>
inline void perComponent(const QRgb* src, QRgb* dst, int count, F f)
{
    for (int i = 0; i < count; ++i) {
        const QRgb s = src[i], d = dst[i];
        dst[i] = kOpaque | QRgb(f(channel(s, 16), channel(d, 16), 16)) << 16
            | QRgb(f(channel(s, 8), channel(d, 8), 8)) << 8 | QRgb(f(channel(s, 0), channel(d, 0), 0));
    }
}

// a in proportion to (255 - w), b in proportion to w.
inline int mix(int a, int b, int w)
{
    return (a * (255 - w) + b * w + 127) / 255;
}

template <bool Invert>
void copyTinted(const QRgb* src, QRgb* dst, int count, const TransferInk& ink)
{
    perComponent(src, dst, count, [&](int s, int, int shift) {
        return mix(channel(ink.fore, shift), channel(ink.back, shift), Invert ? 255 - s : s);
    });
}

template <bool Invert>
void copyAny(const QRgb* src, QRgb* dst, int count, const TransferInk& ink)
{
    if (ink.colourises())
        copyTinted<Invert>(src, dst, count, ink);
    else if (Invert)
        for (int i = 0; i < count; ++i)
            dst[i] = kOpaque | ~src[i];
    else
        copyRowOpaque(src, dst, count, ink);
}

template <bool Invert>
void orRow(const QRgb* src, QRgb* dst, int count, const TransferInk& ink)
{
    perComponent(src, dst, count, [&](int s, int d, int shift) {
        return mix(channel(ink.fore, shift), d, Invert ? 255 - s : s);
    });
}

template <bool Invert>
void bicRow(const QRgb* src, QRgb* dst, int count, const TransferInk& ink)
{
    perComponent(src, dst, count, [&](int s, int d, int shift) {
        return mix(channel(ink.back, shift), d, Invert ? 255 - s : s);
    });
}

template <bool Invert>
void xorRow(const QRgb* src, QRgb* dst, int count, const TransferInk&)
{
    for (int i = 0; i < count; ++i)
        dst[i] = kOpaque | (dst[i] ^ (Invert ? src[i] : ~src[i]));
}

void blendRow(const QRgb* src, QRgb* dst, int count, const TransferInk& ink)
{
    perComponent(src, dst, count,
                 [&](int s, int d, int shift) { return mix(d, s, channel(ink.op, shift)); });
}

void addPinRow(const QRgb* src, QRgb* dst, int count, const TransferInk& ink)
{
    perComponent(src, dst, count,
                 [&](int s, int d, int shift) { return std::min(s + d, channel(ink.op, shift)); });
}

void addOverRow(const QRgb* src, QRgb* dst, int count, const TransferInk&)
{
    perComponent(src, dst, count, [](int s, int d, int) { return (s + d) & 0xFF; });
}

void subPinRow(const QRgb* src, QRgb* dst, int count, const TransferInk& ink)
{
    perComponent(src, dst, count,
                 [&](int s, int d, int shift) { return std::max(d - s, channel(ink.op, shift)); });
}

void subOverRow(const QRgb* src, QRgb* dst, int count, const TransferInk&)
{
    perComponent(src, dst, count, [](int s, int d, int) { return (d - s) & 0xFF; });
}

void maxRow(const QRgb* src, QRgb* dst, int count, const TransferInk&)
{
    perComponent(src, dst, count, [](int s, int d, int) { return std::max(s, d); });
}

void minRow(const QRgb* src, QRgb* dst, int count, const TransferInk&)
{
    perComponent(src, dst, count, [](int s, int d, int) { return std::min(s, d); });
}

// Source words of the back colour leave the destination alone.
void transparentRow(const QRgb* src, QRgb* dst, int count, const TransferInk& ink)
{
    const QRgb back = ink.back & 0xFFFFFF;
    for (int i = 0; i < count; ++i)
        if ((src[i] & 0xFFFFFF) != back)
            dst[i] = kOpaque | src[i];
}

struct ModeEntry {
    SInt16 mode;
    RowTransfer row;
};

constexpr ModeEntry kModes[] = {
    {srcCopy, copyAny<false>},     {srcOr, orRow<false>},       {srcXor, xorRow<false>},
    {srcBic, bicRow<false>},       {notSrcCopy, copyAny<true>}, {notSrcOr, orRow<true>},
    {notSrcXor, xorRow<true>},     {notSrcBic, bicRow<true>},   {blend, blendRow},
    {addPin, addPinRow},           {addOver, addOverRow},       {subPin, subPinRow},
    {transparent, transparentRow}, {adMax, maxRow},             {subOver, subOverRow},
    {adMin, minRow},
};

} // namespace

bool transferReadsDestination(RowTransfer transfer)
{
    return transfer != copyAny<false> && transfer != copyAny<true>;
}

void maskRow(const QRgb* copied, const QRgb* mask, QRgb* dst, int count)
{
    for (int i = 0; i < count; ++i) {
        const QRgb c = copied[i], m = mask[i], d = dst[i];
        const auto at = [&](int shift) {
            return QRgb(mix(channel(c, shift), channel(d, shift), channel(m, shift))) << shift;
        };
        dst[i] = kOpaque | at(16) | at(8) | at(0);
    }
}

RowTransfer rowTransferFor(SInt16 mode, const char* call)
{
    const SInt16 plain = SInt16(mode & ~ditherCopy);
    const auto* entry = std::find_if(std::begin(kModes), std::end(kModes),
                                     [plain](const ModeEntry& e) { return e.mode == plain; });
    if (entry != std::end(kModes))
        return entry->row;
    VelmarLog(kLogNotImpl, "Velmar::%s: transfer mode %d copies as srcCopy", call, int(mode));
    return copyAny<false>;
}

} // namespace Velmar::Private
