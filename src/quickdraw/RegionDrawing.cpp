// Drawing regions on the current port.
#include <Velmar/QDRegions.h>
#include <Velmar/QDShapes.h>
#include <Velmar/QuickDraw.h>

#include "quickdraw/GrafPortPrivate.h"
#include "quickdraw/CurrentPort.h"
#include "quickdraw/RegionHandles.h"
#include "quickdraw/RegionHilite.h"
#include "quickdraw/RegionOps.h"
#include "quickdraw/ShapeLog.h"
#include "quickdraw/ShapePainting.h"
#include "quickdraw/ShapeRecording.h"

namespace Velmar {

using namespace Private;

void PaintRgn(RgnHandle rgn)
{
    if (VELMAR_CHECK_REGION(rgn))
        fillShapeRegion("PaintRgn", kQDGrafVerbPaint, *rgn);
}

void EraseRgn(RgnHandle rgn)
{
    if (VELMAR_CHECK_REGION(rgn))
        fillShapeRegion("EraseRgn", kQDGrafVerbErase, *rgn);
}

void FillRgn(RgnHandle rgn, const PatPtr& pattern)
{
    if (VELMAR_CHECK_REGION(rgn))
        fillShapeRegion("FillRgn", kQDGrafVerbFill, *rgn, &pattern);
}

// The frame is the region minus the region inset by the pen width both ways, painted.
void FrameRgn(RgnHandle rgn)
{
    CurrentPort port("FrameRgn");
    if (!port || !VELMAR_CHECK_REGION(rgn) || recordFrameShape(port, *rgn))
        return;
    const int w = penPixelWidth(port->currentPen());
    if (w == 0 || rgn->isEmpty())
        return;
    fillShapeRegion("FrameRgn", kQDGrafVerbPaint, rgn->subtracted(insetRegion(*rgn, w, w)));
}

void InvertRgn(RgnHandle rgn)
{
    if (!VELMAR_CHECK_REGION(rgn))
        return;
    MakeQPainter painter("InvertRgn");
    if (!painter)
        return;
    QtGrafPort* port = painter.port();
    if (!port->image()) {
        shapeWarning("InvertRgn has not implemented for DirectQtDrawing yet");
        return;
    }
    // The hilite mode is part of the call's contract even though this operation ignores it.
    LMSetHiliteMode(LMGetHiliteMode());
    // Pixels are edited in place: the painter ends first, so that it never paints into a
    // buffer the edit has detached from, and starts again on the next drawing call.
    port->EndPaint();
    QRegion area = *rgn;
    if (port->painterState.clipEnabled)
        area &= port->painterState.clip;
    hiliteRegion(port->image(), area.translated(-port->origin()), port->backColor.rgb(),
                 port->hiliteColor.rgb());
    painter |= rgn->boundingRect();
}

// The fill verb has no pattern of its own here: it fills with the pen pattern, as paint does.
void StdRgn(SInt16 verb, RgnHandle rgn)
{
    using Draw = void (*)(RgnHandle);
    static constexpr Draw kByVerb[] = {FrameRgn, PaintRgn, EraseRgn, InvertRgn, PaintRgn};
    if (verb < 0 || verb >= SInt16(std::size(kByVerb))) {
        shapeWarning("warning: StdRgn: unknown verb");
        return;
    }
    kByVerb[verb](rgn);
}

} // namespace Velmar
