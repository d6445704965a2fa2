#include "classic/resfile/Picture.h"

#include "classic/resfile/BigEndian.h"
#include "classic/resfile/PictData.h"

#include <Velmar/Velmar.h>

#include <QHash>

#include <algorithm>
#include <cstring>
#include <optional>

namespace Velmar::Classic {

namespace {

constexpr qsizetype kFileHeader = 512; // PICT files on disk start with 512 bytes for the application

// Where the opcodes start, their version and the frame.
struct Layout {
    qsizetype start = 0;
    int version = 0;
    Rect frame{};
};

std::optional<Layout> layoutOf(const QByteArray& pict)
{
    for (const qsizetype base : {qsizetype(0), kFileHeader}) {
        BigEndianReader in(pict, base + 2);
        Layout l;
        l.frame = in.rect();
        const UInt16 first = in.u16();
        if (!in.ok())
            continue;
        if (first == 0x1101) { // version opcode 0x11, version 1
            l.version = 1;
            l.start = base + 12;
            return l;
        }
        if (first == 0x0011 && in.u16() == 0x02FF && in.ok()) {
            l.version = 2;
            l.start = base + 14;
            return l;
        }
    }
    return std::nullopt;
}

qint64 width(const Rect& r) { return qint64(r.right) - r.left; }
qint64 height(const Rect& r) { return qint64(r.bottom) - r.top; }

SInt16 clamp16(qint64 v)
{
    return SInt16(std::clamp<qint64>(v, -32767, 32767));
}

// Positions a picture moves step by step (origin, pen, text) stay within this range, so that
// no number of steps can overflow.
constexpr int kFar = 1 << 20;
QPoint clampFar(const QPoint& p)
{
    return QPoint(std::clamp(p.x(), -kFar, kFar), std::clamp(p.y(), -kFar, kFar));
}

// The classic eight colours of FgColor/BkColor (version 1 pictures).
RGBColor oldStyleColor(UInt32 value, bool fore)
{
    switch (value) {
    case 33: return RGBColor(0, 0, 0);
    case 30: return RGBColor(65535, 65535, 65535);
    case 205: return RGBColor(0xDD6B, 0x08C2, 0x06A2);
    case 341: return RGBColor(0x0000, 0x8000, 0x11B0);
    case 409: return RGBColor(0x0000, 0x0000, 0xD400);
    case 273: return RGBColor(0x0241, 0xAB54, 0xEAFF);
    case 137: return RGBColor(0xF2D7, 0x0856, 0x84EC);
    case 69: return RGBColor(0xFC00, 0xF37D, 0x052F);
    default: return fore ? RGBColor(0, 0, 0) : RGBColor(65535, 65535, 65535);
    }
}

// The port state a picture may change, put back when playback ends however it ends.
class PortStateScope {
public:
    explicit PortStateScope(GrafPtr port) : m_port(port), m_background(port->currentBackground())
    {
        GetPenState(&m_pen);
        GetForeColor(&m_fore);
        GetBackColor(&m_back);
        GetPortOpColor(port, &m_op);
        m_font = GetPortTextFont(port);
        m_size = GetPortTextSize(port);
        m_face = GetPortTextFace(port);
        m_mode = GetPortTextMode(port);
        m_appFont = port->appFontFlag != 0;
        m_clip = NewRgn();
        GetClip(m_clip);
    }
    ~PortStateScope()
    {
        SetPenState(&m_pen);
        RGBForeColor(&m_fore);
        RGBBackColor(&m_back);
        SetPortOpColor(m_port, &m_op);
        TextFont(m_font, m_appFont);
        TextSize(m_size, m_appFont);
        TextFace(m_face, m_appFont);
        TextMode(m_mode);
        BackPat(PatPtr(m_background));
        SetClip(m_clip);
        DisposeRgn(m_clip);
    }
    PortStateScope(const PortStateScope&) = delete;
    PortStateScope& operator=(const PortStateScope&) = delete;
    RgnHandle clip() const { return m_clip; }

private:
    GrafPtr m_port;
    QBrush m_background;
    PenState m_pen;
    RGBColor m_fore, m_back, m_op;
    SInt16 m_font = 0, m_size = 0, m_mode = 0;
    Style m_face = 0;
    bool m_appFont = true;
    RgnHandle m_clip = nullptr;
};

// A region handle owned by a scope.
class ScopedRgn {
public:
    explicit ScopedRgn(const QRegion& region) : m_rgn(NewRgn()) { *m_rgn = region; }
    ~ScopedRgn() { DisposeRgn(m_rgn); }
    ScopedRgn(const ScopedRgn&) = delete;
    ScopedRgn& operator=(const ScopedRgn&) = delete;
    operator RgnHandle() const { return m_rgn; }

private:
    RgnHandle m_rgn;
};

class Player {
public:
    Player(const QByteArray& pict, const Layout& layout, const Rect& destination, RgnHandle baseClip)
        : m_in(pict, layout.start), m_version(layout.version), m_frame(layout.frame),
          m_dst(destination), m_baseClip(baseClip)
    {
        std::memset(m_fillPattern, 0xFF, sizeof m_fillPattern);
    }

