// OpenRgn and CloseRgn: frame calls XOR their shapes into the region being defined, and the
// points that MoveTo and LineTo record become one odd-even polygon XORed in at the end.
#include <Velmar/Diagnostics.h>
#include <Velmar/QDRegions.h>
#include <Velmar/QDShapes.h>

#include "quickdraw/CurrentPort.h"
#include "quickdraw/PolyHandles.h"
#include "quickdraw/RegionHandles.h"
#include "quickdraw/ShapeLog.h"
#include "quickdraw/ShapeRecording.h"

#include <QPolygon>

namespace Velmar {

using namespace Private;

void OpenRgn()
{
    CurrentPort port("OpenRgn");
    if (!port)
        return;
    VELMAR_ASSERT(port->definingPoly == false, "port->definingPoly == false");
    VELMAR_ASSERT(port->definingRgn == false, "port->definingRgn == false");
    VELMAR_ASSERT(port->rgnSave == nullptr, "port->rgnSave == NULL");
    // After a misuse the port starts afresh: an earlier region is dropped, an open polygon
    // is let go (it belongs to its caller).
    discardRecording(port);
    port->rgnSave = new QRegion;
    port->polySave = newPoly();
    port->definingRgn = 1;
}

namespace {

void closeRegion(QtGrafPort* port, QRegion& out)
{
    VELMAR_ASSERT(port->definingRgn == true, "port->definingRgn == true");
    VELMAR_ASSERT(port->definingPoly == false, "port->definingPoly == false");
    VELMAR_ASSERT(port->rgnSave, "port->rgnSave");
    VELMAR_ASSERT(port->polySave && port->polySave->qPoly,
                  "port->polySave && port->polySave->qPoly");
    if (!port->definingRgn || !port->rgnSave)
        return;
    if (port->polySave && port->polySave->qPoly && port->polySave->qPoly->size() > 2)
        *port->rgnSave ^= polygonRegion(*port->polySave->qPoly);
    out = *port->rgnSave;
    discardRecording(port);
}

} // namespace

// A null destination leaves the region open, deliberately.
void CloseRgn(RgnHandle dst)
{
    if (!dst)
        return;
    CurrentPort port("CloseRgn");
    if (port && VELMAR_CHECK_REGION(dst))
        closeRegion(port, *dst);
}

CleanupOpenRgn::~CleanupOpenRgn()
{
    QtGrafPort* port = currentGrafPort();
    if (port && port->definingRgn) {
        QRegion scratch;
        closeRegion(port, scratch);
    }
}

} // namespace Velmar
