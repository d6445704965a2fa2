// OpenPoly and ClosePoly: the polygon that MoveTo and LineTo record into.
#include <Velmar/Diagnostics.h>
#include <Velmar/QDShapes.h>

#include "quickdraw/CurrentPort.h"
#include "quickdraw/PolyHandles.h"
#include "quickdraw/ShapeLog.h"

#include <QPolygon>

namespace Velmar {

namespace Private {

PolyPtr* newPoly()
{
    auto* poly = new PolyPtr{new QPolygon};
    LiveHandles<PolyPtr>::instance().add(poly);
    return poly;
}

void freePoly(PolyPtr* poly)
{
    LiveHandles<PolyPtr>::instance().remove(poly);
    delete poly->qPoly;
    delete poly;
}

} // namespace Private

// Misuse never hands out null: without a port, or while a region is being defined, the
// caller gets a polygon that records nothing. A nested OpenPoly closes the first polygon
// (it stays with its caller) and opens the new one.
PolyPtr* OpenPoly()
{
    QtGrafPort* port = Private::currentGrafPort();
    if (!VELMAR_ASSERT(port, "!!port"))
        return Private::newPoly();
    VELMAR_ASSERT(port->definingRgn == false, "port->definingRgn == false");
    VELMAR_ASSERT(port->definingPoly == false, "port->definingPoly == false");
    VELMAR_ASSERT(port->polySave == nullptr, "port->polySave == NULL");
    if (port->definingRgn)
        return Private::newPoly();
    PolyPtr* poly = Private::newPoly();
    port->definingPoly = 1;
    port->polySave = poly;
    return poly;
}

void ClosePoly()
{
    Private::CurrentPort port("ClosePoly");
    if (!port)
        return;
    if (!port->definingPoly) {
        Private::shapeWarning("warning: ClosePoly: no polygon is open");
        return;
    }
    port->definingPoly = 0;
    port->polySave = nullptr;
}

} // namespace Velmar
