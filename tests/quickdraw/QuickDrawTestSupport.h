// Shared helpers of the QuickDraw tests: an offscreen world made current, pixel read-back,
// owned regions, recorded polygons and the assertion check.
#pragma once

#include <Velmar/Diagnostics.h>
#include <Velmar/QDRegions.h>
#include <Velmar/QDShapes.h>
#include <Velmar/QtGrafPort.h>
#include <Velmar/QuickDraw.h>

#include "TestSupport.h"
#include "foundation/Conversions.h"
#include "quickdraw/GrafPortPrivate.h"
#include "quickdraw/PortPainter.h"

#include <QImage>
#include <QPolygon>
#include <QSet>

#include <cstdlib>
#include <memory>

namespace QDTest {

inline Rect R(int top, int left, int bottom, int right)
{
    return Rect{std::int16_t(top), std::int16_t(left), std::int16_t(bottom), std::int16_t(right)};
}
inline Point P(int h, int v)
{
    Point p;
    p.h = std::int16_t(h), p.v = std::int16_t(v);
    return p;
}

// A white 32-bit world with its top-left at (0, 0), made current. Disposed with the scope
// unless the test has disposed of it already.
class World {
public:
    explicit World(int width = 100, int height = 0)
    {
        const Rect bounds = R(0, 0, height ? height : width, width);
        Velmar::NewGWorld(&m_port, 32, &bounds, nullptr, nullptr, 0);
        Velmar::SetPort(m_port);
    }
    ~World() { if (Velmar::IsValidPort(m_port)) Velmar::DisposeGWorld(m_port); }
    World(const World&) = delete;
    World& operator=(const World&) = delete;

    operator Velmar::GrafPtr() const { return m_port; }
    Velmar::GrafPtr operator->() const { return m_port; }
    Velmar::GrafPtr port() const { return m_port; }
    QImage& image() const { return *m_port->image(); }
    QRgb pixel(int x, int y) const { return m_port->image()->pixel(x, y); }
    // The port's painter, started as a drawing call starts it.
    QPainter* painter() const { return Velmar::Private::portPainter(m_port, "test"); }
    // Every pixel that is not the given colour, as (x, y) points.
    QSet<QPoint> touched(QRgb background = 0xFFFFFFFF) const
    {
        m_port->EndPaint();
        const QImage& img = *m_port->image();
        QSet<QPoint> out;
        for (int y = 0; y < img.height(); ++y)
            for (int x = 0; x < img.width(); ++x)
                if (img.pixel(x, y) != background)
                    out.insert(QPoint(x, y));
        return out;
    }

private:
    Velmar::GrafPtr m_port = nullptr;
};

// The pixels of a region, as (x, y) points.
inline QSet<QPoint> regionPixels(const QRegion& region)
{
    QSet<QPoint> out;
    for (const QRect& r : region)
        for (int y = r.top(); y <= r.bottom(); ++y)
            for (int x = r.left(); x <= r.right(); ++x)
                out.insert(QPoint(x, y));
    return out;
}

// The pixels of a rectangle given by its Toolbox edges, and of a frame w deep inside it.
inline QSet<QPoint> rectPixels(int left, int top, int right, int bottom)
{
    return regionPixels(QRegion(QRect(QPoint(left, top), QPoint(right - 1, bottom - 1))));
}
inline QSet<QPoint> framePixels(int left, int top, int right, int bottom, int w)
{
    return rectPixels(left, top, right, bottom) - rectPixels(left + w, top + w, right - w, bottom - w);
}

// "count@x,y wxh" of a pixel set, for failure messages.
inline QByteArray describe(const QSet<QPoint>& pixels)
{
    QRect box;
    for (const QPoint& p : pixels)
        box |= QRect(p, QSize(1, 1));
    return QStringLiteral("%1@%2,%3 %4x%5").arg(pixels.size()).arg(box.x()).arg(box.y())
        .arg(box.width()).arg(box.height()).toLatin1();
}

// The bounding box of a pixel set.
inline QRect boundingBox(const QSet<QPoint>& pixels)
{
    QRect box;
    for (const QPoint& p : pixels)
        box |= QRect(p, QSize(1, 1));
    return box;
}

// Channels within one step (what rounding may give either way), alpha equal.
inline bool near(QRgb a, QRgb b)
{
    return qAlpha(a) == qAlpha(b) && std::abs(qRed(a) - qRed(b)) <= 1
        && std::abs(qGreen(a) - qGreen(b)) <= 1 && std::abs(qBlue(a) - qBlue(b)) <= 1;
}

// The rectangles a drawing call reports for its window: the world gets a stand-in window
// whose only hook records them.
class DirtyRecorder {
public:
    explicit DirtyRecorder(Velmar::GrafPtr port) : m_port(port)
    {
        sDirty = QRect();
        Velmar::Private::PortWindowHooks hooks;
        hooks.markDirty = [](Velmar::AQtWindow*, const QRect& r) { sDirty |= r; };
        m_previous = Velmar::Private::setPortWindowHooks(hooks);
        m_port->window = reinterpret_cast<Velmar::AQtWindow*>(this);
    }
    ~DirtyRecorder()
    {
        m_port->window = nullptr;
        Velmar::Private::setPortWindowHooks(m_previous);
    }
    DirtyRecorder(const DirtyRecorder&) = delete;
    DirtyRecorder& operator=(const DirtyRecorder&) = delete;
    QRect dirty() const { return sDirty; }

private:
    static inline QRect sDirty;
    Velmar::GrafPtr m_port;
    Velmar::Private::PortWindowHooks m_previous;
};

// An owned region handle holding `region`.
struct RgnDeleter {
    void operator()(QRegion* r) const { Velmar::DisposeRgn(r); }
};
using Rgn = std::unique_ptr<QRegion, RgnDeleter>;
inline Rgn rgnOf(const QRegion& region = QRegion())
{
    Rgn r(Velmar::NewRgn());
    *r = region;
    return r;
}

// A polygon recorded with OpenPoly: MoveTo the first point, LineTo the others.
inline Velmar::PolyPtr* recordPoly(const QList<QPoint>& points)
{
    Velmar::PolyPtr* poly = Velmar::OpenPoly();
    for (qsizetype i = 0; i < points.size(); ++i)
        (i ? Velmar::LineTo : Velmar::MoveTo)(short(points[i].x()), short(points[i].y()));
    Velmar::ClosePoly();
    return poly;
}

// Whether an assertion naming `expression` was put to the listener.
inline bool assertedWith(const VelmarTest::ScriptedAutomationListener& l, const char* expression)
{
    for (const auto& q : l.questions())
        if (q.text.contains(QString::fromLatin1(expression)))
            return true;
    return false;
}

} // namespace QDTest