    void run()
    {
        while (m_in.ok() && !m_in.atEnd()) {
            if (m_version == 2)
                m_in.alignWord();
            const UInt16 op = m_version == 2 ? m_in.u16() : m_in.u8();
            if (!m_in.ok() || op == 0x00FF || !play(op))
                return;
        }
    }

private:
    // ---- Mapping from the picture's frame onto the destination -----------------------
    SInt16 mapH(qint64 h) const { return clamp16(scale(h - m_ox - m_frame.left, width(m_dst), width(m_frame)) + m_dst.left); }
    SInt16 mapV(qint64 v) const { return clamp16(scale(v - m_oy - m_frame.top, height(m_dst), height(m_frame)) + m_dst.top); }
    static qint64 scale(qint64 value, qint64 to, qint64 from) { return to == from ? value : value * to / from; }
    Rect mapRect(const Rect& r) const { return Rect{mapV(r.top), mapH(r.left), mapV(r.bottom), mapH(r.right)}; }
    SInt16 scaleH(qint64 n) const { return clamp16(n > 0 ? std::max<qint64>(1, scale(n, width(m_dst), width(m_frame))) : n); }
    SInt16 scaleV(qint64 n) const { return clamp16(n > 0 ? std::max<qint64>(1, scale(n, height(m_dst), height(m_frame))) : n); }
    void moveTo(const QPoint& p) { MoveTo(mapH(p.x()), mapV(p.y())); }
    void lineTo(const QPoint& p) { LineTo(mapH(p.x()), mapV(p.y())); }
    QRegion mapRegion(const QRegion& region) const
    {
        ScopedRgn rgn(region.translated(-m_ox, -m_oy));
        const Rect frame = m_frame, dst = m_dst;
        MapRgn(rgn, &frame, &dst);
        return *static_cast<RgnHandle>(rgn);
    }

    // ---- Operand readers --------------------------------------------------------------
    QPoint point() { const Point p = m_in.point(); return QPoint(p.h, p.v); }
    void readPattern(UInt8 (&pat)[8]) { for (UInt8& b : pat) b = m_in.u8(); }
    RGBColor rgb() { RGBColor c; c.red = m_in.u16(); c.green = m_in.u16(); c.blue = m_in.u16(); return c; }
    PatPtr fillPattern() const { const Pattern p = classicPattern(m_fillPattern); return PatPtr(&p); }

