#include "quickdraw/ShapeRecording.h"

#include <Velmar/Diagnostics.h>
#include <Velmar/QDShapes.h>

#include "quickdraw/GrafPortPrivate.h"

#include <QPolygon>

namespace Velmar::Private {

bool recordFrameShape(QtGrafPort* port, const QRegion& shape)
{
    if (!port || !port->definingRgn)
        return false;
    QRegion* saveRegion = port->rgnSave;
    VELMAR_ASSERT(NULL != saveRegion, "a region is being defined without its region");
    if (saveRegion)
        *saveRegion ^= shape;
    return true;
}

bool recordPenPoint(QtGrafPort* port, int h, int v)
{
    if (!port || !(port->definingPoly || port->definingRgn))
        return false;
    VELMAR_ASSERT(port->polySave, "a polygon or region is being defined without its polygon");
    PolyPtr* polySave = port->polySave;
    VELMAR_ASSERT(polySave != NULL, "a polygon or region is being defined without its polygon");
    if (port->definingRgn)
        VELMAR_ASSERT(port->rgnSave != NULL, "a region is being defined without its region");
    if (polySave && polySave->qPoly)
        polySave->qPoly->append(QPoint(h, v));
    return true;
}

void discardRecording(QtGrafPort* port)
{
    if (!port)
        return;
    if (port->definingRgn && port->polySave) {
        delete port->polySave->qPoly;
        delete port->polySave;
    }
    delete port->rgnSave;
    port->rgnSave = nullptr;
    port->polySave = nullptr;
    port->definingRgn = 0;
    port->definingPoly = 0;
}

void forgetOpenPoly(PolyPtr* poly)
{
    for (QtGrafPort* port : livePorts()) {
        if (port->definingPoly && port->polySave == poly) {
            VelmarLog(kLogQuickDraw, "warning: KillPoly: polygon %p killed while still open",
                      static_cast<void*>(poly));
            port->definingPoly = 0;
            port->polySave = nullptr;
        }
    }
}

QRegion polygonRegion(const QPolygon& polygon)
{
    return QRegion(polygon, Qt::OddEvenFill);
}

} // namespace Velmar::Private
