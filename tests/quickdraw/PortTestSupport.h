// Offscreen worlds shared by the port, pen, pattern and world tests.
#pragma once

#include <Velmar/Diagnostics.h>
#include <Velmar/QtGrafPort.h>
#include <Velmar/QuickDraw.h>

#include "TestSupport.h"
#include "foundation/Conversions.h"
#include "quickdraw/GrafPortPrivate.h"
#include "quickdraw/PortPainter.h"

#include <QImage>

namespace VelmarTest {

// A 32-bit offscreen world with its top-left at (0, 0), made current. Disposed with the
// scope unless the test has disposed of it already.
class World {
public:
    explicit World(int width, int height = 0)
    {
        const Rect r = Velmar::Private::makeRect(0, 0, width, height ? height : width);
        Velmar::NewGWorld(&m_port, 32, &r, nullptr, nullptr, 0);
        Velmar::SetPort(m_port);
    }
    ~World()
    {
        if (Velmar::IsValidPort(m_port))
            Velmar::DisposeGWorld(m_port);
    }
    World(const World&) = delete;
    World& operator=(const World&) = delete;

    operator Velmar::GrafPtr() const { return m_port; }
    Velmar::GrafPtr operator->() const { return m_port; }
    QImage& image() const { return *m_port->image(); }
    QRgb pixel(int x, int y) const { return m_port->image()->pixel(x, y); }
    // The port's painter, started as a drawing call starts it.
    QPainter* painter() const { return Velmar::Private::portPainter(m_port, "test"); }

private:
    Velmar::GrafPtr m_port = nullptr;
};

} // namespace VelmarTest