    // ---- Shapes -----------------------------------------------------------------------
    void rectVerb(int verb, const Rect& r)
    {
        const Rect m = mapRect(r);
        switch (verb) {
        case 0: FrameRect(&m); break;
        case 1: PaintRect(&m); break;
        case 2: EraseRect(&m); break;
        case 3: InvertRect(&m); break;
        case 4: FillRect(&m, fillPattern()); break;
        }
    }
    void roundRectVerb(int verb, const Rect& r)
    {
        const Rect m = mapRect(r);
        const short w = scaleH(m_ovalSize.h), h = scaleV(m_ovalSize.v);
        switch (verb) {
        case 0: FrameRoundRect(&m, w, h); break;
        case 1: PaintRoundRect(&m, w, h); break;
        case 2: EraseRoundRect(&m, w, h); break;
        case 3: InvertRoundRect(&m, w, h); break;
        case 4: FillRoundRect(&m, w, h, fillPattern()); break;
        }
    }
    void ovalVerb(int verb, const Rect& r)
    {
        const Rect m = mapRect(r);
        switch (verb) {
        case 0: FrameOval(&m); break;
        case 1: PaintOval(&m); break;
        case 2: EraseOval(&m); break;
        case 3: InvertOval(&m); break;
        case 4: FillOval(&m, fillPattern()); break;
        }
    }
    void arcVerb(int verb, const Rect& r, short start, short arc)
    {
        const Rect m = mapRect(r);
        switch (verb) {
        case 0: FrameArc(&m, start, arc); break;
        case 1: PaintArc(&m, start, arc); break;
        case 2: EraseArc(&m, start, arc); break;
        case 3: InvertArc(&m, start, arc); break;
        case 4: FillArc(&m, start, arc, fillPattern()); break;
        }
    }
    void polyVerb(int verb, const QPolygon& poly)
    {
        if (poly.isEmpty())
            return;
        Point pen;
        GetPen(&pen);
        PolyPtr* p = OpenPoly();
        for (qsizetype i = 0; i < poly.size(); ++i)
            i ? lineTo(poly[i]) : moveTo(poly[i]);
        ClosePoly();
        switch (verb) {
        case 0: FramePoly(p); break;
        case 1: PaintPoly(p); break;
        case 2: ErasePoly(p); break;
        case 3: InvertPoly(p); break;
        case 4: FillPoly(p, fillPattern()); break;
        }
        KillPoly(p);
        MoveTo(pen.h, pen.v);
    }
    void regionVerb(int verb, const QRegion& region)
    {
        ScopedRgn rgn(mapRegion(region));
        switch (verb) {
        case 0: FrameRgn(rgn); break;
        case 1: PaintRgn(rgn); break;
        case 2: EraseRgn(rgn); break;
        case 3: InvertRgn(rgn); break;
        case 4: FillRgn(rgn, fillPattern()); break;
        }
    }

    // The shape opcodes 0x30-0x8F: the family in the high nibble, "same" in bit 3, the verb
    // in the low three bits (5-7 are reserved and draw nothing).
    bool shape(UInt16 op)
    {
        const int family = op & 0xF0;
        const bool same = op & 0x08;
        const int verb = op & 0x07;
        switch (family) {
        case 0x30: case 0x40: case 0x50: {
            if (!same)
                m_lastRect = m_in.rect();
            if (!m_in.ok())
                return false;
            if (family == 0x30) rectVerb(verb, m_lastRect);
            else if (family == 0x40) roundRectVerb(verb, m_lastRect);
            else ovalVerb(verb, m_lastRect);
            return true;
        }
        case 0x60: {
            if (!same)
                m_lastRect = m_in.rect();
            const short start = m_in.s16(), arc = m_in.s16();
            if (!m_in.ok())
                return false;
            arcVerb(verb, m_lastRect, start, arc);
            return true;
        }
        case 0x70:
            if (!same)
                m_lastPoly = Pict::readPolygon(m_in);
            if (!m_in.ok())
                return false;
            polyVerb(verb, m_lastPoly);
            return true;
        case 0x80:
            if (!same)
                m_lastRegion = Pict::readRegion(m_in);
            if (!m_in.ok())
                return false;
            regionVerb(verb, m_lastRegion);
            return true;
        }
        return false;
    }

    // ---- Text -------------------------------------------------------------------------
    void text(const QByteArray& bytes)
    {
        moveTo(m_textLoc);
        if (!bytes.isEmpty())
            DrawText(bytes.constData(), 0, SInt16(bytes.size()));
    }
    SInt16 textSize(SInt16 size) const
    {
        if (size <= 0)
            return 0;
        return SInt16(std::clamp<qint64>(scale(size, height(m_dst), height(m_frame)), 1, 1000));
    }

