#include "quickdraw/ShapeRecording.h"

#include <Velmar/Diagnostics.h>
#include <Velmar/QDShapes.h>

#include "quickdraw/GrafPortPrivate.h"
#include "quickdraw/PolyHandles.h"

#include <QPolygon>

namespace Velmar::Private {

bool recordFrameShape(QtGrafPort* port, const QRegion& shape)
{
    if (!port || !port->definingRgn)
        return false;
    QRegion* saveRegion = port->rgnSave;
    if (VELMAR_ASSERT(saveRegion, "NULL != saveRegion"))
        *saveRegion ^= shape;
    return true;
}

bool recordPenPoint(QtGrafPort* port, int h, int v)
{
    if (!port || !(port->definingPoly || port->definingRgn))
        return false;
    VELMAR_ASSERT(port->polySave, "port->polySave");
    PolyPtr* polySave = port->polySave;
    VELMAR_ASSERT(polySave, "polySave != NULL");
    if (port->definingRgn)
        VELMAR_ASSERT(port->rgnSave, "port->rgnSave != NULL");
    if (polySave && polySave->qPoly)
        polySave->qPoly->append(QPoint(h, v));
    return true;
}

void discardRecording(QtGrafPort* port)
{
    if (!port)
        return;
    if (port->definingRgn && port->polySave)
        freePoly(port->polySave);
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

} // namespace Velmar::Private
