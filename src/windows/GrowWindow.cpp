// GrowWindow: the classic modal resize. A rubber band follows the mouse from the frame's
// bottom-right corner, held between the host's minimum and maximum sizes.
#include <Velmar/AQtWindow.h>
#include <Velmar/Windows.h>

#include "windows/MouseTracker.h"
#include "windows/WindowPrivate.h"

#include <QCursor>
#include <QRubberBand>

namespace Velmar {

using namespace Private;

SInt32 GrowWindow(WindowRef window, Point start, const Rect* sizeConstraints)
{
    if (!VELMAR_CHECK_WINDOW(window))
        return 0;
    const QPoint origin = window->ReferenceOrigin();
    const QRect content = window->ContentGeometry().translated(origin);
    const QRect frame = window->FrameGeometry().translated(origin);
    const QSize extra = frame.size() - content.size();
    // Top and left are the smallest height and width, bottom and right the largest.
    QSize minimum(1, 1), maximum(kMaxWindowSide, kMaxWindowSide);
    if (sizeConstraints) {
        minimum = QSize(sizeConstraints->left, sizeConstraints->top);
        maximum = QSize(sizeConstraints->right, sizeConstraints->bottom);
    }
    minimum = minimum.expandedTo(QSize(1, 1)) + extra;
    maximum = maximum.boundedTo(QSize(kMaxWindowSide, kMaxWindowSide)) + extra;

    QRubberBand band(QRubberBand::Rectangle);
    band.setGeometry(frame);
    band.show();
    const QPoint grabbed(start.h, start.v);
    const QPoint offset = frame.bottomRight() - grabbed;
    {
        MouseTracker tracker(window);
        tracker.run([&](const QPoint& cursor, bool leftHeld) {
            const QPoint corner = cursor + offset;
            const int width = qMax(qMin(corner.x() - frame.left() + 1, maximum.width()), minimum.width());
            const int height = qMax(qMin(corner.y() - frame.top() + 1, maximum.height()), minimum.height());
            band.setGeometry(QRect(frame.topLeft(), QSize(width, height)));
            if (leftHeld)
                return true;
            band.hide();
            return false;
        });
    }
    const QSize grown = band.size() - extra;
    return SInt32(UInt32(UInt16(grown.width())) | (UInt32(UInt16(grown.height())) << 16));
}

} // namespace Velmar
