// Cheap conversions between Toolbox value types and the Qt types the library works in.
// Everything here is inline: QuickDraw calls these on every drawing operation.
#pragma once

#include <Velmar/MacTypes.h>

#include <QColor>
#include <QPoint>
#include <QRect>
#include <QSize>

#include <algorithm>

namespace Velmar::Private {

// A Toolbox rectangle's right and bottom edges lie outside it; a QRect's corners are
// inclusive, hence the -1 going to Qt and the +1 coming back.
inline QRect toQRect(const Rect& r)
{
    return QRect(QPoint(r.left, r.top), QPoint(r.right - 1, r.bottom - 1));
}

inline QRect toQRect(const Rect* r)
{
    return r ? toQRect(*r) : QRect();
}

// Coordinates outside 16 bits wrap, as they did when a Toolbox host stored them.
inline Rect toRect(const QRect& r)
{
    Rect out;
    out.top = static_cast<SInt16>(r.top());
    out.left = static_cast<SInt16>(r.left());
    out.bottom = static_cast<SInt16>(r.bottom() + 1);
    out.right = static_cast<SInt16>(r.right() + 1);
    return out;
}

inline void toRect(const QRect& r, Rect* out)
{
    if (out)
        *out = toRect(r);
}

inline QPoint toQPoint(Point p)
{
    return QPoint(p.h, p.v);
}

inline Point toPoint(const QPoint& p)
{
    Point out;
    out.v = static_cast<SInt16>(p.y());
    out.h = static_cast<SInt16>(p.x());
    return out;
}

inline Point toPoint(int h, int v)
{
    Point out;
    out.v = static_cast<SInt16>(v);
    out.h = static_cast<SInt16>(h);
    return out;
}

inline Rect makeRect(int left, int top, int right, int bottom)
{
    Rect r;
    r.top = static_cast<SInt16>(top);
    r.left = static_cast<SInt16>(left);
    r.bottom = static_cast<SInt16>(bottom);
    r.right = static_cast<SInt16>(right);
    return r;
}

inline int rectWidth(const Rect& r)
{
    return r.right - r.left;
}

inline int rectHeight(const Rect& r)
{
    return r.bottom - r.top;
}

inline QSize rectSize(const Rect& r)
{
    return QSize(rectWidth(r), rectHeight(r));
}

// Empty exactly as the Toolbox tests it; a null rectangle counts as empty.
inline bool isEmptyRect(const Rect* r)
{
    return !r || r->left > r->right - 1 || r->top > r->bottom - 1;
}

inline bool sameRect(const Rect& a, const Rect& b)
{
    return a.top == b.top && a.left == b.left && a.bottom == b.bottom && a.right == b.right;
}

inline bool samePoint(Point a, Point b)
{
    return a.v == b.v && a.h == b.h;
}

// Coordinates the library computes with are kept within +-kFarCoordinate, far beyond any
// 16-bit Toolbox value, so that Qt's int arithmetic on rectangles, polygons and regions
// (widths, adjustments, translations) can never overflow.
inline constexpr qint64 kFarCoordinate = qint64(1) << 29;

inline int clampFar(qint64 v)
{
    return int(std::clamp(v, -kFarCoordinate, kFarCoordinate));
}

inline bool isFar(qint64 v)
{
    return v < -kFarCoordinate || v > kFarCoordinate;
}

// The rectangle with these inclusive edges, computed in 64 bits and clamped.
inline QRect farRect(qint64 left, qint64 top, qint64 right, qint64 bottom)
{
    return QRect(QPoint(clampFar(left), clampFar(top)), QPoint(clampFar(right), clampFar(bottom)));
}

// `r` grown by `w` on every side, without overflow.
inline QRect grownRect(const QRect& r, int w)
{
    return farRect(qint64(r.left()) - w, qint64(r.top()) - w, qint64(r.right()) + w,
                   qint64(r.bottom()) + w);
}

// Channel conversions at the single-precision scale the whole library shares.
inline unsigned short channel8To16(int byte)
{
    return static_cast<unsigned short>(static_cast<float>(byte & 0xFF) * kChannelScale);
}

inline int channel16To8(unsigned short channel)
{
    return static_cast<int>(static_cast<float>(channel) / kChannelScale);
}

inline QColor toQColor(const RGBColor& c)
{
    return static_cast<QColor>(c);
}

inline RGBColor toRGBColor(const QColor& c)
{
    return RGBColor(c);
}

// Four-character codes: first character in the most significant byte.
inline char fourCharByte(FourCharCode code, int index)
{
    return static_cast<char>((code >> (8 * (3 - index))) & 0xFF);
}

} // namespace Velmar::Private