    // ---- Bitmaps and pixmaps ----------------------------------------------------------
    void pixels(const Pict::PixelOperand& operand)
    {
        const QImage& image = operand.image;
        if (image.isNull())
            return;
        GrafPtr port = GetCurrentPort();
        PixMapHandle map = NewPixMap();
        if (SetPixBounds(map, &operand.bounds) != noErr) {
            DisposePixMap(map);
            return;
        }
        Ptr base = GetPixBaseAddr(map);
        const SInt32 rowBytes = GetPixRowBytes(map);
        if (base && rowBytes >= image.width() * 4) {
            for (int y = 0; y < image.height(); ++y)
                std::memcpy(base + qsizetype(y) * rowBytes, image.constScanLine(y), size_t(image.width()) * 4);
            const Rect dst = mapRect(operand.dstRect);
            if (operand.hasMask) {
                ScopedRgn mask(mapRegion(operand.mask));
                CopyBits(map, GetPortBitMapForCopyBits(port), &operand.srcRect, &dst, operand.mode, mask);
            } else {
                CopyBits(map, GetPortBitMapForCopyBits(port), &operand.srcRect, &dst, operand.mode, nullptr);
            }
        }
        DisposePixMap(map);
    }

    void setClip(const QRegion& region)
    {
        ScopedRgn clip(mapRegion(region));
        SectRgn(clip, m_baseClip, clip);
        SetClip(clip);
    }

    // Opcodes this player does not draw, skipped by the lengths the format gives them.
    bool skipUnknown(UInt16 op)
    {
        const auto in = [op](UInt16 lo, UInt16 hi) { return op >= lo && op <= hi; };
        if (in(0x0017, 0x0019) || in(0x00B0, 0x00CF) || in(0x8000, 0x80FF))
            return true;
        if (in(0x0024, 0x0027) || in(0x002D, 0x002F) || in(0x0092, 0x0097) || in(0x009C, 0x009F)
            || in(0x00A2, 0x00AF)) {
            m_in.skip(m_in.u16());
            return m_in.ok();
        }
        if (in(0x00D0, 0x00FE) || op >= 0x8100) {
            m_in.skip(m_in.u32());
            return m_in.ok();
        }
        if (in(0x0100, 0x7FFF)) {
            m_in.skip((op >> 8) * 2);
            return m_in.ok();
        }
        return false;
    }

