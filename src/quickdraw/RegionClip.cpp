// The current port's clip as regions, and the desktop region.
#include <Velmar/QDRegions.h>
#include <Velmar/QtGrafPort.h>

#include "foundation/Conversions.h"
#include "quickdraw/GrafPortPrivate.h"
#include "quickdraw/ShapeLog.h"

#include <QGuiApplication>
#include <QScreen>

namespace Velmar {

using namespace Private;

// The port's stored clip, in force or not; a fresh port's is the wide-open rectangle.
void GetClip(RgnHandle rgn)
{
    QtGrafPort* port = shapePort("warning: GetClip: cannot get current port");
    if (port && given(rgn, "warning: GetClip: null region"))
        *rgn = port->clipRegion;
}

void SetClip(RgnHandle rgn)
{
    QtGrafPort* port = shapePort("warning: SetClip: cannot get current port");
    if (port && given(rgn, "warning: SetClip: null region"))
        SetPortClipRegion(port, rgn);
}

void ClipRect(const Rect* r)
{
    QtGrafPort* port = shapePort("warning: ClipRect: cannot get current port");
    if (port && given(r, "warning: ClipRect: null rectangle")) {
        QRegion region(toQRect(r));
        SetPortClipRegion(port, &region);
    }
}

// Recomputed at every call so that screens coming and going are seen.
RgnHandle GetGrayRgn()
{
    static QRegion gray;
    gray = QRegion();
    if (qobject_cast<QGuiApplication*>(QCoreApplication::instance())) {
        const QList<QScreen*> screens = QGuiApplication::screens();
        for (QScreen* screen : screens)
            gray += screen->availableGeometry();
    }
    return &gray;
}

} // namespace Velmar
