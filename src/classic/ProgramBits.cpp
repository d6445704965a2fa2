// Ports drawing into a program's own bitmap: OpenPort, then SetPortBits(&myBits) or portBits
// written directly. The library port behind such a port is an offscreen world the bitmap's
// size, in the bitmap's coordinates. The program's memory is the truth: before each drawing
// call the layer reads it into the world when its bytes differ from what the layer last saw
// (the program wrote them), and after each drawing call it writes the world back (a pixel
// darker than middle grey sets its bit). So the bits are right whenever the program can look.
#include "classic/ClassicPrivate.h"

#include <QColor>

#include <cstring>

namespace VelmarClassic {

bool boundToProgramBits(const PortLink& link)
{
    return link.boundBits.baseAddr != nullptr;
}

namespace {

// Large enough for any bitmap of the time; beyond it a made-up record is refused (the
// library port behind it takes four bytes a pixel).
constexpr int kMaxSide = 8192;
constexpr qint64 kMaxPixels = 16 * 1024 * 1024;
constexpr Velmar::UInt32 kBlack = 0xFF000000u, kWhite = 0xFFFFFFFFu;

bool sameBits(const BitMap& a, const BitMap& b)
{
    return a.baseAddr == b.baseAddr && a.rowBytes == b.rowBytes
        && Velmar::EqualRect(&a.bounds, &b.bounds);
}

// A bitmap of the program's memory: not the screen's (null), not a pixmap's row bytes.
bool usable(const BitMap& bits)
{
    const int width = bits.bounds.right - bits.bounds.left;
    const int height = bits.bounds.bottom - bits.bounds.top;
    return bits.baseAddr && (bits.rowBytes & 0xC000) == 0 && width > 0 && height > 0
        && width <= kMaxSide && height <= kMaxSide && qint64(width) * height <= kMaxPixels
        && bits.rowBytes * 8 >= width;
}

qsizetype byteCount(const BitMap& bits)
{
    return qsizetype(bits.rowBytes) * (bits.bounds.bottom - bits.bounds.top);
}

struct Words {
    Velmar::UInt32* base = nullptr;
    qsizetype stride = 0; // in words
};

Words worldWords(const PortLink& link)
{
    Velmar::PixMapHandle pixmap = Velmar::GetGWorldPixMap(link.port());
    auto* base =
        reinterpret_cast<Velmar::UInt32*>(pixmap ? Velmar::GetPixBaseAddr(pixmap) : nullptr);
    return {base, base ? Velmar::GetPixRowBytes(pixmap) / 4 : 0};
}

void bind(PortLink& link, const BitMap& bits)
{
    const bool wasBound = boundToProgramBits(link);
    link.boundBits = BitMap{};
    link.bitsSeen.clear();
    link.worldSeen.clear();
    if (!usable(bits)) {
        // Back on the screen, as a new port.
        if (wasBound)
            Velmar::SetPortBounds(link.port(), &globals()->screenBits.bounds);
        return;
    }
    Velmar::SetPortBounds(link.port(), &bits.bounds);
    const Words w = worldWords(link);
    Rect bounds{};
    Velmar::GetPortBounds(link.port(), &bounds);
    // The world must be the bitmap's size to stand for it.
    if (w.base && Velmar::EqualRect(&bounds, &bits.bounds))
        link.boundBits = bits;
}

} // namespace

void loadProgramBits(PortLink& link)
{
    if (link.window || !link.ownPort || link.colour)
        return;
    if (!sameBits(link.record->portBits, link.boundBits)
        && !(link.record->portBits.baseAddr == nullptr && !boundToProgramBits(link)))
        bind(link, link.record->portBits);
    if (!boundToProgramBits(link))
        return;
    const BitMap& bits = link.boundBits;
    const qsizetype size = byteCount(bits);
    if (link.bitsSeen.size() == size
        && std::memcmp(link.bitsSeen.constData(), bits.baseAddr, size) == 0)
        return;
    const Words w = worldWords(link);
    if (!w.base)
        return;
    const int width = bits.bounds.right - bits.bounds.left;
    const int height = bits.bounds.bottom - bits.bounds.top;
    const auto* bytes = reinterpret_cast<const Velmar::UInt8*>(bits.baseAddr);
    link.worldSeen.resize(std::size_t(width) * std::size_t(height));
    for (int y = 0; y < height; ++y) {
        const Velmar::UInt8* row = bytes + qsizetype(y) * bits.rowBytes;
        Velmar::UInt32* out = w.base + y * w.stride;
        for (int x = 0; x < width; ++x)
            out[x] = (row[x >> 3] & (0x80 >> (x & 7))) ? kBlack : kWhite;
        std::memcpy(link.worldSeen.data() + qsizetype(y) * width, out, std::size_t(width) * 4);
    }
    link.bitsSeen = QByteArray(bits.baseAddr, size);
}

void storeProgramBits(PortLink& link)
{
    if (!boundToProgramBits(link))
        return;
    const Words w = worldWords(link);
    const BitMap& bits = link.boundBits;
    const int width = bits.bounds.right - bits.bounds.left;
    const int height = bits.bounds.bottom - bits.bounds.top;
    // Filled by loadProgramBits, which every drawing call runs first.
    if (!w.base || link.worldSeen.size() != std::size_t(width) * std::size_t(height)
        || link.bitsSeen.size() != byteCount(bits))
        return;
    auto* bytes = reinterpret_cast<Velmar::UInt8*>(bits.baseAddr);
    auto* seenBytes = reinterpret_cast<Velmar::UInt8*>(link.bitsSeen.data());
    // Only the pixels that changed since the last write-back: rows compared whole, then the
    // span between the first and last changed pixel converted.
    for (int y = 0; y < height; ++y) {
        const Velmar::UInt32* in = w.base + y * w.stride;
        Velmar::UInt32* seen = link.worldSeen.data() + qsizetype(y) * width;
        if (std::memcmp(in, seen, std::size_t(width) * 4) == 0)
            continue;
        int first = 0, last = width - 1;
        while (in[first] == seen[first])
            ++first;
        while (in[last] == seen[last])
            --last;
        std::memcpy(seen + first, in + first, std::size_t(last - first + 1) * 4);
        const qsizetype rowStart = qsizetype(y) * bits.rowBytes;
        // Bits beyond the bounds in the last byte are the program's and stay as they were.
        for (int x = first; x <= last; ++x) {
            const bool dark = qGray(QRgb(in[x])) < 128;
            const Velmar::UInt8 bit = Velmar::UInt8(0x80 >> (x & 7));
            Velmar::UInt8& byte = bytes[rowStart + (x >> 3)];
            byte = Velmar::UInt8(dark ? (byte | bit) : (byte & ~bit));
            seenBytes[rowStart + (x >> 3)] = byte;
        }
    }
}

} // namespace VelmarClassic

using namespace VelmarClassic;

void SetPortBits(const BitMap* bm)
{
    PortLink* link = currentLink();
    if (!link || !VELMAR_ASSERT(bm, "bm != NULL"))
        return;
    link->record->portBits = *bm;
    if (!link->window)
        loadProgramBits(*link);
}
