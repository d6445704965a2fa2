// Recording of outlines while a polygon (OpenPoly) or a region (OpenRgn) is being defined:
// MoveTo and LineTo append points to the open polygon, frame calls XOR into the region.
#pragma once

#include <Velmar/QtGrafPort.h>

#include "quickdraw/CurrentPort.h"
#include "quickdraw/ShapeRegions.h"

namespace Velmar::Private {

// While the port defines a region: XORs `shape` into the region being defined and returns
// true (the caller then draws nothing). Otherwise returns false.
bool recordFrameShape(QtGrafPort* port, const QRegion& shape);

// The current port to draw a frame on. Null when there is none (after the call's warning)
// and when the port defines a region: `shape()` is then XORed into the region instead of
// drawn.
template <typename Shape>
QtGrafPort* framingPort(const char* call, Shape shape)
{
    QtGrafPort* port = CurrentPort(call);
    if (port && port->definingRgn) {
        recordFrameShape(port, shape());
        return nullptr;
    }
    return port;
}

// While the port defines a polygon or a region: appends (h, v) to the open polygon.
// Returns true when the port is recording.
bool recordPenPoint(QtGrafPort* port, int h, int v);

// Drops whatever the port is recording. A region's scratch polygon and region are freed;
// an open polygon belongs to its caller and is only let go.
void discardRecording(QtGrafPort* port);

// Called when a polygon is killed: a port still recording into it stops recording, so that
// its polygon pointer never dangles.
void forgetOpenPoly(PolyPtr* poly);

} // namespace Velmar::Private