    bool play(UInt16 op)
    {
        if (op >= 0x0030 && op <= 0x008F)
            return shape(op);
        switch (op) {
        case 0x0000: return true;
        case 0x0001: { const QRegion r = Pict::readRegion(m_in); if (m_in.ok()) setClip(r); break; }
        case 0x0002: { UInt8 p[8]; readPattern(p); const Pattern pat = classicPattern(p); BackPat(&pat); break; }
        case 0x0003: { const SInt16 id = m_in.s16(); TextFont(m_fontIDs.value(id, id)); break; }
        case 0x0004: TextFace(m_in.u8()); break;
        case 0x0005: TextMode(m_in.s16()); break;
        case 0x0006: m_in.skip(4); break; // space extra
        case 0x0007: { const QPoint s = point(); PenSize(scaleH(s.x()), scaleV(s.y())); break; }
        case 0x0008: PenMode(m_in.s16()); break;
        case 0x0009: { UInt8 p[8]; readPattern(p); const Pattern pat = classicPattern(p); PenPat(&pat); break; }
        case 0x000A: readPattern(m_fillPattern); break;
        case 0x000B: m_ovalSize = m_in.point(); break;
        case 0x000C: { // dh then dv
            const int dh = m_in.s16(), dv = m_in.s16();
            m_ox = std::clamp(m_ox + dh, -kFar, kFar);
            m_oy = std::clamp(m_oy + dv, -kFar, kFar);
            break;
        }
        case 0x000D: TextSize(textSize(m_in.s16())); break;
        case 0x000E: { const RGBColor c = oldStyleColor(m_in.u32(), true); RGBForeColor(&c); break; }
        case 0x000F: { const RGBColor c = oldStyleColor(m_in.u32(), false); RGBBackColor(&c); break; }
        case 0x0010: m_in.skip(8); break; // text ratio
        case 0x0011: m_in.skip(1); break; // version
        case 0x0012: case 0x0013: case 0x0014: {
            UInt8 p[8];
            if (!Pict::readPixPat(m_in, p))
                return false;
            const Pattern pat = classicPattern(p);
            if (op == 0x0012) BackPat(&pat);
            else if (op == 0x0013) PenPat(&pat);
            else std::memcpy(m_fillPattern, p, 8);
            break;
        }
        case 0x0015: case 0x0016: m_in.skip(2); break; // fractional pen, character extra
        case 0x001A: { const RGBColor c = rgb(); if (m_in.ok()) RGBForeColor(&c); break; }
        case 0x001B: { const RGBColor c = rgb(); if (m_in.ok()) RGBBackColor(&c); break; }
        case 0x001C: case 0x001E: break; // hilite mode, default hilite
        case 0x001D: m_in.skip(6); break; // hilite colour
        case 0x001F: { const RGBColor c = rgb(); if (m_in.ok()) OpColor(&c); break; }
        case 0x0020: { m_pen = point(); const QPoint to = point(); if (!m_in.ok()) return false; moveTo(m_pen); lineTo(to); m_pen = to; break; }
        case 0x0021: { const QPoint to = point(); if (!m_in.ok()) return false; moveTo(m_pen); lineTo(to); m_pen = to; break; }
        case 0x0022: case 0x0023: {
            if (op == 0x0022)
                m_pen = point();
            const int dh = m_in.s8(), dv = m_in.s8();
            if (!m_in.ok())
                return false;
            const QPoint to = clampFar(m_pen + QPoint(dh, dv));
            moveTo(m_pen);
            lineTo(to);
            m_pen = to;
            break;
        }
        case 0x0028: { m_textLoc = point(); const QByteArray t = m_in.pascal(); if (m_in.ok()) text(t); break; }
        case 0x0029: { m_textLoc = clampFar(m_textLoc + QPoint(m_in.u8(), 0)); const QByteArray t = m_in.pascal(); if (m_in.ok()) text(t); break; }
        case 0x002A: { m_textLoc = clampFar(m_textLoc + QPoint(0, m_in.u8())); const QByteArray t = m_in.pascal(); if (m_in.ok()) text(t); break; }
        case 0x002B: {
            const int dh = m_in.u8(), dv = m_in.u8();
            m_textLoc = clampFar(m_textLoc + QPoint(dh, dv));
            const QByteArray t = m_in.pascal();
            if (m_in.ok())
                text(t);
            break;
        }
        case 0x002C: {
            const QByteArray data = m_in.bytes(m_in.u16());
            BigEndianReader font(data);
            const SInt16 id = font.s16();
            QByteArray name = font.pascal();
            if (font.ok() && !name.isEmpty()) {
                name.prepend(char(name.size()));
                SInt16 found = 0;
                GetFNum(reinterpret_cast<const unsigned char*>(name.constData()), &found);
                if (found)
                    m_fontIDs.insert(id, found);
            }
            break;
        }
        case 0x0090: case 0x0091: case 0x0098: case 0x0099: case 0x009A: case 0x009B: {
            Pict::PixelOperand operand;
            const bool direct = op >= 0x009A, packed = op >= 0x0098, withMask = op & 1;
            if (!Pict::readPixelOperand(m_in, direct, packed, withMask, operand))
                return false;
            pixels(operand);
            break;
        }
        case 0x00A0: m_in.skip(2); break; // short comment
        case 0x00A1: m_in.skip(2); m_in.skip(m_in.u16()); break; // long comment
        case 0x0C00: { // header: an extended one gives the resolution's own source rectangle
            const SInt16 version = m_in.s16();
            m_in.skip(2 + 4 + 4);
            const Rect source = m_in.rect();
            m_in.skip(4);
            if (m_in.ok() && version == -2 && width(source) > 0 && height(source) > 0)
                m_frame = source;
            break;
        }
        default:
            return skipUnknown(op);
        }
        return m_in.ok();
    }

