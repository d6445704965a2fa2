// OpenRgn and CloseRgn: frame calls XOR their shapes into the region being defined, and the
// points that MoveTo and LineTo record become one odd-even polygon XORed in at the end.
#include <Velmar/Diagnostics.h>
#include <Velmar/QDRegions.h>
#include <Velmar/QDShapes.h>

#include "quickdraw/ShapeLog.h"
#include "quickdraw/ShapeRecording.h"

#include <QPolygon>

namespace Velmar {

using namespace Private;

void OpenRgn()
{
    QtGrafPort* port = shapePort("warning: OpenRgn: cannot get current port");
    if (!port)
        return;
    VELMAR_ASSERT(port->definingPoly == false, "OpenRgn while a polygon is open");
    VELMAR_ASSERT(port->definingRgn == false, "OpenRgn while a region is being defined");
    VELMAR_ASSERT(port->rgnSave == NULL, "OpenRgn while a region is recorded");
    // After a misuse the port starts afresh: an earlier region is dropped, an open polygon
    // is let go (it belongs to its caller).
    discardRecording(port);
    port->rgnSave = new QRegion;
    port->polySave = new PolyPtr{new QPolygon};
    port->definingRgn = 1;
}

// A null destination leaves the region open, deliberately.
void CloseRgn(RgnHandle dst)
{
    if (!dst)
        return;
    QtGrafPort* port = shapePort("warning: CloseRgn: cannot get current port");
    if (!port)
        return;
    VELMAR_ASSERT(port->definingRgn == true, "CloseRgn without OpenRgn");
    VELMAR_ASSERT(port->definingPoly == false, "CloseRgn while a polygon is open");
    VELMAR_ASSERT(port->rgnSave, "CloseRgn without a recorded region");
    VELMAR_ASSERT(port->polySave && port->polySave->qPoly, "CloseRgn without a recorded polygon");
    if (!port->definingRgn || !port->rgnSave)
        return;
    if (port->polySave && port->polySave->qPoly && port->polySave->qPoly->size() > 2)
        *port->rgnSave ^= polygonRegion(*port->polySave->qPoly);
    *dst = *port->rgnSave;
    discardRecording(port);
}

CleanupOpenRgn::~CleanupOpenRgn()
{
    QtGrafPort* port = currentGrafPort();
    if (port && port->definingRgn) {
        QRegion scratch;
        CloseRgn(&scratch);
    }
}

} // namespace Velmar
