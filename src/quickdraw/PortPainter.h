// What drawing calls use: the painter of a port, the resolved fill and background brushes,
// and the pen-mode to composition-mode table.
#pragma once

#include <Velmar/QtGrafPort.h>
#include <Velmar/QuickDraw.h>

#include "quickdraw/GrafPortPrivate.h"

namespace Velmar::Private {

// The slow half of portPainter: logs, starts the painter, or gives null.
QPainter* startPortPainter(QtGrafPort* port, const char* caller);

// The port's active painter, started if need be; null (with a log line naming `caller`)
// without a port, for a direct-drawing window outside its paint event, or when the
// painter cannot start. A null port logs "warning: <caller>: Can't get current port!".
inline QPainter* portPainter(QtGrafPort* port, const char* caller)
{
    if (port && painterRuns(port))
        return port->painter;
    return startPortPainter(port, caller);
}

// A port's cached brush while its ink is unchanged, else `resolve(port)` (which refills it).
inline const QBrush& cachedBrush(QtGrafPort* port, const QtGrafPortPrivate::BrushCache& cache,
                                 const QBrush& (*resolve)(QtGrafPort*))
{
    if (cache.valid && cache.serial == portData(port)->inkSerial)
        return cache.result;
    return resolve(port);
}

// The brush Paint and Fill operations use: the pen pattern in the foreground colour, on the
// back colour (or transparent paper under patOr). The reference stays valid until the next
// call for the same port.
const QBrush& resolveFillBrush(QtGrafPort* port);
inline const QBrush& resolvedFillBrush(QtGrafPort* port)
{
    return cachedBrush(port, portData(port)->fillCache, resolveFillBrush);
}
// The brush Erase operations and ScrollRect use: the background pattern in the back colour.
const QBrush& resolveBackgroundBrush(QtGrafPort* port);
inline const QBrush& resolvedBackgroundBrush(QtGrafPort* port)
{
    return cachedBrush(port, portData(port)->backCache, resolveBackgroundBrush);
}
// A given pattern resolved like the fill brush (FillRect and friends).
QBrush resolvedPatternBrush(QtGrafPort* port, const QBrush& pattern);

// Recolours `brush` with ink and paper (the recolouring rules): solid black -> ink, solid
// white -> paper, textures get ink on opaque or transparent paper. Cached process-wide.
QBrush recolourBrush(const QBrush& brush, const QColor& ink, const QColor& paper,
                     bool transparentPaper);

// The composition mode a pen mode draws with.
QPainter::CompositionMode compositionModeForPenMode(SInt16 mode);

// Converts eight pattern bytes to a brush (inverted bytes, least-significant bit leftmost).
QBrush patternToBrush(const Pattern& pattern);

} // namespace Velmar::Private