    BigEndianReader m_in;
    int m_version;
    Rect m_frame;
    Rect m_dst;
    RgnHandle m_baseClip;
    int m_ox = 0; // the picture's origin, moved by the Origin opcode
    int m_oy = 0;
    QPoint m_pen;
    QPoint m_textLoc;
    Point m_ovalSize{};
    Rect m_lastRect{};
    QPolygon m_lastPoly;
    QRegion m_lastRegion;
    UInt8 m_fillPattern[8];
    QHash<SInt16, SInt16> m_fontIDs; // the picture's font numbers to this system's, by name
};

} // namespace

Pattern classicPattern(const UInt8 (&bits)[8])
{
    // The library's patterns paint clear bits in the pen colour, least significant bit
    // leftmost, except the all-set and all-clear patterns, which it keeps as solid black and
    // white. A picture's patterns paint set bits, most significant bit leftmost.
    Pattern p;
    bool allSet = true, allClear = true;
    for (int i = 0; i < 8; ++i) {
        allSet = allSet && bits[i] == 0xFF;
        allClear = allClear && bits[i] == 0x00;
    }
    for (int i = 0; i < 8; ++i) {
        UInt8 reversed = 0;
        for (int b = 0; b < 8; ++b)
            reversed |= UInt8(((bits[i] >> b) & 1) << (7 - b));
        p.pat[i] = (allSet || allClear) ? bits[i] : UInt8(~reversed);
    }
    return p;
}

Rect pictureFrame(const QByteArray& pict)
{
    if (const auto layout = layoutOf(pict))
        return layout->frame;
    if (pict.size() < 10)
        return Rect{};
    BigEndianReader in(pict, 2);
    return in.rect();
}

bool drawPicture(const QByteArray& pict, const Rect& destination)
{
    GrafPtr port = GetCurrentPort();
    if (!port || !IsValidPort(port))
        return false;
    const auto layout = layoutOf(pict);
    if (!layout || width(layout->frame) <= 0 || height(layout->frame) <= 0)
        return false;
    PortStateScope saved(port);
    Player(pict, *layout, destination, saved.clip()).run();
    return true;
}

QImage pictureImage(const QByteArray& pict, QString* error)
{
    const auto fail = [error](const QString& why) {
        if (error)
            *error = why;
        return QImage();
    };
    const auto layout = layoutOf(pict);
    if (!layout)
        return fail(QStringLiteral("not a version 1 or 2 picture"));
    const qint64 w = width(layout->frame), h = height(layout->frame);
    if (w <= 0 || h <= 0 || w * h > Pict::kMaxPixels)
        return fail(QStringLiteral("picture frame %1 x %2 cannot be drawn").arg(w).arg(h));
    GrafPtr savedPort = nullptr;
    void* savedDevice = nullptr;
    GetGWorld(&savedPort, &savedDevice);
    GrafPtr world = nullptr;
    const Rect bounds{0, 0, SInt16(h), SInt16(w)};
    if (NewGWorld(&world, 32, &bounds, nullptr, nullptr, 0) != noErr || !world)
        return fail(QStringLiteral("no offscreen world of %1 x %2").arg(w).arg(h));
    SetGWorld(world, nullptr);
    EraseRect(&bounds);
    drawPicture(pict, bounds);
    world->EndPaint();
    const QImage image = world->image() ? world->image()->copy() : QImage();
    if (savedPort && IsValidPort(savedPort))
        SetGWorld(savedPort, savedDevice);
    DisposeGWorld(world);
    return image.isNull() ? fail(QStringLiteral("the offscreen world has no pixels")) : image;
}

} // namespace Velmar::Classic
