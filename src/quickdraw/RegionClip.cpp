// The current port's clip as regions, and the desktop region.
#include <Velmar/QDRegions.h>
#include <Velmar/QtGrafPort.h>

#include "foundation/Conversions.h"
#include "quickdraw/GrafPortPrivate.h"
#include "quickdraw/RegionHandles.h"
#include "quickdraw/CurrentPort.h"
#include "quickdraw/ShapeLog.h"

#include <QGuiApplication>
#include <QScreen>

namespace Velmar {

using namespace Private;

// The port's stored clip, in force or not; a fresh port's is the wide-open rectangle.
void GetClip(RgnHandle rgn)
{
    CurrentPort port("GetClip");
    if (port && given(rgn, "warning: GetClip: null region") && VELMAR_CHECK_REGION(rgn))
        *rgn = port->clipRegion;
}

void SetClip(RgnHandle rgn)
{
    CurrentPort port("SetClip");
    if (port && given(rgn, "warning: SetClip: null region") && VELMAR_CHECK_REGION(rgn))
        setPortClip(port, *rgn);
}

void ClipRect(const Rect* r)
{
    CurrentPort port("ClipRect");
    if (port && given(r, "warning: ClipRect: null rectangle"))
        setPortClip(port, QRegion(toQRect(r)));
}

// Recomputed at every call so that screens coming and going are seen. The region belongs to
// the library and stays live for the whole process.
RgnHandle GetGrayRgn()
{
    static QRegion& gray = *[] {
        auto* region = new QRegion;
        registerRegion(region);
        return region;
    }();
    gray = QRegion();
    if (qobject_cast<QGuiApplication*>(QCoreApplication::instance())) {
        const QList<QScreen*> screens = QGuiApplication::screens();
        for (QScreen* screen : screens)
            gray += screen->availableGeometry();
    }
    return &gray;
}

} // namespace Velmar
