// OpenPoly and ClosePoly: the polygon that MoveTo and LineTo record into.
#include <Velmar/Diagnostics.h>
#include <Velmar/QDShapes.h>

#include "quickdraw/GrafPortPrivate.h"
#include "quickdraw/ShapeLog.h"
#include "quickdraw/ShapeRecording.h"

#include <QPolygon>

namespace Velmar {

namespace {

PolyPtr* newPoly()
{
    return new PolyPtr{new QPolygon};
}

} // namespace

// Misuse never hands out null: without a port, or while a region is being defined, the
// caller gets a polygon that records nothing. A nested OpenPoly closes the first polygon
// (it stays with its caller) and opens the new one.
PolyPtr* OpenPoly()
{
    QtGrafPort* port = Private::currentGrafPort();
    VELMAR_ASSERT(!!port, "OpenPoly needs a current port");
    if (!port)
        return newPoly();
    VELMAR_ASSERT(port->definingRgn == false, "OpenPoly while a region is being defined");
    VELMAR_ASSERT(port->definingPoly == false, "OpenPoly while a polygon is open");
    VELMAR_ASSERT(port->polySave == NULL, "OpenPoly while a polygon is recorded");
    if (port->definingRgn)
        return newPoly();
    PolyPtr* poly = newPoly();
    port->definingPoly = 1;
    port->polySave = poly;
    return poly;
}

void ClosePoly()
{
    QtGrafPort* port = Private::currentGrafPort();
    if (!port) {
        Private::shapeWarning("warning: ClosePoly: cannot get current port");
        return;
    }
    if (!port->definingPoly) {
        Private::shapeWarning("warning: ClosePoly: no polygon is open");
        return;
    }
    port->definingPoly = 0;
    port->polySave = nullptr;
}

} // namespace Velmar
