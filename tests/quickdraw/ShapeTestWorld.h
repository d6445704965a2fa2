// An offscreen world made current for the shape and region tests, with pixel read-back.
#pragma once

#include <Velmar/QDRegions.h>
#include <Velmar/QDShapes.h>
#include <Velmar/QtGrafPort.h>
#include <Velmar/QuickDraw.h>

#include <QImage>
#include <QSet>

namespace ShapeTest {

inline Rect R(int top, int left, int bottom, int right)
{
    return Rect{std::int16_t(top), std::int16_t(left), std::int16_t(bottom), std::int16_t(right)};
}

// A white world of the given size at (0, 0), current while it lives; the previous port
// comes back afterwards.
class World {
public:
    explicit World(int width = 100, int height = 100)
    {
        Velmar::GetPort(&m_previous);
        const Rect bounds = R(0, 0, height, width);
        Velmar::NewGWorld(&m_port, 32, &bounds, nullptr, nullptr, 0);
        Velmar::SetPort(m_port);
    }
    ~World()
    {
        Velmar::SetPort(m_previous);
        Velmar::DisposeGWorld(m_port);
    }
    World(const World&) = delete;
    World& operator=(const World&) = delete;

    Velmar::GrafPtr port() const { return m_port; }

    // The image as drawn so far (the painter is ended so that everything has landed).
    QImage image() const
    {
        m_port->EndPaint();
        return m_port->image()->copy();
    }
    // Every pixel that is not the given colour, as (x, y) points.
    QSet<QPoint> touched(QRgb background = 0xFFFFFFFF) const
    {
        const QImage img = image();
        QSet<QPoint> out;
        for (int y = 0; y < img.height(); ++y)
            for (int x = 0; x < img.width(); ++x)
                if (img.pixel(x, y) != background)
                    out.insert(QPoint(x, y));
        return out;
    }
    QRgb pixel(int x, int y) const
    {
        m_port->EndPaint();
        return m_port->image()->pixel(x, y);
    }

private:
    Velmar::GrafPtr m_port = nullptr;
    Velmar::GrafPtr m_previous = nullptr;
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

inline QByteArray describe(const QSet<QPoint>& pixels)
{
    QRect box;
    for (const QPoint& p : pixels)
        box |= QRect(p, QSize(1, 1));
    return "count " + QByteArray::number(pixels.size()) + " box " + QByteArray::number(box.x())
        + "," + QByteArray::number(box.y()) + " " + QByteArray::number(box.width()) + "x"
        + QByteArray::number(box.height());
}

} // namespace ShapeTest
